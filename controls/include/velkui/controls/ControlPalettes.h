#pragma once

#include <velkui/ui/Theme.h>

namespace velkui::controls {

// Sets the theme colours that the controls and windows of this library draw
// with (window and panel backgrounds, text, button faces and outlines, focus
// ring, marks, selected faces) to the dark look: the colours the library's
// key-frame theme gives at the dark interface brightness
// (ui::GetDefaultKeyframeThemeColors). Every other colour stays; Theme::Update
// brings the theme's own colours back. Call NotifyThemeChanged afterwards, as
// after any theme change.
//
// A theme that should follow the brightness instead installs the tracks
// (ui::LoadDefaultKeyframeTheme) and sets the brightness.
void ApplyDarkControlColors(ui::Theme& theme);

}  // namespace velkui::controls
