#pragma once

#include <string>

#include <velkcore/Geometry.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/ui/UI_SubView.h>

namespace gallery {

// The size of one showcase panel.
inline constexpr float kControlsShowcaseWidth = 600;
inline constexpr float kControlsShowcaseHeight = 430;

// A panel holding every button kind of the controls library, laid out in
// labelled rows and put into telling states (default, focused, hovered,
// pressed, disabled, on, mixed). `context` measures the texts. The panel is
// shown, sized kControlsShowcaseWidth x kControlsShowcaseHeight at (0, 0);
// add it to a window root or draw it with UI_DispatchDrawFromRoot. An
// installed node manager and theme are needed (the focus and the pointer
// state belong to the node manager). The footer says which states are shown,
// unless another text is given.
velkui::ui::SubViewP BuildControlsShowcase(velkui::pictel::Pictel& context,
                                           const std::u16string& title,
                                           const std::u16string& footer = {});

// Draws two showcases side by side into `area` of `context`: the left one in
// the theme's light colours, the right one in the dark interface (the
// library's key-frame theme at brightness 0 when the installed theme takes
// key frames, else the dark control colours). The theme's brightness and
// colours are restored afterwards; a key-frame theme keeps the library's tracks. Needs an installed
// node manager and theme; `area` should be at least 2 x kControlsShowcaseWidth + 24 wide and
// kControlsShowcaseHeight high.
void DrawControlsPage(velkui::pictel::Pictel& context, const velkcore::RectT<float>& area);

}  // namespace gallery
