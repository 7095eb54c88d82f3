#include "ui/UI_Container.h"

#include <algorithm>
#include <limits>

#include <boost/numeric/conversion/cast.hpp>

#include "tarsel/MatrixT.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"
#include "ui/src/PlainViewGeometry.h"

namespace norvik::ui {

UI_Container::UI_Container() = default;

UI_Container::~UI_Container() { DeleteChildren(); }

int UI_Container::CheckedIndex(std::size_t inIndex, std::size_t inLimit) const {
  int index = boost::numeric_cast<int>(inIndex);
  if (inIndex >= inLimit) throw boost::numeric::positive_overflow();
  return index;
}

UI_Node* UI_Container::ChildGet(std::size_t inIndex) const {
  return mChildren[static_cast<std::size_t>(CheckedIndex(inIndex, mChildren.size()))].get();
}

UI_Container::iterator UI_Container::ChildFind(const UI_Node* inChild) {
  return std::find_if(mChildren.begin(), mChildren.end(),
                      [inChild](const UI_NodeP& c) { return c.get() == inChild; });
}

void UI_Container::ChildPushBack(const UI_NodeP& inChild) {
  if (!inChild) return;
  int index = boost::numeric_cast<int>(mChildren.size());
  UI_NodeProtector protect(GetAsANode());
  UI_NodeP child(inChild);
  child->UI_SetParent(this);
  child->mIndex = index;
  mChildren.push_back(child);
  ChildAdded(child.get());
}

UI_Container::iterator UI_Container::ChildInsert(iterator inWhere, const UI_NodeP& inChild) {
  return ChildInsert(static_cast<std::size_t>(inWhere - mChildren.begin()), inChild);
}

UI_Container::iterator UI_Container::ChildInsert(std::size_t inIndex, const UI_NodeP& inChild) {
  std::size_t at = static_cast<std::size_t>(CheckedIndex(inIndex, mChildren.size() + 1));
  if (!inChild) return mChildren.begin() + static_cast<std::ptrdiff_t>(at);
  UI_NodeProtector protect(GetAsANode());
  UI_NodeP child(inChild);
  mChildren.push_back(child);
  std::rotate(mChildren.begin() + static_cast<std::ptrdiff_t>(at), mChildren.end() - 1, mChildren.end());
  child->UI_SetParent(this);
  // UI_SetParent may have run host code that changed the list; find the child again.
  iterator where = ChildFind(child.get());
  if (where == mChildren.end()) return where;
  UpdateIndicesToEnd(where);
  mTabOrderCache.clear();
  ChildAdded(child.get());
  return ChildFind(child.get());
}

UI_NodeP UI_Container::ChildRemove(iterator inWhere) {
  if (inWhere == mChildren.end()) return UI_NodeP();
  UI_NodeProtector protect(GetAsANode());
  UI_NodeP child = *inWhere;
  iterator next = mChildren.erase(inWhere);
  UpdateIndicesToEnd(next);
  mTabOrderCache.clear();
  child->UI_SetParent(nullptr);
  child->mIndex = -1;
  ChildRemoved(child.get());
  return child;
}

UI_NodeP UI_Container::ChildRemove(UI_Node* inChild) {
  iterator where = ChildFind(inChild);
  if (where == mChildren.end()) return UI_NodeP();
  // Focus hand-over runs host code, which may drop the last reference to this node.
  UI_NodeProtector protect(GetAsANode());
  UI_NodeP child = *where;
  if (UI_NodeManager* manager = UI_NodeManager::Get()) {
    manager->ReplaceInAllCachedNodes(child.get(), GetAsANode(), true);
    // Focus hand-over runs host code, which may already have moved the child.
    where = ChildFind(child.get());
    if (where == mChildren.end()) return UI_NodeP();
  }
  return ChildRemove(where);
}

bool UI_Container::ChildRequestRemove(UI_Node* inChild) {
  iterator where = ChildFind(inChild);
  if (where == mChildren.end()) return false;
  ChildRemove(where);
  return true;
}

void UI_Container::ChildMove(std::size_t inFrom, std::size_t inTo) {
  int from = CheckedIndex(inFrom, mChildren.size());
  int to = CheckedIndex(inTo, mChildren.size());
  if (from == to) return;
  auto begin = mChildren.begin();
  if (from < to) {
    std::rotate(begin + from, begin + from + 1, begin + to + 1);
  } else {
    std::rotate(begin + to, begin + from, begin + from + 1);
  }
  for (int i = std::min(from, to); i <= std::max(from, to); ++i) mChildren[static_cast<std::size_t>(i)]->mIndex = i;
  ChildOrderChanged();
}

void UI_Container::ChildSwapOrder(std::size_t inA, std::size_t inB) {
  int a = CheckedIndex(inA, mChildren.size());
  int b = CheckedIndex(inB, mChildren.size());
  std::swap(mChildren[inA], mChildren[inB]);
  mChildren[inA]->mIndex = a;
  mChildren[inB]->mIndex = b;
  ChildOrderChanged();
}

void UI_Container::DetachChild(UI_Node* inChild) {
  if (UI_NodeManager* manager = UI_NodeManager::Get()) {
    manager->ReplaceInAllCachedNodes(inChild, GetAsANode(), true);
  }
  inChild->UI_SetParent(nullptr);
  inChild->mIndex = -1;
  ChildRemoved(inChild);
}

void UI_Container::DeleteChildren() {
  // Work on our own copy: the callbacks below may add or remove children.
  UI_NodeProtector protect(GetAsANode());
  ChildList children;
  children.swap(mChildren);
  mTabOrderCache.clear();
  for (const UI_NodeP& child : children) {
    if (child->mParent == this) DetachChild(child.get());
  }
}

void UI_Container::UpdateIndicesToEnd(iterator inFrom) {
  for (iterator it = inFrom; it != mChildren.end(); ++it) {
    (*it)->mIndex = static_cast<int>(it - mChildren.begin());
  }
}

void UI_Container::ChildAdded(UI_Node*) {}

void UI_Container::ChildRemoved(UI_Node*) {}

void UI_Container::ChildOrderChanged() {}

namespace {

using PointF = tarsel::geom::PointT<float>;
using Matrix = tarsel::geom::ScaleMatrixT<float>;

// The point in the child's space when the child covers it; asks the child's
// own virtual operations when its class overrides any of them.
bool HitsChild(const UI_Node& inChild, const UI_Node* inScrollingParent, const PointF& inPoint, PointF& outLocal) {
  const bool plain = plainview::KeepsViewHitTest(inChild);
  if (!(plain ? plainview::ViewIsShown(inChild) : inChild.UI_IsShown())) return false;
  const Matrix m = plain ? plainview::ViewStep(inChild, inScrollingParent) : inChild.UI_GetSelfToParentMatrix();
  if (m.IsTranslationOnly()) {
    // Most children are only moved: undo the offset instead of inverting.
    outLocal = PointF(inPoint.x - m.tx, inPoint.y - m.ty);
  } else {
    if (!m.IsInvertible()) return false;  // a view scaled to nothing covers no point
    outLocal = m.Inverse().Transform(inPoint);
  }
  return plain ? plainview::ViewHitTest(inChild, outLocal) : inChild.UI_HitTest(outLocal);
}

}  // namespace

std::pair<bool, UI_Container::iterator> UI_Container::GetChildHit(bool inRecursive, bool inSkipOSChildren,
                                                                   tarsel::geom::PointT<float>& ioPoint) {
  // The children of one container share their parent: whether it scrolls them is asked once.
  const UI_Node* scrolling = plainview::ScrollingParent(GetAsANode());
  for (auto it = mChildren.rbegin(); it != mChildren.rend(); ++it) {
    UI_Node* child = it->get();
    // A wide container's children do not stay in the cache between two
    // walks; fetching a few ahead overlaps their loads with the tests.
    if (mChildren.rend() - it > plainview::kPrefetchAhead) plainview::Prefetch(*it[plainview::kPrefetchAhead]);
    if (inSkipOSChildren && !plainview::KeepsViewNotNative(*child) && child->UI_ReceivesEventsFromOS()) continue;
    PointF local;
    if (!HitsChild(*child, scrolling, ioPoint, local)) continue;
    iterator hit = it.base() - 1;
    ioPoint = local;
    if (inRecursive) {
      UI_NodeP keep(child);
      auto deeper = child->GetChildHit(true, inSkipOSChildren, ioPoint);
      if (deeper.first) return deeper;
      hit = ChildFind(child);
      if (hit == mChildren.end()) return {false, hit};
    }
    return {true, hit};
  }
  return {false, mChildren.end()};
}

}  // namespace norvik::ui
