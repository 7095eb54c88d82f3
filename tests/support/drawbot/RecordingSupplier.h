#pragma once
// A drawing back end that draws nothing and records every call, so that node
// code can be tested without pixels. Fonts advance by half their size per
// character, which makes text widths easy to reason about in tests.
#include <memory>
#include <string>
#include <vector>

#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"

namespace norvik::drawbot::testing {

struct DrawCall {
  std::string op;                       // "PaintRect", "FillPath", "StrokePath", "DrawString", ...
  ColorRGBA color;                      // fill, pen or brush colour
  tarsel::geom::RectT<float> rect;      // PaintRect rectangle, path bounds, text rectangle
  tarsel::geom::PointT<float> point;    // text or image position
  std::string text;                     // text drawn (UTF-8), or the path's segments
  tarsel::geom::MatrixT<float> transform;
  AntiAliasPolicy antiAlias = kAntiAliasNone;
  size_t stateDepth = 0;
  float opacity = 1;
};

class RecordingPath : public PathInterface {
 public:
  void MoveTo(tarsel::geom::PointT<long> const& p) override;
  void MoveTo(tarsel::geom::PointT<float> const& p) override;
  void LineTo(tarsel::geom::PointT<long> const& p) override;
  void LineTo(tarsel::geom::PointT<float> const& p) override;
  void BezierTo(tarsel::geom::PointT<long> const& c1, tarsel::geom::PointT<long> const& c2,
                tarsel::geom::PointT<long> const& e) override;
  void BezierTo(tarsel::geom::PointT<float> const& c1, tarsel::geom::PointT<float> const& c2,
                tarsel::geom::PointT<float> const& e) override;
  void AddRect(tarsel::geom::RectT<long> const& r) override;
  void AddRect(tarsel::geom::RectT<float> const& r) override;
  void AddArc(tarsel::geom::PointT<float> const& c, float r, float start, float sweep) override;
  void ClosePath() override;

  // "M x y", "L x y", "C x1 y1 x2 y2 x y", "R l t w h", "A cx cy r s w", "Z", joined by spaces.
  std::string const& GetDescription() const { return mText; }
  std::vector<std::string> const& GetOps() const { return mOps; }
  std::vector<tarsel::geom::PointT<float>> const& GetPoints() const { return mPoints; }
  bool IsPixelAligned() const { return mAligned; }
  tarsel::geom::RectT<float> GetBounds() const;

 private:
  void Add(std::string const& inOp, std::vector<float> const& inValues);
  std::string mText;
  std::vector<std::string> mOps;
  std::vector<tarsel::geom::PointT<float>> mPoints;
  bool mAligned = true;
};

class RecordingFont : public FontInterface {
 public:
  RecordingFont(std::u16string inFamily, std::u16string inStyle, float inSize)
      : mFamily(std::move(inFamily)), mStyle(std::move(inStyle)), mSize(inSize) {}
  float GetAscent() const override { return mSize * 0.8f; }
  float GetDescent() const override { return mSize * 0.2f; }
  float GetSize() const override { return mSize; }
  float MeasureStringWidth(unsigned short const* inText, long inLength) const override;
  float MeasureMultiLineStringHeight(unsigned short const* inText, float inWidth, long inLength) const override;
  std::u16string const& GetFamily() const { return mFamily; }
  std::u16string const& GetStyle() const { return mStyle; }

 private:
  std::u16string mFamily;
  std::u16string mStyle;
  float mSize;
};

class RecordingSupplier : public SupplierInterface {
 public:
  SurfaceInterface* NewSurface(NativeDrawTarget, NativeRegion, bool) const override;
  SurfaceInterface* NewReferenceSurface(SurfaceInterface* inSurface, bool inFlag,
                                        tarsel::geom::RectT<long> const* inRect) const override;
  SurfaceInterface* NewOffscreenSurface(unsigned long inWidth, unsigned long inHeight, bool) const override;
  SurfaceInterface* NewBufferSurface(unsigned long inWidth, unsigned long inHeight, long, PixelLayout, void*,
                                     boost::intrusive_ptr<DataDeleter>) const override;
  PenInterface* NewPen(ColorRGBA const& inColor, float inWidth) const override;
  BrushInterface* NewBrush(ColorRGBA const& inColor) const override;
  using SupplierInterface::NewLinearShader;
  LinearShaderInterface* NewLinearShader(tarsel::geom::PointT<float> const& inStart,
                                         tarsel::geom::PointT<float> const& inEnd, ColorRGBA const* inColors,
                                         float const* inPositions, unsigned long inCount) const override;
  RadialShaderInterface* NewRadialShader(tarsel::geom::PointT<float> const& inCentre, float const* inRadii,
                                         tarsel::geom::PointT<float> const& inFocus, ColorRGBA const* inColors,
                                         float const* inPositions, unsigned long inCount) const override;
  FontInterface* NewFont(unsigned short const* inFamily, unsigned short const* inStyle, float inSize) const override;
  ImageInterface* NewFileImage(ImageFileType, void const*, unsigned long) const override;
  ImageInterface* NewBufferImage(unsigned long inWidth, unsigned long inHeight, long, PixelLayout, void*,
                                 boost::intrusive_ptr<DataDeleter> inDeleter) const override;
  PathInterface* NewPath() const override { return new RecordingPath(); }

  // Surfaces made by this supplier record into this log.
  std::vector<DrawCall>& GetCalls() const { return mCalls; }
  std::vector<std::string> GetOps() const;
  void ClearCalls() const { mCalls.clear(); }

 private:
  mutable std::vector<DrawCall> mCalls;
};

class RecordingPen : public PenInterface {
 public:
  RecordingPen(ColorRGBA const& inColor, float inWidth) : mColor(inColor), mWidth(inWidth) {}
  void SetWidth(float w) override { mWidth = w; }
  float GetWidth() const override { return mWidth; }
  void SetMiterLimit(float l) override { mMiter = l; }
  float GetMiterLimit() const override { return mMiter; }
  void SetLineJoin(LineJoin j) override { mJoin = j; }
  LineJoin GetLineJoin() const override { return mJoin; }
  void SetLineCap(LineCap c) override { mCap = c; }
  LineCap GetLineCap() const override { return mCap; }
  void SetDashArray(float const* d, long n) override { mDashes.assign(d, d + n); }
  void GetDashArray(long n, float* out) const override {
    for (long i = 0; i < n && i < GetDashCount(); ++i) out[i] = mDashes[static_cast<size_t>(i)];
  }
  long GetDashCount() const override { return static_cast<long>(mDashes.size()); }
  ColorRGBA const& GetColor() const { return mColor; }

 private:
  ColorRGBA mColor;
  float mWidth;
  float mMiter = 10;
  LineJoin mJoin = kLineJoinMiter;
  LineCap mCap = kLineCapFlat;
  std::vector<float> mDashes;
};

class RecordingBrush : public BrushInterface {
 public:
  explicit RecordingBrush(ColorRGBA const& inColor) : mColor(inColor) {}
  ColorRGBA const& GetColor() const { return mColor; }

 private:
  ColorRGBA mColor;
};

class RecordingLinearShader : public LinearShaderInterface {
 public:
  std::vector<float> positions;
  std::vector<ColorRGBA> colors;
};

class RecordingImage : public ImageInterface {
 public:
  RecordingImage(unsigned long inWidth, unsigned long inHeight, boost::intrusive_ptr<DataDeleter> inDeleter = nullptr)
      : mWidth(inWidth), mHeight(inHeight), mDeleter(std::move(inDeleter)) {}
  unsigned long GetWidth() const override { return mWidth; }
  unsigned long GetHeight() const override { return mHeight; }

 private:
  unsigned long mWidth, mHeight;
  boost::intrusive_ptr<DataDeleter> mDeleter;
};

class RecordingSurface : public SurfaceInterface {
 public:
  RecordingSurface(RecordingSupplier const* inSupplier, long inWidth, long inHeight);

  // Replaces the clip by a set of rectangles in surface pixels.
  void SetClipRects(std::vector<tarsel::geom::RectT<long>> const& inRects);
  size_t GetStateDepth() const { return mStates.size(); }
  // Number of IsWithinClipBounds calls, to check that bisection stays logarithmic.
  mutable long mClipProbes = 0;

  void PushStateStack() override;
  void PopStateStack() override;
  void PaintRect(ColorRGBA const& inColor, tarsel::geom::RectT<float> const& inRect) override;
  void FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType inFill) override;
  void StrokePath(PenInterface const& inPen, PathInterface const& inPath) override;
  void ShadePath(ShaderInterface const& inShader, PathInterface const& inPath, FillType inFill) override;
  void GetOutputClipRects(std::vector<tarsel::geom::RectT<long>>* outRects) const override;
  void Clip(PathInterface const& inPath, FillType inFill) override;
  tarsel::geom::RectT<long> GetClipBounds() override;
  bool IsWithinClipBounds(tarsel::geom::RectT<long> const& inRect) const override;
  void Transform(tarsel::geom::MatrixT<float> const& inMatrix) override;
  void GetTransform(tarsel::geom::MatrixT<float>* outMatrix) const override;
  float MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText, long inLength) override;
  float MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText, float inWidth,
                                     long inLength) override;
  using SurfaceInterface::DrawImage;
  void DrawImage(ImageInterface const& inImage, tarsel::geom::PointT<float> const& inPoint,
                 float inOpacity) override;
  boost::intrusive_ptr<ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(InterpolationPolicy inPolicy) override { mStates.back().interpolation = inPolicy; }
  InterpolationPolicy GetInterpolationPolicy() override { return mStates.back().interpolation; }
  void SetAntiAliasPolicy(AntiAliasPolicy inPolicy) override { mStates.back().antiAlias = inPolicy; }
  AntiAliasPolicy GetAntiAliasPolicy() override { return mStates.back().antiAlias; }
  void SetTextDisplayPolicy(TextDisplayPolicy inPolicy) override { mStates.back().textDisplay = inPolicy; }
  TextDisplayPolicy GetTextDisplayPolicy() override { return mStates.back().textDisplay; }
  void Flush() override { Record("Flush"); }

 protected:
  void DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                      tarsel::geom::PointT<float> const& inPoint, TextAlignment inAlignment) override;
  void DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                               unsigned short const* inText, tarsel::geom::RectT<float> const& inRect,
                               TextAlignment inAlignment) override;

 private:
  struct State {
    AntiAliasPolicy antiAlias = kAntiAliasNone;
    InterpolationPolicy interpolation = kInterpolationNearestNeighbor;
    TextDisplayPolicy textDisplay = kTextDisplayGridFitted;
    tarsel::geom::MatrixT<float> transform;
    std::vector<tarsel::geom::RectT<long>> clip;  // in surface pixels
  };
  DrawCall& Record(std::string const& inOp);
  RecordingSupplier const* mRecorder;
  long mWidth, mHeight;
  std::vector<State> mStates;
};

}  // namespace norvik::drawbot::testing
