#include "OSBrushInterface.h"

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

#include "CairoColor.h"

namespace velkui::pictel::cairo {

namespace {

void RequireStops(const ColorRGBA* colors, const float* positions, std::int32_t count) {
  velkcore::RequireInput(colors != nullptr && positions != nullptr && count > 0);
}

bool IsFinite(const velkcore::PointT<float>& p) {
  return std::isfinite(p.x) && std::isfinite(p.y);
}

}  // namespace

void OSSolidBrushInterface::ApplySource(cairo_t* context) const {
  SetSourceColor(context, color_);
}

void OSGradient::ApplySource(cairo_t* context) const {
  cairo_set_source(context, pattern_.get());
}

void OSGradient::SetPattern(cairo_pattern_t* pattern, const ColorRGBA* colors,
                            const float* positions, std::int32_t count) {
  pattern_.reset(pattern);
  for (std::int32_t i = 0; i < count; ++i) {
    const ColorRGBA& c = colors[i];
    cairo_pattern_add_color_stop_rgba(pattern, Channel(positions[i]), Channel(c.red),
                                      Channel(c.green), Channel(c.blue), Channel(c.alpha));
  }
  cairo_pattern_set_extend(pattern, CAIRO_EXTEND_PAD);
}

OSLinearGradientBrushInterface::OSLinearGradientBrushInterface(const velkcore::PointT<float>& start,
                                                               const velkcore::PointT<float>& end,
                                                               const ColorRGBA* colors,
                                                               const float* positions,
                                                               std::int32_t count) {
  RequireStops(colors, positions, count);
  velkcore::RequireInput(IsFinite(start) && IsFinite(end));
  SetPattern(cairo_pattern_create_linear(start.x, start.y, end.x, end.y), colors, positions, count);
}

OSRadialGradientBrushInterface::OSRadialGradientBrushInterface(
    const velkcore::PointT<float>& centre, float radius, const ColorRGBA* colors,
    const float* positions, std::int32_t count) {
  RequireStops(colors, positions, count);
  velkcore::RequireInput(IsFinite(centre) && std::isfinite(radius) && radius >= 0.0f);
  SetPattern(cairo_pattern_create_radial(centre.x, centre.y, 0.0, centre.x, centre.y, radius),
             colors, positions, count);
}

}  // namespace velkui::pictel::cairo
