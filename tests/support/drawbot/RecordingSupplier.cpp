#include "support/drawbot/RecordingSupplier.h"

#include <algorithm>
#include <cmath>
#include <sstream>

#include "drawbot/BasicSurfaceReferenceInterface.h"

namespace norvik::drawbot::testing {

using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

namespace {

std::string ToUTF8(unsigned short const* inText, long inLength = -1) {
  std::u16string text;
  for (long i = 0; inText && (inLength < 0 ? inText[i] != 0 : i < inLength); ++i)
    text.push_back(static_cast<char16_t>(inText[i]));
  return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(text));
}

long Length(unsigned short const* inText) {
  long n = 0;
  while (inText && inText[n]) ++n;
  return n;
}

RectT<long> ToPixels(RectT<float> const& inRect) {
  return RectT<long>::FromEdges(static_cast<long>(std::floor(inRect.left)), static_cast<long>(std::floor(inRect.top)),
                                static_cast<long>(std::ceil(inRect.Right())),
                                static_cast<long>(std::ceil(inRect.Bottom())));
}

}  // namespace

void RecordingPath::Add(std::string const& inOp, std::vector<float> const& inValues) {
  std::ostringstream s;
  s << inOp;
  for (float v : inValues) s << ' ' << v;
  if (!mText.empty()) mText += ' ';
  mText += s.str();
  mOps.push_back(inOp);
}

void RecordingPath::MoveTo(PointT<long> const& p) {
  Add("M", {float(p.x), float(p.y)});
  mPoints.emplace_back(p);
}
void RecordingPath::MoveTo(PointT<float> const& p) {
  mAligned = false;
  Add("M", {p.x, p.y});
  mPoints.push_back(p);
}
void RecordingPath::LineTo(PointT<long> const& p) {
  Add("L", {float(p.x), float(p.y)});
  mPoints.emplace_back(p);
}
void RecordingPath::LineTo(PointT<float> const& p) {
  mAligned = false;
  Add("L", {p.x, p.y});
  mPoints.push_back(p);
}
void RecordingPath::BezierTo(PointT<long> const& c1, PointT<long> const& c2, PointT<long> const& e) {
  Add("C", {float(c1.x), float(c1.y), float(c2.x), float(c2.y), float(e.x), float(e.y)});
  mPoints.insert(mPoints.end(), {PointT<float>(c1), PointT<float>(c2), PointT<float>(e)});
}
void RecordingPath::BezierTo(PointT<float> const& c1, PointT<float> const& c2, PointT<float> const& e) {
  mAligned = false;
  Add("C", {c1.x, c1.y, c2.x, c2.y, e.x, e.y});
  mPoints.insert(mPoints.end(), {c1, c2, e});
}
void RecordingPath::AddRect(RectT<long> const& r) {
  Add("R", {float(r.left), float(r.top), float(r.width), float(r.height)});
  mPoints.insert(mPoints.end(), {PointT<float>(r.left, r.top), PointT<float>(r.Right(), r.Bottom())});
}
void RecordingPath::AddRect(RectT<float> const& r) {
  mAligned = false;
  Add("R", {r.left, r.top, r.width, r.height});
  mPoints.insert(mPoints.end(), {PointT<float>(r.left, r.top), PointT<float>(r.Right(), r.Bottom())});
}
void RecordingPath::AddArc(PointT<float> const& c, float r, float start, float sweep) {
  mAligned = false;
  Add("A", {c.x, c.y, r, start, sweep});
  mPoints.insert(mPoints.end(), {PointT<float>(c.x - r, c.y - r), PointT<float>(c.x + r, c.y + r)});
}
void RecordingPath::ClosePath() { Add("Z", {}); }

RectT<float> RecordingPath::GetBounds() const {
  if (mPoints.empty()) return RectT<float>();
  float l = mPoints[0].x, t = mPoints[0].y, r = l, b = t;
  for (auto const& p : mPoints) {
    l = std::min(l, p.x);
    t = std::min(t, p.y);
    r = std::max(r, p.x);
    b = std::max(b, p.y);
  }
  return RectT<float>::FromEdges(l, t, r, b);
}

float RecordingFont::MeasureStringWidth(unsigned short const* inText, long inLength) const {
  long n = inLength < 0 ? Length(inText) : std::min(inLength, Length(inText));
  return static_cast<float>(n) * mSize * 0.5f;
}

float RecordingFont::MeasureMultiLineStringHeight(unsigned short const* inText, float inWidth, long inLength) const {
  float width = MeasureStringWidth(inText, inLength);
  float lines = inWidth > 0 ? std::ceil(width / inWidth) : 1;
  return std::max(1.0f, lines) * mSize;
}

SurfaceInterface* RecordingSupplier::NewSurface(NativeDrawTarget, NativeRegion, bool) const {
  return new RecordingSurface(this, 1000, 1000);
}
SurfaceInterface* RecordingSupplier::NewReferenceSurface(SurfaceInterface* inSurface, bool inFlag,
                                                         RectT<long> const* inRect) const {
  return new BasicSurfaceReferenceInterface(this, inSurface, inFlag, inRect);
}
SurfaceInterface* RecordingSupplier::NewOffscreenSurface(unsigned long inWidth, unsigned long inHeight,
                                                         bool) const {
  return new RecordingSurface(this, static_cast<long>(inWidth), static_cast<long>(inHeight));
}
SurfaceInterface* RecordingSupplier::NewBufferSurface(unsigned long inWidth, unsigned long inHeight, long,
                                                      PixelLayout, void*,
                                                      boost::intrusive_ptr<DataDeleter>) const {
  return new RecordingSurface(this, static_cast<long>(inWidth), static_cast<long>(inHeight));
}
PenInterface* RecordingSupplier::NewPen(ColorRGBA const& inColor, float inWidth) const {
  return new RecordingPen(inColor, inWidth);
}
BrushInterface* RecordingSupplier::NewBrush(ColorRGBA const& inColor) const { return new RecordingBrush(inColor); }
LinearShaderInterface* RecordingSupplier::NewLinearShader(PointT<float> const&, PointT<float> const&,
                                                          ColorRGBA const* inColors, float const* inPositions,
                                                          unsigned long inCount) const {
  auto* shader = new RecordingLinearShader();
  shader->colors.assign(inColors, inColors + inCount);
  shader->positions.assign(inPositions, inPositions + inCount);
  return shader;
}
RadialShaderInterface* RecordingSupplier::NewRadialShader(PointT<float> const&, float const*, PointT<float> const&,
                                                          ColorRGBA const*, float const*, unsigned long) const {
  return new RadialShaderInterface();
}
FontInterface* RecordingSupplier::NewFont(unsigned short const* inFamily, unsigned short const* inStyle,
                                          float inSize) const {
  auto text = [](unsigned short const* s) {
    std::u16string out;
    for (long i = 0; s && s[i]; ++i) out.push_back(static_cast<char16_t>(s[i]));
    return out;
  };
  return new RecordingFont(text(inFamily), text(inStyle), inSize);
}
ImageInterface* RecordingSupplier::NewFileImage(ImageFileType, void const*, unsigned long) const {
  return new RecordingImage(16, 16);
}
ImageInterface* RecordingSupplier::NewBufferImage(unsigned long inWidth, unsigned long inHeight, long, PixelLayout,
                                                  void*, boost::intrusive_ptr<DataDeleter> inDeleter) const {
  return new RecordingImage(inWidth, inHeight, std::move(inDeleter));
}
std::vector<std::string> RecordingSupplier::GetOps() const {
  std::vector<std::string> ops;
  for (auto const& call : mCalls) ops.push_back(call.op);
  return ops;
}

RecordingSurface::RecordingSurface(RecordingSupplier const* inSupplier, long inWidth, long inHeight)
    : SurfaceInterface(inSupplier), mRecorder(inSupplier), mWidth(inWidth), mHeight(inHeight) {
  mStates.emplace_back();
  mStates.back().clip.push_back(RectT<long>(0, 0, inWidth, inHeight));
}

DrawCall& RecordingSurface::Record(std::string const& inOp) {
  DrawCall call;
  call.op = inOp;
  call.transform = mStates.back().transform;
  call.antiAlias = mStates.back().antiAlias;
  call.stateDepth = mStates.size();
  mRecorder->GetCalls().push_back(call);
  return mRecorder->GetCalls().back();
}

void RecordingSurface::SetClipRects(std::vector<RectT<long>> const& inRects) { mStates.back().clip = inRects; }

void RecordingSurface::PushStateStack() {
  mStates.push_back(mStates.back());
  Record("Push");
}
void RecordingSurface::PopStateStack() {
  if (mStates.size() > 1) mStates.pop_back();
  Record("Pop");
}
void RecordingSurface::PaintRect(ColorRGBA const& inColor, RectT<float> const& inRect) {
  if (inRect.IsEmpty()) return;
  DrawCall& call = Record("PaintRect");
  call.color = inColor;
  call.rect = inRect;
}
void RecordingSurface::FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType) {
  DrawCall& call = Record("FillPath");
  call.color = dynamic_cast<RecordingBrush const&>(inBrush).GetColor();
  call.rect = dynamic_cast<RecordingPath const&>(inPath).GetBounds();
  call.text = dynamic_cast<RecordingPath const&>(inPath).GetDescription();
}
void RecordingSurface::StrokePath(PenInterface const& inPen, PathInterface const& inPath) {
  DrawCall& call = Record("StrokePath");
  call.color = dynamic_cast<RecordingPen const&>(inPen).GetColor();
  call.rect = dynamic_cast<RecordingPath const&>(inPath).GetBounds();
  call.text = dynamic_cast<RecordingPath const&>(inPath).GetDescription();
}
void RecordingSurface::ShadePath(ShaderInterface const&, PathInterface const& inPath, FillType) {
  DrawCall& call = Record("ShadePath");
  call.rect = dynamic_cast<RecordingPath const&>(inPath).GetBounds();
}
void RecordingSurface::GetOutputClipRects(std::vector<RectT<long>>* outRects) const { *outRects = mStates.back().clip; }

void RecordingSurface::Clip(PathInterface const& inPath, FillType) {
  RectT<long> pixels = ToPixels(mStates.back().transform.TransformBounds(
      dynamic_cast<RecordingPath const&>(inPath).GetBounds()));
  std::vector<RectT<long>> clipped;
  for (auto const& r : mStates.back().clip) {
    RectT<long> part = r.Intersection(pixels);
    if (!part.IsEmpty()) clipped.push_back(part);
  }
  mStates.back().clip = clipped;
  Record("Clip").rect = RectT<float>(pixels);
}

RectT<long> RecordingSurface::GetClipBounds() {
  RectT<long> bounds;
  for (auto const& r : mStates.back().clip) bounds = bounds.Union(r);
  MatrixT<float> inverse = mStates.back().transform;
  if (!inverse.Invert()) return RectT<long>();
  return ToPixels(inverse.TransformBounds(RectT<float>(bounds)));
}

bool RecordingSurface::IsWithinClipBounds(RectT<long> const& inRect) const {
  ++mClipProbes;
  RectT<long> pixels = ToPixels(mStates.back().transform.TransformBounds(RectT<float>(inRect)));
  for (auto const& r : mStates.back().clip)
    if (r.Intersects(pixels)) return true;
  return false;
}

void RecordingSurface::Transform(MatrixT<float> const& inMatrix) {
  mStates.back().transform = mStates.back().transform.Concat(inMatrix);
}
void RecordingSurface::GetTransform(MatrixT<float>* outMatrix) const { *outMatrix = mStates.back().transform; }

float RecordingSurface::MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText, long inLength) {
  return inFont.MeasureStringWidth(inText, inLength);
}
float RecordingSurface::MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText,
                                                     float inWidth, long inLength) {
  return inFont.MeasureMultiLineStringHeight(inText, inWidth, inLength);
}
void RecordingSurface::DrawImage(ImageInterface const& inImage, PointT<float> const& inPoint, float inOpacity) {
  if (!(inOpacity > 0 && inOpacity <= 1)) return;
  DrawCall& call = Record("DrawImage");
  call.point = inPoint;
  call.rect = RectT<float>(inPoint.x, inPoint.y, static_cast<float>(inImage.GetWidth()),
                           static_cast<float>(inImage.GetHeight()));
  call.opacity = inOpacity;
}
boost::intrusive_ptr<ImageInterface> RecordingSurface::GetSurfaceImage() {
  return new RecordingImage(static_cast<unsigned long>(mWidth), static_cast<unsigned long>(mHeight));
}
void RecordingSurface::DrawStringImpl(BrushInterface const& inBrush, FontInterface const&,
                                      unsigned short const* inText, PointT<float> const& inPoint,
                                      TextAlignment inAlignment) {
  DrawCall& call = Record("DrawString");
  call.color = dynamic_cast<RecordingBrush const&>(inBrush).GetColor();
  call.text = ToUTF8(inText);
  call.point = inPoint;
  call.rect = RectT<float>(static_cast<float>(inAlignment), 0, 0, 0);
}
void RecordingSurface::DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const&,
                                               unsigned short const* inText, RectT<float> const& inRect,
                                               TextAlignment) {
  DrawCall& call = Record("DrawMultiLineString");
  call.color = dynamic_cast<RecordingBrush const&>(inBrush).GetColor();
  call.text = ToUTF8(inText);
  call.rect = inRect;
}

}  // namespace norvik::drawbot::testing
