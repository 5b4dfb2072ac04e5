#include <gtest/gtest.h>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/test/GoldenImage.h>
#include <velkui/ui/Theme.h>

#include "LayoutPanel.h"
#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

// The dividers draw with the theme's colours.
struct ScopedTheme {
  ScopedTheme() { ui::Theme::Initialize(std::make_unique<ui::Theme>()); }
  ~ScopedTheme() { ui::Theme::Terminate(); }
  ScopedTheme(const ScopedTheme&) = delete;
  ScopedTheme& operator=(const ScopedTheme&) = delete;
};

::testing::AssertionResult RendersAsGolden(gallery::LayoutPanel& panel, std::int32_t width,
                                           std::int32_t height, const std::string& name) {
  const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  const auto surface = supplier->NewSurface(width, height, false);
  pictel::Pictel context(supplier.get(), surface.get());
  panel.Draw(context);
  return velkui::test::MatchesGolden(*surface->GetSurfaceImage(), VELKUI_TEST_DATA_DIR "/golden",
                                     name, {2, 0.0});
}

// The same panel, made wide and then narrow: the cards flip from a row to a column and the
// tools wrap onto more lines.
TEST(LayoutPanelGoldenTest, ReflowsWhenResized) {
  const ScopedTheme theme;
  gallery::LayoutPanel panel(600, 240);
  EXPECT_TRUE(RendersAsGolden(panel, 600, 240, "layout_panel_wide"));
  const RectT<float> cardsWide = panel.Cards()->UI_GetLocalRectF(true);
  EXPECT_LT(cardsWide.height, 100);

  panel.Resize(260, 520);
  EXPECT_TRUE(RendersAsGolden(panel, 260, 520, "layout_panel_narrow"));
  const RectT<float> cardsNarrow = panel.Cards()->UI_GetLocalRectF(true);
  EXPECT_LT(cardsNarrow.width, 200);
  EXPECT_LE(panel.Tools()->UI_GetLocalRectF(true).width, 236);

  // And back: the layout does not depend on the way there.
  panel.Resize(600, 240);
  EXPECT_EQ(panel.Cards()->UI_GetLocalRectF(true), cardsWide);
}

}  // namespace
}  // namespace velkui::layout::test
