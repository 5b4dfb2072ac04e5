#include <chrono>
#include <thread>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/test/ErrorOf.h>

#include "X11TestSupport.h"

namespace velkui::ui::x11test {
namespace {

constexpr pictel::ColorRGBA kGrey{0.4f, 0.4f, 0.4f, 1};

// Input on platform windows without library windows: the messages as the
// backend hands them out.
class X11InputTest : public X11Test {
 protected:
  PlatformWindow CreateRaw(const RectT<std::int32_t>& client, std::uint32_t style = kStylePopup) {
    WindowCreateParams params;
    params.style = style | kStyleVisible;
    params.frame = client;
    const PlatformWindow window = x11.CreateWindow(params);
    x11.ActivateWindow(window, false);
    Drain();
    return window;
  }
  // Every message until none has come for `settle` seconds (paints are
  // validated and left out; key presses get their characters).
  std::vector<OS_Event> Drain(double settle = 0.15) {
    std::vector<OS_Event> events;
    auto quietSince = std::chrono::steady_clock::now();
    for (;;) {
      OS_Event event;
      if (x11.GetNextEvent(event, false)) {
        quietSince = std::chrono::steady_clock::now();
        if (event.GetMsg() == kMsgPaint) {
          // Painted opaque, as a real window would be (a pop-up's transparent
          // pixels are cut out of its shape).
          if (const std::optional<PaintTarget> target = x11.BeginPaint(event.GetWindow())) {
            const auto surface =
                pictel::NewOSSupplier()->NewOSSurface(target->context, nullptr, false);
            surface->PaintRect({1, 1, 1, 1}, velkcore::RectT<float>{0, 0, 4000, 4000});
            surface->Flush();
            x11.EndPaint(event.GetWindow(), *target);
          }
          continue;
        }
        x11.TranslateEvent(event);
        events.push_back(event);
        continue;
      }
      const double quiet =
          std::chrono::duration<double>(std::chrono::steady_clock::now() - quietSince).count();
      if (quiet >= settle) return events;
      x11.WaitForActivity(settle - quiet);
    }
  }
  static std::vector<std::uint32_t> Messages(const std::vector<OS_Event>& events,
                                             bool withMoves = false) {
    std::vector<std::uint32_t> messages;
    for (const OS_Event& e : events) {
      if (!withMoves && e.GetMsg() == kMsgPointerMove) continue;
      if (e.GetMsg() == kMsgActivate || e.GetMsg() == kMsgActivateApp ||
          e.GetMsg() == kMsgSetFocus || e.GetMsg() == kMsgKillFocus) {
        continue;
      }
      messages.push_back(e.GetMsg());
    }
    return messages;
  }
  static const OS_Event* FirstOf(const std::vector<OS_Event>& events, std::uint32_t message) {
    for (const OS_Event& e : events) {
      if (e.GetMsg() == message) return &e;
    }
    return nullptr;
  }
  void MoveTo(PlatformWindow window, std::int32_t x, std::int32_t y) {
    const RectT<std::int32_t> client = x11.GetClientRect(window);
    x11.InjectPointerMove({client.left + x, client.top + y});
  }
};

TEST_F(X11InputTest, AClickAndTypingReachTheFocusedNodeInOrder) {
  OS_WindowP window = MakeWindow({100, 100, 300, 200});
  RecordingViewP view = AddView(*window, {10, 10, 200, 100}, kGrey);
  view->wantsFocus = true;
  ASSERT_TRUE(view->UI_GainKeyboardFocus());
  Click(*window, 50, 40);
  TypeKey('H');
  x11.InjectKey(vk::kShift, false, true);
  TypeKey('I');
  x11.InjectKey(vk::kShift, false, false);
  TypeKey(vk::kReturn);
  TypeKey(vk::kReturn, true);
  TypeKey(vk::kLeft, true);
  ASSERT_TRUE(PumpUntil([&] { return view->KeyDownCodes().size() == 6; }));
  PumpFor(0.1);
  EXPECT_EQ(view->Typed(), u"hI\r\r");
  EXPECT_EQ(view->KeyDownCodes(), (std::vector<std::int16_t>{'H', vk::kShift, 'I', vk::kReturn,
                                                             -vk::kReturn, -vk::kLeft}));
  const std::vector<std::string> expected{
      "down",  "up",      "keydown", "char",  "keyup",   "keydown", "keydown", "char",    "keyup",
      "keyup", "keydown", "char",    "keyup", "keydown", "char",    "keyup",   "keydown", "keyup"};
  EXPECT_EQ(view->order, expected);
  const MouseEvent down = view->MouseOf(MouseEvent::kButtonDown).at(0);
  EXPECT_EQ(down.GetPosition(), (PointT<float>{40, 30}));
  EXPECT_EQ(down.GetClickCount(), 1);
}

TEST_F(X11InputTest, ASecondPressSoonAndNearIsADoubleClickTheThirdIsNot) {
  const PlatformWindow window = CreateRaw({200, 150, 200, 120});
  MoveTo(window, 50, 50);
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  EXPECT_EQ(Messages(Drain()), (std::vector<std::uint32_t>{
                                   kMsgLeftButtonDown, kMsgLeftButtonUp, kMsgLeftButtonDoubleClick,
                                   kMsgLeftButtonUp, kMsgLeftButtonDown, kMsgLeftButtonUp}));
  // Too far away, then too late.
  x11.InjectButton(4, true);
  x11.InjectButton(4, false);
  MoveTo(window, 60, 50);
  x11.InjectButton(4, true);
  x11.InjectButton(4, false);
  std::this_thread::sleep_for(std::chrono::milliseconds(x11.GetDoubleClickTime() + 50));
  x11.InjectButton(4, true);
  x11.InjectButton(4, false);
  EXPECT_EQ(Messages(Drain()), (std::vector<std::uint32_t>{
                                   kMsgRightButtonDown, kMsgRightButtonUp, kMsgRightButtonDown,
                                   kMsgRightButtonUp, kMsgRightButtonDown, kMsgRightButtonUp}));
}

TEST_F(X11InputTest, KeyStateFollowsTheMessagesTakenAndTheLocksToggle) {
  const PlatformWindow window = CreateRaw({50, 50, 100, 100});
  x11.InjectKey(vk::kShift, false, true);
  x11.Sync();
  // The press waits in the queue: not down yet.
  EXPECT_FALSE(x11.GetKeyState(vk::kShift).down);
  OS_Event event;
  ASSERT_TRUE(x11.GetNextEvent(event, false));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgKeyDown));
  EXPECT_EQ(event.GetWindow(), window);
  EXPECT_EQ(event.GetWParam(), static_cast<std::uint64_t>(vk::kShift));
  EXPECT_TRUE(x11.GetKeyState(vk::kShift).down);
  EXPECT_TRUE(x11.GetKeyState(vk::kLeftShift).down);
  EXPECT_FALSE(x11.GetKeyState(vk::kRightShift).down);
  EXPECT_EQ(x11.MapScanCodeToVirtualKey(GetKeyParam(event.GetLParam()).scanCode), vk::kShift);
  x11.InjectKey(vk::kShift, false, false);
  Drain();
  EXPECT_FALSE(x11.GetKeyState(vk::kShift).down);

  const bool capsBefore = x11.GetKeyState(vk::kCapsLock).toggled;
  TypeKey(vk::kCapsLock);
  Drain();
  EXPECT_NE(x11.GetKeyState(vk::kCapsLock).toggled, capsBefore);
  TypeKey('Q');
  const std::vector<OS_Event> typed = Drain();
  const OS_Event* character = FirstOf(typed, kMsgChar);
  ASSERT_NE(character, nullptr);
  EXPECT_EQ(character->GetWParam(), static_cast<std::uint64_t>(capsBefore ? u'q' : u'Q'));
  TypeKey(vk::kCapsLock);
  Drain();
  EXPECT_EQ(x11.GetKeyState(vk::kCapsLock).toggled, capsBefore);
}

TEST_F(X11InputTest, AltMakesSystemKeysControlMakesControlCharacters) {
  CreateRaw({50, 50, 100, 100});
  x11.InjectKey(vk::kAlt, false, true);
  TypeKey('F');
  x11.InjectKey(vk::kAlt, false, false);
  std::vector<OS_Event> events = Drain();
  EXPECT_EQ(Messages(events),
            (std::vector<std::uint32_t>{kMsgSysKeyDown, kMsgSysKeyDown, kMsgSysChar, kMsgSysKeyUp,
                                        kMsgSysKeyUp}));
  EXPECT_EQ(FirstOf(events, kMsgSysChar)->GetWParam(), static_cast<std::uint64_t>(u'f'));
  EXPECT_TRUE(GetKeyParam(FirstOf(events, kMsgSysChar)->GetLParam()).altHeld);

  x11.InjectKey(vk::kControl, true, true);
  TypeKey('A');
  x11.InjectKey(vk::kControl, true, false);
  events = Drain();
  const OS_Event* control = FirstOf(events, kMsgKeyDown);
  ASSERT_NE(control, nullptr);
  EXPECT_EQ(control->GetWParam(), static_cast<std::uint64_t>(vk::kControl));
  EXPECT_TRUE(GetKeyParam(control->GetLParam()).extended);
  ASSERT_NE(FirstOf(events, kMsgChar), nullptr);
  EXPECT_EQ(FirstOf(events, kMsgChar)->GetWParam(), 1u);

  // Delete and the arrows type nothing; the keypad's Enter and '/' are extended.
  TypeKey(vk::kDelete, true);
  TypeKey(vk::kDivide, true);
  events = Drain();
  EXPECT_EQ(Messages(events),
            (std::vector<std::uint32_t>{kMsgKeyDown, kMsgKeyUp, kMsgKeyDown, kMsgChar, kMsgKeyUp}));
  EXPECT_EQ(events[0].GetWParam(), static_cast<std::uint64_t>(vk::kDelete));
  EXPECT_TRUE(GetKeyParam(events[2].GetLParam()).extended);
  EXPECT_EQ(events[3].GetWParam(), static_cast<std::uint64_t>(u'/'));
}

TEST_F(X11InputTest, TheKeypadFollowsNumLockAndShift) {
  CreateRaw({50, 50, 100, 100});
  const auto setNumLock = [&](bool on) {
    if (x11.GetKeyState(vk::kNumLock).toggled != on) TypeKey(vk::kNumLock, true);
    Drain();
    ASSERT_EQ(x11.GetKeyState(vk::kNumLock).toggled, on);
  };
  setNumLock(true);
  TypeKey(vk::kNumpad0 + 7);
  std::vector<OS_Event> events = Drain();
  ASSERT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgKeyDown, kMsgChar, kMsgKeyUp}));
  EXPECT_EQ(events[0].GetWParam(), static_cast<std::uint64_t>(vk::kNumpad0 + 7));
  EXPECT_EQ(events[1].GetWParam(), static_cast<std::uint64_t>(u'7'));
  // With Shift the keypad reports the navigation key, not extended.
  x11.InjectKey(vk::kShift, false, true);
  TypeKey(vk::kNumpad0 + 7);
  x11.InjectKey(vk::kShift, false, false);
  events = Drain();
  ASSERT_EQ(events.size(), 4u);
  EXPECT_EQ(events[1].GetWParam(), static_cast<std::uint64_t>(vk::kHome));
  EXPECT_FALSE(GetKeyParam(events[1].GetLParam()).extended);
  setNumLock(false);
  TypeKey(vk::kNumpad0 + 7);
  events = Drain();
  ASSERT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgKeyDown, kMsgKeyUp}));
  EXPECT_EQ(events[0].GetWParam(), static_cast<std::uint64_t>(vk::kHome));
  EXPECT_FALSE(GetKeyParam(events[0].GetLParam()).extended);
  // The dedicated Home key is extended.
  TypeKey(vk::kHome, true);
  events = Drain();
  ASSERT_FALSE(events.empty());
  EXPECT_TRUE(GetKeyParam(events[0].GetLParam()).extended);
}

TEST_F(X11InputTest, MovesCoalesceAndLeavingIsReportedOnceWhenTracked) {
  const PlatformWindow window = CreateRaw({300, 300, 200, 150});
  MoveTo(window, 10, 10);
  Drain();
  for (std::int32_t x = 20; x <= 100; x += 10) MoveTo(window, x, 40);
  x11.Sync();
  EXPECT_TRUE(x11.HasPendingPointerMove(window));
  const std::vector<OS_Event> moves = Drain();
  ASSERT_EQ(Messages(moves, true), (std::vector<std::uint32_t>{kMsgPointerMove}));
  EXPECT_EQ(GetPointParam(moves[0].GetLParam()), (PointT<std::int32_t>{100, 40}));

  x11.TrackPointerLeave(window);
  MoveTo(window, 250, 40);
  MoveTo(window, 150, 40);
  MoveTo(window, 260, 40);
  EXPECT_EQ(Messages(Drain()), (std::vector<std::uint32_t>{kMsgPointerLeft}));
}

TEST_F(X11InputTest, TheCaptureHoldsThePointerOutsideAndIsReleasedWithALeave) {
  const PlatformWindow window = CreateRaw({300, 300, 200, 150});
  const PlatformWindow other = CreateRaw({600, 300, 100, 100});
  x11.ActivateWindow(window, false);
  MoveTo(window, 10, 10);
  Drain();
  x11.SetCapture(window);
  EXPECT_EQ(x11.GetCapture(), window);
  x11.TrackPointerLeave(window);
  MoveTo(other, 20, 20);
  std::vector<OS_Event> events = Drain();
  ASSERT_EQ(Messages(events, true), (std::vector<std::uint32_t>{kMsgPointerMove}));
  EXPECT_EQ(events.back().GetWindow(), window);
  EXPECT_EQ(GetPointParam(events.back().GetLParam()), (PointT<std::int32_t>{320, 20}));
  x11.ReleaseCapture();
  events = Drain();
  EXPECT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgPointerLeft}));
  EXPECT_EQ(events.back().GetWindow(), window);
  EXPECT_EQ(x11.GetWindowFromPoint(x11.GetPointerPosition()), other);
  // Another window taking the capture tells the first.
  x11.SetCapture(window);
  x11.SetCapture(other);
  events = Drain();
  EXPECT_EQ(Messages(events), (std::vector<std::uint32_t>{kMsgCaptureLost}));
  EXPECT_EQ(events.back().GetWindow(), window);
  x11.ReleaseCapture();
}

TEST_F(X11InputTest, WheelNotchesGoToTheFocusWindowInScreenCoordinates) {
  const PlatformWindow window = CreateRaw({300, 300, 200, 150});
  MoveTo(window, 30, 40);
  Drain();
  x11.InjectWheel(120, false);
  x11.InjectWheel(60, false);
  x11.InjectWheel(60, false);
  x11.InjectWheel(-120, true);
  const std::vector<OS_Event> events = Drain();
  ASSERT_EQ(Messages(events),
            (std::vector<std::uint32_t>{kMsgWheel, kMsgWheel, kMsgHorizontalWheel}));
  EXPECT_EQ(GetWheelDelta(events[0].GetWParam()), 120);
  EXPECT_EQ(GetPointParam(events[0].GetLParam()), (PointT<std::int32_t>{330, 340}));
  EXPECT_EQ(GetWheelDelta(events[2].GetWParam()), -120);
  EXPECT_EQ(events[2].GetWindow(), window);
}

TEST_F(X11InputTest, ATypedAheadCharacterIsNotRemovedInsteadOfTheOneHandled) {
  CreateRaw({50, 50, 100, 100});
  TypeKey('A');
  TypeKey('B');
  x11.Sync();
  OS_Event event;
  ASSERT_TRUE(x11.GetNextEvent(event, false));
  ASSERT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgKeyDown));
  x11.TranslateEvent(event);
  EXPECT_FALSE(x11.RemovePendingCharacter(u'b'));
  EXPECT_TRUE(x11.RemovePendingCharacter(u'a'));
  EXPECT_FALSE(x11.RemovePendingCharacter(u'a'));
  const std::vector<OS_Event> rest = Drain();
  EXPECT_EQ(Messages(rest),
            (std::vector<std::uint32_t>{kMsgKeyUp, kMsgKeyDown, kMsgChar, kMsgKeyUp}));
}

TEST_F(X11InputTest, KeysWithoutAKeyOnThisKeyboardAreAnError) {
  EXPECT_THROW(x11.InjectKey(0, false, true), velkcore::Exception);
  const auto error = velkui::test::ErrorOf([&] { x11.InjectKey(255, false, true); });
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetNumber(), 60);
  EXPECT_NE(std::string(error->what()).find("255"), std::string::npos) << error->what();
}

TEST_F(X11InputTest, DisabledWindowsGetNoInputAndADestroyedWindowsMessagesAreDropped) {
  const PlatformWindow window = CreateRaw({200, 200, 120, 80});
  MoveTo(window, 20, 20);
  Drain();
  x11.EnableWindow(window, false);
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  TypeKey('K');
  EXPECT_TRUE(Messages(Drain(), true).empty());
  x11.EnableWindow(window, true);
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  EXPECT_EQ(Messages(Drain()), (std::vector<std::uint32_t>{kMsgLeftButtonDown, kMsgLeftButtonUp}));
  // A capture ends when its window is disabled.
  x11.SetCapture(window);
  x11.EnableWindow(window, false);
  EXPECT_EQ(x11.GetCapture(), kNoPlatformWindow);
  EXPECT_EQ(Messages(Drain()), (std::vector<std::uint32_t>{kMsgCaptureLost}));
  x11.EnableWindow(window, true);

  TypeKey('K');
  x11.SetTimer(window, 3, 10);
  x11.Sync();
  x11.DestroyWindow(window);
  EXPECT_FALSE(x11.IsWindow(window));
  EXPECT_EQ(x11.GetActiveWindow(), kNoPlatformWindow);
  EXPECT_EQ(x11.GetFocus(), kNoPlatformWindow);
  for (const OS_Event& event : Drain()) EXPECT_NE(event.GetWindow(), window) << event.GetMsg();
}

}  // namespace
}  // namespace velkui::ui::x11test
