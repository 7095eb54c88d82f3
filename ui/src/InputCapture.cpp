#include "ui/InputCapture.h"

#include "ui/InputPlatform.h"
#include "ui/KeyboardCode.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_SuspendToolTips.h"

namespace norvik::ui {

InputCapture::InputCapture(boost::intrusive_ptr<UI_Node> inNode, const MouseEvent& inInitialEvent)
    : mInitialMouseEvent(inInitialEvent), mPreviousMouseEvent(inInitialEvent), mNode(std::move(inNode)) {}

InputCapture::~InputCapture() {
  if (mSetCapture && mNode) {
    mSetCapture = false;
    mNode->UI_ReleaseCapture();
  }
  mSuspendToolTips.reset();
}

void InputCapture::InvokeBegin() {
  UI_NodeManager* manager = UI_NodeManager::Get();
  mSuspendToolTips = std::make_unique<UI_SuspendToolTips>(manager ? manager->GetToolTipManager() : nullptr);
  mBegun = true;
  Begin();
  if (mNode) {
    mNode->UI_SetCapture();
    mSetCapture = true;
  }
}

void InputCapture::InvokeEnd(bool inCancelled) {
  mSuspendToolTips.reset();
  if (mSetCapture) {
    mSetCapture = false;
    if (mNode) mNode->UI_ReleaseCapture();
  }
  if (inCancelled) mCancelled = true;
  if (mBegun && !mEnded) {
    mEnded = true;
    End();
  }
}

// ----------------------------------------------------------------- manager side

InputCapture* UI_NodeManager::GetActiveInputCapture(const UI_Node* inNode) const {
  InputCapture* capture = mInputCapture.get();
  if (!capture || capture->HasBeenCancelled()) return nullptr;
  if (inNode && capture->GetNode() != inNode) return nullptr;
  return capture;
}

// ------------------------------------------------------------- captured dispatch

namespace {

// inPoint, in inFrom's coordinates, in the coordinates of inTo; both may sit
// in different trees, which meet in global coordinates.
UI_Node::PointF ConvertBetweenNodes(const UI_Node* inFrom, const UI_Node* inTo, const UI_Node::PointF& inPoint) {
  if (inFrom == inTo) return inPoint;
  UI_Node::PointF global = UI_Node::UI_GetSelfToRootMatrix(inFrom).Transform(inPoint);
  return UI_Node::UI_GetSelfToRootMatrix(inTo).Inverse().Transform(global);
}

}  // namespace

bool UI_Node::UI_DispatchCapturedMouseEvent(UI_Node* inNode, const MouseEvent& inEvent) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  InputCaptureP capture(manager ? manager->GetActiveInputCapture(nullptr) : nullptr);
  if (!capture) return false;

  MouseEvent copy(inEvent);
  UI_DispatchCapturedCursor(inNode, copy.GetPosition(), copy.GetModKey());
  if (UI_Node* captureNode = capture->GetNode(); captureNode && inNode && captureNode != inNode)
    copy.SetPosition(ConvertBetweenNodes(inNode, captureNode, copy.GetPosition()));

  bool handled = capture->DoMouseEvent(copy);
  // The gesture ends itself with the release of the button that started it,
  // unless DoMouseEvent claimed that release. The capture may already have
  // been replaced or ended from inside DoMouseEvent; only this one is ended.
  if (!handled && copy.IsEndDragEvent(capture->GetInitialMouseEvent()) && manager == UI_NodeManager::Get() &&
      manager->GetInputCapture() == capture)
    manager->EndInputCapture(false);
  if (!copy.IsAction(MouseEvent::kActionMouseOver)) capture->mPreviousMouseEvent = copy;
  return true;
}

bool UI_Node::UI_DispatchCapturedCursor(UI_Node* inNode, const PointF& inPoint, ModKeys inModKeys) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager) return false;
  InputCaptureP capture(manager->GetActiveInputCapture(nullptr));
  if (!capture) return manager->IsSuspendingMouseOverUpdates();

  PointF point = inPoint;
  if (UI_Node* captureNode = capture->GetNode(); captureNode && inNode && captureNode != inNode)
    point = ConvertBetweenNodes(inNode, captureNode, inPoint);
  if (!capture->DoCursor(point, inModKeys)) GetInputPlatform().SetDefaultCursor();
  return true;
}

bool UI_Node::UI_DispatchCapturedKeyboardEvent(UI_Node*, const KeyboardEvent& inEvent) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  InputCaptureP capture(manager ? manager->GetActiveInputCapture(nullptr) : nullptr);
  if (!capture) return false;

  if (UI_NodeP captureNode = capture->GetNode()) {
    // A modifier pressed during a gesture can change its cursor at once.
    UI_DispatchCapturedCursor(captureNode.get(), capture->GetPreviousMouseEvent().GetPosition(), inEvent.GetModKey());
    bool handled = capture->DoKeyboardEvent(inEvent);
    bool isBareEscape = inEvent.IsActionKeyDown() &&
                        KeyboardEvent::GetControlCode(inEvent.GetOSCode()) == kControlCodeEscape &&
                        inEvent.GetModKey().IsEmpty();
    if (!handled && isBareEscape && manager == UI_NodeManager::Get() && manager->GetInputCapture() == capture)
      manager->EndInputCapture(true);
  }
  return true;
}

}  // namespace norvik::ui
