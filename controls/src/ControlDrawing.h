#pragma once

// Drawing helpers shared by the controls: theme colours through the colour
// change map, rounded shapes, gradients, labels and resource images.

#include <cstddef>
#include <string_view>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/UI_ColorChangeSupport.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>

namespace velkui::controls::detail {

using pictel::ColorRGBA;
using velkcore::PointT;
using velkcore::RectT;

// Label text beside a button's face, box or picture.
inline constexpr ui::UI_Color kLabelColor = 28;
inline constexpr ui::UI_Color kDisabledLabelColor = 29;
inline constexpr float kLabelGap = 6.0f;

pictel::ColorRGBA ThemeColor(ui::UI_Color index, const ColorChangeMap* map);
pictel::ColorRGBA WithAlpha(pictel::ColorRGBA color, float alpha);
pictel::ColorRGBA Mix(const pictel::ColorRGBA& a, const pictel::ColorRGBA& b, float t);
RectT<float> Inset(const RectT<float>& rect, float dx, float dy);
// True when the theme's window background is dark: the art set for dark
// interfaces is chosen then.
bool IsDarkInterface();

// A rounded rectangle; `topOnly` rounds the two top corners only.
pictel::PathP RoundedPath(const pictel::Pictel& context, const RectT<float>& rect, float radius,
                          bool topOnly = false);
pictel::PathP EllipsePath(const pictel::Pictel& context, const RectT<float>& rect);
void Fill(pictel::Pictel& context, const pictel::PathP& path, const pictel::ColorRGBA& color);
void Stroke(pictel::Pictel& context, const pictel::PathP& path, const pictel::ColorRGBA& color,
            float width);
// A two-colour gradient through a middle colour at `midpoint`, from top to
// bottom of `rect` (or from left to right when `horizontal`).
void FillGradient(pictel::Pictel& context, pictel::PathP& path, const RectT<float>& rect,
                  const pictel::ColorRGBA& first, const pictel::ColorRGBA& last, float midpoint,
                  bool horizontal);

// The control font of `size` (the theme's face of font 7).
pictel::FontP ControlFont(const pictel::Pictel& context, float size, bool bold = false);
// One line of text vertically centred in `rect`, aligned and truncated with
// an ellipsis to its width; underlines the unit at `mnemonic` unless it is npos.
void DrawLabel(pictel::Pictel& context, const velkcore::UTF16String& text, const RectT<float>& rect,
               ControlAlignment alignment, const pictel::FontP& font,
               const pictel::ColorRGBA& color, std::size_t mnemonic);
float MeasureText(const pictel::Pictel& context, const pictel::FontP& font,
                  const velkcore::UTF16String& text);

// A library image by name, in the set for the current interface brightness
// ("KT7_" names on dark interfaces, when the library has them). Null when
// the library has no image of that name.
pictel::ImageP FindControlImage(const pictel::Pictel& context, std::string_view name);
bool HasControlImage(std::string_view name);

}  // namespace velkui::controls::detail

namespace velkui::controls {
class UI_TextControlBase;
}

namespace velkui::controls::detail {
// The font of a text control: its own face, style and size where set, else
// the theme's control font.
pictel::FontP TextControlFont(const pictel::Pictel& context, const UI_TextControlBase& text);
}  // namespace velkui::controls::detail

namespace velkui::controls::detail {
// The image scaled into `destination`.
void DrawImageIn(pictel::Pictel& context, const pictel::ImageInterface& image,
                 const velkcore::RectT<float>& destination, float opacity);
// Positive, finite scale factors (else the input-contract violation).
void RequireScale(const velkcore::PointT<float>& scale);
}  // namespace velkui::controls::detail
