#include "controls/UI_InteractiveControlView.h"

namespace norvik::controls {

UI_InteractiveControlView::UI_InteractiveControlView() { UI_SetNodeID("UI_InteractiveControlView"); }

UI_InteractiveControlView::~UI_InteractiveControlView() = default;

void UI_InteractiveControlView::SendInteractive(UI_InteractiveControlChangedMessage::ChangeMessage inChange,
                                                ModKeys inModKeys) {
  if (mInteractiveList.empty()) return;
  ui::UI_NodeProtector protector(this);
  UI_InteractiveControlChangedMessage message(this, inChange, inModKeys);
  CallListeners(mInteractiveList, &message);
}

void UI_InteractiveControlView::BeginInteractiveChange() {
  mChangePending = true;
  SendInteractive(UI_InteractiveControlChangedMessage::kBegin, ModKeys());
}

void UI_InteractiveControlView::ContinueInteractiveChange(ModKeys inModKeys) {
  SendInteractive(UI_InteractiveControlChangedMessage::kContinue, inModKeys);
}

// Pending is cleared even when a listener throws, so that a failed gesture
// does not leave the control looking mid-change.
void UI_InteractiveControlView::FinishInteractiveChange() {
  struct Clear {
    bool& flag;
    ~Clear() { flag = false; }
  } clear{mChangePending};
  SendInteractive(UI_InteractiveControlChangedMessage::kFinish, ModKeys());
}

void UI_InteractiveControlView::CancelInteractiveChange() {
  struct Clear {
    bool& flag;
    ~Clear() { flag = false; }
  } clear{mChangePending};
  SendInteractive(UI_InteractiveControlChangedMessage::kCancel, ModKeys());
}

void UI_InteractiveControlView::ForwardInteractiveControlMessageFromChild(
    UI_InteractiveControlChangedMessage* inMessage) {
  switch (inMessage->GetChangeMessage()) {
    case UI_InteractiveControlChangedMessage::kBegin:
      BeginInteractiveChange();
      break;
    case UI_InteractiveControlChangedMessage::kContinue:
      inMessage->SetControl(this);
      CallListeners(mInteractiveList, inMessage);
      break;
    case UI_InteractiveControlChangedMessage::kFinish:
      FinishInteractiveChange();
      SendValueChangedMessage();
      break;
    case UI_InteractiveControlChangedMessage::kCancel:
      CancelInteractiveChange();
      break;
  }
}

ScBeginAndEndInteractiveChange::ScBeginAndEndInteractiveChange(UI_InteractiveControlView* inControl)
    : mControl(inControl), mProtector(inControl) {
  mControl->BeginInteractiveChange();
}

ScBeginAndEndInteractiveChange::~ScBeginAndEndInteractiveChange() {
  if (mFinished) return;
  try {
    mControl->CancelInteractiveChange();
  } catch (...) {
    // A destructor may run while an exception unwinds; the first failure is the one reported.
  }
}

void ScBeginAndEndInteractiveChange::Finish() {
  if (mFinished) return;
  mFinished = true;
  mControl->FinishInteractiveChange();
}

}  // namespace norvik::controls
