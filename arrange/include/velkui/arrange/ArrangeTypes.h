#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>

namespace velkui::arrange {

using PointF = velkcore::PointT<float>;
using RectF = velkcore::RectT<float>;

enum class AlignmentHorizontal : std::int32_t { Left = 0, Center = 1, Right = 2 };
enum class AlignmentVertical : std::int32_t { Top = 0, Center = 1, Bottom = 2 };

enum class GroupArrangementType : std::int32_t {
  Row = 0,
  Column = 1,
  Flipping = 2,
  HorizontalWrapping = 3,
  VerticalWrapping = 4,
  AutoLayout = 5,
};

// True for the six known arrangement types.
constexpr bool IsValidArrangementType(GroupArrangementType type) {
  const auto value = static_cast<std::int32_t>(type);
  return value >= 0 && value <= 5;
}

}  // namespace velkui::arrange
