#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/Theme.h>

namespace velkui::ui {

// A chart of the theme's colours 0..kThemePaletteSize - 1: a grid of cells
// filling `area` row by row, `columns` (at least 1) to a row. Each cell is
// split into a white and a black half under the colour, so that translucent
// colours show as such; an index the theme does not hold is left blank.
void DrawThemeSwatches(pictel::SurfaceInterface& surface, const Theme& theme,
                       const velkcore::RectT<float>& area, std::int32_t columns);

// The cell of `index` in that chart (for hit-testing, say "18: focus ring").
velkcore::RectT<float> GetThemeSwatchCell(const velkcore::RectT<float>& area, std::int32_t columns,
                                          ThemeColorIndex index);

// The colour index whose cell holds `point`, or -1 when none does.
std::int64_t FindThemeSwatchIndex(const velkcore::RectT<float>& area, std::int32_t columns,
                                  const velkcore::PointT<float>& point);

}  // namespace velkui::ui
