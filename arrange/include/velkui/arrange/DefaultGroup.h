#pragma once

#include <cmath>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/arrange/AbstractArrangeableGroup.h>

namespace velkui::arrange {

// A group whose spacing, alignments and margins are stored values. Each setter invalidates the
// group when the value changes, so the next arrangement uses it. Non-finite values and unknown
// alignments raise the contract violation.
template <typename Group>
class DefaultGroup : public Group {
 public:
  template <typename... Args>
  explicit DefaultGroup(Args&&... args) : Group(std::forward<Args>(args)...) {}

  void SetHorizontalSpacing(float value) { Store(horizontalSpacing_, value); }
  void SetVerticalSpacing(float value) { Store(verticalSpacing_, value); }
  void SetHorizontalAlignment(AlignmentHorizontal value) {
    const auto raw = static_cast<int>(value);
    velkcore::RequireInput(raw >= 0 && raw <= 2);
    StoreValue(horizontalAlignment_, value);
  }
  void SetVerticalAlignment(AlignmentVertical value) {
    const auto raw = static_cast<int>(value);
    velkcore::RequireInput(raw >= 0 && raw <= 2);
    StoreValue(verticalAlignment_, value);
  }
  void SetLeftMargin(float value) { Store(leftMargin_, value); }
  void SetRightMargin(float value) { Store(rightMargin_, value); }
  void SetTopMargin(float value) { Store(topMargin_, value); }
  void SetBottomMargin(float value) { Store(bottomMargin_, value); }

  float HorizontalSpacing() const override { return horizontalSpacing_; }
  float VerticalSpacing() const override { return verticalSpacing_; }
  AlignmentHorizontal HorizontalAlignment() const override { return horizontalAlignment_; }
  AlignmentVertical VerticalAlignment() const override { return verticalAlignment_; }
  float LeftMargin() const override { return leftMargin_; }
  float RightMargin() const override { return rightMargin_; }
  float TopMargin() const override { return topMargin_; }
  float BottomMargin() const override { return bottomMargin_; }

 private:
  void Store(float& field, float value) {
    velkcore::RequireInput(std::isfinite(value));
    StoreValue(field, value);
  }
  template <typename T>
  void StoreValue(T& field, T value) {
    if (field == value) return;
    field = value;
    this->Invalidate();
  }

  float horizontalSpacing_ = 0;
  float verticalSpacing_ = 0;
  AlignmentHorizontal horizontalAlignment_ = AlignmentHorizontal::Left;
  AlignmentVertical verticalAlignment_ = AlignmentVertical::Top;
  float leftMargin_ = 0;
  float rightMargin_ = 0;
  float topMargin_ = 0;
  float bottomMargin_ = 0;
};

}  // namespace velkui::arrange
