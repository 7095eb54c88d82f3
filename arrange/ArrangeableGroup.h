#pragma once
// Groups: elements whose candidates are arrangements of their children.
// RebuildSelf gathers the children's candidates and lets the group add its
// own for every combination of them; the choice at a size does the rest.
#include <vector>

#include "arrange/GroupArrangement.h"
#include "arrange/IArrangeable.h"

namespace norvik::arrange {

namespace impl {

class AbstractArrangeableGroup : public IArrangeable {
 public:
  explicit AbstractArrangeableGroup(IArrangeable* inParent = nullptr);
  ~AbstractArrangeableGroup() override;

  virtual float HorizontalSpacing() const { return 0.0f; }
  virtual float VerticalSpacing() const { return 0.0f; }
  virtual AlignmentHorizontal HorizontalAlignment() const { return kAlignLeft; }
  virtual AlignmentVertical VerticalAlignment() const { return kAlignTop; }
  virtual ISeparator* BuildSeparator() { return nullptr; }
  virtual void ClearSeparators() {}
  virtual float LeftMargin() const { return 0.0f; }
  virtual float RightMargin() const { return 0.0f; }
  virtual float TopMargin() const { return 0.0f; }
  virtual float BottomMargin() const { return 0.0f; }
  virtual void Position(PointF const&) {}
  virtual void SetDimensions(PointF const&) {}
  // Adds this group's candidates over one combination of child candidates.
  virtual void AddGroupArrangements(std::vector<ArrangementPtr> const& inChildren) = 0;

  void RebuildSelf() override;
  ArrangementSet& ArrangementsSelf() override { return mSet; }

  const std::vector<ISeparator*>& Separators() const { return mSeparators; }
  // Drops the separators so that the next rebuild asks for new ones.
  void ForgetSeparators();

 private:
  void RebuildSeparators(std::size_t inChildCount);

  ArrangementSet mSet;
  std::vector<ISeparator*> mSeparators;
};

// Groups whose one candidate is an Arrangement over all children.
template <class Arrangement>
class BasicArrangeableGroup : public AbstractArrangeableGroup {
 public:
  using AbstractArrangeableGroup::AbstractArrangeableGroup;
  static void AddCandidates(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren) {
    inGroup.ArrangementsSelf().AddArrangement(new Arrangement(inGroup, inChildren, inGroup.Separators(), true));
  }
  void AddGroupArrangements(std::vector<ArrangementPtr> const& inChildren) override {
    AddCandidates(*this, inChildren);
  }
};

}  // namespace impl

class Row : public impl::BasicArrangeableGroup<impl::RowArrangement> {
 public:
  using BasicArrangeableGroup::BasicArrangeableGroup;
};

class Column : public impl::BasicArrangeableGroup<impl::ColumnArrangement> {
 public:
  using BasicArrangeableGroup::BasicArrangeableGroup;
};

// A group that lists its children itself, for trees built in code. The list
// does not own the children; a child that dies leaves it and invalidates it.
template <class Group>
class WithChildren : public Group {
 public:
  using Group::Group;
  ~WithChildren() override {
    for (IArrangeable* child : mChildren) child->SetParent(nullptr);
  }

  void AddChild(IArrangeable& inChild) {
    mChildren.push_back(&inChild);
    inChild.SetParent(this);
    this->Invalidate();
  }
  void RemoveChild(IArrangeable& inChild) {
    for (auto it = mChildren.begin(); it != mChildren.end(); ++it) {
      if (*it != &inChild) continue;
      mChildren.erase(it);
      inChild.SetParent(nullptr);
      this->Invalidate();
      return;
    }
  }
  std::size_t ChildCount() const { return mChildren.size(); }

  bool VisitChildren(boost::function<bool(IArrangeable const&)> inVisitor) const override {
    for (IArrangeable* child : std::vector<IArrangeable*>(mChildren))
      if (!inVisitor(*child)) return false;
    return true;
  }
  bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor) override {
    for (IArrangeable* child : std::vector<IArrangeable*>(mChildren))
      if (!inVisitor(*child)) return false;
    return true;
  }

 protected:
  void ChildDestroyed(IArrangeable& inChild) override { RemoveChild(inChild); }

 private:
  std::vector<IArrangeable*> mChildren;
};

}  // namespace norvik::arrange
