#pragma once
// Translation and scale pair: maps a point p to (p * scale + translation).
// This is the node-to-parent transform of the view tree.
#include "tarsel/PointT.h"
#include "tarsel/RectT.h"

namespace tarsel::geom {

template <typename T>
struct ScaleMatrixT {
  T sx{1};
  T sy{1};
  T tx{0};
  T ty{0};

  constexpr ScaleMatrixT() = default;
  constexpr ScaleMatrixT(T inSx, T inSy, T inTx, T inTy) : sx(inSx), sy(inSy), tx(inTx), ty(inTy) {}

  static constexpr ScaleMatrixT Translation(T inTx, T inTy) { return ScaleMatrixT(1, 1, inTx, inTy); }
  static constexpr ScaleMatrixT Scale(T inSx, T inSy) { return ScaleMatrixT(inSx, inSy, 0, 0); }

  constexpr bool IsIdentity() const { return sx == 1 && sy == 1 && tx == 0 && ty == 0; }
  constexpr bool IsTranslationOnly() const { return sx == 1 && sy == 1; }
  constexpr bool IsInvertible() const { return sx != 0 && sy != 0; }

  constexpr PointT<T> Transform(const PointT<T>& p) const { return {p.x * sx + tx, p.y * sy + ty}; }
  RectT<T> Transform(const RectT<T>& r) const {
    PointT<T> a = Transform(r.Origin());
    PointT<T> b = Transform(PointT<T>(r.Right(), r.Bottom()));
    T l = a.x < b.x ? a.x : b.x, t = a.y < b.y ? a.y : b.y;
    T w = a.x < b.x ? b.x - a.x : a.x - b.x, h = a.y < b.y ? b.y - a.y : a.y - b.y;
    return RectT<T>(l, t, w, h);
  }

  // this after inFirst: Transform(p) == this->Transform(inFirst.Transform(p)).
  constexpr ScaleMatrixT Concat(const ScaleMatrixT& inFirst) const {
    return ScaleMatrixT(sx * inFirst.sx, sy * inFirst.sy, inFirst.tx * sx + tx, inFirst.ty * sy + ty);
  }

  // The inverse; the identity when the scale is zero (check IsInvertible first).
  constexpr ScaleMatrixT Inverse() const {
    if (!IsInvertible()) return ScaleMatrixT();
    return ScaleMatrixT(1 / sx, 1 / sy, -tx / sx, -ty / sy);
  }

  constexpr bool operator==(const ScaleMatrixT& o) const {
    return sx == o.sx && sy == o.sy && tx == o.tx && ty == o.ty;
  }
  constexpr bool operator!=(const ScaleMatrixT& o) const { return !(*this == o); }
};

using ScaleMatrixF = ScaleMatrixT<float>;

}  // namespace tarsel::geom
