#include "controls/UI_PictureTextButton.h"

#include <algorithm>
#include <cmath>

#include "controls/UI_PictureButton.h"
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

void UI_PictureTextButton::SetImageAndTextAlignment(drawbot::TextAlignment inAlignment) {
  if (mBlockAlignment == inAlignment) return;
  mBlockAlignment = inAlignment;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureTextButton::SetImageBaseName(const UTF8String& inName) {
  if (mImageBaseName == inName) return;
  mImageBaseName = inName;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureTextButton::SetStyle(Style inStyle) {
  if (mStyle == inStyle) return;
  mStyle = inStyle;
  UI_Invalidate(nullptr, 0);
}

// The block is the picture, the spacing and the label's measured width. Left
// aligned it starts at the inset; centred or right aligned it moves across,
// but never left of the inset. The label's rectangle always runs on to the
// right edge, so a label drawn from its left end is never cut short.
std::pair<ui::UI_Node::RectF, ui::UI_Node::RectF> UI_PictureTextButton::ComputeTextAndImageOffset(
    const RectF& inRect) const {
  constexpr float kInset = 2;
  const bool picture = mStyle != kStyleTextOnly;
  const bool text = mStyle != kStylePictureOnly;
  const float size = picture ? GetPictureSize() : 0;
  const float gap = picture && text ? mSpacing : 0;
  float start = inRect.left + kInset;
  if (mBlockAlignment != drawbot::kTextAlignLeft) {
    DrawTextControlBaseParameters label;
    FillTextParameters(label, UI_GetCurrentTheme().get());
    const float block = size + gap + (text ? MeasureControlLabel(label, GetText()) : 0);
    const float free = inRect.width - block;
    start = std::max(start, inRect.left + (mBlockAlignment == drawbot::kTextAlignCenter ? std::floor(free / 2)
                                                                                         : free - kInset));
  }
  const RectF pictureRect(start, std::floor(inRect.top + (inRect.height - size) / 2 + mVerticalOffset), size, size);
  if (!text) return {pictureRect, RectF(inRect.left + inRect.width, inRect.top, 0, inRect.height)};
  const float textLeft = start + size + gap;
  return {pictureRect,
          RectF(textLeft, inRect.top, std::max(0.0f, inRect.left + inRect.width - textLeft), inRect.height)};
}

void DrawPTButtonPicture::operator()(DrawParameters::StateFlags, const tarsel::geom::RectT<float>& inRect,
                                     const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot,
                                     const ui::Theme&, const ColorChangeMap*) const {
  const tarsel::geom::RectT<float> r(inRect.left + inOffset.x, inRect.top + inOffset.y, inRect.width, inRect.height);
  UI_PictureButton::DrawPicture(mParams, mImage, r, mScale, 1, inDrawbot);
}

void UI_PictureTextButton::DrawPicture(const DrawParameters& inParams, const RectF& inRect,
                                       drawbot::Drawbot& inDrawbot) {
  const drawbot::ImageInterface* image = LoadImage(mImageBaseName, inDrawbot.GetSupplier());
  if (!image || !inParams.GetTheme()) return;
  const DrawPTButtonPicture face(inParams, *image, mScale);
  face(inParams.GetControlState(), inRect, PointF(), inDrawbot, *inParams.GetTheme(), inParams.GetColorChangeMap());
}

void UI_PictureTextButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawPictureTextButtonParameters params(this);
  FillTextButtonParameters(params);
  const RectF bounds = params.GetRectF();
  const auto [picture, text] = ComputeTextAndImageOffset(bounds);
  // The bevel shows only while lit; the picture and label stand on it.
  params.SetText(UTF16String());
  UI_Button::Draw(params, *inDrawbot);
  if (picture.width > 0) DrawPicture(params, picture, *inDrawbot);
  DrawTextControlBaseParameters label(params);
  label.SetText(GetText());
  DrawControlLabel(params, label, text, *inDrawbot);
}

}  // namespace norvik::controls
