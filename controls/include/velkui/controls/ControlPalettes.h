#pragma once

#include <velkui/ui/Theme.h>

namespace velkui::controls {

// Sets the theme colours that the controls of this library draw with (window
// and panel backgrounds, text, button faces and outlines, focus ring, marks,
// selected faces) to a dark look, leaving every other colour alone. The
// default palette is the light look; Theme::Update brings it back. Call
// NotifyThemeChanged afterwards, as after any theme change.
void ApplyDarkControlColors(ui::Theme& theme);

}  // namespace velkui::controls
