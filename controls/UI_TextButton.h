#pragma once
// A push button with a label. The label's mnemonic marker is stripped when
// the text is set; the bevel's outline shows only while the button is rolled
// over or pressed.
#include <utility>
#include <vector>

#include "controls/UI_Button.h"
#include "controls/UI_TextControlBase.h"

namespace norvik::controls {

class UI_TextButton : public UI_Button, public UI_TextControlBase {
 public:
  UI_TextButton();
  explicit UI_TextButton(const UTF16String& inText);

  void SetText(const UTF16String& inText);
  // A label shown while exactly these modifier keys are held.
  void InsertModifiedName(ModKeys inKeys, const UTF16String& inText);
  void ModKeyChanged(ModKeys inModKeys) override;
  void SetSupportLegacyWindowsKeyboardActivation(bool inOn) { mReturnActivates = inOn; }
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  PointF UI_GetRecommendedSize() const override;

  // Width and height for a label of width inTextWidth in a font of inFontSize.
  static PointF RecommendedSize(float inTextWidth, float inFontSize);
  static void Draw(const DrawTextButtonParameters& inParams, drawbot::Drawbot& inDrawbot);

 protected:
  // The record of this button's current look.
  void FillTextButtonParameters(DrawTextButtonParameters& ioParams) const;

 private:
  UTF16String mBaseName;
  std::vector<std::pair<ModKeys, UTF16String>> mModifiedNames;
  ModKeys mNameKeyMask;
  bool mReturnActivates = false;
};

using UI_TextButtonP = boost::intrusive_ptr<UI_TextButton>;

// Rounds half away from zero.
float RoundHalfAway(float inValue);

}  // namespace norvik::controls
