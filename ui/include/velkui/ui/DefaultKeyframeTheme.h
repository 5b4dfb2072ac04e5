#pragma once

#include <string_view>
#include <utility>
#include <vector>

#include <velkui/pictel/PictelTypes.h>
#include <velkui/ui/KeyframeThemeEditor.h>

namespace velkui::ui {

// The library's own key-frame theme, the resource "VelkuiDefault" (type
// "xml", resources/themes/VelkuiDefault.xml): tracks over the interface
// brightness for the colours that the controls and windows draw with.
// Brightness 0 (kDarkInterfaceBrightness) gives the dark interface; from the
// default brightness 0.5 upwards the tracks give the default light palette,
// so installing them changes nothing at the default brightness.

inline constexpr float kDarkInterfaceBrightness = 0.0f;
inline constexpr std::string_view kDefaultKeyframeThemeName = "VelkuiDefault";

// The theme file's text.
std::string_view GetDefaultKeyframeThemeText();

// Reads the tracks into `editor` (each replaces the track of its colour
// index, others stay), rebuilds its colours at its current brightness and
// announces the change (NotifyThemeChanged). Then
//
//   editor.SetBrightness(velkui::ui::kDarkInterfaceBrightness);
//   editor.NotifyThemeChanged();
//
// turns the interface dark, and SetBrightness(GetDefaultBrightness()) light again.
void LoadDefaultKeyframeTheme(KeyframeThemeEditor& editor);

// The colours the default tracks give at `brightness`, one per tracked index
// in index order (read once from the resource). The brightness must be finite.
std::vector<std::pair<ThemeColorIndex, pictel::ColorRGBA>> GetDefaultKeyframeThemeColors(
    float brightness);

}  // namespace velkui::ui
