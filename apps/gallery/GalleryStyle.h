#pragma once
// The gallery's look, taken from the current theme: a handful of colour
// roles, the label font, and small drawing helpers shared by the sections.
// Every colour is asked of the theme at draw time, so switching brightness
// repaints the whole page in the other look.
#include <string_view>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotTypes.h"
#include "drawbot/DrawbotWrappers.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"

namespace norvik::gallery {

using RectF = tarsel::geom::RectT<float>;
using PointF = tarsel::geom::PointT<float>;
using drawbot::ColorRGBA;

// Theme colour identifiers the gallery paints with.
enum ThemeColorID : unsigned {
  kColorWindowBackground = 2,
  kColorPanel = 7,
  kColorText = 1,
  kColorAccent = 8,
};

// Colour roles derived from the theme.
struct GalleryColors {
  ColorRGBA background;  // behind everything
  ColorRGBA panel;       // section panels
  ColorRGBA header;      // the title bar of the page
  ColorRGBA text;        // labels
  ColorRGBA dimText;     // secondary labels
  ColorRGBA border;      // panel and tile outlines
  ColorRGBA accent;      // focus ring, selection, the switch when on
  ColorRGBA hover;       // fill of a view under the mouse
};

// The roles of the current theme.
GalleryColors CurrentColors();

// a * (1 - t) + b * t, channel by channel, opaque.
ColorRGBA Mix(const ColorRGBA& inA, const ColorRGBA& inB, float inT);

// The label font of the theme in a family the platform has, at inSize points
// (0: the theme's size). Null when no supplier is given.
drawbot::FontP LabelFont(const drawbot::Drawbot* inDrawbot, float inSize = 0, bool inBold = false);

// The localised text of a key text ("$$$/norvik/gallery/...=Text").
UTF16String Text(std::string_view inKeyText);

// Drawing helpers.
void FillRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, const ColorRGBA& inColor);
void FillRoundRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, float inRadius, const ColorRGBA& inColor);
void StrokeRoundRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, float inRadius, const ColorRGBA& inColor,
                     float inWidth);
// A line of text with its baseline placed to centre it vertically in inRect.
void DrawLabel(drawbot::Drawbot* inDrawbot, const UTF16String& inText, const RectF& inRect, const ColorRGBA& inColor,
               drawbot::TextAlignment inAlign = drawbot::kTextAlignLeft, float inSize = 0, bool inBold = false);

}  // namespace norvik::gallery
