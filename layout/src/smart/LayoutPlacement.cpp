#include "layout/LayoutPlacement.h"

#include <algorithm>

namespace norvik::layout {

namespace {

enum class Side { kNear, kFar };
enum class Axis { kHorizontal, kVertical };

float Extent(const PointF& p, Axis a) { return a == Axis::kHorizontal ? p.x : p.y; }
float& Start(RectF& r, Axis a) { return a == Axis::kHorizontal ? r.left : r.top; }
float& Length(RectF& r, Axis a) { return a == Axis::kHorizontal ? r.width : r.height; }

// The own piece at the near (left, top) or far (right, bottom) end of the
// area on one axis; on the cross axis both pieces span the area.
void PlaceOnAxis(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize, RectF& outOwn,
                 RectF& outDecorated, ExtraSpaceAlgorithm* inExtra, Axis inAxis, Side inSide) {
  RectF area = inArea;
  const float areaStart = Start(area, inAxis), areaLength = Length(area, inAxis);
  const float own = Extent(inOwnSize, inAxis), decorated = Extent(inDecoratedSize, inAxis);
  if (own > areaLength) {
    // A neighbour that does not fit pushes the decorated layout out.
    outOwn = area;
    outDecorated = RectF();
    return;
  }
  outOwn = area;
  outDecorated = area;
  Length(outOwn, inAxis) = own;
  if (inSide == Side::kFar) Start(outOwn, inAxis) = areaStart + areaLength - own;
  if (areaLength <= own + decorated) {
    Length(outDecorated, inAxis) = areaLength - own;
    Start(outDecorated, inAxis) = inSide == Side::kNear ? areaStart + own : areaStart;
    return;
  }
  Length(outDecorated, inAxis) = decorated;
  Start(outDecorated, inAxis) = inSide == Side::kNear ? areaStart + areaLength - decorated : areaStart;
  if (!inExtra) inExtra = ExtraSpace_Pass::GetSharedPtr().get();
  if (inAxis == Axis::kHorizontal)
    inExtra->AdjustRectsHorizontally(outOwn, outDecorated);
  else
    inExtra->AdjustRectsVertically(outOwn, outDecorated);
}

PointF SideBySide(const PointF& a, const PointF& b) { return PointF(a.x + b.x, std::max(a.y, b.y)); }
PointF Stacked(const PointF& a, const PointF& b) { return PointF(std::max(a.x, b.x), a.y + b.y); }

}  // namespace

void LayoutPlacement_LeftOfDO::GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize,
                                        RectF& outOwn, RectF& outDecorated, ExtraSpaceAlgorithmP inExtra) {
  PlaceOnAxis(inArea, inOwnSize, inDecoratedSize, outOwn, outDecorated, inExtra.get(), Axis::kHorizontal,
              Side::kNear);
}
PointF LayoutPlacement_LeftOfDO::GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) {
  return SideBySide(inOwnSize, inDecoratedSize);
}

void LayoutPlacement_RightOfDO::GetRects(const RectF& inArea, const PointF& inOwnSize,
                                         const PointF& inDecoratedSize, RectF& outOwn, RectF& outDecorated,
                                         ExtraSpaceAlgorithmP inExtra) {
  PlaceOnAxis(inArea, inOwnSize, inDecoratedSize, outOwn, outDecorated, inExtra.get(), Axis::kHorizontal,
              Side::kFar);
}
PointF LayoutPlacement_RightOfDO::GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) {
  return SideBySide(inOwnSize, inDecoratedSize);
}

void LayoutPlacement_AboveDO::GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize,
                                       RectF& outOwn, RectF& outDecorated, ExtraSpaceAlgorithmP inExtra) {
  PlaceOnAxis(inArea, inOwnSize, inDecoratedSize, outOwn, outDecorated, inExtra.get(), Axis::kVertical,
              Side::kNear);
}
PointF LayoutPlacement_AboveDO::GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) {
  return Stacked(inOwnSize, inDecoratedSize);
}

void LayoutPlacement_BelowDO::GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize,
                                       RectF& outOwn, RectF& outDecorated, ExtraSpaceAlgorithmP inExtra) {
  PlaceOnAxis(inArea, inOwnSize, inDecoratedSize, outOwn, outDecorated, inExtra.get(), Axis::kVertical,
              Side::kFar);
}
PointF LayoutPlacement_BelowDO::GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) {
  return Stacked(inOwnSize, inDecoratedSize);
}

}  // namespace norvik::layout
