#pragma once
// A few GL calls for the OpenGL view tests, kept out of the tests so that no
// test includes a GL header: each works on the context current now.
#include <string>

namespace norvik::test {

// Fills a rectangle given in top-down window coordinates of a surface
// inSurfaceHeight pixels high, through the scissor and a clear.
void FillGLRectangle(int inX, int inY, int inWidth, int inHeight, int inSurfaceHeight, float inRed, float inGreen,
                     float inBlue);
// The renderer of the current context ("" with none), for messages.
std::string CurrentGLRenderer();

}  // namespace norvik::test
