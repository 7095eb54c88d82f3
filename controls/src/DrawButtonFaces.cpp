#include "controls/DrawButtonFaces.h"

#include "controls/UI_PictureButton.h"
#include "controls/UI_TextControlBase.h"

namespace norvik::controls {

using tarsel::geom::PointT;
using tarsel::geom::RectT;

DrawButtonText::DrawButtonText(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText,
                               float inIndent)
    : mParams(inParams), mText(inText), mIndent(inIndent) {}

void DrawButtonText::operator()(tarsel::utility::Flags<unsigned long>, const RectT<float>& inRect,
                                const PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme&,
                                const ColorChangeMap*) const {
  const RectT<float> r(inRect.left + inOffset.x + mIndent, inRect.top + inOffset.y, inRect.width - mIndent,
                       inRect.height);
  DrawControlLabel(mParams, mText, r, inDrawbot);
}

DrawButtonPicture::DrawButtonPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage,
                                     float inScale, float inAlpha)
    : mParams(inParams), mImage(inImage), mScale(inScale), mAlpha(inAlpha) {}

void DrawButtonPicture::operator()(tarsel::utility::Flags<unsigned long>, const RectT<float>& inRect,
                                   const PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme&,
                                   const ColorChangeMap*) const {
  const RectT<float> r(inRect.left + inOffset.x, inRect.top + inOffset.y, inRect.width, inRect.height);
  UI_PictureButton::DrawPicture(mParams, mImage, r, mScale, mAlpha, inDrawbot);
}

}  // namespace norvik::controls
