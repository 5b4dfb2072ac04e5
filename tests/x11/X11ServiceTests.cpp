#include <atomic>
#include <chrono>
#include <cstring>
#include <thread>

#include <velkui/ui/OS_ToolTip.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_ToolTipManager.h>

#include "X11TestSupport.h"

namespace velkui::ui::x11test {
namespace {

using Clock = std::chrono::steady_clock;

double SecondsSince(Clock::time_point start) {
  return std::chrono::duration<double>(Clock::now() - start).count();
}

std::string BytesOf(const std::u16string& text) {
  std::string bytes(text.size() * 2, '\0');
  std::memcpy(bytes.data(), text.data(), bytes.size());
  return bytes;
}

class X11ServiceTest : public X11Test {
 protected:
  PlatformWindow CreateRaw() {
    WindowCreateParams params;
    params.style = kStylePopup;
    params.frame = {10, 10, 50, 50};
    return x11.CreateWindow(params);
  }
  // The timer ticks that come within `seconds`, with the loop blocking in between.
  std::vector<double> TicksFor(double seconds) {
    std::vector<double> ticks;
    const Clock::time_point start = Clock::now();
    while (SecondsSince(start) < seconds) {
      OS_Event event;
      if (x11.GetNextEvent(event, false)) {
        if (event.GetMsg() == kMsgTimer) ticks.push_back(SecondsSince(start));
        continue;
      }
      x11.WaitForActivity(seconds - SecondsSince(start));
    }
    return ticks;
  }
};

TEST_F(X11ServiceTest, TimersTickFromTheDeadlineHeapAndNeverPileUp) {
  const PlatformWindow window = CreateRaw();
  x11.SetTimer(window, 7, 40);
  const std::vector<double> ticks = TicksFor(0.42);
  // Ten ticks are due; a loaded machine may lose some (they are not made up), never gain.
  EXPECT_GE(ticks.size(), 5u);
  EXPECT_LE(ticks.size(), 10u);
  ASSERT_FALSE(ticks.empty());
  EXPECT_GE(ticks.front(), 0.035);

  // A busy loop that takes nothing for a while finds one tick waiting, not five.
  std::this_thread::sleep_for(std::chrono::milliseconds(200));
  OS_Event event;
  ASSERT_TRUE(x11.GetNextEvent(event, false));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgTimer));
  EXPECT_EQ(event.GetWParam(), 7u);
  EXPECT_FALSE(x11.GetNextEvent(event, false));

  // Intervals below 10 ms count as 10 ms; a killed timer is silent.
  x11.KillTimer(window, 7);
  x11.SetTimer(window, 8, 1);
  EXPECT_LE(TicksFor(0.1).size(), 10u);
  x11.KillTimer(window, 8);
  EXPECT_TRUE(TicksFor(0.15).empty());
  // So are the timers of a destroyed window.
  x11.SetTimer(window, 9, 20);
  x11.DestroyWindow(window);
  EXPECT_TRUE(TicksFor(0.1).empty());
}

TEST_F(X11ServiceTest, AWaitingLoopSleepsUntilItsTimerOrAnEvent) {
  const PlatformWindow window = CreateRaw();
  OS_Event event;
  EXPECT_FALSE(x11.GetNextEvent(event, false));
  // Nothing comes: the wait runs out without an event.
  Clock::time_point start = Clock::now();
  EXPECT_FALSE(x11.WaitForActivity(0.2));
  EXPECT_GE(SecondsSince(start), 0.19);
  // A waiting GetNextEvent comes back for the timer.
  x11.SetTimer(window, 1, 60);
  start = Clock::now();
  ASSERT_TRUE(x11.GetNextEvent(event, true));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgTimer));
  EXPECT_GE(SecondsSince(start), 0.055);
  x11.KillTimer(window, 1);
  // ...and for a quit request, after the queue ran dry.
  x11.PostEvent(OS_Event(window, kMsgUser, 5, 0, x11.GetTime()));
  x11.PostQuit(3);
  ASSERT_TRUE(x11.GetNextEvent(event, true));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgUser));
  ASSERT_TRUE(x11.GetNextEvent(event, true));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgQuit));
  EXPECT_EQ(event.GetWParam(), 3u);
}

TEST_F(X11ServiceTest, ATooltipAppearsAfterItsDelayInAPopupOnScreen) {
  OS_WindowP window = MakeWindow({100, 100, 400, 300});
  RecordingViewP gain = AddView(*window, {20, 20, 80, 30}, {0.4f, 0.4f, 0.4f, 1}, "gain");
  gain->UI_SetToolTip(u"Gain", 0);
  UI_ToolTipManager& tips = *session.GetNodeManager().GetToolTipManager();
  x11.InjectPointerMove(Screen(*window, 60, 35));
  const Clock::time_point start = Clock::now();
  ASSERT_TRUE(PumpUntil([&] { return tips.OwnerOfDisplayedTip(gain.get()); }, 5.0));
  EXPECT_GE(SecondsSince(start), UI_ToolTipManager::GetInitialDisplayDelay() - 0.02);
  auto* tip = dynamic_cast<OS_ToolTip*>(tips.GetDisplayedTip());
  ASSERT_NE(tip, nullptr);
  OS_PopupWindow* popup = tip->GetWindow();
  ASSERT_NE(popup, nullptr);
  const PlatformWindow handle = Handle(*popup);
  ASSERT_TRUE(
      PumpUntil([&] { return x11.GetPaintCount(handle) > 0 && !x11.HasPendingPaint(handle); }));
  // Below the pointer, on screen, in the theme's colours, and the window stays active.
  const RectT<std::int32_t> frame = x11.GetFrameRect(handle);
  const PointT<std::int32_t> pointer = x11.GetPointerPosition();
  EXPECT_EQ(frame.left, pointer.x);
  EXPECT_EQ(frame.top, pointer.y + 20);
  EXPECT_EQ(x11.GetWindowFromPoint({frame.left + frame.width / 2, frame.top + frame.height / 2}),
            handle);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*window));
  const PixelProbe shown(*x11.CaptureWindowPixels(handle));
  EXPECT_EQ(shown.At(3, frame.height / 2), PixelOf(Theme::Get().GetColor(130)));
  EXPECT_GT(shown.Count(PixelOf(Theme::Get().GetColor(131)), 0, 0, frame.width, frame.height), 0);
}

TEST_F(X11ServiceTest, MonitorsComeFromXRandR) {
  const std::vector<MonitorDescription> monitors = x11.GetMonitors();
  ASSERT_FALSE(monitors.empty());
  int primaries = 0;
  for (const MonitorDescription& monitor : monitors) {
    EXPECT_FALSE(monitor.bounds.IsEmpty());
    EXPECT_EQ(velkcore::Intersection(monitor.bounds, monitor.workArea), monitor.workArea);
    EXPECT_NE(monitor.id, 0u);
    primaries += monitor.primary ? 1 : 0;
  }
  EXPECT_EQ(primaries, 1);
  // run-under-xvfb makes one screen of 1280 × 800.
  EXPECT_EQ(monitors.front().bounds, (RectT<std::int32_t>{0, 0, 1280, 800}));
  EXPECT_EQ(x11.GetMonitors(), monitors);
}

// The other side of the clipboard is a second connection on its own thread,
// as another application would be.
TEST_F(X11ServiceTest, TheClipboardGoesToOtherClientsAndComesBack) {
  const std::string text = BytesOf(u"h\u00e9llo \u2713");
  const std::string large(600 * 1024, 'x');
  x11.SetClipboard({{"VELKUI/UnicodeText", text},
                    {"VELKUI/FileDrop", "/tmp/a\n/tmp/b"},
                    {"VELKUI/Large", large}});
  EXPECT_EQ(x11.GetClipboard("VELKUI/FileDrop"), "/tmp/a\n/tmp/b");

  std::atomic<bool> done = false;
  std::vector<std::string> types;
  std::optional<std::string> readText;
  std::optional<std::string> readLarge;
  std::optional<std::string> missing;
  std::thread reader([&] {
    X11Platform other;
    types = other.GetClipboardTypes();
    readText = other.GetClipboard("VELKUI/UnicodeText");
    readLarge = other.GetClipboard("VELKUI/Large");
    missing = other.GetClipboard("VELKUI/iTunesDrop");
    // Now the other client takes the clipboard over, and serves it until told.
    other.SetClipboard({{"VELKUI/UnicodeText", BytesOf(u"back")}});
    done = true;
    while (done) {
      other.WaitForActivity(0.02);
      OS_Event event;
      while (other.GetNextEvent(event, false)) {
      }
    }
  });
  ASSERT_TRUE(PumpUntil([&] { return done.load(); }, 10.0));
  EXPECT_EQ(types,
            (std::vector<std::string>{"VELKUI/UnicodeText", "VELKUI/FileDrop", "VELKUI/Large"}));
  EXPECT_EQ(readText, text);
  EXPECT_EQ(readLarge.value_or("").size(), large.size());
  EXPECT_TRUE(readLarge == large);
  EXPECT_FALSE(missing.has_value());

  EXPECT_EQ(x11.GetClipboard("VELKUI/UnicodeText"), BytesOf(u"back"));
  EXPECT_EQ(x11.GetClipboardTypes(), (std::vector<std::string>{"VELKUI/UnicodeText"}));
  EXPECT_FALSE(x11.GetClipboard("VELKUI/FileDrop").has_value());
  done = false;
  reader.join();
}

}  // namespace
}  // namespace velkui::ui::x11test
