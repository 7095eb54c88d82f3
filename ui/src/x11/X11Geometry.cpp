// Visibility, position and size, and the activation, focus and capture state.
#include <algorithm>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {

void OS_NativeLayer_X11::Configure(X11Window& ioWindow, bool inMove) {
  // A window manager holds a managed window to its size hints, so they move first.
  const bool managed = ioWindow.parent == 0 && !ioWindow.overrideRedirect;
  if (managed) ApplySizeHints(ioWindow);
  // A position asked of a window manager places the frame, not the client
  // area: asked again with each size change, it would creep by the frame.
  const std::uint32_t values[] = {static_cast<std::uint32_t>(static_cast<std::int32_t>(ioWindow.rect.left)),
                                  static_cast<std::uint32_t>(static_cast<std::int32_t>(ioWindow.rect.top)),
                                  static_cast<std::uint32_t>(std::max<long>(1, ioWindow.rect.width)),
                                  static_cast<std::uint32_t>(std::max<long>(1, ioWindow.rect.height))};
  if (inMove || !managed)
    xcb_configure_window(mConnection, ioWindow.id,
                         XCB_CONFIG_WINDOW_X | XCB_CONFIG_WINDOW_Y | XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT,
                         values);
  else
    xcb_configure_window(mConnection, ioWindow.id, XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT, values + 2);
}

void OS_NativeLayer_X11::ShowWindow(OS_WindowHandle inWindow, int inShowCommand) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  const bool wasVisible = (window->style & kOSStyleVisible) != 0;
  switch (inShowCommand) {
    case kOSShowHide:
      if (!wasVisible) return;
      window->style &= ~kOSStyleVisible;
      xcb_unmap_window(mConnection, window->id);
      if (mCapture == inWindow || IsChild(inWindow, mCapture)) ReleaseCapture();
      if (mActive == inWindow) {
        CallProcedure(inWindow, kOSMsgActivate, kOSActivationInactive, 0);
        mActive = 0;
      }
      break;
    case kOSShowMinimize:
    case kOSShowMinimized:
    case kOSShowMinNoActive: {
      if (window->parent != 0) return;
      window->minimized = true;
      window->style |= kOSStyleVisible;
      // ICCCM iconify request; without a window manager the window simply unmaps.
      xcb_client_message_event_t message{};
      message.response_type = XCB_CLIENT_MESSAGE;
      message.format = 32;
      message.window = window->id;
      message.type = Atom("WM_CHANGE_STATE");
      message.data.data32[0] = 3;  // IconicState
      xcb_send_event(mConnection, 0, mScreen->root,
                     XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                     reinterpret_cast<const char*>(&message));
      xcb_unmap_window(mConnection, window->id);
      SendSize(inWindow);
      break;
    }
    case kOSShowMaximized: {
      if (window->parent != 0) return;
      if (!window->maximized && !window->minimized) window->normalRect = window->rect;
      window->maximized = true;
      window->minimized = false;
      std::vector<OS_Monitor> monitors = GetMonitors();
      if (!monitors.empty()) window->rect = monitors.front().workArea;
      ApplyWindowState(*window);
      Configure(*window, true);
      window->style |= kOSStyleVisible;
      xcb_map_window(mConnection, window->id);
      SendSize(inWindow);
      SetActiveWindow(inWindow);
      break;
    }
    case kOSShowRestore:
    case kOSShowNormal:
      if (window->minimized || window->maximized) {
        const bool wasMaximized = window->maximized;
        window->minimized = window->maximized = false;
        if (wasMaximized) window->rect = window->normalRect;
        ApplyWindowState(*window);
        Configure(*window, window->positioned);
        SendSize(inWindow);
      }
      [[fallthrough]];
    default:
      if (!wasVisible) UpdateSizeLimits(inWindow);
      window = Find(inWindow);
      if (!window) return;
      window->style |= kOSStyleVisible;
      // A popup that bypasses the window manager opens above everything
      // else, even above windows made after it.
      if (!wasVisible && window->overrideRedirect) Raise(inWindow);
      // The server answers a map with Expose, which becomes the first paint.
      if (!wasVisible || inShowCommand == kOSShowRestore || inShowCommand == kOSShowNormal)
        xcb_map_window(mConnection, window->id);
      if (window->parent == 0 && inShowCommand != kOSShowNA && inShowCommand != kOSShowNoActivate &&
          (window->exStyle & kOSExStyleNoActivate) == 0 && !window->overrideRedirect)
        SetActiveWindow(inWindow);
      break;
  }
  xcb_flush(mConnection);
}

void OS_NativeLayer_X11::Raise(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  auto& siblings = SiblingsOf(*window);
  siblings.erase(std::remove(siblings.begin(), siblings.end(), inWindow), siblings.end());
  siblings.insert(siblings.begin(), inWindow);
  const std::uint32_t above = XCB_STACK_MODE_ABOVE;
  xcb_configure_window(mConnection, window->id, XCB_CONFIG_WINDOW_STACK_MODE, &above);
}

bool OS_NativeLayer_X11::IsWindowVisible(OS_WindowHandle inWindow) const {
  for (const X11Window* w = Find(inWindow); w; w = w->parent ? Find(w->parent) : nullptr) {
    if ((w->style & kOSStyleVisible) == 0 || w->minimized) return false;
    if (w->parent == 0) return true;
  }
  return false;
}

bool OS_NativeLayer_X11::IsMinimized(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window && window->minimized;
}

bool OS_NativeLayer_X11::IsMaximized(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window && window->maximized;
}

void OS_NativeLayer_X11::SetWindowPos(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter, const OS_Rect& inRect,
                                      std::uint32_t inFlags) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  const OS_Rect old = window->rect;
  if ((inFlags & kOSPosNoMove) == 0 && (inRect.left != old.left || inRect.top != old.top)) {
    window->rect.left = inRect.left;
    window->rect.top = inRect.top;
    window->positioned = true;
  }
  if ((inFlags & kOSPosNoSize) == 0) {
    window->rect.width = std::max<long>(0, inRect.width);
    window->rect.height = std::max<long>(0, inRect.height);
  }
  if (window->rect != old) Configure(*window, window->rect.left != old.left || window->rect.top != old.top);
  if ((inFlags & kOSPosNoZOrder) == 0) {
    auto& siblings = SiblingsOf(*window);
    siblings.erase(std::remove(siblings.begin(), siblings.end(), inWindow), siblings.end());
    auto at = std::find(siblings.begin(), siblings.end(), inInsertAfter);
    siblings.insert(inInsertAfter == 0 || at == siblings.end() ? siblings.begin() : std::next(at), inWindow);
    const std::uint32_t above = XCB_STACK_MODE_ABOVE;
    if (inInsertAfter == 0) xcb_configure_window(mConnection, window->id, XCB_CONFIG_WINDOW_STACK_MODE, &above);
  }
  if (inFlags & kOSPosShowWindow) ShowWindow(inWindow, (inFlags & kOSPosNoActivate) ? kOSShowNA : kOSShow);
  if (inFlags & kOSPosHideWindow) ShowWindow(inWindow, kOSShowHide);
  if (X11Window* still = Find(inWindow)) {
    if (still->rect.width != old.width || still->rect.height != old.height) {
      SendSize(inWindow);
      if (X11Window* sized = Find(inWindow)) Damage(*sized, nullptr);
    }
  }
  xcb_flush(mConnection);
}

OS_Rect OS_NativeLayer_X11::GetWindowRect(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  if (!window) return OS_Rect();
  const OS_Point origin = ClientToScreen(inWindow, OS_Point(0, 0));
  return OS_Rect(origin.x, origin.y, window->rect.width, window->rect.height);
}

OS_Rect OS_NativeLayer_X11::GetClientRect(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? OS_Rect(0, 0, window->rect.width, window->rect.height) : OS_Rect();
}

OS_Point OS_NativeLayer_X11::ClientToScreen(OS_WindowHandle inWindow, OS_Point inPoint) const {
  OS_Point point = inPoint;
  for (const X11Window* w = Find(inWindow); w; w = w->parent ? Find(w->parent) : nullptr) {
    point.x += w->rect.left;
    point.y += w->rect.top;
    if (w->parent == 0) break;
  }
  return point;
}

OS_Point OS_NativeLayer_X11::ScreenToClient(OS_WindowHandle inWindow, OS_Point inPoint) const {
  const OS_Point origin = ClientToScreen(inWindow, OS_Point(0, 0));
  return OS_Point(inPoint.x - origin.x, inPoint.y - origin.y);
}

bool OS_NativeLayer_X11::GetWindowPlacement(OS_WindowHandle inWindow, OS_WindowPlacement& outPlacement) const {
  const X11Window* window = Find(inWindow);
  if (!window) return false;
  outPlacement.showCommand = window->minimized   ? kOSShowMinimized
                             : window->maximized ? kOSShowMaximized
                                                 : kOSShowNormal;
  outPlacement.normalRect = (window->minimized || window->maximized) ? window->normalRect : GetWindowRect(inWindow);
  outPlacement.flags = 0;
  return true;
}

void OS_NativeLayer_X11::SetWindowPlacement(OS_WindowHandle inWindow, const OS_WindowPlacement& inPlacement) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  window->normalRect = inPlacement.normalRect;
  if (!window->minimized && !window->maximized)
    SetWindowPos(inWindow, 0, inPlacement.normalRect, kOSPosNoZOrder | kOSPosNoActivate);
  if (inPlacement.showCommand == kOSShowMaximized || inPlacement.showCommand == kOSShowMinimized ||
      inPlacement.showCommand == kOSShowRestore)
    ShowWindow(inWindow, inPlacement.showCommand);
}

OS_WindowHandle OS_NativeLayer_X11::DeepestAt(OS_WindowHandle inWindow, OS_Point inScreen) const {
  const X11Window* window = Find(inWindow);
  if (!window) return 0;
  for (OS_WindowHandle child : window->children) {
    const X11Window* c = Find(child);
    if (!c || (c->style & kOSStyleVisible) == 0 || (c->style & kOSStyleDisabled) != 0) continue;
    if (GetWindowRect(child).Contains(inScreen)) return DeepestAt(child, inScreen);
  }
  return inWindow;
}

OS_WindowHandle OS_NativeLayer_X11::WindowFromPoint(OS_Point inScreenPoint) const {
  for (OS_WindowHandle top : mStacking) {
    const X11Window* w = Find(top);
    if (!w || !IsWindowVisible(top)) continue;
    if (GetWindowRect(top).Contains(inScreenPoint)) return DeepestAt(top, inScreenPoint);
  }
  return 0;
}

// Activation moves between top levels: the old one hears it is inactive, the
// new one that it is active, and (through the default handling) the new one
// takes the keyboard focus unless the focus already lies inside it. When it
// comes from or goes to a window of another client, every top level first
// hears that the application as a whole came forward or went back, which is
// what keeps the focus inside a window over a visit elsewhere.
void OS_NativeLayer_X11::Activate(OS_WindowHandle inTopLevel, int inActivationCode) {
  if (inTopLevel == mActive && (inTopLevel != 0 || !mApplicationActive)) return;
  const OS_WindowHandle old = mActive;
  mActive = inTopLevel;
  const bool applicationChanges = mApplicationActive != (inTopLevel != 0);
  mApplicationActive = inTopLevel != 0;
  if (applicationChanges && inTopLevel == 0) SendActivateApp(false, 0);
  if (old != 0 && Find(old)) CallProcedure(old, kOSMsgActivate, kOSActivationInactive, static_cast<std::intptr_t>(inTopLevel));
  if (inTopLevel == 0) {
    if (mFocus != 0) {
      const OS_WindowHandle lost = mFocus;
      mFocus = 0;
      CallProcedure(lost, kOSMsgKillFocus, 0, 0);
    }
    return;
  }
  if (applicationChanges) SendActivateApp(true, old);
  if (mActive != inTopLevel || !Find(inTopLevel)) return;
  CallProcedure(inTopLevel, kOSMsgActivate, static_cast<std::uintptr_t>(inActivationCode),
                static_cast<std::intptr_t>(old));
}

void OS_NativeLayer_X11::SendActivateApp(bool inActive, OS_WindowHandle inOther) {
  std::vector<OS_WindowHandle> topLevels;
  for (OS_WindowHandle handle : mStacking)
    if (const X11Window* window = Find(handle); window && !window->destroying) topLevels.push_back(handle);
  for (OS_WindowHandle handle : topLevels)
    if (Find(handle)) CallProcedure(handle, kOSMsgActivateApp, inActive ? 1 : 0, static_cast<std::intptr_t>(inOther));
}

void OS_NativeLayer_X11::SetActiveWindow(OS_WindowHandle inWindow) {
  const OS_WindowHandle top = TopLevelOf(inWindow);
  X11Window* window = Find(top);
  if (!window || top == mActive || window->overrideRedirect || (window->exStyle & kOSExStyleNoActivate)) return;
  if (IsWindowVisible(top)) {
    // The server refuses the focus to a window that is not viewable yet (a
    // window manager maps it some time after our request): then it follows
    // the first exposure.
    if (window->viewable)
      xcb_set_input_focus(mConnection, XCB_INPUT_FOCUS_PARENT, window->id, XCB_CURRENT_TIME);
    else
      window->focusWhenViewable = true;
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = window->id;
    message.type = Atom("_NET_ACTIVE_WINDOW");
    message.data.data32[0] = 1;  // from an application
    message.data.data32[1] = XCB_CURRENT_TIME;
    xcb_send_event(mConnection, 0, mScreen->root,
                   XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                   reinterpret_cast<const char*>(&message));
    xcb_flush(mConnection);
  }
  Activate(top, kOSActivationActive);
}

void OS_NativeLayer_X11::SetFocus(OS_WindowHandle inWindow) {
  if (inWindow != 0 && !Find(inWindow)) return;
  if (inWindow != 0 && TopLevelOf(inWindow) != mActive) {
    SetActiveWindow(inWindow);
    if (inWindow != 0 && !Find(inWindow)) return;
  }
  if (inWindow == mFocus) return;
  const OS_WindowHandle old = mFocus;
  mFocus = inWindow;
  if (old != 0 && Find(old)) CallProcedure(old, kOSMsgKillFocus, inWindow, 0);
  if (inWindow != 0 && mFocus == inWindow) CallProcedure(inWindow, kOSMsgSetFocus, old, 0);
}

void OS_NativeLayer_X11::SetCapture(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window || mCapture == inWindow) return;
  const OS_WindowHandle old = mCapture;
  mCapture = inWindow;
  xcb_grab_pointer_cookie_t cookie = xcb_grab_pointer(
      mConnection, 0, window->id,
      XCB_EVENT_MASK_POINTER_MOTION | XCB_EVENT_MASK_BUTTON_PRESS | XCB_EVENT_MASK_BUTTON_RELEASE |
          XCB_EVENT_MASK_ENTER_WINDOW | XCB_EVENT_MASK_LEAVE_WINDOW,
      XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC, XCB_NONE, XCB_NONE, XCB_CURRENT_TIME);
  mGrabSequence = cookie.sequence;
  std::free(xcb_grab_pointer_reply(mConnection, cookie, nullptr));
  if (old != 0 && Find(old)) CallProcedure(old, kOSMsgCaptureChanged, 0, static_cast<std::intptr_t>(inWindow));
}

void OS_NativeLayer_X11::ReleaseCapture() {
  if (mCapture == 0) return;
  const OS_WindowHandle old = mCapture;
  mCapture = 0;
  xcb_ungrab_pointer(mConnection, XCB_CURRENT_TIME);
  xcb_flush(mConnection);
  if (Find(old)) CallProcedure(old, kOSMsgCaptureChanged, 0, 0);
}

void OS_NativeLayer_X11::TrackMouseLeave(OS_WindowHandle inWindow) {
  if (X11Window* window = Find(inWindow)) window->trackLeave = true;
}

}  // namespace norvik::ui::x11
