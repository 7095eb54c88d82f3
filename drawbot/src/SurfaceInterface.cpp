// The operations that every surface shares, built on the back end's primitives.
#include "drawbot/SurfaceInterface.h"

#include <cmath>

#include "drawbot/BitmapCacheInterface.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "tarsel/StringUtils.h"

namespace norvik::drawbot {

using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

namespace {

bool IsEmptyText(unsigned short const* inText) { return inText == nullptr || inText[0] == 0; }

long TextLength(unsigned short const* inText) {
  long n = 0;
  while (inText[n] != 0) ++n;
  return n;
}

}  // namespace

boost::intrusive_ptr<CacheInterface> SurfaceInterface::PushCacheStack(RectT<float> const& inRect) {
  boost::intrusive_ptr<CacheInterface> cache(new BitmapCacheInterface(this, inRect));
  if (cache->GetSurface() == nullptr) return nullptr;
  return cache;
}

void SurfaceInterface::PopCacheStack(boost::intrusive_ptr<CacheInterface> inCache) { inCache.reset(); }

RectT<long> SurfaceInterface::GetMinimumClipBounds(RectT<long> const& inRect) {
  return GetMinimumHorizontalClipBounds(GetMinimumVerticalClipBounds(inRect));
}

// Bisection on IsWithinClipBounds: the first column whose strip touches the
// clip becomes the left edge, the last one the right edge.
RectT<long> SurfaceInterface::GetMinimumHorizontalClipBounds(RectT<long> const& inRect) {
  if (inRect.IsEmpty() || !IsWithinClipBounds(inRect)) return RectT<long>();
  long top = inRect.top, bottom = inRect.Bottom();
  long lo = inRect.left, hi = inRect.Right() - 1;
  while (lo < hi) {
    long mid = lo + (hi - lo) / 2;
    if (IsWithinClipBounds(RectT<long>::FromEdges(lo, top, mid + 1, bottom)))
      hi = mid;
    else
      lo = mid + 1;
  }
  long left = lo;
  hi = inRect.Right() - 1;
  while (lo < hi) {
    long mid = lo + (hi - lo + 1) / 2;
    if (IsWithinClipBounds(RectT<long>::FromEdges(mid, top, hi + 1, bottom)))
      lo = mid;
    else
      hi = mid - 1;
  }
  return RectT<long>::FromEdges(left, top, lo + 1, bottom);
}

RectT<long> SurfaceInterface::GetMinimumVerticalClipBounds(RectT<long> const& inRect) {
  if (inRect.IsEmpty() || !IsWithinClipBounds(inRect)) return RectT<long>();
  long left = inRect.left, right = inRect.Right();
  long lo = inRect.top, hi = inRect.Bottom() - 1;
  while (lo < hi) {
    long mid = lo + (hi - lo) / 2;
    if (IsWithinClipBounds(RectT<long>::FromEdges(left, lo, right, mid + 1)))
      hi = mid;
    else
      lo = mid + 1;
  }
  long top = lo;
  hi = inRect.Bottom() - 1;
  while (lo < hi) {
    long mid = lo + (hi - lo + 1) / 2;
    if (IsWithinClipBounds(RectT<long>::FromEdges(left, mid, right, hi + 1)))
      lo = mid;
    else
      hi = mid - 1;
  }
  return RectT<long>::FromEdges(left, top, right, lo + 1);
}

bool SurfaceInterface::IsWithinClipBounds(RectT<long> const& inRect) const {
  return !inRect.Intersection(const_cast<SurfaceInterface*>(this)->GetClipBounds()).IsEmpty();
}

void SurfaceInterface::DrawString(BrushInterface const& inBrush, FontInterface const& inFont,
                                  unsigned short const* inText, PointT<float> const& inPoint,
                                  TextAlignment inAlignment, TextTruncation inTruncation, float inMaxWidth) {
  if (IsEmptyText(inText)) return;
  if (inTruncation == kTextTruncationNone) {
    DrawStringImpl(inBrush, inFont, inText, inPoint, inAlignment);
    return;
  }
  UTF16String fitted = TruncateString(inFont, inText, inTruncation, inMaxWidth);
  if (fitted.empty()) return;
  DrawStringImpl(inBrush, inFont, reinterpret_cast<unsigned short const*>(fitted.c_str()), inPoint, inAlignment);
}

void SurfaceInterface::DrawMultiLineString(BrushInterface const& inBrush, FontInterface const& inFont,
                                           unsigned short const* inText, RectT<float> const& inRect,
                                           TextAlignment inAlignment) {
  if (IsEmptyText(inText) || inRect.IsEmpty()) return;
  DrawMultiLineStringImpl(inBrush, inFont, inText, inRect, inAlignment);
}

void SurfaceInterface::DrawStringWithUnderline(BrushInterface const& inBrush, FontInterface const& inFont,
                                               PenInterface const& inPen, unsigned short const* inText,
                                               PointT<float> const& inPoint, TextAlignment inAlignment,
                                               TextTruncation inTruncation, float inMaxWidth, long inFirst,
                                               long inLast) {
  if (IsEmptyText(inText) || inFirst < 0 || inLast < 0 || inFirst > inLast) return;
  if (inMaxWidth != 0 && inMaxWidth < static_cast<float>(inLast)) return;

  UTF16String text(reinterpret_cast<char16_t const*>(inText), static_cast<size_t>(TextLength(inText)));
  if (inMaxWidth != 0 && inTruncation != kTextTruncationNone)
    text = TruncateString(inFont, inText, inTruncation, inMaxWidth);
  if (text.empty()) return;
  auto const* chars = reinterpret_cast<unsigned short const*>(text.c_str());
  long length = static_cast<long>(text.size());

  PointT<float> origin = inPoint;
  if (inAlignment != kTextAlignLeft) {
    float width = MeasureStringWidth(inFont, chars, -1);
    origin.x -= inAlignment == kTextAlignCenter ? width * 0.5f : width;
  }

  long last = std::min(inLast, length - 1);
  float lineStart, lineEnd;
  if (inFirst == 0) {
    lineStart = origin.x;
    lineEnd = origin.x + MeasureStringWidth(inFont, chars, last + 1);
  } else {
    long first = std::min(inFirst, length);
    lineStart = origin.x + std::round(MeasureStringWidth(inFont, chars, first));
    lineEnd = lineStart + std::round(MeasureStringWidth(inFont, chars + first, std::max(0L, last + 1 - first)));
  }
  float lineY = std::round(inPoint.y) + 2;

  PathP path(GetSupplier());
  if (!path) return;
  path->MoveTo(PointT<float>(lineStart, lineY));
  path->LineTo(PointT<float>(lineEnd, lineY));
  path->ClosePath();

  ScSurfaceState state(this);
  AntiAliasPolicy previous = GetAntiAliasPolicy();
  SetAntiAliasPolicy(kAntiAliasNone);
  StrokePath(inPen, *path);
  SetAntiAliasPolicy(previous);
  DrawStringImpl(inBrush, inFont, chars, origin, kTextAlignLeft);
}

float SurfaceInterface::MeasureMaximumMultiLineStringWidth(FontInterface const& inFont, UTF16String const& inText) {
  UTF16String const& ending = tarsel::utility::GetLineEnding();
  float widest = 0;
  size_t start = 0;
  while (start <= inText.size()) {
    size_t end = inText.find(ending, start);
    if (end == UTF16String::npos) end = inText.size();
    if (end > start) {
      UTF16String line = inText.substr(start, end - start);
      widest = std::max(widest, MeasureStringWidth(inFont, reinterpret_cast<unsigned short const*>(line.c_str()), -1));
    }
    start = end + ending.size();
  }
  return widest;
}

void SurfaceInterface::DrawImage(SupplierInterface const& inSupplier, ImageInterface const& inImage,
                                 RectT<float> const& inDest, RectT<float> const* inSource, float inOpacity) {
  if (!(inDest.width > 0) || !(inDest.height > 0)) return;
  if (!(inOpacity > 0 && inOpacity <= 1)) return;
  float srcWidth = inSource ? inSource->width : static_cast<float>(inImage.GetWidth());
  float srcHeight = inSource ? inSource->height : static_cast<float>(inImage.GetHeight());
  if (!(srcWidth > 0) || !(srcHeight > 0)) return;

  ScSurfaceState state(this);
  double scaleX = static_cast<double>(inDest.width) / srcWidth;
  double scaleY = static_cast<double>(inDest.height) / srcHeight;

  PathP clip(&inSupplier);
  clip->AddRect(inDest);
  Clip(*clip, kFillWinding);

  MatrixT<float> place = MatrixT<float>::Translation(inDest.left, inDest.top);
  // Only the horizontal factor decides: a destination as wide as the source
  // draws the image at its natural size, clipped to the destination.
  const bool natural = std::fabs(scaleX - 1.0) <= 1e-12 * std::fabs(scaleX) && !inSupplier.GetSmoothingNeeded();
  if (natural)
    SetAntiAliasPolicy(kAntiAliasNone);
  else
    place = place.Concat(MatrixT<float>::Scale(static_cast<float>(scaleX), static_cast<float>(scaleY)));
  if (inSource) place = place.Concat(MatrixT<float>::Translation(-inSource->left, -inSource->top));
  Transform(place);
  DrawImage(inImage, PointT<float>(0, 0), inOpacity);
}

void SurfaceInterface::DrawCache(CacheInterface const& inCache) {
  SurfaceInterface* cacheSurface = inCache.GetSurface();
  if (cacheSurface == nullptr) return;
  boost::intrusive_ptr<ImageInterface> image = cacheSurface->GetSurfaceImage();
  if (!image) return;
  auto const* bitmap = dynamic_cast<BitmapCacheInterface const*>(&inCache);

  ScSurfaceState state(this);
  MatrixT<float> current;
  GetTransform(&current);
  MatrixT<float> stored;
  cacheSurface->GetTransform(&stored);
  if (bitmap) stored = bitmap->GetSurfaceTransform();
  MatrixT<float> currentInverse = current, storedInverse = stored;
  if (!currentInverse.Invert() || !storedInverse.Invert()) return;

  Transform(currentInverse);
  // A cached pixel p stands for the user point stored^-1(p), which now lands at current(stored^-1(p)).
  Transform(current.Concat(storedInverse));
  DrawImage(*image, PointT<float>(0, 0), 1.0f);
}

}  // namespace norvik::drawbot
