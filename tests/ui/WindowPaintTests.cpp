#include <gtest/gtest.h>

#include <velkui/test/PixelProbe.h>
#include <velkui/ui/OS_PopupWindow.h>
#include <velkui/ui/OS_ViewContainer.h>
#include <velkui/ui/Theme.h>

#include "WindowTestSupport.h"

namespace velkui::ui::test {
namespace {

using velkui::test::Pixel;
using velkui::test::PixelProbe;

constexpr Pixel kBlack{0, 0, 0, 255};

class WindowPaintTest : public WindowTest {
 protected:
  OS_WindowP window = MakeWindow({50, 50, 200, 100});

  PixelProbe Pixels(OS_Window& w) { return PixelProbe(*headless.GetWindowImage(Handle(w))); }
  static Pixel ToPixel(const pictel::ColorRGBA& c) {
    const auto byte = [](float v) { return static_cast<std::uint8_t>(std::lround(v * 255.0f)); };
    return {byte(c.red), byte(c.green), byte(c.blue), byte(c.alpha)};
  }
};

TEST_F(WindowPaintTest, TheWindowPaintsItsBackgroundAndItsTree) {
  auto view = View(window.get(), {20, 10, 30, 40}, "view");
  view->paints = true;
  headless.ProcessEvents();
  const PixelProbe pixels = Pixels(*window);
  EXPECT_EQ(pixels.Count(kBlack, 0, 0, 200, 100), 30 * 40);
  EXPECT_EQ(pixels.At(20, 10), kBlack);
  EXPECT_EQ(pixels.At(49, 49), kBlack);
  // The background is the theme's window colour.
  EXPECT_EQ(pixels.At(100, 50), ToPixel(Theme::Get().GetColor(4)));
  window->SetBackgroundColor(pictel::ColorRGBA{1, 0, 0, 1});
  headless.ProcessEvents();
  EXPECT_EQ(Pixels(*window).At(100, 50), (Pixel{255, 0, 0, 255}));
}

TEST_F(WindowPaintTest, InvalidationsAccumulateIntoOneRepaint) {
  auto a = View(window.get(), {0, 0, 10, 10}, "a");
  auto b = View(window.get(), {100, 50, 10, 10}, "b");
  headless.ProcessEvents();
  const std::int32_t before = headless.GetPaintCount(Handle(*window));
  a->paints = true;
  a->UI_Invalidate(nullptr, InvalidateFlags{});
  b->paints = true;
  b->UI_Invalidate(nullptr, InvalidateFlags{});
  a->UI_Invalidate(nullptr, InvalidateFlags{});
  EXPECT_EQ(headless.GetPendingPaintBounds(Handle(*window)), (RectT<std::int32_t>{0, 0, 110, 60}));
  ClearLog();
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetPaintCount(Handle(*window)), before + 1);
  // Only what was asked for is drawn again.
  EXPECT_EQ(std::count(log->begin(), log->end(), "a:draw"), 1);
  EXPECT_EQ(std::count(log->begin(), log->end(), "b:draw"), 1);
  EXPECT_EQ(Pixels(*window).Count(kBlack, 0, 0, 200, 100), 200);
  // Nothing pending: no paint at all.
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetPaintCount(Handle(*window)), before + 1);
}

TEST_F(WindowPaintTest, UpdateNowPaintsAtOnce) {
  auto view = View(window.get(), {0, 0, 10, 10}, "view");
  headless.ProcessEvents();
  view->paints = true;
  view->UI_Invalidate(nullptr, InvalidateFlags{});
  EXPECT_NE(Pixels(*window).At(5, 5), kBlack);
  view->UI_UpdateNow(UpdateFlags{});
  EXPECT_EQ(Pixels(*window).At(5, 5), kBlack);
  EXPECT_FALSE(headless.HasPendingPaint(Handle(*window)));
}

TEST_F(WindowPaintTest, AnEmptyOrHiddenWindowPaintsNothing) {
  auto empty = MakeWindow({300, 300, 0, 0});
  OS_Event paint(Handle(*empty), kMsgPaint, 0, 0, 0);
  EXPECT_FALSE(empty->UI_Paint(&paint));
  window->UI_Show(false);
  window->UI_Invalidate(nullptr, InvalidateFlags{});
  const std::int32_t before = headless.GetPaintCount(Handle(*window));
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetPaintCount(Handle(*window)), before);
  // Shown again, it paints what it missed.
  window->UI_Show(true);
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetPaintCount(Handle(*window)), before + 1);
}

TEST_F(WindowPaintTest, AThemeChangeRepaintsTheWindow) {
  headless.ProcessEvents();
  Theme& theme = Theme::Get();
  theme.SetColor(4, {0, 0, 1, 1});
  theme.NotifyThemeChanged();
  EXPECT_TRUE(headless.HasPendingPaint(Handle(*window)));
  headless.ProcessEvents();
  EXPECT_EQ(Pixels(*window).At(1, 1), (Pixel{0, 0, 255, 255}));
  theme.Update();
  theme.NotifyThemeChanged();
}

TEST_F(WindowPaintTest, EmbeddedWindowsPaintTheirOwnPixelsAndAreClippedFromTheHost) {
  auto holder = View(window.get(), {10, 10, 180, 80}, "holder");
  auto container = MakeView<OS_ViewContainer>(holder.get(), {20, 20, 40, 30});
  container->SetBackgroundColor(pictel::ColorRGBA{0, 1, 0, 1});
  holder->paints = true;
  headless.ProcessEvents();
  const PlatformWindow child = Handle(*container);
  ASSERT_NE(child, kNoPlatformWindow);
  EXPECT_EQ(PixelProbe(*headless.GetWindowImage(child)).At(5, 5), (Pixel{0, 255, 0, 255}));
  // The host's own paint leaves the child's area alone.
  const PixelProbe host = Pixels(*window);
  EXPECT_EQ(host.At(15, 15), kBlack);
  EXPECT_EQ(host.Count(kBlack, 30, 30, 40, 30), 0);
  // On screen the child lies over its host.
  const PixelProbe screen(*headless.RenderScreen());
  EXPECT_EQ(screen.At(90, 90), (Pixel{0, 255, 0, 255}));
  EXPECT_EQ(screen.At(65, 65), kBlack);
}

TEST_F(WindowPaintTest, APopupDrawsWithItsOwnSupplier) {
  auto popup = velkcore::MakeIntrusive<OS_PopupWindow>();
  popup->UI_CreatePopupWindow({400, 400, 60, 20});
  EXPECT_NE(popup->UI_GetDrawSupplier(), window->UI_GetDrawSupplier());
  popup->UI_Show(true);
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetPaintCount(Handle(*popup)), 1);
  EXPECT_EQ(headless.GetFrameRect(Handle(*popup)), (RectT<std::int32_t>{400, 400, 60, 20}));
  // Showing a pop-up leaves the active window as it was.
  EXPECT_EQ(headless.GetActiveWindow(), Handle(*window));
}

}  // namespace
}  // namespace velkui::ui::test
