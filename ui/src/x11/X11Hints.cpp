// The hints that tell a window manager what kind of window a top level is:
// ICCCM (WM_HINTS, WM_NORMAL_HINTS, WM_TRANSIENT_FOR, WM_PROTOCOLS), EWMH
// (_NET_WM_WINDOW_TYPE, _NET_WM_STATE, _NET_WM_PID) and the Motif decoration
// hint; and which top levels bypass the window manager altogether.
#include <unistd.h>

#include <xcb/xcb_icccm.h>

#include <algorithm>
#include <cstring>
#include <vector>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {

// Caption-less popups that never take activation (menus, tips, popup
// containers) appear at once and exactly where asked, so the window manager
// does not see them. A caption-less popup that may activate is an
// application's own undecorated main window, and is managed.
bool BypassesWindowManager(std::uint32_t inStyle, std::uint32_t inExStyle) {
  return (inStyle & kOSStyleChild) == 0 && (inStyle & kOSStylePopup) != 0 &&
         (inStyle & kOSStyleCaption) != kOSStyleCaption && (inExStyle & kOSExStyleNoActivate) != 0;
}

void OS_NativeLayer_X11::UpdateTopLevelKind(X11Window& ioWindow) {
  const bool bypass = BypassesWindowManager(ioWindow.style, ioWindow.exStyle);
  if (bypass != ioWindow.overrideRedirect) {
    // The window manager reads the attribute when the window is mapped, so a
    // shown window is mapped again with the new one.
    const bool shown = (ioWindow.style & kOSStyleVisible) != 0 && !ioWindow.minimized;
    if (shown) xcb_unmap_window(mConnection, ioWindow.id);
    ioWindow.overrideRedirect = bypass;
    const std::uint32_t value = bypass ? 1u : 0u;
    xcb_change_window_attributes(mConnection, ioWindow.id, XCB_CW_OVERRIDE_REDIRECT, &value);
    ApplyTopLevelHints(ioWindow);
    if (shown) xcb_map_window(mConnection, ioWindow.id);
    return;
  }
  if (ioWindow.overrideRedirect)
    ApplyWindowState(ioWindow);
  else
    ApplyTopLevelHints(ioWindow);
}

void OS_NativeLayer_X11::ApplyTopLevelHints(X11Window& ioWindow) {
  const xcb_window_t id = ioWindow.id;
  // A window that takes the focus is locally active in ICCCM's terms: the
  // window manager offers the focus with WM_TAKE_FOCUS and we take it.
  std::vector<xcb_atom_t> protocols{Atom("WM_DELETE_WINDOW"), Atom("_NET_WM_PING")};
  if ((ioWindow.exStyle & kOSExStyleNoActivate) == 0) protocols.push_back(Atom("WM_TAKE_FOCUS"));
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, Atom("WM_PROTOCOLS"), XCB_ATOM_ATOM, 32,
                      static_cast<std::uint32_t>(protocols.size()), protocols.data());
  // The process id means something only together with the machine it runs on.
  std::uint32_t pid = static_cast<std::uint32_t>(getpid());
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, Atom("_NET_WM_PID"), XCB_ATOM_CARDINAL, 32, 1, &pid);
  char host[256] = {};
  if (gethostname(host, sizeof(host) - 1) == 0)
    xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, XCB_ATOM_WM_CLIENT_MACHINE, XCB_ATOM_STRING, 8,
                        static_cast<std::uint32_t>(std::strlen(host)), host);
  if (ioWindow.owner != 0) {
    xcb_window_t owner = static_cast<xcb_window_t>(ioWindow.owner);
    xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, XCB_ATOM_WM_TRANSIENT_FOR, XCB_ATOM_WINDOW, 32, 1,
                        &owner);
  }
  const char* type = "_NET_WM_WINDOW_TYPE_NORMAL";
  if (ioWindow.overrideRedirect)
    type = (ioWindow.exStyle & kOSExStyleTopmost) ? "_NET_WM_WINDOW_TYPE_POPUP_MENU" : "_NET_WM_WINDOW_TYPE_TOOLTIP";
  else if (ioWindow.exStyle & kOSExStyleToolWindow)
    type = "_NET_WM_WINDOW_TYPE_UTILITY";
  else if (ioWindow.owner != 0 || (ioWindow.exStyle & kOSExStyleDialogModalFrame))
    type = "_NET_WM_WINDOW_TYPE_DIALOG";
  xcb_atom_t typeAtom = Atom(type);
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, Atom("_NET_WM_WINDOW_TYPE"), XCB_ATOM_ATOM, 32, 1,
                      &typeAtom);
  // Motif hints: decorations only for windows with a caption.
  const bool decorated = (ioWindow.style & kOSStyleCaption) == kOSStyleCaption;
  std::uint32_t motif[5] = {2, 0, decorated ? 1u : 0u, 0, 0};
  xcb_atom_t motifAtom = Atom("_MOTIF_WM_HINTS");
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, motifAtom, motifAtom, 32, 5, motif);
  ApplyIcccmHints(ioWindow);
  ApplyWindowState(ioWindow);
}

// _NET_WM_STATE as set before mapping; the window manager reads it at map time.
void OS_NativeLayer_X11::ApplyWindowState(X11Window& ioWindow) {
  std::vector<xcb_atom_t> states;
  if (ioWindow.exStyle & kOSExStyleTopmost) states.push_back(Atom("_NET_WM_STATE_ABOVE"));
  if (ioWindow.exStyle & kOSExStyleDialogModalFrame) states.push_back(Atom("_NET_WM_STATE_MODAL"));
  if (ioWindow.owner != 0) states.push_back(Atom("_NET_WM_STATE_SKIP_TASKBAR"));
  if (ioWindow.maximized) {
    states.push_back(Atom("_NET_WM_STATE_MAXIMIZED_VERT"));
    states.push_back(Atom("_NET_WM_STATE_MAXIMIZED_HORZ"));
  }
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, ioWindow.id, Atom("_NET_WM_STATE"), XCB_ATOM_ATOM, 32,
                      static_cast<std::uint32_t>(states.size()), states.data());
  RequestStateChanges(ioWindow);
}

namespace {

struct NetState {
  std::uint32_t bit;
  const char* first;
  const char* second;  // changed together with the first, or null
};

constexpr NetState kChangeableStates[] = {
    {1, "_NET_WM_STATE_ABOVE", nullptr},
    {2, "_NET_WM_STATE_MODAL", nullptr},
    {4, "_NET_WM_STATE_MAXIMIZED_VERT", "_NET_WM_STATE_MAXIMIZED_HORZ"},
};

}  // namespace

// A window manager reads _NET_WM_STATE only when a window is mapped; a change
// to a shown window is a request to the root window.
void OS_NativeLayer_X11::RequestStateChanges(X11Window& ioWindow) {
  std::uint32_t wanted = 0;
  if (ioWindow.exStyle & kOSExStyleTopmost) wanted |= 1;
  if (ioWindow.exStyle & kOSExStyleDialogModalFrame) wanted |= 2;
  if (ioWindow.maximized) wanted |= 4;
  const bool shown = (ioWindow.style & kOSStyleVisible) != 0 && !ioWindow.minimized;
  if (shown && !ioWindow.overrideRedirect && ioWindow.parent == 0) {
    for (const NetState& state : kChangeableStates) {
      if (((wanted ^ ioWindow.netStates) & state.bit) == 0) continue;
      xcb_client_message_event_t message{};
      message.response_type = XCB_CLIENT_MESSAGE;
      message.format = 32;
      message.window = ioWindow.id;
      message.type = Atom("_NET_WM_STATE");
      message.data.data32[0] = (wanted & state.bit) ? 1 : 0;  // add or remove
      message.data.data32[1] = Atom(state.first);
      message.data.data32[2] = state.second ? Atom(state.second) : 0;
      message.data.data32[3] = 1;  // from an application
      xcb_send_event(mConnection, 0, mScreen->root,
                     XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                     reinterpret_cast<const char*>(&message));
    }
  }
  ioWindow.netStates = wanted;
}

// WM_HINTS: whether the window manager may give the window the keyboard
// focus. WM_NORMAL_HINTS: the position when the program placed the window
// (else the window manager places it), the limits of its size, and that a
// window without a sizing frame keeps its size.
void OS_NativeLayer_X11::ApplyIcccmHints(X11Window& ioWindow) {
  xcb_icccm_wm_hints_t hints{};
  xcb_icccm_wm_hints_set_input(&hints, (ioWindow.exStyle & kOSExStyleNoActivate) == 0 ? 1 : 0);
  xcb_icccm_wm_hints_set_normal(&hints);
  xcb_icccm_set_wm_hints(mConnection, ioWindow.id, &hints);
  ApplySizeHints(ioWindow);
}

void OS_NativeLayer_X11::ApplySizeHints(X11Window& ioWindow) {
  xcb_size_hints_t size{};
  if (ioWindow.positioned)
    xcb_icccm_size_hints_set_position(&size, 0, static_cast<int32_t>(ioWindow.rect.left),
                                      static_cast<int32_t>(ioWindow.rect.top));
  const auto width = static_cast<int32_t>(std::max<long>(1, ioWindow.rect.width));
  const auto height = static_cast<int32_t>(std::max<long>(1, ioWindow.rect.height));
  xcb_icccm_size_hints_set_size(&size, 0, width, height);
  const bool framed = (ioWindow.style & kOSStyleCaption) == kOSStyleCaption;
  if (framed && (ioWindow.style & kOSStyleThickFrame) == 0 && !ioWindow.maximized) {
    xcb_icccm_size_hints_set_min_size(&size, width, height);
    xcb_icccm_size_hints_set_max_size(&size, width, height);
  } else {
    const OS_MinMaxInfo& limits = ioWindow.limits;
    if (limits.minTrackSize.x > 0 || limits.minTrackSize.y > 0)
      xcb_icccm_size_hints_set_min_size(&size, static_cast<int32_t>(std::max<long>(1, limits.minTrackSize.x)),
                                        static_cast<int32_t>(std::max<long>(1, limits.minTrackSize.y)));
    if (limits.maxTrackSize.x > 0 || limits.maxTrackSize.y > 0)
      xcb_icccm_size_hints_set_max_size(
          &size, static_cast<int32_t>(limits.maxTrackSize.x > 0 ? limits.maxTrackSize.x : 32767),
          static_cast<int32_t>(limits.maxTrackSize.y > 0 ? limits.maxTrackSize.y : 32767));
  }
  xcb_icccm_size_hints_set_win_gravity(&size, XCB_GRAVITY_NORTH_WEST);
  xcb_icccm_set_wm_normal_hints(mConnection, ioWindow.id, &size);
}

// Asked when the window is shown rather than with each change of its
// rectangle: while a rectangle is being set, the window answers a limit for
// that change only.
void OS_NativeLayer_X11::UpdateSizeLimits(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window || window->parent != 0 || window->overrideRedirect) return;
  OS_MinMaxInfo limits;
  CallProcedure(inWindow, kOSMsgGetMinMaxInfo, 0, reinterpret_cast<std::intptr_t>(&limits));
  window = Find(inWindow);
  if (!window) return;
  const bool changed = !(limits.minTrackSize == window->limits.minTrackSize) ||
                       !(limits.maxTrackSize == window->limits.maxTrackSize);
  window->limits = limits;
  if (changed) ApplySizeHints(*window);
}

}  // namespace norvik::ui::x11
