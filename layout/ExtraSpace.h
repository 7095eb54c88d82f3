#pragma once
// Strategies for the surplus between a wrapper's own piece and the layout it
// wraps. The first rectangle is always the own piece, the second the wrapped
// (decorated) one.
#include <boost/intrusive_ptr.hpp>

#include "layout/SmartLayout.h"

namespace norvik::layout {

class ExtraSpaceAlgorithm : public tarsel::utility::RefCountedObject {
 public:
  ~ExtraSpaceAlgorithm() override = default;
  virtual void AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) = 0;
  virtual void AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) = 0;
};

using ExtraSpaceAlgorithmP = boost::intrusive_ptr<ExtraSpaceAlgorithm>;

// The decorated layout takes the surplus.
class ExtraSpace_Pass : public ExtraSpaceAlgorithm {
 public:
  void AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) override;
  void AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) override;
  static ExtraSpaceAlgorithmP GetSharedPtr();
};

// The wrapper's own piece takes the surplus.
class ExtraSpace_Keep : public ExtraSpaceAlgorithm {
 public:
  void AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) override;
  void AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) override;
  static ExtraSpaceAlgorithmP GetSharedPtr();
};

// A fair share of the surplus for each of a counted set of wrappers. The
// count is of the wrappers that share, not of the references held to this
// object. As the chain is walked from the outside in, the first participant
// takes 1/n of its gap rounded down, the next 1/(n-1) of what is left, and the
// last everything that remains, so rounding never loses a pixel.
class SharedExtraSpace : public ExtraSpaceAlgorithm {
 public:
  // One more wrapper shares this space.
  void AddParticipant() { ++mParticipants; }
  unsigned GetParticipantCount() const { return mParticipants; }
  void ResetAdjustCount() { mAdjustCount = 0; }
  // A notifier that resets the adjust count at each placement from the top;
  // the caller sets the layout it wraps.
  LayoutDecoratorP CreateNotifierLayout();

 protected:
  // The piece of inGap that the next participant takes. A space with no
  // participants is a programming error.
  float NextShare(float inGap);

 private:
  unsigned mParticipants = 0;
  unsigned mAdjustCount = 0;
};

using SharedExtraSpaceP = boost::intrusive_ptr<SharedExtraSpace>;

class SharedExtraSpace_Horizontal : public SharedExtraSpace {
 public:
  void AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) override;
  void AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) override;
};

class SharedExtraSpace_Vertical : public SharedExtraSpace {
 public:
  void AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) override;
  void AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) override;
};

}  // namespace norvik::layout
