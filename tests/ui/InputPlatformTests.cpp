// The input seam over the native layer: modifier state as of the message and
// as the keyboard holds it now, removal of a pending message, and the default
// cursor, all read from the headless window system.
#include <gtest/gtest.h>

#include "ui/HeadlessWindowSystem.h"
#include "ui/InputPlatform.h"
#include "ui/KeyboardEvent.h"

namespace norvik::ui {
namespace {

TEST(InputPlatformOverNativeLayer, WithoutALayerTheAnswersAreQuiet) {
  ASSERT_EQ(GetNativeLayer(), nullptr);
  EXPECT_TRUE(utility::GetCurrentModKeys().IsEmpty());
  EXPECT_TRUE(utility::GetRecentEventModKeys().IsEmpty());
  EXPECT_FALSE(GetInputPlatform().RemovePendingMessage(1, kOSMsgSysChar));
  GetInputPlatform().SetDefaultCursor();  // nothing to set it on; must not fail
}

TEST(InputPlatformOverNativeLayer, HeldKeysAreReadNowAndCapsLockByItsToggle) {
  HeadlessWindowSystem system;
  system.Install();
  system.PressKey(16);
  system.PressKey(18);
  EXPECT_EQ(utility::GetCurrentModKeys(), ModifierKeys(kModKeyShift | kModKeyAlt));
  EXPECT_TRUE(utility::GetRecentEventModKeys().IsEmpty()) << "no message has carried the keys yet";
  system.SetKeyToggled(20, true);
  EXPECT_EQ(utility::GetCurrentModKeys(), ModifierKeys(kModKeyShift | kModKeyAlt | kModKeyCapsLock));
  EXPECT_EQ(utility::GetRecentEventModKeys(), ModifierKeys(kModKeyCapsLock));
  system.ReleaseKey(16);
  system.ReleaseKey(18);
  system.SetKeyToggled(20, false);
  EXPECT_TRUE(utility::GetCurrentModKeys().IsEmpty());
}

TEST(InputPlatformOverNativeLayer, AnAltShortcutRemovesOnePendingSystemCharacter) {
  HeadlessWindowSystem system;
  system.Install();
  OS_NativeLayer& layer = system.GetLayer();
  OS_WindowCreateParams params;
  params.rect = OS_Rect(0, 0, 100, 100);
  const OS_WindowHandle window = system.CreateForeignWindow(params, false);
  ASSERT_NE(window, 0u);
  layer.PostMessage(window, kOSMsgSysChar, 'f', 0);
  layer.PostMessage(window, kOSMsgSysChar, 'g', 0);
  KeyboardEvent altF(KeyboardEvent::kActionKeyDown, 'F', 'F', ModifierKeys(kModKeyAlt), false,
                     OS_Event(window, kOSMsgSysKeyDown, 'F', 0));
  FlushPostActionKeyEvents(altF);
  OS_Event left;
  ASSERT_TRUE(layer.PeekMessage(left, window, kOSMsgSysChar, kOSMsgSysChar, true));
  EXPECT_EQ(left.GetWParam(), static_cast<std::uintptr_t>('g'));
  EXPECT_FALSE(layer.PeekMessage(left, window, kOSMsgSysChar, kOSMsgSysChar, false));
}

}  // namespace
}  // namespace norvik::ui
