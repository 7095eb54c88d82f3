#include "controls/UI_StaticText.h"

#include <cmath>

#include "drawbot/Drawbot.h"

namespace norvik::controls {

UI_StaticText::UI_StaticText(const UTF16String& inText, bool inMultiLine) : mMultiLine(inMultiLine) {
  UI_SetNodeID("UI_StaticText");
  SetTextAlignment(drawbot::kTextAlignLeft);
  SetTextTruncation(drawbot::kTextTruncationEndWithEllipsis);
  SetText(inText);
}

void UI_StaticText::SetText(const UTF16String& inText) {
  if (inText == GetText()) return;
  StoreText(inText);
  UI_Invalidate(nullptr, 0);
}

void UI_StaticText::SetMultiLine(bool inMultiLine) {
  if (inMultiLine == mMultiLine) return;
  mMultiLine = inMultiLine;
  UI_Invalidate(nullptr, 0);
}

void UI_StaticText::SetFontSize(float inSize) {
  const float size = std::isfinite(inSize) && inSize > 0 ? inSize : 0.0f;
  if (size == mFontSize) return;
  mFontSize = size;
  UI_Invalidate(nullptr, 0);
}

void UI_StaticText::FillLabel(DrawTextControlBaseParameters& ioText) const {
  FillTextParameters(ioText, UI_GetCurrentTheme().get());
  if (mFontSize > 0) ioText.SetFontSize(mFontSize);
}

ui::UI_Node::PointF UI_StaticText::UI_GetRecommendedSize() const {
  DrawTextControlBaseParameters text;
  FillLabel(text);
  if (!mMultiLine) return MeasureControlLabelBlock(text, GetText(), 0);
  return MeasureControlLabelBlock(text, GetText(), UI_GetLocalRectF(false).width);
}

void UI_StaticText::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (!inDrawbot) return;
  DrawParameters params(this);
  DrawTextControlBaseParameters text;
  FillLabel(text);
  const RectF bounds(0, 0, UI_GetLocalRectF(false).width, UI_GetLocalRectF(false).height);
  if (mMultiLine)
    DrawControlLabelLines(params, text, bounds, *inDrawbot);
  else
    DrawControlLabel(params, text, bounds, *inDrawbot);
}

}  // namespace norvik::controls
