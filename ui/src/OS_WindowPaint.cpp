// The native paint of OS_Window: the update region, cut into the window's draw
// segments, each painted on a surface of the window's supplier.
#include <chrono>
#include <thread>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotTypes.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "tarsel/ErrorManager.h"
#include "ui/OS_Window.h"

namespace norvik::ui {

bool OS_Window::UI_Paint(OS_Event*) {
  if (!UI_SupportsDrawbot()) return false;
  const RectL local = UI_GetLocalRect();
  if (local.width < 1 || local.height < 1) return false;
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return false;
  UI_NodeProtector protect(this);
  drawbot::SupplierInterface* supplier = UI_GetDrawSupplier();
  tarsel::config::ScErrorManagerPaint errorBracket;
  const OS_WindowHandle handle = mPlatformWindow;
  const OS_PaintContext context = layer->BeginPaint(handle);
  if (supplier) {
    std::vector<RectL> segments;
    UI_GetDrawSegments(segments);
    if (segments.empty()) {
      PaintRun(supplier, context.target, context.updateRegion);
    } else {
      for (const RectL& segment : segments) {
        if (segment.width <= 0 || segment.height <= 0) continue;
        OS_RegionHandle region = layer->CreateRegion(segment);
        if (!region) continue;
        if (context.updateRegion && layer->IntersectRegions(region, context.updateRegion))
          PaintRun(supplier, context.target, region);
        layer->DestroyRegion(region);
      }
    }
  }
  layer->EndPaint(handle, context);
  return true;
}

void OS_Window::PaintRun(drawbot::SupplierInterface* inSupplier, void* inTarget, void* inRegion) {
  drawbot::SurfaceInterfaceP surface(inSupplier->NewSurface(inTarget, inRegion, false));
  if (!surface) return;
  drawbot::Drawbot drawbot(inSupplier, surface.get());
  if (const unsigned long delay = drawbot::GetRedrawDebugFlashDelay()) {
    // A debugging flash: the repainted part shows green for a moment.
    surface->PaintRect(drawbot::ColorRGBA{0.0f, 1.0f, 0.0f, 1.0f}, RectF(surface->GetClipBounds()));
    surface->Flush();
    std::this_thread::sleep_for(std::chrono::milliseconds(delay));
  }
  UI_Draw(&drawbot);
  surface->Flush();
}

}  // namespace norvik::ui
