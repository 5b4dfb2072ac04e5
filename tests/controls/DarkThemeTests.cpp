// The library's key-frame theme: its light end is the default palette, its
// dark end the controls' dark look, and everything in between a blend.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <map>

#include <velkui/controls/ControlPalettes.h>
#include <velkui/pictel/ColorConversion.h>
#include <velkui/ui/DefaultKeyframeTheme.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/ThemePalette.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

using Colors = std::map<ui::ThemeColorIndex, pictel::ColorRGBA>;

Colors At(float brightness) {
  Colors colors;
  for (const auto& [index, color] : ui::GetDefaultKeyframeThemeColors(brightness)) {
    colors[index] = color;
  }
  return colors;
}

float Luminance(const pictel::ColorRGBA& c) {
  auto linear = [](float v) {
    return v <= 0.03928f ? v / 12.92f : std::pow((v + 0.055f) / 1.055f, 2.4f);
  };
  return 0.2126f * linear(c.red) + 0.7152f * linear(c.green) + 0.0722f * linear(c.blue);
}

float Contrast(const pictel::ColorRGBA& a, const pictel::ColorRGBA& b) {
  const float la = Luminance(a);
  const float lb = Luminance(b);
  return (std::max(la, lb) + 0.05f) / (std::min(la, lb) + 0.05f);
}

void ExpectNear(const pictel::ColorRGBA& actual, const pictel::ColorRGBA& expected,
                ui::ThemeColorIndex index, float tolerance) {
  EXPECT_NEAR(actual.red, expected.red, tolerance) << "colour " << index;
  EXPECT_NEAR(actual.green, expected.green, tolerance) << "colour " << index;
  EXPECT_NEAR(actual.blue, expected.blue, tolerance) << "colour " << index;
  EXPECT_NEAR(actual.alpha, expected.alpha, 1e-5f) << "colour " << index;
}

// What the controls and windows draw with.
constexpr ui::ThemeColorIndex kUsedColors[] = {
    0,  1,   2,   3,   4,   5,   6,   7,   8,   16,  17,  18,  19,  20,  21,  22,  23,
    24, 25,  26,  27,  28,  29,  30,  31,  32,  33,  34,  35,  36,  37,  38,  39,  48,
    80, 140, 179, 180, 181, 309, 347, 348, 349, 350, 351, 352, 353, 354, 355, 356, 357};

class DarkThemeTest : public ControlTest {};

TEST_F(DarkThemeTest, TheTracksCoverTheControlColoursAndEndInTheDefaultPalette) {
  const Colors light = At(ui::GetDefaultBrightness());
  for (const ui::ThemeColorIndex index : kUsedColors) {
    ASSERT_TRUE(light.contains(index)) << "colour " << index << " has no track";
  }
  // Hues are whole degrees in theme files: within a level of the palette.
  for (const auto& [index, color] : light) {
    ExpectNear(color, ui::GetDefaultThemeColor(index), index, 1.0f / 255 + 1e-5f);
  }
  for (const auto& [index, color] : At(1.0f)) {
    ExpectNear(color, light.at(index), index, 1e-6f);
  }
}

TEST_F(DarkThemeTest, TheThemeFileIsStrictlyWellFormed) {
  ui::KeyframeThemeEditor editor;
  editor.SetStrictMode(true);
  EXPECT_NO_THROW(ui::LoadDefaultKeyframeTheme(editor));
  EXPECT_THROW(ui::GetDefaultKeyframeThemeColors(NAN), velkcore::Exception);
}

TEST_F(DarkThemeTest, AnEditorWithTheTracksTurnsDarkWithTheBrightness) {
  ui::KeyframeThemeEditor editor;
  const std::uint64_t before = editor.GetThemeChangeCount();
  ui::LoadDefaultKeyframeTheme(editor);
  EXPECT_GT(editor.GetThemeChangeCount(), before);
  editor.SetBrightness(ui::kDarkInterfaceBrightness);
  // The same dark look as the controls' own switch on a plain theme.
  ui::Theme& plain = ui::Theme::Get();
  ApplyDarkControlColors(plain);
  for (const ui::ThemeColorIndex index : kUsedColors) {
    ExpectNear(editor.GetColor(index), plain.GetColor(index), index, 1e-6f);
  }
  // Colours without a track keep the palette.
  EXPECT_EQ(editor.GetColor(242), ui::GetDefaultThemeColor(242));
  plain.Update();
  EXPECT_EQ(plain.GetColor(4), ui::GetDefaultThemeColor(4));
}

TEST_F(DarkThemeTest, TheDarkEndIsDarkAndReadable) {
  const Colors dark = At(ui::kDarkInterfaceBrightness);
  EXPECT_LT(Luminance(dark.at(4)), 0.05f) << "window background";
  EXPECT_LT(Luminance(dark.at(20)), Luminance(ui::GetDefaultThemeColor(20)));
  // Labels on faces, text on backgrounds, marks on boxes.
  const std::pair<ui::ThemeColorIndex, ui::ThemeColorIndex> pairs[] = {
      {28, 20}, {28, 21}, {179, 4}, {1, 2}, {349, 347}, {349, 348}, {36, 39}, {38, 347}};
  for (const auto& [text, background] : pairs) {
    EXPECT_GT(Contrast(dark.at(text), dark.at(background)), 4.0f)
        << "colour " << text << " on colour " << background;
  }
  EXPECT_GT(Contrast(dark.at(33), dark.at(32)), 3.0f) << "default button label";
  // The focus ring stands out from a face.
  EXPECT_GT(Contrast(dark.at(18), dark.at(21)), 3.0f);
}

TEST_F(DarkThemeTest, InBetweenTheColoursBlendWithoutChangingHue) {
  const Colors dark = At(0);
  const Colors light = At(0.5f);
  for (const float b : {0.1f, 0.3f, 0.45f}) {
    for (const auto& [index, color] : At(b)) {
      if (index == 38) continue;  // the radio dot switches from grey to the accent
      float h = 0, s = 0, v = 0, h0 = 0, s0 = 0, v0 = 0, h1 = 0, s1 = 0, v1 = 0;
      pictel::RGBtoHSB(color, h, s, v, false);
      pictel::RGBtoHSB(dark.at(index), h0, s0, v0, false);
      pictel::RGBtoHSB(light.at(index), h1, s1, v1, false);
      EXPECT_GE(v, std::min(v0, v1) - 1e-4f) << "colour " << index << " at " << b;
      EXPECT_LE(v, std::max(v0, v1) + 1e-4f) << "colour " << index << " at " << b;
      if (s1 > 0.05f && v > 0.1f) {
        EXPECT_NEAR(h, h1, 2.0f) << "colour " << index << " at " << b;
        EXPECT_NEAR(s, s1, 0.02f) << "colour " << index << " at " << b;
      }
    }
  }
  // The radio dot is grey in the dark and takes the accent from a quarter up.
  pictel::ColorRGBA dot = At(0.2f).at(38);
  EXPECT_FLOAT_EQ(dot.red, dot.blue);
  dot = At(0.3f).at(38);
  EXPECT_GT(dot.blue, dot.red + 0.3f);
}

}  // namespace
}  // namespace velkui::controls::test
