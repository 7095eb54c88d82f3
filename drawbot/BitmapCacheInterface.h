#pragma once
// The pixels of one node, drawn into an off-screen surface of its supplier.
// The cache remembers the rectangle, transform, policies and kind of supplier
// that it was drawn under; IsValid compares them with a surface's present
// state. Translations compare by their fractional parts only, so a cache
// survives whole-pixel scrolling and is redrawn after a fractional move.
#include <memory>
#include <typeindex>

#include "drawbot/CacheInterface.h"
#include "drawbot/SurfaceInterface.h"

namespace norvik::drawbot {

class BitmapCacheInterface : public CacheInterface {
 public:
  // Captures inSource's state and, when inRect covers at least one pixel on
  // screen, makes the surface to draw into.
  BitmapCacheInterface(SurfaceInterface* inSource, tarsel::geom::RectT<float> const& inRect);
  ~BitmapCacheInterface() override;

  SurfaceInterface* GetSurface() const override { return mSurface.get(); }
  bool IsValid(SurfaceInterface const& inSurface, tarsel::geom::RectT<float> const& inRect) const override;

  tarsel::geom::RectT<float> const& GetRect() const { return mRect; }
  tarsel::geom::RectT<long> const& GetSurfaceDestRect() const { return mDestRect; }
  // The cache surface's transform: the source's, then the move to the cache's origin.
  tarsel::geom::MatrixT<float> const& GetSurfaceTransform() const { return mTransform; }
  AntiAliasPolicy GetAntiAliasPolicy() const { return mAntiAlias; }
  InterpolationPolicy GetInterpolationPolicy() const { return mInterpolation; }

 private:
  boost::intrusive_ptr<SurfaceInterface> mSurface;
  std::unique_ptr<ScSurfaceState> mFillState;
  tarsel::geom::RectT<float> mRect;
  tarsel::geom::RectT<long> mDestRect;
  tarsel::geom::MatrixT<float> mTransform;
  tarsel::geom::MatrixT<float> mSourceTransform;
  std::type_index mSupplierType;
  AntiAliasPolicy mAntiAlias;
  InterpolationPolicy mInterpolation;
};

}  // namespace norvik::drawbot
