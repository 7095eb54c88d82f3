#include "drawbot/BasicSurfaceReferenceInterface.h"

#include "drawbot/DrawbotWrappers.h"

namespace norvik::drawbot {

using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

BasicSurfaceReferenceInterface::BasicSurfaceReferenceInterface(SupplierInterface const* inSupplier,
                                                               SurfaceInterface* inSurface, bool,
                                                               RectT<long> const* inRect)
    : SurfaceInterface(inSupplier), mSurface(inSurface), mHasRect(inRect != nullptr) {
  if (inRect) mRect = *inRect;
}

void BasicSurfaceReferenceInterface::ClipToReferenceSurface(SupplierInterface const* inSupplier) {
  if (!mHasRect) return;
  PathP path(inSupplier);
  if (!path) return;
  path->AddRect(mRect);
  mSurface->Clip(*path, kFillWinding);
}

void BasicSurfaceReferenceInterface::PushStateStack() { mSurface->PushStateStack(); }
void BasicSurfaceReferenceInterface::PopStateStack() { mSurface->PopStateStack(); }
boost::intrusive_ptr<CacheInterface> BasicSurfaceReferenceInterface::PushCacheStack(RectT<float> const& inRect) {
  return mSurface->PushCacheStack(inRect);
}
void BasicSurfaceReferenceInterface::PopCacheStack(boost::intrusive_ptr<CacheInterface> inCache) {
  mSurface->PopCacheStack(boost::intrusive_ptr<CacheInterface>(inCache));
}
void BasicSurfaceReferenceInterface::PaintRect(ColorRGBA const& inColor, RectT<float> const& inRect) {
  mSurface->PaintRect(inColor, inRect);
}
void BasicSurfaceReferenceInterface::FillPath(BrushInterface const& inBrush, PathInterface const& inPath,
                                              FillType inFill) {
  mSurface->FillPath(inBrush, inPath, inFill);
}
void BasicSurfaceReferenceInterface::StrokePath(PenInterface const& inPen, PathInterface const& inPath) {
  mSurface->StrokePath(inPen, inPath);
}
void BasicSurfaceReferenceInterface::ShadePath(ShaderInterface const& inShader, PathInterface const& inPath,
                                               FillType inFill) {
  mSurface->ShadePath(inShader, inPath, inFill);
}
SupplierInterface const* BasicSurfaceReferenceInterface::GetOutputSupplier() const {
  return mSurface->GetOutputSupplier();
}
SurfaceInterface* BasicSurfaceReferenceInterface::GetOutputSurface() { return mSurface->GetOutputSurface(); }
SurfaceInterface const* BasicSurfaceReferenceInterface::GetOutputSurface() const {
  return static_cast<SurfaceInterface const*>(mSurface.get())->GetOutputSurface();
}
void BasicSurfaceReferenceInterface::GetOutputTransform(MatrixT<float>* outMatrix) const {
  mSurface->GetOutputTransform(outMatrix);
}
void BasicSurfaceReferenceInterface::GetOutputClipRects(std::vector<RectT<long>>* outRects) const {
  mSurface->GetOutputClipRects(outRects);
}
void BasicSurfaceReferenceInterface::Clip(PathInterface const& inPath, FillType inFill) {
  mSurface->Clip(inPath, inFill);
}
RectT<long> BasicSurfaceReferenceInterface::GetClipBounds() { return mSurface->GetClipBounds(); }
RectT<long> BasicSurfaceReferenceInterface::GetMinimumClipBounds(RectT<long> const& inRect) {
  return mSurface->GetMinimumClipBounds(inRect);
}
RectT<long> BasicSurfaceReferenceInterface::GetMinimumHorizontalClipBounds(RectT<long> const& inRect) {
  return mSurface->GetMinimumHorizontalClipBounds(inRect);
}
RectT<long> BasicSurfaceReferenceInterface::GetMinimumVerticalClipBounds(RectT<long> const& inRect) {
  return mSurface->GetMinimumVerticalClipBounds(inRect);
}
bool BasicSurfaceReferenceInterface::IsWithinClipBounds(RectT<long> const& inRect) const {
  return mSurface->IsWithinClipBounds(inRect);
}
void BasicSurfaceReferenceInterface::Transform(MatrixT<float> const& inMatrix) { mSurface->Transform(inMatrix); }
void BasicSurfaceReferenceInterface::GetTransform(MatrixT<float>* outMatrix) const {
  mSurface->GetTransform(outMatrix);
}
void BasicSurfaceReferenceInterface::DrawString(BrushInterface const& inBrush, FontInterface const& inFont,
                                                unsigned short const* inText, PointT<float> const& inPoint,
                                                TextAlignment inAlignment, TextTruncation inTruncation,
                                                float inMaxWidth) {
  mSurface->DrawString(inBrush, inFont, inText, inPoint, inAlignment, inTruncation, inMaxWidth);
}
void BasicSurfaceReferenceInterface::DrawMultiLineString(BrushInterface const& inBrush, FontInterface const& inFont,
                                                         unsigned short const* inText, RectT<float> const& inRect,
                                                         TextAlignment inAlignment) {
  mSurface->DrawMultiLineString(inBrush, inFont, inText, inRect, inAlignment);
}
void BasicSurfaceReferenceInterface::DrawStringWithUnderline(BrushInterface const& inBrush,
                                                             FontInterface const& inFont, PenInterface const& inPen,
                                                             unsigned short const* inText,
                                                             PointT<float> const& inPoint, TextAlignment inAlignment,
                                                             TextTruncation inTruncation, float inMaxWidth,
                                                             long inFirst, long inLast) {
  mSurface->DrawStringWithUnderline(inBrush, inFont, inPen, inText, inPoint, inAlignment, inTruncation, inMaxWidth,
                                    inFirst, inLast);
}
float BasicSurfaceReferenceInterface::MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText,
                                                         long inLength) {
  return mSurface->MeasureStringWidth(inFont, inText, inLength);
}
float BasicSurfaceReferenceInterface::MeasureMultiLineStringHeight(FontInterface const& inFont,
                                                                   unsigned short const* inText, float inWidth,
                                                                   long inLength) {
  return mSurface->MeasureMultiLineStringHeight(inFont, inText, inWidth, inLength);
}
float BasicSurfaceReferenceInterface::MeasureMaximumMultiLineStringWidth(FontInterface const& inFont,
                                                                         UTF16String const& inText) {
  return mSurface->MeasureMaximumMultiLineStringWidth(inFont, inText);
}
void BasicSurfaceReferenceInterface::DrawImage(SupplierInterface const& inSupplier, ImageInterface const& inImage,
                                               RectT<float> const& inDest, RectT<float> const* inSource,
                                               float inOpacity) {
  mSurface->DrawImage(inSupplier, inImage, inDest, inSource, inOpacity);
}
void BasicSurfaceReferenceInterface::DrawImage(ImageInterface const& inImage, PointT<float> const& inPoint,
                                               float inOpacity) {
  mSurface->DrawImage(inImage, inPoint, inOpacity);
}
void BasicSurfaceReferenceInterface::DrawCache(CacheInterface const& inCache) { mSurface->DrawCache(inCache); }
boost::intrusive_ptr<ImageInterface> BasicSurfaceReferenceInterface::GetSurfaceImage() {
  return mSurface->GetSurfaceImage();
}
void BasicSurfaceReferenceInterface::SetInterpolationPolicy(InterpolationPolicy inPolicy) {
  mSurface->SetInterpolationPolicy(inPolicy);
}
InterpolationPolicy BasicSurfaceReferenceInterface::GetInterpolationPolicy() {
  return mSurface->GetInterpolationPolicy();
}
void BasicSurfaceReferenceInterface::SetAntiAliasPolicy(AntiAliasPolicy inPolicy) {
  mSurface->SetAntiAliasPolicy(inPolicy);
}
AntiAliasPolicy BasicSurfaceReferenceInterface::GetAntiAliasPolicy() { return mSurface->GetAntiAliasPolicy(); }
void BasicSurfaceReferenceInterface::SetTextDisplayPolicy(TextDisplayPolicy inPolicy) {
  mSurface->SetTextDisplayPolicy(inPolicy);
}
TextDisplayPolicy BasicSurfaceReferenceInterface::GetTextDisplayPolicy() {
  return mSurface->GetTextDisplayPolicy();
}
void BasicSurfaceReferenceInterface::Flush() { mSurface->Flush(); }
void BasicSurfaceReferenceInterface::DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                                                    unsigned short const* inText, PointT<float> const& inPoint,
                                                    TextAlignment inAlignment) {
  mSurface->DrawStringImpl(inBrush, inFont, inText, inPoint, inAlignment);
}
void BasicSurfaceReferenceInterface::DrawMultiLineStringImpl(BrushInterface const& inBrush,
                                                             FontInterface const& inFont,
                                                             unsigned short const* inText,
                                                             RectT<float> const& inRect, TextAlignment inAlignment) {
  mSurface->DrawMultiLineStringImpl(inBrush, inFont, inText, inRect, inAlignment);
}

}  // namespace norvik::drawbot
