#include "layout/UI_TextLayout.h"

#include <cmath>

namespace norvik::layout {

UI_TextLayout::UI_TextLayout(controls::UI_StaticTextP inText, float inWidth, drawbot::Drawbot*)
    : UI_NodeLayout(inText, inText ? Measure(inText.get(), SanitizeExtent(inWidth)) : PointF()) {}

PointF UI_TextLayout::Measure(controls::UI_StaticText* inText, float inWidth) {
  // Only the width is the measure's business: the text keeps its place until
  // the layout that measured it is placed, which may never happen.
  RectF rect = inText->UI_GetLocalRectF(true);
  rect.width = inWidth;
  inText->UI_SetLocalRectF(rect);
  inText->SetMultiLine(true);
  const PointF multi = SanitizeSize(inText->UI_GetRecommendedSize());
  inText->SetMultiLine(false);
  const PointF single = SanitizeSize(inText->UI_GetRecommendedSize());
  PointF size = single;
  if (multi.y > single.y * 1.5f) {
    inText->SetMultiLine(true);
    size = multi;
  }
  return PointF(std::ceil(size.x + 2), std::ceil(size.y + 1));
}

}  // namespace norvik::layout
