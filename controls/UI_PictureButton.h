#pragma once
// A button that shows an image: either one named by its base name and read
// from the toolkit's resources, or one that a supply function picks for the
// button's state and modifier keys. Its chrome shows only when asked or while
// the button is lit.
#include <boost/function.hpp>

#include "controls/ResourceImageSource.h"
#include "controls/UI_Button.h"

namespace norvik::controls {

class UI_PictureButton : public UI_Button, public ResourceImageSource {
 public:
  using ImageSupplyFunction = boost::function<void(UI_PictureSupplyMessage*)>;

  UI_PictureButton();

  void SetImageBaseName(const UTF8String& inName);
  const UTF8String& GetImageBaseName() const { return mImageBaseName; }
  void SetImageSupplyFunction(const ImageSupplyFunction& inFunction);
  void SetScale(float inScale);
  void SetAlpha(float inAlpha);
  // Space kept free around the image: the image is clipped inside it, and the
  // recommended size is the scaled image with the border on each side.
  void SetImageBorder(float inBorder);
  float GetImageBorder() const { return mImageBorder; }
  // The image for the current state from the supply function, else null.
  const drawbot::ImageInterface* GetImage() const;
  // Return (with no modifier) also activates the button while it has focus.
  void SetSupportLegacyWindowsKeyboardActivation(bool inOn) { mReturnActivates = inOn; }
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  PointF UI_GetRecommendedSize() const override;

  // Paints the bevel and, when the record has one, its image as the face.
  static void Draw(const DrawPictureButtonParameters& inParams, drawbot::Drawbot& inDrawbot);

  // Centres inImage in inRect at whole pixels; disabled images are faded by
  // the alpha of theme colour 306.
  static void DrawPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage,
                          const RectF& inRect, float inScale, float inAlpha, drawbot::Drawbot& inDrawbot);

 protected:
  // The supplier of the drawing under way, so that a supply function decodes
  // its image for the surface it lands on; outside a draw, the manager's.
  const drawbot::SupplierInterface* GetDrawingSupplier() const;

 private:
  const drawbot::ImageInterface* FindImage() const;

  const drawbot::SupplierInterface* mDrawingSupplier = nullptr;

  UTF8String mImageBaseName;
  ImageSupplyFunction mSupply;
  float mScale = 1;
  float mAlpha = 1;
  float mImageBorder = 0;
  bool mReturnActivates = false;
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
