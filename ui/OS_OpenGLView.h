#pragma once
// The OpenGL view of the native layer. Its context is made for the view's own
// native window: a double-buffered RGBA surface of 24 colour bits with a
// 16-bit depth buffer, and a context drawing on it. A paint remembers the
// surface and context that were current (the host may have its own), makes
// the view's current, clears to transparent black, lets DrawOpenGL draw,
// presents the back buffer and puts the previous pair back.
//
// On a platform without GL no context is made: the view keeps its place in
// the tree (it clips, shows, hides and moves with its parent like any view
// container), the paint still runs PreDrawOpenGL, DrawOpenGL and
// PostDrawOpenGL in order, and HasOpenGLContext says false so that a
// subclass can skip its GL calls.
#include "ui/OS_NativeLayer.h"
#include "ui/OS_OpenGLViewBase.h"

namespace norvik::ui {

class OS_OpenGLView : public OS_OpenGLViewBase {
 public:
  explicit OS_OpenGLView(bool inDoubleBuffered = false);
  // Ends the context while the native window still exists.
  ~OS_OpenGLView() override;

  // Makes the surface and the context (ending any earlier pair first).
  void InitOpenGL() override;
  // Destroys the context and the surface; safe when there are none.
  void EndOpenGL() override;
  void PreDrawOpenGL() override;
  // What the view shows; the subclass draws here with its context current.
  void DrawOpenGL() override {}
  void PostDrawOpenGL() override;

  bool HasOpenGLContext() const { return mRenderingContext != 0; }
  OS_WindowHandle GetOpenGLWindow() const { return mGLWindow; }
  OS_GLSurfaceHandle GetDeviceContext() const { return mDeviceContext; }
  OS_GLContextHandle GetRenderingContext() const { return mRenderingContext; }

  // The format every view asks for.
  static OS_GLPixelFormat GetPixelFormat();

 protected:
  OS_WindowHandle mGLWindow = 0;             // the native window the context was made for
  OS_GLSurfaceHandle mDeviceContext = 0;     // where GL draws in it
  OS_GLContextHandle mRenderingContext = 0;
  OS_GLCurrent mPrevious;                    // what was current before the paint
  bool mMadeCurrent = false;                 // this paint made ours current
};

using OS_OpenGLViewP = boost::intrusive_ptr<OS_OpenGLView>;

}  // namespace norvik::ui
