#include "arrange/GroupArrangement.h"

#include <algorithm>
#include <cmath>
#include <typeinfo>

#include "arrange/ArrangeableGroup.h"

namespace norvik::arrange::impl {

GroupArrangement::GroupArrangement(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                                   std::vector<ISeparator*> const& inSeparators, bool inGroupLevel, LineAxis inAxis)
    : mGroup(&inGroup), mAxis(inAxis), mChildren(inChildren), mSeparators(inSeparators), mGroupLevel(inGroupLevel) {
  mSeparators.resize(mChildren.empty() ? 0 : mChildren.size() - 1, nullptr);
  ReadGroup();
  ComputeMinimum();
  std::uint64_t signature = reinterpret_cast<std::uintptr_t>(mGroup) * 31 + (mAxis.vertical ? 7 : 3) + mGroupLevel;
  for (const ArrangementPtr& child : mChildren) signature = signature * 1099511628211ull ^ child->Signature();
  mSignature = signature;
}

// The group's properties are read once: every setter of a group invalidates
// it, and the rebuild that follows makes new arrangements.
void GroupArrangement::ReadGroup() {
  const bool vertical = mAxis.vertical;
  mSpacing = SaneExtent(vertical ? mGroup->VerticalSpacing() : mGroup->HorizontalSpacing());
  const int horizontal = mGroup->HorizontalAlignment();
  const int verticalAlignment = mGroup->VerticalAlignment();
  mMainAlignment = vertical ? verticalAlignment : horizontal;
  mCrossAlignment = vertical ? horizontal : verticalAlignment;
  if (!mGroupLevel) return;
  const float left = SaneExtent(mGroup->LeftMargin()), right = SaneExtent(mGroup->RightMargin());
  const float top = SaneExtent(mGroup->TopMargin()), bottom = SaneExtent(mGroup->BottomMargin());
  mMargins = vertical ? Margins{top, bottom, left, right} : Margins{left, right, top, bottom};
}

float GroupArrangement::Spacings() const {
  return mChildren.empty() ? 0.0f : mSpacing * static_cast<float>(mChildren.size() - 1);
}

void GroupArrangement::ComputeMinimum() {
  float sum = 0.0f, largest = 0.0f;
  for (const ArrangementPtr& child : mChildren) {
    sum += mAxis.MinMain(*child);
    largest = std::max(largest, mAxis.MinCross(*child));
  }
  const PointF minimum = mAxis.Point(sum + Spacings() + mMargins.Main(), largest + mMargins.Cross());
  mMinWidth = minimum.x;
  mMinHeight = minimum.y;
}

void GroupArrangement::Prepare() {
  if (mPrepared) return;
  for (const ArrangementPtr& child : mChildren) child->Prepare();
  ComputeNaturalWidth();
  ComputeNaturalHeight();
  mHorizontallyExpandable = std::any_of(mChildren.begin(), mChildren.end(),
                                        [](const ArrangementPtr& c) { return c->HorizontallyExpandable(); });
  mVerticallyExpandable = std::any_of(mChildren.begin(), mChildren.end(),
                                      [](const ArrangementPtr& c) { return c->VerticallyExpandable(); });
  mPrepared = true;
}

void GroupArrangement::ComputeNaturalWidth() {
  float value = 0.0f;
  for (const ArrangementPtr& child : mChildren)
    value = mAxis.vertical ? std::max(value, child->NaturalWidth()) : value + child->NaturalWidth();
  mNaturalWidth = mAxis.vertical ? value + mMargins.Cross() : value + Spacings() + mMargins.Main();
}

void GroupArrangement::ComputeNaturalHeight() {
  float value = 0.0f;
  for (const ArrangementPtr& child : mChildren)
    value = mAxis.vertical ? value + child->NaturalHeight() : std::max(value, child->NaturalHeight());
  mNaturalHeight = mAxis.vertical ? value + Spacings() + mMargins.Main() : value + mMargins.Cross();
}

void GroupArrangement::Distribute(float inMain, float inCross) const {
  if (mDistributed && std::fabs(inMain - mLastDistributed.x) < kDistributionEpsilon &&
      std::fabs(inCross - mLastDistributed.y) < kDistributionEpsilon)
    return;
  mLastDistributed = PointF(inMain, inCross);
  mDistributed = true;
  const float minimumMain = mAxis.Main(PointF(mMinWidth, mMinHeight)) - mMargins.Main();
  mDistribution = DistributeLine(mChildren, mAxis, inMain, inCross, inMain - minimumMain);
}

float GroupArrangement::AlignOffset(int inAlignment, float inFree) const {
  if (inAlignment == 1) return inFree * 0.5f;
  if (inAlignment == 2) return inFree;
  return 0.0f;
}

void GroupArrangement::PlaceSeparator(std::size_t inIndex, float inPos, RectF const& inPrevious,
                                      RectF const& inCurrent) const {
  ISeparator* separator = mSeparators[inIndex - 1];
  if (!separator) return;
  // Across the line the separator spans the shorter neighbour; a tie takes
  // the current child.
  const float previousCross = mAxis.Cross(inPrevious.Size());
  const RectF& shorter = previousCross < mAxis.Cross(inCurrent.Size()) ? inPrevious : inCurrent;
  const float crossPos = mAxis.Cross(PointF(shorter.left, shorter.top));
  separator->Arrange(mAxis.Rect(inPos - mSpacing, crossPos, mSpacing, mAxis.Cross(shorter.Size())));
}

PointF GroupArrangement::Arrange(RectF const& inRect) {
  Prepare();
  const float availMain = std::max(0.0f, mAxis.Main(inRect.Size()) - mMargins.Main());
  const float availCross = std::max(0.0f, mAxis.Cross(inRect.Size()) - mMargins.Cross());
  Distribute(availMain, availCross);
  const LineResult distribution = mDistribution;  // a child may re-enter and redistribute
  const PointF origin(inRect.left, inRect.top);
  const float start = mAxis.Main(origin) + mMargins.mainBefore;
  const float crossStart = mAxis.Cross(origin) + mMargins.crossBefore;
  float pos = start + AlignOffset(mMainAlignment, availMain - distribution.usedMain);
  if (mGroupLevel)
    mGroup->Position(mAxis.Point(pos, crossStart + AlignOffset(mCrossAlignment, availCross - distribution.usedCross)));
  float largestCross = 0.0f;
  RectF previous;
  for (std::size_t i = 0; i < mChildren.size(); ++i) {
    const LineRecord& record = distribution.records[i];
    if (i > 0) pos += mSpacing;
    const float crossPos = crossStart + AlignOffset(mCrossAlignment, availCross - record.cross);
    const PointF used = mChildren[i]->Arrange(mAxis.Rect(pos, crossPos, record.main, record.cross));
    const RectF current = mAxis.Rect(pos, crossPos, mAxis.Main(used), mAxis.Cross(used));
    if (i > 0) PlaceSeparator(i, pos, previous, current);
    previous = current;
    pos += mAxis.Main(used);
    largestCross = std::max(largestCross, mAxis.Cross(used));
  }
  // The margins are part of what the group uses, so that a group that takes
  // its size from the result keeps its margins.
  const PointF result = mAxis.Point(std::max(availMain, pos - start) + mMargins.Main(),
                                    std::max(availCross, largestCross) + mMargins.Cross());
  if (mGroupLevel) mGroup->SetDimensions(result);
  return result;
}

float GroupArrangement::ExpandedWidth(float inWidth) const {
  if (!mAxis.vertical) {
    const float avail = inWidth - mMargins.Main();
    float sum = 0.0f;
    for (std::size_t i = 0; i < mChildren.size() && sum < avail; ++i) sum += mChildren[i]->ExpandedWidth(avail - sum);
    return std::min(avail, sum + Spacings()) + mMargins.Main();
  }
  float largest = 0.0f;
  for (const ArrangementPtr& child : mChildren)
    largest = std::max(largest, child->ExpandedWidth(inWidth - mMargins.Cross()));
  return largest + mMargins.Cross();
}

float GroupArrangement::ExpandedHeight(float inHeight) const {
  if (mAxis.vertical) {
    const float avail = inHeight - mMargins.Main();
    float sum = 0.0f;
    for (std::size_t i = 0; i < mChildren.size() && sum < avail; ++i)
      sum += mChildren[i]->ExpandedHeight(avail - sum);
    return std::min(avail, sum + Spacings()) + mMargins.Main();
  }
  float largest = 0.0f;
  for (const ArrangementPtr& child : mChildren)
    largest = std::max(largest, child->ExpandedHeight(inHeight - mMargins.Cross()));
  return largest + mMargins.Cross();
}

float GroupArrangement::OverflowArea(PointF const& inSize) const {
  const float availMain = mAxis.Main(inSize) - mMargins.Main();
  const float availCross = mAxis.Cross(inSize) - mMargins.Cross();
  float area = 0.0f, sum = 0.0f;
  for (std::size_t i = 0; i < mChildren.size(); ++i) {
    const float minMain = mAxis.MinMain(*mChildren[i]), minCross = mAxis.MinCross(*mChildren[i]);
    if (sum + minMain > availMain) area += minCross * (minMain - std::max(0.0f, availMain - sum));
    area += minMain * std::max(0.0f, minCross - availCross);
    sum += minMain + (i > 0 ? mSpacing : 0.0f);
  }
  return area;
}

float GroupArrangement::WastedArea(PointF const& inSize) const {
  const float availMain = std::max(0.0f, mAxis.Main(inSize) - mMargins.Main());
  const float availCross = std::max(0.0f, mAxis.Cross(inSize) - mMargins.Cross());
  Distribute(availMain, availCross);
  float waste = 0.0f, sum = 0.0f;
  for (std::size_t i = 0; i < mChildren.size(); ++i) {
    const float main = mDistribution.records[i].main;
    waste += mChildren[i]->WastedArea(mAxis.Point(main, availCross));
    if (i > 0) {
      waste += mSpacing * availCross;
      sum += mSpacing;
    }
    sum += main;
  }
  waste += (availMain - sum) * availCross;
  return waste + mMargins.Main() * mAxis.Cross(inSize) + mMargins.Cross() * mAxis.Main(inSize);
}

bool GroupArrangement::Dominates(IArrangement const& inOther) const {
  if (typeid(inOther) != typeid(*this)) return false;
  auto& other = static_cast<GroupArrangement const&>(inOther);
  if (other.mGroup != mGroup || other.mGroupLevel != mGroupLevel || other.mAxis.vertical != mAxis.vertical ||
      other.mChildren.size() != mChildren.size() || other.mSeparators != mSeparators || other.mSpacing != mSpacing ||
      other.mMainAlignment != mMainAlignment || other.mCrossAlignment != mCrossAlignment ||
      other.mMargins.mainBefore != mMargins.mainBefore || other.mMargins.mainAfter != mMargins.mainAfter ||
      other.mMargins.crossBefore != mMargins.crossBefore || other.mMargins.crossAfter != mMargins.crossAfter)
    return false;
  for (std::size_t i = 0; i < mChildren.size(); ++i)
    if (mChildren[i] != other.mChildren[i] && !mChildren[i]->Dominates(*other.mChildren[i])) return false;
  return true;
}

}  // namespace norvik::arrange::impl
