#include <velkui/controls/ControlAlignment.h>

namespace velkui::controls {

pictel::TextAlignment UI_GetPictelTextAlignment(ControlAlignment alignment,
                                                const velkcore::RectT<float>& rect,
                                                velkcore::PointT<float>* anchor) {
  velkcore::PointT<float> point{rect.left, rect.top};
  pictel::TextAlignment result = pictel::TextAlignment::kStart;
  switch (alignment) {
    case kControlAlignCenter:
      point = {rect.left + rect.width / 2, rect.top + rect.height / 2};
      result = pictel::TextAlignment::kCenter;
      break;
    case kControlAlignRight:
      point = {rect.left + rect.width, rect.top + rect.height};
      result = pictel::TextAlignment::kEnd;
      break;
    default:
      break;
  }
  if (anchor != nullptr) *anchor = point;
  return result;
}

velkcore::RectT<float> UI_AlignRectInRect(const velkcore::PointT<float>& size,
                                          const velkcore::RectT<float>& rect,
                                          ControlAlignment alignment) {
  float left = rect.left;
  if (alignment == kControlAlignCenter) left = rect.left + (rect.width - size.x) / 2;
  if (alignment == kControlAlignRight) left = rect.left + rect.width - size.x;
  return {left, rect.top + (rect.height - size.y) / 2, size.x, size.y};
}

}  // namespace velkui::controls
