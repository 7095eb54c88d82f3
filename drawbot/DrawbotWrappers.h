#pragma once
// Value wrappers that view code holds instead of raw interfaces. Each is built
// from a supplier and the factory's arguments; with a null supplier it stays
// empty and raises nothing, which is how code that only measures goes on
// without a surface.
#include <memory>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"

namespace norvik::drawbot {

template <typename T>
class SharedPImpl {
 public:
  SharedPImpl() = default;
  explicit SharedPImpl(T* inObject) : mObject(inObject) {}
  explicit SharedPImpl(boost::intrusive_ptr<T> inObject) : mObject(std::move(inObject)) {}
  virtual ~SharedPImpl() = default;
  SharedPImpl(const SharedPImpl&) = default;
  SharedPImpl& operator=(const SharedPImpl&) = default;

  T* Get() const { return mObject.get(); }
  T* operator->() const { return mObject.get(); }
  T& operator*() const { return *mObject; }
  explicit operator bool() const { return mObject != nullptr; }
  bool IsNull() const { return mObject == nullptr; }
  boost::intrusive_ptr<T> const& GetPtr() const { return mObject; }
  void Reset(T* inObject = nullptr) { mObject.reset(inObject); }

 protected:
  boost::intrusive_ptr<T> mObject;
};

template <typename T>
class PImpl {
 public:
  PImpl() = default;
  explicit PImpl(T* inObject) : mObject(inObject) {}
  virtual ~PImpl() = default;
  PImpl(const PImpl&) = delete;
  PImpl& operator=(const PImpl&) = delete;

  T* Get() const { return mObject.get(); }
  T* operator->() const { return mObject.get(); }
  T& operator*() const { return *mObject; }
  explicit operator bool() const { return mObject != nullptr; }
  bool IsNull() const { return mObject == nullptr; }

 protected:
  boost::intrusive_ptr<T> mObject;
};

class PenP : public SharedPImpl<PenInterface> {
 public:
  PenP() = default;
  PenP(SupplierInterface const* inSupplier, ColorRGBA const& inColor, float inWidth)
      : SharedPImpl(inSupplier ? inSupplier->NewPen(inColor, inWidth) : nullptr) {}
};

class BrushP : public SharedPImpl<BrushInterface> {
 public:
  BrushP() = default;
  BrushP(SupplierInterface const* inSupplier, ColorRGBA const& inColor)
      : SharedPImpl(inSupplier ? inSupplier->NewBrush(inColor) : nullptr) {}
};

class LinearShaderP : public SharedPImpl<LinearShaderInterface> {
 public:
  LinearShaderP() = default;
  LinearShaderP(SupplierInterface const* inSupplier, tarsel::geom::PointT<float> const& inStart,
                tarsel::geom::PointT<float> const& inEnd, ColorRGBA const& inFirst, ColorRGBA const& inLast)
      : SharedPImpl(inSupplier ? inSupplier->NewLinearShader(inStart, inEnd, inFirst, inLast) : nullptr) {}
  LinearShaderP(SupplierInterface const* inSupplier, tarsel::geom::PointT<float> const& inStart,
                tarsel::geom::PointT<float> const& inEnd, std::vector<std::pair<float, ColorRGBA>> const& inStops)
      : SharedPImpl(inSupplier ? inSupplier->NewLinearShader(inStart, inEnd, inStops) : nullptr) {}
};

class RadialShaderP : public SharedPImpl<RadialShaderInterface> {
 public:
  RadialShaderP() = default;
  RadialShaderP(SupplierInterface const* inSupplier, tarsel::geom::PointT<float> const& inCentre, float const* inRadii,
                tarsel::geom::PointT<float> const& inFocus, ColorRGBA const* inColors, float const* inPositions,
                unsigned long inCount)
      : SharedPImpl(inSupplier ? inSupplier->NewRadialShader(inCentre, inRadii, inFocus, inColors, inPositions, inCount)
                               : nullptr) {}
};

class PathP : public SharedPImpl<PathInterface> {
 public:
  PathP() = default;
  explicit PathP(SupplierInterface const* inSupplier) : SharedPImpl(inSupplier ? inSupplier->NewPath() : nullptr) {}
};

class FontP : public SharedPImpl<FontInterface> {
 public:
  FontP() = default;
  FontP(SupplierInterface const* inSupplier, unsigned short const* inFamily, unsigned short const* inStyle,
        float inSize)
      : SharedPImpl(inSupplier ? inSupplier->NewFont(inFamily, inStyle, inSize) : nullptr) {}
  FontP(SupplierInterface const* inSupplier, UTF16String const& inFamily, UTF16String const& inStyle, float inSize)
      : FontP(inSupplier, reinterpret_cast<unsigned short const*>(inFamily.c_str()),
              reinterpret_cast<unsigned short const*>(inStyle.c_str()), inSize) {}
};

class ImageP : public SharedPImpl<ImageInterface> {
 public:
  ImageP() = default;
  explicit ImageP(ImageInterface* inImage) : SharedPImpl(inImage) {}
  explicit ImageP(boost::intrusive_ptr<ImageInterface> inImage) : SharedPImpl(std::move(inImage)) {}
};

class FileImageP : public ImageP {
 public:
  FileImageP() = default;
  FileImageP(SupplierInterface const* inSupplier, ImageFileType inType, void const* inData, unsigned long inSize)
      : ImageP(inSupplier ? inSupplier->NewFileImage(inType, inData, inSize) : nullptr) {}
};

class BufferImageP : public ImageP {
 public:
  BufferImageP() = default;
  BufferImageP(SupplierInterface const* inSupplier, unsigned long inWidth, unsigned long inHeight, long inRowBytes,
               PixelLayout inLayout, void* inData, boost::intrusive_ptr<DataDeleter> inDeleter)
      : ImageP(inSupplier ? inSupplier->NewBufferImage(inWidth, inHeight, inRowBytes, inLayout, inData,
                                                       std::move(inDeleter))
                          : nullptr) {}
};

class SurfaceP : public SharedPImpl<SurfaceInterface> {
 public:
  SurfaceP() = default;
  explicit SurfaceP(SurfaceInterface* inSurface) : SharedPImpl(inSurface) {}
  // An off-screen surface.
  SurfaceP(SupplierInterface const* inSupplier, unsigned long inWidth, unsigned long inHeight, bool inFlag = false)
      : SharedPImpl(inSupplier ? inSupplier->NewOffscreenSurface(inWidth, inHeight, inFlag) : nullptr) {}
};

// The surface of one native paint.
class OSSurfaceP : public PImpl<SurfaceInterface> {
 public:
  OSSurfaceP(SupplierInterface const* inSupplier, NativeDrawTarget inTarget, NativeRegion inRegion,
             bool inBuffered = false)
      : PImpl(inSupplier ? inSupplier->NewSurface(inTarget, inRegion, inBuffered) : nullptr) {}
  static std::unique_ptr<OSSurfaceP> New(SupplierInterface const* inSupplier, NativeDrawTarget inTarget,
                                         NativeRegion inRegion) {
    return std::make_unique<OSSurfaceP>(inSupplier, inTarget, inRegion);
  }
};

}  // namespace norvik::drawbot
