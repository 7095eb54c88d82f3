#pragma once
// A leaf of an arrangement tree: it states a natural size, optionally a
// smaller minimum and a wish to stretch, and receives a rectangle in Place.
#include <memory>

#include "arrange/IArrangeable.h"
#include "arrange/IArrangement.h"

namespace norvik::arrange {

class Single : public IArrangeable {
 public:
  explicit Single(IArrangeable* inParent = nullptr);
  ~Single() override;

  virtual float MinWidth() const { return NaturalWidth(); }
  virtual float MinHeight() const { return NaturalHeight(); }
  virtual float ExpandedWidth(float inWidth) const;
  virtual float ExpandedHeight(float inHeight) const;
  virtual bool HorizontallyExpandable() const { return false; }
  virtual bool VerticallyExpandable() const { return false; }
  virtual float LeftMargin() const { return 0.0f; }
  virtual float RightMargin() const { return 0.0f; }
  virtual float TopMargin() const { return 0.0f; }
  virtual float BottomMargin() const { return 0.0f; }
  virtual float NaturalWidth() const = 0;
  virtual float NaturalHeight() const = 0;
  virtual PointF Place(RectF const& inRect) = 0;

  void RebuildSelf() override;
  impl::ArrangementSet& ArrangementsSelf() override;

  // Cleared when the leaf dies, so that an arrangement that outlives it (a
  // sibling deleted it from its Place) skips it instead of calling into it.
  const std::shared_ptr<Single*>& LifeCell() const { return mLifeCell; }

 private:
  std::unique_ptr<impl::ArrangementSet> mSet;
  std::shared_ptr<Single*> mLifeCell;
};

namespace impl {

// The leaf's arrangement: a snapshot of the leaf's sizes and margins taken at
// rebuild, so that measuring a candidate never calls into the leaf again.
class SingleArrangement : public IArrangement {
 public:
  explicit SingleArrangement(Single& inSingle);

  PointF Arrange(RectF const& inRect) override;
  bool HorizontallyExpandable() const override { return mHorizontallyExpandable; }
  bool VerticallyExpandable() const override { return mVerticallyExpandable; }
  float MinWidth() const override { return mMinWidth; }
  float MinHeight() const override { return mMinHeight; }
  float NaturalWidth() const override { return mNaturalWidth; }
  float NaturalHeight() const override { return mNaturalHeight; }
  float ExpandedWidth(float inWidth) const override;
  float ExpandedHeight(float inHeight) const override;
  bool IsGroupLevel() const override { return false; }
  bool Dominates(IArrangement const& inOther) const override;
  std::uint64_t Signature() const override { return reinterpret_cast<std::uintptr_t>(mSingle.get()); }

 private:
  std::shared_ptr<Single*> mSingle;
  bool mHorizontallyExpandable;
  bool mVerticallyExpandable;
  float mLeft, mTop, mHorizontalMargins, mVerticalMargins;
  float mMinWidth, mMinHeight, mNaturalWidth, mNaturalHeight;
};

}  // namespace impl
}  // namespace norvik::arrange
