#pragma once
// UI_Container owns children by strong reference, in z-order: the first child
// is drawn first, the last is topmost and is hit-tested first. Each child knows
// its index; every structural change renumbers what moved and empties the tab
// order cache, which focus advance rebuilds on demand.
//
// Indices handed in from outside are checked: one that does not fit an int, or
// lies past the end, raises boost::numeric::bad_numeric_cast (positive or
// negative overflow) instead of touching memory.
#include <cstddef>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>
#include <boost/noncopyable.hpp>

#include "tarsel/PointT.h"
#include "ui/ThemeOwner.h"

namespace norvik::ui {

class UI_Node;
using UI_NodeP = boost::intrusive_ptr<UI_Node>;

class UI_Container : public ThemeOwner, private boost::noncopyable {
 public:
  using ChildList = std::vector<UI_NodeP>;
  using iterator = ChildList::iterator;
  using const_iterator = ChildList::const_iterator;
  using reverse_iterator = ChildList::reverse_iterator;
  using const_reverse_iterator = ChildList::const_reverse_iterator;

  UI_Container();
  ~UI_Container() override;

  // Removes without clearing the manager's cached pointers; true if it was a child.
  virtual bool ChildRequestRemove(UI_Node* inChild);
  virtual void ChildPushBack(const UI_NodeP& inChild);
  virtual bool AllowFocusToAdvanceFromChildren() const { return true; }
  virtual void ChildAdded(UI_Node* inChild);
  virtual void ChildRemoved(UI_Node* inChild);
  virtual void ChildOrderChanged();
  virtual bool IsANode() const { return mAsNode != nullptr; }

  // The node this container is part of, or null for a plain container. Upward
  // walks stop at a container that is not a node.
  UI_Node* GetAsANode() const { return mAsNode; }

  std::size_t ChildSize() const { return mChildren.size(); }
  iterator ChildBegin() { return mChildren.begin(); }
  iterator ChildEnd() { return mChildren.end(); }
  const_iterator ChildBegin() const { return mChildren.begin(); }
  const_iterator ChildEnd() const { return mChildren.end(); }
  reverse_iterator ChildRBegin() { return mChildren.rbegin(); }
  reverse_iterator ChildREnd() { return mChildren.rend(); }
  const_reverse_iterator ChildRBegin() const { return mChildren.rbegin(); }
  const_reverse_iterator ChildREnd() const { return mChildren.rend(); }
  UI_Node* ChildGet(std::size_t inIndex) const;
  iterator ChildFind(const UI_Node* inChild);

  iterator ChildInsert(iterator inWhere, const UI_NodeP& inChild);
  iterator ChildInsert(std::size_t inIndex, const UI_NodeP& inChild);
  UI_NodeP ChildRemove(iterator inWhere);
  // Removes inChild after handing every cached pointer into it (or into a
  // sibling's subtree) to this node. Null when it was not a child.
  UI_NodeP ChildRemove(UI_Node* inChild);
  void ChildMove(std::size_t inFrom, std::size_t inTo);
  void ChildSwapOrder(std::size_t inA, std::size_t inB);
  void DeleteChildren();

  // Hit-tests the shown children from topmost to bottom. On a hit ioPoint is
  // replaced by the point in the hit child's coordinates; with inRecursive the
  // deepest hit wins. No hit leaves ioPoint as it was.
  std::pair<bool, iterator> GetChildHit(bool inRecursive, bool inSkipOSChildren,
                                        tarsel::geom::PointT<float>& ioPoint);

  void UpdateIndicesToEnd(iterator inFrom);

  // The next child in tab order (weight, then index) after child inIndex,
  // going forward for inDirection 1 and backward otherwise; -1 starts at the
  // first or last. Answers whether the step wrapped, and that child's index.
  std::pair<bool, int> UI_GetNextFocusIndex(int inDirection, int inIndex);

  const ChildList& GetTabOrderCache() const { return mTabOrderCache; }

 protected:
  // Set by UI_Node for the container that is part of it.
  void SetAsANode(UI_Node* inNode) { mAsNode = inNode; }
  void ClearTabOrderCache() { mTabOrderCache.clear(); }

  ChildList mChildren;
  ChildList mTabOrderCache;

 private:
  friend class UI_Node;
  int CheckedIndex(std::size_t inIndex, std::size_t inLimit) const;
  void DetachChild(UI_Node* inChild);

  UI_Node* mAsNode = nullptr;
};

}  // namespace norvik::ui
