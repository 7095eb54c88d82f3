// Real key presses through the X server reaching the focused node: key codes,
// characters with and without Shift, Tab moving focus, dead keys composing,
// and the keyboard layout in force deciding which key a character came from.
#include <xkbcommon/xkbcommon-keysyms.h>

#include "support/ui/KeyCodes.h"
#include "x11/X11BridgeFixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

constexpr short kKeyOne = '1';

class X11BridgeKeyboard : public X11BridgeTest {
 protected:
  void SetUp() override {
    X11BridgeTest::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    mWindow = MakeMainWindow(OS_Rect(60, 60, 300, 200));
    mFirst = Add(mWindow.get(), new KeyLogView("first"), 10, 10, 100, 30);
    mSecond = Add(mWindow.get(), new KeyLogView("second"), 10, 50, 100, 30);
    ASSERT_TRUE(mFirst->UI_GainKeyboardFocus(kFocusChangeMouse));
    Settle(20);
  }
  void TearDown() override {
    mFirst.reset();
    mSecond.reset();
    mWindow.reset();
    X11BridgeTest::TearDown();
  }
  std::string FocusLeaf() const {
    const UI_Node* leaf = mManager.GetKeyboardFocusLeafNode();
    return leaf ? leaf->UI_GetNodeID().c_str() : "";
  }

  OS_TopLevelViewContainerP mWindow;
  KeyLogViewP mFirst, mSecond;
};

TEST_F(X11BridgeKeyboard, TypedKeysReachTheFocusedNodeWithCodesAndCharacters) {
  ASSERT_TRUE(mUser->Tap(XKB_KEY_a));
  ASSERT_TRUE(mUser->Key(XKB_KEY_Shift_L, true));
  ASSERT_TRUE(mUser->Tap(XKB_KEY_1));
  ASSERT_TRUE(mUser->Key(XKB_KEY_Shift_L, false));
  ASSERT_TRUE(WaitFor([&] { return mFirst->Actions(KeyboardEvent::kActionKeyUp).size() == 3; }));

  EXPECT_TRUE(mSecond->keys.empty());
  const auto downs = mFirst->Actions(KeyboardEvent::kActionKeyDown);
  ASSERT_EQ(downs.size(), 3u);
  EXPECT_EQ(downs[0].GetOSCode(), 'A');
  EXPECT_EQ(downs[1].GetOSCode(), ui::test::keys::kShift);
  EXPECT_EQ(downs[2].GetOSCode(), kKeyOne);
  EXPECT_TRUE(downs[2].GetModKey().Test(kModKeyShift));
  EXPECT_FALSE(downs[0].GetModKey().Test(kModKeyShift));

  const auto chars = mFirst->Actions(KeyboardEvent::kActionKeyChar);
  ASSERT_EQ(chars.size(), 2u);
  EXPECT_EQ(chars[0].GetCharacter(), u'a');
  EXPECT_EQ(chars[1].GetCharacter(), u'!');
  EXPECT_EQ(chars[1].GetOSCode(), kKeyOne) << "the character's key is the key that typed it";
  EXPECT_TRUE(chars[1].GetModKey().Test(kModKeyShift));
}

TEST_F(X11BridgeKeyboard, ADeadKeyComposesWithTheNextLetter) {
  // A key of the server's keyboard becomes the dead acute accent, as on many layouts.
  const xcb_keycode_t grave = mUser->KeycodeOf(XKB_KEY_grave);
  ASSERT_NE(grave, 0);
  mUser->MapKey(grave, XKB_KEY_dead_acute, XKB_KEY_dead_diaeresis);
  Settle(50);
  ASSERT_TRUE(mUser->Tap(XKB_KEY_dead_acute));
  ASSERT_TRUE(mUser->Tap(XKB_KEY_e));
  ASSERT_TRUE(mUser->Key(XKB_KEY_Shift_L, true));
  ASSERT_TRUE(mUser->Tap(XKB_KEY_dead_acute));
  ASSERT_TRUE(mUser->Tap(XKB_KEY_u));
  ASSERT_TRUE(mUser->Key(XKB_KEY_Shift_L, false));
  ASSERT_TRUE(WaitFor([&] { return mFirst->Actions(KeyboardEvent::kActionKeyChar).size() >= 2; }));
  Settle(30);
  const auto chars = mFirst->Actions(KeyboardEvent::kActionKeyChar);
  ASSERT_EQ(chars.size(), 2u) << "the dead keys type nothing of their own";
  EXPECT_EQ(chars[0].GetCharacter(), 0xE9) << "e with acute";
  EXPECT_EQ(chars[1].GetCharacter(), 0xDC) << "U with diaeresis";
  const auto downs = mFirst->Actions(KeyboardEvent::kActionKeyDown);
  ASSERT_FALSE(downs.empty());
  EXPECT_EQ(downs[0].GetOSCode(), 192) << "a dead key is the key at its place on a US keyboard";
}

TEST_F(X11BridgeKeyboard, ALetterBeyondAsciiOnItsOwnKeyTypesItself) {
  // As on a French keyboard, where the key of 2 types e with acute.
  const xcb_keycode_t two = mUser->KeycodeOf(XKB_KEY_2);
  ASSERT_NE(two, 0);
  mUser->MapKey(two, XKB_KEY_eacute, XKB_KEY_2);
  ASSERT_TRUE(WaitFor([&] { return mUser->KeycodeOf(XKB_KEY_eacute) == two; }));
  Settle(30);
  mUser->KeyCode(two, true);
  mUser->KeyCode(two, false);
  ASSERT_TRUE(WaitFor([&] { return !mFirst->Actions(KeyboardEvent::kActionKeyChar).empty(); }));
  EXPECT_EQ(mFirst->Actions(KeyboardEvent::kActionKeyChar)[0].GetCharacter(), 0xE9);
  ASSERT_FALSE(mFirst->Actions(KeyboardEvent::kActionKeyDown).empty());
  EXPECT_EQ(mFirst->Actions(KeyboardEvent::kActionKeyDown)[0].GetOSCode(), '2');
}

TEST_F(X11BridgeKeyboard, TheActiveLayoutDecidesWhichKeyACharacterCameFrom) {
  // The key a US keyboard labels Y types z, as on a German layout.
  const xcb_keycode_t y = mUser->KeycodeOf(XKB_KEY_y);
  ASSERT_NE(y, 0);
  const unsigned scan = static_cast<unsigned>(y - 8);
  EXPECT_EQ(mLayer->ScanCodeToVirtualKey(scan), 'Y');
  mUser->MapKey(y, XKB_KEY_z, XKB_KEY_Z);
  ASSERT_TRUE(WaitFor([&] { return mLayer->ScanCodeToVirtualKey(scan) == 'Z'; }))
      << "the layer follows the server's new mapping";

  // Ctrl with that key: the character message carries a control code, and the
  // node sees the letter of the key under the layout in force.
  ASSERT_TRUE(mUser->Key(XKB_KEY_Control_L, true));
  mUser->KeyCode(y, true);
  mUser->KeyCode(y, false);
  ASSERT_TRUE(mUser->Key(XKB_KEY_Control_L, false));
  ASSERT_TRUE(WaitFor([&] { return !mFirst->Actions(KeyboardEvent::kActionKeyChar).empty(); }));
  const KeyboardEvent typed = mFirst->Actions(KeyboardEvent::kActionKeyChar)[0];
  EXPECT_EQ(typed.GetCharacter(), u'Z');
  EXPECT_TRUE(typed.GetModKey().Test(kModKeyCtrl));
}

TEST_F(X11BridgeKeyboard, ScanCodesOfKeysWithoutAVirtualKeyAnswerZero) {
  EXPECT_EQ(mLayer->ScanCodeToVirtualKey(0), 0);
  EXPECT_EQ(mLayer->ScanCodeToVirtualKey(0xFFFF), 0);
  const xcb_keycode_t left = mUser->KeycodeOf(XKB_KEY_Left);
  ASSERT_NE(left, 0);
  EXPECT_EQ(mLayer->ScanCodeToVirtualKey(static_cast<unsigned>(left - 8)), 37);
}

}  // namespace
}  // namespace norvik::test
