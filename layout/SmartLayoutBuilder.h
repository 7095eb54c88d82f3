#pragma once
// Composes a layout like an onion: each Add wraps what exists so far in one
// more rule. Gaps and pieces added with the sharing flag split the surplus
// along their axis evenly; a run of sharing ends where the direction changes
// and at GetLayout, so each run shares only among itself. A builder is used
// once.
#include "layout/StrategicLayoutDecorator.h"

namespace norvik::ui {
class UI_Node;
}

namespace norvik::layout {

class SmartLayoutBuilder {
 public:
  // Where the added piece stands on the cross axis.
  enum LayoutSpacing {
    kSpacingNone = 0,
    kSpacingCentered = 1,
    kSpacingNearEdge = 2,
    kSpacingFarEdge = 3,
  };

  SmartLayoutBuilder();
  explicit SmartLayoutBuilder(SmartLayoutP inLayout);

  void SetLayout(SmartLayoutP inLayout);
  // Closes the open shared runs and returns the result.
  SmartLayoutP GetLayout();

  void AddLayout_Left(SmartLayoutP inPiece, bool inSharesExtraSpace = false, LayoutSpacing inSpacing = kSpacingNone);
  void AddLayout_Right(SmartLayoutP inPiece, bool inSharesExtraSpace = false, LayoutSpacing inSpacing = kSpacingNone);
  void AddLayout_Top(SmartLayoutP inPiece, bool inSharesExtraSpace = false, LayoutSpacing inSpacing = kSpacingNone);
  void AddLayout_Bottom(SmartLayoutP inPiece, bool inSharesExtraSpace = false,
                        LayoutSpacing inSpacing = kSpacingNone);

  using NodeP = boost::intrusive_ptr<ui::UI_Node>;
  void AddUINode_Left(NodeP inNode, const PointF& inSize, bool inSharesExtraSpace = false,
                      LayoutSpacing inSpacing = kSpacingNone);
  void AddUINode_Right(NodeP inNode, const PointF& inSize, bool inSharesExtraSpace = false,
                       LayoutSpacing inSpacing = kSpacingNone);
  void AddUINode_Top(NodeP inNode, const PointF& inSize, bool inSharesExtraSpace = false,
                     LayoutSpacing inSpacing = kSpacingNone);
  void AddUINode_Bottom(NodeP inNode, const PointF& inSize, bool inSharesExtraSpace = false,
                        LayoutSpacing inSpacing = kSpacingNone);

  void AddSpacer_Left(float inAmount, bool inSharesExtraSpace = false);
  void AddSpacer_Right(float inAmount, bool inSharesExtraSpace = false);
  void AddSpacer_Top(float inAmount, bool inSharesExtraSpace = false);
  void AddSpacer_Bottom(float inAmount, bool inSharesExtraSpace = false);
  void AddSpacer_AllSides(float inAmount);

  void HorizontallyCenter();
  void VerticallyCenter();

  void FinishHorizontalSpacing();
  void FinishVerticalSpacing();

 private:
  enum class Direction { kHorizontal, kVertical };
  // The open shared space of a direction, made on first use; each call
  // counts one more participant.
  ExtraSpaceAlgorithmP JoinSharedSpace(Direction inDirection);
  void AddPiece(SmartLayoutP inPiece, bool inShares, LayoutSpacing inSpacing, LayoutPlacementAlgorithmP inPlacement,
                Direction inDirection);
  void AddSpacer(StrategicLayoutDecoratorP inSpacer, bool inShares, Direction inDirection);
  void Finish(SharedExtraSpaceP& ioOpen);

  SmartLayoutP mLayout;
  SharedExtraSpaceP mHorizontal;
  SharedExtraSpaceP mVertical;
};

}  // namespace norvik::layout
