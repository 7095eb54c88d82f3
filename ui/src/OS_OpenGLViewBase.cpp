#include "ui/OS_OpenGLViewBase.h"

namespace norvik::ui {

void OS_OpenGLViewBase::UI_SetParent(UI_Container* inParent) {
  UI_NodeProtector protect(this);
  EndOpenGL();
  OS_ViewContainer::UI_SetParent(inParent);
  if (inParent) InitOpenGL();
}

void OS_OpenGLViewBase::UI_Draw(drawbot::Drawbot*) {
  UI_NodeProtector protect(this);
  PreDrawOpenGL();
  // A failing subclass still puts the previous context back before the
  // error leaves the paint.
  try {
    DrawOpenGL();
  } catch (...) {
    PostDrawOpenGL();
    throw;
  }
  PostDrawOpenGL();
}

}  // namespace norvik::ui
