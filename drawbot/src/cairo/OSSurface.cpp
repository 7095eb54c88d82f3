// Surfaces of the image back end.
//
// Half-pixel rule. The toolkit's drawing code treats whole numbers as pixel
// centres whenever a shape is anti-aliased or has float points, and as the
// pixels themselves for shapes that stay on whole pixels with anti-aliasing
// off: a one-pixel line at y = 5 lights exactly row 5, and a rectangle from 2
// to 7 fills pixels 2 to 6. Cairo's pixel i spans [i, i + 1], so the first case
// is Cairo's own frame, and the second is that frame moved by half a pixel.
#include <chrono>
#include <thread>

#include "drawbot/Drawbot.h"
#include "drawbot/src/cairo/CairoObjects.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot::cairo {

namespace {

void SetSourceColor(cairo_t* inContext, ColorRGBA const& inColor) {
  cairo_set_source_rgba(inContext, inColor.red, inColor.green, inColor.blue, inColor.alpha);
}

}  // namespace

OSSurfaceInterface::OSSurfaceInterface(OSSupplier const* inSupplier, cairo_surface_t* inTarget, bool inCanGiveImage,
                                       cairo_surface_t* inOutput, cairo_region_t* inRegion,
                                       boost::intrusive_ptr<DataDeleter> inDeleter)
    : SurfaceInterface(inSupplier),
      mTarget(cairo_surface_reference(inTarget)),
      mContext(cairo_create(inTarget)),
      mOutput(inOutput ? cairo_surface_reference(inOutput) : nullptr),
      mRegion(inRegion ? cairo_region_copy(inRegion) : nullptr),
      mDeleter(std::move(inDeleter)),
      mCanGiveImage(inCanGiveImage) {
  if (cairo_status(mContext) != CAIRO_STATUS_SUCCESS) {
    cairo_destroy(mContext);
    if (mOutput) cairo_surface_destroy(mOutput);
    if (mRegion) cairo_region_destroy(mRegion);
    cairo_surface_destroy(mTarget);
    ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnableToCreateSurface=Unable to create drawing surface.");
  }
  // A region whose bounds are the whole visible clip restricts nothing worth
  // the per-rectangle tests, and is dropped.
  if (mRegion) {
    double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
    cairo_clip_extents(mContext, &x1, &y1, &x2, &y2);
    cairo_rectangle_int_t bounds;
    cairo_region_get_extents(mRegion, &bounds);
    if (bounds.x == x1 && bounds.y == y1 && bounds.x + bounds.width == x2 && bounds.y + bounds.height == y2) {
      cairo_region_destroy(mRegion);
      mRegion = nullptr;
    }
  }
  if (mRegion) {
    int count = cairo_region_num_rectangles(mRegion);
    for (int i = 0; i < count; ++i) {
      cairo_rectangle_int_t r;
      cairo_region_get_rectangle(mRegion, i, &r);
      cairo_rectangle(mContext, r.x, r.y, r.width, r.height);
    }
    cairo_set_fill_rule(mContext, CAIRO_FILL_RULE_WINDING);
    cairo_clip(mContext);
  }
  mStates.emplace_back();
  mStates.back().clip = ClipBoxes::ForTarget(mTarget);
  if (mRegion) mStates.back().clip.IntersectRegion(mRegion);
}

OSSurfaceInterface::~OSSurfaceInterface() {
  if (mWriteBack) {
    cairo_surface_flush(mTarget);
    mWriteBack(mTarget);
  }
  cairo_destroy(mContext);
  if (mOutput) cairo_surface_destroy(mOutput);
  if (mRegion) cairo_region_destroy(mRegion);
  cairo_surface_destroy(mTarget);
}

void OSSurfaceInterface::PushStateStack() {
  cairo_save(mContext);
  mStates.push_back(mStates.back());
}

void OSSurfaceInterface::PopStateStack() {
  if (mStates.size() <= 1) return;
  cairo_restore(mContext);
  mStates.pop_back();
}

void OSSurfaceInterface::BeginDrawing(bool inPixelAligned) {
  cairo_save(mContext);
  AntiAliasPolicy aa = mStates.back().antiAlias;
  cairo_set_antialias(mContext, MapAntiAlias(aa));
  if (inPixelAligned && aa == kAntiAliasNone) {
    cairo_matrix_t m;
    cairo_get_matrix(mContext, &m);
    m.x0 += 0.5;
    m.y0 += 0.5;
    cairo_set_matrix(mContext, &m);
  }
}

void OSSurfaceInterface::EndDrawing() {
  cairo_restore(mContext);
  mHasDrawn = true;
}

void OSSurfaceInterface::PaintRect(ColorRGBA const& inColor, RectT<float> const& inRect) {
  if (!(inRect.width > 0) || !(inRect.height > 0)) return;
  // The rectangle is widened to whole pixels, and a whole-pixel rectangle covers
  // the same pixels in both frames, so this hot path skips saving the context:
  // it only sets what every other operation sets for itself anyway.
  double left = std::floor(inRect.left), top = std::floor(inRect.top);
  double right = std::ceil(inRect.Right()), bottom = std::ceil(inRect.Bottom());
  // An opaque box on whole device pixels inside a box clip is written
  // directly: the same pixels as the fill below, at a fraction of its cost.
  ClipBoxes::Box box;
  if (DeviceBoxOf(mContext, left, top, right - left, bottom - top, &box) &&
      FillOpaqueBox(mTarget, mStates.back().clip, box, inColor)) {
    mHasDrawn = true;
    return;
  }
  cairo_set_antialias(mContext, MapAntiAlias(mStates.back().antiAlias));
  cairo_set_operator(mContext, CAIRO_OPERATOR_OVER);
  SetSourceColor(mContext, inColor);
  cairo_new_path(mContext);
  cairo_rectangle(mContext, left, top, right - left, bottom - top);
  cairo_fill(mContext);
  mHasDrawn = true;
}

void OSSurfaceInterface::FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType inFill) {
  auto const& brush = Cast<OSSolidBrushInterface>(inBrush);
  auto const& path = Cast<OSPathInterface>(inPath);
  cairo_fill_rule_t rule = MapFillType(inFill);
  BeginDrawing(path.IsPixelAligned());
  SetSourceColor(mContext, brush.GetColor());
  cairo_set_fill_rule(mContext, rule);
  path.Build(mContext);
  cairo_fill(mContext);
  EndDrawing();
}

void OSSurfaceInterface::StrokePath(PenInterface const& inPen, PathInterface const& inPath) {
  auto const& pen = Cast<OSPenInterface>(inPen);
  auto const& path = Cast<OSPathInterface>(inPath);
  if (!(pen.GetWidth() > 0)) return;
  BeginDrawing(path.IsPixelAligned());
  pen.Apply(mContext);
  path.Build(mContext);
  cairo_stroke(mContext);
  EndDrawing();
}

void OSSurfaceInterface::ShadePath(ShaderInterface const& inShader, PathInterface const& inPath, FillType) {
  auto const* gradient = dynamic_cast<OSGradient const*>(&inShader);
  if (gradient == nullptr) ThrowUnspecified();
  auto const& path = Cast<OSPathInterface>(inPath);
  // Shading always works in the anti-aliased frame, with winding fill.
  BeginDrawing(false);
  cairo_set_source(mContext, gradient->GetPattern());
  cairo_set_fill_rule(mContext, CAIRO_FILL_RULE_WINDING);
  path.Build(mContext);
  cairo_fill(mContext);
  EndDrawing();
}

void OSSurfaceInterface::GetOutputClipRects(std::vector<RectT<long>>* outRects) const {
  outRects->clear();
  cairo_rectangle_list_t* list = cairo_copy_clip_rectangle_list(mContext);
  if (list->status == CAIRO_STATUS_SUCCESS) {
    for (int i = 0; i < list->num_rectangles; ++i) {
      cairo_rectangle_t const& r = list->rectangles[i];
      long left = static_cast<long>(std::floor(r.x)), top = static_cast<long>(std::floor(r.y));
      outRects->push_back(RectT<long>::FromEdges(left, top, static_cast<long>(std::ceil(r.x + r.width)),
                                                 static_cast<long>(std::ceil(r.y + r.height))));
    }
  }
  cairo_rectangle_list_destroy(list);
  if (outRects->empty()) outRects->push_back(const_cast<OSSurfaceInterface*>(this)->GetClipBounds());
}

void OSSurfaceInterface::Clip(PathInterface const& inPath, FillType inFill) {
  auto const& path = Cast<OSPathInterface>(inPath);
  cairo_fill_rule_t rule = MapFillType(inFill);
  cairo_antialias_t previous = cairo_get_antialias(mContext);
  cairo_set_antialias(mContext, MapAntiAlias(mStates.back().antiAlias));
  cairo_set_fill_rule(mContext, rule);
  path.Build(mContext);
  cairo_clip(mContext);
  cairo_set_antialias(mContext, previous);
  ClipBoxes& clip = mStates.back().clip;
  double rect[4];
  ClipBoxes::Box box;
  if (clip.count >= 0 && path.GetSingleRect(rect) && DeviceBoxOf(mContext, rect[0], rect[1], rect[2], rect[3], &box))
    clip.Intersect(box);
  else
    clip.count = -1;
}

RectT<long> OSSurfaceInterface::GetClipBounds() {
  double x1, y1, x2, y2;
  cairo_clip_extents(mContext, &x1, &y1, &x2, &y2);
  return RectT<long>::FromEdges(static_cast<long>(std::floor(x1)), static_cast<long>(std::floor(y1)),
                                static_cast<long>(std::ceil(x2)), static_cast<long>(std::ceil(y2)));
}

bool OSSurfaceInterface::IsWithinClipBounds(RectT<long> const& inRect) const {
  if (!SurfaceInterface::IsWithinClipBounds(inRect)) return false;
  if (mRegion == nullptr) return true;
  // A paint region can be made of several rectangles; test against them, in pixels.
  double x1 = inRect.left, y1 = inRect.top, x2 = inRect.Right(), y2 = inRect.Bottom();
  cairo_user_to_device(mContext, &x1, &y1);
  cairo_user_to_device(mContext, &x2, &y2);
  int left = static_cast<int>(std::floor(std::min(x1, x2))), top = static_cast<int>(std::floor(std::min(y1, y2)));
  int right = static_cast<int>(std::ceil(std::max(x1, x2))), bottom = static_cast<int>(std::ceil(std::max(y1, y2)));
  cairo_rectangle_int_t box{left, top, right - left, bottom - top};
  return cairo_region_contains_rectangle(mRegion, &box) != CAIRO_REGION_OVERLAP_OUT;
}

void OSSurfaceInterface::Transform(MatrixT<float> const& inMatrix) {
  cairo_matrix_t m = ToCairo(inMatrix);
  if (cairo_matrix_invert(&m) != CAIRO_STATUS_SUCCESS) ThrowUnspecified();
  m = ToCairo(inMatrix);
  cairo_transform(mContext, &m);
}

void OSSurfaceInterface::GetTransform(MatrixT<float>* outMatrix) const {
  cairo_matrix_t m;
  cairo_get_matrix(mContext, &m);
  *outMatrix = FromCairo(m);
}

PangoLayout* OSSurfaceInterface::CachedLayout(FontInterface const& inFont, std::string const& inText, int inWidth,
                                               TextAlignment inAlignment) {
  auto const* supplier = static_cast<OSSupplier const*>(GetSupplier());
  return supplier->GetLayoutCache().Get(mContext, Cast<OSFontInterface>(inFont), inText, inWidth, inAlignment,
                                        mStates.back().antiAlias, mStates.back().textDisplay);
}

void OSSurfaceInterface::DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                                        unsigned short const* inText, PointT<float> const& inPoint,
                                        TextAlignment inAlignment) {
  if (inText == nullptr || inText[0] == 0) return;
  auto const& brush = Cast<OSSolidBrushInterface>(inBrush);
  std::string text = ToUTF8(inText, -1);
  BeginDrawing(false);
  PangoLayout* layout = CachedLayout(inFont, text, -1, kTextAlignLeft);
  PangoRectangle logical;
  pango_layout_get_extents(layout, nullptr, &logical);
  double width = static_cast<double>(logical.width) / PANGO_SCALE;
  double x = inPoint.x;
  if (inAlignment == kTextAlignCenter) x -= width * 0.5;
  if (inAlignment == kTextAlignRight) x -= width;
  double baseline = static_cast<double>(pango_layout_get_baseline(layout)) / PANGO_SCALE;
  SetSourceColor(mContext, brush.GetColor());
  cairo_move_to(mContext, x, inPoint.y - baseline);
  pango_cairo_show_layout(mContext, layout);
  EndDrawing();
}

void OSSurfaceInterface::DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                                                 unsigned short const* inText, RectT<float> const& inRect,
                                                 TextAlignment inAlignment) {
  if (inText == nullptr || inText[0] == 0 || inRect.IsEmpty()) return;
  auto const& brush = Cast<OSSolidBrushInterface>(inBrush);
  std::string text = ToUTF8(inText, -1);
  BeginDrawing(false);
  PangoLayout* layout = CachedLayout(inFont, text, static_cast<int>(inRect.width * PANGO_SCALE), inAlignment);
  cairo_rectangle(mContext, inRect.left, inRect.top, inRect.width, inRect.height);
  cairo_clip(mContext);
  SetSourceColor(mContext, brush.GetColor());
  cairo_move_to(mContext, inRect.left, inRect.top);
  pango_cairo_show_layout(mContext, layout);
  EndDrawing();
}

float OSSurfaceInterface::MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText,
                                             long inLength) {
  // Measured under this surface's text policies and scale, as drawing lays the
  // text out, so that a measured width is the drawn width.
  std::string text = inText && inLength != 0 ? ToUTF8(inText, inLength) : std::string();
  if (text.empty()) return 0;
  PangoRectangle logical;
  pango_layout_get_extents(CachedLayout(inFont, text, -1, kTextAlignLeft), nullptr, &logical);
  return static_cast<float>(logical.width) / PANGO_SCALE;
}

float OSSurfaceInterface::MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText,
                                                       float inWidth, long inLength) {
  return Cast<OSFontInterface>(inFont).MeasureMultiLineStringHeight(inText, inWidth, inLength);
}

void OSSurfaceInterface::DrawImage(ImageInterface const& inImage, PointT<float> const& inPoint, float inOpacity) {
  if (!(inOpacity > 0 && inOpacity <= 1)) return;
  auto const& image = Cast<OSImageInterface>(inImage);
  BeginDrawing(false);
  cairo_set_source_surface(mContext, image.GetCairoSurface(), inPoint.x, inPoint.y);
  cairo_pattern_set_filter(cairo_get_source(mContext), MapInterpolation(mStates.back().interpolation));
  cairo_rectangle(mContext, inPoint.x, inPoint.y, static_cast<double>(image.GetWidth()),
                  static_cast<double>(image.GetHeight()));
  cairo_clip(mContext);
  if (inOpacity < 1)
    cairo_paint_with_alpha(mContext, inOpacity);
  else
    cairo_paint(mContext);
  EndDrawing();
}

boost::intrusive_ptr<ImageInterface> OSSurfaceInterface::GetSurfaceImage() {
  if (!mCanGiveImage)
    ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/InvalidSurfaceImage=Invalid surface image.");
  cairo_surface_flush(mTarget);
  // The image shares the pixels; it keeps the surface's buffer alive with it.
  return new OSImageInterface(cairo_surface_reference(mTarget), mDeleter);
}

void OSSurfaceInterface::SetInterpolationPolicy(InterpolationPolicy inPolicy) {
  MapInterpolation(inPolicy);
  mStates.back().interpolation = inPolicy;
}

void OSSurfaceInterface::SetAntiAliasPolicy(AntiAliasPolicy inPolicy) {
  MapAntiAlias(inPolicy);
  mStates.back().antiAlias = inPolicy;
}

void OSSurfaceInterface::SetTextDisplayPolicy(TextDisplayPolicy inPolicy) {
  if (inPolicy != kTextDisplaySmooth && inPolicy != kTextDisplayGridFitted) ThrowUnspecified();
  mStates.back().textDisplay = inPolicy;
}

void OSSurfaceInterface::Flush() {
  cairo_surface_flush(mTarget);
  if (mWriteBack) mWriteBack(mTarget);
  if (mOutput == nullptr || !mHasDrawn) {
    if (mOutput) cairo_surface_flush(mOutput);
    return;
  }
  std::vector<cairo_rectangle_int_t> rects;
  if (mRegion) {
    for (int i = 0; i < cairo_region_num_rectangles(mRegion); ++i) {
      cairo_rectangle_int_t r;
      cairo_region_get_rectangle(mRegion, i, &r);
      rects.push_back(r);
    }
  } else {
    rects.push_back({0, 0, cairo_image_surface_get_width(mTarget), cairo_image_surface_get_height(mTarget)});
  }
  cairo_t* out = cairo_create(mOutput);
  unsigned long delay = GetRedrawDebugFlashDelay();
  for (auto const& r : rects) {
    if (delay != 0) {
      cairo_set_source_rgb(out, 1, 0, 1);
      cairo_rectangle(out, r.x, r.y, r.width, r.height);
      cairo_fill(out);
      cairo_surface_flush(mOutput);
      std::this_thread::sleep_for(std::chrono::milliseconds(delay));
    }
    cairo_set_operator(out, CAIRO_OPERATOR_SOURCE);
    cairo_set_source_surface(out, mTarget, 0, 0);
    cairo_rectangle(out, r.x, r.y, r.width, r.height);
    cairo_fill(out);
    cairo_set_operator(out, CAIRO_OPERATOR_OVER);
  }
  cairo_destroy(out);
  cairo_surface_flush(mOutput);
  mHasDrawn = false;
}

OSReferenceSurface::OSReferenceSurface(SupplierInterface const* inSupplier, SurfaceInterface* inSurface,
                                       bool inFlag, RectT<long> const& inReference)
    : BasicSurfaceReferenceInterface(inSupplier, inSurface, inFlag, inReference.IsEmpty() ? nullptr : &inReference) {
  inSurface->PushStateStack();
  // An empty part comes without a rectangle: the fallback clips nothing.
  ClipToReferenceSurface(inSupplier);
}

OSReferenceSurface::~OSReferenceSurface() { GetReferencedSurface()->PopStateStack(); }

RectT<long> OSReferenceSurface::ReferenceRect(SurfaceInterface* inSurface, RectT<long> const* inRect) {
  const RectT<long> bounds = inSurface->GetClipBounds();
  return inRect ? bounds.Intersection(*inRect) : bounds;
}

}  // namespace norvik::drawbot::cairo
