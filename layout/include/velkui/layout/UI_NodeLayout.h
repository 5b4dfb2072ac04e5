#pragma once

#include <velkui/layout/SmartLayout.h>
#include <velkui/ui/UI_Node.h>

namespace velkui::pictel {
class SupplierInterface;
}

namespace velkui::layout {

// A node as an element of a composed layout: SetLocation sets the node's frame.
//
// Base of the control layouts (static text, text button, check box, radio button): they are
// made from their control, a size and a supplier, measure the control with
// MeasureRecommendedSize and grow their initial size with GrowInitialSizeToFit.
class UI_NodeLayout : public SmartLayout {
 public:
  // A null node raises the contract violation.
  UI_NodeLayout(ui::NodeP node, const PointF& size);
  ~UI_NodeLayout() override;

  // Sets the node's frame (in its parent's coordinates) to `rect`.
  void SetLocation(const RectF& rect) override;

  const ui::NodeP& GetNode() const { return node_; }
  // A null node raises the contract violation.
  void SetNode(ui::NodeP node);

 protected:
  // The node's recommended size, asked with a temporary drawing context over a 1 × 1 offscreen
  // surface of `supplier`. A null supplier raises the contract violation.
  static PointF MeasureRecommendedSize(ui::UI_Node& node,
                                       const pictel::SupplierInterface* supplier);
  // Makes the initial size at least `needed` in each dimension, both rounded up to whole
  // numbers.
  void GrowInitialSizeToFit(const PointF& needed);

 private:
  ui::NodeP node_;
};

}  // namespace velkui::layout
