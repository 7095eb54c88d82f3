#include "controls/UI_RadioButton.h"

#include "drawbot/Drawbot.h"

namespace norvik::controls {

UI_RadioButton::UI_RadioButton(const UTF16String& inText) {
  UI_SetNodeID("UI_RadioButton");
  SetTextAlignment(drawbot::kTextAlignLeft);
  // A radio button stays on after its press; only the group turns it off.
  SetSpringLoaded(false);
  SetText(inText);
}

void UI_RadioButton::SetText(const UTF16String& inText) {
  UTF16String display;
  UI_ProcessStringAndSetMnemonic(inText, display);
  if (display == GetText()) return;
  StoreText(display);
  UI_Invalidate(nullptr, 0);
}

// Clicking a radio button that is on sends a message all the same.
void UI_RadioButton::SendButtonChangedMessage(ModKeys inModKeys) {
  ui::UI_NodeProtector protector(this);
  // Whatever the press did to the look, the button ends on.
  SetDownState(true);
  UI_Button::SendButtonChangedMessage(inModKeys);
}

void UI_RadioButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawRadioButtonParams params(this);
  FillButtonParameters(params);
  FillTextParameters(params, params.GetTheme().get());
  params.SetOn(GetValue() == kButtonOn);
  // The down bit is the press look; on is carried by the record's own flag.
  auto state = params.GetControlState();
  if (!IsButtonCaptured() && !IsKeyDownPending()) state.Clear(kStateDown);
  params.SetControlState(state);
  params.SetButtonSize(GetDefaultButtonSize());
  Draw(params, *inDrawbot);
}

ui::UI_Node::PointF UI_RadioButton::UI_GetRecommendedSize() const {
  DrawTextControlBaseParameters text;
  FillTextParameters(text, UI_GetCurrentTheme().get());
  const float width = MeasureControlLabel(text, GetText());
  const float gap = GetText().empty() ? 0 : 3;
  return PointF(width + GetDefaultButtonSize() + gap, std::max(GetDefaultButtonSize(), text.GetFontSize() + 4));
}

}  // namespace norvik::controls
