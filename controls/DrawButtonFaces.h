#pragma once
// The faces of text and picture buttons: what stands on the bevel. They are
// public so that cells of lists, trees and tool bars can draw a button's face
// with no button behind it. A face holds references to the records it is made
// from, and lives on the stack of the Draw routine that sets it.
#include "controls/DrawParameters.h"
#include "drawbot/ResourceInterfaces.h"

namespace norvik::controls {

// The label, centred vertically, aligned and truncated by the text record,
// indented from the left by inIndent.
class DrawButtonText : public DrawButtonFace {
 public:
  DrawButtonText(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText, float inIndent);
  void operator()(tarsel::utility::Flags<unsigned long> inState, const tarsel::geom::RectT<float>& inRect,
                  const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme& inTheme,
                  const ColorChangeMap* inMap) const override;

 private:
  const DrawParameters& mParams;
  const DrawTextControlBaseParameters& mText;
  float mIndent;
};

// The image, scaled and centred on whole pixels, faded when disabled, and
// clipped inside a border kept free on each side.
class DrawButtonPicture : public DrawButtonFace {
 public:
  DrawButtonPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage, float inScale,
                    float inAlpha, float inImageBorder = 0);
  void operator()(tarsel::utility::Flags<unsigned long> inState, const tarsel::geom::RectT<float>& inRect,
                  const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme& inTheme,
                  const ColorChangeMap* inMap) const override;

 private:
  const DrawParameters& mParams;
  const drawbot::ImageInterface& mImage;
  float mScale;
  float mAlpha;
  float mImageBorder;
};

}  // namespace norvik::controls
