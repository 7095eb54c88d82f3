// The GL operations of a platform that has no GL: nothing is made, nothing
// is current, and every request is refused without harm.
#include "ui/OS_NativeLayer.h"

namespace norvik::ui {

OS_GLSurfaceHandle OS_NativeLayer::CreateGLSurface(OS_WindowHandle, const OS_GLPixelFormat&) { return 0; }

void OS_NativeLayer::DestroyGLSurface(OS_GLSurfaceHandle) {}

OS_GLContextHandle OS_NativeLayer::CreateGLContext(OS_GLSurfaceHandle) { return 0; }

void OS_NativeLayer::DestroyGLContext(OS_GLContextHandle) {}

OS_GLCurrent OS_NativeLayer::GetCurrentGLContext() const { return OS_GLCurrent{}; }

bool OS_NativeLayer::MakeGLContextCurrent(const OS_GLCurrent& inCurrent) {
  // Nothing current is the one state this platform can be put in.
  return inCurrent.context == 0 && inCurrent.surface == 0;
}

void OS_NativeLayer::ClearGLContext(float, float, float, float) {}

bool OS_NativeLayer::SwapGLBuffers(OS_GLSurfaceHandle) { return false; }

}  // namespace norvik::ui
