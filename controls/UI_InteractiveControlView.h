#pragma once
// A control whose value the user changes by a gesture. Listeners of the
// interactive list follow the gesture as a transaction: begin, any number of
// continues (each after the value moved), then finish or cancel. The final
// changed message belongs to the control, not to the transaction.
#include <list>

#include "controls/UI_ControlView.h"

namespace norvik::controls {

class UI_InteractiveControlView : public UI_ControlView {
 public:
  UI_InteractiveControlView();
  ~UI_InteractiveControlView() override;

  void NotifyWhenChangedInteractively(const InteractiveFunctionP& inFunction) {
    mInteractiveList.push_back(inFunction);
  }
  std::size_t InteractiveCallbackSize() const { return mInteractiveList.size(); }
  bool IsChangePending() const { return mChangePending; }

  void BeginInteractiveChange();
  void ContinueInteractiveChange(ModKeys inModKeys);
  void ContinueInteractiveChange() { ContinueInteractiveChange(ModKeys()); }
  void FinishInteractiveChange();
  void CancelInteractiveChange();
  void FinishedUserChange() { SendValueChangedMessage(); }
  // A composite passes a child's transaction on as its own.
  void ForwardInteractiveControlMessageFromChild(UI_InteractiveControlChangedMessage* inMessage);

 private:
  void SendInteractive(UI_InteractiveControlChangedMessage::ChangeMessage inChange, ModKeys inModKeys);

  std::list<InteractiveFunctionP> mInteractiveList;
  bool mChangePending = false;
};

// Begins a change on construction; cancels it on destruction unless Finish
// was called, so that an exception or an early return rolls the change back.
class ScBeginAndEndInteractiveChange {
 public:
  explicit ScBeginAndEndInteractiveChange(UI_InteractiveControlView* inControl);
  ~ScBeginAndEndInteractiveChange();
  ScBeginAndEndInteractiveChange(const ScBeginAndEndInteractiveChange&) = delete;
  ScBeginAndEndInteractiveChange& operator=(const ScBeginAndEndInteractiveChange&) = delete;
  void Finish();

 private:
  UI_InteractiveControlView* mControl;
  ui::UI_NodeProtector mProtector;
  bool mFinished = false;
};

}  // namespace norvik::controls
