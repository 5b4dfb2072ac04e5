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

  // Whether, on each axis it cannot grow along, the arrangement takes exactly its minimum when
  // offered at least that much. True for leaves; lines with negative spacing break it, and so
  // does any line holding such a line. Lets expansion stop descending where the answer is known.
  bool ExpandsRegularly() const { return expandsRegularly_; }

  // x covers y when x is no larger than y in both minimum dimensions.
  bool Covers(const IArrangement& other) const {
    return MinWidth() <= other.MinWidth() && MinHeight() <= other.MinHeight();
  }

 protected:
  void SetExpandsRegularly(bool regular) { expandsRegularly_ = regular; }

 private:
  bool expandsRegularly_ = true;
};

using IArrangementP = boost::intrusive_ptr<IArrangement>;

}  // namespace velkui::arrange::impl
