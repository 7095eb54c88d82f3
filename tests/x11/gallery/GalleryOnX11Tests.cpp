// The gallery's window on a real X server: a click sent through XTEST reaches
// a control of the page through the toolkit's window bridge, the pixels the
// server shows are those of the headless rendering of the same page, and the
// program itself starts, shows its first frame and exits on the display.
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>
#include <xcb/xcb.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "ControlsView.h"
#include "PageSelector.h"
#include "GalleryPage.h"
#include "GalleryWindow.h"
#include "controls/ControlMessages.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_TextButton.h"
#include "support/drawbot/PixelCompare.h"
#include "support/ui/XvfbServer.h"
#include "tarsel/ErrorManager.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using drawbot::testing::PixelImage;

// Inside the 1024x768 screen of the test server, with every control in view.
constexpr long kWidth = 940;
constexpr long kHeight = 660;

class GalleryOnX11 : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    ui::InstallNativeLayer(mLayer.get());
    mInstalled = true;
    mTheme = ui::MakeDefaultKeyframeTheme();
    ui::Theme::Initialize(mTheme);
    // The pointer away from the window, so that nothing on the page is hovered.
    MovePointer(1020, 764);
    mPage.reset(new gallery::GalleryPage(mTheme, false));
    mWindow.reset(new gallery::GalleryWindow(mPage, kWidth, kHeight));
    bool painted = false;
    mWindow->SetFirstFrameFunction([&painted] { painted = true; });
    ASSERT_TRUE(WaitFor([&] { return painted; })) << "the window never painted";
    Settle(100);
  }
  void TearDown() override {
    mWindow.reset();
    mPage.reset();
    if (mInstalled) {
      ui::InstallNativeLayer(nullptr);
      ui::Theme::Terminate();
    }
    X11Fixture::TearDown();
  }

  // The centre of a node, in screen coordinates.
  ui::OS_Point ScreenCentre(const ui::UI_Node* inNode) const {
    const ui::UI_Node::RectF local = inNode->UI_GetLocalRectF(false);
    const ui::UI_Node::RectL onScreen = inNode->UI_LocalToGlobal(
        ui::UI_Node::RectL(0, 0, static_cast<long>(local.width), static_cast<long>(local.height)));
    return ui::OS_Point(onScreen.left + onScreen.width / 2, onScreen.top + onScreen.height / 2);
  }
  void ClickAt(ui::OS_Point inScreen) {
    MovePointer(static_cast<int>(inScreen.x), static_cast<int>(inScreen.y));
    Settle(30);
    Button(1, true);
    Settle(30);
    Button(1, false);
  }
  gallery::ControlsView* Controls() const {
    return static_cast<gallery::ControlsView*>(
        mPage->GetSection("section-controls")->UI_ChildGetFromID("controls"));
  }
  // Counts the change messages of a control from now on.
  controls::ControlChangedFunctionP CountChanges(int& outCount, ui::UI_Node*& outSender) {
    return controls::ControlChangedFunctionP(new controls::ControlChangedFunction(
        [&outCount, &outSender](controls::UI_ControlChangedMessage* inMessage) {
          ++outCount;
          outSender = inMessage->GetControl();
        }));
  }

  xcb_atom_t Atom(const char* inName) {
    xcb_intern_atom_reply_t* reply =
        xcb_intern_atom_reply(mUser, xcb_intern_atom(mUser, 0, std::strlen(inName), inName), nullptr);
    const xcb_atom_t atom = reply ? reply->atom : 0;
    std::free(reply);
    return atom;
  }
  // A client message about the window (or inAbout) to inTo.
  void Send(const char* inType, std::initializer_list<std::uint32_t> inData, xcb_window_t inTo, std::uint32_t inMask,
            xcb_window_t inAbout = 0) {
    xcb_client_message_event_t message{
        XCB_CLIENT_MESSAGE, 32, 0, inAbout ? inAbout : static_cast<xcb_window_t>(mWindow->GetHandle()), Atom(inType), {}};
    std::copy(inData.begin(), inData.end(), message.data.data32);
    xcb_send_event(mUser, 0, inTo, inMask, reinterpret_cast<const char*>(&message));
    xcb_flush(mUser);
  }

  // The window's client area as the server shows it, as opaque 0xAARRGGBB.
  PixelImage ReadWindowFromServer() {
    PixelImage image;
    xcb_get_image_reply_t* reply = xcb_get_image_reply(
        mUser,
        xcb_get_image(mUser, XCB_IMAGE_FORMAT_Z_PIXMAP, static_cast<xcb_drawable_t>(mWindow->GetHandle()), 0, 0,
                      static_cast<std::uint16_t>(kWidth), static_cast<std::uint16_t>(kHeight), ~0u),
        nullptr);
    if (!reply) return image;
    const int length = xcb_get_image_data_length(reply);
    if (length >= kWidth * kHeight * 4) {
      const auto* data = reinterpret_cast<const std::uint32_t*>(xcb_get_image_data(reply));
      image.width = static_cast<int>(kWidth);
      image.height = static_cast<int>(kHeight);
      image.pixels.reserve(static_cast<std::size_t>(kWidth * kHeight));
      for (long i = 0; i < kWidth * kHeight; ++i) image.pixels.push_back(0xFF000000u | (data[i] & 0xFFFFFFu));
    }
    std::free(reply);
    return image;
  }

  // The same page at the same size, rendered by the headless window system
  // while it stands in for the display; the display comes back afterwards.
  PixelImage RenderHeadless() {
    PixelImage image;
    {
      ui::HeadlessWindowSystem system;
      system.Install();
      {
        gallery::GalleryPageP page(new gallery::GalleryPage(mTheme, false));
        gallery::GalleryWindowP window(new gallery::GalleryWindow(page, kWidth, kHeight));
        system.Pump();
        const ui::HeadlessPixels pixels = system.ReadWindowPixels(window->GetHandle());
        image.width = pixels.width;
        image.height = pixels.height;
        image.pixels = pixels.pixels;
      }
      system.Uninstall();
    }
    ui::InstallNativeLayer(mLayer.get());
    return image;
  }

  ui::OS_NodeManager mManager;
  ui::KeyframeThemeEditorP mTheme;
  gallery::GalleryPageP mPage;
  gallery::GalleryWindowP mWindow;
  bool mInstalled = false;
};

TEST_F(GalleryOnX11, AClickOnTheCheckboxTogglesItAndAClickBesideTheWindowDoesNot) {
  controls::UI_Checkbox* snap = Controls()->GetSnapCheckbox();
  ASSERT_TRUE(snap->IsChecked());
  int changes = 0;
  ui::UI_Node* sender = nullptr;
  snap->NotifyWhenChanged(CountChanges(changes, sender));
  ClickAt(ui::OS_Point(1015, 20));  // on the bare root window
  Settle(100);
  EXPECT_EQ(changes, 0);
  ClickAt(ScreenCentre(snap));
  ASSERT_TRUE(WaitFor([&] { return changes > 0; }));
  EXPECT_FALSE(snap->IsChecked());
  EXPECT_EQ(sender, snap);
}

TEST_F(GalleryOnX11, TabTypedOnTheKeyboardWalksTheFocusTilesAndShiftTabWalksBack) {
  constexpr std::uint32_t kKeysymTab = 0xFF09, kKeysymShift = 0xFFE1;
  const std::vector<ui::UI_Node*> tiles = mPage->GetFocusTiles();
  ASSERT_GE(tiles.size(), 2u);
  ASSERT_EQ(mLayer->GetActiveWindow(), mWindow->GetHandle()) << "the shown main window is active";
  // The light-look switch in the header, then the page selector.
  Key(kKeysymTab, true);
  Key(kKeysymTab, false);
  ASSERT_TRUE(WaitFor([&] { return mPage->GetBrightnessSwitch()->UI_HasKeyboardFocus(false); }));
  Key(kKeysymTab, true);
  Key(kKeysymTab, false);
  ASSERT_TRUE(WaitFor([&] { return mPage->GetPageSelector()->UI_HasKeyboardFocus(false); }));
  Key(kKeysymTab, true);
  Key(kKeysymTab, false);
  ASSERT_TRUE(WaitFor([&] { return tiles[0]->UI_HasKeyboardFocus(true); })) << "Tab gave the first tile the focus";
  Key(kKeysymTab, true);
  Key(kKeysymTab, false);
  ASSERT_TRUE(WaitFor([&] { return tiles[1]->UI_HasKeyboardFocus(true); }));
  Key(kKeysymShift, true);
  Key(kKeysymTab, true);
  Key(kKeysymTab, false);
  Key(kKeysymShift, false);
  EXPECT_TRUE(WaitFor([&] { return tiles[0]->UI_HasKeyboardFocus(true); })) << "Shift+Tab went back";
}

TEST_F(GalleryOnX11, TheServerShowsThePixelsOfTheHeadlessRenderingOfThePage) {
  PixelImage onServer;
  const PixelImage headless = RenderHeadless();
  ASSERT_EQ(headless.width, kWidth);
  // The server has the frame once no paint is pending; read until two reads agree.
  PixelImage previous;
  ASSERT_TRUE(WaitFor([&] {
    previous = std::move(onServer);
    onServer = ReadWindowFromServer();
    return onServer.width == kWidth && previous.pixels == onServer.pixels;
  }));
  EXPECT_TRUE(drawbot::testing::MatchesImage(onServer, headless, "gallery-x11/window", 3));
}

TEST_F(GalleryOnX11, ThePageFollowsTheWindowWhenTheServerResizesIt) {
  const ui::OS_WindowHandle handle = mWindow->GetHandle();
  const std::uint32_t size[] = {700, 480};
  xcb_configure_window(mUser, static_cast<xcb_window_t>(handle), XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT,
                       size);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return mPage->UI_GetLocalRectF(false).width == 700.0f; }));
  EXPECT_EQ(mPage->UI_GetLocalRectF(false).height, 480.0f);
  const ui::UI_Node::RectF controls = mPage->GetSection("section-controls")->UI_GetLocalRectF(true);
  EXPECT_LE(controls.left + controls.width, 700.0f) << "the sections were laid out again";
}

TEST_F(GalleryOnX11, TheWindowManagersCloseRequestEndsTheLoopAndTheWindowIsGone) {
  const ui::OS_WindowHandle handle = mWindow->GetHandle();
  // What a window manager sends when the user clicks the close box.
  Send("WM_PROTOCOLS", {Atom("WM_DELETE_WINDOW"), XCB_CURRENT_TIME}, static_cast<xcb_window_t>(handle), 0);
  EXPECT_EQ(mWindow->Run(), 0);
  EXPECT_FALSE(mWindow->IsOpen());
  EXPECT_FALSE(mLayer->IsWindow(handle));
  // Requests of two connections reach the server in no fixed order: ask for a while.
  EXPECT_TRUE(WaitFor([&] {
    xcb_get_window_attributes_reply_t* attributes = xcb_get_window_attributes_reply(
        mUser, xcb_get_window_attributes(mUser, static_cast<xcb_window_t>(handle)), nullptr);
    const bool known = attributes != nullptr;
    std::free(attributes);
    return !known;
  }, 1000)) << "the server still knows the window";
}

// Under openbox, started first: frame-relative configure events, size hints,
// focus given to other clients and back; none of it may raise an X error.
class GalleryUnderOpenbox : public GalleryOnX11 {
 protected:
  void SetUp() override {
    if (!XvfbServer::Get() || std::system("command -v openbox wmctrl >/dev/null") != 0)
      GTEST_SKIP() << "Xvfb, openbox or wmctrl is missing (scripts/install-deps.sh installs them)";
    const std::string display = "DISPLAY=" + XvfbServer::Get()->GetDisplayName();
    if ((mOpenbox = fork()) == 0) execlp("sh", "sh", "-c", (display + " exec openbox >/dev/null 2>&1").c_str(), nullptr);
    for (int i = 0; i < 200 && std::system((display + " wmctrl -m >/dev/null 2>&1").c_str()) != 0; ++i) usleep(50000);
    tarsel::config::ErrorManager::Get(true)->SetReportHandler([this](const auto&) { ++mXErrors; });
    GalleryOnX11::SetUp();
  }
  void TearDown() override {
    if (mLayer) mWindow.reset(), Settle(100);
    EXPECT_EQ(mXErrors, 0) << "X errors from starting, the test or closing";
    tarsel::config::ErrorManager::Get(true)->SetReportHandler(nullptr);
    GalleryOnX11::TearDown();
    if (mOpenbox > 0) kill(mOpenbox, SIGTERM), waitpid(mOpenbox, nullptr, 0);
  }
  // What pagers and wmctrl send the window manager about a window.
  void Ask(const char* inType, std::initializer_list<std::uint32_t> inData, xcb_window_t inAbout = 0) {
    Send(inType, inData, mXTest->GetRoot(), XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT, inAbout);
  }
  pid_t mOpenbox = -1;
  int mXErrors = 0;
};

TEST_F(GalleryUnderOpenbox, HeldToItsMinimumSizeAndMovedAndResizedInOneStepItStillTakesClicksWhereItShows) {
  Ask("_NET_MOVERESIZE_WINDOW", {0xC00 | (2u << 12), 0, 0, 300, 200});  // as wmctrl -e does
  ASSERT_TRUE(WaitFor([&] { return mWindow->UI_GetLocalRect().height == gallery::GalleryPage::kMinHeight; }));
  Ask("_NET_MOVERESIZE_WINDOW", {0xF00 | (2u << 12), 120, 90, 880, 610});
  ASSERT_TRUE(WaitFor([&] { return mWindow->UI_GetLocalRect().width == 880; }));
  // Placed where the layer thinks the window is: a stale position misses.
  controls::UI_Checkbox* snap = Controls()->GetSnapCheckbox();
  ClickAt(ScreenCentre(snap));
  EXPECT_TRUE(WaitFor([&] { return !snap->IsChecked(); })) << "the click missed the checkbox";
}

TEST_F(GalleryUnderOpenbox, FocusInsideTheWindowComesBackWhenActivationReturnsFromAnotherClient) {
  ui::UI_Node* tile = mPage->GetFocusTiles()[2];
  tile->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  const xcb_window_t other = xcb_generate_id(mUser);
  xcb_create_window(mUser, 0, other, mXTest->GetRoot(), 600, 500, 300, 200, 0, XCB_WINDOW_CLASS_INPUT_OUTPUT, 0, 0, 0);
  xcb_map_window(mUser, other);
  Ask("_NET_ACTIVE_WINDOW", {2}, other);
  ASSERT_TRUE(WaitFor([&] { return mLayer->GetActiveWindow() == 0; })) << "the other client never took the focus";
  Ask("_NET_ACTIVE_WINDOW", {2});
  EXPECT_TRUE(WaitFor([&] { return tile->UI_HasKeyboardFocus(true); })) << "the tile lost its focus";
}

// The program as a user starts it on the display: it maps its window, paints
// it, and with --exit-after-first-frame exits at once, telling the time.
TEST(GalleryProgramOnX11, TheProgramShowsItsFirstFrameOnTheDisplayAndExits) {
  XvfbServer* server = XvfbServer::Get();
  if (!server) GTEST_SKIP() << "Xvfb is not available";
  const std::string command = "DISPLAY=" + server->GetDisplayName() + " timeout 20 '" +
                              std::string(NORVIK_GALLERY_EXE) + "' --exit-after-first-frame 2>&1";
  FILE* pipe = popen(command.c_str(), "r");
  ASSERT_NE(pipe, nullptr);
  std::string output;
  char buffer[256];
  while (std::fgets(buffer, sizeof buffer, pipe)) output += buffer;
  const int status = pclose(pipe);
  ASSERT_TRUE(WIFEXITED(status)) << output;
  EXPECT_EQ(WEXITSTATUS(status), 0) << output;
  EXPECT_NE(output.find("First frame after "), std::string::npos) << output;
  EXPECT_EQ(output.find("rendering to"), std::string::npos) << "the window went to the display: " << output;
}

}  // namespace
}  // namespace norvik::test
