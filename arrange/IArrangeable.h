#pragma once
// The element of an arrangement tree. A leaf states its sizes; a group holds
// a set of candidate arrangements of its children and picks one at each size.
// Placement always starts at the root: a child that asks to be arranged hands
// the request up, so that siblings never see a stale distribution.
#include <boost/function.hpp>

#include "arrange/ArrangeTypes.h"

namespace norvik::arrange {

namespace impl {
class ArrangementSet;
}

class IArrangeable {
 public:
  explicit IArrangeable(IArrangeable* inParent = nullptr);
  virtual ~IArrangeable();
  IArrangeable(const IArrangeable&) = delete;
  IArrangeable& operator=(const IArrangeable&) = delete;

  virtual bool VisitChildren(boost::function<bool(IArrangeable const&)> inVisitor) const;
  virtual bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor);
  virtual void RebuildSelf();
  virtual impl::ArrangementSet& ArrangementsSelf() = 0;

  IArrangeable* Parent() const { return mParent; }
  void SetParent(IArrangeable* inParent) { mParent = inParent; }

  impl::ArrangementSet& Arrangements();
  PointF BestSize();
  PointF Arrange(RectF const& inRect);
  void Rearrange();
  void Invalidate();
  void InvalidateAll();
  void EnableArrangement(bool inEnable);
  bool ArrangementEnabled() const;

  bool IsBuilt() const { return mBuilt; }
  // Takes the root state (last rectangle, enabled flag) of an element that
  // this one replaces in the tree.
  void TakeOverFrom(IArrangeable const& inReplaced);
  RectF LastRectangle() const { return mLastRect; }
  // At the root: the rectangle moved to inOrigin and took everything placed
  // in it along, as a view's children go with the view. Nothing is placed
  // now; the next placement from the last rectangle starts there, instead of
  // putting the children back where the old origin was.
  void MoveLastRectangle(PointF const& inOrigin);

 protected:
  // Called on a parent while one of its children is being destroyed, so that
  // a group that lists its children can drop the entry before the next walk.
  virtual void ChildDestroyed(IArrangeable& inChild);

 private:
  IArrangeable& Root();
  const IArrangeable& Root() const;
  void RebuildIfNeeded();
  PointF ArrangeAtRoot(RectF const& inRect);

  bool mBuilt = false;
  bool mArrangementEnabled = true;
  bool mArranging = false;  // at a root: a placement is running
  bool mPlaced = false;     // at a root: the last placement finished built
  PointF mLastUsed;
  RectF mLastRect;
  IArrangeable* mParent = nullptr;
};

IArrangeable* Parent(IArrangeable& inElement);
bool VisitChildren(IArrangeable& inElement, boost::function<bool(IArrangeable&)> inVisitor);
bool VisitChildren(IArrangeable const& inElement, boost::function<bool(IArrangeable const&)> inVisitor);

}  // namespace norvik::arrange
