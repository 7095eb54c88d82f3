#include "controls/UI_RadioGroup.h"

#include <algorithm>

#include "ui/KeyboardEvent.h"
#include "ui/UI_Container.h"

namespace norvik::controls {

UI_RadioGroup::UI_RadioGroup() { UI_SetNodeID("UI_RadioGroup"); }

UI_RadioGroup::~UI_RadioGroup() = default;

void UI_RadioGroup::ChildAdded(ui::UI_Node* inChild) {
  UI_InteractiveControlView::ChildAdded(inChild);
  if (auto* radio = dynamic_cast<UI_RadioButton*>(inChild)) AssociateRadioButton(radio);
}

// The vector holds plain pointers; a removed child must leave it at once.
void UI_RadioGroup::ChildRemoved(ui::UI_Node* inChild) {
  mButtons.erase(std::remove(mButtons.begin(), mButtons.end(), inChild), mButtons.end());
  UI_InteractiveControlView::ChildRemoved(inChild);
}

void UI_RadioGroup::AssociateRadioButton(UI_RadioButton* inButton) {
  mButtons.push_back(inButton);
  if (!mTabFilter)
    mTabFilter = std::make_unique<ui::UI_NodeManager::AddAndRemoveKeyboardEventFilterNode>(
        ui::UI_NodeManager::Get(), this);
  // The button is owned by this group, so the listener cannot outlive it.
  inButton->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [this](UI_ControlChangedMessage* inMessage) { RadioChanged(inMessage); }));
}

void UI_RadioGroup::RadioChanged(UI_ControlChangedMessage* inMessage) {
  ui::UI_NodeProtector protector(this);
  const std::vector<UI_RadioButton*> buttons(mButtons);
  for (UI_RadioButton* button : buttons)
    if (button != inMessage->GetControl() && button->GetValue() == UI_Button::kButtonOn)
      button->SetValue(UI_Button::kButtonOff);
  SetValueKnown();
  ForwardControlMessageFromChild(inMessage);
}

int UI_RadioGroup::IndexOf(const UI_RadioButton* inButton) const {
  auto it = std::find(mButtons.begin(), mButtons.end(), inButton);
  return it == mButtons.end() ? -1 : static_cast<int>(it - mButtons.begin());
}

void UI_RadioGroup::SetIndex(int inIndex) {
  for (std::size_t i = 0; i < mButtons.size(); ++i)
    mButtons[i]->SetValue(static_cast<int>(i) == inIndex ? UI_Button::kButtonOn : UI_Button::kButtonOff);
  if (inIndex >= 0 && static_cast<std::size_t>(inIndex) < mButtons.size()) SetValueKnown();
}

void UI_RadioGroup::SetDrawBorder(bool inDraw) {
  if (mDrawBorder == inDraw) return;
  mDrawBorder = inDraw;
  UI_Invalidate(nullptr, 0);
}

// The border is the bevel's one-pixel outline alone: no fill, no rings, no
// outer gradient. The buttons then paint over the inside.
void UI_RadioGroup::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (!inDrawbot) return;
  if (mDrawBorder) {
    DrawButtonParameters params(this);
    DrawParameters::StateFlags state = params.GetControlState();
    state.Clear(kStateDown | kStateRollover | kStateFocused);
    params.SetControlState(state);
    params.SetDrawOuterBevelOutline(false);
    params.SetDrawInnerGradient(false);
    params.SetDrawInnerBevelOutline(false);
    UI_Button::Draw(params, *inDrawbot);
  }
  UI_InteractiveControlView::UI_Draw(inDrawbot);
}

int UI_RadioGroup::GetIndex() const { return IndexOf(GetSelectedRadioButton()); }

UI_RadioButton* UI_RadioGroup::GetSelectedRadioButton() const {
  for (UI_RadioButton* button : mButtons)
    if (button->GetValue() == UI_Button::kButtonOn) return button;
  return nullptr;
}

bool UI_RadioGroup::UI_GainKeyboardFocus(ui::FocusChangeReason inReason) {
  // Focus goes on to the selected button only when that button takes it: a
  // button that does not hands focus back to its parent, this group, and
  // forwarding again would never end.
  UI_RadioButton* selected = GetSelectedRadioButton();
  if (selected && selected->UI_WantsKeyboardFocus() &&
      (inReason != ui::kFocusChangeAdvance || selected->UI_WantsKeyboardFocusFromAdvance()))
    return selected->UI_GainKeyboardFocus(inReason);
  return UI_InteractiveControlView::UI_GainKeyboardFocus(inReason);
}

bool UI_RadioGroup::UI_DoPreKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) {
  if (inEvent.IsActionKeyDown() && inEvent.GetCode().GetControlCode() == ui::kControlCodeTab) {
    ModKeys keys = inEvent.GetModKey();
    keys.Clear(ui::kModKeyCapsLock);
    const bool forward = keys == ModKeys();
    auto* radio = dynamic_cast<UI_RadioButton*>(inTarget);
    if ((forward || keys == ModKeys(ui::kModKeyShift)) && radio && IndexOf(radio) >= 0 && LeaveGroup(forward))
      return true;
  }
  return UI_InteractiveControlView::UI_DoPreKeyboardEvent(inTarget, inEvent);
}

// The walk starts from the group's own place among its siblings, so none of
// the group's children is offered focus on the way out. When nothing outside
// takes focus the walk may come round to the group again, which hands focus
// back to its selected button.
bool UI_RadioGroup::LeaveGroup(bool inForward) {
  ui::UI_Container* parent = UI_GetParentContainer();
  if (!parent) return false;
  ui::UI_NodeProtector protector(this);
  ui::UI_Node::UI_AdvanceFocus(inForward, UI_GetIndex(), parent);
  return true;
}

bool UI_RadioGroup::UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) {
  const unsigned short code = inEvent.GetCode().GetControlCode();
  const bool previous = code == ui::kControlCodeLeft || code == ui::kControlCodeUp;
  const bool next = code == ui::kControlCodeRight || code == ui::kControlCodeDown;
  auto* target = dynamic_cast<UI_RadioButton*>(inTarget);
  if (!(previous || next) || !inEvent.IsActionKeyDown() || !target || IndexOf(target) < 0 ||
      target->UI_IsDisabled())
    return UI_InteractiveControlView::UI_DoKeyboardEvent(inTarget, inEvent);
  ui::UI_NodeProtector protector(this);
  UI_RadioButton* current = GetSelectedRadioButton();
  if (!current) current = mButtons.front();
  const int from = IndexOf(current);
  const int step = previous ? -1 : 1;
  UI_RadioButton* found = nullptr;
  for (int i = from + step; i >= 0 && i < static_cast<int>(mButtons.size()); i += step) {
    if (mButtons[i]->UI_IsEnabled() && mButtons[i]->UI_AreAllParentsVisible()) {
      found = mButtons[i];
      break;
    }
  }
  if (!found) {
    // At the end of the group the focused button becomes the selection.
    for (UI_RadioButton* button : mButtons)
      button->SetValue(button->UI_HasKeyboardFocus(false) ? UI_Button::kButtonOn : UI_Button::kButtonOff);
    if (UI_RadioButton* selected = GetSelectedRadioButton()) selected->PerformAction(true, inEvent.GetModKey(), false);
    return true;
  }
  current->SetValue(UI_Button::kButtonOff);
  found->SetValue(UI_Button::kButtonOn);
  found->PerformAction(true, inEvent.GetModKey(), false);
  found->UI_GainKeyboardFocus(ui::kFocusChangeAdvance);
  return true;
}

}  // namespace norvik::controls
