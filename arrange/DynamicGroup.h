#pragma once
// A group whose kind (row, column, flipping, either wrapping, automatic) is
// chosen at run time. The element in the arrangement tree is a hosted group
// of that kind, which asks the host for its children and every property, so
// that a change of kind keeps both: only the candidates are rebuilt.
//
// The hosted group is replaced on a change of kind; a parent that lists a
// dynamic group among its children looks it up through Arrangeable() at
// each walk instead of keeping the pointer.
#include <boost/shared_ptr.hpp>

#include "arrange/WrappingArrangeableGroup.h"

namespace norvik::arrange {

enum GroupArrangementType {
  kGroupRow = 0,
  kGroupColumn = 1,
  kGroupFlipping = 2,
  kGroupHorizontalWrapping = 3,
  kGroupVerticalWrapping = 4,
  kGroupAutoLayout = 5,
};

class DynamicGroup {
 public:
  explicit DynamicGroup(IArrangeable* inParent = nullptr, GroupArrangementType inType = kGroupRow);
  virtual ~DynamicGroup();
  DynamicGroup(const DynamicGroup&) = delete;
  DynamicGroup& operator=(const DynamicGroup&) = delete;

  // Without a parent the present group's parent is kept.
  void SetArrangementType(GroupArrangementType inType, IArrangeable* inParent = nullptr);
  GroupArrangementType ArrangementType() const { return mType; }
  impl::AbstractArrangeableGroup& Arrangeable() const { return *mHosted; }

  void Invalidate() { mHosted->Invalidate(); }
  void InvalidateAll() { mHosted->InvalidateAll(); }
  PointF BestSize() { return mHosted->BestSize(); }
  PointF Arrange(RectF const& inRect) { return mHosted->Arrange(inRect); }
  void Rearrange() { mHosted->Rearrange(); }
  void EnableArrangement(bool inEnable) { mHosted->EnableArrangement(inEnable); }
  bool ArrangementEnabled() const { return mHosted->ArrangementEnabled(); }

  virtual float HorizontalSpacing() const { return 0.0f; }
  virtual float VerticalSpacing() const { return 0.0f; }
  virtual AlignmentHorizontal HorizontalAlignment() const { return kAlignLeft; }
  virtual AlignmentVertical VerticalAlignment() const { return kAlignTop; }
  virtual float LeftMargin() const { return 0.0f; }
  virtual float RightMargin() const { return 0.0f; }
  virtual float TopMargin() const { return 0.0f; }
  virtual float BottomMargin() const { return 0.0f; }
  virtual ISeparator* BuildSeparator() { return nullptr; }
  virtual void ClearSeparators() {}
  virtual void Position(PointF const&) {}
  virtual void SetDimensions(PointF const&) {}

  // The children of the hosted group; none by default.
  virtual bool VisitChildren(boost::function<bool(IArrangeable const&)> inVisitor) const;
  virtual bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor);
  virtual void ChildDestroyed(IArrangeable& inChild);

 protected:
  // Drops the separators so that the next rebuild asks for new ones.
  void ForgetSeparators();

 private:
  boost::shared_ptr<impl::AbstractArrangeableGroup> mHosted;
  GroupArrangementType mType = kGroupRow;
};

// A group of kind Group whose properties and children are those of its host.
template <class Group>
class HostedGroup : public Group {
 public:
  HostedGroup(DynamicGroup& inHost, IArrangeable* inParent) : Group(inParent), mHost(inHost) {}

  float HorizontalSpacing() const override { return mHost.HorizontalSpacing(); }
  float VerticalSpacing() const override { return mHost.VerticalSpacing(); }
  AlignmentHorizontal HorizontalAlignment() const override { return mHost.HorizontalAlignment(); }
  AlignmentVertical VerticalAlignment() const override { return mHost.VerticalAlignment(); }
  float LeftMargin() const override { return mHost.LeftMargin(); }
  float RightMargin() const override { return mHost.RightMargin(); }
  float TopMargin() const override { return mHost.TopMargin(); }
  float BottomMargin() const override { return mHost.BottomMargin(); }
  ISeparator* BuildSeparator() override { return mHost.BuildSeparator(); }
  void ClearSeparators() override { mHost.ClearSeparators(); }
  void Position(PointF const& inOrigin) override { mHost.Position(inOrigin); }
  void SetDimensions(PointF const& inSize) override { mHost.SetDimensions(inSize); }
  bool VisitChildren(boost::function<bool(IArrangeable const&)> inVisitor) const override {
    return static_cast<DynamicGroup const&>(mHost).VisitChildren(std::move(inVisitor));
  }
  bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor) override {
    return mHost.VisitChildren(std::move(inVisitor));
  }

 protected:
  void ChildDestroyed(IArrangeable& inChild) override { mHost.ChildDestroyed(inChild); }

 private:
  DynamicGroup& mHost;
};

// A dynamic group that keeps the properties it is asked for. Each setter
// invalidates the group when the value changes.
template <class Base>
class DefaultGroup : public Base {
 public:
  using Base::Base;

  float HorizontalSpacing() const override { return mHorizontalSpacing; }
  float VerticalSpacing() const override { return mVerticalSpacing; }
  AlignmentHorizontal HorizontalAlignment() const override { return mHorizontalAlignment; }
  AlignmentVertical VerticalAlignment() const override { return mVerticalAlignment; }
  float LeftMargin() const override { return mLeft; }
  float RightMargin() const override { return mRight; }
  float TopMargin() const override { return mTop; }
  float BottomMargin() const override { return mBottom; }

  void SetHorizontalSpacing(float inValue) { Set(mHorizontalSpacing, inValue); }
  void SetVerticalSpacing(float inValue) { Set(mVerticalSpacing, inValue); }
  void SetHorizontalAlignment(AlignmentHorizontal inValue) { Set(mHorizontalAlignment, inValue); }
  void SetVerticalAlignment(AlignmentVertical inValue) { Set(mVerticalAlignment, inValue); }
  void SetLeftMargin(float inValue) { Set(mLeft, inValue); }
  void SetRightMargin(float inValue) { Set(mRight, inValue); }
  void SetTopMargin(float inValue) { Set(mTop, inValue); }
  void SetBottomMargin(float inValue) { Set(mBottom, inValue); }

 private:
  template <class T>
  void Set(T& ioField, T inValue) {
    if (ioField == inValue) return;
    ioField = inValue;
    this->Invalidate();
  }

  float mHorizontalSpacing = 0.0f, mVerticalSpacing = 0.0f;
  AlignmentHorizontal mHorizontalAlignment = kAlignLeft;
  AlignmentVertical mVerticalAlignment = kAlignTop;
  float mLeft = 0.0f, mRight = 0.0f, mTop = 0.0f, mBottom = 0.0f;
};

}  // namespace norvik::arrange
