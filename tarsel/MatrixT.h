#pragma once
// A general 2D affine transform, the top two rows of a 3 by 3 matrix:
//   x' = a*x + c*y + tx,   y' = b*x + d*y + ty.
#include <cmath>

#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/ScaleMatrixT.h"

namespace tarsel::geom {

template <typename T>
struct MatrixT {
  T a{1}, b{0}, c{0}, d{1}, tx{0}, ty{0};

  constexpr MatrixT() = default;
  constexpr MatrixT(T inA, T inB, T inC, T inD, T inTx, T inTy)
      : a(inA), b(inB), c(inC), d(inD), tx(inTx), ty(inTy) {}
  constexpr explicit MatrixT(const ScaleMatrixT<T>& s) : a(s.sx), b(0), c(0), d(s.sy), tx(s.tx), ty(s.ty) {}

  static constexpr MatrixT Translation(T x, T y) { return MatrixT(1, 0, 0, 1, x, y); }
  static constexpr MatrixT Scale(T x, T y) { return MatrixT(x, 0, 0, y, 0, 0); }
  static MatrixT Rotation(T radians) {
    T co = std::cos(radians), si = std::sin(radians);
    return MatrixT(co, si, -si, co, 0, 0);
  }

  constexpr bool IsIdentity() const { return a == 1 && b == 0 && c == 0 && d == 1 && tx == 0 && ty == 0; }
  constexpr bool IsScaleAndTranslation() const { return b == 0 && c == 0; }
  constexpr T Determinant() const { return a * d - b * c; }

  constexpr PointT<T> Transform(const PointT<T>& p) const {
    return {a * p.x + c * p.y + tx, b * p.x + d * p.y + ty};
  }
  // The bounding box of the transformed corners.
  RectT<T> TransformBounds(const RectT<T>& r) const;

  // this after inFirst: Transform(p) == this->Transform(inFirst.Transform(p)).
  constexpr MatrixT Concat(const MatrixT& f) const {
    return MatrixT(a * f.a + c * f.b, b * f.a + d * f.b, a * f.c + c * f.d, b * f.c + d * f.d,
                   a * f.tx + c * f.ty + tx, b * f.tx + d * f.ty + ty);
  }

  // Inverts in place. A singular matrix is left unchanged and answers false, or,
  // when inThrowIfSingular, raises "Matrix cannot be inverted.".
  bool Invert(bool inThrowIfSingular = false);

  constexpr bool operator==(const MatrixT& o) const {
    return a == o.a && b == o.b && c == o.c && d == o.d && tx == o.tx && ty == o.ty;
  }
  constexpr bool operator!=(const MatrixT& o) const { return !(*this == o); }
};

// Raises the toolkit's exception for a singular matrix (defined in the library).
[[noreturn]] void ThrowNonInvertableMatrix();

template <typename T>
RectT<T> MatrixT<T>::TransformBounds(const RectT<T>& r) const {
  PointT<T> p[4] = {Transform({r.left, r.top}), Transform({r.Right(), r.top}),
                    Transform({r.left, r.Bottom()}), Transform({r.Right(), r.Bottom()})};
  T l = p[0].x, t = p[0].y, rr = p[0].x, bb = p[0].y;
  for (const auto& q : p) {
    l = q.x < l ? q.x : l; t = q.y < t ? q.y : t;
    rr = q.x > rr ? q.x : rr; bb = q.y > bb ? q.y : bb;
  }
  return RectT<T>::FromEdges(l, t, rr, bb);
}

template <typename T>
bool MatrixT<T>::Invert(bool inThrowIfSingular) {
  T det = Determinant();
  if (det == 0 || !std::isfinite(det)) {
    if (inThrowIfSingular) ThrowNonInvertableMatrix();
    return false;
  }
  T ia = d / det, ib = -b / det, ic = -c / det, id = a / det;
  T itx = -(ia * tx + ic * ty), ity = -(ib * tx + id * ty);
  *this = MatrixT(ia, ib, ic, id, itx, ity);
  return true;
}

using MatrixF = MatrixT<float>;

}  // namespace tarsel::geom
