#pragma once
// The factory of drawing objects. A supplier makes surfaces and the resources
// that draw on them; a resource is valid only with surfaces of its own supplier.
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/DrawbotTypes.h"
#include "drawbot/ResourceInterfaces.h"

namespace norvik::drawbot {

class SurfaceInterface;

// The platform's drawing target and clip region, as the native-window code
// hands them over. The image back end takes a cairo_surface_t* and a
// cairo_region_t*; portable code only passes them through.
using NativeDrawTarget = void*;
using NativeRegion = void*;

class SupplierInterface : public tarsel::utility::RefCountedObject {
 public:
  // A surface drawing onto a platform target, clipped to inRegion when given.
  // With inBuffered the drawing goes to memory first and Flush copies it out
  // (for image targets; other targets are drawn on directly).
  virtual SurfaceInterface* NewSurface(NativeDrawTarget inTarget, NativeRegion inRegion, bool inBuffered) const = 0;
  // A surface over another surface's state, restricted to inRect when given.
  virtual SurfaceInterface* NewReferenceSurface(SurfaceInterface* inSurface, bool inFlag,
                                                tarsel::geom::RectT<long> const* inRect) const = 0;
  // A memory surface of 32-bit premultiplied pixels.
  virtual SurfaceInterface* NewOffscreenSurface(unsigned long inWidth, unsigned long inHeight, bool inFlag) const = 0;
  // A surface over the caller's pixels; the deleter keeps them alive.
  virtual SurfaceInterface* NewBufferSurface(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                             PixelLayout inLayout, void* inData,
                                             boost::intrusive_ptr<DataDeleter> inDeleter) const = 0;
  virtual PenInterface* NewPen(ColorRGBA const& inColor, float inWidth) const = 0;
  virtual BrushInterface* NewBrush(ColorRGBA const& inColor) const = 0;
  virtual bool SupportsLinearShader() const { return GetShadersEnabled(); }
  virtual LinearShaderInterface* NewLinearShader(tarsel::geom::PointT<float> const& inStart,
                                                 tarsel::geom::PointT<float> const& inEnd, ColorRGBA const* inColors,
                                                 float const* inPositions, unsigned long inCount) const = 0;
  virtual bool SupportsRadialShader() const { return GetShadersEnabled(); }
  // inRadii holds the horizontal and the vertical radius; the colours run from
  // the focus (position 0) to the rim (position 1).
  virtual RadialShaderInterface* NewRadialShader(tarsel::geom::PointT<float> const& inCentre, float const* inRadii,
                                                 tarsel::geom::PointT<float> const& inFocus,
                                                 ColorRGBA const* inColors, float const* inPositions,
                                                 unsigned long inCount) const = 0;
  virtual bool SupportsFonts() const { return true; }
  // Family and style are zero-terminated UTF-16; the size is in pixels.
  virtual FontInterface* NewFont(unsigned short const* inFamily, unsigned short const* inStyle,
                                 float inSize) const = 0;
  // Decodes an encoded image held in memory (inSize bytes at inData), or, when
  // inSize is 0, read from the file whose zero-terminated UTF-8 path is inData.
  virtual ImageInterface* NewFileImage(ImageFileType inType, void const* inData, unsigned long inSize) const = 0;
  virtual ImageInterface* NewBufferImage(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                         PixelLayout inLayout, void* inData,
                                         boost::intrusive_ptr<DataDeleter> inDeleter) const = 0;
  virtual PathInterface* NewPath() const = 0;
  virtual bool PrefersToCacheAggressively() const { return false; }
  virtual bool SupportsPixelLayoutBGRA() const { return false; }
  virtual bool PrefersPixelLayoutBGRA() const { return false; }
  virtual bool SupportsPixelLayoutARGB() const { return false; }
  virtual bool PrefersPixelLayoutARGB() const { return false; }

  // Two colours, at 0 and 1.
  LinearShaderInterface* NewLinearShader(tarsel::geom::PointT<float> const& inStart,
                                         tarsel::geom::PointT<float> const& inEnd, ColorRGBA const& inFirst,
                                         ColorRGBA const& inLast) const;
  // Stops as (position, colour); missing stops at 0 and 1 repeat their neighbour.
  LinearShaderInterface* NewLinearShader(tarsel::geom::PointT<float> const& inStart,
                                         tarsel::geom::PointT<float> const& inEnd,
                                         std::vector<std::pair<float, ColorRGBA>> const& inStops) const;

  bool GetShadersEnabled() const { return mShadersEnabled; }
  void SetShadersEnabled(bool inEnabled) { mShadersEnabled = inEnabled; }
  // A supplier whose output is resampled after drawing (a scaled display, a
  // print raster) needs smoothing even for images drawn at their natural size,
  // which then keep the surface's anti-aliasing instead of being snapped.
  bool GetSmoothingNeeded() const { return mSmoothingNeeded; }
  void SetSmoothingNeeded(bool inNeeded) { mSmoothingNeeded = inNeeded; }

 private:
  bool mShadersEnabled = true;
  bool mSmoothingNeeded = false;
};

using SupplierInterfaceP = boost::intrusive_ptr<SupplierInterface>;

// The supplier of the platform back end, one per process.
SupplierInterface* NewOSSupplier();

}  // namespace norvik::drawbot
