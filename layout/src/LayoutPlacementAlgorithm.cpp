#include <velkui/layout/LayoutPlacementAlgorithm.h>

#include <cmath>

#include <velkcore/Error.h>

namespace velkui::layout {

using velkcore::PointT;
using velkcore::RectT;

namespace {

using Axis = LayoutPlacementAtSide::Axis;
using End = LayoutPlacementAtSide::End;

// A rectangle seen along one axis: `main` runs along the axis, `cross` across it.
struct AxisRect {
  float mainStart = 0;
  float mainLength = 0;
  float crossStart = 0;
  float crossLength = 0;
};

AxisRect ToAxis(const RectT<float>& r, Axis axis) {
  if (axis == Axis::kHorizontal) return {r.left, r.width, r.top, r.height};
  return {r.top, r.height, r.left, r.width};
}

RectT<float> FromAxis(const AxisRect& a, Axis axis) {
  if (axis == Axis::kHorizontal) return {a.mainStart, a.crossStart, a.mainLength, a.crossLength};
  return {a.crossStart, a.mainStart, a.crossLength, a.mainLength};
}

float MainOf(const PointT<float>& size, Axis axis) {
  return axis == Axis::kHorizontal ? size.x : size.y;
}

bool IsFinite(const RectT<float>& r) {
  return std::isfinite(r.left) && std::isfinite(r.top) && std::isfinite(r.width) &&
         std::isfinite(r.height);
}

// The own element at the `end` of `area` along `axis`.
void SplitArea(Axis axis, End end, const RectT<float>& area, const PointT<float>& ownSize,
               const PointT<float>& decoratedSize, RectT<float>& ownRect,
               RectT<float>& decoratedRect, const ExtraSpaceAlgorithmP& extraSpace) {
  velkcore::RequireInput(extraSpace != nullptr && IsFinite(area));
  const AxisRect a = ToAxis(area, axis);
  const float own = MainOf(ownSize, axis);
  const float decorated = MainOf(decoratedSize, axis);
  if (own > a.mainLength) {
    ownRect = area;
    decoratedRect = {0, 0, 0, 0};
    return;
  }
  const float areaEnd = a.mainStart + a.mainLength;
  const float ownStart = end == End::kStart ? a.mainStart : areaEnd - own;
  ownRect = FromAxis({ownStart, own, a.crossStart, a.crossLength}, axis);
  if (a.mainLength <= own + decorated) {
    const float restStart = end == End::kStart ? a.mainStart + own : a.mainStart;
    decoratedRect = FromAxis({restStart, a.mainLength - own, a.crossStart, a.crossLength}, axis);
    return;
  }
  const float decoratedStart = end == End::kStart ? areaEnd - decorated : a.mainStart;
  decoratedRect = FromAxis({decoratedStart, decorated, a.crossStart, a.crossLength}, axis);
  if (axis == Axis::kHorizontal) {
    extraSpace->AdjustRectsHorizontally(ownRect, decoratedRect);
  } else {
    extraSpace->AdjustRectsVertically(ownRect, decoratedRect);
  }
}

// Ties take the first operand.
float Larger(float first, float second) {
  return first >= second ? first : second;
}

PointT<float> SideBySide(const PointT<float>& own, const PointT<float>& decorated) {
  return {own.x + decorated.x, Larger(own.y, decorated.y)};
}

PointT<float> Stacked(const PointT<float>& own, const PointT<float>& decorated) {
  return {Larger(own.x, decorated.x), own.y + decorated.y};
}

}  // namespace

LayoutPlacementAlgorithm::~LayoutPlacementAlgorithm() = default;

void LayoutPlacementAtSide::GetRects(const RectT<float>& area, const PointT<float>& ownSize,
                                     const PointT<float>& decoratedSize, RectT<float>& ownRect,
                                     RectT<float>& decoratedRect,
                                     const ExtraSpaceAlgorithmP& extraSpace) const {
  SplitArea(axis_, end_, area, ownSize, decoratedSize, ownRect, decoratedRect, extraSpace);
}

PointT<float> LayoutPlacementAtSide::GetCombinedSize(const PointT<float>& ownSize,
                                                     const PointT<float>& decoratedSize) const {
  return axis_ == Axis::kHorizontal ? SideBySide(ownSize, decoratedSize)
                                    : Stacked(ownSize, decoratedSize);
}

const LayoutPlacementAlgorithmP& LayoutPlacement_LeftOfDO::GetSharedPtr() {
  static const LayoutPlacementAlgorithmP shared(new LayoutPlacement_LeftOfDO());
  return shared;
}

const LayoutPlacementAlgorithmP& LayoutPlacement_RightOfDO::GetSharedPtr() {
  static const LayoutPlacementAlgorithmP shared(new LayoutPlacement_RightOfDO());
  return shared;
}

const LayoutPlacementAlgorithmP& LayoutPlacement_AboveDO::GetSharedPtr() {
  static const LayoutPlacementAlgorithmP shared(new LayoutPlacement_AboveDO());
  return shared;
}

const LayoutPlacementAlgorithmP& LayoutPlacement_BelowDO::GetSharedPtr() {
  static const LayoutPlacementAlgorithmP shared(new LayoutPlacement_BelowDO());
  return shared;
}

}  // namespace velkui::layout
