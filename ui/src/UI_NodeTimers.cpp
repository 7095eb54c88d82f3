// The node side of timers: installing and removing them through the nearest
// window's timer manager, and routing a fired timer back to its node.
//
// A node outside any window has no manager and so no timers; installing one
// there does nothing. A node's timers end when it leaves its parent (a view
// never takes its timers to another window), and a timer lives on only while
// its notification keeps answering true.
#include <utility>

#include "ui/InputCapture.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_NodeTimerManager.h"
#include "ui/src/UI_NodeExtras.h"

namespace norvik::ui {

namespace {

// The tool tip timer of inNode: the first firing after the delay shows the
// tip, the next one (after the display time) takes it down again.
void DispatchToolTipTimer(UI_Node* inNode, UI_NodeManager* inManager) {
  inNode->UI_RemoveTimer(UI_NodeManager::GetTooltipTimerID(), false);
  if (!inManager) return;
  UI_ToolTipManager* tips = inManager->GetToolTipManager();
  if (!tips || UI_Node::UI_GetToolTipForDisplay(inManager->GetMouseOverLeafNode()) != inNode) return;
  if (tips->GetToolTipNode() == inNode) {
    tips->DisposeToolTip();  // the display time has run out
  } else {
    tips->RefreshToolTip(inNode);  // the delay has run out: show it
  }
}

}  // namespace

void UI_Node::UI_InstallTimer(float inSeconds, long inTimerID) {
  UI_NodeTimerManager* manager = UI_GetTimerManager(false);
  if (!manager) return;
  // The same id replaces the earlier timer, interval and all.
  std::list<long>& ids = UI_GetTimerIDs();
  manager->RemoveTimer(this, inTimerID, ids);
  ids.push_back(manager->CreateTimer(this, inTimerID, inSeconds));
}

bool UI_Node::UI_RemoveTimer(long inTimerID, bool inFlag) {
  UI_NodeTimerManager* manager = UI_GetTimerManager(inFlag);
  if (!manager) return false;
  std::list<long> none;
  return manager->RemoveTimer(this, inTimerID, mExtras ? mExtras->timerIDs : none);
}

void UI_Node::UI_RemoveAllTimers() {
  if (UI_NodeTimerManager* manager = UI_GetTimerManager(false)) {
    std::list<long> none;
    manager->RemoveAllTimers(this, mExtras ? mExtras->timerIDs : none);
  } else if (mExtras) {
    mExtras->timerIDs.clear();
  }
}

void UI_Node::UI_InstallTimerNotifyFunction(TimerFunction inFunction) {
  UI_GetExtras().timerFunctions.push_back(std::move(inFunction));
}

bool UI_Node::UI_DispatchPossibleTimer(long inTimerKey) {
  UI_NodeTimerManager* timers = UI_GetTimerManager(false);
  if (!timers) return false;
  UI_NodeTimerData* data = timers->GetTimerData(inTimerKey);
  if (!data) return false;  // already removed: a late message is ignored
  const UI_NodeP node(data->GetNode());
  const long timerID = data->GetTimerID();
  if (!node || (node.get() != this && !node->UI_IsChildOf(*this))) return false;
  UI_NodeProtector protect(this);

  UI_NodeManager* manager = UI_NodeManager::Get();
  // A gesture on the node sees the node's timers first (auto-repeat, scrolling).
  if (manager) {
    const InputCaptureP capture(manager->GetActiveInputCapture(node.get()));
    if (capture && capture->DoTimerNotify(timerID)) return true;
  }

  if (timerID == UI_NodeManager::GetTooltipTimerID()) {
    DispatchToolTipTimer(node.get(), manager);
    return true;
  }

  if (!node->UI_DoTimerNotify(timerID)) node->UI_RemoveTimer(timerID, false);
  return true;
}

}  // namespace norvik::ui
