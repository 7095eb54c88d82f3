#pragma once
// A leaf of a fixed initial size that remembers where it was last placed.
#include "layout/SmartLayout.h"

namespace norvik::layout::test {

class RecordingLayout : public SmartLayout {
 public:
  explicit RecordingLayout(float inWidth = 0, float inHeight = 0) : SmartLayout(PointF(inWidth, inHeight)) {}
  void SetLocation(const RectF& inRect) override {
    rect = inRect;
    ++placements;
  }
  RectF rect{-1, -1, -1, -1};
  int placements = 0;
};

using RecordingLayoutP = boost::intrusive_ptr<RecordingLayout>;

inline RecordingLayoutP Leaf(float inWidth, float inHeight) { return new RecordingLayout(inWidth, inHeight); }

}  // namespace norvik::layout::test
