#pragma once

#include <velkcore/RefCountedObject.h>
#include <velkui/arrange/ArrangeTypes.h>
#include <boost/intrusive_ptr.hpp>

namespace velkui::arrange::impl {

// One concrete way of laying out an arrangeable: a row, a column, lines of a wrapping group,
// or a single leaf. Minimum and best sizes include the margins the arrangement owns.
class IArrangement : public velkcore::RefCountedObject {
 public:
  ~IArrangement() override = default;

  // Places everything inside the rectangle; returns the size used.
  virtual PointF Arrange(const RectF& rect) = 0;
  virtual bool HorizontallyExpandable() const = 0;
  virtual bool VerticallyExpandable() const = 0;
  virtual float MinWidth() const = 0;
  virtual float MinHeight() const = 0;
  virtual float BestWidth() const = 0;
  virtual float BestHeight() const = 0;
  // The width (height) taken when `available` is offered.
  virtual float ExpandedWidth(float available) const = 0;
  virtual float ExpandedHeight(float available) const = 0;
  // Area that does not fit into `size`.
  virtual float Overflow(const PointF& size);
  // Area of `size` left unused.
  virtual float Waste(const PointF& size);
  virtual void Compute() {}
  // An outer arrangement owns its group's margins and reports position and size to the group.
  virtual bool IsOuter() const { return false; }

  // x covers y when x is no larger than y in both minimum dimensions.
  bool Covers(const IArrangement& other) const {
    return MinWidth() <= other.MinWidth() && MinHeight() <= other.MinHeight();
  }
};

using IArrangementP = boost::intrusive_ptr<IArrangement>;

}  // namespace velkui::arrange::impl
