#include "drawbot/src/cairo/PixelBoxes.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>

namespace norvik::drawbot::cairo {

namespace {

// A colour channel as Cairo keeps it: clamped, in 16 bits, rounded to nearest.
std::uint32_t Channel8(float inValue) {
  double d = inValue;
  if (!(d > 0)) d = 0;
  if (d > 1) d = 1;
  return static_cast<std::uint32_t>(static_cast<std::uint16_t>(d * 65535.0 + 0.5)) >> 8;
}

bool IsWhole(double inValue) { return std::fabs(inValue) < 1e9 && inValue == std::floor(inValue); }

}  // namespace

ClipBoxes ClipBoxes::ForTarget(cairo_surface_t* inTarget) {
  ClipBoxes clip;
  if (cairo_surface_get_type(inTarget) != CAIRO_SURFACE_TYPE_IMAGE) return clip;
  clip.count = 1;
  clip.boxes[0] = {0, 0, cairo_image_surface_get_width(inTarget), cairo_image_surface_get_height(inTarget)};
  return clip;
}

void ClipBoxes::IntersectRegion(const cairo_region_t* inRegion) {
  if (count < 0) return;
  const int n = cairo_region_num_rectangles(inRegion);
  if (count != 1 || n > kMaxBoxes) {
    count = -1;
    return;
  }
  const Box whole = boxes[0];
  count = 0;
  for (int i = 0; i < n; ++i) {
    cairo_rectangle_int_t r;
    cairo_region_get_rectangle(inRegion, i, &r);
    Box b{std::max(whole.left, r.x), std::max(whole.top, r.y), std::min(whole.right, r.x + r.width),
          std::min(whole.bottom, r.y + r.height)};
    if (b.left < b.right && b.top < b.bottom) boxes[count++] = b;
  }
}

void ClipBoxes::Intersect(const Box& inBox) {
  int kept = 0;
  for (int i = 0; i < count; ++i) {
    Box b{std::max(boxes[i].left, inBox.left), std::max(boxes[i].top, inBox.top),
          std::min(boxes[i].right, inBox.right), std::min(boxes[i].bottom, inBox.bottom)};
    if (b.left < b.right && b.top < b.bottom) boxes[kept++] = b;
  }
  if (count >= 0) count = kept;
}

bool DeviceBoxOf(cairo_t* inContext, double inX, double inY, double inW, double inH, ClipBoxes::Box* outBox) {
  cairo_matrix_t m;
  cairo_get_matrix(inContext, &m);
  if (m.xy != 0 || m.yx != 0) return false;
  double x1 = inX * m.xx + m.x0, x2 = (inX + inW) * m.xx + m.x0;
  double y1 = inY * m.yy + m.y0, y2 = (inY + inH) * m.yy + m.y0;
  if (!IsWhole(x1) || !IsWhole(x2) || !IsWhole(y1) || !IsWhole(y2)) return false;
  *outBox = {static_cast<int>(std::min(x1, x2)), static_cast<int>(std::min(y1, y2)),
             static_cast<int>(std::max(x1, x2)), static_cast<int>(std::max(y1, y2))};
  return true;
}

bool FillOpaqueBox(cairo_surface_t* inTarget, const ClipBoxes& inClip, const ClipBoxes::Box& inBox,
                   ColorRGBA const& inColor) {
  if (inClip.count < 0 || !(inColor.alpha >= 1)) return false;
  if (cairo_image_surface_get_format(inTarget) != CAIRO_FORMAT_ARGB32) return false;
  double dx = 0, dy = 0;
  cairo_surface_get_device_offset(inTarget, &dx, &dy);
  if (dx != 0 || dy != 0) return false;
  cairo_surface_flush(inTarget);
  unsigned char* data = cairo_image_surface_get_data(inTarget);
  if (data == nullptr) return false;
  const int stride = cairo_image_surface_get_stride(inTarget);
  const std::uint32_t pixel =
      0xff000000u | Channel8(inColor.red) << 16 | Channel8(inColor.green) << 8 | Channel8(inColor.blue);
  for (int i = 0; i < inClip.count; ++i) {
    const ClipBoxes::Box& c = inClip.boxes[i];
    const int left = std::max(c.left, inBox.left), right = std::min(c.right, inBox.right);
    const int top = std::max(c.top, inBox.top), bottom = std::min(c.bottom, inBox.bottom);
    if (left >= right || top >= bottom) continue;
    for (int y = top; y < bottom; ++y) {
      auto* row = reinterpret_cast<std::uint32_t*>(data + static_cast<std::ptrdiff_t>(y) * stride);
      std::fill(row + left, row + right, pixel);
    }
    cairo_surface_mark_dirty_rectangle(inTarget, left, top, right - left, bottom - top);
  }
  return true;
}

}  // namespace norvik::drawbot::cairo
