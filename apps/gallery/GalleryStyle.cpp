#include "GalleryStyle.h"

#include <algorithm>
#include <vector>

#include "drawbot/FontFamilies.h"
#include "tarsel/Localizer.h"
#include "ui/Theme.h"

namespace norvik::gallery {

ColorRGBA Mix(const ColorRGBA& inA, const ColorRGBA& inB, float inT) {
  const float t = std::clamp(inT, 0.0f, 1.0f);
  return ColorRGBA(inA.red + (inB.red - inA.red) * t, inA.green + (inB.green - inA.green) * t,
                   inA.blue + (inB.blue - inA.blue) * t, 1.0f);
}

namespace {

// A theme colour laid over the background it will be painted on, so that
// translucent palette entries give one solid colour.
ColorRGBA Solid(const ColorRGBA& inColor, const ColorRGBA& inUnder) { return Mix(inUnder, inColor, inColor.alpha); }

float Luma(const ColorRGBA& inC) { return 0.299f * inC.red + 0.587f * inC.green + 0.114f * inC.blue; }

}  // namespace

GalleryColors CurrentColors() {
  GalleryColors c;
  c.background = Solid(ui::GetColor(kColorWindowBackground), ColorRGBA(0, 0, 0, 1));
  const ColorRGBA text = Solid(ui::GetColor(kColorText), c.background);
  const bool dark = Luma(c.background) < 0.5f;
  // Panels sit one step off the background towards the text, headers one
  // step the other way, so that the page reads as layers in either look.
  c.panel = Mix(c.background, text, dark ? 0.06f : 0.04f);
  c.header = dark ? Mix(c.background, ColorRGBA(0, 0, 0, 1), 0.35f) : Mix(c.background, text, 0.10f);
  c.text = text;
  c.dimText = Mix(text, c.panel, 0.38f);
  c.border = Mix(c.panel, text, dark ? 0.18f : 0.22f);
  c.accent = Solid(ui::GetColor(kColorAccent), c.panel);
  c.accent.alpha = 1.0f;
  c.hover = Mix(c.panel, c.accent, dark ? 0.28f : 0.20f);
  return c;
}

drawbot::FontP LabelFont(const drawbot::Drawbot* inDrawbot, float inSize, bool inBold) {
  if (!inDrawbot || !inDrawbot->GetSupplier()) return drawbot::FontP();
  static const UTF16String family = drawbot::ChooseFontFamily({ui::GetFontName(0)});
  const float themeSize = ui::GetFontSize(0);
  const float size = inSize > 0 ? inSize : (themeSize > 0 ? themeSize : 11.0f);
  return drawbot::FontP(inDrawbot->GetSupplier(), family, inBold ? UTF16String(u"Bold") : UTF16String(), size);
}

UTF16String Text(std::string_view inKeyText) { return tarsel::config::Localize(inKeyText); }

void FillRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, const ColorRGBA& inColor) {
  inDrawbot->GetSurface()->PaintRect(inColor, inRect);
}

namespace {

drawbot::PathP RoundRectPath(const drawbot::Drawbot* inDrawbot, const RectF& inRect, float inRadius) {
  drawbot::PathP path(inDrawbot->GetSupplier());
  const float r = std::min({inRadius, inRect.width / 2, inRect.height / 2});
  const float l = inRect.left, t = inRect.top, rt = inRect.left + inRect.width, b = inRect.top + inRect.height;
  if (r <= 0) {
    path->AddRect(inRect);
    return path;
  }
  path->MoveTo(PointF(l + r, t));
  path->LineTo(PointF(rt - r, t));
  path->AddArc(PointF(rt - r, t + r), r, 270, 90);
  path->LineTo(PointF(rt, b - r));
  path->AddArc(PointF(rt - r, b - r), r, 0, 90);
  path->LineTo(PointF(l + r, b));
  path->AddArc(PointF(l + r, b - r), r, 90, 90);
  path->LineTo(PointF(l, t + r));
  path->AddArc(PointF(l + r, t + r), r, 180, 90);
  path->ClosePath();
  return path;
}

}  // namespace

void FillRoundRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, float inRadius, const ColorRGBA& inColor) {
  drawbot::BrushP brush(inDrawbot->GetSupplier(), inColor);
  inDrawbot->GetSurface()->FillPath(*brush, *RoundRectPath(inDrawbot, inRect, inRadius), drawbot::kFillWinding);
}

void StrokeRoundRect(drawbot::Drawbot* inDrawbot, const RectF& inRect, float inRadius, const ColorRGBA& inColor,
                     float inWidth) {
  // Strokes straddle the path: inset by half the width so that the line
  // stays inside the rectangle and lands on whole pixels.
  const float h = inWidth / 2;
  RectF inner(inRect.left + h, inRect.top + h, inRect.width - inWidth, inRect.height - inWidth);
  drawbot::PenP pen(inDrawbot->GetSupplier(), inColor, inWidth);
  inDrawbot->GetSurface()->StrokePath(*pen, *RoundRectPath(inDrawbot, inner, inRadius - h));
}

void DrawLabel(drawbot::Drawbot* inDrawbot, const UTF16String& inText, const RectF& inRect, const ColorRGBA& inColor,
               drawbot::TextAlignment inAlign, float inSize, bool inBold) {
  drawbot::FontP font = LabelFont(inDrawbot, inSize, inBold);
  if (!font) return;
  drawbot::BrushP brush(inDrawbot->GetSupplier(), inColor);
  const float ascent = font->GetAscent(), descent = font->GetDescent();
  const float baseline = inRect.top + (inRect.height + ascent - descent) / 2;
  float x = inRect.left;
  if (inAlign == drawbot::kTextAlignCenter) x = inRect.left + inRect.width / 2;
  if (inAlign == drawbot::kTextAlignRight) x = inRect.left + inRect.width;
  inDrawbot->GetSurface()->DrawString(*brush, *font, reinterpret_cast<const unsigned short*>(inText.c_str()),
                                      PointF(x, baseline), inAlign, drawbot::kTextTruncationEndWithEllipsis, inRect.width);
}

}  // namespace norvik::gallery
