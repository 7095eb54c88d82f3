// The colour key of layered windows: pixels of the key colour are cut out of
// the window with the SHAPE extension, both from what shows and from what
// takes the pointer, so the desktop shows and clicks through where the window
// painted the key. The shape follows each presented paint of the back buffer.
#include <xcb/shape.h>

#include <vector>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {

namespace {

// The key comes as 0x00BBGGRR; the back buffer holds 0xAARRGGBB.
std::uint32_t KeyAsPixel(std::uint32_t inColorKey) {
  return ((inColorKey & 0xFF) << 16) | (inColorKey & 0xFF00) | ((inColorKey >> 16) & 0xFF);
}

// Runs of pixels that are not the key, one rectangle a run.
std::vector<xcb_rectangle_t> VisibleRuns(cairo_surface_t* inBuffer, std::uint32_t inKey) {
  std::vector<xcb_rectangle_t> runs;
  const unsigned char* data = cairo_image_surface_get_data(inBuffer);
  const int stride = cairo_image_surface_get_stride(inBuffer);
  const int width = cairo_image_surface_get_width(inBuffer);
  const int height = cairo_image_surface_get_height(inBuffer);
  for (int y = 0; y < height; ++y) {
    const auto* row = reinterpret_cast<const std::uint32_t*>(data + static_cast<std::size_t>(y) * stride);
    for (int x = 0; x < width;) {
      if ((row[x] & 0xFFFFFF) == inKey) {
        ++x;
        continue;
      }
      const int start = x;
      while (x < width && (row[x] & 0xFFFFFF) != inKey) ++x;
      runs.push_back({static_cast<std::int16_t>(start), static_cast<std::int16_t>(y),
                      static_cast<std::uint16_t>(x - start), 1});
    }
  }
  return runs;
}

}  // namespace

void OS_NativeLayer_X11::ApplyColorKeyShape(X11Window& ioWindow) {
  if (!ioWindow.colorKeyed) {
    if (!ioWindow.shaped) return;
    for (xcb_shape_kind_t kind : {XCB_SHAPE_SK_BOUNDING, XCB_SHAPE_SK_INPUT})
      xcb_shape_mask(mConnection, XCB_SHAPE_SO_SET, kind, ioWindow.id, 0, 0, XCB_NONE);
    ioWindow.shaped = false;
    return;
  }
  if (!ioWindow.backBuffer) return;
  cairo_surface_flush(ioWindow.backBuffer);
  const std::vector<xcb_rectangle_t> runs = VisibleRuns(ioWindow.backBuffer, KeyAsPixel(ioWindow.colorKey));
  for (xcb_shape_kind_t kind : {XCB_SHAPE_SK_BOUNDING, XCB_SHAPE_SK_INPUT})
    xcb_shape_rectangles(mConnection, XCB_SHAPE_SO_SET, kind, XCB_CLIP_ORDERING_Y_SORTED, ioWindow.id, 0, 0,
                         static_cast<std::uint32_t>(runs.size()), runs.data());
  ioWindow.shaped = true;
}

}  // namespace norvik::ui::x11
