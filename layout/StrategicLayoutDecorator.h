#pragma once
// A wrapper with a piece of its own beside the layout it wraps: where the
// piece stands is the placement's business, who takes the surplus the
// extra-space strategy's. Spacers are wrappers whose piece is an empty gap.
#include "layout/LayoutPlacement.h"

namespace norvik::layout {

class StrategicLayoutDecorator : public LayoutDecorator {
 public:
  StrategicLayoutDecorator(SmartLayoutP inDecorated, const PointF& inOwnSize,
                           LayoutPlacementAlgorithmP inPlacement, ExtraSpaceAlgorithmP inExtra);

  void SetLocation(const RectF& inRect) override;
  PointF GetInitialSize() override;

  LayoutPlacementAlgorithmP GetLayoutPlacementAlgorithm() const { return mPlacement; }
  void SetLayoutPlacementAlgorithm(LayoutPlacementAlgorithmP inPlacement);
  ExtraSpaceAlgorithmP GetExtraSpaceAlgorithm() const { return mExtra; }
  void SetExtraSpaceAlgorithm(ExtraSpaceAlgorithmP inExtra);

  PointF GetOwnSize() const { return mOwnSize; }
  // Where the own piece went at the last placement.
  RectF GetOwnRect() const { return mOwnRect; }

 protected:
  // The own piece's size at this placement.
  virtual PointF CurrentOwnSize() { return mOwnSize; }

 private:
  PointF mOwnSize;
  RectF mOwnRect;
  LayoutPlacementAlgorithmP mPlacement;
  ExtraSpaceAlgorithmP mExtra;
};

using StrategicLayoutDecoratorP = boost::intrusive_ptr<StrategicLayoutDecorator>;

// A piece that is itself a layout: its own rectangle goes on to that layout.
// The builder stacks pieces this way.
class PieceLayoutDecorator : public StrategicLayoutDecorator {
 public:
  PieceLayoutDecorator(SmartLayoutP inDecorated, SmartLayoutP inPiece, LayoutPlacementAlgorithmP inPlacement,
                       ExtraSpaceAlgorithmP inExtra);
  void SetLocation(const RectF& inRect) override;
  SmartLayoutP GetPiece() const { return mPiece; }

 protected:
  PointF CurrentOwnSize() override;

 private:
  SmartLayoutP mPiece;
};

// A gap on one side; with inKeepsExtraSpace the gap grows with the surplus,
// else the wrapped layout does.
class SpacerOnTheLeft : public StrategicLayoutDecorator {
 public:
  SpacerOnTheLeft(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace);
};
class SpacerOnTheRight : public StrategicLayoutDecorator {
 public:
  SpacerOnTheRight(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace);
};
class SpacerOnTheTop : public StrategicLayoutDecorator {
 public:
  SpacerOnTheTop(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace);
};
class SpacerOnTheBottom : public StrategicLayoutDecorator {
 public:
  SpacerOnTheBottom(SmartLayoutP inDecorated, float inAmount, bool inKeepsExtraSpace);
};

// The same margin on all four sides, the wrapped layout taking any surplus.
class SpacerOnAllSides : public LayoutDecorator {
 public:
  SpacerOnAllSides(SmartLayoutP inDecorated, float inAmount);
};

// Centres the wrapped layout at its initial width (height) when the area is
// wider (taller); a narrower area passes unchanged.
class AlignHorizontallyCentered : public LayoutDecorator {
 public:
  using LayoutDecorator::LayoutDecorator;
  void SetLocation(const RectF& inRect) override;
};

class AlignVerticallyCentered : public LayoutDecorator {
 public:
  using LayoutDecorator::LayoutDecorator;
  void SetLocation(const RectF& inRect) override;
};

// Two layouts side by side (or stacked) by a placement: the first takes the
// placement's own piece, the second the decorated one.
class LayoutJoiner : public SmartLayout {
 public:
  LayoutJoiner(SmartLayoutP inFirst, SmartLayoutP inSecond, LayoutPlacementAlgorithmP inPlacement,
               ExtraSpaceAlgorithmP inExtra);
  void SetLocation(const RectF& inRect) override;
  PointF GetInitialSize() override;

 private:
  SmartLayoutP mFirst;
  SmartLayoutP mSecond;
  LayoutPlacementAlgorithmP mPlacement;
  ExtraSpaceAlgorithmP mExtra;
};

}  // namespace norvik::layout
