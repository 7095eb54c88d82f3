#include "layout/ExtraSpace.h"

#include <cmath>

#include "tarsel/Contract.h"

namespace norvik::layout {

namespace {

// One axis of a rectangle, so that each rule is written once for both.
struct Span {
  float& start;
  float& extent;
  float End() const { return start + extent; }
};

Span Horizontal(RectF& r) { return {r.left, r.width}; }
Span Vertical(RectF& r) { return {r.top, r.height}; }

void Pass(Span own, Span decorated) {
  if (decorated.start > own.start) {
    const float end = decorated.End();
    decorated.start = own.End();
    decorated.extent = end - decorated.start;
  } else {
    decorated.extent = own.start - decorated.start;
  }
}

void Keep(Span own, Span decorated) {
  if (decorated.start > own.start) {
    own.extent = decorated.start - own.start;
  } else {
    const float end = own.End();
    own.start = decorated.End();
    own.extent = end - own.start;
  }
}

}  // namespace

void ExtraSpace_Pass::AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) {
  Pass(Vertical(ioFirst), Vertical(ioSecond));
}
void ExtraSpace_Pass::AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) {
  Pass(Horizontal(ioFirst), Horizontal(ioSecond));
}
ExtraSpaceAlgorithmP ExtraSpace_Pass::GetSharedPtr() {
  static const ExtraSpaceAlgorithmP sPass(new ExtraSpace_Pass);
  return sPass;
}

void ExtraSpace_Keep::AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) {
  Keep(Vertical(ioFirst), Vertical(ioSecond));
}
void ExtraSpace_Keep::AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) {
  Keep(Horizontal(ioFirst), Horizontal(ioSecond));
}
ExtraSpaceAlgorithmP ExtraSpace_Keep::GetSharedPtr() {
  static const ExtraSpaceAlgorithmP sKeep(new ExtraSpace_Keep);
  return sKeep;
}

LayoutDecoratorP SharedExtraSpace::CreateNotifierLayout() {
  // The notifier holds this space strongly: the space lives as long as the
  // layout that resets it.
  SharedExtraSpaceP self(this);
  return LayoutDecoratorP(new LayoutNotifier([self](const RectF&) { self->ResetAdjustCount(); }));
}

float SharedExtraSpace::NextShare(float inGap) {
  NRK_CONTRACT(mParticipants > 0);
  const unsigned shares = mParticipants - (mAdjustCount % mParticipants);
  ++mAdjustCount;
  return std::floor(inGap / static_cast<float>(shares));
}

namespace {

// The own piece (first) takes its share of the gap to the decorated piece
// (second); the decorated piece takes the rest of the surplus.
void Share(Span first, Span second, float inPart) {
  if (second.start > first.start) {
    const float end = second.End();
    second.start = first.End() + inPart;
    second.extent = end - second.start;
    first.extent = second.start - first.start;
  } else {
    const float end = first.End();
    second.extent = first.start - inPart - second.start;
    first.start = second.End();
    first.extent = end - first.start;
  }
}

float Gap(Span first, Span second) {
  return second.start > first.start ? second.start - first.End() : first.start - second.End();
}

}  // namespace

void SharedExtraSpace_Horizontal::AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) {
  Span first = Horizontal(ioFirst), second = Horizontal(ioSecond);
  Share(first, second, NextShare(Gap(first, second)));
}
void SharedExtraSpace_Horizontal::AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) {
  ExtraSpace_Pass::GetSharedPtr()->AdjustRectsVertically(ioFirst, ioSecond);
}

void SharedExtraSpace_Vertical::AdjustRectsVertically(RectF& ioFirst, RectF& ioSecond) {
  Span first = Vertical(ioFirst), second = Vertical(ioSecond);
  Share(first, second, NextShare(Gap(first, second)));
}
void SharedExtraSpace_Vertical::AdjustRectsHorizontally(RectF& ioFirst, RectF& ioSecond) {
  ExtraSpace_Pass::GetSharedPtr()->AdjustRectsHorizontally(ioFirst, ioSecond);
}

}  // namespace norvik::layout
