#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/ui/HeadlessPlatform.h>

namespace velkui::ui::test {
namespace {

using velkcore::PointT;
using velkcore::RectT;

// The backend on its own: messages are taken straight from its queue.
class HeadlessPlatformTest : public ::testing::Test {
 protected:
  HeadlessPlatform platform;

  PlatformWindow Window(const RectT<std::int32_t>& frame, std::uint32_t style = kStylePopup,
                        std::uint32_t exStyle = 0, PlatformWindow parent = kNoPlatformWindow) {
    WindowCreateParams params;
    params.frame = frame;
    params.style = style;
    params.exStyle = exStyle;
    params.parent = parent;
    const PlatformWindow window = platform.CreateWindow(params);
    platform.ShowWindow(window, true, (style & kStyleChild) == 0);
    return window;
  }
  // Takes every waiting message (paints excepted), translating key presses.
  std::vector<OS_Event> Drain() {
    std::vector<OS_Event> events;
    OS_Event event;
    while (platform.GetNextEvent(event, true)) {
      if (event.GetMsg() == kMsgPaint) {
        if (auto target = platform.BeginPaint(event.GetWindow())) {
          platform.EndPaint(event.GetWindow(), *target);
        }
        continue;
      }
      platform.TranslateEvent(event);
      events.push_back(event);
    }
    return events;
  }
  std::vector<std::uint32_t> Messages(const std::vector<OS_Event>& events,
                                      bool keyboardOnly = false) {
    std::vector<std::uint32_t> messages;
    for (const OS_Event& e : events) {
      if (!keyboardOnly || IsKeyboardMessage(e.GetMsg())) messages.push_back(e.GetMsg());
    }
    return messages;
  }
  std::u16string Characters(const std::vector<OS_Event>& events) {
    std::u16string text;
    for (const OS_Event& e : events) {
      if (IsCharacterMessage(e.GetMsg())) text += static_cast<char16_t>(e.GetWParam());
    }
    return text;
  }
};

TEST_F(HeadlessPlatformTest, DecorationFollowsTheStyle) {
  const PlatformWindow plain = Window({10, 20, 100, 50});
  const PlatformWindow caption = Window({10, 20, 100, 50}, kStyleCaption);
  const PlatformWindow sizing = Window({10, 20, 100, 50}, kStyleOverlappedWindow);
  EXPECT_EQ(platform.GetClientRect(plain), (RectT<std::int32_t>{10, 20, 100, 50}));
  EXPECT_EQ(platform.GetClientRect(caption), (RectT<std::int32_t>{11, 45, 98, 24}));
  EXPECT_EQ(platform.GetClientRect(sizing), (RectT<std::int32_t>{14, 48, 92, 18}));
  EXPECT_EQ(platform.GetFrameRect(sizing), (RectT<std::int32_t>{10, 20, 100, 50}));
  const PlatformWindow child = Window({20, 50, 30, 10}, kStyleChild, 0, caption);
  EXPECT_EQ(platform.GetClientRect(child), (RectT<std::int32_t>{20, 50, 30, 10}));
  platform.SetFrameRect(caption, {110, 120, 100, 50});
  EXPECT_EQ(platform.GetClientRect(child), (RectT<std::int32_t>{120, 150, 30, 10}));
  EXPECT_THROW(Window({0, 0, 1, 1}, kStyleChild), velkcore::Exception);
  EXPECT_THROW(Window({0, 0, -1, 1}), velkcore::Exception);
}

TEST_F(HeadlessPlatformTest, ThePointerReachesTheDeepestShownWindowUnderIt) {
  const PlatformWindow back = Window({0, 0, 300, 300});
  const PlatformWindow front = Window({100, 100, 300, 300}, kStyleCaption);
  const PlatformWindow child = Window({150, 150, 50, 50}, kStyleChild, 0, front);
  EXPECT_EQ(platform.GetWindowFromPoint({50, 50}), back);
  // The title bar of the front window hides what lies below it.
  EXPECT_EQ(platform.GetWindowFromPoint({150, 110}), kNoPlatformWindow);
  EXPECT_EQ(platform.GetWindowFromPoint({160, 160}), child);
  platform.ShowWindow(child, false, false);
  EXPECT_EQ(platform.GetWindowFromPoint({160, 160}), front);
  platform.MinimizeWindow(front, true);
  EXPECT_EQ(platform.GetWindowFromPoint({160, 160}), back);
  // A disabled window gets no pointer messages.
  platform.EnableWindow(back, false);
  Drain();
  platform.MovePointer({20, 20});
  platform.Click();
  EXPECT_TRUE(Drain().empty());
}

TEST_F(HeadlessPlatformTest, DoubleClicksAreTheBackendsWithinTimeAndPlace) {
  const PlatformWindow window = Window({0, 0, 200, 200});
  Drain();
  platform.MovePointer({50, 50});
  const auto clicks = [&] {
    std::vector<std::uint32_t> presses;
    for (const OS_Event& e : Drain()) {
      if (e.GetMsg() != kMsgPointerMove && e.GetMsg() != kMsgLeftButtonUp &&
          e.GetMsg() != kMsgRightButtonUp) {
        presses.push_back(e.GetMsg());
      }
    }
    return presses;
  };
  platform.Click();
  platform.AdvanceTime(0.2);
  platform.Click();
  platform.AdvanceTime(0.2);
  platform.Click();
  EXPECT_EQ(clicks(), (std::vector<std::uint32_t>{kMsgLeftButtonDown, kMsgLeftButtonDoubleClick,
                                                  kMsgLeftButtonDown}));
  platform.AdvanceTime(0.6);
  platform.Click();
  platform.AdvanceTime(0.1);
  platform.Click(4);
  platform.AdvanceTime(0.1);
  platform.MovePointer({53, 50});
  platform.Click(4);
  // Too late for the left button; the right one moved beyond half the rectangle.
  EXPECT_EQ(clicks(), (std::vector<std::uint32_t>{kMsgLeftButtonDown, kMsgRightButtonDown,
                                                  kMsgRightButtonDown}));
  platform.SetDoubleClickSize(8, 8);
  platform.AdvanceTime(0.1);
  platform.Click(4);
  EXPECT_EQ(clicks(), (std::vector<std::uint32_t>{kMsgRightButtonDoubleClick}));
  (void)window;
}

TEST_F(HeadlessPlatformTest, KeyStateFollowsTheMessagesTaken) {
  const PlatformWindow window = Window({0, 0, 100, 100});
  Drain();
  ASSERT_EQ(platform.GetFocus(), window);
  platform.PressKey(vk::kShift);
  platform.PressKey(vk::kCapsLock);
  platform.PressKey(vk::kAlt, true);
  EXPECT_FALSE(platform.GetKeyState(vk::kShift).down);
  EXPECT_TRUE(platform.GetModifierKeys().IsEmpty());
  Drain();
  EXPECT_TRUE(platform.GetKeyState(vk::kLeftShift).down);
  EXPECT_TRUE(platform.GetKeyState(vk::kRightAlt).down);
  EXPECT_FALSE(platform.GetKeyState(vk::kLeftAlt).down);
  EXPECT_EQ(platform.GetModifierKeys(),
            ModifierKeys(kModifierShift | kModifierCapsLock | kModifierAlt));
  // A lock stays on after its key is released and goes off with the next press.
  platform.ReleaseKey(vk::kCapsLock);
  platform.TypeKey(vk::kCapsLock);
  platform.ReleaseKey(vk::kShift);
  platform.ReleaseKey(vk::kAlt, true);
  Drain();
  EXPECT_TRUE(platform.GetModifierKeys().IsEmpty());
}

TEST_F(HeadlessPlatformTest, KeyPressesMakeTheirCharactersAsTheDesktopDoes) {
  Window({0, 0, 100, 100});
  Drain();
  platform.TypeKey('A');
  platform.PressKey(vk::kShift);
  platform.TypeKey('B');
  platform.TypeKey('1');
  platform.TypeKey(187);
  platform.ReleaseKey(vk::kShift);
  platform.TypeKey(vk::kTab);
  platform.TypeKey(vk::kReturn);
  platform.TypeKey(vk::kNumpad0 + 7);
  EXPECT_EQ(Characters(Drain()), u"aB!+\t\r");

  // Num Lock on: the keypad types digits; with Shift it navigates.
  platform.TypeKey(vk::kNumLock);
  platform.TypeKey(vk::kNumpad0 + 7);
  platform.PressKey(vk::kShift);
  platform.TypeKey(vk::kNumpad0 + 7);
  platform.ReleaseKey(vk::kShift);
  std::vector<OS_Event> events = Drain();
  EXPECT_EQ(Characters(events), u"7");
  std::vector<std::uint64_t> keys;
  for (const OS_Event& e : events) {
    if (e.GetMsg() == kMsgKeyDown) keys.push_back(e.GetWParam());
  }
  EXPECT_EQ(keys, (std::vector<std::uint64_t>{vk::kNumLock, 103, vk::kShift, vk::kHome}));

  // Control makes control characters; Alt makes system messages; AltGr nothing here.
  platform.PressKey(vk::kControl);
  platform.TypeKey('A');
  platform.ReleaseKey(vk::kControl);
  platform.PressKey(vk::kAlt);
  platform.TypeKey('F');
  platform.ReleaseKey(vk::kAlt);
  events = Drain();
  EXPECT_EQ(Characters(events),
            u"\x01"
            u"f");
  EXPECT_EQ(Messages(events, true),
            (std::vector<std::uint32_t>{kMsgKeyDown, kMsgKeyDown, kMsgChar, kMsgKeyUp, kMsgKeyUp,
                                        kMsgSysKeyDown, kMsgSysKeyDown, kMsgSysChar, kMsgSysKeyUp,
                                        kMsgSysKeyUp}));
  platform.PressKey(vk::kControl);
  platform.PressKey(vk::kAlt, true);
  platform.TypeKey('Q');
  EXPECT_EQ(Characters(Drain()), u"");
}

TEST_F(HeadlessPlatformTest, RepeatsAndReleasesCarryThePreviousStateBit) {
  Window({0, 0, 100, 100});
  Drain();
  platform.PressKey('X');
  platform.PressKey('X');
  platform.ReleaseKey('X');
  platform.PressKey(vk::kDelete, true);
  std::vector<KeyData> data;
  for (const OS_Event& e : Drain()) {
    if (!IsCharacterMessage(e.GetMsg())) data.push_back(GetKeyParam(e.GetLParam()));
  }
  ASSERT_EQ(data.size(), 4u);
  EXPECT_FALSE(data[0].previouslyDown);
  EXPECT_TRUE(data[1].previouslyDown);
  EXPECT_TRUE(data[2].previouslyDown);
  EXPECT_TRUE(data[2].releasing);
  EXPECT_TRUE(data[3].extended);
  EXPECT_EQ(platform.MapScanCodeToVirtualKey(data[0].scanCode), 'X');
  EXPECT_EQ(platform.MapScanCodeToVirtualKey(vk::kRightControl), vk::kControl);
  EXPECT_EQ(platform.GetUnshiftedCharacter('Q'), u'Q');
  EXPECT_EQ(platform.GetUnshiftedCharacter(vk::kTab), 0);
  EXPECT_EQ(platform.GetUnshiftedCharacter(188), u',');
}

TEST_F(HeadlessPlatformTest, OnlyTheKeysOwnCharacterIsRemoved) {
  const PlatformWindow window = Window({0, 0, 100, 100});
  Drain();
  platform.TypeKey(vk::kTab);
  platform.TypeKey('Q');
  OS_Event event;
  ASSERT_TRUE(platform.GetNextEvent(event, false));
  ASSERT_EQ(event.GetMsg(), kMsgKeyDown);
  platform.TranslateEvent(event);
  // The Tab's character is next: it goes, and only it.
  EXPECT_FALSE(platform.RemovePendingCharacter(u'q'));
  EXPECT_TRUE(platform.RemovePendingCharacter(u'\t'));
  EXPECT_FALSE(platform.RemovePendingCharacter(u'\t'));
  EXPECT_EQ(Characters(Drain()), u"q");
  // Characters typed ahead behind another key message stay.
  platform.PostEvent(OS_Event(window, kMsgKeyDown, 'Z', 0, 0));
  platform.PostEvent(OS_Event(window, kMsgChar, u'\t', 0, 0));
  EXPECT_FALSE(platform.RemovePendingCharacter(u'\t'));
  EXPECT_EQ(platform.GetQueueLength(), 2u);
}

TEST_F(HeadlessPlatformTest, TimersTickOnTheVirtualClockOneWaitingTickAtATime) {
  const PlatformWindow window = Window({0, 0, 100, 100});
  Drain();
  platform.SetTimer(window, 7, 0);
  platform.SetTimer(window, 8, 250);
  ASSERT_EQ(platform.GetTimers(window).size(), 2u);
  // A zero interval counts as the shortest one, 10 ms.
  EXPECT_DOUBLE_EQ(platform.GetTimers(window)[0].second, 0.010);
  platform.AdvanceTime(0.009);
  EXPECT_TRUE(Drain().empty());
  platform.AdvanceTime(1.0);
  std::vector<std::uint64_t> ticks;
  for (const OS_Event& e : Drain()) {
    if (e.GetMsg() == kMsgTimer) ticks.push_back(e.GetWParam());
  }
  // Missed ticks are not made up.
  EXPECT_EQ(ticks, (std::vector<std::uint64_t>{7, 8}));
  platform.AdvanceTime(1.0);
  OS_Event event;
  ASSERT_TRUE(platform.GetNextEvent(event, false));
  platform.PostEvent(event);
  platform.KillTimer(window, event.GetWParam() == 7 ? 7 : 8);
  EXPECT_EQ(platform.GetQueueLength(), 0u);
}

TEST_F(HeadlessPlatformTest, PendingAreasMergeAndStayInsideTheWindow) {
  const PlatformWindow window = Window({0, 0, 100, 100});
  Drain();
  const RectT<std::int32_t> outside{150, 150, 10, 10};
  platform.InvalidateRect(window, &outside);
  EXPECT_FALSE(platform.HasPendingPaint(window));
  for (std::int32_t i = 0; i < 20; ++i) {
    const RectT<std::int32_t> dot{i * 4, i * 4, 2, 2};
    platform.InvalidateRect(window, &dot);
  }
  const RectT<std::int32_t> partly{90, 90, 50, 50};
  platform.InvalidateRect(window, &partly);
  EXPECT_EQ(platform.GetPendingPaintBounds(window), (RectT<std::int32_t>{0, 0, 100, 100}));
  const std::optional<PaintTarget> target = platform.BeginPaint(window);
  ASSERT_TRUE(target.has_value());
  EXPECT_LE(target->rects.size(), 17u);
  EXPECT_NE(target->context, nullptr);
  platform.EndPaint(window, *target);
  EXPECT_FALSE(platform.BeginPaint(window).has_value());
}

TEST_F(HeadlessPlatformTest, ActivationMovesBetweenWindowsAndTheApplication) {
  const PlatformWindow first = Window({0, 0, 100, 100});
  std::vector<OS_Event> events = Drain();
  EXPECT_EQ(Messages(events),
            (std::vector<std::uint32_t>{kMsgActivateApp, kMsgActivate, kMsgSetFocus}));
  const PlatformWindow tip = Window({0, 0, 10, 10}, kStylePopup, kExStyleNoActivate);
  EXPECT_EQ(platform.GetActiveWindow(), first);
  const PlatformWindow second = Window({200, 0, 100, 100});
  events = Drain();
  EXPECT_EQ(Messages(events),
            (std::vector<std::uint32_t>{kMsgActivate, kMsgActivate, kMsgKillFocus, kMsgSetFocus}));
  EXPECT_EQ(events[0].GetWindow(), first);
  EXPECT_EQ(events[0].GetWParam(), 0u);
  EXPECT_EQ(events[1].GetWParam(), 1u);
  EXPECT_EQ(events[2].GetWParam(), second);
  platform.ActivateWindow(first, true);
  EXPECT_EQ(Drain()[1].GetWParam(), 2u);
  // Hiding the active window activates the next one; hiding the last ends
  // the application's activation.
  platform.ShowWindow(first, false, false);
  EXPECT_EQ(platform.GetActiveWindow(), second);
  platform.ShowWindow(second, false, false);
  EXPECT_EQ(platform.GetActiveWindow(), kNoPlatformWindow);
  events = Drain();
  EXPECT_EQ(events.back().GetMsg(), kMsgActivateApp);
  EXPECT_EQ(events.back().GetWParam(), 0u);
  (void)tip;
}

TEST_F(HeadlessPlatformTest, CaptureAndLeaving) {
  const PlatformWindow a = Window({0, 0, 100, 100});
  const PlatformWindow b = Window({200, 0, 100, 100});
  Drain();
  platform.MovePointer({50, 50});
  platform.TrackPointerLeave(a);
  platform.SetCapture(a);
  // Captured: moves outside still go to the capture window, and no leave.
  platform.MovePointer({250, 50});
  std::vector<OS_Event> events = Drain();
  ASSERT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgPointerMove, kMsgPointerMove}));
  EXPECT_EQ(events[1].GetWindow(), a);
  EXPECT_EQ(GetPointParam(events[1].GetLParam()), (PointT<std::int32_t>{250, 50}));
  // Taken by another window: the first one hears of it.
  platform.SetCapture(b);
  events = Drain();
  ASSERT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgCaptureLost}));
  EXPECT_EQ(events[0].GetWindow(), a);
  platform.SetCapture(a);
  Drain();
  platform.ReleaseCapture();
  events = Drain();
  ASSERT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgPointerLeft}));
  EXPECT_EQ(platform.GetCapture(), kNoPlatformWindow);
}

TEST_F(HeadlessPlatformTest, QuitComesOnceTheQueueIsEmpty) {
  const PlatformWindow window = Window({0, 0, 100, 100});
  Drain();
  platform.PostQuit(4);
  platform.PostEvent(OS_Event(window, kMsgUser, 1, 2, 0));
  OS_Event event;
  ASSERT_TRUE(platform.GetNextEvent(event, true));
  EXPECT_EQ(event.GetMsg(), kMsgUser);
  ASSERT_TRUE(platform.GetNextEvent(event, true));
  EXPECT_EQ(event.GetMsg(), kMsgQuit);
  EXPECT_EQ(event.GetWParam(), 4u);
  EXPECT_FALSE(platform.GetNextEvent(event, true));
}

}  // namespace
}  // namespace velkui::ui::test
