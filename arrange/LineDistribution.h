#pragma once
// Sharing the space of a line (a row, or a column seen along its own axis)
// among its children. A pure function of the children's measures: it returns
// the extents, and the arrangement applies them in a separate step.
#include <vector>

#include "arrange/IArrangement.h"

namespace norvik::arrange::impl {

// The two axes seen from a line: main is the axis the children follow.
struct LineAxis {
  bool vertical = false;

  float Main(PointF const& p) const { return vertical ? p.y : p.x; }
  float Cross(PointF const& p) const { return vertical ? p.x : p.y; }
  PointF Point(float inMain, float inCross) const {
    return vertical ? PointF(inCross, inMain) : PointF(inMain, inCross);
  }
  RectF Rect(float inMain, float inCross, float inMainLength, float inCrossLength) const {
    return vertical ? RectF(inCross, inMain, inCrossLength, inMainLength)
                    : RectF(inMain, inCross, inMainLength, inCrossLength);
  }
  float MinMain(IArrangement const& a) const { return vertical ? a.MinHeight() : a.MinWidth(); }
  float MinCross(IArrangement const& a) const { return vertical ? a.MinWidth() : a.MinHeight(); }
  float NaturalMain(IArrangement const& a) const { return vertical ? a.NaturalHeight() : a.NaturalWidth(); }
  float NaturalCross(IArrangement const& a) const { return vertical ? a.NaturalWidth() : a.NaturalHeight(); }
  float ExpandedMain(IArrangement const& a, float t) const { return vertical ? a.ExpandedHeight(t) : a.ExpandedWidth(t); }
  float ExpandedCross(IArrangement const& a, float t) const { return vertical ? a.ExpandedWidth(t) : a.ExpandedHeight(t); }
  bool ExpandsMain(IArrangement const& a) const {
    return vertical ? a.VerticallyExpandable() : a.HorizontallyExpandable();
  }
  bool ExpandsCross(IArrangement const& a) const {
    return vertical ? a.HorizontallyExpandable() : a.VerticallyExpandable();
  }
};

struct LineRecord {
  float main = 0.0f;   // the extent along the line
  float cross = 0.0f;  // the extent across it
  bool expands = false;
};

struct LineResult {
  std::vector<LineRecord> records;
  float usedMain = 0.0f;
  float usedCross = 0.0f;
  int passes = 0;
};

// Below this a remainder is left unused, and two sizes count as one.
inline constexpr float kDistributionEpsilon = 0.0001f;
// Children whose limits never settle stop the sharing after this many passes.
inline constexpr int kMaxDistributionPasses = 10000;

// Distributes a content extent (inMain, inCross) among the children. inExtra
// is the room beyond the children's minimum, positive or negative; it is
// shared in proportion to the current extents of the expanding children, and
// whoever reaches a limit drops out while the rest goes round again.
LineResult DistributeLine(std::vector<ArrangementPtr> const& inChildren, LineAxis inAxis, float inMain,
                          float inCross, float inExtra);

}  // namespace norvik::arrange::impl
