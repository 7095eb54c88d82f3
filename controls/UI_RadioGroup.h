#pragma once
// A control that owns radio buttons: at most one of its direct radio children
// is on, arrow keys move the selection (without wrapping), and the group's
// listeners hear each child's change as the group's own. The group is one tab
// stop: Tab and Shift+Tab on one of its buttons leave the group rather than
// walking through its other buttons.
#include <memory>
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
  bool UI_DoPreKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  bool UI_GainKeyboardFocus(ui::FocusChangeReason inReason) override;

  // Index i among the radio children goes on, the others off.
  void SetIndex(int inIndex);
  // The index of the radio child that is on, or -1.
  int GetIndex() const;
  UI_RadioButton* GetSelectedRadioButton() const;
  // A one-pixel outline in the buttons' outline colour around the group.
  void SetDrawBorder(bool inDraw);
  bool GetDrawBorder() const { return mDrawBorder; }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

 private:
  void AssociateRadioButton(UI_RadioButton* inButton);
  void RadioChanged(UI_ControlChangedMessage* inMessage);
  int IndexOf(const UI_RadioButton* inButton) const;
  // Moves focus to the next (or previous) node in tab order outside the group.
  bool LeaveGroup(bool inForward);

  std::vector<UI_RadioButton*> mButtons;
  // Holds the group among the keyboard filters while it has buttons, so that
  // it sees Tab before the focused button's ancestors advance focus.
  std::unique_ptr<ui::UI_NodeManager::AddAndRemoveKeyboardEventFilterNode> mTabFilter;
  bool mDrawBorder = false;
};

}  // namespace norvik::controls
