#pragma once
// A rectangle stored as left, top, width and height. Right and bottom are
// exclusive: a point on the right or bottom edge is outside.
#include <algorithm>

#include "tarsel/PointT.h"

namespace tarsel::geom {

template <typename T>
struct RectT {
  T left{};
  T top{};
  T width{};
  T height{};

  constexpr RectT() = default;
  constexpr RectT(T inLeft, T inTop, T inWidth, T inHeight)
      : left(inLeft), top(inTop), width(inWidth), height(inHeight) {}
  constexpr RectT(const PointT<T>& inOrigin, T inWidth, T inHeight)
      : left(inOrigin.x), top(inOrigin.y), width(inWidth), height(inHeight) {}

  template <typename U>
  constexpr explicit RectT(const RectT<U>& o)
      : left(static_cast<T>(o.left)), top(static_cast<T>(o.top)),
        width(static_cast<T>(o.width)), height(static_cast<T>(o.height)) {}

  static constexpr RectT FromEdges(T inLeft, T inTop, T inRight, T inBottom) {
    return RectT(inLeft, inTop, inRight - inLeft, inBottom - inTop);
  }

  constexpr T Left() const { return left; }
  constexpr T Top() const { return top; }
  constexpr T Right() const { return left + width; }
  constexpr T Bottom() const { return top + height; }
  constexpr T Width() const { return width; }
  constexpr T Height() const { return height; }
  constexpr PointT<T> Origin() const { return {left, top}; }
  constexpr PointT<T> Size() const { return {width, height}; }
  constexpr PointT<T> Center() const { return {left + width / 2, top + height / 2}; }

  constexpr bool IsEmpty() const { return !(width > 0) || !(height > 0); }

  constexpr bool Contains(const PointT<T>& p) const {
    return p.x >= left && p.y >= top && p.x < Right() && p.y < Bottom();
  }
  constexpr bool Contains(const RectT& r) const {
    return r.left >= left && r.top >= top && r.Right() <= Right() && r.Bottom() <= Bottom();
  }
  constexpr bool Intersects(const RectT& r) const {
    return !IsEmpty() && !r.IsEmpty() && r.left < Right() && left < r.Right() && r.top < Bottom() &&
           top < r.Bottom();
  }

  // The common part, or an empty rectangle at the origin when there is none.
  RectT Intersection(const RectT& r) const {
    T l = std::max(left, r.left), t = std::max(top, r.top);
    T rr = std::min(Right(), r.Right()), b = std::min(Bottom(), r.Bottom());
    if (!(rr > l) || !(b > t)) return RectT();
    return FromEdges(l, t, rr, b);
  }
  // The smallest rectangle holding both; an empty side does not count.
  RectT Union(const RectT& r) const {
    if (IsEmpty()) return r;
    if (r.IsEmpty()) return *this;
    return FromEdges(std::min(left, r.left), std::min(top, r.top), std::max(Right(), r.Right()),
                     std::max(Bottom(), r.Bottom()));
  }

  RectT& Offset(T dx, T dy) { left += dx; top += dy; return *this; }
  RectT Offsetted(T dx, T dy) const { return RectT(left + dx, top + dy, width, height); }
  RectT& Inset(T dx, T dy) { left += dx; top += dy; width -= 2 * dx; height -= 2 * dy; return *this; }
  RectT Insetted(T dx, T dy) const { RectT r(*this); return r.Inset(dx, dy); }

  constexpr bool operator==(const RectT& o) const {
    return left == o.left && top == o.top && width == o.width && height == o.height;
  }
  constexpr bool operator!=(const RectT& o) const { return !(*this == o); }
};

using RectF = RectT<float>;
using RectL = RectT<long>;

}  // namespace tarsel::geom
