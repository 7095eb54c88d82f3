#include "controls/UI_PictureTextButton.h"

#include <cmath>

#include "drawbot/Drawbot.h"

namespace norvik::controls {

UI_PictureTextButton::UI_PictureTextButton(const UTF16String& inText) : UI_TextButton(inText) {
  UI_SetNodeID("UI_PictureTextButton");
  SetTextAlignment(drawbot::kTextAlignLeft);
}

void UI_PictureTextButton::SetSpacingBetweenPictureAndText(float inSpacing) {
  if (mSpacing == inSpacing) return;
  mSpacing = inSpacing;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureTextButton::SetPictureVerticalOffset(float inOffset) {
  if (mVerticalOffset == inOffset) return;
  mVerticalOffset = inOffset;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureTextButton::SetScale(float inScale) {
  if (mScale == inScale) return;
  mScale = inScale;
  UI_Invalidate(nullptr, 0);
}

std::pair<ui::UI_Node::RectF, ui::UI_Node::RectF> UI_PictureTextButton::ComputeTextAndImageOffset(
    const RectF& inRect) const {
  const float size = GetPictureSize();
  const RectF picture(inRect.left + 2, std::floor(inRect.top + (inRect.height - size) / 2 + mVerticalOffset), size,
                      size);
  const float textLeft = picture.left + size + mSpacing;
  return {picture, RectF(textLeft, inRect.top, std::max(0.0f, inRect.left + inRect.width - textLeft), inRect.height)};
}

void UI_PictureTextButton::DrawPicture(const DrawParameters&, const RectF&, drawbot::Drawbot&) {}

void UI_PictureTextButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawPictureTextButtonParameters params(this);
  FillTextButtonParameters(params);
  const RectF bounds = params.GetRectF();
  const auto [picture, text] = ComputeTextAndImageOffset(bounds);
  // The bevel shows only while lit; the picture and label stand on it.
  params.SetText(UTF16String());
  UI_Button::Draw(params, *inDrawbot);
  DrawPicture(params, picture, *inDrawbot);
  DrawTextControlBaseParameters label(params);
  label.SetText(GetText());
  DrawControlLabel(params, label, text, *inDrawbot);
}

}  // namespace norvik::controls
