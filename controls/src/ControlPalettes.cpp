#include <velkui/controls/ControlPalettes.h>

#include <array>
#include <utility>

namespace velkui::controls {

namespace {

constexpr pictel::ColorRGBA Rgb(int red, int green, int blue, float alpha = 1.0f) {
  return {static_cast<float>(red) / 255.0f, static_cast<float>(green) / 255.0f,
          static_cast<float>(blue) / 255.0f, alpha};
}
constexpr pictel::ColorRGBA Grey(int level, float alpha = 1.0f) {
  return Rgb(level, level, level, alpha);
}

constexpr pictel::ColorRGBA kAccent = Rgb(83, 170, 240);

// clang-format off
constexpr std::array<std::pair<ui::ThemeColorIndex, pictel::ColorRGBA>, 58> kDarkColors{{
    {0, Grey(255, 0.16f)},   // sheen over control faces
    {1, Grey(225)},          // text
    {2, Grey(30)},           // content background
    {3, Grey(70)},           // frame
    {4, Grey(45)},           // window background
    {5, Grey(160)},          // secondary text
    {6, Grey(52)},           // panel background
    {7, Grey(110)},          // disabled text
    {8, Grey(70)},           // separator line
    {9, Grey(100)},          // strong frame
    {16, Grey(255, 0.06f)},  // hover veil
    {17, Grey(0, 0.3f)},     // pressed veil
    {18, kAccent},           // focus ring
    {19, Grey(24)},          // control outline
    {20, Grey(92)},          // control face, top
    {21, Grey(74)},          // control face, bottom
    {22, Grey(104)},         // hovered face, top
    {23, Grey(84)},          // hovered face, bottom
    {24, Grey(56)},          // pressed face, top
    {25, Grey(66)},          // pressed face, bottom
    {26, Grey(62)},          // disabled face, top
    {27, Grey(58)},          // disabled face, bottom
    {28, Grey(232)},         // control label
    {29, Grey(120)},         // disabled control label
    {30, Rgb(20, 70, 130)},  // default button outline
    {31, Rgb(66, 146, 226)}, // default button face, top
    {32, Rgb(40, 112, 196)}, // default button face, bottom
    {33, Grey(255)},         // default button label
    {34, Rgb(56, 118, 178)}, // toggle on face, top
    {35, Rgb(44, 100, 158)}, // toggle on face, bottom
    {36, Grey(245)},         // check mark
    {37, Grey(120)},         // disabled check mark
    {38, Grey(245)},         // radio dot
    {39, Grey(40)},          // check box background
    {48, Grey(54)},          // disabled control outline
    {80, Grey(190)},         // disclosure triangle
    {140, Grey(45)},         // dialog background
    {150, Grey(72)},         // group box outline
    {151, Grey(200)},        // group box title
    {179, Grey(222)},        // static text
    {180, Grey(120)},        // disabled static text
    {181, kAccent},          // link
    {182, Rgb(140, 200, 250)},  // hovered link
    {309, Grey(60)},         // disabled control ring
    {340, Grey(58)},         // toolbar, top
    {341, Grey(50)},         // toolbar, bottom
    {347, Rgb(52, 112, 172)},   // selected face, top
    {348, Rgb(40, 94, 150)},    // selected face, bottom
    {349, Grey(255)},           // selected label
    {350, Rgb(18, 52, 92)},     // selected outline
    {351, Rgb(62, 124, 186)},   // hovered selected face, top
    {352, Rgb(48, 104, 162)},   // hovered selected face, bottom
    {353, Rgb(34, 80, 128)},    // pressed selected face, top
    {354, Rgb(42, 90, 140)},    // pressed selected face, bottom
    {355, Grey(64)},            // disabled selected outline
    {356, Rgb(54, 64, 76)},     // disabled selected face
    {357, Grey(128)},           // disabled selected label
    {310, Grey(24)},            // dark pane background
}};
// clang-format on

}  // namespace

void ApplyDarkControlColors(ui::Theme& theme) {
  for (const auto& [index, color] : kDarkColors) theme.SetColor(index, color);
}

}  // namespace velkui::controls
