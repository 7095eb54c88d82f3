// Key codes: the KeyboardCode value and its bits, the control-code table of
// platform key codes, the keypad test, and the validation of typed characters.
#include <vector>

#include <gtest/gtest.h>

#include "ui/KeyboardCode.h"
#include "ui/KeyboardEvent.h"

namespace norvik::ui {
namespace {

TEST(KeyboardCodeValue, ACharacterSetsBit31AndTheExtendedBitIsDroppedOnlyWhenAskedTo) {
  KeyboardCode c = KeyboardCode::CreateFromKeyboardChar('7', true);
  EXPECT_TRUE(c.IsExtended());
  EXPECT_EQ(c.GetValue(true), 0xC0000000u | '7');
  EXPECT_EQ(c.GetValue(false), 0x80000000u | '7');
  KeyboardCode home = KeyboardCode::CreateFromControlCode(kControlCodeHome, true);
  EXPECT_EQ(home.GetValue(false), 36u);
  EXPECT_EQ(home.GetControlCode(), kControlCodeHome);
  EXPECT_EQ(home.GetCharacter(), 0);
  EXPECT_FALSE(home.IsPrintable());
}

TEST(KeyboardCodeValue, CharacterZeroGivesNoCode) {
  KeyboardCode none = KeyboardCode::CreateFromKeyboardChar(0, true);
  EXPECT_EQ(none.GetValue(), 65535u);
  EXPECT_FALSE(none.IsValid());
  EXPECT_FALSE(none.IsPrintable());
  EXPECT_FALSE(none.IsExtended());
  EXPECT_EQ(KeyboardCode().GetValue(), 65535u);
}

TEST(KeyboardCodeValue, NoCodeNeverComparesEqualNotEvenToItself) {
  KeyboardCode none;
  EXPECT_FALSE(none == KeyboardCode());
  EXPECT_TRUE(none != KeyboardCode());
  EXPECT_FALSE(none == KeyboardCode(65535));
  EXPECT_FALSE(KeyboardCode::CreateFromControlCode(kControlCodeEscape) == none);
}

TEST(KeyboardCodeValue, EqualityAndOrderFollowTheValue) {
  KeyboardCode a = KeyboardCode::CreateFromKeyboardChar('A');
  KeyboardCode a2 = KeyboardCode::CreateFromKeyboardChar('A');
  KeyboardCode b = KeyboardCode::CreateFromKeyboardChar('B');
  KeyboardCode keypadA = KeyboardCode::CreateFromKeyboardChar('A', true);
  EXPECT_TRUE(a == a2);
  EXPECT_FALSE(a == keypadA);
  EXPECT_TRUE(a < b);
  EXPECT_TRUE(b > a);
  EXPECT_TRUE(a <= a2);
  EXPECT_TRUE(a >= a2);
  EXPECT_TRUE(KeyboardCode::CreateFromControlCode(kControlCodeSpace) < a);
}

struct ControlCodeCase {
  short osCode;
  unsigned short controlCode;
};

class ControlCodeTable : public ::testing::TestWithParam<ControlCodeCase> {};

TEST_P(ControlCodeTable, MapsThePlatformKeyToItsControlCode) {
  EXPECT_EQ(KeyboardEvent::GetControlCode(GetParam().osCode), GetParam().controlCode)
      << "platform key " << GetParam().osCode;
}

INSTANTIATE_TEST_SUITE_P(
    EveryKey, ControlCodeTable,
    ::testing::Values(ControlCodeCase{32, 1}, ControlCodeCase{8, 2}, ControlCodeCase{9, 3}, ControlCodeCase{13, 4},
                      ControlCodeCase{-13, 5}, ControlCodeCase{27, 6}, ControlCodeCase{112, 7},
                      ControlCodeCase{113, 8}, ControlCodeCase{123, 18}, ControlCodeCase{135, 30},
                      ControlCodeCase{-44, 31}, ControlCodeCase{145, 32}, ControlCodeCase{19, 33},
                      ControlCodeCase{45, 34}, ControlCodeCase{-45, 34}, ControlCodeCase{46, 35},
                      ControlCodeCase{-46, 35}, ControlCodeCase{36, 36}, ControlCodeCase{-36, 36},
                      ControlCodeCase{35, 37}, ControlCodeCase{-35, 37}, ControlCodeCase{33, 38},
                      ControlCodeCase{-33, 38}, ControlCodeCase{34, 39}, ControlCodeCase{-34, 39},
                      ControlCodeCase{47, 40}, ControlCodeCase{12, 41}, ControlCodeCase{-1, 41},
                      ControlCodeCase{37, 42}, ControlCodeCase{-37, 42}, ControlCodeCase{39, 43},
                      ControlCodeCase{-39, 43}, ControlCodeCase{38, 44}, ControlCodeCase{-38, 44},
                      ControlCodeCase{40, 45}, ControlCodeCase{-40, 45}, ControlCodeCase{-144, 46},
                      ControlCodeCase{17, 47}, ControlCodeCase{18, 48}, ControlCodeCase{16, 50},
                      ControlCodeCase{20, 51}, ControlCodeCase{-93, 52}));

TEST(ControlCodeTableGaps, KeysOutsideTheTableHaveNoControlCode) {
  for (short code : {0, 65, 90, 48, 111, 136, 144, 93, 44, -32, -27, 200, -200, 32767, -32768}) {
    EXPECT_EQ(KeyboardEvent::GetControlCode(code), kControlCodeNone) << "platform key " << code;
  }
}

TEST(ExtendedKeys, KeypadAndItsNavigationKeysAreExtended) {
  for (short code : {-144, -111, 33, 34, 35, 36, 37, 38, 39, 40, 45, 46, 96, 100, 105, 106, 107, 109, 110}) {
    EXPECT_TRUE(KeyboardEvent::IsExtendedOSCode(code)) << "platform key " << code;
  }
  for (short code : {144, 111, 108, 32, 41, 44, 47, 95, 13, -13, -36, -45, 0, -1, 65}) {
    EXPECT_FALSE(KeyboardEvent::IsExtendedOSCode(code)) << "platform key " << code;
  }
}

TEST(TypedCharacters, ValuesBelowSpaceBecomeZeroAndAnEmptyListGetsOneZero) {
  std::vector<unsigned short> chars{'a', 13, 31, 32, 127, 0x4E2D, 1};
  KeyboardEvent::ValidateKeyChars(chars);
  EXPECT_EQ(chars, (std::vector<unsigned short>{'a', 0, 0, 32, 127, 0x4E2D, 0}));
  chars.clear();
  KeyboardEvent::ValidateKeyChars(chars);
  EXPECT_EQ(chars, std::vector<unsigned short>{0});
}

}  // namespace
}  // namespace norvik::ui
