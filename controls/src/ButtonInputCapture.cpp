#include "controls/ButtonInputCapture.h"

#include "controls/ControlClock.h"
#include "controls/UI_Button.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

ButtonInputCapture::ButtonInputCapture(UI_Button* inButton, const ui::MouseEvent& inEvent, float inRepeatInterval)
    : ui::InputCapture(inButton, inEvent), mRepeatInterval(inRepeatInterval), mModKeys(inEvent.GetModKey()) {
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get();
  mTimerID = manager ? manager->GetUniqueTimerID() : -2;
}

UI_Button* ButtonInputCapture::Button() const { return static_cast<UI_Button*>(GetNode()); }

void ButtonInputCapture::Begin() {
  UI_Button* button = Button();
  if (mRepeatInterval != 0) {
    mStartTime = ControlClockNow();
    button->UI_InstallTimer(mRepeatInterval, mTimerID);
  }
  mSavedDownState = button->GetDownState();
  button->SetDownState(!mSavedDownState);
  button->BeginInteractiveChange();
  button->UI_Invalidate(nullptr, 0);
}

// The look follows the tree's mouse-over state rather than the button's
// rectangle, so that a node lying over part of the button lifts the press.
bool ButtonInputCapture::DoMouseEvent(const ui::MouseEvent& inEvent) {
  UI_Button* button = Button();
  if (inEvent.IsEndDragEvent(GetInitialMouseEvent())) {
    mModKeys = inEvent.GetModKey();
    const bool inside = button->UI_HitTest(inEvent.GetPosition());
    if (ui::UI_NodeManager* manager = ui::UI_NodeManager::Get()) manager->EndInputCapture(!inside);
    return true;
  }
  if (inEvent.IsAction(ui::MouseEvent::kActionMove)) {
    button->SetDownState(button->UI_IsMouseOver(false) ? !mSavedDownState : mSavedDownState);
    return true;
  }
  return false;
}

bool ButtonInputCapture::DoTimerNotify(long inTimerID) {
  if (inTimerID != mTimerID) return false;
  UI_Button* button = Button();
  const bool inside = button->GetDownState() != mSavedDownState;
  if (inside && ControlClockNow() - mStartTime > UI_Button::GetDefaultButtonRepeatDelay()) {
    button->ContinueInteractiveChange();
    mRepeated = true;
  }
  return true;
}

void ButtonInputCapture::End() {
  UI_Button* button = Button();
  ui::UI_NodeProtector protector(button);
  if (mRepeatInterval != 0) button->UI_RemoveTimer(mTimerID, false);
  if (HasBeenCancelled()) {
    button->SetDownState(mSavedDownState);
    button->CancelInteractiveChange();
  } else {
    // A listener that throws leaves the transaction cancelled, not pending.
    try {
      button->PerformAction(!mSavedDownState, mModKeys, false);
      if (!mRepeated) button->ContinueInteractiveChange(mModKeys);
    } catch (...) {
      button->CancelInteractiveChange();
      button->UI_Invalidate(nullptr, 0);
      throw;
    }
    button->FinishInteractiveChange();
  }
  button->UI_Invalidate(nullptr, 0);
}

}  // namespace norvik::controls
