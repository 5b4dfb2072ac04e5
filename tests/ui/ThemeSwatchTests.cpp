#include <velkui/ui/ThemeSwatch.h>

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

constexpr std::int32_t kColumns = 16;
// 23 rows of 16 cells, each 10 by 10.
constexpr velkcore::RectT<float> kArea{0, 0, 160, 230};

class SwatchPixels {
 public:
  SwatchPixels() : pixels_(kWidth * kHeight * 4, 0) {
    const auto supplier = pictel::NewOSSupplier();
    surface_ = supplier->NewBufferSurface(kWidth, kHeight, kWidth * 4, pictel::PixelLayout::kBGRX,
                                          pixels_.data(), {});
  }

  void Draw(const Theme& theme) {
    DrawThemeSwatches(*surface_, theme, kArea, kColumns);
    surface_->Flush();
  }

  // Red, green and blue of one pixel.
  std::array<int, 3> At(int x, int y) const {
    const std::uint8_t* p = &pixels_[static_cast<std::size_t>((y * kWidth + x) * 4)];
    return {p[2], p[1], p[0]};
  }

 private:
  static constexpr int kWidth = 160;
  static constexpr int kHeight = 230;
  std::vector<std::uint8_t> pixels_;
  boost::intrusive_ptr<pictel::SurfaceInterface> surface_;
};

TEST(ThemeSwatchTest, CellsShowTheThemeColoursOverWhiteAndBlack) {
  Theme theme;
  theme.SetColor(365, {1, 0, 0, 1});
  SwatchPixels chart;
  chart.Draw(theme);

  // 18, opaque: the same on both halves of its cell (column 2, row 1).
  EXPECT_EQ(chart.At(22, 15), (std::array<int, 3>{83, 182, 249}));
  EXPECT_EQ(chart.At(27, 15), (std::array<int, 3>{83, 182, 249}));
  // 0, white at three quarters: unchanged over white, 191 over black.
  EXPECT_EQ(chart.At(2, 5), (std::array<int, 3>{255, 255, 255}));
  const std::array<int, 3> overBlack = chart.At(7, 5);
  EXPECT_NEAR(overBlack[0], 191, 1);
  // 365 is the last cell (column 13, row 22).
  EXPECT_EQ(chart.At(132, 225), (std::array<int, 3>{255, 0, 0}));
  // No cell beyond it.
  EXPECT_EQ(chart.At(145, 225), (std::array<int, 3>{0, 0, 0}));
}

TEST(ThemeSwatchTest, CellsAndHitTestingAgree) {
  EXPECT_EQ(GetThemeSwatchCell(kArea, kColumns, 18), (velkcore::RectT<float>{20, 10, 10, 10}));
  for (const ThemeColorIndex index : {0, 15, 16, 18, 200, 365}) {
    const velkcore::RectT<float> cell = GetThemeSwatchCell(kArea, kColumns, index);
    EXPECT_EQ(FindThemeSwatchIndex(kArea, kColumns, {cell.left + 1, cell.top + 1}),
              static_cast<std::int64_t>(index));
  }
  EXPECT_EQ(FindThemeSwatchIndex(kArea, kColumns, {145, 225}), -1);  // past the last cell
  EXPECT_EQ(FindThemeSwatchIndex(kArea, kColumns, {5, 230}), -1);

  EXPECT_THROW(GetThemeSwatchCell(kArea, 0, 1), velkcore::Exception);
  EXPECT_THROW(GetThemeSwatchCell(kArea, kColumns, kThemePaletteSize), velkcore::Exception);
}

}  // namespace
}  // namespace velkui::ui
