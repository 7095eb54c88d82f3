// Shape and text helpers built on the drawing contract.
#include "drawbot/DrawHelpers.h"

#include <algorithm>
#include <cmath>

namespace norvik {

using drawbot::PathP;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

namespace {

drawbot::BoolSettingReader gSettingReader = nullptr;

void ReplacePath(drawbot::SupplierInterface const* inSupplier, PathP* outPath) {
  if (inSupplier) *outPath = PathP(inSupplier);
}

}  // namespace

void drawbot::SetBoolSettingReader(BoolSettingReader inReader) { gSettingReader = inReader; }

bool drawbot::ReadBoolSetting(char const* inKey, bool inDefault) {
  return gSettingReader ? gSettingReader(inKey, inDefault) : inDefault;
}

void GetEllipsePath(drawbot::SupplierInterface const* inSupplier, RectT<float> const& inRect, PathP* outPath) {
  ReplacePath(inSupplier, outPath);
  if (!*outPath) return;
  float x = inRect.left, y = inRect.top, w = inRect.width, h = inRect.height;
  float rx = w * 0.5f, ry = h * 0.5f;
  auto kx = static_cast<float>(rx * 0.5522847498308), ky = static_cast<float>(ry * 0.5522847498308);
  float cx = x + rx, cy = y + ry;
  PathP& path = *outPath;
  path->MoveTo(PointT<float>(cx, y));
  path->BezierTo(PointT<float>(cx + kx, y), PointT<float>(x + w, cy - ky), PointT<float>(x + w, cy));
  path->BezierTo(PointT<float>(x + w, cy + ky), PointT<float>(cx + kx, y + h), PointT<float>(cx, y + h));
  path->BezierTo(PointT<float>(cx - kx, y + h), PointT<float>(x, cy + ky), PointT<float>(x, cy));
  path->BezierTo(PointT<float>(x, cy - ky), PointT<float>(cx - kx, y), PointT<float>(cx, y));
  path->ClosePath();
}

void GetRoundedRectPath(drawbot::SupplierInterface const* inSupplier, RectT<float> const& inRect, float inRadius,
                        PathP* outPath) {
  ReplacePath(inSupplier, outPath);
  if (!*outPath) return;
  PathP& path = *outPath;
  if (!(inRadius > 0)) {
    path->AddRect(inRect);
    return;
  }
  float left = inRect.left, top = inRect.top, right = inRect.Right(), bottom = inRect.Bottom();
  float hs = std::min(inRadius, inRect.width * 0.5f);
  float vs = std::min(inRadius, inRect.height * 0.5f);
  // Control points at half the corner size along the edges: a squarer corner
  // than a circular arc, on purpose.
  path->MoveTo(PointT<float>(left + hs, top));
  path->LineTo(PointT<float>(right - hs, top));
  path->BezierTo(PointT<float>(right - hs + hs * 0.5f, top), PointT<float>(right, top + vs - vs * 0.5f),
                 PointT<float>(right, top + vs));
  path->LineTo(PointT<float>(right, bottom - vs));
  path->BezierTo(PointT<float>(right, bottom - vs + vs * 0.5f), PointT<float>(right - hs + hs * 0.5f, bottom),
                 PointT<float>(right - hs, bottom));
  path->LineTo(PointT<float>(left + hs, bottom));
  path->BezierTo(PointT<float>(left + hs - hs * 0.5f, bottom), PointT<float>(left, bottom - vs + vs * 0.5f),
                 PointT<float>(left, bottom - vs));
  path->LineTo(PointT<float>(left, top + vs));
  path->BezierTo(PointT<float>(left, top + vs - vs * 0.5f), PointT<float>(left + hs - hs * 0.5f, top),
                 PointT<float>(left + hs, top));
  path->ClosePath();
}

void StrokeRect(drawbot::Drawbot& inDrawbot, RectT<long> const& inRect, drawbot::ColorRGBA const& inColor,
                float inWidth) {
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  if (surface == nullptr || inDrawbot.GetSupplier() == nullptr) return;
  drawbot::ScSurfaceState state(surface);
  PathP path(inDrawbot.GetSupplier());
  surface->SetAntiAliasPolicy(drawbot::kAntiAliasNone);
  path->AddRect(inRect);
  drawbot::PenP pen(inDrawbot.GetSupplier(), inColor, inWidth);
  surface->StrokePath(*pen, *path);
}

float GetFontBaseline(drawbot::FontP const& inFont, RectT<float> const& inRect) {
  if (drawbot::ReadBoolSetting("norvik.utils.FontDependentBaselines", false)) {
    float ascent = inFont->GetAscent(), descent = inFont->GetDescent();
    return inRect.top + ((inRect.height - (ascent + descent)) * 0.5f + ascent);
  }
  float size = inFont->GetSize();
  return std::round(size * 0.9f + inRect.top + (inRect.height - size) * 0.5f);
}

}  // namespace norvik
