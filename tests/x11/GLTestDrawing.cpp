#include "x11/GLTestDrawing.h"

#include <GL/gl.h>

namespace norvik::test {

void FillGLRectangle(int inX, int inY, int inWidth, int inHeight, int inSurfaceHeight, float inRed, float inGreen,
                     float inBlue) {
  glEnable(GL_SCISSOR_TEST);
  glScissor(inX, inSurfaceHeight - inY - inHeight, inWidth, inHeight);  // GL counts rows from the bottom
  glClearColor(inRed, inGreen, inBlue, 1.0f);
  glClear(GL_COLOR_BUFFER_BIT);
  glDisable(GL_SCISSOR_TEST);
}

std::string CurrentGLRenderer() {
  const GLubyte* renderer = glGetString(GL_RENDERER);
  return renderer ? reinterpret_cast<const char*>(renderer) : "";
}

}  // namespace norvik::test
