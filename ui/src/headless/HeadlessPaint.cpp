// Painting in the headless system: damage regions, paint messages, the
// per-window image surfaces, the region algebra, layered attributes and the
// compositing of the virtual screen. Also cursors and the caret, which are
// recorded rather than shown.
#include <algorithm>

#include "drawbot/SupplierInterface.h"
#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {
namespace {

cairo_region_t* AsRegion(OS_RegionHandle inRegion) { return static_cast<cairo_region_t*>(inRegion); }

cairo_rectangle_int_t ToCairo(const OS_Rect& inRect) {
  return {static_cast<int>(inRect.left), static_cast<int>(inRect.top), static_cast<int>(std::max(0L, inRect.width)),
          static_cast<int>(std::max(0L, inRect.height))};
}

// A copy of a window's pixels in which those of the colour key (0x00BBGGRR)
// are transparent.
cairo_surface_t* KeyedCopy(cairo_surface_t* inSource, std::uint32_t inColorKey) {
  const int width = cairo_image_surface_get_width(inSource);
  const int height = cairo_image_surface_get_height(inSource);
  cairo_surface_t* copy = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height);
  cairo_surface_flush(inSource);
  const unsigned char* from = cairo_image_surface_get_data(inSource);
  unsigned char* to = cairo_image_surface_get_data(copy);
  const int fromStride = cairo_image_surface_get_stride(inSource);
  const int toStride = cairo_image_surface_get_stride(copy);
  const std::uint32_t key = ((inColorKey & 0xFF) << 16) | (inColorKey & 0xFF00) | ((inColorKey >> 16) & 0xFF);
  for (int y = 0; y < height; ++y) {
    const auto* fromRow = reinterpret_cast<const std::uint32_t*>(from + y * fromStride);
    auto* toRow = reinterpret_cast<std::uint32_t*>(to + y * toStride);
    for (int x = 0; x < width; ++x) toRow[x] = (fromRow[x] & 0xFFFFFF) == key ? 0 : fromRow[x];
  }
  cairo_surface_mark_dirty(copy);
  return copy;
}

}  // namespace

void OS_NativeLayer_Headless::EnsureSurface(HeadlessWindow& inWindow) {
  const int width = static_cast<int>(inWindow.rect.width);
  const int height = static_cast<int>(inWindow.rect.height);
  // A window without area (minimised, or not sized yet) keeps its pixels.
  if (width <= 0 || height <= 0) return;
  if (inWindow.surface && cairo_image_surface_get_width(inWindow.surface) == width &&
      cairo_image_surface_get_height(inWindow.surface) == height)
    return;
  cairo_surface_t* surface = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height);
  if (inWindow.surface) {
    cairo_t* context = cairo_create(surface);
    cairo_set_source_surface(context, inWindow.surface, 0, 0);
    cairo_set_operator(context, CAIRO_OPERATOR_SOURCE);
    cairo_paint(context);
    cairo_destroy(context);
    cairo_surface_destroy(inWindow.surface);
  }
  inWindow.surface = surface;
}

bool OS_NativeLayer_Headless::HasVisibleDamage(const HeadlessWindow& inWindow) const {
  return !cairo_region_is_empty(inWindow.damage) && inWindow.rect.width > 0 && inWindow.rect.height > 0 &&
         inWindow.show != ShowState::kMinimized && IsWindowVisible(inWindow.handle);
}

void OS_NativeLayer_Headless::InvalidateRect(OS_WindowHandle inWindow, const OS_Rect* inRect) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  const OS_Rect client(0, 0, window->rect.width, window->rect.height);
  const OS_Rect area = inRect ? client.Intersection(*inRect) : client;
  if (area.IsEmpty()) return;
  const cairo_rectangle_int_t rect = ToCairo(area);
  cairo_region_union_rectangle(window->damage, &rect);
}

int OS_NativeLayer_Headless::DeliverPaints() {
  // Parents paint before their children.
  std::vector<std::pair<int, OS_WindowHandle>> damaged;
  for (const auto& entry : mWindows) {
    if (!HasVisibleDamage(*entry.second)) continue;
    int depth = 0;
    for (const HeadlessWindow* w = entry.second.get(); w->parent != 0; w = Find(w->parent)) ++depth;
    damaged.emplace_back(depth, entry.first);
  }
  std::stable_sort(damaged.begin(), damaged.end(),
                   [](const auto& inA, const auto& inB) { return inA.first < inB.first; });
  int count = 0;
  for (const auto& entry : damaged) {
    HeadlessWindow* window = Find(entry.second);
    if (!window || !HasVisibleDamage(*window)) continue;
    CallProcedure(entry.second, kOSMsgPaint, 0, 0);
    ++count;
    // A window that does not paint its damage is not asked again and again:
    // what it left is dropped, as if painted.
    if ((window = Find(entry.second)) != nullptr && !cairo_region_is_empty(window->damage)) {
      cairo_region_destroy(window->damage);
      window->damage = cairo_region_create();
    }
  }
  return count;
}

void OS_NativeLayer_Headless::UpdateWindow(OS_WindowHandle inWindow) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || !HasVisibleDamage(*window)) return;
  CallProcedure(inWindow, kOSMsgPaint, 0, 0);
  if ((window = Find(inWindow)) != nullptr && !cairo_region_is_empty(window->damage)) {
    cairo_region_destroy(window->damage);
    window->damage = cairo_region_create();
  }
}

OS_PaintContext OS_NativeLayer_Headless::BeginPaint(OS_WindowHandle inWindow) {
  OS_PaintContext context;
  HeadlessWindow* window = Find(inWindow);
  if (!window) return context;
  EnsureSurface(*window);
  cairo_region_t* update = window->damage;
  window->damage = cairo_region_create();
  const cairo_rectangle_int_t client = ToCairo(OS_Rect(0, 0, window->rect.width, window->rect.height));
  cairo_region_intersect_rectangle(update, &client);
  cairo_rectangle_int_t bounds;
  cairo_region_get_extents(update, &bounds);
  context.target = window->surface;
  context.updateRegion = update;
  context.updateBounds = OS_Rect(bounds.x, bounds.y, bounds.width, bounds.height);
  return context;
}

void OS_NativeLayer_Headless::EndPaint(OS_WindowHandle inWindow, const OS_PaintContext& inContext) {
  if (const HeadlessWindow* window = Find(inWindow))
    if (window->surface && inContext.target == window->surface) cairo_surface_flush(window->surface);
  if (inContext.updateRegion) cairo_region_destroy(AsRegion(inContext.updateRegion));
}

const drawbot::SupplierInterface* OS_NativeLayer_Headless::GetDrawSupplier() const {
  if (!mSupplier) mSupplier = drawbot::NewOSSupplier();
  return mSupplier.get();
}

void OS_NativeLayer_Headless::SetLayeredAttributes(OS_WindowHandle inWindow, std::uint32_t inColorKey,
                                                   unsigned char inAlpha, unsigned inFlags) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  window->colorKey = inColorKey;
  window->alpha = inAlpha;
  window->layeredFlags = inFlags;
}

unsigned char OS_NativeLayer_Headless::GetOpacity(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return 0;
  const bool layered = (window->exStyle & kOSExStyleLayered) != 0 && (window->layeredFlags & kOSLayeredAlpha) != 0;
  return layered ? window->alpha : 255;
}

// ---- regions ----

OS_RegionHandle OS_NativeLayer_Headless::CreateRegion(const OS_Rect& inRect) {
  if (inRect.IsEmpty()) return cairo_region_create();
  const cairo_rectangle_int_t rect = ToCairo(inRect);
  return cairo_region_create_rectangle(&rect);
}

void OS_NativeLayer_Headless::DestroyRegion(OS_RegionHandle inRegion) {
  if (inRegion) cairo_region_destroy(AsRegion(inRegion));
}

bool OS_NativeLayer_Headless::IntersectRegion(OS_RegionHandle inOutRegion, const OS_Rect& inRect) {
  if (!inOutRegion) return false;
  const cairo_rectangle_int_t rect = ToCairo(inRect);
  cairo_region_intersect_rectangle(AsRegion(inOutRegion), &rect);
  return !cairo_region_is_empty(AsRegion(inOutRegion));
}

bool OS_NativeLayer_Headless::IntersectRegions(OS_RegionHandle inOutRegion, OS_RegionHandle inOther) {
  if (!inOutRegion || !inOther) return false;
  cairo_region_intersect(AsRegion(inOutRegion), AsRegion(inOther));
  return !cairo_region_is_empty(AsRegion(inOutRegion));
}

bool OS_NativeLayer_Headless::IsRegionEmpty(OS_RegionHandle inRegion) const {
  return !inRegion || cairo_region_is_empty(AsRegion(inRegion));
}

OS_Rect OS_NativeLayer_Headless::GetRegionBounds(OS_RegionHandle inRegion) const {
  if (!inRegion) return OS_Rect();
  cairo_rectangle_int_t bounds;
  cairo_region_get_extents(AsRegion(inRegion), &bounds);
  return OS_Rect(bounds.x, bounds.y, bounds.width, bounds.height);
}

// ---- read back ----

cairo_surface_t* OS_NativeLayer_Headless::GetWindowSurface(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->surface : nullptr;
}

void OS_NativeLayer_Headless::ComposeWindow(cairo_t* inContext, const HeadlessWindow& inWindow,
                                            OS_Point inOrigin) const {
  const double x = static_cast<double>(inOrigin.x);
  const double y = static_cast<double>(inOrigin.y);
  cairo_save(inContext);
  cairo_rectangle(inContext, x, y, static_cast<double>(inWindow.rect.width), static_cast<double>(inWindow.rect.height));
  cairo_clip(inContext);
  cairo_push_group(inContext);
  if (inWindow.surface) {
    const bool keyed = (inWindow.exStyle & kOSExStyleLayered) != 0 && (inWindow.layeredFlags & kOSLayeredColorKey) != 0;
    cairo_surface_t* source = keyed ? KeyedCopy(inWindow.surface, inWindow.colorKey) : inWindow.surface;
    cairo_set_source_surface(inContext, source, x, y);
    cairo_paint(inContext);
    if (keyed) cairo_surface_destroy(source);
  }
  // Children draw over their parent, the bottom one first.
  for (auto it = inWindow.children.rbegin(); it != inWindow.children.rend(); ++it) {
    const HeadlessWindow* child = Find(*it);
    if (!child || (child->style & kOSStyleVisible) == 0) continue;
    ComposeWindow(inContext, *child, OS_Point(inOrigin.x + child->rect.left, inOrigin.y + child->rect.top));
  }
  cairo_pop_group_to_source(inContext);
  cairo_paint_with_alpha(inContext, GetOpacity(inWindow.handle) / 255.0);
  cairo_restore(inContext);
}

cairo_surface_t* OS_NativeLayer_Headless::ComposeScreen() const {
  OS_Rect screen;
  for (const OS_Monitor& monitor : mMonitors) screen = screen.Union(monitor.bounds);
  cairo_surface_t* surface = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, static_cast<int>(std::max(1L, screen.width)),
                                                        static_cast<int>(std::max(1L, screen.height)));
  cairo_t* context = cairo_create(surface);
  cairo_set_source_rgb(context, 0, 0, 0);
  cairo_paint(context);
  for (auto it = mTopLevels.rbegin(); it != mTopLevels.rend(); ++it) {
    const HeadlessWindow* window = Find(*it);
    if (!window || (window->style & kOSStyleVisible) == 0 || window->show == ShowState::kMinimized) continue;
    ComposeWindow(context, *window, OS_Point(window->rect.left - screen.left, window->rect.top - screen.top));
  }
  cairo_destroy(context);
  cairo_surface_flush(surface);
  return surface;
}

// ---- cursors and caret ----

OS_CursorHandle OS_NativeLayer_Headless::LoadSystemCursor(int inSystemCursor) {
  return inSystemCursor > 0 ? static_cast<OS_CursorHandle>(inSystemCursor) : 0;
}

OS_CursorHandle OS_NativeLayer_Headless::CreateCursorFromPixels(const std::uint32_t* inPixels, int inWidth,
                                                                int inHeight, int inHotX, int inHotY) {
  if (!inPixels || inWidth <= 0 || inHeight <= 0) return 0;
  Cursor cursor;
  cursor.pixels.assign(inPixels, inPixels + static_cast<std::size_t>(inWidth) * static_cast<std::size_t>(inHeight));
  cursor.size = OS_Point(inWidth, inHeight);
  cursor.hotSpot = OS_Point(inHotX, inHotY);
  const OS_CursorHandle handle = mNextCursor++;
  mCursors[handle] = std::move(cursor);
  return handle;
}

void OS_NativeLayer_Headless::DestroyCursor(OS_CursorHandle inCursor) { mCursors.erase(inCursor); }

bool OS_NativeLayer_Headless::GetCursorImage(OS_CursorHandle inCursor, std::vector<std::uint32_t>& outPixels,
                                             OS_Point& outSize, OS_Point& outHotSpot) const {
  auto it = mCursors.find(inCursor);
  if (it == mCursors.end()) return false;
  outPixels = it->second.pixels;
  outSize = it->second.size;
  outHotSpot = it->second.hotSpot;
  return true;
}

void OS_NativeLayer_Headless::ShowCaret(OS_WindowHandle inWindow, bool inShow) {
  if (HeadlessWindow* window = Find(inWindow)) window->caretCount += inShow ? 1 : -1;
}

int OS_NativeLayer_Headless::GetCaretCount(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->caretCount : 0;
}

void OS_NativeLayer_Headless::SetPreference(const std::string& inName, bool inValue) {
  mPreferences[inName] = inValue;
  for (OS_WindowHandle window : mTopLevels) PostMessage(window, kOSMsgSettingChange, 0, 0);
}

bool OS_NativeLayer_Headless::GetPreference(const std::string& inName, bool& outValue) const {
  auto it = mPreferences.find(inName);
  if (it == mPreferences.end()) return false;
  outValue = it->second;
  return true;
}

}  // namespace norvik::ui::headless
