// Monitors through RandR, work areas through the desktop's _NET_WORKAREA hint.
#include <xcb/randr.h>

#include <cstdlib>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {

OS_Rect OS_NativeLayer_X11::ReadWorkArea() {
  const OS_Rect whole(0, 0, mScreen->width_in_pixels, mScreen->height_in_pixels);
  xcb_get_property_reply_t* reply = xcb_get_property_reply(
      mConnection, xcb_get_property(mConnection, 0, mScreen->root, Atom("_NET_WORKAREA"), XCB_ATOM_CARDINAL, 0, 4),
      nullptr);
  OS_Rect area = whole;
  if (reply && xcb_get_property_value_length(reply) >= 16) {
    const auto* v = static_cast<const std::uint32_t*>(xcb_get_property_value(reply));
    area = OS_Rect(v[0], v[1], v[2], v[3]);
  }
  std::free(reply);
  return area.IsEmpty() ? whole : area;
}

std::vector<OS_Monitor> OS_NativeLayer_X11::GetMonitors() const {
  auto* self = const_cast<OS_NativeLayer_X11*>(this);
  const OS_Rect workArea = self->ReadWorkArea();
  std::vector<OS_Monitor> monitors;
  xcb_randr_get_monitors_reply_t* reply =
      xcb_randr_get_monitors_reply(mConnection, xcb_randr_get_monitors(mConnection, mScreen->root, 1), nullptr);
  if (reply) {
    for (auto it = xcb_randr_get_monitors_monitors_iterator(reply); it.rem; xcb_randr_monitor_info_next(&it)) {
      OS_Monitor monitor;
      monitor.bounds = OS_Rect(it.data->x, it.data->y, it.data->width, it.data->height);
      OS_Rect work = monitor.bounds.Intersection(workArea);
      monitor.workArea = work.IsEmpty() ? monitor.bounds : work;
      if (it.data->primary)
        monitors.insert(monitors.begin(), monitor);
      else
        monitors.push_back(monitor);
    }
    std::free(reply);
  }
  if (monitors.empty()) {
    OS_Monitor monitor;
    monitor.bounds = OS_Rect(0, 0, mScreen->width_in_pixels, mScreen->height_in_pixels);
    monitor.workArea = workArea;
    monitors.push_back(monitor);
  }
  return monitors;
}

}  // namespace norvik::ui::x11
