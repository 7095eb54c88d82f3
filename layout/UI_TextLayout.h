#pragma once
// A label's leaf: decides once, at a given width, whether the label needs
// several lines. It keeps one line unless wrapping makes the text more than
// half as tall again, so a label that fits stays a single line and never
// wraps a stray word.
#include "controls/UI_StaticText.h"
#include "layout/UI_NodeLayout.h"

namespace norvik::drawbot {
class Drawbot;
}

namespace norvik::layout {

class UI_TextLayout : public UI_NodeLayout {
 public:
  // inDrawbot may be null: labels measure through the platform's fonts.
  UI_TextLayout(controls::UI_StaticTextP inText, float inWidth, drawbot::Drawbot* inDrawbot = nullptr);

 private:
  static PointF Measure(controls::UI_StaticText* inText, float inWidth);
};

}  // namespace norvik::layout
