// What others do to our windows: a window manager iconifying and restoring a
// top level (unmapping it with WM_STATE Iconic, mapping it again), and the
// pointer grab that stands for the capture ending without our asking, because
// its window became unviewable.
#include <cstdlib>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

constexpr std::uint32_t kIconicState = 3;

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

void OS_NativeLayer_X11::TranslateUnmap(const xcb_unmap_notify_event_t* inEvent) {
  X11Window* window = Find(inEvent->window);
  // Our own hiding and minimising change the style or the state first.
  if (!window || inEvent->event != inEvent->window || (window->style & kOSStyleVisible) == 0 || window->minimized)
    return;
  if (mCapture != 0 && (mCapture == inEvent->window || IsChild(inEvent->window, mCapture))) ReleaseCapture();
  if (window->parent != 0 || ReadWmState(window->id) != kIconicState) return;
  if (X11Window* iconified = Find(inEvent->window)) {
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
