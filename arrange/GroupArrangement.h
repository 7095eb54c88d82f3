#pragma once
// Rows and columns of child arrangements. A column is a row with the axes
// exchanged, so both share one implementation over a LineAxis.
#include <vector>

#include "arrange/ISeparator.h"
#include "arrange/LineDistribution.h"

namespace norvik::arrange::impl {

class AbstractArrangeableGroup;

class GroupArrangement : public IArrangement {
 public:
  PointF Arrange(RectF const& inRect) override;
  bool HorizontallyExpandable() const override { return mHorizontallyExpandable; }
  bool VerticallyExpandable() const override { return mVerticallyExpandable; }
  float MinWidth() const override { return mMinWidth; }
  float MinHeight() const override { return mMinHeight; }
  float NaturalWidth() const override { return mNaturalWidth; }
  float NaturalHeight() const override { return mNaturalHeight; }
  float ExpandedWidth(float inWidth) const override;
  float ExpandedHeight(float inHeight) const override;
  float OverflowArea(PointF const& inSize) const override;
  float WastedArea(PointF const& inSize) const override;
  void Prepare() override;
  bool IsGroupLevel() const override { return mGroupLevel; }
  bool Dominates(IArrangement const& inOther) const override;
  std::uint64_t Signature() const override { return mSignature; }
  virtual void ComputeNaturalWidth();
  virtual void ComputeNaturalHeight();

  const std::vector<ArrangementPtr>& Children() const { return mChildren; }
  // The extents of the last distribution, for inspection.
  const std::vector<LineRecord>& ItemSizes() const { return mDistribution.records; }

 protected:
  GroupArrangement(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                   std::vector<ISeparator*> const& inSeparators, bool inGroupLevel, LineAxis inAxis);

 private:
  struct Margins {
    float mainBefore = 0.0f, mainAfter = 0.0f, crossBefore = 0.0f, crossAfter = 0.0f;
    float Main() const { return mainBefore + mainAfter; }
    float Cross() const { return crossBefore + crossAfter; }
  };

  void ReadGroup();
  void ComputeMinimum();
  void Distribute(float inMain, float inCross) const;
  float Spacings() const;
  float AlignOffset(int inAlignment, float inFree) const;
  void PlaceSeparator(std::size_t inIndex, float inPos, RectF const& inPrevious, RectF const& inCurrent) const;

  float mMinWidth = -1.0f, mMinHeight = -1.0f, mNaturalWidth = -1.0f, mNaturalHeight = -1.0f;
  AbstractArrangeableGroup* mGroup;
  LineAxis mAxis;
  Margins mMargins;
  float mSpacing = 0.0f;
  int mMainAlignment = 0, mCrossAlignment = 0;
  mutable LineResult mDistribution;
  mutable PointF mLastDistributed;
  mutable bool mDistributed = false;
  std::vector<ArrangementPtr> mChildren;
  std::vector<ISeparator*> mSeparators;
  bool mGroupLevel;
  bool mHorizontallyExpandable = false, mVerticallyExpandable = false;
  bool mPrepared = false;
  std::uint64_t mSignature = 0;
};

class RowArrangement : public GroupArrangement {
 public:
  RowArrangement(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                 std::vector<ISeparator*> const& inSeparators, bool inGroupLevel)
      : GroupArrangement(inGroup, inChildren, inSeparators, inGroupLevel, LineAxis{false}) {}
};

class ColumnArrangement : public GroupArrangement {
 public:
  ColumnArrangement(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                    std::vector<ISeparator*> const& inSeparators, bool inGroupLevel)
      : GroupArrangement(inGroup, inChildren, inSeparators, inGroupLevel, LineAxis{true}) {}
};

}  // namespace norvik::arrange::impl
