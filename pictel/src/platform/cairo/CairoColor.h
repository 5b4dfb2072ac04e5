#pragma once

#include <algorithm>
#include <cmath>

#include <velkui/pictel/PictelTypes.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// A channel limited to 0..1 (not-a-number counts as 0).
inline double Channel(float value) {
  return std::isnan(value) ? 0.0 : std::clamp(static_cast<double>(value), 0.0, 1.0);
}

inline void SetSourceColor(cairo_t* context, const ColorRGBA& color) {
  cairo_set_source_rgba(context, Channel(color.red), Channel(color.green), Channel(color.blue),
                        Channel(color.alpha));
}

}  // namespace velkui::pictel::cairo
