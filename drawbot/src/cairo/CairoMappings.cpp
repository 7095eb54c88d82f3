// Error texts and the mapping of the toolkit's policy values onto Cairo's.
#include "drawbot/src/cairo/CairoObjects.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot::cairo {

void ThrowDrawingError(char const* inKeyText) {
  tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, inKeyText);
}

void ThrowUnspecified() {
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/Unspecified=Unspecified drawing error.");
}

cairo_antialias_t MapAntiAlias(AntiAliasPolicy inPolicy) {
  switch (inPolicy) {
    case kAntiAliasNone: return CAIRO_ANTIALIAS_NONE;
    case kAntiAlias: return CAIRO_ANTIALIAS_GRAY;
    case kAntiAliasHighQuality: return CAIRO_ANTIALIAS_BEST;
  }
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnknownAntiAliasPolicy=Unknown Anti-Alias Policy.");
}

cairo_filter_t MapInterpolation(InterpolationPolicy inPolicy) {
  switch (inPolicy) {
    case kInterpolationNearestNeighbor: return CAIRO_FILTER_NEAREST;
    case kInterpolationLowQuality: return CAIRO_FILTER_BILINEAR;
    case kInterpolationHighQuality: return CAIRO_FILTER_GOOD;
  }
  ThrowDrawingError(
      "$$$/norvik/drawbot/Error/OSSupplier/UnknownInterpolationPolicy=Unknown Interpolation Policy.");
}

cairo_fill_rule_t MapFillType(FillType inFill) {
  switch (inFill) {
    case kFillAlternate: return CAIRO_FILL_RULE_EVEN_ODD;
    case kFillWinding: return CAIRO_FILL_RULE_WINDING;
  }
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnknownFillType=Unknown Fill Type.");
}

cairo_line_cap_t MapLineCap(LineCap inCap) {
  switch (inCap) {
    case kLineCapFlat: return CAIRO_LINE_CAP_BUTT;
    case kLineCapRound: return CAIRO_LINE_CAP_ROUND;
    case kLineCapSquare: return CAIRO_LINE_CAP_SQUARE;
  }
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnknownLineCapType=Unknown Line Cap Type.");
}

cairo_line_join_t MapLineJoin(LineJoin inJoin) {
  switch (inJoin) {
    case kLineJoinMiter: return CAIRO_LINE_JOIN_MITER;
    case kLineJoinBevel: return CAIRO_LINE_JOIN_BEVEL;
    case kLineJoinRound: return CAIRO_LINE_JOIN_ROUND;
  }
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnknownLineJoinType=Unknown Line Join Type.");
}

cairo_format_t MapPixelLayout(PixelLayout inLayout) {
  switch (inLayout) {
    case kPixelLayoutRGB24:
    case kPixelLayoutRGB32: return CAIRO_FORMAT_RGB24;
    case kPixelLayoutBGRA:
    case kPixelLayoutBGRAPremul: return CAIRO_FORMAT_ARGB32;
    default: break;
  }
  ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnsupportedPixelFormat=Unsupported Pixel Format.");
}

cairo_matrix_t ToCairo(MatrixT<float> const& inMatrix) {
  cairo_matrix_t m;
  cairo_matrix_init(&m, inMatrix.a, inMatrix.b, inMatrix.c, inMatrix.d, inMatrix.tx, inMatrix.ty);
  return m;
}

MatrixT<float> FromCairo(cairo_matrix_t const& inMatrix) {
  return MatrixT<float>(static_cast<float>(inMatrix.xx), static_cast<float>(inMatrix.yx),
                        static_cast<float>(inMatrix.xy), static_cast<float>(inMatrix.yy),
                        static_cast<float>(inMatrix.x0), static_cast<float>(inMatrix.y0));
}

}  // namespace norvik::drawbot::cairo
