#include "ui/OS_OpenGLViewBase.h"

namespace norvik::ui {

void OS_OpenGLViewBase::UI_SetParent(UI_Container* inParent) {
  UI_NodeProtector protect(this);
  EndOpenGL();
  OS_ViewContainer::UI_SetParent(inParent);
  if (inParent) InitOpenGL();
}

void OS_OpenGLViewBase::UI_Draw(drawbot::Drawbot*) {
  PreDrawOpenGL();
  DrawOpenGL();
  PostDrawOpenGL();
}

}  // namespace norvik::ui
