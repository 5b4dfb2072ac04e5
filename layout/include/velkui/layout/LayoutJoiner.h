#pragma once

#include <velkui/layout/StrategicLayoutDecorator.h>

namespace velkui::layout {

// Two elements side by side: the own element of this decorator is a second SmartLayout, which
// is given the own rectangle once the decorated object has been placed.
class LayoutJoiner : public StrategicLayoutDecorator {
 public:
  LayoutJoiner(SmartLayoutP element, SmartLayoutP decorated, LayoutPlacementAlgorithmP placement,
               ExtraSpaceAlgorithmP extraSpace);
  ~LayoutJoiner() override;

  void SetLocation(const RectF& area) override;

  const SmartLayoutP& GetElement() const { return element_; }
  // Raises the contract violation for null or for an element that contains this joiner.
  void SetElement(SmartLayoutP element);

 protected:
  PointF GetOwnSize() const override;
  const SmartLayout* GetOtherPart() const override { return element_.get(); }

 private:
  SmartLayoutP element_;
};

// A child laid out inside its parent: the parent gets the whole rectangle, the child the same
// size at (0, 0), in the parent's own coordinates. The initial size is the larger width and the
// larger height of the two.
class ParentChildLayoutJoiner : public LayoutJoiner {
 public:
  ParentChildLayoutJoiner(SmartLayoutP parent, SmartLayoutP child);
  ~ParentChildLayoutJoiner() override;

  PointF GetInitialSize() const override;
  void SetLocation(const RectF& rect) override;
};

}  // namespace velkui::layout
