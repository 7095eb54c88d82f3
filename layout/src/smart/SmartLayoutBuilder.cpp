#include "layout/SmartLayoutBuilder.h"

#include "layout/UI_NodeLayout.h"

namespace norvik::layout {

SmartLayoutBuilder::SmartLayoutBuilder() : mLayout(EmptyLayout::GetSharedPtr()) {}

SmartLayoutBuilder::SmartLayoutBuilder(SmartLayoutP inLayout) { SetLayout(std::move(inLayout)); }

void SmartLayoutBuilder::SetLayout(SmartLayoutP inLayout) {
  mLayout = inLayout ? std::move(inLayout) : EmptyLayout::GetSharedPtr();
}

SmartLayoutP SmartLayoutBuilder::GetLayout() {
  FinishHorizontalSpacing();
  FinishVerticalSpacing();
  return mLayout;
}

void SmartLayoutBuilder::Finish(SharedExtraSpaceP& ioOpen) {
  if (!ioOpen) return;
  LayoutDecoratorP notifier = ioOpen->CreateNotifierLayout();
  notifier->SetDecoratedObject(mLayout);
  mLayout = notifier;
  ioOpen.reset();
}

void SmartLayoutBuilder::FinishHorizontalSpacing() { Finish(mHorizontal); }
void SmartLayoutBuilder::FinishVerticalSpacing() { Finish(mVertical); }

ExtraSpaceAlgorithmP SmartLayoutBuilder::JoinSharedSpace(Direction inDirection) {
  SharedExtraSpaceP& open = inDirection == Direction::kHorizontal ? mHorizontal : mVertical;
  if (!open) {
    if (inDirection == Direction::kHorizontal)
      open = new SharedExtraSpace_Horizontal;
    else
      open = new SharedExtraSpace_Vertical;
  }
  open->AddParticipant();
  return open;
}

void SmartLayoutBuilder::AddPiece(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing,
                                  LayoutPlacementAlgorithmP inPlacement, Direction inDirection) {
  const bool horizontal = inDirection == Direction::kHorizontal;
  // A change of direction ends the other direction's run of shared gaps.
  if (horizontal)
    FinishVerticalSpacing();
  else
    FinishHorizontalSpacing();
  SmartLayoutP piece = inPiece ? std::move(inPiece) : EmptyLayout::GetSharedPtr();
  switch (inSpacing) {
    case kSpacingCentered:
      piece = horizontal ? SmartLayoutP(new AlignVerticallyCentered(piece))
                         : SmartLayoutP(new AlignHorizontallyCentered(piece));
      break;
    case kSpacingNearEdge:
      piece = horizontal ? SmartLayoutP(new SpacerOnTheBottom(piece, 0, true))
                         : SmartLayoutP(new SpacerOnTheRight(piece, 0, true));
      break;
    case kSpacingFarEdge:
      piece = horizontal ? SmartLayoutP(new SpacerOnTheTop(piece, 0, true))
                         : SmartLayoutP(new SpacerOnTheLeft(piece, 0, true));
      break;
    case kSpacingNone:
      break;
  }
  const ExtraSpaceAlgorithmP extra = inShares ? JoinSharedSpace(inDirection) : ExtraSpace_Pass::GetSharedPtr();
  mLayout = new PieceLayoutDecorator(mLayout, piece, std::move(inPlacement), extra);
}

void SmartLayoutBuilder::AddLayout_Left(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing) {
  AddPiece(std::move(inPiece), inShares, inSpacing, new LayoutPlacement_LeftOfDO, Direction::kHorizontal);
}
void SmartLayoutBuilder::AddLayout_Right(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing) {
  AddPiece(std::move(inPiece), inShares, inSpacing, new LayoutPlacement_RightOfDO, Direction::kHorizontal);
}
void SmartLayoutBuilder::AddLayout_Top(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing) {
  AddPiece(std::move(inPiece), inShares, inSpacing, new LayoutPlacement_AboveDO, Direction::kVertical);
}
void SmartLayoutBuilder::AddLayout_Bottom(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing) {
  AddPiece(std::move(inPiece), inShares, inSpacing, new LayoutPlacement_BelowDO, Direction::kVertical);
}

void SmartLayoutBuilder::AddUINode_Left(NodeP inNode, const PointF& inSize, bool inShares, LayoutSpacing inSpacing) {
  AddLayout_Left(new UI_NodeLayout(std::move(inNode), inSize), inShares, inSpacing);
}
void SmartLayoutBuilder::AddUINode_Right(NodeP inNode, const PointF& inSize, bool inShares,
                                         LayoutSpacing inSpacing) {
  AddLayout_Right(new UI_NodeLayout(std::move(inNode), inSize), inShares, inSpacing);
}
void SmartLayoutBuilder::AddUINode_Top(NodeP inNode, const PointF& inSize, bool inShares, LayoutSpacing inSpacing) {
  AddLayout_Top(new UI_NodeLayout(std::move(inNode), inSize), inShares, inSpacing);
}
void SmartLayoutBuilder::AddUINode_Bottom(NodeP inNode, const PointF& inSize, bool inShares,
                                          LayoutSpacing inSpacing) {
  AddLayout_Bottom(new UI_NodeLayout(std::move(inNode), inSize), inShares, inSpacing);
}

void SmartLayoutBuilder::AddSpacer(StrategicLayoutDecoratorP inSpacer, bool inShares, Direction inDirection) {
  if (inShares) inSpacer->SetExtraSpaceAlgorithm(JoinSharedSpace(inDirection));
  mLayout = inSpacer;
}

void SmartLayoutBuilder::AddSpacer_Left(float inAmount, bool inShares) {
  FinishVerticalSpacing();
  AddSpacer(new SpacerOnTheLeft(mLayout, inAmount, false), inShares, Direction::kHorizontal);
}
void SmartLayoutBuilder::AddSpacer_Right(float inAmount, bool inShares) {
  FinishVerticalSpacing();
  AddSpacer(new SpacerOnTheRight(mLayout, inAmount, false), inShares, Direction::kHorizontal);
}
void SmartLayoutBuilder::AddSpacer_Top(float inAmount, bool inShares) {
  FinishHorizontalSpacing();
  AddSpacer(new SpacerOnTheTop(mLayout, inAmount, false), inShares, Direction::kVertical);
}
void SmartLayoutBuilder::AddSpacer_Bottom(float inAmount, bool inShares) {
  FinishHorizontalSpacing();
  AddSpacer(new SpacerOnTheBottom(mLayout, inAmount, false), inShares, Direction::kVertical);
}

void SmartLayoutBuilder::AddSpacer_AllSides(float inAmount) {
  // The margin stands outside every run of shared gaps.
  FinishHorizontalSpacing();
  FinishVerticalSpacing();
  mLayout = new SpacerOnAllSides(mLayout, inAmount);
}

void SmartLayoutBuilder::HorizontallyCenter() {
  FinishHorizontalSpacing();
  FinishVerticalSpacing();
  mLayout = new AlignHorizontallyCentered(mLayout);
}

void SmartLayoutBuilder::VerticallyCenter() {
  FinishHorizontalSpacing();
  FinishVerticalSpacing();
  mLayout = new AlignVerticallyCentered(mLayout);
}

}  // namespace norvik::layout
