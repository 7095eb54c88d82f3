#include "controls/UI_Checkbox.h"

#include "drawbot/Drawbot.h"

namespace norvik::controls {

UI_Checkbox::UI_Checkbox(const UTF16String& inText) {
  UI_SetNodeID("UI_Checkbox");
  SetTextAlignment(drawbot::kTextAlignLeft);
  SetText(inText);
}

void UI_Checkbox::SetText(const UTF16String& inText) {
  UTF16String display;
  UI_ProcessStringAndSetMnemonic(inText, display);
  if (display == GetText()) return;
  StoreText(display);
  UI_Invalidate(nullptr, 0);
}

void UI_Checkbox::SetValue(CheckboxValue inValue) {
  SetValueKnown();
  if (mValue == inValue) return;
  mValue = inValue;
  UI_Invalidate(nullptr, 0);
}

UI_Checkbox::CheckboxValue UI_Checkbox::NextValue() const {
  switch (mValue) {
    case kOff: return kOn;
    case kOn: return mTriState ? kMixed : kOff;
    case kMixed: return kOff;
  }
  return kOff;
}

void UI_Checkbox::ToggleState() { SetValue(NextValue()); }

// The step runs before the base's message, so listeners read the new value.
// The base then writes its own two-way value, which the checkbox ignores.
void UI_Checkbox::SendButtonChangedMessage(ModKeys inModKeys) {
  ui::UI_NodeProtector protector(this);
  ToggleState();
  UI_Button::SendButtonChangedMessage(inModKeys);
}

void UI_Checkbox::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawCheckBoxParams params(this);
  FillButtonParameters(params);
  FillTextParameters(params, params.GetTheme().get());
  params.SetValue(mValue);
  params.SetCheckSize(GetDefaultCheckSize());
  Draw(params, *inDrawbot);
}

ui::UI_Node::PointF UI_Checkbox::UI_GetRecommendedSize() const {
  DrawTextControlBaseParameters text;
  FillTextParameters(text, UI_GetCurrentTheme().get());
  const float width = MeasureControlLabel(text, GetText());
  const float gap = GetText().empty() ? 0 : 3;
  return PointF(width + GetDefaultCheckSize() + gap, std::max(GetDefaultCheckSize(), text.GetFontSize() + 4));
}

}  // namespace norvik::controls
