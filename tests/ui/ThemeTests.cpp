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
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

using pictel::ColorRGBA;

std::optional<velkcore::Exception> ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const velkcore::Exception& e) {
    return e;
  }
  return std::nullopt;
}

void ExpectContractViolation(const std::function<void()>& action) {
  const auto error = ErrorOf(action);
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetLevel(), velkcore::ErrorLevel::kContractViolation);
  EXPECT_EQ(error->GetNumber(), velkcore::kInputContractViolationNumber);
}

ColorRGBA Bytes(int r, int g, int b, float a = 1) {
  return {r / 255.0f, g / 255.0f, b / 255.0f, a};
}

// Tests of the singleton leave no theme installed behind them.
class InstalledThemeTest : public ::testing::Test {
 protected:
  void SetUp() override { Theme::Terminate(); }
  void TearDown() override { Theme::Terminate(); }
};

TEST(ThemePaletteTest, FreshThemeHoldsTheWholePaletteWithItsFixedRows) {
  const Theme theme;
  for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
    ASSERT_TRUE(theme.HasColor(index)) << index;
    EXPECT_EQ(theme.GetColor(index), GetDefaultThemeColor(index)) << index;
  }
  EXPECT_FALSE(theme.HasColor(kThemePaletteSize));

  EXPECT_EQ(theme.GetColor(0), (ColorRGBA{1, 1, 1, 0.75f}));
  EXPECT_EQ(theme.GetColor(1), Bytes(38, 38, 38));
  EXPECT_EQ(theme.GetColor(2), (ColorRGBA{1, 1, 1, 1}));
  EXPECT_EQ(theme.GetColor(3), Bytes(199, 199, 199));
  EXPECT_EQ(theme.GetColor(4), Bytes(247, 247, 247));
  EXPECT_EQ(theme.GetColor(6), Bytes(224, 224, 224));
  EXPECT_EQ(theme.GetColor(15), Bytes(223, 223, 223, 0.5f));
  EXPECT_EQ(theme.GetColor(18), Bytes(83, 182, 249));
}

TEST(ThemePaletteTest, RowsAreOrderedWithRolesAndWholeByteComponents) {
  ThemeColorIndex next = 0;
  for (const ThemePaletteRow& row : GetDefaultThemePalette()) {
    EXPECT_EQ(row.first, next);
    EXPECT_GE(row.last, row.first);
    next = row.last + 1;
    ASSERT_NE(row.role, nullptr);
    EXPECT_STRNE(row.role, "");
    for (const float c : {row.color.red, row.color.green, row.color.blue}) {
      const float bytes = c * 255.0f;
      EXPECT_NEAR(bytes, std::round(bytes), 1e-3) << row.first;
      EXPECT_TRUE(c >= 0 && c <= 1) << row.first;
    }
    EXPECT_TRUE(row.color.alpha > 0 && row.color.alpha <= 1) << row.first;
  }
  EXPECT_EQ(next, kThemePaletteSize);
  EXPECT_STREQ(GetDefaultThemeColorRole(18), "focus ring");
  ExpectContractViolation([] { GetDefaultThemeColor(kThemePaletteSize); });
}

TEST(ThemeColorTest, UnknownIndexIsAContractViolation) {
  const Theme theme;
  ExpectContractViolation([&] { theme.GetColor(kThemePaletteSize); });
  ExpectContractViolation([&] { theme.GetColor(~ThemeColorIndex{0}); });
}

TEST(ThemeColorTest, BrightnessRebuildsThePaletteButKeepsOtherIndices) {
  Theme theme;
  EXPECT_EQ(theme.GetBrightness(), GetDefaultBrightness());
  EXPECT_EQ(GetDefaultBrightness(), 0.5f);

  theme.SetColor(4, {1, 0, 0, 1});
  theme.SetColor(400, {0, 1, 0, 1});
  EXPECT_EQ(theme.GetColor(4), (ColorRGBA{1, 0, 0, 1}));

  theme.SetBrightness(0.2f);
  EXPECT_EQ(theme.GetBrightness(), 0.2f);
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
  EXPECT_EQ(theme.GetColor(400), (ColorRGBA{0, 1, 0, 1}));

  theme.SetColor(4, {1, 0, 0, 1});
  theme.Update();
  EXPECT_EQ(theme.GetBrightness(), 0.2f);
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
}

TEST(ThemeColorTest, NonFiniteInputIsRefusedAndChangesNothing) {
  Theme theme;
  ExpectContractViolation([&] { theme.SetBrightness(std::nanf("")); });
  ExpectContractViolation([&] { theme.SetBrightness(INFINITY); });
  EXPECT_EQ(theme.GetBrightness(), 0.5f);
  ExpectContractViolation([&] { theme.SetColor(4, {std::nanf(""), 0, 0, 1}); });
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
  ExpectContractViolation([&] { theme.SetTinting({0, 0, INFINITY, 1}); });
  EXPECT_EQ(theme.GetTinting(), (ColorRGBA{0, 0, 0, 1}));
}

TEST(ThemeTintTest, DefaultTintLeavesThePaletteAlone) {
  Theme theme;
  theme.SetTinting({0, 0, 0, 1});
  theme.SetTinting({1, 1, 1, 1});
  for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
    ASSERT_EQ(theme.GetColor(index), GetDefaultThemeColor(index)) << index;
  }
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
  EXPECT_GT(saturation, 0.05);
  EXPECT_LT(saturation, 0.25);

  theme.SetTinting({0, 0, 0, 1});
  EXPECT_EQ(theme.GetColor(4), GetDefaultThemeColor(4));
}

TEST(ThemeFontTest, FontsStartWithAnInstalledFaceAtSizeEleven) {
  const Theme theme;
  const velkcore::UTF16String platformFace = pictel::GetPlatformUIFontFamily();
  for (ThemeFontIndex index : {0, 1, 2, 3, 4, 6, 7}) {
    EXPECT_EQ(theme.GetFontName(index), platformFace) << index;
  }
  const velkcore::UTF16String fontFive = theme.GetFontName(5);
  EXPECT_EQ(fontFive, pictel::HasFontFamily(u"Tahoma") ? u"Tahoma" : platformFace);
  for (ThemeFontIndex index = 0; index < Theme::kDefaultFontCount; ++index) {
    EXPECT_TRUE(pictel::HasFontFamily(theme.GetFontName(index))) << index;
    EXPECT_EQ(theme.GetFontSize(index), 11.0f) << index;
  }
  EXPECT_FALSE(theme.HasFont(Theme::kDefaultFontCount));
  ExpectContractViolation([&] { theme.GetFontName(Theme::kDefaultFontCount); });
  ExpectContractViolation([&] { theme.GetFontSize(Theme::kDefaultFontCount); });
}

TEST(ThemeFontTest, FontCountBoundsTheIndicesThatExist) {
  const Theme few(3);
  EXPECT_TRUE(few.HasFont(2));
  EXPECT_FALSE(few.HasFont(3));
  EXPECT_FALSE(few.HasFont(6));

  const Theme many(12);
  EXPECT_TRUE(many.HasFont(11));
  EXPECT_EQ(many.GetFontName(11), many.GetFontName(5));
  EXPECT_EQ(many.GetFontSize(11), 11.0f);

  ExpectContractViolation([] { Theme tooMany(1'000'000'000); });
}

TEST(ThemeFontTest, SettersCheckTheirInputAndCreateMissingIndices) {
  Theme theme;
  theme.SetFontName(2, u"DejaVu Sans Mono");
  theme.SetFontSize(2, 14.5f);
  EXPECT_EQ(theme.GetFontName(2), u"DejaVu Sans Mono");
  EXPECT_EQ(theme.GetFontSize(2), 14.5f);

  theme.SetFontSize(20, 9);
  EXPECT_TRUE(theme.HasFont(20));
  EXPECT_EQ(theme.GetFontName(20), theme.GetFontName(5));
  theme.SetFontName(21, u"DejaVu Serif");
  EXPECT_EQ(theme.GetFontSize(21), 11.0f);

  ExpectContractViolation([&] { theme.SetFontName(0, u""); });
  ExpectContractViolation([&] { theme.SetFontSize(0, 0); });
  ExpectContractViolation([&] { theme.SetFontSize(0, -3); });
  ExpectContractViolation([&] { theme.SetFontSize(0, std::nanf("")); });
  EXPECT_EQ(theme.GetFontSize(0), 11.0f);
}

TEST(ThemeNotifyTest, CountGoesUpBeforeTheFunctionsRunInOrder) {
  Theme theme;
  EXPECT_EQ(theme.GetThemeChangeCount(), 0u);
  std::vector<std::pair<int, std::uint64_t>> calls;
  const auto first = std::make_shared<ThemeChangedFunction>(
      [&] { calls.emplace_back(1, theme.GetThemeChangeCount()); });
  const auto second = std::make_shared<ThemeChangedFunction>(
      [&] { calls.emplace_back(2, theme.GetThemeChangeCount()); });
  theme.InstallThemeChangedFunction(first);
  theme.InstallThemeChangedFunction(second);
  theme.InstallThemeChangedFunction(first);  // already there

  theme.NotifyThemeChanged();
  theme.NotifyThemeChanged();
  const std::vector<std::pair<int, std::uint64_t>> expected{{1, 1}, {2, 1}, {1, 2}, {2, 2}};
  EXPECT_EQ(calls, expected);

  EXPECT_TRUE(theme.RemoveThemeChangedFunction(first));
  EXPECT_FALSE(theme.RemoveThemeChangedFunction(first));
  calls.clear();
  theme.NotifyThemeChanged();
  EXPECT_EQ(calls, (std::vector<std::pair<int, std::uint64_t>>{{2, 3}}));
}

TEST(ThemeNotifyTest, EmptyFunctionRaisesBadFunctionCallAfterCounting) {
  Theme theme;
  ExpectContractViolation([&] { theme.InstallThemeChangedFunction(nullptr); });
  theme.InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>());
  EXPECT_THROW(theme.NotifyThemeChanged(), std::bad_function_call);
  EXPECT_EQ(theme.GetThemeChangeCount(), 1u);
}

TEST(ThemeNotifyTest, FunctionMayRemoveAnotherThatHasNotRunYet) {
  Theme theme;
  int laterCalls = 0;
  const auto later = std::make_shared<ThemeChangedFunction>([&] { ++laterCalls; });
  theme.InstallThemeChangedFunction(
      std::make_shared<ThemeChangedFunction>([&] { theme.RemoveThemeChangedFunction(later); }));
  theme.InstallThemeChangedFunction(later);
  theme.NotifyThemeChanged();
  EXPECT_EQ(laterCalls, 0);
}

TEST_F(InstalledThemeTest, InitializeGetTerminate) {
  EXPECT_FALSE(Theme::IsInitialized());
  ExpectContractViolation([] { Theme::Get(); });
  ExpectContractViolation([] { Theme::Initialize(nullptr); });
  EXPECT_EQ(GetThemeChangeCount(), 0u);
  ExpectContractViolation(
      [] { InstallThemeChangedFunction(std::make_shared<ThemeChangedFunction>([] {})); });
  Theme::Terminate();  // nothing installed: nothing happens

  auto owned = std::make_unique<Theme>();
  Theme* const theme = owned.get();
  Theme::Initialize(std::move(owned));
  EXPECT_EQ(&Theme::Get(), theme);
  ExpectContractViolation([] { Theme::Initialize(std::make_unique<Theme>()); });
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
}

TEST_F(InstalledThemeTest, ReplacementThemeNeverRepeatsAnEarlierCount) {
  Theme::Initialize(std::make_unique<Theme>());
  for (int i = 0; i < 5; ++i) Theme::Get().NotifyThemeChanged();
  const std::uint64_t retired = GetThemeChangeCount();
  Theme::Terminate();

  Theme::Initialize(std::make_unique<Theme>());
  EXPECT_GT(GetThemeChangeCount(), retired);
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
