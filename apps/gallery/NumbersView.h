#pragma once
// The gallery's "Numbers and units" page: what a user may type into measured
// fields, evaluated live for fields of six units (each cell the display text,
// the value and whether it was an error), and beside it number data formats
// (flags, custom signs, minus infinity) and the steps each modifier key takes.
#include "GalleryViews.h"

namespace norvik::gallery {

// The typed expressions against the field units, evaluated at each paint.
class ExpressionTableView : public ui::UI_SubView {
 public:
  ExpressionTableView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  static constexpr float kRowHeight = 40;
};

// Number data: one value in several formats, and a step per modifier key.
class NumberFormatsView : public ui::UI_SubView {
 public:
  NumberFormatsView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  static constexpr float kRowHeight = 22;
};

class NumbersView : public ui::UI_SubView {
 public:
  NumbersView();
  void UI_SizeChanged(const RectF& inLocalRect) override;

 private:
  void Arrange();
  boost::intrusive_ptr<SectionView> mExpressionSection, mFormatSection;
  ui::UI_NodeP mExpressions, mFormats;
};

}  // namespace norvik::gallery
