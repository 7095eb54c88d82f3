#include "controls/UI_TextButton.h"

#include <algorithm>

#include "controls/DrawButtonFaces.h"
#include "drawbot/Drawbot.h"
#include "ui/KeyboardEvent.h"

namespace norvik::controls {

namespace {
constexpr float kTextMargin = 10;     // left and right of the label
constexpr float kTextVerticalPad = 9;  // 4 above, 4 below, 1 for the free top row
}  // namespace

float RoundHalfAway(float inValue) {
  return static_cast<float>(static_cast<long>(inValue < 0 ? inValue - 0.5f : inValue + 0.5f));
}

UI_TextButton::UI_TextButton() { UI_SetNodeID("UI_TextButton"); }

UI_TextButton::UI_TextButton(const UTF16String& inText) : UI_TextButton() { SetText(inText); }

void UI_TextButton::SetText(const UTF16String& inText) {
  mBaseName = inText;
  UTF16String display;
  UI_ProcessStringAndSetMnemonic(inText, display);
  if (display == GetText()) return;
  StoreText(display);
  UI_Invalidate(nullptr, 0);
}

void UI_TextButton::InsertModifiedName(ModKeys inKeys, const UTF16String& inText) {
  mNameKeyMask |= inKeys;
  mModifiedNames.emplace_back(inKeys, inText);
  SetModifierKeyCallbackEnabled(true);
}

void UI_TextButton::ModKeyChanged(ModKeys inModKeys) {
  if (inModKeys != GetCurrentModKeys() && !mModifiedNames.empty()) {
    UTF16String name = mBaseName;
    for (const auto& [keys, text] : mModifiedNames) {
      if (keys == (mNameKeyMask & inModKeys)) {
        name = text;
        break;
      }
    }
    UTF16String display;
    UI_ProcessStringAndSetMnemonic(name, display);
    if (display != GetText()) {
      StoreText(display);
      UI_Invalidate(nullptr, 0);
    }
  }
  UI_Button::ModKeyChanged(inModKeys);
}

bool UI_TextButton::UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) {
  if (mReturnActivates && !UI_IsDisabled() &&
      inEvent.CompareShortcut(ui::KeyboardCode::CreateFromControlCode(ui::kControlCodeReturn), ui::kModKeyNone))
    return HandleControlActivateViaKeyboard(inEvent);
  return UI_Button::UI_DoKeyboardEvent(inTarget, inEvent);
}

void UI_TextButton::FillTextButtonParameters(DrawTextButtonParameters& ioParams) const {
  FillButtonParameters(ioParams);
  FillTextParameters(ioParams, ioParams.GetTheme().get());
  const auto state = ioParams.GetControlState();
  const bool lit = state.TestAny(kStateRollover | kStateDown) && !state.Test(kStateDisabled);
  ioParams.SetDrawOutline(lit && !ShouldDisplayBorderNever());
  if (GetDownState()) ioParams.SetOffset(ioParams.GetOffset() + GetDownOffset());
  FillDefaultAppearance(ioParams);
}

void UI_TextButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawTextButtonParameters params(this);
  FillTextButtonParameters(params);
  Draw(params, *inDrawbot);
}

void UI_TextButton::Draw(const DrawTextButtonParameters& inParams, drawbot::Drawbot& inDrawbot) {
  const DrawButtonText face(inParams, inParams, inParams.GetTextIndent());
  DrawTextButtonParameters withFace(inParams);
  withFace.SetDrawButtonFace(&face);
  UI_Button::Draw(withFace, inDrawbot);
}

ui::UI_Node::PointF UI_TextButton::RecommendedSize(float inTextWidth, float inFontSize) {
  if (inTextWidth <= 0 || inFontSize <= 0) return PointF(0, RoundHalfAway(inFontSize + kTextVerticalPad));
  return PointF(RoundHalfAway(2 * kTextMargin + inTextWidth), RoundHalfAway(inFontSize + kTextVerticalPad));
}

ui::UI_Node::PointF UI_TextButton::UI_GetRecommendedSize() const {
  DrawTextControlBaseParameters text;
  FillTextParameters(text, UI_GetCurrentTheme().get());
  const float width = MeasureControlLabel(text, GetText());
  PointF size = RecommendedSize(width, text.GetFontSize());
  size.y = RoundHalfAway(std::max(text.GetFontSize() + kTextVerticalPad, UI_GetLocalRectF(false).height));
  return size;
}

}  // namespace norvik::controls
