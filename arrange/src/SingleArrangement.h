#pragma once

#include <velkui/arrange/IArrangement.h>

namespace velkui::arrange {
class Single;
}

namespace velkui::arrange::impl {

// The one candidate of a leaf: the leaf's sizes and margins as they were when the leaf was
// measured, and the leaf itself for expansion and placement.
class SingleArrangement : public IArrangement {
 public:
  explicit SingleArrangement(Single& leaf);

  PointF Arrange(const RectF& rect) override;
  bool HorizontallyExpandable() const override { return horizontallyExpandable_; }
  bool VerticallyExpandable() const override { return verticallyExpandable_; }
  float MinWidth() const override { return minWidth_; }
  float MinHeight() const override { return minHeight_; }
  float BestWidth() const override { return bestWidth_; }
  float BestHeight() const override { return bestHeight_; }
  float ExpandedWidth(float available) const override;
  float ExpandedHeight(float available) const override;

  // The leaf is going away; the arrangement keeps its recorded sizes and places nothing.
  void DetachLeaf() { leaf_ = nullptr; }

 private:
  Single* leaf_;
  bool horizontallyExpandable_;
  bool verticallyExpandable_;
  float leftMargin_;
  float topMargin_;
  float horizontalMargins_;
  float verticalMargins_;
  float minWidth_;
  float minHeight_;
  float bestWidth_;
  float bestHeight_;
};

}  // namespace velkui::arrange::impl
