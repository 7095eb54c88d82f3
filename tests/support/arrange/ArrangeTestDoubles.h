#pragma once
// Doubles for the arrangement engine: a leaf that records what it is given,
// and an arrangement whose measures are set by the test.
#include <vector>

#include <boost/function.hpp>

#include "arrange/ArrangeableGroup.h"
#include "arrange/Single.h"

namespace norvik::arrange::test {

struct LeafSizes {
  float naturalWidth = 10.0f, naturalHeight = 10.0f;
  float minWidth = -1.0f, minHeight = -1.0f;  // -1: the natural size
  float maxWidth = -1.0f;                     // -1: no limit when expanding
  bool expandsHorizontally = false, expandsVertically = false;
  float left = 0.0f, right = 0.0f, top = 0.0f, bottom = 0.0f;
};

class RecordingLeaf : public Single {
 public:
  explicit RecordingLeaf(LeafSizes inSizes = {}) : sizes(inSizes) {}

  float NaturalWidth() const override { return sizes.naturalWidth; }
  float NaturalHeight() const override { return sizes.naturalHeight; }
  float MinWidth() const override { return sizes.minWidth < 0 ? sizes.naturalWidth : sizes.minWidth; }
  float MinHeight() const override { return sizes.minHeight < 0 ? sizes.naturalHeight : sizes.minHeight; }
  float ExpandedWidth(float inWidth) const override {
    const float width = Single::ExpandedWidth(inWidth);
    return sizes.maxWidth >= 0 && width > sizes.maxWidth ? sizes.maxWidth : width;
  }
  bool HorizontallyExpandable() const override { return sizes.expandsHorizontally; }
  bool VerticallyExpandable() const override { return sizes.expandsVertically; }
  float LeftMargin() const override { return sizes.left; }
  float RightMargin() const override { return sizes.right; }
  float TopMargin() const override { return sizes.top; }
  float BottomMargin() const override { return sizes.bottom; }
  PointF Place(RectF const& inRect) override {
    placed.push_back(inRect);
    if (onPlace) onPlace();  // may delete this leaf: touch nothing after it
    return inRect.Size();
  }

  LeafSizes sizes;
  std::vector<RectF> placed;
  boost::function<void()> onPlace;
};

using TestRow = WithChildren<Row>;
using TestColumn = WithChildren<Column>;

// An arrangement whose measures the test states directly.
class FixedArrangement : public impl::IArrangement {
 public:
  struct Measures {
    float minWidth = 0, minHeight = 0, naturalWidth = 0, naturalHeight = 0, waste = 0, overflow = 0;
  };
  explicit FixedArrangement(Measures inMeasures) : m(inMeasures) {}
  PointF Arrange(RectF const& inRect) override { return inRect.Size(); }
  bool HorizontallyExpandable() const override { return false; }
  bool VerticallyExpandable() const override { return false; }
  float MinWidth() const override { return m.minWidth; }
  float MinHeight() const override { return m.minHeight; }
  float NaturalWidth() const override { return m.naturalWidth; }
  float NaturalHeight() const override { return m.naturalHeight; }
  float ExpandedWidth(float) const override { return m.naturalWidth; }
  float ExpandedHeight(float) const override { return m.naturalHeight; }
  float OverflowArea(PointF const&) const override { return m.overflow; }
  float WastedArea(PointF const&) const override { return m.waste; }
  bool IsGroupLevel() const override { return true; }
  bool Dominates(IArrangement const&) const override { return false; }
  Measures m;
};

// An element whose candidates the test puts in its set.
class CandidateElement : public IArrangeable {
 public:
  impl::ArrangementSet& ArrangementsSelf() override { return set; }
  impl::ArrangementSet set;
};

}  // namespace norvik::arrange::test
