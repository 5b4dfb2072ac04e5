#pragma once

#include <velkui/arrange/IArrangeable.h>

namespace velkui::arrange {

// A leaf of the arrangement: stands for one item of the host (a node, a box of fixed size...).
// The host supplies the natural size and receives the placement.
//
// A leaf that is not expandable on an axis takes its minimum size there whenever it is offered
// at least that much; the engine relies on this to keep deep trees linear.
// Sizes and margins must be finite, sizes not negative (else the contract violation is raised
// when the leaf is measured).
class Single : public IArrangeable {
 public:
  explicit Single(IArrangeable* parent = nullptr);
  ~Single() override;

  virtual float MinWidth() const { return NaturalWidth(); }
  virtual float MinHeight() const { return NaturalHeight(); }
  virtual float ExpandedWidth(float available) const {
    return HorizontallyExpandable() ? available : MinWidth();
  }
  virtual float ExpandedHeight(float available) const {
    return VerticallyExpandable() ? available : MinHeight();
  }
  virtual bool HorizontallyExpandable() const { return false; }
  virtual bool VerticallyExpandable() const { return false; }
  virtual float LeftMargin() const { return 0; }
  virtual float RightMargin() const { return 0; }
  virtual float TopMargin() const { return 0; }
  virtual float BottomMargin() const { return 0; }
  virtual float NaturalWidth() const = 0;
  virtual float NaturalHeight() const = 0;
  // Receives the leaf's rectangle, margins already taken off; never NaN, never negative sizes.
  virtual void Place(const RectF& rect) = 0;

 protected:
  void RebuildSelf() override;
  impl::ArrangementSet& ArrangementsSelf() override { return arrangements_; }

 private:
  impl::ArrangementSet arrangements_;
};

}  // namespace velkui::arrange
