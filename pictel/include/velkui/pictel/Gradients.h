#pragma once

#include <cstdint>
#include <functional>

#include <velkcore/Geometry.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>

namespace velkui::utils {

// Shades `path` with a linear gradient (winding rule). When the supplier has no
// linear shaders, fills it with one colour instead: first + (last - first) ×
// the interface brightness.
void HandleGradient(pictel::Pictel* pictel, pictel::PathP& path,
                    const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
                    const pictel::ColorRGBA* colors, const float* positions, std::int32_t count);
void HandleGradient(pictel::Pictel* pictel, pictel::PathP& path,
                    const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
                    const pictel::ColorRGBA& from, const pictel::ColorRGBA& to);

// The theme installs where the interface brightness comes from; without one it is 0.5.
void SetGradientBrightnessFunction(std::function<float()> brightness);

}  // namespace velkui::utils
