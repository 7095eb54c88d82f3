// The keyboard path: the recorder, the modifier notifier, an active capture,
// the keyboard filters, and then the focused node and each of its ancestors
// until one handles the key. A node may keep typed characters from climbing
// past it.
#include <vector>

#include "ui/ActionRecorder.h"
#include "ui/KeyboardCode.h"
#include "ui/KeyboardEvent.h"
#include "ui/UI_ModKeyNotifier.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

bool UI_Node::UI_DispatchKeyboardEvent(UI_Node* inNode, const KeyboardEvent& inEvent) {
  UI_NodeP target(inNode);
  automateui::ActionRecorder::GetInstance().RecordKeyboardEvent(inNode, inEvent);
  UI_ModKeyNotifier::Get().DispatchModKeyEvent(inEvent.GetModKey());
  if (UI_DispatchCapturedKeyboardEvent(inNode, inEvent)) return true;
  if (UI_NodeManager* manager = UI_NodeManager::Get(); manager && manager->DispatchPreKeyboardEvent(inNode, inEvent))
    return true;
  if (!inNode) return false;

  // The next ancestor is taken before each call, so a node that detaches
  // itself in its handler does not cut the walk short.
  UI_NodeP node(inNode);
  while (node) {
    UI_NodeP parent(node->UI_GetParentNode());
    if (node->UI_IsEnabled() && UI_DispatchKeyboardEventToNode(node.get(), inNode, inEvent)) return true;
    if (inEvent.IsActionKeyChar() && !node->UI_DispatchKeyboardCharEventToParent()) return false;
    node = std::move(parent);
  }
  // Unhandled: the platform's default handler gets the message.
  return false;
}

bool UI_Node::UI_DispatchKeyboardEventToNode(UI_Node* inNode, UI_Node* inTarget, const KeyboardEvent& inEvent) {
  UI_NodeP protector(inNode);
  if (CustomKeyboardFunction custom = inNode->UI_GetCustomKeyboardEventFunction()) {
    bool tookOver = false;
    bool result = (*custom)(inTarget, inEvent, tookOver);
    if (tookOver) return result;
  }
  return inNode->UI_DoKeyboardEvent(inTarget, inEvent);
}

bool UI_NodeManager::DispatchPreKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) {
  if (inEvent.GetModKey() != mLastModKeys) {
    // A modifier can change the cursor without the mouse moving.
    if (mMouseOverRoot) {
      UI_NodeP root(mMouseOverRoot);
      tarsel::geom::PointT<long> local = root->UI_GlobalToLocal(GetGlobalMousePosition());
      root->UI_DispatchCursor(tarsel::geom::PointT<float>(local), inEvent.GetModKey(), false);
    }
    mLastModKeys = inEvent.GetModKey();
  }
  if (mKeyboardFilters.empty()) return false;
  // A copy, so that a filter may remove itself or another one.
  std::vector<UI_NodeP> filters(mKeyboardFilters.begin(), mKeyboardFilters.end());
  for (const UI_NodeP& filter : filters) {
    if (filter->UI_DoPreKeyboardEvent(inTarget, inEvent)) return true;
  }
  return false;
}

bool UI_NodeManager::CompareControlActivateShortcut(const KeyboardEvent& inEvent) {
  const KeyboardCode space = KeyboardCode::CreateFromControlCode(kControlCodeSpace);
  const KeyboardCode enter = KeyboardCode::CreateFromControlCode(kControlCodeEnter);
  const KeyboardCode returnKey = KeyboardCode::CreateFromControlCode(kControlCodeReturn);
  const ModifierKeys none;
  const ModifierKeys ctrl(kModKeyCtrl);
  if (inEvent.IsActionKeyDown() && !inEvent.IsRepeat()) {
    return inEvent.CompareShortcut(space, none) || inEvent.CompareShortcut(enter, ctrl) ||
           inEvent.CompareShortcut(returnKey, ctrl);
  }
  if (inEvent.IsActionKeyUp()) {
    return inEvent.CompareShortcut(space, none) || inEvent.CompareCode(enter) || inEvent.CompareCode(returnKey);
  }
  return false;
}

}  // namespace norvik::ui
