// Focus advance with Tab.
//
// The walk is three mutually recursive steps. Advance moves through one
// container's children in tab order; TryChild offers focus to one child and
// otherwise searches inside it; Ascend leaves a container through its parent.
// Each step answers kFound, kNotHere or kVisited. A node enters the visited set
// when it is tried, and the ancestors of the starting container are in it from
// the start, so the walk never offers focus to an ancestor and always ends: a
// round trip comes back to a visited node.
//
// When the walk reaches the end of a container it first asks the parent
// (Ascend) and only wraps inside the container when the parent finds nothing,
// so Tab leaves a nested panel for its next sibling before it cycles.
#include <algorithm>
#include <functional>
#include <utility>

#include <boost/container/flat_set.hpp>
#include <boost/container/small_vector.hpp>

#include "tarsel/Contract.h"
#include "ui/KeyboardEvent.h"
#include "ui/OS_FocusPlatform.h"
#include "ui/UI_Container.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

namespace {

enum class AdvanceResult { kFound = 0, kNotHere = 1, kVisited = 2 };

// Ordered by node address. A walk touches a few dozen nodes at most on a
// typical step, so a flat set on the stack beats a tree of allocations.
using VisitedSet = boost::container::flat_set<const UI_Node*, std::less<const UI_Node*>,
                                              boost::container::small_vector<const UI_Node*, 32>>;

class FocusAdvanceWalk {
 public:
  explicit FocusAdvanceWalk(int inDirection) : mDirection(inDirection) {}

  void MarkVisited(const UI_Node* inNode) { mVisited.insert(inNode); }

  AdvanceResult Advance(int inIndex, UI_Container* inContainer, int inDepth);
  AdvanceResult TryChild(UI_Node* inNode, int inDepth);
  AdvanceResult Ascend(UI_Container* inContainer, int inDepth);

 private:
  int mDirection;
  VisitedSet mVisited;
};

AdvanceResult FocusAdvanceWalk::Advance(int inIndex, UI_Container* inContainer, int inDepth) {
  const int depth = inDepth + 1;
  if (!inContainer) return AdvanceResult::kNotHere;
  if (inContainer->ChildSize() == 0) return Ascend(inContainer, depth);
  bool wrapped = false;
  for (;;) {
    const std::pair<bool, int> next = inContainer->UI_GetNextFocusIndex(mDirection, inIndex);
    if (next.first && !wrapped) {
      // Leave through the parent before cycling inside this container.
      wrapped = true;
      if (Ascend(inContainer, depth) == AdvanceResult::kFound) return AdvanceResult::kFound;
    }
    // Host code ran during the walk and may have emptied or shrunk this container.
    if (inContainer->ChildSize() == 0) return AdvanceResult::kNotHere;
    if (next.second < 0 || static_cast<std::size_t>(next.second) >= inContainer->ChildSize()) {
      return AdvanceResult::kNotHere;
    }
    const UI_NodeP child(inContainer->ChildGet(static_cast<std::size_t>(next.second)));
    const AdvanceResult r = TryChild(child.get(), depth);
    if (r == AdvanceResult::kVisited) {
      if (depth == 1) return AdvanceResult::kVisited;
      if (wrapped) return AdvanceResult::kNotHere;
      return Ascend(inContainer, depth);
    }
    if (r == AdvanceResult::kFound) return AdvanceResult::kFound;
    // The child just tried is visited now: the next round ends in the case above.
  }
}

AdvanceResult FocusAdvanceWalk::TryChild(UI_Node* inNode, int inDepth) {
  if (!inNode) return AdvanceResult::kNotHere;
  if (!mVisited.insert(inNode).second) return AdvanceResult::kVisited;
  if (inNode->UI_IsEnabled()) {
    inNode->UI_PrepareForKeyboardFocusFromAdvance(inNode);
    if (inNode->UI_AreAllParentsVisible() && inNode->UI_GainKeyboardFocus(kFocusChangeAdvance)) {
      return AdvanceResult::kFound;
    }
  }
  // A node that did not take focus, disabled or not, is searched from the
  // start (or the end) of its own children.
  return Advance(-1, inNode, inDepth);
}

AdvanceResult FocusAdvanceWalk::Ascend(UI_Container* inContainer, int inDepth) {
  UI_Node* node = inContainer->GetAsANode();
  if (!node) return AdvanceResult::kNotHere;
  UI_Container* parent = node->UI_GetParentContainer();
  if (!parent) return AdvanceResult::kNotHere;
  // A container that keeps focus among its children refuses to let the walk
  // out, so the walk wraps inside it.
  if (!inContainer->AllowFocusToAdvanceFromChildren()) return AdvanceResult::kNotHere;
  const UI_NodeP parentNode(parent->GetAsANode());
  return Advance(node->UI_GetIndex(), parent, inDepth);
}

}  // namespace

std::pair<bool, int> UI_Container::UI_GetNextFocusIndex(int inDirection, int inIndex) {
  const int n = static_cast<int>(mChildren.size());
  if (n == 0) return {false, -1};
  if (mTabOrderCache.empty()) {
    mTabOrderCache = mChildren;
    std::stable_sort(mTabOrderCache.begin(), mTabOrderCache.end(), [](const UI_NodeP& a, const UI_NodeP& b) {
      return a->UI_GetTabOrderWeight() < b->UI_GetTabOrderWeight();
    });
  }
  if (inIndex == -1 && inDirection != 1) inIndex = n;
  const long k = inDirection == 1 ? static_cast<long>(inIndex) + 1 : static_cast<long>(inIndex) - 1;
  // The double modulo keeps an out-of-range index from outside within the list.
  const long next = ((n + k) % n + n) % n;
  return {k != next, mTabOrderCache[static_cast<std::size_t>(next)]->UI_GetIndex()};
}

bool UI_Node::UI_AdvanceFocus(bool inForward, int inIndex, UI_Container* inParent) {
  UI_Container* parent_containerP = inParent;
  NRK_CONTRACT(parent_containerP);
  FocusAdvanceWalk walk(inForward ? 1 : -1);
  const UI_NodeP parentNode(parent_containerP->GetAsANode());
  // The container and all its ancestors are never offered focus by the walk.
  for (const UI_Node* ancestor = parentNode.get(); ancestor; ancestor = ancestor->UI_GetParentNode()) {
    walk.MarkVisited(ancestor);
  }
  const AdvanceResult result = walk.Advance(inIndex, parent_containerP, 0);
  if (result != AdvanceResult::kFound) return false;
  if (UI_NodeManager* manager = UI_NodeManager::Get()) {
    if (OS_FocusPlatform* platform = manager->GetFocusPlatform()) platform->RemovePendingKeyMessages();
  }
  return true;
}

bool UI_Node::UI_DoAdvanceKeyboardFocus(UI_Container* inSelf, UI_Node* inTarget, const KeyboardEvent& inEvent) {
  if (!inEvent.IsActionKeyDown()) return false;
  if (inEvent.GetCode().GetControlCode() != kControlCodeTab) return false;
  ModifierKeys mods = inEvent.GetModKey();
  mods.Clear(kModKeyCapsLock);
  const bool forward = mods == ModifierKeys(kModKeyNone);
  if (!forward && mods != ModifierKeys(kModKeyShift)) return false;
  if (inTarget && inTarget->UI_GetParentContainer()) {
    UI_AdvanceFocus(forward, inTarget->UI_GetIndex(), inTarget->UI_GetParentContainer());
  } else if (inSelf) {
    UI_AdvanceFocus(forward, 0, inSelf);
  }
  return true;
}

UI_Node* UI_Node::UI_GetFirstFocusableChildNode() {
  for (const UI_NodeP& child : mChildren) {
    if (child->UI_WantsKeyboardFocus()) return child.get();
    if (UI_Node* inside = child->UI_GetFirstFocusableChildNode()) return inside;
  }
  return nullptr;
}

}  // namespace norvik::ui
