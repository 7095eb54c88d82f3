#pragma once
// A button that shows an image: either one named by its base name and read
// from the toolkit's resources, or one that a supply function picks for the
// button's state and modifier keys. Its chrome shows only when asked or while
// the button is lit.
#include <boost/function.hpp>

#include "controls/UI_Button.h"

namespace norvik::controls {

class UI_PictureButton : public UI_Button {
 public:
  using ImageSupplyFunction = boost::function<void(UI_PictureSupplyMessage*)>;

  UI_PictureButton();

  void SetImageBaseName(const UTF8String& inName);
  const UTF8String& GetImageBaseName() const { return mImageBaseName; }
  void SetImageSupplyFunction(const ImageSupplyFunction& inFunction);
  void SetScale(float inScale);
  void SetAlpha(float inAlpha);
  // The image for the current state from the supply function, else null.
  const drawbot::ImageInterface* GetImage() const;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

  // Centres inImage in inRect at whole pixels; disabled images are faded by
  // the alpha of theme colour 306.
  static void DrawPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage,
                          const RectF& inRect, float inScale, float inAlpha, drawbot::Drawbot& inDrawbot);

 private:
  const drawbot::ImageInterface* FindImage(const drawbot::SupplierInterface* inSupplier) const;

  UTF8String mImageBaseName;
  ImageSupplyFunction mSupply;
  float mScale = 1;
  float mAlpha = 1;
};

// A button that paints nothing itself: its owner's function draws it.
class UI_OwnerDrawButton : public UI_Button {
 public:
  using OwnerDrawFunction = boost::function<void(UI_OwnerDrawButton&, drawbot::Drawbot&)>;

  UI_OwnerDrawButton();
  void SetOwnerDrawFunction(const OwnerDrawFunction& inFunction) { mDraw = inFunction; }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

 private:
  OwnerDrawFunction mDraw;
};

}  // namespace norvik::controls
