// Keyboard layouts switched on the desktop: with two layouts in the server's
// keymap, the one the desktop locks decides which key a scan code is, what
// the layout answers, and what a key types, before and after any key press.
#include <unistd.h>
// xcb/xkb.h names a field "explicit", a C++ keyword.
#define explicit explicit_
#include <xcb/xkb.h>
#undef explicit
#include <xkbcommon/xkbcommon-keysyms.h>

#include <cstdlib>
#include <string>

#include "support/ui/XvfbServer.h"
#include "ui/KeyboardLayout.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

constexpr unsigned kLanguageGerman = 1031;

class X11Layouts : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    if (access("/usr/bin/setxkbmap", X_OK) != 0) GTEST_SKIP() << "setxkbmap is not installed";
    ASSERT_EQ(SetLayouts("us,de"), 0);
    mChanged = true;
    std::free(xcb_xkb_use_extension_reply(mUser, xcb_xkb_use_extension(mUser, 1, 0), nullptr));
    mWindow = MakeShownWindow(OS_Rect(100, 100, 200, 150), 0x336699);
    mY = mXTest->KeycodeOf(XKB_KEY_y);
    ASSERT_NE(mY, 0);
    // The layer has read the new keymap when the second layout's name is known.
    ASSERT_TRUE(WaitFor([&] { return mLayer->ScanCodeToVirtualKey(mY - 8u) == 'Y'; }));
  }
  void TearDown() override {
    if (mChanged) {
      LockGroup(0);
      SetLayouts("us");
    }
    X11Fixture::TearDown();
  }
  int SetLayouts(const std::string& inLayouts) {
    const std::string command =
        "setxkbmap -display " + XvfbServer::Get()->GetDisplayName() + " -layout " + inLayouts + " >/dev/null 2>&1";
    return std::system(command.c_str());
  }
  // What the desktop does when the user picks another layout.
  void LockGroup(int inGroup) {
    xcb_xkb_latch_lock_state(mUser, XCB_XKB_ID_USE_CORE_KBD, 0, 0, 1, static_cast<uint8_t>(inGroup), 0, 0, 0);
    xcb_flush(mUser);
  }

  bool mChanged = false;
  OS_WindowHandle mWindow = 0;
  xcb_keycode_t mY = 0;
};

TEST_F(X11Layouts, TheLockedLayoutDecidesKeysBeforeAnyIsPressed) {
  const unsigned scan = mY - 8u;
  const KeyboardLayoutInterface* layout = mLayer->GetKeyboardLayout();
  ASSERT_NE(layout, nullptr);
  EXPECT_NE(layout->GetActiveLayout(), kLanguageGerman);
  LockGroup(1);
  ASSERT_TRUE(WaitFor([&] { return mLayer->ScanCodeToVirtualKey(scan) == 'Z'; }))
      << "the German layout has Z where the US one has Y";
  EXPECT_EQ(layout->GetActiveLayout(), kLanguageGerman);
  EXPECT_EQ(layout->CharacterToKey(layout->GetActiveLayout(), u'Z'), 'Z');
  EXPECT_EQ(layout->KeyToCharacter(layout->GetActiveLayout(), 'Z'), u'Z');

  mXTest->KeyCode(mY, true);
  mXTest->KeyCode(mY, false);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgChar); }));
  EXPECT_EQ(MessagesOf(kOSMsgChar)[0].wParam, std::uintptr_t('z'));
  EXPECT_EQ(MessagesOf(kOSMsgKeyDown)[0].wParam, std::uintptr_t('Z'));

  LockGroup(0);
  ASSERT_TRUE(WaitFor([&] { return mLayer->ScanCodeToVirtualKey(scan) == 'Y'; })) << "back to the US layout";
  EXPECT_NE(layout->GetActiveLayout(), kLanguageGerman);
}

}  // namespace
}  // namespace norvik::test
