#pragma once
// A label that is not a button: one line cut to its width, or several
// lines wrapped at its width. It takes no focus and sends nothing; dialogs
// and layouts place it by its recommended size.
#include "controls/UI_ControlView.h"
#include "controls/UI_TextControlBase.h"

namespace norvik::controls {

class UI_StaticText : public UI_ControlView, public UI_TextControlBase {
 public:
  explicit UI_StaticText(const UTF16String& inText = UTF16String(), bool inMultiLine = false);

  void SetText(const UTF16String& inText);
  bool IsMultiLine() const { return mMultiLine; }
  void SetMultiLine(bool inMultiLine);
  // A size in pixels; 0 (or anything not above 0) is the theme's label size.
  float GetFontSize() const { return mFontSize; }
  void SetFontSize(float inSize);

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // One line: the text's width and line height. Several: the current width,
  // and the height of the text wrapped at it.
  PointF UI_GetRecommendedSize() const override;

 private:
  void FillLabel(DrawTextControlBaseParameters& ioText) const;

  bool mMultiLine;
  float mFontSize = 0;
};

using UI_StaticTextP = boost::intrusive_ptr<UI_StaticText>;

}  // namespace norvik::controls
