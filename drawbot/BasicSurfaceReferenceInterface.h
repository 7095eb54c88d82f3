#pragma once
// A surface that forwards every operation to another surface, holding a
// reference to it. Back ends and tests derive from it to watch or restrict
// what reaches the inner surface.
#include "drawbot/SurfaceInterface.h"

namespace norvik::drawbot {

class BasicSurfaceReferenceInterface : public SurfaceInterface {
 public:
  // inRect, when given, is the part of the inner surface this one stands for,
  // in the inner surface's current user space (see ClipToReferenceSurface).
  // The buffering wish is the back end's to honour; forwarding ignores it.
  BasicSurfaceReferenceInterface(SupplierInterface const* inSupplier, SurfaceInterface* inSurface, bool inBuffered,
                                 tarsel::geom::RectT<long> const* inRect);

  // Clips the inner surface to the reference rectangle, winding fill.
  void ClipToReferenceSurface(SupplierInterface const* inSupplier);
  SurfaceInterface* GetReferencedSurface() const { return mSurface.get(); }

  void PushStateStack() override;
  void PopStateStack() override;
  boost::intrusive_ptr<CacheInterface> PushCacheStack(tarsel::geom::RectT<float> const& inRect) override;
  void PopCacheStack(boost::intrusive_ptr<CacheInterface> inCache) override;
  void PaintRect(ColorRGBA const& inColor, tarsel::geom::RectT<float> const& inRect) override;
  void FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType inFill) override;
  void StrokePath(PenInterface const& inPen, PathInterface const& inPath) override;
  void ShadePath(ShaderInterface const& inShader, PathInterface const& inPath, FillType inFill) override;
  SupplierInterface const* GetOutputSupplier() const override;
  SurfaceInterface* GetOutputSurface() override;
  SurfaceInterface const* GetOutputSurface() const override;
  void GetOutputTransform(tarsel::geom::MatrixT<float>* outMatrix) const override;
  void GetOutputClipRects(std::vector<tarsel::geom::RectT<long>>* outRects) const override;
  void Clip(PathInterface const& inPath, FillType inFill) override;
  tarsel::geom::RectT<long> GetClipBounds() override;
  tarsel::geom::RectT<long> GetMinimumClipBounds(tarsel::geom::RectT<long> const& inRect) override;
  tarsel::geom::RectT<long> GetMinimumHorizontalClipBounds(tarsel::geom::RectT<long> const& inRect) override;
  tarsel::geom::RectT<long> GetMinimumVerticalClipBounds(tarsel::geom::RectT<long> const& inRect) override;
  bool IsWithinClipBounds(tarsel::geom::RectT<long> const& inRect) const override;
  void Transform(tarsel::geom::MatrixT<float> const& inMatrix) override;
  void GetTransform(tarsel::geom::MatrixT<float>* outMatrix) const override;
  void DrawString(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                  tarsel::geom::PointT<float> const& inPoint, TextAlignment inAlignment, TextTruncation inTruncation,
                  float inMaxWidth) override;
  void DrawMultiLineString(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                           tarsel::geom::RectT<float> const& inRect, TextAlignment inAlignment) override;
  void DrawStringWithUnderline(BrushInterface const& inBrush, FontInterface const& inFont, PenInterface const& inPen,
                               unsigned short const* inText, tarsel::geom::PointT<float> const& inPoint,
                               TextAlignment inAlignment, TextTruncation inTruncation, float inMaxWidth,
                               long inFirst, long inLast) override;
  float MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText, long inLength) override;
  float MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText, float inWidth,
                                     long inLength) override;
  float MeasureMaximumMultiLineStringWidth(FontInterface const& inFont, UTF16String const& inText) override;
  void DrawImage(SupplierInterface const& inSupplier, ImageInterface const& inImage,
                 tarsel::geom::RectT<float> const& inDest, tarsel::geom::RectT<float> const* inSource,
                 float inOpacity) override;
  void DrawImage(ImageInterface const& inImage, tarsel::geom::PointT<float> const& inPoint,
                 float inOpacity) override;
  void DrawCache(CacheInterface const& inCache) override;
  boost::intrusive_ptr<ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(InterpolationPolicy inPolicy) override;
  InterpolationPolicy GetInterpolationPolicy() override;
  void SetAntiAliasPolicy(AntiAliasPolicy inPolicy) override;
  AntiAliasPolicy GetAntiAliasPolicy() override;
  void SetTextDisplayPolicy(TextDisplayPolicy inPolicy) override;
  TextDisplayPolicy GetTextDisplayPolicy() override;
  void Flush() override;

 protected:
  void DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                      tarsel::geom::PointT<float> const& inPoint, TextAlignment inAlignment) override;
  void DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                               unsigned short const* inText, tarsel::geom::RectT<float> const& inRect,
                               TextAlignment inAlignment) override;

 private:
  boost::intrusive_ptr<SurfaceInterface> mSurface;
  bool mHasRect;
  tarsel::geom::RectT<long> mRect;
};

}  // namespace norvik::drawbot
