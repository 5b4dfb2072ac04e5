// Buttons in a real window of the headless backend: input arrives as
// native-level events and timers run on the virtual clock.

#include <gtest/gtest.h>

#include <velkui/controls/UI_DisclosureTriangleButton.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/PlatformSession.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

class HeadlessWindowTest : public ::testing::Test {
 protected:
  ui::PlatformSession session{std::make_unique<ui::HeadlessPlatform>()};
  ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
  ui::OS_WindowP window;
  boost::intrusive_ptr<UI_TextButton> button = velkcore::MakeIntrusive<UI_TextButton>(u"Step");
  MessageLog log;

  void SetUp() override {
    window =
        velkcore::MakeIntrusive<ui::OS_Window>(u"Buttons", RectT<std::int32_t>{100, 100, 300, 200},
                                               ui::kStylePopup | ui::kStyleClipSiblings, 0u);
    window->UI_Show(true);
    button->UI_SetLocalRectF({20, 20, 80, 24});
    button->UI_Show(true);
    window->ChildPushBack(button);
    log.Watch(*button);
    headless.ProcessEvents();
  }
  void TearDown() override {
    window->DeleteChildren();
    window.reset();
    headless.ProcessEvents();
  }
  void PointAt(std::int32_t x, std::int32_t y) {
    const RectT<std::int32_t> client = headless.GetClientRect(window->GetPlatformWindow(false));
    headless.MovePointer({client.left + x, client.top + y});
    headless.ProcessEvents();
  }
  int Count(const std::string& prefix) const {
    return static_cast<int>(
        std::count_if(log.Entries().begin(), log.Entries().end(),
                      [&](const std::string& e) { return e.starts_with(prefix); }));
  }
};

TEST_F(HeadlessWindowTest, AHeldButtonRepeatsOnThePlatformTimer) {
  PointAt(30, 30);
  headless.PressButton(1);
  headless.ProcessEvents();
  EXPECT_EQ(log.Entries(), Log{"begin"});
  headless.RunFor(1.0);
  EXPECT_GE(Count("continue"), 14);
  EXPECT_LE(Count("continue"), 16);
  const int repeats = Count("continue");
  headless.ReleaseButton(1);
  headless.ProcessEvents();
  EXPECT_EQ(Count("continue"), repeats);
  EXPECT_EQ(log.Entries()[log.Entries().size() - 2], "changed(0)");
  EXPECT_EQ(log.Entries().back(), "finish");
  EXPECT_FALSE(button->GetDownState());
  // The timer went with the capture: time passing adds nothing.
  headless.RunFor(0.5);
  EXPECT_EQ(Count("continue"), repeats);
}

TEST_F(HeadlessWindowTest, AClickAndTheSpaceBarPressTheButton) {
  auto plain = velkcore::MakeIntrusive<UI_TextButton>(u"Plain");
  plain->UI_SetLocalRectF({150, 20, 80, 24});
  plain->UI_Show(true);
  window->ChildPushBack(plain);
  MessageLog plainLog;
  plainLog.Watch(*plain);
  PointAt(160, 30);
  headless.Click(1);
  headless.ProcessEvents();
  EXPECT_EQ(plainLog.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish"}));
  EXPECT_TRUE(plain->UI_HasKeyboardFocus(true));
  headless.TypeKey(32);
  headless.ProcessEvents();
  EXPECT_EQ(plainLog.Entries().size(), 8u);
}

TEST_F(HeadlessWindowTest, TheTriangleTwirlsOnTheVirtualClock) {
  auto triangle = velkcore::MakeIntrusive<UI_DisclosureTriangleButton>(u"More");
  triangle->UI_SetLocalRectF({20, 60, 80, 20});
  triangle->UI_Show(true);
  window->ChildPushBack(triangle);
  PointAt(25, 70);
  headless.Click(1);
  headless.ProcessEvents();
  EXPECT_TRUE(triangle->IsOpen());
  headless.RunFor(0.075);
  EXPECT_NEAR(triangle->GetCurrentAngle(), 45.0f, 3.0f);
  headless.RunFor(0.2);
  EXPECT_EQ(triangle->GetCurrentAngle(), 90.0f);
  EXPECT_TRUE(triangle->UI_GetTimerList().empty() || !triangle->UI_GetTimerList()[0]->IsLive());
}

}  // namespace
}  // namespace velkui::controls::test
