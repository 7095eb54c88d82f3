#pragma once
// A view container that shows OpenGL drawing. The context belongs to the
// native window, and a native re-parent invalidates it, so the context is
// ended before the container moves and built again once it has a parent.
// A paint makes the context current, lets the subclass draw, then presents
// and puts back whatever context was current before.
#include "ui/OS_ViewContainer.h"

namespace norvik::ui {

class OS_OpenGLViewBase : public OS_ViewContainer {
 public:
  explicit OS_OpenGLViewBase(bool inDoubleBuffered = false) : OS_ViewContainer(inDoubleBuffered) {}

  // ---- virtual operations added here, in slot order ----
  virtual void InitOpenGL() = 0;
  virtual void EndOpenGL() = 0;
  virtual void PreDrawOpenGL() = 0;
  virtual void DrawOpenGL() = 0;
  virtual void PostDrawOpenGL() = 0;

  void UI_SetParent(UI_Container* inParent) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
};

}  // namespace norvik::ui
