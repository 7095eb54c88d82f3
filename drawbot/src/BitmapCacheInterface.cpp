#include "drawbot/BitmapCacheInterface.h"

#include <cmath>
#include <typeinfo>

#include "drawbot/SupplierInterface.h"

namespace norvik::drawbot {

using tarsel::geom::MatrixT;
using tarsel::geom::RectT;

namespace {

std::type_index SupplierType(SurfaceInterface const& inSurface) {
  SupplierInterface const* supplier = inSurface.GetSupplier();
  return supplier ? std::type_index(typeid(*supplier)) : std::type_index(typeid(void));
}

float Fraction(float inValue) { return inValue - std::floor(inValue); }

}  // namespace

BitmapCacheInterface::BitmapCacheInterface(SurfaceInterface* inSource, RectT<float> const& inRect)
    : mRect(inRect),
      mSupplierType(SupplierType(*inSource)),
      mAntiAlias(inSource->GetAntiAliasPolicy()),
      mInterpolation(inSource->GetInterpolationPolicy()) {
  inSource->GetTransform(&mTransform);
  mSourceTransform = mTransform;
  RectT<float> onScreen = mTransform.TransformBounds(inRect);
  long left = static_cast<long>(std::floor(onScreen.left));
  long top = static_cast<long>(std::floor(onScreen.top));
  long right = static_cast<long>(std::ceil(onScreen.Right()));
  long bottom = static_cast<long>(std::ceil(onScreen.Bottom()));
  mDestRect = RectT<long>::FromEdges(left, top, right, bottom);
  if (inRect.IsEmpty() || mDestRect.width <= 0 || mDestRect.height <= 0) return;
  SupplierInterface const* supplier = inSource->GetSupplier();
  if (supplier == nullptr) return;

  mSurface = supplier->NewOffscreenSurface(static_cast<unsigned long>(mDestRect.width),
                                           static_cast<unsigned long>(mDestRect.height), false);
  if (!mSurface) return;
  mSurface->SetAntiAliasPolicy(mAntiAlias);
  mSurface->SetInterpolationPolicy(mInterpolation);
  MatrixT<float> toOrigin = MatrixT<float>::Translation(static_cast<float>(-mDestRect.left),
                                                        static_cast<float>(-mDestRect.top));
  mTransform = toOrigin.Concat(mTransform);
  mSurface->Transform(mTransform);
  mFillState = std::make_unique<ScSurfaceState>(mSurface.get());
}

BitmapCacheInterface::~BitmapCacheInterface() { mFillState.reset(); }

bool BitmapCacheInterface::IsValid(SurfaceInterface const& inSurface, RectT<float> const& inRect) const {
  if (SupplierType(inSurface) != mSupplierType) return false;
  if (!(inRect == mRect)) return false;

  MatrixT<float> current;
  inSurface.GetTransform(&current);
  // The stored transform without the move to the cache's origin, kept as
  // captured so that float round-off cannot tell two equal transforms apart.
  MatrixT<float> const& captured = mSourceTransform;
  if (current.a != captured.a || current.b != captured.b || current.c != captured.c || current.d != captured.d)
    return false;
  if (Fraction(current.tx) != Fraction(captured.tx) || Fraction(current.ty) != Fraction(captured.ty)) return false;

  auto& surface = const_cast<SurfaceInterface&>(inSurface);
  return surface.GetAntiAliasPolicy() == mAntiAlias && surface.GetInterpolationPolicy() == mInterpolation;
}

}  // namespace norvik::drawbot
