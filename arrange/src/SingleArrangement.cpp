#include "SingleArrangement.h"

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/arrange/Single.h>

namespace velkui::arrange::impl {

namespace {

float RequireSize(float value) {
  velkcore::RequireInput(std::isfinite(value) && value >= 0);
  return value;
}

float RequireFinite(float value) {
  velkcore::RequireInput(std::isfinite(value));
  return value;
}

// Never hands NaN or a negative extent to the host.
float Sanitized(float value) {
  return std::isnan(value) ? 0.0f : value;
}
float SanitizedExtent(float value) {
  return std::isnan(value) ? 0.0f : std::max(0.0f, value);
}

}  // namespace

SingleArrangement::SingleArrangement(Single& leaf)
    : leaf_(&leaf),
      horizontallyExpandable_(leaf.HorizontallyExpandable()),
      verticallyExpandable_(leaf.VerticallyExpandable()),
      leftMargin_(RequireFinite(leaf.LeftMargin())),
      topMargin_(RequireFinite(leaf.TopMargin())),
      horizontalMargins_(leftMargin_ + RequireFinite(leaf.RightMargin())),
      verticalMargins_(topMargin_ + RequireFinite(leaf.BottomMargin())),
      minWidth_(RequireSize(leaf.MinWidth()) + horizontalMargins_),
      minHeight_(RequireSize(leaf.MinHeight()) + verticalMargins_),
      bestWidth_(RequireSize(leaf.NaturalWidth()) + horizontalMargins_),
      bestHeight_(RequireSize(leaf.NaturalHeight()) + verticalMargins_) {}

PointF SingleArrangement::Arrange(const RectF& rect) {
  if (leaf_ != nullptr) {
    leaf_->Place({Sanitized(rect.left + leftMargin_), Sanitized(rect.top + topMargin_),
                  SanitizedExtent(rect.width - horizontalMargins_),
                  SanitizedExtent(rect.height - verticalMargins_)});
  }
  return {rect.width, rect.height};
}

float SingleArrangement::ExpandedWidth(float available) const {
  // A leaf that cannot grow takes its minimum whenever that much is offered.
  if ((!horizontallyExpandable_ && available >= minWidth_) || leaf_ == nullptr) return minWidth_;
  return RequireFinite(leaf_->ExpandedWidth(available - horizontalMargins_)) + horizontalMargins_;
}

float SingleArrangement::ExpandedHeight(float available) const {
  if ((!verticallyExpandable_ && available >= minHeight_) || leaf_ == nullptr) return minHeight_;
  return RequireFinite(leaf_->ExpandedHeight(available - verticalMargins_)) + verticalMargins_;
}

}  // namespace velkui::arrange::impl
