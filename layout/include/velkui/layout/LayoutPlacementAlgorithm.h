#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/layout/ExtraSpaceAlgorithm.h>

namespace velkui::layout {

// Where a decorator's own element goes relative to its decorated object, and how one area is
// split between the two.
class LayoutPlacementAlgorithm : public velkcore::RefCountedObject {
 public:
  ~LayoutPlacementAlgorithm() override;

  // Splits `area` into the own element's rectangle and the decorated object's:
  // - an own element larger than the area along the axis takes the whole area, and the
  //   decorated object gets an empty rectangle (all zero);
  // - otherwise the own element takes its size at its end of the area, across the full area;
  // - an area no larger than both sizes together leaves the decorated object the rest;
  // - a larger one gives the decorated object its own size at the far end and lets
  //   `extraSpace` close the gap.
  // A null `extraSpace` raises the contract violation.
  virtual void GetRects(const velkcore::RectT<float>& area, const velkcore::PointT<float>& ownSize,
                        const velkcore::PointT<float>& decoratedSize,
                        velkcore::RectT<float>& ownRect, velkcore::RectT<float>& decoratedRect,
                        const ExtraSpaceAlgorithmP& extraSpace) const = 0;
  // The size both need side by side (or stacked).
  virtual velkcore::PointT<float> GetCombinedSize(
      const velkcore::PointT<float>& ownSize,
      const velkcore::PointT<float>& decoratedSize) const = 0;
};

using LayoutPlacementAlgorithmP = boost::intrusive_ptr<const LayoutPlacementAlgorithm>;

// The own element at one end of the area along one axis: what the four placements below share.
class LayoutPlacementAtSide : public LayoutPlacementAlgorithm {
 public:
  enum class Axis { kHorizontal, kVertical };
  enum class End { kStart, kEnd };

  void GetRects(const velkcore::RectT<float>& area, const velkcore::PointT<float>& ownSize,
                const velkcore::PointT<float>& decoratedSize, velkcore::RectT<float>& ownRect,
                velkcore::RectT<float>& decoratedRect,
                const ExtraSpaceAlgorithmP& extraSpace) const override;
  velkcore::PointT<float> GetCombinedSize(
      const velkcore::PointT<float>& ownSize,
      const velkcore::PointT<float>& decoratedSize) const override;

 protected:
  LayoutPlacementAtSide(Axis axis, End end) : axis_(axis), end_(end) {}

 private:
  Axis axis_;
  End end_;
};

// The own element to the left of the decorated object.
class LayoutPlacement_LeftOfDO : public LayoutPlacementAtSide {
 public:
  LayoutPlacement_LeftOfDO() : LayoutPlacementAtSide(Axis::kHorizontal, End::kStart) {}
  static const LayoutPlacementAlgorithmP& GetSharedPtr();
};

// The own element to the right of the decorated object.
class LayoutPlacement_RightOfDO : public LayoutPlacementAtSide {
 public:
  LayoutPlacement_RightOfDO() : LayoutPlacementAtSide(Axis::kHorizontal, End::kEnd) {}
  static const LayoutPlacementAlgorithmP& GetSharedPtr();
};

// The own element above the decorated object.
class LayoutPlacement_AboveDO : public LayoutPlacementAtSide {
 public:
  LayoutPlacement_AboveDO() : LayoutPlacementAtSide(Axis::kVertical, End::kStart) {}
  static const LayoutPlacementAlgorithmP& GetSharedPtr();
};

// The own element below the decorated object.
class LayoutPlacement_BelowDO : public LayoutPlacementAtSide {
 public:
  LayoutPlacement_BelowDO() : LayoutPlacementAtSide(Axis::kVertical, End::kEnd) {}
  static const LayoutPlacementAlgorithmP& GetSharedPtr();
};

}  // namespace velkui::layout
