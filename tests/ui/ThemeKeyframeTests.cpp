#include <velkui/ui/KeyframeThemeEditor.h>

#include <gtest/gtest.h>

#include <cmath>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorConversion.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

using pictel::ColorRGBA;
using KeyValue = KeyframeThemeEditor::KeyValue;

constexpr ThemeColorIndex kIndex = 4;

class Editor : public KeyframeThemeEditor {
 public:
  // The colour at `brightness`, starting from a marker colour that shows when nothing is written.
  ColorRGBA At(ThemeColorIndex index, float brightness) const {
    ColorRGBA out{0.25f, 0.5f, 0.75f, 0.125f};
    InterpolateColor(index, brightness, out);
    return out;
  }
};

KeyValue Grey(float value, bool hold = false) {
  return {0, 0, value, 1, hold};
}

ColorRGBA GreyColor(float value) {
  return {value, value, value, 1};
}

void ExpectColorNear(const ColorRGBA& actual, const ColorRGBA& expected) {
  EXPECT_NEAR(actual.red, expected.red, 1e-5);
  EXPECT_NEAR(actual.green, expected.green, 1e-5);
  EXPECT_NEAR(actual.blue, expected.blue, 1e-5);
  EXPECT_NEAR(actual.alpha, expected.alpha, 1e-5);
}

TEST(KeyframeInterpolationTest, BetweenKeysValueAndAlphaFollowTheBrightness) {
  Editor editor;
  EXPECT_EQ(editor.At(kIndex, 0.5f), (ColorRGBA{0.25f, 0.5f, 0.75f, 0.125f}));  // no keys
  editor.SetColorKeyValue(kIndex, 0.0f, {0, 0, 0.2f, 1.0f, false});
  editor.SetColorKeyValue(kIndex, 1.0f, {0, 0, 0.8f, 0.5f, false});
  ExpectColorNear(editor.At(kIndex, 0.5f), {0.5f, 0.5f, 0.5f, 0.75f});
  ExpectColorNear(editor.At(kIndex, 0.25f), {0.35f, 0.35f, 0.35f, 0.875f});
}

TEST(KeyframeInterpolationTest, HoldKeepsTheKeyColourUpToTheNextKey) {
  Editor editor;
  editor.SetColorKeyValue(kIndex, 0.0f, {200, 0.5f, 0.2f, 1, true});
  editor.SetColorKeyValue(kIndex, 1.0f, Grey(0.8f));
  const ColorRGBA held = pictel::HSBtoRGB(200.0f, 0.5f, 0.2f, 1.0f);
  for (const float b : {0.0f, 0.3f, 0.999f}) EXPECT_EQ(editor.At(kIndex, b), held) << b;
  ExpectColorNear(editor.At(kIndex, 1.0f), GreyColor(0.8f));
}

TEST(KeyframeInterpolationTest, OutsideTheKeysTheNearestEndKeyHolds) {
  Editor editor;
  editor.SetColorKeyValue(kIndex, 0.3f, {120, 1, 0.4f, 1, false});
  editor.SetColorKeyValue(kIndex, 0.7f, Grey(0.9f));
  const ColorRGBA first = pictel::HSBtoRGB(120.0f, 1.0f, 0.4f, 1.0f);
  EXPECT_EQ(editor.At(kIndex, 0.1f), first);
  EXPECT_EQ(editor.At(kIndex, -50.0f), first);
  ExpectColorNear(editor.At(kIndex, 0.7f), GreyColor(0.9f));
  ExpectColorNear(editor.At(kIndex, 3.0f), GreyColor(0.9f));
}

TEST(KeyframeInterpolationTest, HueAndSaturationFollowTheInterpolatedValue) {
  Editor editor;
  editor.SetColorKeyValue(kIndex, 0.0f, {0, 0.2f, 0.2f, 1, false});
  editor.SetColorKeyValue(kIndex, 1.0f, {100, 0.6f, 0.8f, 1, false});
  // At brightness 0.5 the value is 0.5, and so is the hue's parameter.
  ExpectColorNear(editor.At(kIndex, 0.5f), pictel::HSBtoRGB(50.0f, 0.4f, 0.5f, 1.0f));
  // At brightness 0 the value is 0.2, which also places hue and saturation at 0.2.
  ExpectColorNear(editor.At(kIndex, 0.0f), pictel::HSBtoRGB(20.0f, 0.28f, 0.2f, 1.0f));
}

TEST(KeyframeInterpolationTest, HueIsTruncatedAndOtherComponentsClamped) {
  Editor editor;
  editor.SetColorKeyValue(1, 0.0f, {370.9f, 1, 1, 1, false});
  EXPECT_EQ(editor.At(1, 0.5f), pictel::HSBtoRGB(10.0f, 1.0f, 1.0f, 1.0f));
  editor.SetColorKeyValue(2, 0.0f, {-30, 1, 1, 1, false});
  EXPECT_EQ(editor.At(2, 0.5f), pictel::HSBtoRGB(-30.0f, 1.0f, 1.0f, 1.0f));
  editor.SetColorKeyValue(3, 0.0f, {60, 1.5f, 2.0f, -0.25f, false});
  EXPECT_EQ(editor.At(3, 0.5f), pictel::HSBtoRGB(60.0f, 1.0f, 1.0f, 0.0f));

  // Keys a denormal apart overflow the hue's parameter; the colour stays valid.
  editor.SetColorKeyValue(5, 0.0f, {0, 0.5f, 0.5f, 1, false});
  editor.SetColorKeyValue(5, 1e-38f, {90, 0.7f, 0.5f, 1, false});
  const ColorRGBA c = editor.At(5, 5e-39f);
  for (const float component : {c.red, c.green, c.blue, c.alpha}) {
    EXPECT_TRUE(component >= 0 && component <= 1) << component;
  }
}

TEST(KeyframeBrightnessTest, TracksOverrideThePaletteExceptIndependentOrEmptyOnes) {
  KeyframeThemeEditor editor;
  editor.SetColorKeyValue(1, 0.0f, Grey(0.9f));
  editor.SetColorKeyValue(1, 1.0f, Grey(0.1f));
  editor.SetColorKeyValue(2, 0.0f, Grey(0.0f));
  editor.SetIndependent(2);
  editor.SetColorTrack(3, {});
  editor.SetColorKeyValue(400, 0.0f, Grey(0.3f));

  editor.SetBrightness(0.25f);
  ExpectColorNear(editor.GetColor(1), GreyColor(0.7f));
  EXPECT_EQ(editor.GetColor(2), GetDefaultThemeColor(2));
  EXPECT_EQ(editor.GetColor(3), GetDefaultThemeColor(3));
  ExpectColorNear(editor.GetColor(400), GreyColor(0.3f));

  editor.SetIndependent(2, false);
  editor.ClearColorKeyValue(1);
  editor.Update();
  ExpectColorNear(editor.GetColor(2), GreyColor(0.0f));
  EXPECT_EQ(editor.GetColor(1), GetDefaultThemeColor(1));
  editor.ClearColorKeyValues();
  editor.Update();
  EXPECT_EQ(editor.GetColor(2), GetDefaultThemeColor(2));
}

TEST(KeyframeTrackTest, NonFiniteKeysAreRefusedAndChangeNothing) {
  KeyframeThemeEditor editor;
  editor.SetColorKeyValue(kIndex, 0.0f, Grey(0.1f));
  EXPECT_THROW(editor.SetColorKeyValue(kIndex, std::nanf(""), Grey(0.5f)), velkcore::Exception);
  EXPECT_THROW(editor.SetColorTrack(kIndex, {{0.2f, Grey(0.1f)}, {0.3f, {INFINITY, 0, 0, 1}}}),
               velkcore::Exception);
  EXPECT_EQ(editor.GetColorTrack(kIndex), (KeyframeThemeEditor::ColorTrack{{0.0f, Grey(0.1f)}}));
}

TEST(KeyframeSourceBrightnessTest, FindsWhereTheTrackReachesTheColoursValue) {
  Editor editor;
  EXPECT_EQ(editor.GetSourceBrightness(kIndex, GreyColor(0.3f)), GetDefaultBrightness());
  editor.SetColorKeyValue(kIndex, 0.0f, Grey(0.2f));
  editor.SetColorKeyValue(kIndex, 1.0f, Grey(0.8f));
  for (const float b : {0.0f, 0.35f, 0.6f, 1.0f}) {
    EXPECT_NEAR(editor.GetSourceBrightness(kIndex, editor.At(kIndex, b)), b, 1e-5) << b;
  }
  // The value of a colour is its brightest component.
  EXPECT_NEAR(editor.GetSourceBrightness(kIndex, {0.5f, 0.1f, 0.0f, 1}), 0.5f, 1e-6);
  // Never reached: the key that comes closest.
  EXPECT_EQ(editor.GetSourceBrightness(kIndex, GreyColor(0.05f)), 0.0f);
  EXPECT_EQ(editor.GetSourceBrightness(kIndex, GreyColor(1.0f)), 1.0f);

  Editor falling;
  falling.SetColorKeyValue(kIndex, 0.2f, Grey(0.9f, true));
  falling.SetColorKeyValue(kIndex, 0.6f, Grey(0.5f));
  falling.SetColorKeyValue(kIndex, 1.0f, Grey(0.1f));
  EXPECT_EQ(falling.GetSourceBrightness(kIndex, GreyColor(0.9f)), 0.2f);
  EXPECT_NEAR(falling.GetSourceBrightness(kIndex, GreyColor(0.3f)), 0.8f, 1e-6);
}

}  // namespace
}  // namespace velkui::ui
