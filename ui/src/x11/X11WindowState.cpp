// What others do to our windows: a window manager iconifying and restoring a
// top level (unmapping it with WM_STATE Iconic, mapping it again), moving and
// sizing it while the user drags its frame, and the pointer grab that stands
// for the capture ending without our asking, because its window became
// unviewable.
#include <cstdlib>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

constexpr std::uint32_t kIconicState = 3;
constexpr std::chrono::milliseconds kSizeMovePoll(40);

}  // namespace

std::uint32_t OS_NativeLayer_X11::ReadWmState(xcb_window_t inWindow) {
  const xcb_atom_t state = Atom("WM_STATE");
  xcb_get_property_reply_t* reply =
      xcb_get_property_reply(mConnection, xcb_get_property(mConnection, 0, inWindow, state, state, 0, 2), nullptr);
  std::uint32_t value = 0;
  if (reply && xcb_get_property_value_length(reply) >= 4)
    value = *static_cast<const std::uint32_t*>(xcb_get_property_value(reply));
  std::free(reply);
  return value;
}

void OS_NativeLayer_X11::ExposedFirst(X11Window& ioWindow) {
  if (ioWindow.viewable) return;
  ioWindow.viewable = true;
  if (!ioWindow.focusWhenViewable) return;
  ioWindow.focusWhenViewable = false;
  if (mActive == ioWindow.id) xcb_set_input_focus(mConnection, XCB_INPUT_FOCUS_PARENT, ioWindow.id, XCB_CURRENT_TIME);
}

void OS_NativeLayer_X11::TranslateUnmap(const xcb_unmap_notify_event_t* inEvent) {
  X11Window* window = Find(inEvent->window);
  if (window && inEvent->event == inEvent->window) window->viewable = false;
  // Our own hiding and minimising change the style or the state first.
  if (!window || inEvent->event != inEvent->window || (window->style & kOSStyleVisible) == 0 || window->minimized)
    return;
  if (mCapture != 0 && (mCapture == inEvent->window || IsChild(inEvent->window, mCapture))) ReleaseCapture();
  if (window->parent != 0 || ReadWmState(window->id) != kIconicState) return;
  // The minimise command first, as if the user had asked us: it lets the
  // window remember its size, so that coming back at that size is no change.
  CallProcedure(inEvent->window, kOSMsgSysCommand, kOSSysCommandMinimize, 0);
  if (X11Window* iconified = Find(inEvent->window); iconified && !iconified->minimized) {
    iconified->minimized = true;
    SendSize(inEvent->window);
  }
}

void OS_NativeLayer_X11::TranslateMap(const xcb_map_notify_event_t* inEvent) {
  X11Window* window = Find(inEvent->window);
  if (!window || inEvent->event != inEvent->window || window->parent != 0 || !window->minimized ||
      (window->style & kOSStyleVisible) == 0)
    return;
  window->minimized = false;
  SendSize(inEvent->window);
  if (X11Window* restored = Find(inEvent->window)) Damage(*restored, nullptr);
}

bool OS_NativeLayer_X11::PointerButtonsDown() {
  xcb_query_pointer_reply_t* reply =
      xcb_query_pointer_reply(mConnection, xcb_query_pointer(mConnection, mScreen->root), nullptr);
  const bool down = reply && (reply->mask & (XCB_BUTTON_MASK_1 | XCB_BUTTON_MASK_2 | XCB_BUTTON_MASK_3)) != 0;
  std::free(reply);
  return down;
}

// Our own capture holds the buttons for a drag inside our windows; only a
// change under a button held elsewhere is the window manager's doing.
void OS_NativeLayer_X11::NoticeUserSizeMove(OS_WindowHandle inWindow) {
  if (mSizeMoveWindow != 0 || mCapture != 0 || !PointerButtonsDown()) return;
  mSizeMoveWindow = inWindow;
  mSizeMoveCheck = std::chrono::steady_clock::now() + kSizeMovePoll;
  CallProcedure(inWindow, kOSMsgEnterSizeMove, 0, 0);
}

// The window manager's grab tells us nothing when it ends, so the buttons are
// asked after while the loop lasts.
void OS_NativeLayer_X11::CheckUserSizeMoveEnd() {
  if (mSizeMoveWindow == 0 || std::chrono::steady_clock::now() < mSizeMoveCheck) return;
  if (Find(mSizeMoveWindow) && PointerButtonsDown()) {
    mSizeMoveCheck = std::chrono::steady_clock::now() + kSizeMovePoll;
    return;
  }
  const OS_WindowHandle window = mSizeMoveWindow;
  mSizeMoveWindow = 0;
  if (Find(window)) CallProcedure(window, kOSMsgExitSizeMove, 0, 0);
}

// Crossing events in Ungrab mode come when a pointer grab ends. Those that
// the server made before our latest grab belong to an earlier one that we
// released ourselves; a later one means the grab was taken from us.
void OS_NativeLayer_X11::NoticeGrabEnd(const xcb_enter_notify_event_t* inEvent) {
  if (inEvent->mode != XCB_NOTIFY_MODE_UNGRAB || mCapture == 0) return;
  const auto sinceGrab = static_cast<std::int16_t>(inEvent->sequence - static_cast<std::uint16_t>(mGrabSequence));
  if (sinceGrab < 0) return;
  ReleaseCapture();
}

}  // namespace norvik::ui::x11
