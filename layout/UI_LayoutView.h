#pragma once
// A container that stands its children one after another at the size of
// their content. Four sub-view layout flags hold its rules, so that an
// archive's sub-view keys and these setters speak of the same bits:
//
//   1  layout enabled. Clear, the view is a plain sub-view: AutoLayout leaves
//      the children alone and a resize moves them by their layout bindings.
//   2  layout mode 1, horizontal: children stand left to right. Clear (mode 0,
//      vertical), they stand top to bottom. Child order is the order on screen.
//   4  maintain margins: the gap found before each child along the stack
//      (from the view's edge for the first, from its neighbour for the rest)
//      and its offset across the stack are kept, so that margins drawn by a
//      designer survive. Clear, children are packed from the corner, edge to
//      edge.
//   8  scale children: a later resize scales every child's rectangle by the
//      view's change of size on each axis, so that children keep their share
//      of the view. Clear, children follow their layout bindings.
//
// Only children that are meant to show take part. A child that recommends no
// size (a group of controls placed by hand) keeps the size it has; a nested
// layout view is laid out first, so that its recommended size is current.
#include "ui/UI_SubView.h"

namespace norvik::drawbot {
class Drawbot;
}

namespace norvik::layout {

class UI_LayoutView : public ui::UI_SubView {
 public:
  static constexpr std::uint8_t kLayoutEnabled = 1;
  static constexpr std::uint8_t kLayoutHorizontal = 2;
  static constexpr std::uint8_t kMaintainMargins = 4;
  static constexpr std::uint8_t kScaleChildren = 8;

  enum LayoutMode : unsigned long { kLayoutModeVertical = 0, kLayoutModeHorizontal = 1 };

  // Laid out, vertical, margins maintained, children not scaled.
  UI_LayoutView();

  // Other values than the two modes are ignored.
  void SetLayoutMode(unsigned long inMode);
  unsigned long GetLayoutMode() const;
  void SetScaleChildren(bool inScale) { SetFlag(kScaleChildren, inScale); }
  bool GetScaleChildren() const { return HasFlag(kScaleChildren); }
  void SetLayoutEnabled(bool inEnabled) { SetFlag(kLayoutEnabled, inEnabled); }
  bool GetLayoutEnabled() const { return HasFlag(kLayoutEnabled); }
  void SetMaintainMargins(bool inMaintain) { SetFlag(kMaintainMargins, inMaintain); }
  bool GetMaintainMargins() const { return HasFlag(kMaintainMargins); }

  // Sizes the children to their content and stacks them by the mode. The
  // view keeps its own rectangle; its recommended size then holds the stack.
  void AutoLayout(drawbot::Drawbot* inDrawbot);

  // The stack's extent, with trailing margins equal to the leading ones when
  // margins are maintained; (0, 0) before the first AutoLayout.
  PointF UI_GetRecommendedSize() const override { return mContentSize; }
  void UI_LayoutChildren(const RectF& inOldSize, const RectF& inNewSize) override;

 private:
  void SetFlag(std::uint8_t inFlag, bool inOn);
  bool HasFlag(std::uint8_t inFlag) const { return (UI_GetSubViewLayoutFlags() & inFlag) != 0; }

  PointF mContentSize;
};

using UI_LayoutViewP = boost::intrusive_ptr<UI_LayoutView>;

}  // namespace norvik::layout
