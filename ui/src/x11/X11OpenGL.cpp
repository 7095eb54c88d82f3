// OpenGL views on X11: GLX surfaces as child windows of the view's window,
// through the GL connection of X11GLContexts. The surface follows the size
// of its window whenever it is made current, and its Expose events damage
// the window, so that the view repaints what was uncovered.
#include <cstdlib>

#include "ui/src/x11/OS_NativeLayer_X11.h"
#include "ui/src/x11/X11GLContexts.h"

namespace norvik::ui::x11 {

X11GLContexts& OS_NativeLayer_X11::GL() const {
  if (!mGL) mGL = std::make_unique<X11GLContexts>(mDisplayName);
  return *mGL;
}

OS_WindowHandle OS_NativeLayer_X11::GLSurfaceOwner(std::uint32_t inWindow) const {
  return mGL ? mGL->ParentOf(inWindow) : 0;
}

OS_GLSurfaceHandle OS_NativeLayer_X11::CreateGLSurface(OS_WindowHandle inWindow, const OS_GLPixelFormat& inFormat) {
  X11Window* window = Find(inWindow);
  if (!window || !GL().IsAvailable()) return 0;
  // The GL connection names this window next: a round trip makes sure the
  // server has it.
  std::free(xcb_get_input_focus_reply(mConnection, xcb_get_input_focus(mConnection), nullptr));
  const OS_GLSurfaceHandle surface = GL().CreateSurface(
      window->id, static_cast<int>(window->rect.width), static_cast<int>(window->rect.height), inFormat);
  if (!surface) return 0;
  const std::uint32_t mask = XCB_EVENT_MASK_EXPOSURE;
  xcb_change_window_attributes(mConnection, static_cast<xcb_window_t>(surface), XCB_CW_EVENT_MASK, &mask);
  xcb_flush(mConnection);
  return surface;
}

void OS_NativeLayer_X11::DestroyGLSurface(OS_GLSurfaceHandle inSurface) {
  if (mGL) mGL->DestroySurface(inSurface);
}

OS_GLContextHandle OS_NativeLayer_X11::CreateGLContext(OS_GLSurfaceHandle inSurface) {
  return mGL ? mGL->CreateContext(inSurface) : 0;
}

void OS_NativeLayer_X11::DestroyGLContext(OS_GLContextHandle inContext) {
  if (mGL) mGL->DestroyContext(inContext);
}

OS_GLCurrent OS_NativeLayer_X11::GetCurrentGLContext() const { return GL().Current(); }

bool OS_NativeLayer_X11::MakeGLContextCurrent(const OS_GLCurrent& inCurrent) {
  if (const OS_WindowHandle owner = GLSurfaceOwner(static_cast<std::uint32_t>(inCurrent.surface))) {
    if (const X11Window* window = Find(owner))
      mGL->FitSurface(inCurrent.surface, static_cast<int>(window->rect.width), static_cast<int>(window->rect.height));
  }
  return GL().MakeCurrent(inCurrent);
}

void OS_NativeLayer_X11::ClearGLContext(float inRed, float inGreen, float inBlue, float inAlpha) {
  GL().Clear(inRed, inGreen, inBlue, inAlpha);
}

bool OS_NativeLayer_X11::SwapGLBuffers(OS_GLSurfaceHandle inSurface) { return mGL && mGL->Swap(inSurface); }

}  // namespace norvik::ui::x11
