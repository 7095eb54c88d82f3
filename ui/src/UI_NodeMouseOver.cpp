// Mouse-over state: which nodes have the mouse over them (state flag 2), the
// deepest one (the manager's mouse-over leaf), and the exit events that nodes
// hear when the mouse leaves them.
//
// A change of leaf compares the root-first parent chains of the old and the
// new leaf. The nodes past the common part of the old chain are left, those
// past the common part of the new chain are entered; UI_MouseOverChanged runs
// only after the whole chain is consistent. Both chains are held as strong
// references for the whole update, since exit handlers may delete nodes.
#include <algorithm>

#include "ui/MouseEvent.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_SuspendToolTips.h"
#include "ui/UI_ToolTipManager.h"

namespace norvik::ui {
namespace {

UI_Node::NodeChain StrongChain(UI_Node* inNode) {
  UI_Node::NodeChain chain;
  if (!inNode) return chain;
  std::vector<UI_Node*> parents = inNode->UI_GetNodeParents();
  chain.assign(parents.begin(), parents.end());
  return chain;
}

// The tip for the new leaf. A node's own tip waits for the display delay
// before it shows; a tip already on screen for this node, or one that an
// ancestor shows for it, follows the mouse at once.
void UpdateToolTipsAfterMouseOverChange(UI_NodeManager* inManager, UI_Node* inLeaf) {
  UI_ToolTipManager* tips = inManager->GetToolTipManager();
  if (!tips) return;
  UI_Node* display = inLeaf ? UI_Node::UI_GetToolTipForDisplay(inLeaf) : nullptr;
  if (!display || UI_SuspendToolTips::IsSuspended()) {
    tips->DisposeToolTip();
  } else if (display == inLeaf && tips->GetToolTipNode() != inLeaf) {
    tips->DisposeToolTip();
    UI_NodeP protect(inLeaf);
    inLeaf->UI_InstallTimer(tips->GetDisplayDelay(), UI_NodeManager::GetTooltipTimerID());
  } else {
    tips->RefreshToolTip(display);
  }
}

}  // namespace

bool UI_Node::UI_IsMouseOver(bool inLeafOnly) const {
  if (!mStateFlags.Test(kStateMouseOver)) return false;
  if (!inLeafOnly) return true;
  const UI_NodeManager* manager = UI_NodeManager::GetConst();
  return manager && manager->GetMouseOverLeafNode() == this;
}

void UI_Node::UI_UpdateMouseOverState(const MouseEvent& inEvent) {
  UI_NodeP protector(this);
  MouseEvent copy(inEvent);
  UI_NodeP target(UI_GetMouseProxy(&copy));
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!target || !manager || manager->IsSuspendingMouseOverUpdates()) return;

  // Native children are not skipped here: the mouse is over them as well.
  PointF point = copy.GetPosition();
  auto [hit, it] = target->GetChildHit(true, false, point);
  UI_NodeP leaf = hit ? *it : target;
  if (leaf.get() == manager->GetMouseOverLeafNode()) return;
  copy.SetPosition(point);
  leaf->UI_SetMouseOverLeafNode(&copy);
}

void UI_Node::UI_SetMouseOverLeafNode(const MouseEvent* inEvent) {
  UI_NodeP protector(this);
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return;
  UI_NodeP oldLeaf(manager->GetMouseOverLeafNode());
  NodeChain oldChain = StrongChain(oldLeaf.get());
  NodeChain newChain = StrongChain(this);
  auto [oldTail, newTail] = std::mismatch(oldChain.cbegin(), oldChain.cend(), newChain.cbegin(), newChain.cend());

  // From here on the event's position is global, so that each node it reaches
  // can have it in its own coordinates.
  MouseEvent global;
  if (inEvent) {
    global = *inEvent;
    global.SetPosition(UI_LocalToGlobalF(inEvent->GetPosition()));
  }
  const MouseEvent* event = inEvent ? &global : nullptr;
  UI_SetMouseOverState(false, event, oldTail, oldChain.cend(), oldLeaf.get());
  UI_SetMouseOverState(true, event, newTail, newChain.cend(), this);

  manager->SetMouseOverLeafNode(this);
  manager->SetMouseOverRootNode(UI_GetRootNode());
  UpdateToolTipsAfterMouseOverChange(manager, this);
}

void UI_Node::UI_SetMouseOverState(bool inEntering, const MouseEvent* inEvent, NodeChain::const_iterator inFirst,
                                   NodeChain::const_iterator inLast, UI_Node* inLeaf) {
  NodeChain changed;
  if (inFirst == inLast) {
    // The leaf stops or starts being the leaf while it stays on the chain: it
    // is told, but its flag does not change and it hears no exit.
    if (!inLeaf) return;
    UI_NodeP leaf(inLeaf);
    changed.push_back(leaf);
    if (leaf->UI_InvalidateOnMouseOverChange(true)) leaf->UI_Invalidate(nullptr, 0);
  }
  for (auto it = inFirst; it != inLast; ++it) {
    const UI_NodeP& node = *it;
    bool isLeaf = node.get() == inLeaf;
    if (!isLeaf && node->mStateFlags.Test(kStateMouseOver) == inEntering) continue;
    changed.push_back(node);
    if (node->UI_InvalidateOnMouseOverChange(isLeaf)) node->UI_Invalidate(nullptr, 0);
    if (inEntering) {
      node->mStateFlags.Set(kStateMouseOver);
      continue;
    }
    node->mStateFlags.Clear(kStateMouseOver);
    if (inEvent) {
      MouseEvent exit(*inEvent);
      exit.SetPosition(node->UI_GlobalToLocalF(inEvent->GetPosition()));
      UI_DispatchMouseEventToLeaf(node.get(), node.get(), exit);
    }
  }
  for (const UI_NodeP& node : changed) node->UI_MouseOverChanged(inEntering);
}

void UI_Node::UI_MouseExited(const MouseEvent* inEvent, UI_Node* inNode) {
  if (!inNode) return;
  UI_NodeP protector(inNode);
  MouseEvent copy;
  if (inEvent) copy = *inEvent;
  UI_NodeP proxy(inNode->UI_GetMouseProxy(inEvent ? &copy : nullptr));
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!proxy || !manager || manager->IsSuspendingMouseOverUpdates()) return;
  UI_NodeP oldLeaf(manager->GetMouseOverLeafNode());
  if (!oldLeaf) return;

  NodeChain chain = StrongChain(oldLeaf.get());
  auto found = std::find(chain.cbegin(), chain.cend(), proxy);
  if (found == chain.cend()) return;
  UI_Node* newLeaf = found == chain.cbegin() ? nullptr : (found - 1)->get();
  manager->SetMouseOverLeafNode(newLeaf);
  if (!newLeaf) manager->SetMouseOverRootNode(nullptr);

  MouseEvent global(copy);
  if (inEvent) global.SetPosition(proxy->UI_LocalToGlobalF(copy.GetPosition()));
  UI_SetMouseOverState(false, inEvent ? &global : nullptr, found, chain.cend(), oldLeaf.get());
  UpdateToolTipsAfterMouseOverChange(manager, newLeaf);
}

void UI_Node::UI_InvalidateMouseOverNodes() {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return;
  for (UI_NodeP node(manager->GetMouseOverLeafNode()); node; node = node->UI_GetParentNode()) {
    if (node->UI_InvalidateOnMouseOverChange(true) || node->UI_InvalidateOnMouseOverChange(false))
      node->UI_Invalidate(nullptr, 0);
  }
}

}  // namespace norvik::ui
