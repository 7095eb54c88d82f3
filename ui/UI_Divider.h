#pragma once
// A thin line that divides two neighbours: drawn along the longer side of
// its rectangle, centred in the shorter one, in the theme's outline colour.
#include "ui/UI_SubView.h"

namespace norvik::ui {

class UI_Divider : public UI_SubView {
 public:
  UI_Divider();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // One pixel across, and no preferred length.
  PointF UI_GetRecommendedSize() const override { return PointF(1, 1); }

  // The rectangle of the line inside a view of the given size.
  static RectF LineRect(PointF const& inSize);
};

}  // namespace norvik::ui
