// Keyboard events: their three forms, the shortcut character as the keyboard
// layout gives it, the code that shortcuts compare, and the removal of the
// system character message after an Alt shortcut.
#include <vector>

#include <gtest/gtest.h>

#include "support/ui/FakeInputPlatform.h"
#include "ui/KeyboardEvent.h"

namespace norvik::ui {
namespace {

using test::FakeInputPlatform;
using test::FakeKeyboardLayout;

KeyboardEvent KeyDown(short inOSCode, unsigned short inCharacter, ModifierKeys inMods = {}) {
  return KeyboardEvent(KeyboardEvent::kActionKeyDown, inCharacter, inOSCode, inMods, false,
                       OS_Event(1, kOSMsgKeyDown, static_cast<std::uintptr_t>(inOSCode), 0));
}

TEST(KeyboardEventForms, CharacterFormIsACharActionWithNoKey) {
  KeyboardEvent e(std::vector<unsigned short>{'h', 'i', 9}, ModifierKeys(kModKeyShift), false, OS_Event());
  EXPECT_TRUE(e.IsActionKeyChar());
  EXPECT_EQ(e.GetOSCode(), -1);
  ASSERT_EQ(e.GetNumCharacters(), 3u);
  EXPECT_EQ(e.GetCharacter(1), 'i');
  EXPECT_EQ(e.GetCharacter(2), 0);
  EXPECT_EQ(e.GetCharacter(3), 0) << "past the end reads as 0";
}

TEST(KeyboardEventForms, CharacterFormWithNoCharactersStillHasOne) {
  KeyboardEvent e(std::vector<unsigned short>{}, {}, false, OS_Event());
  EXPECT_EQ(e.GetNumCharacters(), 1u);
  EXPECT_EQ(e.GetCharacter(0), 0);
}

TEST(ShortcutCharacter, IsTheKeysOwnCharacterUpperCasedSaveForKeysTakenAsTyped) {
  struct Case {
    short key;
    unsigned short typed;
    unsigned char mods;
    unsigned short shortcut;
    const char* why;
  };
  const Case cases[] = {
      {'Q', 'q', 0, 'Q', "a letter of the US layout comes out upper case"},
      {'Q', 0, 0, 0, "character 0 is its own result"},
      {'1', '!', kModKeyShift, '1', "Shift+1 types '!', the shortcut sees the key's character"},
      {191, '?', 0, '/', "a key typing another character maps through the layout"},
      {-111, '/', 0, '/', "the extended sign is not part of the key"},
      {'C', 'c', 0, 'c', "C is taken as typed"},
      {'V', 'v', 0, 'v', "V is taken as typed"},
      {91, 'x', 0, 'x', "key 91 is taken as typed"},
      {'B', 'b', 0, 'B', "B is not"},
  };
  for (const Case& c : cases) {
    EXPECT_EQ(KeyDown(c.key, c.typed, ModifierKeys(c.mods)).GetShortcutCharacter(), c.shortcut) << c.why;
  }
}

TEST(ShortcutCharacter, WithoutAKeyTheCharactersKeyIsLookedUp) {
  KeyboardEvent e(KeyboardEvent::kActionKeyChar, '@', 0, ModifierKeys(kModKeyShift), false, OS_Event());
  EXPECT_EQ(e.GetShortcutCharacter(), '2');
  KeyboardEvent lower(KeyboardEvent::kActionKeyChar, 'k', 0, {}, false, OS_Event());
  EXPECT_EQ(lower.GetShortcutCharacter(), 'K');
}

TEST(ShortcutCharacter, ACharacterNoKeyTypesStaysAsTyped) {
  KeyboardEvent e(KeyboardEvent::kActionKeyChar, 0x00E9, 0, {}, false, OS_Event());
  EXPECT_EQ(e.GetShortcutCharacter(), 0x00E9);
}

TEST(ShortcutCharacter, UsesTheActiveLayoutWhenItsCodePageIsSupported) {
  FakeKeyboardLayout german(1031, 1252);
  german.AddKey(186, 0x00FC);  // u with diaeresis, lower case
  EXPECT_EQ(KeyDown(186, 0x00FC).GetShortcutCharacter(), 0x00DC);
  ASSERT_FALSE(german.mLayoutsAsked.empty());
  EXPECT_EQ(german.mLayoutsAsked.back(), 1031u);
}

TEST(ShortcutCharacter, FallsBackToUSEnglishForOtherCodePages) {
  FakeKeyboardLayout russian(1049, 1251);
  russian.AddKey('D', 0x0432);
  EXPECT_EQ(KeyDown('D', 0x0432).GetShortcutCharacter(), 'D');
  ASSERT_FALSE(russian.mLayoutsAsked.empty());
  EXPECT_EQ(russian.mLayoutsAsked.back(), 1033u);
}

TEST(ShortcutCharacter, IsComputedOnceAndKeptInTheEvent) {
  KeyboardEvent e = [] {
    FakeKeyboardLayout greek(1032, 1253);
    return KeyDown('D', 0x03B4);
  }();
  {
    FakeKeyboardLayout czech(1029, 1250);
    czech.AddKey('D', 0x010F);  // d with caron
    EXPECT_EQ(e.GetShortcutCharacter(), 0x010E);
  }
  // The layout is gone; the event answers from its cache.
  EXPECT_EQ(e.GetShortcutCharacter(), 0x010E);
  EXPECT_EQ(e.GetCode().GetCharacter(), 0x010E);
}

TEST(KeyCode, PrintableKeysGiveTheirShortcutCharacter) {
  KeyboardCode q = KeyDown('Q', 'q').GetCode();
  EXPECT_TRUE(q.IsPrintable());
  EXPECT_EQ(q.GetCharacter(), 'Q');
  KeyboardCode keypad5 = KeyDown(101, '5').GetCode();
  EXPECT_TRUE(keypad5.IsPrintable());
  EXPECT_TRUE(keypad5.IsExtended());
  EXPECT_EQ(keypad5.GetCharacter(), '5');
}

TEST(KeyCode, AKeyWithNeitherCharacterNorControlCodeHasNoCodeAndMatchesNothing) {
  KeyboardEvent e = KeyDown(200, 0);
  EXPECT_EQ(e.GetCode().GetValue(), 65535u);
  EXPECT_FALSE(e.CompareCode(KeyboardCode()));
  EXPECT_FALSE(e.CompareShortcut(KeyboardCode(), {}));
  EXPECT_FALSE(e.CompareShortcut(KeyboardCode(65535), {}));
}

TEST(ShortcutMatching, ModifiersMustMatchExactlyWithCapsLockIgnored) {
  KeyboardCode s = KeyboardCode::CreateFromKeyboardChar('S');
  // Key-down events carry the key's upper-case character, as the platform's translation gives it.
  KeyboardEvent ctrlS = KeyDown('S', 'S', ModifierKeys(kModKeyCtrl | kModKeyCapsLock));
  EXPECT_TRUE(ctrlS.CompareShortcut(s, ModifierKeys(kModKeyCtrl)));
  EXPECT_FALSE(ctrlS.CompareShortcut(s, ModifierKeys(kModKeyCtrl | kModKeyCapsLock)));
  EXPECT_FALSE(ctrlS.CompareShortcut(s, ModifierKeys(kModKeyCtrl | kModKeyShift)));
  EXPECT_FALSE(ctrlS.CompareShortcut(s, {}));
  EXPECT_TRUE(ctrlS.CompareCode(s));
  EXPECT_FALSE(ctrlS.CompareCode(KeyboardCode::CreateFromKeyboardChar('D')));
}

TEST(PostActionFlush, ASystemKeyRemovesOnePendingSystemCharacterOfItsWindow) {
  FakeInputPlatform platform;
  platform.PostMessage(1, kOSMsgSysChar);
  platform.PostMessage(2, kOSMsgSysChar);
  platform.PostMessage(1, kOSMsgSysChar);
  KeyboardEvent altF(KeyboardEvent::kActionKeyDown, 'F', 'F', ModifierKeys(kModKeyAlt), false,
                     OS_Event(1, kOSMsgSysKeyDown, 'F', 0));
  FlushPostActionKeyEvents(altF);
  EXPECT_EQ(platform.GetQueue(), (std::vector<std::pair<OS_WindowHandle, unsigned>>{{2, kOSMsgSysChar},
                                                                                     {1, kOSMsgSysChar}}));
  KeyboardEvent altUp(KeyboardEvent::kActionKeyUp, 'F', 'F', ModifierKeys(kModKeyAlt), false,
                      OS_Event(2, kOSMsgSysKeyUp, 'F', 0));
  FlushPostActionKeyEvents(altUp);
  EXPECT_EQ(platform.GetQueue(), (std::vector<std::pair<OS_WindowHandle, unsigned>>{{1, kOSMsgSysChar}}));
}

TEST(PostActionFlush, OrdinaryKeysLeaveTheQueueAlone) {
  FakeInputPlatform platform;
  platform.PostMessage(1, kOSMsgSysChar);
  platform.PostMessage(1, kOSMsgChar);
  FlushPostActionKeyEvents(KeyDown('F', 'f'));
  FlushPostActionKeyEvents(KeyboardEvent(OS_Event(1, kOSMsgSysChar, 'f', 0)));
  EXPECT_EQ(platform.GetQueue().size(), 2u);
}

}  // namespace
}  // namespace norvik::ui
