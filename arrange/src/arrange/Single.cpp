#include "arrange/Single.h"

#include <algorithm>

namespace norvik::arrange {

Single::Single(IArrangeable* inParent)
    : IArrangeable(inParent), mSet(new impl::ArrangementSet), mLifeCell(std::make_shared<Single*>(this)) {}

Single::~Single() { *mLifeCell = nullptr; }

float Single::ExpandedWidth(float inWidth) const { return HorizontallyExpandable() ? inWidth : NaturalWidth(); }

float Single::ExpandedHeight(float inHeight) const { return VerticallyExpandable() ? inHeight : NaturalHeight(); }

void Single::RebuildSelf() {
  mSet->clear();
  mSet->AddArrangement(new impl::SingleArrangement(*this));
}

impl::ArrangementSet& Single::ArrangementsSelf() { return *mSet; }

namespace impl {

SingleArrangement::SingleArrangement(Single& inSingle)
    : mSingle(inSingle.LifeCell()),
      mHorizontallyExpandable(inSingle.HorizontallyExpandable()),
      mVerticallyExpandable(inSingle.VerticallyExpandable()),
      mLeft(SaneExtent(inSingle.LeftMargin())),
      mTop(SaneExtent(inSingle.TopMargin())),
      mHorizontalMargins(mLeft + SaneExtent(inSingle.RightMargin())),
      mVerticalMargins(mTop + SaneExtent(inSingle.BottomMargin())) {
  mNaturalWidth = SaneExtent(inSingle.NaturalWidth());
  mNaturalHeight = SaneExtent(inSingle.NaturalHeight());
  // A minimum above the natural size would make the natural size unreachable.
  mMinWidth = std::min(SaneExtent(inSingle.MinWidth()), mNaturalWidth) + mHorizontalMargins;
  mMinHeight = std::min(SaneExtent(inSingle.MinHeight()), mNaturalHeight) + mVerticalMargins;
  mNaturalWidth += mHorizontalMargins;
  mNaturalHeight += mVerticalMargins;
}

PointF SingleArrangement::Arrange(RectF const& inRect) {
  Single* single = *mSingle;
  if (!single) return {0.0f, 0.0f};
  const RectF inner(inRect.left + mLeft, inRect.top + mTop, std::max(0.0f, inRect.width - mHorizontalMargins),
                    std::max(0.0f, inRect.height - mVerticalMargins));
  const PointF used = single->Place(inner);
  return {SaneExtent(used.x) + mHorizontalMargins, SaneExtent(used.y) + mVerticalMargins};
}

float SingleArrangement::ExpandedWidth(float inWidth) const {
  Single* single = *mSingle;
  if (!single) return mNaturalWidth;
  return SaneExtent(single->ExpandedWidth(std::max(0.0f, inWidth - mHorizontalMargins))) + mHorizontalMargins;
}

float SingleArrangement::ExpandedHeight(float inHeight) const {
  Single* single = *mSingle;
  if (!single) return mNaturalHeight;
  return SaneExtent(single->ExpandedHeight(std::max(0.0f, inHeight - mVerticalMargins))) + mVerticalMargins;
}

bool SingleArrangement::Dominates(IArrangement const& inOther) const {
  auto other = dynamic_cast<SingleArrangement const*>(&inOther);
  return other && *other->mSingle == *mSingle && other->mHorizontallyExpandable == mHorizontallyExpandable &&
         other->mVerticallyExpandable == mVerticallyExpandable && other->mLeft == mLeft && other->mTop == mTop &&
         other->mHorizontalMargins == mHorizontalMargins && other->mVerticalMargins == mVerticalMargins &&
         other->mMinWidth == mMinWidth && other->mMinHeight == mMinHeight &&
         other->mNaturalWidth == mNaturalWidth && other->mNaturalHeight == mNaturalHeight;
}

}  // namespace impl
}  // namespace norvik::arrange
