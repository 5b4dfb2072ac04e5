#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/test/PixelProbe.h>
#include <velkui/ui/OS_ToolTip.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_ToolTipManager.h>

#include "WindowTestSupport.h"

namespace velkui::ui::test {
namespace {

using velkui::test::Pixel;
using velkui::test::PixelProbe;

class ToolTipTest : public WindowTest {
 protected:
  OS_WindowP window = MakeWindow({100, 100, 400, 300});
  LoggingViewP gain = Tipped({10, 10, 60, 20}, "gain", u"Gain");
  LoggingViewP pan = Tipped({100, 10, 60, 20}, "pan", u"Pan");
  LoggingViewP plain = View(window.get(), {200, 10, 60, 20}, "plain");
  UI_ToolTipManager& tips = *session.GetNodeManager().GetToolTipManager();

  LoggingViewP Tipped(const RectT<float>& frame, const std::string& name,
                      const std::u16string& tip) {
    LoggingViewP view = View(window.get(), frame, name);
    view->UI_SetToolTip(tip, 0);
    return view;
  }
  void Hover(UI_Node& node) {
    const RectT<float> r = node.UI_LocalToGlobalF(node.UI_GetLocalRectF(false));
    MoveTo(*window, static_cast<std::int32_t>(r.left + r.width / 2),
           static_cast<std::int32_t>(r.top + r.height / 2));
    headless.ProcessEvents();
  }
  bool Shows(const UI_Node& node) const { return tips.OwnerOfDisplayedTip(&node); }
  OS_ToolTip* Tip() const { return dynamic_cast<OS_ToolTip*>(tips.GetDisplayedTip()); }
};

TEST_F(ToolTipTest, ATipAppearsAfterTheInitialDelayInAThemedPopup) {
  Hover(*gain);
  headless.RunFor(0.74);
  EXPECT_FALSE(Shows(*gain));
  headless.RunFor(0.02);
  ASSERT_TRUE(Shows(*gain));
  OS_ToolTip* tip = Tip();
  ASSERT_NE(tip, nullptr);
  EXPECT_EQ(tip->GetText(), u"Gain");
  OS_PopupWindow* popup = tip->GetWindow();
  ASSERT_NE(popup, nullptr);
  const PlatformWindow handle = Handle(*popup);
  EXPECT_TRUE(headless.IsWindowVisible(handle));
  // Below the pointer, without taking activation.
  const PointT<std::int32_t> pointer = headless.GetPointerPosition();
  const RectT<std::int32_t> frame = headless.GetFrameRect(handle);
  EXPECT_EQ(frame.left, pointer.x);
  EXPECT_EQ(frame.top, pointer.y + 20);
  EXPECT_EQ(headless.GetActiveWindow(), Handle(*window));
  // Drawn in the theme's tooltip colours, transparent beyond its corners.
  const PixelProbe pixels(*headless.GetWindowImage(handle));
  const pictel::ColorRGBA background = Theme::Get().GetColor(130);
  const auto byte = [](float v) { return static_cast<std::uint8_t>(std::lround(v * 255.0f)); };
  EXPECT_EQ(pixels.At(3, frame.height / 2),
            (Pixel{byte(background.red), byte(background.green), byte(background.blue), 255}));
  EXPECT_EQ(pixels.At(0, 0).alpha, 0);
  EXPECT_GT(pixels.Count(
                Pixel{byte(Theme::Get().GetColor(131).red), byte(Theme::Get().GetColor(131).green),
                      byte(Theme::Get().GetColor(131).blue), 255},
                0, 0, frame.width, frame.height),
            0);
}

TEST_F(ToolTipTest, TheDisplayTimeGrowsWithTheText) {
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(), 5.0);
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(std::u16string(50, u'x')), 5.0);
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(std::u16string(51, u'x')), 10.0);
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(std::u16string(100, u'x')), 10.0);
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(std::u16string(101, u'x')), 20.0);
  // Characters, not UTF-16 units: 50 characters outside the basic plane.
  std::u16string wide;
  for (int i = 0; i < 50; ++i) wide += u"\U0001F3B5";
  EXPECT_EQ(UI_ToolTipManager::GetDisplayTime(wide), 5.0);

  gain->UI_SetToolTip(std::u16string(51, u'g'), 0);
  Hover(*gain);
  headless.RunFor(0.76);
  ASSERT_TRUE(Shows(*gain));
  headless.RunFor(9.9);
  EXPECT_TRUE(Shows(*gain));
  headless.RunFor(0.2);
  EXPECT_FALSE(Shows(*gain));
  // It stays away while the pointer stays.
  headless.RunFor(5);
  EXPECT_FALSE(Shows(*gain));
}

TEST_F(ToolTipTest, MovingOnSoonAfterATipWentShowsTheNextAtOnce) {
  Hover(*gain);
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*gain));
  Hover(*plain);
  EXPECT_FALSE(Shows(*gain));
  headless.RunFor(0.3);
  Hover(*pan);
  // Only the platform's shortest timer interval.
  headless.RunFor(0.02);
  EXPECT_TRUE(Shows(*pan));
  // Long after the last tip, the full delay applies again.
  Hover(*plain);
  headless.RunFor(0.4);
  Hover(*gain);
  headless.RunFor(0.5);
  EXPECT_FALSE(Shows(*gain));
  headless.RunFor(0.3);
  EXPECT_TRUE(Shows(*gain));
}

TEST_F(ToolTipTest, AClickOrAKeyPressDismissesTheTipUntilThePointerMovesOn) {
  Hover(*gain);
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*gain));
  headless.Click();
  headless.ProcessEvents();
  EXPECT_FALSE(Shows(*gain));
  headless.RunFor(6);
  EXPECT_FALSE(Shows(*gain));
  // Pressed before the delay ran out: the pending tip goes too.
  Hover(*pan);
  headless.RunFor(0.3);
  window->UI_Activate();
  headless.TypeKey('A');
  headless.RunFor(1);
  EXPECT_FALSE(Shows(*pan));
}

TEST_F(ToolTipTest, NoTipsDuringACaptureOrWhileTheApplicationIsInactive) {
  Hover(*gain);
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*gain));
  auto capture = velkcore::MakeIntrusive<LoggingCapture>(gain.get(),
                                                         Mouse(MouseEvent::kButtonDown, 1, 1), log);
  session.GetNodeManager().BeginInputCapture(capture);
  EXPECT_FALSE(Shows(*gain));
  EXPECT_TRUE(tips.IsSuspended());
  gain->UI_DisplayToolTip(true);
  EXPECT_FALSE(Shows(*gain));
  session.GetNodeManager().EndInputCapture(false);
  EXPECT_FALSE(tips.IsSuspended());

  Hover(*pan);
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*pan));
  headless.DeactivateApplication();
  headless.ProcessEvents();
  EXPECT_FALSE(Shows(*pan));
  EXPECT_FALSE(tips.CanShowTips());
  window->UI_Activate();
  headless.ProcessEvents();
  EXPECT_TRUE(tips.CanShowTips());
}

TEST_F(ToolTipTest, ChangingTheTextOfTheShownTipUpdatesItInPlace) {
  Hover(*gain);
  headless.RunFor(0.8);
  OS_ToolTip* tip = Tip();
  ASSERT_NE(tip, nullptr);
  const PlatformWindow handle = Handle(*tip->GetWindow());
  const std::int32_t narrow = headless.GetFrameRect(handle).width;
  gain->UI_SetToolTip(u"Gain of the selected channel in decibels", 0);
  EXPECT_EQ(Tip(), tip);
  EXPECT_EQ(tip->GetText(), u"Gain of the selected channel in decibels");
  EXPECT_GT(headless.GetFrameRect(handle).width, narrow);
  // A width wraps the text: narrower and taller.
  gain->UI_SetToolTip(u"Gain of the selected channel in decibels, before the fader", 80);
  ASSERT_NE(Tip(), nullptr);
  EXPECT_LE(headless.GetFrameRect(Handle(*Tip()->GetWindow())).width, 80 + 2 * 7 + 1);
  EXPECT_GT(headless.GetFrameRect(Handle(*Tip()->GetWindow())).height, 30);
  gain->UI_SetToolTip(u"", 0);
  EXPECT_FALSE(Shows(*gain));
}

TEST_F(ToolTipTest, ADyingOwnerTakesItsTipWithIt) {
  Hover(*gain);
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*gain));
  OS_PopupWindow* popup = Tip()->GetWindow();
  const PlatformWindow handle = Handle(*popup);
  window->ChildRemove(gain.get());
  gain.reset();
  EXPECT_EQ(tips.GetDisplayedTip(), nullptr);
  headless.RunFor(1);
  EXPECT_FALSE(headless.IsWindow(handle) && headless.IsWindowVisible(handle));
}

TEST_F(ToolTipTest, AParentMayShowTheTipForItsChildren) {
  class Composite : public LoggingView {
   public:
    using LoggingView::LoggingView;
    bool UI_DisplaysToolTipForChild(const UI_Node*) const override { return true; }
  };
  auto composite = MakeView<Composite>(window.get(), {10, 100, 200, 50}, "composite", log);
  composite->UI_SetToolTip(u"Transport", 0);
  auto part = View(composite.get(), {10, 10, 20, 20}, "part");
  EXPECT_EQ(part->UI_GetToolTipForDisplay(), composite.get());
  EXPECT_EQ(gain->UI_GetToolTipForDisplay(), gain.get());
  Hover(*part);
  headless.RunFor(0.5);
  // The delay applies to a tip shown for a child as well.
  EXPECT_FALSE(Shows(*composite));
  headless.RunFor(0.3);
  EXPECT_TRUE(Shows(*composite));
}

TEST_F(ToolTipTest, DisabledTipsAndFailingFactories) {
  tips.SetTipsEnabled(false);
  Hover(*gain);
  headless.RunFor(1);
  EXPECT_FALSE(Shows(*gain));
  tips.SetTipsEnabled(true);

  UI_ToolTipManager broken;
  const auto error = velkui::test::ErrorOf([&] { broken.DisplayTip(u"text", gain.get(), 0); });
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetCategory(), velkcore::kCategoryUserInterface);
  EXPECT_EQ(error->GetNumber(), 6);
  EXPECT_STREQ(error->what(), "Unknown tool tip error.");
  UI_ToolTipManager nullFactory(
      [](const velkcore::UTF16String&, UI_Node*, std::int32_t) { return UI_ToolTipP(); });
  EXPECT_THROW(nullFactory.DisplayTip(u"text", gain.get(), 0), velkcore::Exception);
}

TEST_F(ToolTipTest, TipsStayOnTheMonitor) {
  headless.SetMonitors({{{0, 0, 800, 600}, {0, 0, 800, 560}, 1, true}});
  auto low = MakeWindow({500, 500, 300, 60});
  auto corner = View(low.get(), {250, 20, 50, 40}, "corner");
  corner->UI_SetToolTip(u"A tooltip with rather more text than fits", 0);
  headless.MovePointer(Screen(*low, 290, 50));
  headless.RunFor(0.8);
  ASSERT_TRUE(Shows(*corner));
  const RectT<std::int32_t> frame = headless.GetFrameRect(Handle(*Tip()->GetWindow()));
  EXPECT_LE(frame.Right(), 800);
  EXPECT_LE(frame.Bottom(), 560);
  // Above the pointer, for want of room below.
  EXPECT_LT(frame.Bottom(), headless.GetPointerPosition().y);
}

}  // namespace
}  // namespace velkui::ui::test
