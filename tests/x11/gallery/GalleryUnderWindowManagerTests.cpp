// The gallery under openbox on the test's Xvfb: frame-relative configure
// events, size hints, focus visiting another client, and no X error.
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>

#include "ControlsView.h"
#include "GalleryWindow.h"
#include "controls/UI_Checkbox.h"
#include "support/ui/XvfbServer.h"
#include "tarsel/ErrorManager.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

class GalleryUnderWindowManager : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    if (access("/usr/bin/openbox", X_OK) != 0) GTEST_SKIP() << "openbox is not installed (scripts/install-deps.sh)";
    if ((mWindowManager = fork()) == 0) {
      std::freopen("/dev/null", "w", stderr), std::freopen("/dev/null", "w", stdout);
      setenv("DISPLAY", XvfbServer::Get()->GetDisplayName().c_str(), 1);
      execl("/usr/bin/openbox", "openbox", "--sm-disable", static_cast<char*>(nullptr));
      _exit(127);
    }
    ASSERT_TRUE(WaitFor([&] {
      auto* owner = xcb_get_selection_owner_reply(mUser, xcb_get_selection_owner(mUser, Atom("WM_S0")), nullptr);
      const bool managed = owner && owner->owner != 0;
      return std::free(owner), managed;
    }, 10000));
    tarsel::config::ErrorManager::Get(true)->SetReportHandler([this](const auto&) { ++mXErrors; });
    ui::InstallNativeLayer(mLayer.get());
    const ui::KeyframeThemeEditorP theme = ui::MakeDefaultKeyframeTheme();
    ui::Theme::Initialize(theme);
    mPage.reset(new gallery::GalleryPage(theme, false));
    mWindow.reset(new gallery::GalleryWindow(mPage, 900, 640));
    ASSERT_TRUE(WaitFor([&] { return mLayer->GetActiveWindow() == Handle() && mWindow->UI_IsShown(); }));
    Settle(400);  // the window manager's own focus changes after mapping
  }
  void TearDown() override {
    mWindow.reset();
    mPage.reset();
    if (mWindowManager > 0) {
      Settle(100);
      EXPECT_EQ(mXErrors, 0) << "X errors from start, the test and closing";
      ui::InstallNativeLayer(nullptr);
      ui::Theme::Terminate();
      tarsel::config::ErrorManager::Get(true)->SetReportHandler(nullptr);
      kill(mWindowManager, SIGTERM);
      waitpid(mWindowManager, nullptr, 0);
    }
    X11Fixture::TearDown();
  }
  xcb_window_t Handle() const { return static_cast<xcb_window_t>(mWindow->GetHandle()); }
  xcb_atom_t Atom(const char* inName) {
    auto* reply = xcb_intern_atom_reply(mUser, xcb_intern_atom(mUser, 0, std::strlen(inName), inName), nullptr);
    const xcb_atom_t atom = reply ? reply->atom : 0;
    std::free(reply);
    return atom;
  }
  // What pagers and wmctrl send the window manager.
  void Ask(const char* inType, std::initializer_list<std::uint32_t> inData, xcb_window_t inWindow = 0) {
    xcb_client_message_event_t message{XCB_CLIENT_MESSAGE, 32, 0, inWindow ? inWindow : Handle(), Atom(inType), {}};
    std::copy(inData.begin(), inData.end(), message.data.data32);
    xcb_send_event(mUser, 0, mXTest->GetRoot(), XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT,
                   reinterpret_cast<const char*>(&message));
    xcb_flush(mUser);
  }
  ui::OS_Point ServerOrigin() {
    auto* reply = xcb_translate_coordinates_reply(
        mUser, xcb_translate_coordinates(mUser, Handle(), mXTest->GetRoot(), 0, 0), nullptr);
    const ui::OS_Point origin(reply ? reply->dst_x : -1, reply ? reply->dst_y : -1);
    std::free(reply);
    return origin;
  }

  pid_t mWindowManager = -1;
  int mXErrors = 0;
  ui::OS_NodeManager mManager;
  gallery::GalleryPageP mPage;
  gallery::GalleryWindowP mWindow;
};

TEST_F(GalleryUnderWindowManager, AfterAMoveAndResizeInOneStepClicksStillReachTheirControls) {
  Ask("_NET_MOVERESIZE_WINDOW", {0xC00 | (2u << 12), 0, 0, 300, 200});  // as wmctrl -e does
  ASSERT_TRUE(WaitFor([&] { return mWindow->UI_GetLocalRect().height == 600; })) << "held to its minimum size";
  Ask("_NET_MOVERESIZE_WINDOW", {0xF00 | (2u << 12), 200, 150, 880, 610});
  ASSERT_TRUE(WaitFor([&] { return mWindow->UI_GetLocalRect().width == 880; }));
  Settle(150);
  EXPECT_EQ(mLayer->ClientToScreen(Handle(), ui::OS_Point(0, 0)), ServerOrigin());
  auto* controls = static_cast<gallery::ControlsView*>(mPage->GetSection("section-controls")->UI_ChildGetFromID("controls"));
  controls::UI_Checkbox* snap = controls->GetSnapCheckbox();
  const ui::UI_Node::RectL box = snap->UI_LocalToGlobal(ui::UI_Node::RectL(0, 0, 10, 10));
  const ui::OS_Point layer = mLayer->ClientToScreen(Handle(), ui::OS_Point(0, 0)), server = ServerOrigin();
  MovePointer(box.left + 5 - layer.x + server.x, box.top + 5 - layer.y + server.y);
  const bool before = snap->IsChecked();
  Button(1, true);
  Button(1, false);
  EXPECT_TRUE(WaitFor([&] { return snap->IsChecked() != before; })) << "the click missed the checkbox";
}

TEST_F(GalleryUnderWindowManager, FocusInsideTheWindowComesBackWhenActivationReturnsFromAnotherClient) {
  ui::UI_Node* tile = mPage->GetFocusTiles()[2];
  tile->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  const xcb_window_t other = xcb_generate_id(mUser);
  xcb_create_window(mUser, 0, other, mXTest->GetRoot(), 600, 500, 300, 200, 0, XCB_WINDOW_CLASS_INPUT_OUTPUT,
                    XCB_COPY_FROM_PARENT, 0, nullptr);
  xcb_map_window(mUser, other);
  Ask("_NET_ACTIVE_WINDOW", {2}, other);
  ASSERT_TRUE(WaitFor([&] { return mLayer->GetActiveWindow() == 0; })) << "the other client never took the focus";
  EXPECT_FALSE(mManager.IsApplicationFrontmost());
  Ask("_NET_ACTIVE_WINDOW", {2});
  EXPECT_TRUE(WaitFor([&] { return tile->UI_HasKeyboardFocus(true); })) << "the tile lost its focus";
}

}  // namespace
}  // namespace norvik::test
