#pragma once
// A radio button: a round 14-pixel button left of its label. A click turns it
// on and never off; turning the others of a group off is the group's work.
#include "controls/UI_Button.h"
#include "controls/UI_TextControlBase.h"

namespace norvik::controls {

class UI_RadioButton : public UI_Button, public UI_TextControlBase {
 public:
  explicit UI_RadioButton(const UTF16String& inText = UTF16String());

  static float GetDefaultButtonSize() { return 14; }
  void SetText(const UTF16String& inText);
  void SendButtonChangedMessage(ModKeys inModKeys) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  PointF UI_GetRecommendedSize() const override;

  static std::pair<RectF, RectF> GetButtonTextRects(float inButtonSize, const RectF& inRect);
  static void Draw(const DrawRadioButtonParams& inParams, drawbot::Drawbot& inDrawbot);
};

using UI_RadioButtonP = boost::intrusive_ptr<UI_RadioButton>;

}  // namespace norvik::controls
