// Keyboard focus as the native window system sees it: the native set-focus
// and kill-focus messages of a window, grouping of focus changes, and the
// plain accessors of the focus leaf.
//
// Native focus messages arrive synchronously while the tree itself tells the
// platform about a change (UI_SetKeyboardFocusWithOS); the updating-focus
// counter makes these handlers return at once in that case, and the
// suspend-OS-focus guard keeps them from telling the platform what it has just
// told us.
#include <optional>

#include "ui/OS_FocusPlatform.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

UI_Node* UI_Node::UI_GetKeyboardFocusLeafNode() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst();
  return manager ? manager->GetKeyboardFocusLeafNode() : nullptr;
}

UI_Node* UI_Node::UI_GetPreviousKeyboardFocusNode() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst();
  return manager ? manager->GetPreviousKeyboardFocusLeafNode() : nullptr;
}

void UI_Node::UI_SetKeyboardFocusLeafNode(UI_Node* inNode) {
  if (inNode) inNode->UI_SetKeyboardFocusWithOS();
}

void UI_Node::UI_ClearPreviousKeyboardFocus() {
  if (UI_NodeManager* manager = UI_NodeManager::Get()) manager->SetPreviousKeyboardFocusLeafNode(nullptr);
}

void UI_Node::UI_OSSetFocus(UI_Node* inWindow, bool inSuspendOS) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!inWindow || !manager || manager->IsUpdatingFocus()) return;
  UI_NodeProtector protect(inWindow);
  std::optional<UI_NodeManager::SuspendOSFocusUpdates> suspend;
  if (inSuspendOS) suspend.emplace(manager);
  UI_Node* leaf = manager->GetKeyboardFocusLeafNode();
  // Focus already inside this window: the platform only confirms it.
  if (leaf && (leaf == inWindow || leaf->UI_IsChildOf(*inWindow))) return;
  inWindow->UI_GainKeyboardFocus(kFocusChangeRestore);
}

namespace {

// Walks up from the handle that receives focus: the first of our windows met
// before leaving the native child hierarchy is the new holder. A top-level
// window that is not ours means focus went outside. Null when it is not ours.
UI_Node* FindOurFocusHolder(const OS_FocusPlatform& inPlatform, OS_WindowHandle inNext) {
  OS_WindowHandle handle = inNext;
  while (handle != 0) {
    UI_Node* ours = inPlatform.GetOurWindowNode(handle);
    if (!ours && !inPlatform.IsChildWindow(handle)) return nullptr;
    if (ours) return ours;
    handle = inPlatform.GetParentWindow(handle);
  }
  return nullptr;
}

}  // namespace

void UI_Node::UI_OSKillFocus(UI_Node* inWindow, OS_WindowHandle inNextHandle) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!inWindow || !manager || manager->IsUpdatingFocus()) return;
  UI_NodeProtector protect(inWindow);
  UI_NodeManager::SuspendOSFocusUpdates suspend(manager);
  const OS_FocusPlatform* platform = manager->GetFocusPlatform();
  UI_Node* holder = platform ? FindOurFocusHolder(*platform, inNextHandle) : nullptr;
  if (holder) {
    UI_NodeP keep(holder);
    holder->UI_GainKeyboardFocus(kFocusChangeHandOver);
  } else {
    inWindow->UI_UpdateKeyboardFocusStateDueToLoss();
  }
}

void UI_NodeManager::LoseKeyboardFocus() {
  if (!mKeyboardFocusLeaf) return;
  const UI_NodeP root(mKeyboardFocusLeaf->UI_GetRootNode());
  if (root) root->UI_LoseKeyboardFocus();
}

UI_NodeManager::GroupingFocusChanges::GroupingFocusChanges(UI_NodeManager* inManager, bool inRestore) {
  if (!inManager || inManager->mGroupingFocus > 0) return;  // an inner group is inert
  mManager = inManager;
  if (inRestore) mRestore = inManager->mKeyboardFocusLeaf;
  // Focus leaves the tree for real before the group starts, so that every
  // flag is clear while changes are not being recorded.
  inManager->LoseKeyboardFocus();
  ++inManager->mGroupingFocus;
}

UI_NodeManager::GroupingFocusChanges::~GroupingFocusChanges() {
  if (!mManager) return;
  UI_NodeP next(mManager->mKeyboardFocusLeaf);
  // Still grouping: this clears the leaf and leaves every flag alone.
  mManager->LoseKeyboardFocus();
  --mManager->mGroupingFocus;
  if (mRestore && mRestore->UI_IsShown()) next = mRestore;
  if (next) next->UI_GainKeyboardFocus(kFocusChangeRestore);
}

}  // namespace norvik::ui
