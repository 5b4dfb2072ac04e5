#include <velkui/controls/UI_Divider.h>

#include <cmath>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kSeparator = 8;

}  // namespace

UI_Divider::UI_Divider() {
  UI_SetNodeID("UI_Divider");
}

UI_Divider::~UI_Divider() = default;

bool UI_Divider::IsVertical() const {
  if (vertical_) return *vertical_;
  const velkcore::RectT<float> r = UI_GetLocalRectF(false);
  return r.height > r.width;
}

void UI_Divider::SetSeparatorFrame(bool acrossColumn, const arrange::RectF& frame) {
  // Between two children of a row the line stands upright; between two of a column it lies flat.
  const bool vertical = !acrossColumn;
  if (vertical_ != vertical) {
    vertical_ = vertical;
    UI_Invalidate(nullptr, {});
  }
  UI_SetLocalRectF(frame);
}

void UI_Divider::UI_Draw(pictel::Pictel* context) const {
  const velkcore::RectT<float> r = UI_GetLocalRectF(false);
  const pictel::ColorRGBA color = detail::ThemeColor(kSeparator, nullptr);
  if (IsVertical()) {
    context->GetSurface()->PaintRect(
        color, {std::floor(r.left + r.width / 2 - 0.5f), r.top, 1.0f, r.height});
  } else {
    context->GetSurface()->PaintRect(
        color, {r.left, std::floor(r.top + r.height / 2 - 0.5f), r.width, 1.0f});
  }
  UI_ControlView::UI_Draw(context);
}

velkcore::PointT<float> UI_Divider::UI_GetRecommendedSize(pictel::Pictel*) {
  return IsVertical() ? velkcore::PointT<float>{2, 120} : velkcore::PointT<float>{120, 2};
}

}  // namespace velkui::controls
