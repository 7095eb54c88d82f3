#include "ui/OS_OpenGLView.h"

namespace norvik::ui {

OS_OpenGLView::OS_OpenGLView(bool inDoubleBuffered) : OS_OpenGLViewBase(inDoubleBuffered) {}

OS_OpenGLView::~OS_OpenGLView() { OS_OpenGLView::EndOpenGL(); }

OS_GLPixelFormat OS_OpenGLView::GetPixelFormat() {
  OS_GLPixelFormat format;
  format.doubleBuffered = true;
  format.colorBits = 24;
  format.depthBits = 16;
  return format;
}

void OS_OpenGLView::InitOpenGL() {
  OS_OpenGLView::EndOpenGL();
  OS_NativeLayer* layer = GetNativeLayer();
  const OS_WindowHandle window = GetHandle();
  if (!layer || !window) return;
  const OS_GLSurfaceHandle surface = layer->CreateGLSurface(window, GetPixelFormat());
  if (!surface) return;
  const OS_GLContextHandle context = layer->CreateGLContext(surface);
  if (!context) {
    layer->DestroyGLSurface(surface);
    return;
  }
  mGLWindow = window;
  mDeviceContext = surface;
  mRenderingContext = context;
}

void OS_OpenGLView::EndOpenGL() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (layer && mRenderingContext) layer->DestroyGLContext(mRenderingContext);
  if (layer && mDeviceContext) layer->DestroyGLSurface(mDeviceContext);
  mRenderingContext = 0;
  mDeviceContext = 0;
  mGLWindow = 0;
  mMadeCurrent = false;
}

void OS_OpenGLView::PreDrawOpenGL() {
  mMadeCurrent = false;
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer) return;
  mPrevious = layer->GetCurrentGLContext();
  if (!mRenderingContext) return;
  mMadeCurrent = layer->MakeGLContextCurrent(OS_GLCurrent{nullptr, mDeviceContext, mRenderingContext});
  if (mMadeCurrent) layer->ClearGLContext(0.0f, 0.0f, 0.0f, 0.0f);
}

void OS_OpenGLView::PostDrawOpenGL() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mMadeCurrent) return;
  layer->SwapGLBuffers(mDeviceContext);
  layer->MakeGLContextCurrent(mPrevious);
  mMadeCurrent = false;
  mPrevious = OS_GLCurrent{};
}

}  // namespace norvik::ui
