#pragma once

#include <span>

#include <velkui/pictel/PictelTypes.h>
#include <velkui/ui/Theme.h>

namespace velkui::ui {

// The default palette: one colour for every library colour index 0..365, a
// light grey look with one blue accent and the usual green, amber and red for
// levels and states. Rows cover consecutive indices that share a colour and a role.
struct ThemePaletteRow {
  ThemeColorIndex first;
  ThemeColorIndex last;  // inclusive
  pictel::ColorRGBA color;
  const char* role;  // what the colour is meant for, in a few words
};

inline constexpr ThemeColorIndex kThemePaletteSize = 366;

// The rows in index order, covering 0..kThemePaletteSize - 1 without gaps.
std::span<const ThemePaletteRow> GetDefaultThemePalette();

// The default colour of one index; an index outside the palette is an input-contract violation.
const pictel::ColorRGBA& GetDefaultThemeColor(ThemeColorIndex index);
// The role of the row holding `index` (same contract).
const char* GetDefaultThemeColorRole(ThemeColorIndex index);

}  // namespace velkui::ui
