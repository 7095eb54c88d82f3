#pragma once
// A key as shortcuts compare it. One 32-bit value: the low 16 bits hold a
// character or a control code, bit 31 marks a printable character and bit 30
// a key of the numeric keypad ("extended"). The value 65535 means "no code";
// it never compares equal to anything, itself included, so a key that has
// neither a character nor a control code can never trigger a shortcut.
#include <cstdint>

namespace norvik::ui {

// Control codes: keys that are not characters, independent of the platform's
// own key numbering.
enum ControlCode : unsigned short {
  kControlCodeNone = 0,
  kControlCodeSpace = 1,
  kControlCodeBackspace = 2,
  kControlCodeTab = 3,
  kControlCodeReturn = 4,
  kControlCodeEnter = 5,  // the numeric keypad's Enter
  kControlCodeEscape = 6,
  kControlCodeF1 = 7,     // F1 to F24 are 7 to 30
  kControlCodeF24 = 30,
  kControlCodePrintScreen = 31,
  kControlCodeScrollLock = 32,
  kControlCodePause = 33,
  kControlCodeInsert = 34,
  kControlCodeDelete = 35,
  kControlCodeHome = 36,
  kControlCodeEnd = 37,
  kControlCodePageUp = 38,
  kControlCodePageDown = 39,
  kControlCodeHelp = 40,
  kControlCodeClear = 41,
  kControlCodeLeft = 42,
  kControlCodeRight = 43,
  kControlCodeUp = 44,
  kControlCodeDown = 45,
  kControlCodeNumLock = 46,
  kControlCodeCtrl = 47,
  kControlCodeAlt = 48,
  kControlCodeShift = 50,
  kControlCodeCapsLock = 51,
  kControlCodeContextMenu = 52,
};

class KeyboardCode {
 public:
  static constexpr std::uint32_t kNoCode = 65535;
  static constexpr std::uint32_t kPrintableBit = 0x80000000u;
  static constexpr std::uint32_t kExtendedBit = 0x40000000u;

  constexpr KeyboardCode() = default;
  constexpr explicit KeyboardCode(std::uint32_t inValue) : mValue(inValue) {}

  // A printable character; character 0 gives no code.
  static KeyboardCode CreateFromKeyboardChar(unsigned short inCharacter, bool inExtended = false);
  // A control code; control code 0 gives no code.
  static KeyboardCode CreateFromControlCode(unsigned short inControlCode, bool inExtended = false);

  // The raw value; without inWithExtended the keypad bit is cleared, so that
  // a keypad key and its main-block twin give the same value.
  std::uint32_t GetValue(bool inWithExtended = true) const {
    return inWithExtended ? mValue : (mValue & ~kExtendedBit);
  }
  bool IsValid() const { return mValue != kNoCode; }
  bool IsPrintable() const { return IsValid() && (mValue & kPrintableBit) != 0; }
  bool IsExtended() const { return IsValid() && (mValue & kExtendedBit) != 0; }
  // The character of a printable code, else 0.
  unsigned short GetCharacter() const {
    return IsPrintable() ? static_cast<unsigned short>(mValue & 0xFFFFu) : 0;
  }
  // The control code of a non-printable code, else kControlCodeNone.
  unsigned short GetControlCode() const {
    return (IsValid() && !IsPrintable()) ? static_cast<unsigned short>(mValue & 0xFFFFu) : 0;
  }

  // Equality is false whenever either side is "no code".
  bool operator==(const KeyboardCode& o) const { return IsValid() && o.IsValid() && mValue == o.mValue; }
  bool operator!=(const KeyboardCode& o) const { return !(*this == o); }
  bool operator<(const KeyboardCode& o) const { return mValue < o.mValue; }
  bool operator>(const KeyboardCode& o) const { return o < *this; }
  bool operator<=(const KeyboardCode& o) const { return !(o < *this); }
  bool operator>=(const KeyboardCode& o) const { return !(*this < o); }

 private:
  std::uint32_t mValue = kNoCode;
};

}  // namespace norvik::ui
