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
                                     float inScale, float inAlpha, float inImageBorder)
    : mParams(inParams), mImage(inImage), mScale(inScale), mAlpha(inAlpha), mImageBorder(inImageBorder) {}

void DrawButtonPicture::operator()(tarsel::utility::Flags<unsigned long>, const RectT<float>& inRect,
                                   const PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme&,
                                   const ColorChangeMap*) const {
  const RectT<float> r(inRect.left + inOffset.x + mImageBorder, inRect.top + inOffset.y + mImageBorder,
                       inRect.width - 2 * mImageBorder, inRect.height - 2 * mImageBorder);
  if (r.width <= 0 || r.height <= 0) return;
  if (mImageBorder > 0) ui::UI_Node::UI_ClipToRect(r, &inDrawbot);
  UI_PictureButton::DrawPicture(mParams, mImage, r, mScale, mAlpha, inDrawbot);
}

}  // namespace norvik::controls
