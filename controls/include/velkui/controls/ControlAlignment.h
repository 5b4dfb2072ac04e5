#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::controls {

// Horizontal placement of a control's text or content.
enum ControlAlignment : std::int32_t {
  kControlAlignLeft = 0,
  kControlAlignCenter = 1,
  kControlAlignRight = 2,
};

// Vertical placement of text in a static text's rectangle.
enum ControlVerticalAlignment : std::int32_t {
  kControlAlignTop = 0,
  kControlAlignMiddle = 1,
  kControlAlignBottom = 2,
};

// The text alignment for `alignment` and, in `anchor` (may be null), the point
// of `rect` that the text is anchored to: the origin for left, the centre for
// centre, origin plus size for right. Any other value is treated as left.
pictel::TextAlignment UI_GetPictelTextAlignment(ControlAlignment alignment,
                                                const velkcore::RectT<float>& rect,
                                                velkcore::PointT<float>* anchor);

// `size` placed inside `rect` at the given horizontal alignment, centred vertically.
velkcore::RectT<float> UI_AlignRectInRect(const velkcore::PointT<float>& size,
                                          const velkcore::RectT<float>& rect,
                                          ControlAlignment alignment);

}  // namespace velkui::controls
