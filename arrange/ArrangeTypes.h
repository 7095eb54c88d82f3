#pragma once
// Value types shared by every arrangement: float geometry, the alignment of a
// group on each axis, and the clamp that keeps bad sizes out of the engine.
#include <algorithm>
#include <cmath>

#include "tarsel/PointT.h"
#include "tarsel/RectT.h"

namespace norvik::arrange {

using PointF = tarsel::geom::PointT<float>;
using RectF = tarsel::geom::RectT<float>;

enum AlignmentHorizontal { kAlignLeft = 0, kAlignHorizontalCenter = 1, kAlignRight = 2 };
enum AlignmentVertical { kAlignTop = 0, kAlignVerticalCenter = 1, kAlignBottom = 2 };

// The largest extent the engine works with. Sizes and margins come from
// client code and views; a value past this is clamped so that sums over
// thousands of children, and products of two of them, stay finite.
inline constexpr float kMaxExtent = 1.0e9f;

// NaN, infinite and negative extents count as 0, so that no NaN reaches a node.
inline float SaneExtent(float inValue) {
  if (!(inValue > 0.0f) || inValue == INFINITY) return 0.0f;
  return inValue < kMaxExtent ? inValue : kMaxExtent;
}

// A coordinate may be negative, but never NaN or infinite.
inline float SaneCoordinate(float inValue) {
  if (!std::isfinite(inValue)) return 0.0f;
  return std::clamp(inValue, -kMaxExtent, kMaxExtent);
}

}  // namespace norvik::arrange
