#pragma once
// The image back end over Cairo and Pango: the classes behind NewOSSupplier().
// Private to the drawing layer; portable code reaches them only through the
// interfaces.
#include <cairo.h>
#include <pango/pangocairo.h>

#include <functional>
#include <map>
#include <tuple>
#include <vector>

#include "drawbot/BasicSurfaceReferenceInterface.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "drawbot/src/cairo/LayoutCache.h"
#include "drawbot/src/cairo/PixelBoxes.h"

namespace norvik::drawbot::cairo {

using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

// Raises the back end's error texts.
[[noreturn]] void ThrowDrawingError(char const* inKeyText);
[[noreturn]] void ThrowUnspecified();

cairo_antialias_t MapAntiAlias(AntiAliasPolicy inPolicy);
cairo_filter_t MapInterpolation(InterpolationPolicy inPolicy);
cairo_fill_rule_t MapFillType(FillType inFill);
cairo_line_cap_t MapLineCap(LineCap inCap);
cairo_line_join_t MapLineJoin(LineJoin inJoin);
// The Cairo format that a pixel layout is drawn through (ARGB32 or RGB24).
cairo_format_t MapPixelLayout(PixelLayout inLayout);

cairo_matrix_t ToCairo(MatrixT<float> const& inMatrix);
MatrixT<float> FromCairo(cairo_matrix_t const& inMatrix);

// Casts a resource of this back end, raising "Unspecified drawing error." for
// one made by another supplier.
template <typename Out, typename In>
Out const& Cast(In const& inObject) {
  auto const* out = dynamic_cast<Out const*>(&inObject);
  if (out == nullptr) ThrowUnspecified();
  return *out;
}

class OSPenInterface : public PenInterface {
 public:
  OSPenInterface(ColorRGBA const& inColor, float inWidth) : mColor(inColor), mWidth(inWidth) {}
  void SetWidth(float inWidth) override { mWidth = inWidth; }
  float GetWidth() const override { return mWidth; }
  void SetMiterLimit(float inLimit) override { mMiterLimit = inLimit; }
  float GetMiterLimit() const override { return mMiterLimit; }
  void SetLineJoin(LineJoin inJoin) override;
  LineJoin GetLineJoin() const override { return mJoin; }
  void SetLineCap(LineCap inCap) override;
  LineCap GetLineCap() const override { return mCap; }
  void SetDashArray(float const* inDashes, long inCount) override;
  void GetDashArray(long inCount, float* outDashes) const override;
  long GetDashCount() const override { return static_cast<long>(mDashes.size()); }

  // Sets colour, width, joins, caps and dashes on the context.
  void Apply(cairo_t* inContext) const;

 private:
  ColorRGBA mColor;
  float mWidth;
  float mMiterLimit = 10;
  LineJoin mJoin = kLineJoinMiter;
  LineCap mCap = kLineCapFlat;
  std::vector<double> mDashes;
};

class OSSolidBrushInterface : public BrushInterface {
 public:
  explicit OSSolidBrushInterface(ColorRGBA const& inColor) : mColor(inColor) {}
  ColorRGBA const& GetColor() const { return mColor; }

 private:
  ColorRGBA mColor;
};

// Both gradients hold a Cairo pattern.
class OSGradient {
 public:
  explicit OSGradient(cairo_pattern_t* inPattern) : mPattern(inPattern) {}
  ~OSGradient() { cairo_pattern_destroy(mPattern); }
  OSGradient(const OSGradient&) = delete;
  OSGradient& operator=(const OSGradient&) = delete;
  cairo_pattern_t* GetPattern() const { return mPattern; }

 private:
  cairo_pattern_t* mPattern;
};

class OSLinearGradientBrushInterface : public LinearShaderInterface, public OSGradient {
 public:
  using OSGradient::OSGradient;
};

class OSRadialGradientBrushInterface : public RadialShaderInterface, public OSGradient {
 public:
  using OSGradient::OSGradient;
};

class OSPathInterface : public PathInterface {
 public:
  void MoveTo(PointT<long> const& inPoint) override;
  void MoveTo(PointT<float> const& inPoint) override;
  void LineTo(PointT<long> const& inPoint) override;
  void LineTo(PointT<float> const& inPoint) override;
  void BezierTo(PointT<long> const& inC1, PointT<long> const& inC2, PointT<long> const& inEnd) override;
  void BezierTo(PointT<float> const& inC1, PointT<float> const& inC2, PointT<float> const& inEnd) override;
  void AddRect(RectT<long> const& inRect) override;
  void AddRect(RectT<float> const& inRect) override;
  void AddArc(PointT<float> const& inCentre, float inRadius, float inStartAngle, float inSweepAngle) override;
  void ClosePath() override;

  bool IsPixelAligned() const { return mPixelAligned; }
  // True, with x, y, width and height, when the path is one rectangle and nothing else.
  bool GetSingleRect(double (&outRect)[4]) const;
  // Replays the path onto the context's current path, in its user space.
  void Build(cairo_t* inContext) const;

 private:
  enum class Op { kMove, kLine, kCurve, kRect, kArc, kClose };
  struct Segment {
    Op op;
    double v[6];
  };
  void Move(double inX, double inY);
  void Line(double inX, double inY);
  void Curve(double const (&inV)[6]);
  void Rect(double inX, double inY, double inW, double inH);

  std::vector<Segment> mSegments;
  bool mPixelAligned = true;
  bool mFigureOpen = false;
  double mFirstX = 0, mFirstY = 0, mCurrentX = 0, mCurrentY = 0;
};

class OSImageInterface : public ImageInterface {
 public:
  // Takes over inSurface's reference.
  OSImageInterface(cairo_surface_t* inSurface, boost::intrusive_ptr<DataDeleter> inDeleter = nullptr)
      : mSurface(inSurface), mDeleter(std::move(inDeleter)) {}
  ~OSImageInterface() override { cairo_surface_destroy(mSurface); }
  unsigned long GetWidth() const override {
    return static_cast<unsigned long>(cairo_image_surface_get_width(mSurface));
  }
  unsigned long GetHeight() const override {
    return static_cast<unsigned long>(cairo_image_surface_get_height(mSurface));
  }
  cairo_surface_t* GetCairoSurface() const { return mSurface; }

 private:
  cairo_surface_t* mSurface;
  boost::intrusive_ptr<DataDeleter> mDeleter;
};

class OSSupplier;

class OSFontInterface : public FontInterface {
 public:
  OSFontInterface(OSSupplier const* inSupplier, PangoFontDescription* inDescription, float inSize);
  ~OSFontInterface() override;
  float GetAscent() const override { return mAscent; }
  float GetDescent() const override { return mDescent; }
  float GetSize() const override { return mSize; }
  float MeasureStringWidth(unsigned short const* inText, long inLength) const override;
  float MeasureMultiLineStringHeight(unsigned short const* inText, float inWidth, long inLength) const override;
  PangoFontDescription const* GetDescription() const { return mDescription; }

 private:
  OSSupplier const* mSupplier;
  PangoFontDescription* mDescription;
  float mSize;
  float mAscent = 0;
  float mDescent = 0;
};

// Text of a UTF-16 string, up to inLength characters (-1: to the terminator), as UTF-8.
std::string ToUTF8(unsigned short const* inText, long inLength);

// Sets the layout's font options from the anti-alias and text display policies:
// grid-fitted text hints its metrics and rounds glyph positions, smooth text does not.
void ApplyTextPolicies(PangoLayout* inLayout, AntiAliasPolicy inAntiAlias, TextDisplayPolicy inDisplay);

class OSSupplier : public SupplierInterface {
 public:
  OSSupplier();
  ~OSSupplier() override;

  SurfaceInterface* NewSurface(NativeDrawTarget inTarget, NativeRegion inRegion, bool inBuffered) const override;
  SurfaceInterface* NewReferenceSurface(SurfaceInterface* inSurface, bool inFlag,
                                        RectT<long> const* inRect) const override;
  SurfaceInterface* NewOffscreenSurface(unsigned long inWidth, unsigned long inHeight, bool inFlag) const override;
  SurfaceInterface* NewBufferSurface(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                     PixelLayout inLayout, void* inData,
                                     boost::intrusive_ptr<DataDeleter> inDeleter) const override;
  PenInterface* NewPen(ColorRGBA const& inColor, float inWidth) const override;
  BrushInterface* NewBrush(ColorRGBA const& inColor) const override;
  LinearShaderInterface* NewLinearShader(PointT<float> const& inStart, PointT<float> const& inEnd,
                                         ColorRGBA const* inColors, float const* inPositions,
                                         unsigned long inCount) const override;
  using SupplierInterface::NewLinearShader;
  RadialShaderInterface* NewRadialShader(PointT<float> const& inCentre, float const* inRadii,
                                         PointT<float> const& inFocus, ColorRGBA const* inColors,
                                         float const* inPositions, unsigned long inCount) const override;
  FontInterface* NewFont(unsigned short const* inFamily, unsigned short const* inStyle, float inSize) const override;
  ImageInterface* NewFileImage(ImageFileType inType, void const* inData, unsigned long inSize) const override;
  ImageInterface* NewBufferImage(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                 PixelLayout inLayout, void* inData,
                                 boost::intrusive_ptr<DataDeleter> inDeleter) const override;
  PathInterface* NewPath() const override { return new OSPathInterface(); }
  bool SupportsPixelLayoutBGRA() const override { return true; }
  bool PrefersPixelLayoutBGRA() const override { return true; }

  // The layout that measures text without any paint in progress.
  PangoLayout* GetMeasuringLayout() const { return mMeasuringLayout; }
  // The shaped layouts that surfaces draw and measure text with.
  LayoutCache& GetLayoutCache() const { return mLayoutCache; }

 private:
  using FontKey = std::tuple<std::u16string, int, float>;
  cairo_surface_t* mMeasuringSurface = nullptr;
  cairo_t* mMeasuringContext = nullptr;
  PangoLayout* mMeasuringLayout = nullptr;
  mutable std::map<FontKey, boost::intrusive_ptr<OSFontInterface>> mFontCache;
  // After the fonts: its entries hold references on them.
  mutable LayoutCache mLayoutCache;
};

// A surface over a Cairo image surface or a platform target.
class OSSurfaceInterface : public SurfaceInterface {
 public:
  // inTarget: the surface drawn on (a reference is taken). inOutput, when not
  // null, is where Flush copies the pixels to, clipped to inRegion.
  OSSurfaceInterface(OSSupplier const* inSupplier, cairo_surface_t* inTarget, bool inCanGiveImage,
                     cairo_surface_t* inOutput, cairo_region_t* inRegion,
                     boost::intrusive_ptr<DataDeleter> inDeleter = nullptr);
  ~OSSurfaceInterface() override;

  // For caller's pixels that Cairo cannot draw on in place: called with the
  // surface drawn on at each Flush and at the end, to copy the pixels back.
  void SetWriteBack(std::function<void(cairo_surface_t*)> inWriteBack) { mWriteBack = std::move(inWriteBack); }

  void PushStateStack() override;
  void PopStateStack() override;
  void PaintRect(ColorRGBA const& inColor, RectT<float> const& inRect) override;
  void FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType inFill) override;
  void StrokePath(PenInterface const& inPen, PathInterface const& inPath) override;
  void ShadePath(ShaderInterface const& inShader, PathInterface const& inPath, FillType inFill) override;
  void GetOutputClipRects(std::vector<RectT<long>>* outRects) const override;
  void Clip(PathInterface const& inPath, FillType inFill) override;
  RectT<long> GetClipBounds() override;
  bool IsWithinClipBounds(RectT<long> const& inRect) const override;
  void Transform(MatrixT<float> const& inMatrix) override;
  void GetTransform(MatrixT<float>* outMatrix) const override;
  float MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText, long inLength) override;
  float MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText, float inWidth,
                                     long inLength) override;
  using SurfaceInterface::DrawImage;
  void DrawImage(ImageInterface const& inImage, PointT<float> const& inPoint, float inOpacity) override;
  boost::intrusive_ptr<ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(InterpolationPolicy inPolicy) override;
  InterpolationPolicy GetInterpolationPolicy() override { return mStates.back().interpolation; }
  void SetAntiAliasPolicy(AntiAliasPolicy inPolicy) override;
  AntiAliasPolicy GetAntiAliasPolicy() override { return mStates.back().antiAlias; }
  void SetTextDisplayPolicy(TextDisplayPolicy inPolicy) override;
  TextDisplayPolicy GetTextDisplayPolicy() override { return mStates.back().textDisplay; }
  void Flush() override;

  cairo_t* GetContext() const { return mContext; }
  std::size_t GetStateDepth() const { return mStates.size(); }

 protected:
  void DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                      PointT<float> const& inPoint, TextAlignment inAlignment) override;
  void DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                               unsigned short const* inText, RectT<float> const& inRect,
                               TextAlignment inAlignment) override;

 private:
  struct State {
    AntiAliasPolicy antiAlias = kAntiAliasNone;
    InterpolationPolicy interpolation = kInterpolationNearestNeighbor;
    TextDisplayPolicy textDisplay = kTextDisplayGridFitted;
    // The clip as whole device pixels, when it is a few boxes.
    ClipBoxes clip;
  };
  // Saves the context and moves it to whole-pixel centres when the shape stays
  // on whole pixels with anti-aliasing off; see the source for why.
  void BeginDrawing(bool inPixelAligned);
  void EndDrawing();
  // The supplier's cached layout of inText under this state's text policies.
  PangoLayout* CachedLayout(FontInterface const& inFont, std::string const& inText, int inWidth,
                            TextAlignment inAlignment);

  cairo_surface_t* mTarget;
  cairo_t* mContext;
  cairo_surface_t* mOutput;
  cairo_region_t* mRegion;
  boost::intrusive_ptr<DataDeleter> mDeleter;
  std::function<void(cairo_surface_t*)> mWriteBack;
  bool mCanGiveImage;
  bool mHasDrawn = false;
  std::vector<State> mStates;
};

// A surface over another one's state, standing for the part of it that the
// outer clip bounds and the given rectangle share; policies and the state
// stack are those of the surface it refers to. Windows paint through a back
// buffer already, so even a buffered reference draws straight through the
// outer surface's context, in its device space.
class OSReferenceSurface : public BasicSurfaceReferenceInterface {
 public:
  // inReference: the part stood for, from ReferenceRect.
  OSReferenceSurface(SupplierInterface const* inSupplier, SurfaceInterface* inSurface, bool inFlag,
                     RectT<long> const& inReference);
  ~OSReferenceSurface() override;

  // The outer clip bounds restricted to inRect (when given). An empty result
  // means the reference cannot stand for anything and falls back to the whole
  // outer surface.
  static RectT<long> ReferenceRect(SurfaceInterface* inSurface, RectT<long> const* inRect);
};

}  // namespace norvik::drawbot::cairo
