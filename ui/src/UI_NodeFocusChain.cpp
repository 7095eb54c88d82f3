// UI_Node: the keyboard focus chain. The focus leaf is the manager's; every
// node from the root down to it carries mHasKeyboardFocus. Moving focus
// changes only the part of the two chains below their common ancestor.
#include <algorithm>

#include <boost/container/small_vector.hpp>

#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

namespace {

// Focus moves at every Tab: the chains of a step live on the stack, as plain
// pointers, since nothing is called between building them and taking the
// tails. Only the tails (the part of each chain below the common ancestor) are
// called, and only they are held; each hold costs two atomic operations.
using Chain = boost::container::small_vector<UI_Node*, 24>;

// Root first, inLeaf last.
Chain ChainOf(UI_Node* inLeaf) {
  Chain chain;
  for (UI_Node* p = inLeaf; p; p = p->UI_GetParentNode()) chain.push_back(p);
  std::reverse(chain.begin(), chain.end());
  return chain;
}

}  // namespace

bool UI_Node::UI_HasKeyboardFocus(bool inLeafOnly) const {
  if (!mHasKeyboardFocus) return false;
  if (!inLeafOnly) return true;
  const UI_NodeManager* manager = UI_NodeManager::GetConst();
  return manager && manager->GetKeyboardFocusLeafNode() == this;
}

void UI_Node::UI_SetKeyboardFocusState(bool inGaining, const std::vector<UI_NodeP>& inTail, UI_Node* inLeaf,
                                       std::vector<UI_NodeP>& ioChanged, FocusChangeReason inReason) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager || manager->mGroupingFocus > 0) return;
  UI_NodeManager::ScUpdatingFocus updating(manager);
  const bool emptyTail = inTail.empty();
  // The caller holds the tail; only the leaf of an empty tail needs holding here.
  const UI_NodeP leafOnly[1] = {emptyTail ? UI_NodeP(inLeaf) : UI_NodeP()};
  const UI_NodeP* first = emptyTail ? leafOnly : inTail.data();
  const UI_NodeP* last = emptyTail ? leafOnly + (inLeaf ? 1 : 0) : inTail.data() + inTail.size();
  for (const UI_NodeP* it = first; it != last; ++it) {
    const UI_NodeP& x = *it;
    const bool isLeaf = x.get() == inLeaf;
    if (!isLeaf && x->mHasKeyboardFocus == inGaining) continue;
    if (x->UI_InvalidateOnKeyboardFocusChange(isLeaf)) x->UI_Invalidate(nullptr, 0);
    if (manager->mSuspendOSFocus < 1) {
      x->UI_NotifyBeforeFocusChangeWithOS(inGaining, inReason);
      if (inGaining) {
        x->UI_SetKeyboardFocusWithOS();
      } else {
        x->UI_ClearKeyboardFocusWithOS();
      }
    }
    if (!(emptyTail && !inGaining)) x->mHasKeyboardFocus = inGaining;
    ioChanged.push_back(x);
  }
}

void UI_Node::UI_DispatchFocusChange(const std::vector<UI_NodeP>& inChanged, FocusChangeReason inReason) {
  for (const UI_NodeP& node : inChanged) node->UI_FocusChanged(inReason);
}

bool UI_Node::UI_GainKeyboardFocus(FocusChangeReason inReason) {
  UI_NodeProtector protect(this);
  if (inReason == kFocusChangeAdvance && !UI_WantsKeyboardFocusFromAdvance()) return false;
  if (!UI_WantsKeyboardFocus()) {
    if (UI_NodeP parent = UI_GetParentNode()) parent->UI_GainKeyboardFocus(inReason);
    return false;
  }
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return false;
  std::vector<UI_NodeP> changed;
  {
    UI_NodeManager::ScUpdatingFocus updating(manager);
    UI_NodeP old(manager->mKeyboardFocusLeaf);
    if (old.get() != this) {
      manager->mPreviousKeyboardFocusLeaf = old.get();
      manager->mKeyboardFocusLeaf = this;
      const Chain oldChain = ChainOf(old.get());
      const Chain newChain = ChainOf(this);
      auto common = std::mismatch(oldChain.begin(), oldChain.end(), newChain.begin(), newChain.end());
      const std::vector<UI_NodeP> oldTail(common.first, oldChain.end());
      const std::vector<UI_NodeP> newTail(common.second, newChain.end());
      changed.reserve(oldTail.size() + newTail.size() + 2);
      UI_SetKeyboardFocusState(false, oldTail, old.get(), changed, inReason);
      UI_SetKeyboardFocusState(true, newTail, this, changed, inReason);
    }
  }
  if (manager->mGroupingFocus < 1) UI_DispatchFocusChange(changed, inReason);
  return true;
}

void UI_Node::UI_PrepareForKeyboardFocusFromAdvance(UI_Node* inNode) {
  if (UI_NodeP parent = UI_GetParentNode()) parent->UI_PrepareForKeyboardFocusFromAdvance(inNode);
}

void UI_Node::UI_LoseKeyboardFocus() {
  UI_NodeProtector protect(this);
  if (UI_NodeP parent = UI_GetParentNode()) {
    if (parent->UI_GainKeyboardFocus(kFocusChangeHandOver)) return;
  }
  UI_UpdateKeyboardFocusStateDueToLoss();
}

void UI_Node::UI_UpdateKeyboardFocusStateDueToLoss() {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return;
  UI_NodeProtector protect(this);
  std::vector<UI_NodeP> changed;
  {
    UI_NodeManager::ScUpdatingFocus updating(manager);
    UI_NodeP leaf(manager->mKeyboardFocusLeaf);
    if (leaf && (leaf.get() == this || leaf->UI_IsChildOf(*this))) {
      const Chain chain = ChainOf(leaf.get());
      auto self = std::find(chain.begin(), chain.end(), this);
      manager->mKeyboardFocusLeaf = self == chain.begin() ? nullptr : *(self - 1);
      manager->mPreviousKeyboardFocusLeaf = leaf.get();
      std::vector<UI_NodeP> tail(self, chain.end());
      UI_SetKeyboardFocusState(false, tail, leaf.get(), changed, kFocusChangeLoss);
    }
  }
  if (manager->mGroupingFocus < 1) UI_DispatchFocusChange(changed, kFocusChangeLoss);
}

void UI_Node::UI_ActivationChanged(WindowActivation inActivation) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return;
  const bool frontmost = manager->mApplicationFrontmost;
  // A window going inactive with the whole application keeps its focus state for the return.
  if (inActivation == kWindowInactive && !frontmost) return;
  if (manager->mUpdatingFocus > 0) return;
  UI_NodeProtector protect(this);
  if (inActivation == kWindowInactive) {
    UI_UpdateKeyboardFocusStateDueToLoss();
    return;
  }
  if (UI_HasKeyboardFocus(false)) return;
  if (!frontmost) {
    UI_Node* previous = manager->mPreviousKeyboardFocusLeaf;
    if (!previous || previous == this || previous->UI_IsChildOf(*this)) return;
    manager->mPreviousKeyboardFocusLeaf = nullptr;
  }
  UI_GainKeyboardFocus(kFocusChangeRestore);
}

}  // namespace norvik::ui
