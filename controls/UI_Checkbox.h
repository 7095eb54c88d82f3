#pragma once
// A check box: a 14-pixel box left of its label, cycling off, on (and mixed
// when tri-state) on each click. The checkbox keeps its own three-way value;
// the button's two-way value underneath only follows the press.
#include "controls/UI_Button.h"
#include "controls/UI_TextControlBase.h"

namespace norvik::controls {

// The mark in a check box: the tick when on, the mixed bar when mixed or
// unknown, nothing when off. Scaled to the rectangle it is given.
class DrawCheckbox : public DrawButtonFace {
 public:
  explicit DrawCheckbox(const DrawCheckBoxParams& inParams) : mParams(inParams) {}
  void operator()(DrawParameters::StateFlags inState, const tarsel::geom::RectT<float>& inRect,
                  const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme& inTheme,
                  const ColorChangeMap* inMap) const override;
  void Paint(const tarsel::geom::RectT<float>& inBox, drawbot::Drawbot& inDrawbot) const;

 private:
  const DrawCheckBoxParams& mParams;
};

class UI_Checkbox : public UI_Button, public UI_TextControlBase {
 public:
  enum CheckboxValue { kOff = 0, kOn = 1, kMixed = 2 };

  explicit UI_Checkbox(const UTF16String& inText = UTF16String());

  static float GetDefaultCheckSize() { return 14; }
  void SetText(const UTF16String& inText);
  CheckboxValue GetValue() const { return mValue; }
  void SetValue(CheckboxValue inValue);
  void SetChecked(bool inChecked) { SetValue(inChecked ? kOn : kOff); }
  bool IsChecked() const { return mValue == kOn; }
  void SetTriState(bool inTriState) { mTriState = inTriState; }
  bool GetTriState() const { return mTriState; }
  // The user's step without telling anyone.
  void ToggleState();

  void SendButtonChangedMessage(ModKeys inModKeys) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  PointF UI_GetRecommendedSize() const override;

  // The box (left, inCheckSize wide) and the label (the rest, 3 further in).
  static std::pair<RectF, RectF> GetButtonTextRects(float inCheckSize, const RectF& inRect);
  static void Draw(const DrawCheckBoxParams& inParams, drawbot::Drawbot& inDrawbot);
  // The box's four nested gradients, its mark and the label, unclipped.
  static void DrawHelper(const DrawCheckBoxParams& inParams, drawbot::Drawbot& inDrawbot);

 private:
  CheckboxValue NextValue() const;

  CheckboxValue mValue = kOff;
  bool mTriState = false;
};

using UI_CheckboxP = boost::intrusive_ptr<UI_Checkbox>;

}  // namespace norvik::controls
