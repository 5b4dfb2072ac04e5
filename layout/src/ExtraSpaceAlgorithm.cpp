#include <velkui/layout/ExtraSpaceAlgorithm.h>

#include <algorithm>

namespace velkui::layout {

using velkcore::RectT;

namespace {

// Horizontally the two elements stay this far apart; vertically they touch.
constexpr float kHorizontalGap = 1.0f;

// `grower` widens toward `other` until it is `gap` away from it. Only ever widens: when the two
// are already closer than the gap, `grower` keeps its size.
void GrowTowardHorizontally(RectT<float>& grower, const RectT<float>& other, float gap) {
  if (grower.left <= other.left) {
    grower.width = std::max(grower.width, other.left - gap - grower.left);
  } else {
    const float right = grower.left + grower.width;
    const float left = std::min(grower.left, other.left + other.width + gap);
    grower.left = left;
    grower.width = right - left;
  }
}

void GrowTowardVertically(RectT<float>& grower, const RectT<float>& other) {
  if (grower.top <= other.top) {
    grower.height = std::max(grower.height, other.top - grower.top);
  } else {
    const float bottom = grower.top + grower.height;
    const float top = std::min(grower.top, other.top + other.height);
    grower.top = top;
    grower.height = bottom - top;
  }
}

}  // namespace

ExtraSpaceAlgorithm::~ExtraSpaceAlgorithm() = default;

void ExtraSpace_Keep::AdjustRectsVertically(RectT<float>& own, RectT<float>& decorated) const {
  GrowTowardVertically(own, decorated);
}

void ExtraSpace_Keep::AdjustRectsHorizontally(RectT<float>& own, RectT<float>& decorated) const {
  GrowTowardHorizontally(own, decorated, kHorizontalGap);
}

const ExtraSpaceAlgorithmP& ExtraSpace_Keep::GetSharedPtr() {
  static const ExtraSpaceAlgorithmP shared(new ExtraSpace_Keep());
  return shared;
}

void ExtraSpace_Pass::AdjustRectsVertically(RectT<float>& own, RectT<float>& decorated) const {
  GrowTowardVertically(decorated, own);
}

void ExtraSpace_Pass::AdjustRectsHorizontally(RectT<float>& own, RectT<float>& decorated) const {
  GrowTowardHorizontally(decorated, own, kHorizontalGap);
}

const ExtraSpaceAlgorithmP& ExtraSpace_Pass::GetSharedPtr() {
  static const ExtraSpaceAlgorithmP shared(new ExtraSpace_Pass());
  return shared;
}

}  // namespace velkui::layout
