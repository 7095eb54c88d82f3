#pragma once
// A text button with a picture beside its label. The picture is a face drawn
// by the virtual DrawPicture, so derived buttons (the disclosure triangle)
// can draw theirs as geometry.
#include "controls/ResourceImageSource.h"
#include "controls/UI_TextButton.h"

namespace norvik::controls {

// The picture of a picture-and-text button: the image at its scale, centred
// in the picture's rectangle and faded when disabled.
class DrawPTButtonPicture : public DrawButtonFace {
 public:
  DrawPTButtonPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage, float inScale)
      : mParams(inParams), mImage(inImage), mScale(inScale) {}
  void operator()(DrawParameters::StateFlags inState, const tarsel::geom::RectT<float>& inRect,
                  const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme& inTheme,
                  const ColorChangeMap* inMap) const override;

 private:
  const DrawParameters& mParams;
  const drawbot::ImageInterface& mImage;
  float mScale;
};

class UI_PictureTextButton : public UI_TextButton, public ResourceImageSource {
 public:
  // Which parts the button shows.
  enum Style { kStylePictureAndText = 0, kStylePictureOnly = 1, kStyleTextOnly = 2 };

  explicit UI_PictureTextButton(const UTF16String& inText = UTF16String());

  // Where the picture and its label, as one block, sit across the button.
  void SetImageAndTextAlignment(drawbot::TextAlignment inAlignment);
  drawbot::TextAlignment GetImageAndTextAlignment() const { return mBlockAlignment; }
  void SetStyle(Style inStyle);
  Style GetStyle() const { return mStyle; }

  void SetSpacingBetweenPictureAndText(float inSpacing);
  void SetPictureVerticalOffset(float inOffset);
  void SetScale(float inScale);
  float GetScale() const { return mScale; }
  void SetImageBaseName(const UTF8String& inName);
  const UTF8String& GetImageBaseName() const { return mImageBaseName; }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

  // The picture's side, and the picture and label rectangles of inRect. A
  // part the style hides gets an empty rectangle.
  float GetPictureSize() const { return 12 * mScale; }
  std::pair<RectF, RectF> ComputeTextAndImageOffset(const RectF& inRect) const;

 protected:
  // Draws the picture into inRect: the resource image of the base name, or
  // nothing without a base name; a name the resources lack raises.
  virtual void DrawPicture(const DrawParameters& inParams, const RectF& inRect, drawbot::Drawbot& inDrawbot);

 private:
  UTF8String mImageBaseName;
  float mSpacing = 4;
  float mVerticalOffset = 0;
  float mScale = 1;
  drawbot::TextAlignment mBlockAlignment = drawbot::kTextAlignLeft;
  Style mStyle = kStylePictureAndText;
};

}  // namespace norvik::controls
