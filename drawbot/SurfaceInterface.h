#pragma once
// The drawing target. A surface has a stack of state records (clip, transform
// and the three policies); PushStateStack saves them and PopStateStack puts them
// back, never below the base record. A fresh surface has anti-aliasing off,
// nearest-neighbour interpolation, grid-fitted text, the identity transform and
// its full bounds as clip.
//
// The operations with a body here are built once on the back end's primitives:
// truncated and underlined text, image scaling, caches and the clip bisection.
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/CacheInterface.h"
#include "drawbot/DrawbotTypes.h"
#include "drawbot/ResourceInterfaces.h"
#include "tarsel/MatrixT.h"
#include "tarsel/UTFString.h"

namespace norvik::drawbot {

class SupplierInterface;

class SurfaceInterface : public tarsel::utility::RefCountedObject {
 public:
  explicit SurfaceInterface(SupplierInterface const* inSupplier) : mSupplier(inSupplier) {}

  virtual void PushStateStack() = 0;
  virtual void PopStateStack() = 0;
  // Starts filling a cache of inRect (user space): the caller draws into the
  // cache's surface until PopCacheStack. Null when inRect is empty on screen.
  virtual boost::intrusive_ptr<CacheInterface> PushCacheStack(tarsel::geom::RectT<float> const& inRect);
  virtual void PopCacheStack(boost::intrusive_ptr<CacheInterface> inCache);
  virtual void PaintRect(ColorRGBA const& inColor, tarsel::geom::RectT<float> const& inRect) = 0;
  virtual void FillPath(BrushInterface const& inBrush, PathInterface const& inPath, FillType inFill) = 0;
  virtual void StrokePath(PenInterface const& inPen, PathInterface const& inPath) = 0;
  virtual void ShadePath(ShaderInterface const& inShader, PathInterface const& inPath, FillType inFill) = 0;
  virtual SupplierInterface const* GetSupplier() const { return mSupplier; }
  virtual SupplierInterface const* GetOutputSupplier() const { return GetSupplier(); }
  virtual SurfaceInterface* GetOutputSurface() { return this; }
  virtual SurfaceInterface const* GetOutputSurface() const { return this; }
  virtual void GetOutputTransform(tarsel::geom::MatrixT<float>* outMatrix) const {
    *outMatrix = tarsel::geom::MatrixT<float>();
  }
  virtual void GetOutputClipRects(std::vector<tarsel::geom::RectT<long>>* outRects) const = 0;
  // Intersects the current clip with the path.
  virtual void Clip(PathInterface const& inPath, FillType inFill) = 0;
  virtual tarsel::geom::RectT<long> GetClipBounds() = 0;
  virtual tarsel::geom::RectT<long> GetMinimumClipBounds(tarsel::geom::RectT<long> const& inRect);
  virtual tarsel::geom::RectT<long> GetMinimumHorizontalClipBounds(tarsel::geom::RectT<long> const& inRect);
  virtual tarsel::geom::RectT<long> GetMinimumVerticalClipBounds(tarsel::geom::RectT<long> const& inRect);
  virtual bool IsWithinClipBounds(tarsel::geom::RectT<long> const& inRect) const;
  // Multiplies inMatrix onto the current transform, in front of it: inMatrix
  // applies to points first.
  virtual void Transform(tarsel::geom::MatrixT<float> const& inMatrix) = 0;
  virtual void GetTransform(tarsel::geom::MatrixT<float>* outMatrix) const = 0;
  // inPoint is on the baseline, at its left end, middle or right end.
  virtual void DrawString(BrushInterface const& inBrush, FontInterface const& inFont, unsigned short const* inText,
                          tarsel::geom::PointT<float> const& inPoint, TextAlignment inAlignment,
                          TextTruncation inTruncation, float inMaxWidth);
  virtual void DrawMultiLineString(BrushInterface const& inBrush, FontInterface const& inFont,
                                   unsigned short const* inText, tarsel::geom::RectT<float> const& inRect,
                                   TextAlignment inAlignment);
  // Draws inText with the characters inFirst to inLast underlined (mnemonics).
  virtual void DrawStringWithUnderline(BrushInterface const& inBrush, FontInterface const& inFont,
                                       PenInterface const& inPen, unsigned short const* inText,
                                       tarsel::geom::PointT<float> const& inPoint, TextAlignment inAlignment,
                                       TextTruncation inTruncation, float inMaxWidth, long inFirst, long inLast);
  virtual float MeasureStringWidth(FontInterface const& inFont, unsigned short const* inText, long inLength) = 0;
  virtual float MeasureMultiLineStringHeight(FontInterface const& inFont, unsigned short const* inText,
                                             float inWidth, long inLength) = 0;
  virtual float MeasureMaximumMultiLineStringWidth(FontInterface const& inFont, UTF16String const& inText);
  // Scales the image (or its inSource part) into inDest.
  virtual void DrawImage(SupplierInterface const& inSupplier, ImageInterface const& inImage,
                         tarsel::geom::RectT<float> const& inDest, tarsel::geom::RectT<float> const* inSource,
                         float inOpacity);
  // The image at its natural size with its top left at inPoint.
  virtual void DrawImage(ImageInterface const& inImage, tarsel::geom::PointT<float> const& inPoint,
                         float inOpacity) = 0;
  virtual void DrawCache(CacheInterface const& inCache);
  virtual boost::intrusive_ptr<ImageInterface> GetSurfaceImage() = 0;
  virtual void SetInterpolationPolicy(InterpolationPolicy inPolicy) = 0;
  virtual InterpolationPolicy GetInterpolationPolicy() = 0;
  virtual void SetAntiAliasPolicy(AntiAliasPolicy inPolicy) = 0;
  virtual AntiAliasPolicy GetAntiAliasPolicy() = 0;
  virtual void SetTextDisplayPolicy(TextDisplayPolicy inPolicy) = 0;
  virtual TextDisplayPolicy GetTextDisplayPolicy() = 0;
  // Delivers all drawing to the output.
  virtual void Flush() = 0;

 protected:
  virtual void DrawStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                              unsigned short const* inText, tarsel::geom::PointT<float> const& inPoint,
                              TextAlignment inAlignment) = 0;
  virtual void DrawMultiLineStringImpl(BrushInterface const& inBrush, FontInterface const& inFont,
                                       unsigned short const* inText, tarsel::geom::RectT<float> const& inRect,
                                       TextAlignment inAlignment) = 0;

  SupplierInterface const* mSupplier;

  friend class BasicSurfaceReferenceInterface;
};

using SurfaceInterfaceP = boost::intrusive_ptr<SurfaceInterface>;

// Keeps the state of a surface pushed for as long as it lives.
class ScSurfaceState {
 public:
  explicit ScSurfaceState(SurfaceInterface* inSurface) : mSurface(inSurface) {
    if (mSurface) mSurface->PushStateStack();
  }
  ~ScSurfaceState() {
    if (mSurface) mSurface->PopStateStack();
  }
  ScSurfaceState(const ScSurfaceState&) = delete;
  ScSurfaceState& operator=(const ScSurfaceState&) = delete;

 private:
  SurfaceInterface* mSurface;
};

}  // namespace norvik::drawbot
