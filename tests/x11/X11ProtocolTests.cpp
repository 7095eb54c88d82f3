// The X11 layer among other clients: the hints a window manager reads, the
// close request, iconifying and restoring by a window manager, a pointer grab
// lost with its window, activation asked of and given by the window manager,
// XSETTINGS, opacity, the work area, and X errors.
#include <unistd.h>
#include <xcb/shape.h>
#include <xcb/xcb.h>
#include <xcb/xcb_icccm.h>

#include <cstdlib>
#include <cstring>
#include <functional>
#include <string>
#include <vector>

#include "tarsel/ErrorManager.h"
#include "tarsel/UTFString.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

class X11Protocol : public X11Fixture {
 protected:
  xcb_atom_t UserAtom(const char* inName) {
    xcb_intern_atom_reply_t* reply = xcb_intern_atom_reply(
        mUser, xcb_intern_atom(mUser, 0, static_cast<uint16_t>(std::strlen(inName)), inName), nullptr);
    const xcb_atom_t atom = reply ? reply->atom : xcb_atom_t(XCB_ATOM_NONE);
    std::free(reply);
    return atom;
  }
  // A property's 32-bit items; empty when the window has none.
  std::vector<std::uint32_t> Read32(xcb_window_t inWindow, const char* inProperty) {
    xcb_get_property_reply_t* reply = xcb_get_property_reply(
        mUser, xcb_get_property(mUser, 0, inWindow, UserAtom(inProperty), XCB_GET_PROPERTY_TYPE_ANY, 0, 64), nullptr);
    std::vector<std::uint32_t> values;
    if (reply && reply->format == 32) {
      const auto* data = static_cast<const std::uint32_t*>(xcb_get_property_value(reply));
      values.assign(data, data + xcb_get_property_value_length(reply) / 4);
    }
    std::free(reply);
    return values;
  }
  std::string ReadString(xcb_window_t inWindow, xcb_atom_t inProperty) {
    xcb_get_property_reply_t* reply = xcb_get_property_reply(
        mUser, xcb_get_property(mUser, 0, inWindow, inProperty, XCB_GET_PROPERTY_TYPE_ANY, 0, 256), nullptr);
    std::string text;
    if (reply) text.assign(static_cast<const char*>(xcb_get_property_value(reply)), xcb_get_property_value_length(reply));
    std::free(reply);
    return text;
  }
  bool HasAtom(const std::vector<std::uint32_t>& inAtoms, const char* inName) {
    const xcb_atom_t atom = UserAtom(inName);
    for (std::uint32_t a : inAtoms)
      if (a == atom) return true;
    return false;
  }
  bool IsOverrideRedirect(xcb_window_t inWindow) {
    xcb_get_window_attributes_reply_t* a =
        xcb_get_window_attributes_reply(mUser, xcb_get_window_attributes(mUser, inWindow), nullptr);
    const bool result = a && a->override_redirect;
    std::free(a);
    return result;
  }
  void SendProtocol(OS_WindowHandle inWindow, const char* inProtocol) {
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = static_cast<xcb_window_t>(inWindow);
    message.type = UserAtom("WM_PROTOCOLS");
    message.data.data32[0] = UserAtom(inProtocol);
    xcb_send_event(mUser, 0, message.window, XCB_EVENT_MASK_NO_EVENT, reinterpret_cast<const char*>(&message));
    xcb_flush(mUser);
  }
  // The client messages that reach the root window while inAction runs, with
  // the user's connection playing the window manager.
  std::vector<xcb_client_message_event_t> RootRequests(const std::function<void()>& inAction) {
    const std::uint32_t redirect = XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT;
    xcb_change_window_attributes(mUser, mXTest->GetRoot(), XCB_CW_EVENT_MASK, &redirect);
    UserSync();
    inAction();
    SyncLayer();
    UserSync();
    std::vector<xcb_client_message_event_t> messages;
    while (xcb_generic_event_t* event = xcb_poll_for_event(mUser)) {
      if ((event->response_type & 0x7F) == XCB_CLIENT_MESSAGE)
        messages.push_back(*reinterpret_cast<xcb_client_message_event_t*>(event));
      std::free(event);
    }
    const std::uint32_t none = 0;
    xcb_change_window_attributes(mUser, mXTest->GetRoot(), XCB_CW_EVENT_MASK, &none);
    UserSync();
    return messages;
  }
  // The layer's round trip (its monitors are a question with an answer): the
  // server has done what the layer asked before the user looks.
  void SyncLayer() { mLayer->GetMonitors(); }
  // The user's round trip: the server has done what the user asked.
  void UserSync() { std::free(xcb_get_input_focus_reply(mUser, xcb_get_input_focus(mUser), nullptr)); }
};

// ---- hints ----

TEST_F(X11Protocol, AMainWindowNamesItsClassTakesFocusAndKeepsItsPlace) {
  const OS_WindowHandle main = MakeShownWindow(OS_Rect(40, 50, 200, 100), 0x101010);
  // Desktops match windows by the program's name; the pid goes with the host.
  EXPECT_EQ(ReadString(main, XCB_ATOM_WM_CLASS), std::string("x11_tests\0X11_tests", 19) + '\0');
  char host[256] = {};
  gethostname(host, sizeof(host) - 1);
  EXPECT_EQ(ReadString(main, XCB_ATOM_WM_CLIENT_MACHINE), host);
  EXPECT_TRUE(HasAtom(Read32(main, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_NORMAL"));
  EXPECT_TRUE(HasAtom(Read32(main, "WM_PROTOCOLS"), "WM_DELETE_WINDOW"));
  EXPECT_EQ(Read32(main, "_NET_WM_PID"), std::vector<std::uint32_t>{static_cast<std::uint32_t>(getpid())});
  EXPECT_FALSE(IsOverrideRedirect(main));

  xcb_icccm_wm_hints_t hints{};
  ASSERT_TRUE(xcb_icccm_get_wm_hints_reply(mUser, xcb_icccm_get_wm_hints(mUser, main), &hints, nullptr));
  EXPECT_TRUE(hints.flags & XCB_ICCCM_WM_HINT_INPUT);
  EXPECT_TRUE(hints.input);
  xcb_size_hints_t size{};
  ASSERT_TRUE(xcb_icccm_get_wm_normal_hints_reply(mUser, xcb_icccm_get_wm_normal_hints(mUser, main), &size, nullptr));
  EXPECT_TRUE(size.flags & XCB_ICCCM_SIZE_HINT_P_POSITION);
  EXPECT_EQ(size.x, 40);
  EXPECT_EQ(size.y, 50);
  EXPECT_FALSE(size.flags & XCB_ICCCM_SIZE_HINT_P_MAX_SIZE) << "a window with a sizing frame may be resized";

  // The node property is the layer's own: other clients never see it.
  int node = 0;
  mLayer->SetProperty(main, "norvik::ui::OS_Window::property", &node);
  SyncLayer();
  EXPECT_EQ(mLayer->GetProperty(main, "norvik::ui::OS_Window::property"), &node);
  EXPECT_TRUE(Read32(main, "norvik::ui::OS_Window::property").empty());
}

TEST_F(X11Protocol, OwnedAndModalWindowsAreTransientDialogs) {
  const OS_WindowHandle main = MakeShownWindow(OS_Rect(0, 0, 300, 200), 0x101010);
  const OS_WindowHandle owned = MakeShownWindow(OS_Rect(20, 20, 100, 80), 0x202020, kOSStyleOverlappedWindow, 0, main);
  const OS_WindowHandle modal =
      MakeShownWindow(OS_Rect(40, 40, 100, 80), 0x303030, kOSStyleCaption | kOSStyleSysMenu,
                      kOSExStyleDialogModalFrame, main);
  EXPECT_EQ(Read32(owned, "WM_TRANSIENT_FOR"), std::vector<std::uint32_t>{static_cast<std::uint32_t>(main)});
  EXPECT_TRUE(HasAtom(Read32(owned, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_DIALOG"));
  EXPECT_TRUE(HasAtom(Read32(owned, "_NET_WM_STATE"), "_NET_WM_STATE_SKIP_TASKBAR"));
  EXPECT_FALSE(HasAtom(Read32(owned, "_NET_WM_STATE"), "_NET_WM_STATE_MODAL"));
  EXPECT_TRUE(HasAtom(Read32(modal, "_NET_WM_STATE"), "_NET_WM_STATE_MODAL"));
  EXPECT_TRUE(HasAtom(Read32(modal, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_DIALOG"));
  EXPECT_TRUE(Read32(main, "WM_TRANSIENT_FOR").empty());

  xcb_size_hints_t size{};
  ASSERT_TRUE(xcb_icccm_get_wm_normal_hints_reply(mUser, xcb_icccm_get_wm_normal_hints(mUser, modal), &size, nullptr));
  ASSERT_TRUE(size.flags & XCB_ICCCM_SIZE_HINT_P_MAX_SIZE) << "a dialog without a sizing frame keeps its size";
  EXPECT_EQ(size.min_width, 100);
  EXPECT_EQ(size.max_width, 100);
  EXPECT_EQ(size.max_height, 80);
  mLayer->SetWindowPos(modal, 0, OS_Rect(40, 40, 120, 90), kOSPosNoZOrder | kOSPosNoActivate | kOSPosNoMove);
  SyncLayer();
  ASSERT_TRUE(xcb_icccm_get_wm_normal_hints_reply(mUser, xcb_icccm_get_wm_normal_hints(mUser, modal), &size, nullptr));
  EXPECT_EQ(size.max_width, 120) << "the program's own resize moves the limits with it";
}

TEST_F(X11Protocol, PopupsBypassTheWindowManagerAndAnActivatableOneNoLonger) {
  const OS_WindowHandle menu = MakeShownWindow(OS_Rect(10, 10, 80, 60), 0x404040, kOSStylePopup,
                                               kOSExStyleNoActivate | kOSExStyleTopmost);
  EXPECT_TRUE(IsOverrideRedirect(menu));
  EXPECT_TRUE(HasAtom(Read32(menu, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_POPUP_MENU"));
  xcb_icccm_wm_hints_t hints{};
  ASSERT_TRUE(xcb_icccm_get_wm_hints_reply(mUser, xcb_icccm_get_wm_hints(mUser, menu), &hints, nullptr));
  EXPECT_FALSE(hints.input) << "a window that never activates takes no focus from the window manager";

  // Made able to activate, it becomes an undecorated window the window manager handles.
  mLayer->SetExStyle(menu, mLayer->GetExStyle(menu) & ~kOSExStyleNoActivate);
  SyncLayer();
  EXPECT_FALSE(IsOverrideRedirect(menu));
  EXPECT_TRUE(HasAtom(Read32(menu, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_NORMAL"));
  EXPECT_TRUE(mLayer->IsWindowVisible(menu));
  mLayer->SetActiveWindow(menu);
  EXPECT_EQ(mLayer->GetActiveWindow(), menu);
}

// ---- requests and changes from others ----

TEST_F(X11Protocol, TheWindowManagersCloseRequestArrivesAsClose) {
  const OS_WindowHandle kept = MakeShownWindow(OS_Rect(0, 0, 100, 100), 0x111111);
  const OS_WindowHandle closed = MakeShownWindow(OS_Rect(200, 0, 100, 100), 0x222222);
  mHandler = [&](const RecordedMessage& m) { return m.message == kOSMsgClose && m.window == kept; };
  SendProtocol(kept, "WM_DELETE_WINDOW");
  SendProtocol(closed, "WM_DELETE_WINDOW");
  ASSERT_TRUE(WaitFor([&] { return !mLayer->IsWindow(closed); })) << "the default answer to close destroys";
  EXPECT_TRUE(mLayer->IsWindow(kept)) << "a window that claims the close stays";
  const auto closes = MessagesOf(kOSMsgClose);
  ASSERT_EQ(closes.size(), 2u);
  EXPECT_EQ(closes[0].window, kept);
}

TEST_F(X11Protocol, AWindowManagerIconifyingAndRestoringAWindowMinimisesAndRestoresIt) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(30, 30, 120, 90), 0x555555);
  mMessages.clear();
  const std::uint32_t iconic[2] = {3, 0};
  xcb_change_property(mUser, XCB_PROP_MODE_REPLACE, window, UserAtom("WM_STATE"), UserAtom("WM_STATE"), 32, 2, iconic);
  xcb_unmap_window(mUser, window);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return mLayer->IsMinimized(window); }));
  EXPECT_FALSE(mLayer->IsWindowVisible(window));
  ASSERT_FALSE(MessagesOf(kOSMsgSize).empty());
  EXPECT_EQ(MessagesOf(kOSMsgSize).back().wParam, std::uintptr_t(kOSSizeMinimized));

  const std::uint32_t normal[2] = {1, 0};
  xcb_change_property(mUser, XCB_PROP_MODE_REPLACE, window, UserAtom("WM_STATE"), UserAtom("WM_STATE"), 32, 2, normal);
  xcb_map_window(mUser, window);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return !mLayer->IsMinimized(window); }));
  EXPECT_TRUE(mLayer->IsWindowVisible(window));
  EXPECT_EQ(MessagesOf(kOSMsgSize).back().wParam, std::uintptr_t(kOSSizeRestored));
  EXPECT_EQ(PointParamX(MessagesOf(kOSMsgSize).back().lParam), 120);
}

TEST_F(X11Protocol, AnotherClientHidingOurWindowTakesNoMinimiseButEndsItsGrab) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(30, 30, 120, 90), 0x555555);
  mLayer->SetCapture(window);
  mMessages.clear();
  xcb_unmap_window(mUser, window);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgCaptureChanged); })) << "the lost grab is told";
  EXPECT_EQ(mLayer->GetCapture(), 0u);
  EXPECT_FALSE(mLayer->IsMinimized(window)) << "no window manager iconified it";
  // A new capture works as before.
  xcb_map_window(mUser, window);
  UserSync();  // viewable again before the layer grabs
  mLayer->SetCapture(window);
  MovePointer(900, 700);
  ASSERT_TRUE(WaitFor([&] {
    const auto moves = MessagesOf(kOSMsgMouseMove);
    return !moves.empty() && PointParamX(moves.back().lParam) == 900 - 30;
  }));
  EXPECT_EQ(mLayer->GetCapture(), window);
  mLayer->ReleaseCapture();
}

TEST_F(X11Protocol, AGrabTakenAgainRightAfterItsReleaseIsNotLostToTheOldOnesEnd) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(30, 30, 120, 90), 0x555555);
  MovePointer(900, 700);  // outside: ending a grab then tells the window the pointer left it
  ASSERT_TRUE(WaitFor([&] { return mLayer->GetCursorPos() == OS_Point(900, 700); }));
  mLayer->SetCapture(window);
  mLayer->ReleaseCapture();
  mLayer->SetCapture(window);
  mMessages.clear();
  Settle(80);
  EXPECT_EQ(mLayer->GetCapture(), window);
  EXPECT_FALSE(Received(kOSMsgCaptureChanged));
  mLayer->ReleaseCapture();
}

TEST_F(X11Protocol, ActivationIsAskedOfTheWindowManagerAndFollowsTheFocusItGives) {
  const OS_WindowHandle first = MakeShownWindow(OS_Rect(0, 0, 100, 100), 0x111111);
  const OS_WindowHandle second = MakeShownWindow(OS_Rect(200, 0, 100, 100), 0x222222);
  mLayer->SetActiveWindow(first);
  const auto requests = RootRequests([&] { mLayer->SetActiveWindow(second); });
  bool asked = false;
  for (const xcb_client_message_event_t& m : requests)
    if (m.type == UserAtom("_NET_ACTIVE_WINDOW")) asked = m.window == second && m.data.data32[0] == 1;
  EXPECT_TRUE(asked) << "_NET_ACTIVE_WINDOW went to the root window";

  // The window manager gives the focus to the first window: it becomes active.
  mMessages.clear();
  xcb_set_input_focus(mUser, XCB_INPUT_FOCUS_POINTER_ROOT, first, XCB_CURRENT_TIME);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return mLayer->GetActiveWindow() == first; }));
  EXPECT_FALSE(MessagesOf(kOSMsgActivate).empty());
  // And to a window of another client: ours are all inactive.
  xcb_window_t foreign = xcb_generate_id(mUser);
  xcb_create_window(mUser, XCB_COPY_FROM_PARENT, foreign, mXTest->GetRoot(), 500, 500, 50, 50, 0,
                    XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT, 0, nullptr);
  xcb_map_window(mUser, foreign);
  UserSync();
  xcb_set_input_focus(mUser, XCB_INPUT_FOCUS_POINTER_ROOT, foreign, XCB_CURRENT_TIME);
  xcb_flush(mUser);
  EXPECT_TRUE(WaitFor([&] { return mLayer->GetActiveWindow() == 0; }));
  xcb_destroy_window(mUser, foreign);
  xcb_flush(mUser);
}

TEST_F(X11Protocol, StateChangesOfAShownWindowAreAskedOfTheWindowManager) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 200, 100), 0x111111);
  auto stateRequests = [&](const std::vector<xcb_client_message_event_t>& inMessages) {
    std::vector<xcb_client_message_event_t> result;
    for (const xcb_client_message_event_t& m : inMessages)
      if (m.type == UserAtom("_NET_WM_STATE") && m.window == window) result.push_back(m);
    return result;
  };
  auto above = stateRequests(RootRequests([&] { mLayer->SetExStyle(window, kOSExStyleTopmost); }));
  ASSERT_EQ(above.size(), 1u);
  EXPECT_EQ(above[0].data.data32[0], 1u) << "add";
  EXPECT_EQ(above[0].data.data32[1], UserAtom("_NET_WM_STATE_ABOVE"));
  auto removed = stateRequests(RootRequests([&] { mLayer->SetExStyle(window, 0); }));
  ASSERT_EQ(removed.size(), 1u);
  EXPECT_EQ(removed[0].data.data32[0], 0u) << "remove";
  auto maximised = stateRequests(RootRequests([&] { mLayer->ShowWindow(window, kOSShowMaximized); }));
  ASSERT_EQ(maximised.size(), 1u);
  EXPECT_EQ(maximised[0].data.data32[1], UserAtom("_NET_WM_STATE_MAXIMIZED_VERT"));
  EXPECT_EQ(maximised[0].data.data32[2], UserAtom("_NET_WM_STATE_MAXIMIZED_HORZ"));
  EXPECT_TRUE(stateRequests(RootRequests([&] { mLayer->SetExStyle(window, 0); })).empty())
      << "nothing changed, nothing asked";
}

TEST_F(X11Protocol, AWindowResizedByAnotherClientHearsItsNewSizeAndRepaints) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(20, 20, 100, 80), 0x224466);
  mMessages.clear();
  const std::uint32_t size[2] = {160, 120};
  xcb_configure_window(mUser, window, XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT, size);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgSize) && Received(kOSMsgPaint); }));
  EXPECT_EQ(PointParamX(MessagesOf(kOSMsgSize).back().lParam), 160);
  EXPECT_EQ(PointParamY(MessagesOf(kOSMsgSize).back().lParam), 120);
  EXPECT_EQ(mLayer->GetClientRect(window), OS_Rect(0, 0, 160, 120));
  EXPECT_TRUE(WaitFor([&] { return ReadPixel(window, 150, 110) == 0x224466u; })) << "the new area is painted";
}

TEST_F(X11Protocol, AWindowUncoveredByAnotherClientsWindowIsRepainted) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(20, 20, 100, 80), 0x336633);
  xcb_window_t cover = xcb_generate_id(mUser);
  const std::uint32_t black = 0;
  xcb_create_window(mUser, XCB_COPY_FROM_PARENT, cover, mXTest->GetRoot(), 40, 40, 40, 40, 0,
                    XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT, XCB_CW_BACK_PIXEL, &black);
  xcb_map_window(mUser, cover);
  UserSync();
  Settle(20);
  mMessages.clear();
  xcb_destroy_window(mUser, cover);
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgPaint); })) << "the exposed part asks for paint";
  EXPECT_TRUE(WaitFor([&] { return ReadPixel(window, 40, 40) == 0x336633u; }));
}

// ---- desktop settings and the screen ----

// The settings data of a daemon that knows these integer settings.
std::vector<std::uint8_t> IntegerSettings(const std::vector<std::pair<std::string, std::uint32_t>>& inSettings,
                                          std::uint32_t inSerial) {
  std::vector<std::uint8_t> data = {0, 0, 0, 0};
  auto put32 = [&](std::uint32_t v) {
    for (int i = 0; i < 4; ++i) data.push_back(static_cast<std::uint8_t>(v >> (8 * i)));
  };
  put32(inSerial);
  put32(static_cast<std::uint32_t>(inSettings.size()));
  for (const auto& [name, value] : inSettings) {
    data.insert(data.end(), {0, 0, static_cast<std::uint8_t>(name.size()), static_cast<std::uint8_t>(name.size() >> 8)});
    data.insert(data.end(), name.begin(), name.end());
    while (data.size() % 4) data.push_back(0);
    put32(inSerial);
    put32(value);
  }
  return data;
}

TEST_F(X11Protocol, TheDesktopSettingsFollowTheSettingsDaemonAndTellTheTopLevels) {
  EXPECT_EQ(mLayer->GetDoubleClickTime(), 500u) << "no daemon: the default";
  const xcb_atom_t settings = UserAtom("_XSETTINGS_SETTINGS");
  xcb_window_t daemon = xcb_generate_id(mUser);
  xcb_create_window(mUser, XCB_COPY_FROM_PARENT, daemon, mXTest->GetRoot(), -10, -10, 1, 1, 0,
                    XCB_WINDOW_CLASS_INPUT_ONLY, XCB_COPY_FROM_PARENT, 0, nullptr);
  auto publish = [&](const std::vector<std::uint8_t>& data) {
    xcb_change_property(mUser, XCB_PROP_MODE_REPLACE, daemon, settings, settings, 8,
                        static_cast<std::uint32_t>(data.size()), data.data());
    xcb_flush(mUser);
  };
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 50, 50), 0x111111);
  publish(IntegerSettings({{"Net/DoubleClickTime", 250}}, 1));
  xcb_set_selection_owner(mUser, daemon, UserAtom("_XSETTINGS_S0"), XCB_CURRENT_TIME);
  xcb_client_message_event_t manager{};
  manager.response_type = XCB_CLIENT_MESSAGE;
  manager.format = 32;
  manager.window = mXTest->GetRoot();
  manager.type = UserAtom("MANAGER");
  manager.data.data32[0] = XCB_CURRENT_TIME;
  manager.data.data32[1] = UserAtom("_XSETTINGS_S0");
  manager.data.data32[2] = daemon;
  xcb_send_event(mUser, 0, manager.window, XCB_EVENT_MASK_STRUCTURE_NOTIFY, reinterpret_cast<const char*>(&manager));
  xcb_flush(mUser);
  EXPECT_TRUE(WaitFor([&] { return mLayer->GetDoubleClickTime() == 250u; })) << "a daemon that starts later is heard";

  mMessages.clear();
  publish(IntegerSettings({{"Net/DoubleClickTime", 700}, {"Net/DoubleClickDistance", 6}, {"Gtk/AutoMnemonics", 0}}, 2));
  EXPECT_TRUE(WaitFor([&] { return mLayer->GetDoubleClickTime() == 700u; })) << "a changed setting is followed";
  EXPECT_EQ(mLayer->GetDoubleClickSize(), OS_Point(12, 12));
  bool alwaysOn = false;
  EXPECT_TRUE(mLayer->GetPreference("windows.MnemonicsAlwaysOn", alwaysOn) && alwaysOn);
  EXPECT_TRUE(WaitFor([&] { return Received(kOSMsgSettingChange); }));
  EXPECT_EQ(MessagesOf(kOSMsgSettingChange).front().window, window);

  std::vector<tarsel::config::ErrorReport> reports;
  tarsel::config::ErrorManager* errors = tarsel::config::ErrorManager::Get(true);
  auto previous = errors->SetReportHandler([&](const tarsel::config::ErrorReport& r) { reports.push_back(r); });
  std::vector<std::uint8_t> lying = IntegerSettings({{"Net/DoubleClickTime", 300}}, 3);
  lying[8] = 9;  // nine settings in the bytes of one
  publish(lying);
  EXPECT_TRUE(WaitFor([&] { return !reports.empty(); }));
  errors->SetReportHandler(previous);
  ASSERT_FALSE(reports.empty());
  EXPECT_EQ(reports[0].mKeyPath, "norvik/ui/Error/XSettingsMalformed");
  EXPECT_EQ(mLayer->GetDoubleClickTime(), 500u) << "nothing of malformed data is kept";
  EXPECT_FALSE(mLayer->GetPreference("windows.MnemonicsAlwaysOn", alwaysOn));

  xcb_destroy_window(mUser, daemon);
  xcb_flush(mUser);
  EXPECT_TRUE(WaitFor([&] { return mLayer->GetDoubleClickTime() == 500u; })) << "the daemon gone: the default";
}

TEST_F(X11Protocol, OpacityIsTheWindowManagersOpacityHint) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 100, 100), 0x111111);
  mLayer->SetLayeredAttributes(window, 0, 128, kOSLayeredAlpha);
  SyncLayer();
  EXPECT_EQ(Read32(window, "_NET_WM_WINDOW_OPACITY"), std::vector<std::uint32_t>{0x80808080u});
  mLayer->SetLayeredAttributes(window, 0, 255, kOSLayeredAlpha);
  SyncLayer();
  EXPECT_TRUE(Read32(window, "_NET_WM_WINDOW_OPACITY").empty()) << "opaque windows carry no hint";
}

TEST_F(X11Protocol, AColourKeyCutsItsPixelsOutOfWhatShowsAndWhatTakesThePointer) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 60, 40), 0x224466);
  auto shapedArea = [&](xcb_shape_kind_t inKind) {
    xcb_shape_get_rectangles_reply_t* reply =
        xcb_shape_get_rectangles_reply(mUser, xcb_shape_get_rectangles(mUser, window, inKind), nullptr);
    long area = 0;
    const xcb_rectangle_t* r = reply ? xcb_shape_get_rectangles_rectangles(reply) : nullptr;
    for (int i = 0; r && i < xcb_shape_get_rectangles_rectangles_length(reply); ++i) area += r[i].width * r[i].height;
    std::free(reply);
    return area;
  };
  mLayer->SetLayeredAttributes(window, 0x664422, 0, kOSLayeredColorKey);  // the fill, as 0x00BBGGRR
  SyncLayer();
  EXPECT_EQ(shapedArea(XCB_SHAPE_SK_BOUNDING) + shapedArea(XCB_SHAPE_SK_INPUT), 0) << "every pixel is the key";
  mLayer->SetLayeredAttributes(window, 0x0000FF, 0, kOSLayeredColorKey);
  SyncLayer();
  EXPECT_EQ(shapedArea(XCB_SHAPE_SK_BOUNDING), 60 * 40) << "no pixel is the key";
}

TEST_F(X11Protocol, TheWorkAreaComesFromTheDesktopAndBoundsAMaximisedWindow) {
  const std::uint32_t area[4] = {0, 30, 1024, 700};
  const xcb_atom_t workArea = UserAtom("_NET_WORKAREA");
  xcb_change_property(mUser, XCB_PROP_MODE_REPLACE, mXTest->GetRoot(), workArea, XCB_ATOM_CARDINAL, 32, 4, area);
  UserSync();
  const std::vector<OS_Monitor> monitors = mLayer->GetMonitors();
  ASSERT_FALSE(monitors.empty());
  EXPECT_EQ(monitors[0].workArea, OS_Rect(0, 30, 1024, 700));
  EXPECT_EQ(monitors[0].bounds, OS_Rect(0, 0, 1024, 768));
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(10, 40, 100, 100), 0x111111);
  mLayer->ShowWindow(window, kOSShowMaximized);
  EXPECT_EQ(mLayer->GetWindowRect(window), OS_Rect(0, 30, 1024, 700));
  xcb_delete_property(mUser, mXTest->GetRoot(), workArea);
  UserSync();
}

TEST_F(X11Protocol, AnXErrorIsReportedAndTheLayerGoesOn) {
  std::vector<tarsel::config::ErrorReport> reports;
  tarsel::config::ErrorManager* errors = tarsel::config::ErrorManager::Get(true);
  auto previous = errors->SetReportHandler([&](const tarsel::config::ErrorReport& r) { reports.push_back(r); });
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 100, 100), 0x111111);
  // A window is no cursor: the server refuses to free it.
  mLayer->DestroyCursor(static_cast<OS_CursorHandle>(window));
  const bool reported = WaitFor([&] { return !reports.empty(); });
  errors->SetReportHandler(previous);
  ASSERT_TRUE(reported);
  EXPECT_EQ(reports[0].mKeyPath, "norvik/ui/x11/Error/Protocol");
  const std::string message = tarsel::utility::UTF16to8(reports[0].mMessage).c_str();
  EXPECT_NE(message.find("major code 95"), std::string::npos) << message << " (95 is FreeCursor)";
  EXPECT_TRUE(mLayer->IsWindow(window));
  mMessages.clear();
  MovePointer(50, 50);
  EXPECT_TRUE(WaitFor([&] { return Received(kOSMsgMouseMove); })) << "events still flow";
}

}  // namespace
}  // namespace norvik::test
