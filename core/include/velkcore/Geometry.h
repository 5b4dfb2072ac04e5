#pragma once

#include <cmath>

namespace velkcore {

template <typename T>
struct PointT {
  T x{};
  T y{};

  friend bool operator==(const PointT&, const PointT&) = default;
};

template <typename T>
struct RectT {
  T left{};
  T top{};
  T width{};
  T height{};

  T Right() const { return left + width; }
  T Bottom() const { return top + height; }
  bool IsEmpty() const { return !(width > T{}) || !(height > T{}); }
  bool Contains(const PointT<T>& p) const {
    return p.x >= left && p.y >= top && p.x < left + width && p.y < top + height;
  }

  friend bool operator==(const RectT&, const RectT&) = default;
};

// Bounding box of the overlap of two rectangles; zero size when they do not meet.
template <typename T>
RectT<T> Intersection(const RectT<T>& a, const RectT<T>& b) {
  const T l = a.left > b.left ? a.left : b.left;
  const T t = a.top > b.top ? a.top : b.top;
  const T r = a.Right() < b.Right() ? a.Right() : b.Right();
  const T btm = a.Bottom() < b.Bottom() ? a.Bottom() : b.Bottom();
  if (!(r > l) || !(btm > t)) return RectT<T>{l, t, T{}, T{}};
  return RectT<T>{l, t, r - l, btm - t};
}

// Smallest rectangle holding both; an empty rectangle adds nothing.
template <typename T>
RectT<T> Union(const RectT<T>& a, const RectT<T>& b) {
  if (a.IsEmpty()) return b;
  if (b.IsEmpty()) return a;
  const T l = a.left < b.left ? a.left : b.left;
  const T t = a.top < b.top ? a.top : b.top;
  const T r = a.Right() > b.Right() ? a.Right() : b.Right();
  const T btm = a.Bottom() > b.Bottom() ? a.Bottom() : b.Bottom();
  return RectT<T>{l, t, r - l, btm - t};
}

// Translation plus axis-aligned scale: p' = (sx * x + tx, sy * y + ty).
template <typename T>
struct ScaleMatrixT {
  T tx{0};
  T ty{0};
  T sx{1};
  T sy{1};

  static ScaleMatrixT Identity() { return {}; }
  bool IsIdentity() const { return tx == T{0} && ty == T{0} && sx == T{1} && sy == T{1}; }
  PointT<T> Transform(const PointT<T>& p) const { return {sx * p.x + tx, sy * p.y + ty}; }

  friend bool operator==(const ScaleMatrixT&, const ScaleMatrixT&) = default;
};

[[noreturn]] void ThrowSingularMatrix();

// 2-D affine matrix: (x, y) -> (a*x + c*y + tx, b*x + d*y + ty).
template <typename T>
struct MatrixT {
  T a{1};
  T b{0};
  T c{0};
  T d{1};
  T tx{0};
  T ty{0};

  static MatrixT Identity() { return {}; }
  static MatrixT Translation(T x, T y) { return {1, 0, 0, 1, x, y}; }
  static MatrixT Scale(T x, T y) { return {x, 0, 0, y, 0, 0}; }

  bool IsIdentity() const { return *this == MatrixT{}; }
  T Determinant() const { return a * d - b * c; }

  PointT<T> Transform(const PointT<T>& p) const {
    return {a * p.x + c * p.y + tx, b * p.x + d * p.y + ty};
  }

  // this applied after `first`: (this * first)(p) == this(first(p)).
  MatrixT Concat(const MatrixT& first) const {
    return {a * first.a + c * first.b,   b * first.a + d * first.b,
            a * first.c + c * first.d,   b * first.c + d * first.d,
            a * first.tx + c * first.ty + tx, b * first.tx + d * first.ty + ty};
  }

  // Inverts in place; a singular matrix raises the geometry error and stays unchanged.
  void Invert() {
    const T det = Determinant();
    if (det == T{0} || !std::isfinite(static_cast<double>(det))) ThrowSingularMatrix();
    const MatrixT m = *this;
    a = m.d / det;
    b = -m.b / det;
    c = -m.c / det;
    d = m.a / det;
    tx = (m.c * m.ty - m.d * m.tx) / det;
    ty = (m.b * m.tx - m.a * m.ty) / det;
  }

  MatrixT Inverted() const {
    MatrixT m = *this;
    m.Invert();
    return m;
  }

  friend bool operator==(const MatrixT&, const MatrixT&) = default;
};

}  // namespace velkcore
