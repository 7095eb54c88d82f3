#pragma once
// One working button of every kind, in a row that wraps, and a status line
// under them that says what the last one did ("Text button pressed",
// "Checkbox: on"). The radio buttons stand in a radio group.
#include <vector>

#include "ButtonSamples.h"
#include "ui/UI_SubView.h"

namespace norvik::controls {
class UI_RadioGroup;
}

namespace norvik::gallery {

class LiveButtonsView : public ui::UI_SubView {
 public:
  LiveButtonsView();

  // The live button of inKind; for radio buttons, the first of the group.
  controls::UI_ControlView* GetButton(ButtonKind inKind) const;
  controls::UI_RadioGroup* GetRadioGroup() const;
  const UTF16String& GetStatus() const { return mStatus; }
  // The height the buttons and the status line need at inWidth.
  float GetHeightForWidth(float inWidth) const;

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

  static constexpr float kRowHeight = 30;
  static constexpr float kStatusHeight = 20;

 private:
  // The frames of the buttons (the radio group counting as one) at inWidth,
  // and the bottom of the last row.
  std::vector<RectF> Flow(float inWidth, float& outBottom) const;
  void Arrange();
  void SetStatus(const UTF16String& inStatus);
  void Listen(controls::UI_ControlView& inControl, ButtonKind inKind);
  UTF16String Describe(ButtonKind inKind) const;

  std::vector<controls::UI_ControlViewP> mButtons;  // by kind; the radio entry is the first radio
  std::vector<ui::UI_NodeP> mItems;           // what is laid out: the buttons and the radio group
  ui::UI_NodeP mRadioGroup;
  std::vector<ui::UI_NodeP> mRadios;
  UTF16String mStatus;
};

}  // namespace norvik::gallery
