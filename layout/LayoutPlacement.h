#pragma once
// Where a wrapper's own piece stands relative to the layout it wraps, and
// how the two sizes combine. Each placement is a pure function of the area
// and the two sizes; the surplus, if any, goes where the extra-space
// strategy says.
#include <boost/intrusive_ptr.hpp>

#include "layout/ExtraSpace.h"

namespace norvik::layout {

class LayoutPlacementAlgorithm : public tarsel::utility::RefCountedObject {
 public:
  ~LayoutPlacementAlgorithm() override = default;
  virtual void GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize,
                        RectF& outOwn, RectF& outDecorated,
                        boost::intrusive_ptr<ExtraSpaceAlgorithm> inExtra) = 0;
  virtual PointF GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) = 0;
};

using LayoutPlacementAlgorithmP = boost::intrusive_ptr<LayoutPlacementAlgorithm>;

class LayoutPlacement_LeftOfDO : public LayoutPlacementAlgorithm {
 public:
  void GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize, RectF& outOwn,
                RectF& outDecorated, boost::intrusive_ptr<ExtraSpaceAlgorithm> inExtra) override;
  PointF GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) override;
};

class LayoutPlacement_RightOfDO : public LayoutPlacementAlgorithm {
 public:
  void GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize, RectF& outOwn,
                RectF& outDecorated, boost::intrusive_ptr<ExtraSpaceAlgorithm> inExtra) override;
  PointF GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) override;
};

class LayoutPlacement_AboveDO : public LayoutPlacementAlgorithm {
 public:
  void GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize, RectF& outOwn,
                RectF& outDecorated, boost::intrusive_ptr<ExtraSpaceAlgorithm> inExtra) override;
  PointF GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) override;
};

class LayoutPlacement_BelowDO : public LayoutPlacementAlgorithm {
 public:
  void GetRects(const RectF& inArea, const PointF& inOwnSize, const PointF& inDecoratedSize, RectF& outOwn,
                RectF& outDecorated, boost::intrusive_ptr<ExtraSpaceAlgorithm> inExtra) override;
  PointF GetCombinedSize(const PointF& inOwnSize, const PointF& inDecoratedSize) override;
};

}  // namespace norvik::layout
