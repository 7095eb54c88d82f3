#include "layout/StrategicLayoutDecorator.h"

#include <cmath>

namespace norvik::layout {

namespace {

ExtraSpaceAlgorithmP KeepOrPass(bool inKeeps) {
  return inKeeps ? ExtraSpace_Keep::GetSharedPtr() : ExtraSpace_Pass::GetSharedPtr();
}

}  // namespace

StrategicLayoutDecorator::StrategicLayoutDecorator(SmartLayoutP inDecorated, const PointF& inOwnSize,
                                                   LayoutPlacementAlgorithmP inPlacement,
                                                   ExtraSpaceAlgorithmP inExtra)
    : LayoutDecorator(std::move(inDecorated)), mOwnSize(SanitizeSize(inOwnSize)) {
  SetLayoutPlacementAlgorithm(std::move(inPlacement));
  SetExtraSpaceAlgorithm(std::move(inExtra));
}

void StrategicLayoutDecorator::SetLayoutPlacementAlgorithm(LayoutPlacementAlgorithmP inPlacement) {
  mPlacement = inPlacement ? std::move(inPlacement) : LayoutPlacementAlgorithmP(new LayoutPlacement_LeftOfDO);
}

void StrategicLayoutDecorator::SetExtraSpaceAlgorithm(ExtraSpaceAlgorithmP inExtra) {
  mExtra = inExtra ? std::move(inExtra) : ExtraSpace_Pass::GetSharedPtr();
}

PointF StrategicLayoutDecorator::GetInitialSize() {
  return mPlacement->GetCombinedSize(CurrentOwnSize(), GetDecoratedObject()->GetInitialSize());
}

void StrategicLayoutDecorator::SetLocation(const RectF& inRect) {
  const SmartLayoutP inner = GetDecoratedObject();
  const PointF innerSize = inner->GetInitialSize();
  RectF local;
  mPlacement->GetRects(SanitizeRect(inRect), CurrentOwnSize(), innerSize, mOwnRect, local, mExtra);
  inner->SetLocation(local);
}

PieceLayoutDecorator::PieceLayoutDecorator(SmartLayoutP inDecorated, SmartLayoutP inPiece,
                                           LayoutPlacementAlgorithmP inPlacement, ExtraSpaceAlgorithmP inExtra)
    : StrategicLayoutDecorator(std::move(inDecorated), PointF(), std::move(inPlacement), std::move(inExtra)),
      mPiece(inPiece ? std::move(inPiece) : EmptyLayout::GetSharedPtr()) {}

PointF PieceLayoutDecorator::CurrentOwnSize() { return mPiece->GetInitialSize(); }

void PieceLayoutDecorator::SetLocation(const RectF& inRect) {
  StrategicLayoutDecorator::SetLocation(inRect);
  mPiece->SetLocation(GetOwnRect());
}

SpacerOnTheLeft::SpacerOnTheLeft(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace)
    : StrategicLayoutDecorator(std::move(inDecorated), PointF(inAmount, 0),
                               LayoutPlacementAlgorithmP(new LayoutPlacement_LeftOfDO), KeepOrPass(inKeepsExtraSpace)) {}

SpacerOnTheRight::SpacerOnTheRight(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace)
    : StrategicLayoutDecorator(std::move(inDecorated), PointF(inAmount, 0),
                               LayoutPlacementAlgorithmP(new LayoutPlacement_RightOfDO),
                               KeepOrPass(inKeepsExtraSpace)) {}

SpacerOnTheTop::SpacerOnTheTop(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace)
    : StrategicLayoutDecorator(std::move(inDecorated), PointF(0, inAmount),
                               LayoutPlacementAlgorithmP(new LayoutPlacement_AboveDO), KeepOrPass(inKeepsExtraSpace)) {}

SpacerOnTheBottom::SpacerOnTheBottom(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace)
    : StrategicLayoutDecorator(std::move(inDecorated), PointF(0, inAmount),
                               LayoutPlacementAlgorithmP(new LayoutPlacement_BelowDO),
                               KeepOrPass(inKeepsExtraSpace)) {}

SpacerOnAllSides::SpacerOnAllSides(SmartLayoutP inDecorated, float inAmount) {
  SmartLayoutP chain = new SpacerOnTheLeft(std::move(inDecorated), inAmount, false);
  chain = new SpacerOnTheRight(chain, inAmount, false);
  chain = new SpacerOnTheTop(chain, inAmount, false);
  chain = new SpacerOnTheBottom(chain, inAmount, false);
  SetDecoratedObject(chain);
}

void AlignHorizontallyCentered::SetLocation(const RectF& inRect) {
  RectF rect = SanitizeRect(inRect);
  const float w = GetDecoratedObject()->GetInitialSize().x;
  if (rect.width > w) {
    rect.left = std::floor(rect.left + rect.width * 0.5f - w * 0.5f);
    rect.width = std::ceil(w);
  }
  LayoutDecorator::SetLocation(rect);
}

void AlignVerticallyCentered::SetLocation(const RectF& inRect) {
  RectF rect = SanitizeRect(inRect);
  const float h = GetDecoratedObject()->GetInitialSize().y;
  if (rect.height > h) {
    rect.top = std::floor(rect.top + rect.height * 0.5f - h * 0.5f);
    rect.height = std::ceil(h);
  }
  LayoutDecorator::SetLocation(rect);
}

LayoutJoiner::LayoutJoiner(SmartLayoutP inFirst, SmartLayoutP inSecond, LayoutPlacementAlgorithmP inPlacement,
                           ExtraSpaceAlgorithmP inExtra)
    : mFirst(inFirst ? std::move(inFirst) : EmptyLayout::GetSharedPtr()),
      mSecond(inSecond ? std::move(inSecond) : EmptyLayout::GetSharedPtr()),
      mPlacement(inPlacement ? std::move(inPlacement) : LayoutPlacementAlgorithmP(new LayoutPlacement_LeftOfDO)),
      mExtra(inExtra ? std::move(inExtra) : ExtraSpace_Pass::GetSharedPtr()) {}

PointF LayoutJoiner::GetInitialSize() {
  return mPlacement->GetCombinedSize(mFirst->GetInitialSize(), mSecond->GetInitialSize());
}

void LayoutJoiner::SetLocation(const RectF& inRect) {
  RectF first, second;
  mPlacement->GetRects(SanitizeRect(inRect), mFirst->GetInitialSize(), mSecond->GetInitialSize(), first, second,
                       mExtra);
  mFirst->SetLocation(first);
  mSecond->SetLocation(second);
}

}  // namespace norvik::layout
