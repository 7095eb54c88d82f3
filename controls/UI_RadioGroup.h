#pragma once
// A control that owns radio buttons: at most one of its direct radio children
// is on, arrow keys move the selection (without wrapping), and the group's
// listeners hear each child's change as the group's own.
#include <vector>

#include "controls/UI_RadioButton.h"

namespace norvik::controls {

class UI_RadioGroup : public UI_InteractiveControlView {
 public:
  UI_RadioGroup();
  ~UI_RadioGroup() override;

  void ChildAdded(ui::UI_Node* inChild) override;
  void ChildRemoved(ui::UI_Node* inChild) override;
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  bool UI_GainKeyboardFocus(ui::FocusChangeReason inReason) override;

  // Index i among the radio children goes on, the others off.
  void SetIndex(int inIndex);
  // The index of the radio child that is on, or -1.
  int GetIndex() const;
  UI_RadioButton* GetSelectedRadioButton() const;
  void SetDrawBorder(bool inDraw) { mDrawBorder = inDraw; }

 private:
  void AssociateRadioButton(UI_RadioButton* inButton);
  void RadioChanged(UI_ControlChangedMessage* inMessage);
  int IndexOf(const UI_RadioButton* inButton) const;

  std::vector<UI_RadioButton*> mButtons;
  bool mDrawBorder = false;
};

}  // namespace norvik::controls
