#pragma once

#include <cmath>
#include <cstdint>
#include <optional>

#include <velkcore/Geometry.h>

// Matrix and rectangle helpers shared by the node sources.
namespace velkui::ui::detail {

using velkcore::PointT;
using velkcore::RectT;
using velkcore::ScaleMatrixT;

inline constexpr float kDegenerateScale = 1e-6f;

inline bool IsDegenerate(const ScaleMatrixT<float>& m) {
  return !(std::fabs(m.sx) > kDegenerateScale) || !(std::fabs(m.sy) > kDegenerateScale);
}

// `after` applied to the result of `first`.
inline ScaleMatrixT<float> Concat(const ScaleMatrixT<float>& after,
                                  const ScaleMatrixT<float>& first) {
  return {after.sx * first.tx + after.tx, after.sy * first.ty + after.ty, after.sx * first.sx,
          after.sy * first.sy};
}

// The point that `m` maps onto `p`; none for a degenerate matrix.
inline std::optional<PointT<float>> InverseTransform(const ScaleMatrixT<float>& m,
                                                     const PointT<float>& p) {
  if (IsDegenerate(m)) return std::nullopt;
  return PointT<float>{(p.x - m.tx) / m.sx, (p.y - m.ty) / m.sy};
}

// Both corners mapped; the result has a non-negative size even for mirroring scales.
inline RectT<float> TransformRect(const ScaleMatrixT<float>& m, const RectT<float>& r) {
  const float x0 = m.sx * r.left + m.tx;
  const float x1 = m.sx * (r.left + r.width) + m.tx;
  const float y0 = m.sy * r.top + m.ty;
  const float y1 = m.sy * (r.top + r.height) + m.ty;
  const float left = std::fmin(x0, x1);
  const float top = std::fmin(y0, y1);
  return {left, top, std::fmax(x0, x1) - left, std::fmax(y0, y1) - top};
}

// Left and top floored, right and bottom ceiled.
inline RectT<std::int32_t> RoundOut(const RectT<float>& r) {
  const auto left = static_cast<std::int32_t>(std::floor(r.left));
  const auto top = static_cast<std::int32_t>(std::floor(r.top));
  const auto right = static_cast<std::int32_t>(std::ceil(r.left + r.width));
  const auto bottom = static_cast<std::int32_t>(std::ceil(r.top + r.height));
  return {left, top, right - left, bottom - top};
}

inline RectT<float> ToFloat(const RectT<std::int32_t>& r) {
  return {static_cast<float>(r.left), static_cast<float>(r.top), static_cast<float>(r.width),
          static_cast<float>(r.height)};
}

inline PointT<std::int32_t> RoundPoint(const PointT<float>& p) {
  return {static_cast<std::int32_t>(std::lround(p.x)), static_cast<std::int32_t>(std::lround(p.y))};
}

// One axis of a child following its parent's resize by `delta` (centred
// children keep the middle of `newParentLength`).
inline void FollowParentResize(float newParentLength, float delta, bool centred,
                               bool leadingFollows, bool trailingFollows, float* position,
                               float* length) {
  if (centred) {
    *position = std::trunc((newParentLength - *length) * 0.5f);
    return;
  }
  if (leadingFollows) {
    *position += delta;
    *length -= delta;
  }
  if (trailingFollows) *length += delta;
}

inline velkcore::MatrixT<float> ToAffine(const ScaleMatrixT<float>& m) {
  return {m.sx, 0.0f, 0.0f, m.sy, m.tx, m.ty};
}

}  // namespace velkui::ui::detail
