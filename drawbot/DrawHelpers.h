#pragma once
// Shape and text helpers that nearly every control uses.
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"

namespace norvik {

// Replaces *outPath by an ellipse inscribed in inRect (four Béziers, clockwise
// from the top). With a null supplier the existing path object is kept.
void GetEllipsePath(drawbot::SupplierInterface const* inSupplier, tarsel::geom::RectT<float> const& inRect,
                    drawbot::PathP* outPath);
// A rounded rectangle whose corners are squarer than circular arcs; a radius
// of 0 or less gives the plain rectangle.
void GetRoundedRectPath(drawbot::SupplierInterface const* inSupplier, tarsel::geom::RectT<float> const& inRect,
                        float inRadius, drawbot::PathP* outPath);
// Outlines an integer rectangle, without anti-aliasing.
void StrokeRect(drawbot::Drawbot& inDrawbot, tarsel::geom::RectT<long> const& inRect,
                drawbot::ColorRGBA const& inColor, float inWidth);
// The baseline that centres text of inFont vertically in inRect.
float GetFontBaseline(drawbot::FontP const& inFont, tarsel::geom::RectT<float> const& inRect);

namespace drawbot {
// The "norvik.utils.FontDependentBaselines" setting lives with the settings
// manager above this layer; that layer installs a reader here. Without one the
// setting is false.
using BoolSettingReader = bool (*)(char const* inKey, bool inDefault);
void SetBoolSettingReader(BoolSettingReader inReader);
bool ReadBoolSetting(char const* inKey, bool inDefault);
}  // namespace drawbot

}  // namespace norvik
