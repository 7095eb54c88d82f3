#pragma once
// A point in view coordinates (float) or pixels (long).

namespace tarsel::geom {

template <typename T>
struct PointT {
  T x{};
  T y{};

  constexpr PointT() = default;
  constexpr PointT(T inX, T inY) : x(inX), y(inY) {}

  template <typename U>
  constexpr explicit PointT(const PointT<U>& inOther) : x(static_cast<T>(inOther.x)), y(static_cast<T>(inOther.y)) {}

  constexpr PointT operator+(const PointT& o) const { return {x + o.x, y + o.y}; }
  constexpr PointT operator-(const PointT& o) const { return {x - o.x, y - o.y}; }
  constexpr PointT operator-() const { return {-x, -y}; }
  PointT& operator+=(const PointT& o) { x += o.x; y += o.y; return *this; }
  PointT& operator-=(const PointT& o) { x -= o.x; y -= o.y; return *this; }
  constexpr bool operator==(const PointT& o) const { return x == o.x && y == o.y; }
  constexpr bool operator!=(const PointT& o) const { return !(*this == o); }
};

using PointF = PointT<float>;
using PointL = PointT<long>;

}  // namespace tarsel::geom
