#include <velkui/ui/Theme.h>

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorConversion.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

using pictel::ColorRGBA;

using velkui::test::RaisesContractViolation;

// Tests of the singleton leave no theme installed behind them.
class InstalledThemeTest : public ::testing::Test {
 protected:
  void SetUp() override { Theme::Terminate(); }
  void TearDown() override { Theme::Terminate(); }
};

TEST(ThemePaletteTest, FreshThemeHoldsTheWholePaletteWithItsFixedRows) {
  const Theme theme;
  for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
    ASSERT_EQ(theme.GetColor(index), GetDefaultThemeColor(index)) << index;
  }
  EXPECT_FALSE(theme.HasColor(kThemePaletteSize));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.GetColor(kThemePaletteSize); }));
  EXPECT_TRUE(RaisesContractViolation([] { GetDefaultThemeColor(kThemePaletteSize); }));
}

TEST(ThemeColorTest, BrightnessRebuildsThePaletteButKeepsOtherIndices) {
  Theme theme;
  EXPECT_EQ(theme.GetBrightness(), 0.5f);
  theme.SetColor(4, {1, 0, 0, 1});
  theme.SetColor(400, {0, 1, 0, 1});
  theme.SetBrightness(0.2f);
  EXPECT_EQ(theme.GetBrightness(), 0.2f);
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
  EXPECT_EQ(theme.GetColor(400), (ColorRGBA{0, 1, 0, 1}));
  theme.SetColor(4, {1, 0, 0, 1});
  theme.Update();
  EXPECT_EQ(theme.GetBrightness(), 0.2f);
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));

  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetBrightness(std::nanf("")); }));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetColor(4, {std::nanf(""), 0, 0, 1}); }));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetTinting({0, 0, INFINITY, 1}); }));
  EXPECT_EQ(theme.GetBrightness(), 0.2f);
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
}

TEST(ThemeTintTest, TintColoursGreysKeepsAccentsAndSurvivesBrightness) {
  Theme theme;
  const ColorRGBA tint = pictel::HSBtoRGB(30.0f, 0.25f, 1.0f, 1.0f);
  theme.SetTinting(tint);
  float hue = 0, saturation = 0, value = 0;
  pictel::RGBtoHSB(theme.GetColor(4), hue, saturation, value, false);
  EXPECT_NEAR(hue, 30, 0.5);
  EXPECT_NEAR(saturation, 0.25, 1e-3);
  EXPECT_NEAR(value, 247 / 255.0, 1e-3);
  EXPECT_EQ(theme.GetColor(0).alpha, 0.75f);
  EXPECT_EQ(theme.GetColor(18), GetDefaultThemeColor(18));  // more saturated than the tint
  theme.SetBrightness(0.8f);
  EXPECT_NE(theme.GetColor(4), GetDefaultThemeColor(4));

  theme.SetTinting({tint.red, tint.green, tint.blue, 0.5f});  // half strength
  pictel::RGBtoHSB(theme.GetColor(4), hue, saturation, value, false);
  EXPECT_NEAR(hue, 30, 0.5);
  EXPECT_TRUE(saturation > 0.05f && saturation < 0.25f) << saturation;

  // Black (the default) and white tints change nothing.
  for (const ColorRGBA neutral : {ColorRGBA{0, 0, 0, 1}, ColorRGBA{1, 1, 1, 1}}) {
    theme.SetTinting(neutral);
    for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
      ASSERT_EQ(theme.GetColor(index), GetDefaultThemeColor(index)) << index;
    }
  }
}

TEST(ThemeFontTest, FontsStartWithAnInstalledFaceAtSizeEleven) {
  const Theme theme;
  const velkcore::UTF16String platformFace = pictel::GetPlatformUIFontFamily();
  for (ThemeFontIndex index : {0, 1, 2, 3, 4, 6, 7}) {
    EXPECT_EQ(theme.GetFontName(index), platformFace) << index;
  }
  EXPECT_EQ(theme.GetFontName(5), pictel::HasFontFamily(u"Tahoma") ? u"Tahoma" : platformFace);
  for (ThemeFontIndex index = 0; index < Theme::kDefaultFontCount; ++index) {
    EXPECT_TRUE(pictel::HasFontFamily(theme.GetFontName(index))) << index;
    EXPECT_EQ(theme.GetFontSize(index), 11.0f) << index;
  }
  EXPECT_TRUE(RaisesContractViolation([&] { theme.GetFontName(Theme::kDefaultFontCount); }));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.GetFontSize(Theme::kDefaultFontCount); }));

  const Theme few(3);
  EXPECT_TRUE(few.HasFont(2));
  EXPECT_FALSE(few.HasFont(6));  // the platform face goes only to fonts that exist
  EXPECT_TRUE(RaisesContractViolation([] { Theme tooMany(1'000'000'000); }));
}

TEST(ThemeFontTest, SettersCheckTheirInputAndCreateMissingIndices) {
  Theme theme;
  theme.SetFontSize(20, 9);
  EXPECT_EQ(theme.GetFontName(20), theme.GetFontName(5));
  theme.SetFontName(21, u"DejaVu Serif");
  EXPECT_EQ(theme.GetFontSize(21), 11.0f);
  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetFontName(0, u""); }));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetFontSize(0, 0); }));
  EXPECT_TRUE(RaisesContractViolation([&] { theme.SetFontSize(0, std::nanf("")); }));
  EXPECT_EQ(theme.GetFontSize(0), 11.0f);
}

TEST(ThemeNotifyTest, CountGoesUpBeforeTheFunctionsRunInOrder) {
  Theme theme;
  EXPECT_EQ(theme.GetThemeChangeCount(), 0u);
  std::vector<std::pair<int, std::uint64_t>> calls;
  const auto first = std::make_shared<ThemeChangedFunction>(
      [&] { calls.emplace_back(1, theme.GetThemeChangeCount()); });
  theme.InstallThemeChangedFunction(first);
  theme.InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>(
      [&] { calls.emplace_back(2, theme.GetThemeChangeCount()); }));
  theme.InstallThemeChangedFunction(first);  // already there
  theme.NotifyThemeChanged();
  theme.NotifyThemeChanged();
  EXPECT_TRUE(theme.RemoveThemeChangedFunction(first));
  theme.NotifyThemeChanged();
  const std::vector<std::pair<int, std::uint64_t>> expected{{1, 1}, {2, 1}, {1, 2}, {2, 2}, {2, 3}};
  EXPECT_EQ(calls, expected);

  EXPECT_TRUE(RaisesContractViolation([&] { theme.InstallThemeChangedFunction(nullptr); }));
  theme.InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>());
  EXPECT_THROW(theme.NotifyThemeChanged(), std::bad_function_call);
  EXPECT_EQ(theme.GetThemeChangeCount(), 4u);
}

TEST_F(InstalledThemeTest, InitializeGetTerminate) {
  EXPECT_FALSE(Theme::IsInitialized());
  EXPECT_TRUE(RaisesContractViolation([] { Theme::Get(); }));
  EXPECT_TRUE(RaisesContractViolation([] { Theme::Initialize(nullptr); }));
  EXPECT_TRUE(RaisesContractViolation(
      [] { InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>([] {})); }));
  EXPECT_EQ(GetThemeChangeCount(), 0u);
  Theme::Terminate();  // nothing installed: nothing happens

  auto owned = std::make_unique<Theme>();
  Theme* const theme = owned.get();
  Theme::Initialize(std::move(owned));
  EXPECT_EQ(&Theme::Get(), theme);
  EXPECT_TRUE(RaisesContractViolation([] { Theme::Initialize(std::make_unique<Theme>()); }));
  EXPECT_EQ(&Theme::Get(), theme);

  int calls = 0;
  InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>([&] { ++calls; }));
  const std::uint64_t before = GetThemeChangeCount();
  EXPECT_GT(before, 0u);  // caches made before any theme was installed are stale
  Theme::Get().NotifyThemeChanged();
  EXPECT_EQ(calls, 1);
  EXPECT_EQ(GetThemeChangeCount(), before + 1);

  Theme::Terminate();
  EXPECT_FALSE(Theme::IsInitialized());
  EXPECT_EQ(GetThemeChangeCount(), 0u);
  Theme::Initialize(std::make_unique<Theme>());
  EXPECT_GT(GetThemeChangeCount(), before + 1);  // never a count of the replaced theme
}

TEST_F(InstalledThemeTest, FunctionMayTerminateTheThemeWhileBeingCalled) {
  Theme::Initialize(std::make_unique<Theme>());
  int laterCalls = 0;
  InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>([] { Theme::Terminate(); }));
  InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>([&] { ++laterCalls; }));
  Theme::Get().NotifyThemeChanged();
  EXPECT_FALSE(Theme::IsInitialized());
  EXPECT_EQ(laterCalls, 0);
}

}  // namespace
}  // namespace velkui::ui
