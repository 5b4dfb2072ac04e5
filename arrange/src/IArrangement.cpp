#include <velkui/arrange/IArrangement.h>

#include <algorithm>

namespace velkui::arrange::impl {

float IArrangement::Overflow(const PointF& size) {
  return MinWidth() * std::max(0.0f, MinHeight() - size.y) +
         MinHeight() * std::max(0.0f, MinWidth() - size.x);
}

float IArrangement::Waste(const PointF& size) {
  return size.x * size.y - ExpandedWidth(size.x) * ExpandedHeight(size.y);
}

}  // namespace velkui::arrange::impl
