#include "ui/HeadlessWindowSystem.h"

#include <cstring>

#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui {
namespace {

HeadlessPixels PixelsOf(cairo_surface_t* inSurface) {
  HeadlessPixels result;
  if (!inSurface) return result;
  cairo_surface_flush(inSurface);
  result.width = cairo_image_surface_get_width(inSurface);
  result.height = cairo_image_surface_get_height(inSurface);
  const int stride = cairo_image_surface_get_stride(inSurface);
  const unsigned char* data = cairo_image_surface_get_data(inSurface);
  result.pixels.resize(static_cast<std::size_t>(result.width) * static_cast<std::size_t>(result.height));
  for (int y = 0; y < result.height; ++y)
    std::memcpy(&result.pixels[static_cast<std::size_t>(y) * static_cast<std::size_t>(result.width)],
                data + static_cast<std::ptrdiff_t>(y) * stride, static_cast<std::size_t>(result.width) * 4);
  return result;
}

}  // namespace

HeadlessWindowSystem::HeadlessWindowSystem() : mLayer(std::make_unique<headless::OS_NativeLayer_Headless>()) {}

HeadlessWindowSystem::~HeadlessWindowSystem() { Uninstall(); }

OS_NativeLayer& HeadlessWindowSystem::GetLayer() { return *mLayer; }

void HeadlessWindowSystem::Install() {
  if (mInstalled) return;
  mPrevious = GetNativeLayer();
  InstallNativeLayer(mLayer.get());
  mInstalled = true;
}

void HeadlessWindowSystem::Uninstall() {
  if (!mInstalled) return;
  mInstalled = false;
  InstallNativeLayer(mPrevious);
  mPrevious = nullptr;
}

void HeadlessWindowSystem::MovePointer(OS_Point inScreenPoint) { mLayer->InjectPointerMove(inScreenPoint); }
void HeadlessWindowSystem::PressButton(int inButton) { mLayer->InjectButton(inButton, true); }
void HeadlessWindowSystem::ReleaseButton(int inButton) { mLayer->InjectButton(inButton, false); }

void HeadlessWindowSystem::Click(OS_Point inScreenPoint, int inButton) {
  MovePointer(inScreenPoint);
  PressButton(inButton);
  ReleaseButton(inButton);
}

void HeadlessWindowSystem::TurnWheel(int inRawDelta) { mLayer->InjectWheel(inRawDelta, false); }
void HeadlessWindowSystem::TurnHorizontalWheel(int inRawDelta) { mLayer->InjectWheel(inRawDelta, true); }
void HeadlessWindowSystem::PressKey(int inVirtualKey, bool inExtended) { mLayer->InjectKey(inVirtualKey, true, inExtended); }
void HeadlessWindowSystem::ReleaseKey(int inVirtualKey, bool inExtended) {
  mLayer->InjectKey(inVirtualKey, false, inExtended);
}

void HeadlessWindowSystem::TypeKey(int inVirtualKey, bool inExtended) {
  PressKey(inVirtualKey, inExtended);
  ReleaseKey(inVirtualKey, inExtended);
}

void HeadlessWindowSystem::TypeCharacter(char16_t inCharacter) { mLayer->InjectCharacter(inCharacter); }
void HeadlessWindowSystem::SetKeyToggled(int inVirtualKey, bool inToggled) {
  mLayer->SetKeyToggled(inVirtualKey, inToggled);
}

void HeadlessWindowSystem::AdvanceClock(OS_EventTime inMilliseconds) { mLayer->AdvanceClock(inMilliseconds); }
int HeadlessWindowSystem::Pump() { return mLayer->PumpUntilIdle(); }
std::size_t HeadlessWindowSystem::GetQueueLength() const { return mLayer->GetQueueLength(); }
void HeadlessWindowSystem::SetIdleWaitLimit(unsigned inMilliseconds) { mLayer->SetIdleWaitLimit(inMilliseconds); }

void HeadlessWindowSystem::SetMonitors(const std::vector<OS_Monitor>& inMonitors) { mLayer->SetMonitors(inMonitors); }
void HeadlessWindowSystem::SetPreference(const std::string& inName, bool inValue) {
  mLayer->SetPreference(inName, inValue);
}

OS_WindowHandle HeadlessWindowSystem::CreateForeignWindow(const OS_WindowCreateParams& inParams, bool inOtherThread) {
  return mLayer->CreateForeignWindow(inParams, inOtherThread);
}

void HeadlessWindowSystem::SetApplication(OS_WindowHandle inWindow, int inApplication) {
  mLayer->SetApplication(inWindow, inApplication);
}

void HeadlessWindowSystem::DeactivateApplication() { mLayer->DeactivateApplication(); }
int HeadlessWindowSystem::GetCaretCount(OS_WindowHandle inWindow) const { return mLayer->GetCaretCount(inWindow); }
unsigned char HeadlessWindowSystem::GetOpacity(OS_WindowHandle inWindow) const { return mLayer->GetOpacity(inWindow); }

bool HeadlessWindowSystem::GetCursorImage(OS_CursorHandle inCursor, std::vector<std::uint32_t>& outPixels,
                                          OS_Point& outSize, OS_Point& outHotSpot) const {
  return mLayer->GetCursorImage(inCursor, outPixels, outSize, outHotSpot);
}

HeadlessPixels HeadlessWindowSystem::ReadWindowPixels(OS_WindowHandle inWindow) const {
  return PixelsOf(mLayer->GetWindowSurface(inWindow));
}

HeadlessPixels HeadlessWindowSystem::ReadScreenPixels() const {
  cairo_surface_t* screen = mLayer->ComposeScreen();
  HeadlessPixels result = PixelsOf(screen);
  cairo_surface_destroy(screen);
  return result;
}

bool HeadlessWindowSystem::WriteWindowPNG(OS_WindowHandle inWindow, const std::string& inPath) const {
  cairo_surface_t* surface = mLayer->GetWindowSurface(inWindow);
  return surface && cairo_surface_write_to_png(surface, inPath.c_str()) == CAIRO_STATUS_SUCCESS;
}

bool HeadlessWindowSystem::WriteScreenPNG(const std::string& inPath) const {
  cairo_surface_t* screen = mLayer->ComposeScreen();
  const bool written = cairo_surface_write_to_png(screen, inPath.c_str()) == CAIRO_STATUS_SUCCESS;
  cairo_surface_destroy(screen);
  return written;
}

}  // namespace norvik::ui
