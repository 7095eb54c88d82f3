// Damage, paint and presentation. Each window paints into a back buffer of its
// client size that persists between paints; EndPaint copies the repainted
// region to the window through a Cairo xcb surface, so the screen never shows
// a half-drawn frame.
#include <algorithm>
#include <cstring>
#include <vector>

#include "drawbot/SupplierInterface.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

cairo_rectangle_int_t ToCairo(const OS_Rect& inRect) {
  return {static_cast<int>(inRect.left), static_cast<int>(inRect.top), static_cast<int>(inRect.width),
          static_cast<int>(inRect.height)};
}

}  // namespace

void OS_NativeLayer_X11::Damage(X11Window& ioWindow, const OS_Rect* inRect) {
  const OS_Rect client(0, 0, ioWindow.rect.width, ioWindow.rect.height);
  const OS_Rect area = inRect ? inRect->Intersection(client) : client;
  if (area.IsEmpty()) return;
  const cairo_rectangle_int_t rect = ToCairo(area);
  if (!ioWindow.damage)
    ioWindow.damage = cairo_region_create_rectangle(&rect);
  else
    cairo_region_union_rectangle(ioWindow.damage, &rect);
}

void OS_NativeLayer_X11::InvalidateRect(OS_WindowHandle inWindow, const OS_Rect* inRect) {
  if (X11Window* window = Find(inWindow)) Damage(*window, inRect);
}

void OS_NativeLayer_X11::UpdateWindow(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (window && window->damage && IsWindowVisible(inWindow)) CallProcedure(inWindow, kOSMsgPaint, 0, 0);
}

bool OS_NativeLayer_X11::DeliverPaint() {
  for (auto& [handle, window] : mWindows) {
    if (!window->damage) continue;
    if (!IsWindowVisible(handle)) {
      cairo_region_destroy(window->damage);
      window->damage = nullptr;
      continue;
    }
    const OS_WindowHandle target = handle;
    CallProcedure(target, kOSMsgPaint, 0, 0);
    // A window that did not paint is taken as painted, so it is not asked forever.
    if (X11Window* still = Find(target); still && still->damage) {
      cairo_region_destroy(still->damage);
      still->damage = nullptr;
    }
    return true;
  }
  return false;
}

OS_PaintContext OS_NativeLayer_X11::BeginPaint(OS_WindowHandle inWindow) {
  OS_PaintContext context;
  X11Window* window = Find(inWindow);
  if (!window) return context;
  const int width = static_cast<int>(std::max<long>(1, window->rect.width));
  const int height = static_cast<int>(std::max<long>(1, window->rect.height));
  if (!window->backBuffer || cairo_image_surface_get_width(window->backBuffer) != width ||
      cairo_image_surface_get_height(window->backBuffer) != height) {
    if (window->backBuffer) cairo_surface_destroy(window->backBuffer);
    window->backBuffer = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height);
    Damage(*window, nullptr);  // a new buffer holds nothing yet
  }
  cairo_region_t* region = window->damage ? window->damage : cairo_region_create();
  window->damage = nullptr;
  cairo_rectangle_int_t extents;
  cairo_region_get_extents(region, &extents);
  context.target = window->backBuffer;
  context.updateRegion = region;
  context.updateBounds = OS_Rect(extents.x, extents.y, extents.width, extents.height);
  return context;
}

void OS_NativeLayer_X11::EndPaint(OS_WindowHandle inWindow, const OS_PaintContext& inContext) {
  auto* region = static_cast<cairo_region_t*>(inContext.updateRegion);
  if (X11Window* window = Find(inWindow); window && region) {
    Present(*window, region);
    ApplyColorKeyShape(*window);
  }
  if (region) cairo_region_destroy(region);
}

// The back buffer's pixels go to the window with PutImage, band by band so
// that no request exceeds the server's maximum length. On the 24- and 32-bit
// TrueColor visuals of today's servers, Cairo's ARGB32 rows are already in
// the server's ZPixmap layout.
void OS_NativeLayer_X11::Present(X11Window& ioWindow, cairo_region_t* inRegion) {
  if (!ioWindow.backBuffer || cairo_region_is_empty(inRegion)) return;
  if (!ioWindow.gc) {
    ioWindow.gc = xcb_generate_id(mConnection);
    xcb_create_gc(mConnection, ioWindow.gc, ioWindow.id, 0, nullptr);
  }
  cairo_surface_flush(ioWindow.backBuffer);
  const unsigned char* pixels = cairo_image_surface_get_data(ioWindow.backBuffer);
  const int stride = cairo_image_surface_get_stride(ioWindow.backBuffer);
  const int bufferWidth = cairo_image_surface_get_width(ioWindow.backBuffer);
  const int bufferHeight = cairo_image_surface_get_height(ioWindow.backBuffer);
  const std::size_t maxBytes = static_cast<std::size_t>(xcb_get_maximum_request_length(mConnection)) * 4 - 64;
  std::vector<unsigned char> band;
  for (int i = 0, n = cairo_region_num_rectangles(inRegion); i < n; ++i) {
    cairo_rectangle_int_t r;
    cairo_region_get_rectangle(inRegion, i, &r);
    r.width = std::min(r.width, bufferWidth - r.x);
    r.height = std::min(r.height, bufferHeight - r.y);
    if (r.width <= 0 || r.height <= 0 || r.x < 0 || r.y < 0) continue;
    const std::size_t rowBytes = static_cast<std::size_t>(r.width) * 4;
    const int rowsPerBand = static_cast<int>(std::max<std::size_t>(1, maxBytes / rowBytes));
    for (int y = r.y; y < r.y + r.height; y += rowsPerBand) {
      const int rows = std::min(rowsPerBand, r.y + r.height - y);
      band.resize(rowBytes * static_cast<std::size_t>(rows));
      for (int row = 0; row < rows; ++row)
        std::memcpy(band.data() + rowBytes * static_cast<std::size_t>(row),
                    pixels + static_cast<std::size_t>(y + row) * static_cast<std::size_t>(stride) +
                        static_cast<std::size_t>(r.x) * 4,
                    rowBytes);
      xcb_put_image(mConnection, XCB_IMAGE_FORMAT_Z_PIXMAP, ioWindow.id, ioWindow.gc, static_cast<uint16_t>(r.width),
                    static_cast<uint16_t>(rows), static_cast<int16_t>(r.x), static_cast<int16_t>(y), 0,
                    mScreen->root_depth, static_cast<std::uint32_t>(band.size()), band.data());
    }
  }
  xcb_flush(mConnection);
}

const drawbot::SupplierInterface* OS_NativeLayer_X11::GetDrawSupplier() const { return mSupplier.get(); }

void OS_NativeLayer_X11::SetLayeredAttributes(OS_WindowHandle inWindow, std::uint32_t inColorKey,
                                              unsigned char inAlpha, unsigned inFlags) {
  X11Window* window = Find(TopLevelOf(inWindow));
  if (!window) return;
  const xcb_atom_t opacity = Atom("_NET_WM_WINDOW_OPACITY");
  window->alpha = (inFlags & kOSLayeredAlpha) ? inAlpha : 255;
  window->colorKeyed = (inFlags & kOSLayeredColorKey) != 0;
  window->colorKey = inColorKey;
  ApplyColorKeyShape(*window);
  if (window->alpha == 255) {
    xcb_delete_property(mConnection, window->id, opacity);
  } else {
    const std::uint32_t value = static_cast<std::uint32_t>(window->alpha) * 0x01010101u;
    xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, window->id, opacity, XCB_ATOM_CARDINAL, 32, 1, &value);
  }
  xcb_flush(mConnection);
}

OS_RegionHandle OS_NativeLayer_X11::CreateRegion(const OS_Rect& inRect) {
  const cairo_rectangle_int_t rect = ToCairo(inRect);
  return cairo_region_create_rectangle(&rect);
}

void OS_NativeLayer_X11::DestroyRegion(OS_RegionHandle inRegion) {
  if (inRegion) cairo_region_destroy(static_cast<cairo_region_t*>(inRegion));
}

bool OS_NativeLayer_X11::IntersectRegion(OS_RegionHandle inOutRegion, const OS_Rect& inRect) {
  auto* region = static_cast<cairo_region_t*>(inOutRegion);
  if (!region) return false;
  const cairo_rectangle_int_t rect = ToCairo(inRect);
  cairo_region_intersect_rectangle(region, &rect);
  return !cairo_region_is_empty(region);
}

bool OS_NativeLayer_X11::IntersectRegions(OS_RegionHandle inOutRegion, OS_RegionHandle inOther) {
  auto* region = static_cast<cairo_region_t*>(inOutRegion);
  if (!region || !inOther) return false;
  cairo_region_intersect(region, static_cast<cairo_region_t*>(inOther));
  return !cairo_region_is_empty(region);
}

bool OS_NativeLayer_X11::IsRegionEmpty(OS_RegionHandle inRegion) const {
  return !inRegion || cairo_region_is_empty(static_cast<cairo_region_t*>(inRegion));
}

OS_Rect OS_NativeLayer_X11::GetRegionBounds(OS_RegionHandle inRegion) const {
  if (!inRegion) return OS_Rect();
  cairo_rectangle_int_t extents;
  cairo_region_get_extents(static_cast<cairo_region_t*>(inRegion), &extents);
  return OS_Rect(extents.x, extents.y, extents.width, extents.height);
}

}  // namespace norvik::ui::x11
