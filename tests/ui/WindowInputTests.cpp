#include <gtest/gtest.h>

#include <velkui/ui/NodeManagerGuards.h>

#include "WindowTestSupport.h"

namespace velkui::ui::test {
namespace {

class WindowInputTest : public WindowTest {
 protected:
  OS_WindowP window = MakeWindow({100, 100, 400, 300});
  RecordingViewP view = Recording(window.get(), {0, 0, 400, 300}, "view");

  RecordingViewP Recording(UI_Node* parent, const RectT<float>& frame, const std::string& name) {
    return MakeView<RecordingView>(parent, frame, name, log);
  }
};

// ---- Mouse messages ----

TEST_F(WindowInputTest, EachButtonMessageBecomesItsActionButtonAndBaseCount) {
  struct Row {
    std::uint32_t message;
    MouseEvent::Action action;
    std::int32_t button;
    std::int32_t count;
  };
  const Row rows[] = {
      {kMsgLeftButtonDown, MouseEvent::kButtonDown, 1, 1},
      {kMsgLeftButtonUp, MouseEvent::kButtonUp, 1, 1},
      {kMsgLeftButtonDoubleClick, MouseEvent::kButtonDown, 1, 2},
      {kMsgMiddleButtonDown, MouseEvent::kButtonDown, 2, 1},
      {kMsgMiddleButtonUp, MouseEvent::kButtonUp, 2, 1},
      {kMsgMiddleButtonDoubleClick, MouseEvent::kButtonDown, 2, 2},
      {kMsgRightButtonDown, MouseEvent::kButtonDown, 4, 1},
      {kMsgRightButtonUp, MouseEvent::kButtonUp, 4, 1},
      {kMsgRightButtonDoubleClick, MouseEvent::kButtonDown, 4, 2},
  };
  headless.SetKeyState(vk::kShift, {true, false});
  for (const Row& row : rows) {
    view->mouse.clear();
    // Far apart in time: every row starts a new click chain.
    headless.AdvanceTime(5);
    Post(*window, row.message, 0, MakePointParam({30, 40}));
    headless.ProcessEvents();
    ASSERT_EQ(view->mouse.size(), 1u) << row.message;
    const MouseEvent& e = view->mouse.front();
    EXPECT_EQ(e.GetAction(), row.action) << row.message;
    EXPECT_EQ(e.GetButton(), row.button) << row.message;
    EXPECT_EQ(e.GetClickCount(), row.count) << row.message;
    EXPECT_EQ(e.GetPosition(), (PointT<float>{30, 40}));
    EXPECT_EQ(e.GetModKey(), ModifierKeys{kModifierShift});
    ASSERT_NE(e.GetOSEvent(), nullptr);
  }
}

TEST_F(WindowInputTest, AMoveUpdatesTheMouseOverStateFirstAndOnlyTheNewestMoveIsDispatched) {
  auto inner = Recording(view.get(), {100, 100, 50, 50}, "inner");
  MoveTo(*window, 10, 10);
  MoveTo(*window, 120, 130);
  headless.ProcessEvents();
  EXPECT_TRUE(inner->UI_IsMouseOver(true));
  // The first move only updated the mouse-over state.
  ASSERT_EQ(view->MouseOf(MouseEvent::kMove).size(), 1u);
  const MouseEvent move = view->MouseOf(MouseEvent::kMove).front();
  EXPECT_EQ(move.GetPosition(), (PointT<float>{120, 130}));
  EXPECT_EQ(move.GetClickCount(), 0);
  EXPECT_EQ(inner->MouseOf(MouseEvent::kMove).front().GetPosition(), (PointT<float>{20, 30}));
  // Buttons held travel with moves.
  Post(*window, kMsgPointerMove, MouseEvent::kLeftButton | MouseEvent::kRightButton,
       MakePointParam({15, 15}));
  headless.ProcessEvents();
  EXPECT_EQ(view->MouseOf(MouseEvent::kMove).back().GetButton(), 5);
  EXPECT_FALSE(inner->UI_IsMouseOver(false));
}

TEST_F(WindowInputTest, TheWheelGoesToTheEnabledWindowUnderThePointer) {
  // The other window lies over the right part of this one, and stays on top.
  auto other = MakeWindow({300, 150, 200, 200}, kStylePopup, kExStyleTopmost);
  auto otherView = Recording(other.get(), {0, 0, 200, 200}, "other");
  window->UI_Activate();
  headless.ProcessEvents();
  ASSERT_EQ(headless.GetFocus(), Handle(*window));
  headless.MovePointer(Screen(*other, 50, 60));
  headless.TurnWheel(-360);
  headless.ProcessEvents();
  ASSERT_EQ(otherView->MouseOf(MouseEvent::kWheel).size(), 1u);
  const MouseEvent wheel = otherView->MouseOf(MouseEvent::kWheel).front();
  EXPECT_EQ(wheel.GetMouseWheelDelta(), -3);
  EXPECT_EQ(wheel.GetMouseWheelAxis(), MouseEvent::kVerticalAxis);
  EXPECT_EQ(wheel.GetPosition(), (PointT<float>{50, 60}));
  EXPECT_EQ(wheel.GetClickCount(), 0);
  headless.TurnWheel(120, true);
  headless.ProcessEvents();
  EXPECT_EQ(otherView->MouseOf(MouseEvent::kWheel).back().GetMouseWheelAxis(),
            MouseEvent::kHorizontalAxis);
  EXPECT_TRUE(view->MouseOf(MouseEvent::kWheel).empty());

  // A disabled window under the pointer: the receiving window gets it, in its
  // own coordinates.
  other->UI_SetDisabled(true);
  headless.TurnWheel(-120);
  headless.ProcessEvents();
  ASSERT_EQ(view->MouseOf(MouseEvent::kWheel).size(), 1u);
  EXPECT_EQ(view->MouseOf(MouseEvent::kWheel).front().GetPosition(), (PointT<float>{250, 110}));
}

TEST_F(WindowInputTest, OnlyTheWheelReachesChildrenThatOwnPlatformWindows) {
  auto field = Recording(view.get(), {10, 10, 100, 100}, "field");
  field->ownsPlatformWindow = true;
  field->handlesMouse = true;
  window->UI_Activate();
  MoveTo(*window, 20, 20);
  headless.Click();
  headless.TurnWheel(120);
  headless.ProcessEvents();
  EXPECT_TRUE(field->MouseOf(MouseEvent::kButtonDown).empty());
  EXPECT_EQ(view->MouseOf(MouseEvent::kButtonDown).size(), 1u);
  EXPECT_EQ(field->MouseOf(MouseEvent::kWheel).size(), 1u);
}

TEST_F(WindowInputTest, LeavingUpdatesTheWindowNowUnderThePointerOrExitsTheChain) {
  auto other = MakeWindow({520, 100, 200, 200});
  auto otherView = Recording(other.get(), {0, 0, 200, 200}, "other");
  MoveTo(*window, 10, 10);
  headless.ProcessEvents();
  ASSERT_TRUE(view->UI_IsMouseOver(true));
  // Into the other window: the leave message of the first one already finds
  // the pointer there.
  headless.MovePointer(Screen(*other, 30, 30));
  headless.ProcessEvents();
  EXPECT_FALSE(view->UI_IsMouseOver(false));
  EXPECT_TRUE(otherView->UI_IsMouseOver(true));
  // Onto the bare desktop.
  headless.MovePointer({1000, 700});
  headless.ProcessEvents();
  EXPECT_FALSE(otherView->UI_IsMouseOver(false));
  EXPECT_EQ(UI_Node::UI_GetMouseOverLeafNode(), nullptr);
  // The exit notice reached the old leaf as a mouse-over update.
  EXPECT_FALSE(otherView->MouseOf(MouseEvent::kMouseOverUpdate).empty());
}

TEST_F(WindowInputTest, ClicksAreCountedByTheWindowsCounter) {
  MoveTo(*window, 50, 50);
  for (int i = 0; i < 4; ++i) {
    headless.AdvanceTime(0.05);
    headless.Click();
  }
  headless.ProcessEvents();
  const auto downs = view->MouseOf(MouseEvent::kButtonDown);
  const auto ups = view->MouseOf(MouseEvent::kButtonUp);
  ASSERT_EQ(downs.size(), 4u);
  ASSERT_EQ(ups.size(), 4u);
  const std::int32_t expected[] = {1, 2, 3, 4};
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(downs[static_cast<std::size_t>(i)].GetClickCount(), expected[i]);
    EXPECT_EQ(ups[static_cast<std::size_t>(i)].GetClickCount(), expected[i]);
  }
  EXPECT_TRUE(ups[1].IsLeftButtonDoubleClick());
  EXPECT_FALSE(downs[1].IsLeftButtonDoubleClick());
  // Too late, or too far, and the chain starts again.
  headless.AdvanceTime(1.0);
  headless.Click();
  headless.AdvanceTime(0.05);
  MoveTo(*window, 60, 50);
  headless.Click();
  headless.ProcessEvents();
  EXPECT_EQ(view->MouseOf(MouseEvent::kButtonDown)[4].GetClickCount(), 1);
  EXPECT_EQ(view->MouseOf(MouseEvent::kButtonDown)[5].GetClickCount(), 1);
}

TEST_F(WindowInputTest, AClickActivatesItsWindowUnlessSuspended) {
  auto other = MakeWindow({600, 100, 200, 200});
  ASSERT_EQ(headless.GetActiveWindow(), Handle(*other));
  MoveTo(*window, 5, 5);
  {
    const SuspendOSMouseActivates suspended(session.GetNodeManager(), window.get());
    headless.Click();
    headless.ProcessEvents();
    EXPECT_EQ(headless.GetActiveWindow(), Handle(*other));
  }
  headless.Click();
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetActiveWindow(), Handle(*window));
}

// ---- Keyboard messages ----

class KeyboardTranslationTest : public WindowTest {
 protected:
  KeyboardEvent Translate(std::uint32_t message, std::uint64_t w, const KeyData& data) {
    const OS_Event event(1, message, w, MakeKeyParam(data), 0);
    std::optional<KeyboardEvent> key = UI_GetKeyboardEventFromOSEvent(event, headless);
    EXPECT_TRUE(key.has_value());
    return key.value_or(KeyboardEvent(KeyboardEvent::kKeyUp, {}, 0, {}));
  }
  static KeyData Scan(std::uint32_t scan, bool extended = false, bool previouslyDown = false) {
    KeyData data;
    data.scanCode = scan;
    data.extended = extended;
    data.previouslyDown = previouslyDown;
    return data;
  }
};

TEST_F(KeyboardTranslationTest, MessagesMapToActionsAndTheRepeatBit) {
  struct Row {
    std::uint32_t message;
    KeyboardEvent::Action action;
  };
  const Row rows[] = {
      {kMsgKeyDown, KeyboardEvent::kKeyDown},
      {kMsgSysKeyDown, KeyboardEvent::kKeyDown},
      {kMsgKeyUp, KeyboardEvent::kKeyUp},
      {kMsgSysKeyUp, KeyboardEvent::kKeyUp},
      {kMsgChar, KeyboardEvent::kCharacter},
      {kMsgSysChar, KeyboardEvent::kCharacter},
      {kMsgDeadChar, KeyboardEvent::kDeadCharacter},
      {kMsgSysDeadChar, KeyboardEvent::kDeadCharacter},
  };
  for (const Row& row : rows) {
    const std::uint64_t w = IsCharacterMessage(row.message) ? u'x' : 'X';
    EXPECT_EQ(Translate(row.message, w, Scan('X')).GetAction(), row.action) << row.message;
    const bool repeats = row.action != KeyboardEvent::kKeyUp;
    EXPECT_EQ(Translate(row.message, w, Scan('X', false, true)).IsRepeat(), repeats) << row.message;
    EXPECT_FALSE(Translate(row.message, w, Scan('X')).IsRepeat());
  }
  const OS_Event paint(1, kMsgPaint, 0, 0, 0);
  EXPECT_FALSE(UI_GetKeyboardEventFromOSEvent(paint, headless).has_value());
}

TEST_F(KeyboardTranslationTest, KeyMessagesCarryTheUnshiftedCharacterOfTheKey) {
  headless.SetKeyState(vk::kShift, {true, false});
  const KeyboardEvent a = Translate(kMsgKeyDown, 'A', Scan('A'));
  EXPECT_EQ(a.GetOSCode(), 'A');
  ASSERT_EQ(a.GetNumCharacters(), 1u);
  EXPECT_EQ(a.GetCharacter(0), u'A');
  EXPECT_EQ(a.GetModKey(), ModifierKeys{kModifierShift});
  const KeyboardEvent two = Translate(kMsgKeyDown, '2', Scan('2'));
  EXPECT_EQ(two.GetCharacter(0), u'2');
  // Keys without a printable character carry none, so that their control code counts.
  const KeyboardEvent tab = Translate(kMsgKeyDown, vk::kTab, Scan(vk::kTab));
  EXPECT_EQ(tab.GetNumCharacters(), 0u);
  EXPECT_EQ(tab.GetCode(), KeyboardCode::CreateFromControlCode(kKeyTab, false));
}

TEST_F(KeyboardTranslationTest, CharacterMessagesMapTheirKeyBackAndFollowTheControlRules) {
  const KeyboardEvent plain = Translate(kMsgChar, u'a', Scan('A'));
  EXPECT_EQ(plain.GetOSCode(), 'A');
  EXPECT_EQ(plain.GetCharacter(0), u'a');

  // Control+A: the control character gives way to the key.
  headless.SetKeyState(vk::kControl, {true, false});
  const KeyboardEvent controlA = Translate(kMsgChar, 1, Scan('A'));
  EXPECT_EQ(controlA.GetCharacter(0), u'A');
  EXPECT_EQ(controlA.GetModKey(), ModifierKeys{kModifierControl});
  // A control character equal to its key stays.
  EXPECT_EQ(Translate(kMsgChar, 13, Scan(vk::kReturn)).GetCharacter(0), 13);
  EXPECT_EQ(Translate(kMsgChar, 127, Scan(vk::kBackspace)).GetCharacter(0), vk::kBackspace);
  // Printable characters are never replaced.
  EXPECT_EQ(Translate(kMsgChar, u'a', Scan('A')).GetCharacter(0), u'a');

  // AltGr (Control with the right Alt): no Control, and the character stays.
  headless.SetKeyState(vk::kRightAlt, {true, false});
  const KeyboardEvent altGr = Translate(kMsgChar, u'@', Scan('Q'));
  EXPECT_EQ(altGr.GetModKey(), ModifierKeys{kModifierAlt});
  EXPECT_EQ(altGr.GetCharacter(0), u'@');
  const KeyboardEvent altGrControl = Translate(kMsgChar, 3, Scan('C'));
  EXPECT_EQ(altGrControl.GetCharacter(0), 3);
}

TEST_F(KeyboardTranslationTest, ExtendedKeysOtherThanModifiersAreNegated) {
  EXPECT_EQ(Translate(kMsgKeyDown, vk::kDelete, Scan(vk::kDelete, true)).GetOSCode(), -vk::kDelete);
  const KeyboardEvent enter = Translate(kMsgKeyDown, vk::kReturn, Scan(vk::kReturn, true));
  EXPECT_EQ(enter.GetOSCode(), -vk::kReturn);
  EXPECT_EQ(enter.GetKeyControlCode(), kKeyEnter);
  EXPECT_EQ(Translate(kMsgKeyDown, vk::kControl, Scan(vk::kRightControl, true)).GetOSCode(),
            vk::kControl);
  EXPECT_EQ(Translate(kMsgKeyDown, vk::kAlt, Scan(vk::kRightAlt, true)).GetOSCode(), vk::kAlt);
  EXPECT_EQ(Translate(kMsgKeyDown, vk::kShift, Scan(vk::kRightShift, true)).GetOSCode(),
            vk::kShift);
  EXPECT_EQ(Translate(kMsgChar, u'/', Scan(vk::kDivide, true)).GetOSCode(), -vk::kDivide);
}

TEST_F(KeyboardTranslationTest, WithNumLockOnShiftedKeypadKeysBecomeDigitsAgain) {
  struct Row {
    std::int16_t reported;
    std::int16_t keypad;
    char16_t character;
  };
  const Row rows[] = {
      {vk::kClear, 101, u'5'}, {vk::kPageUp, 105, u'9'}, {vk::kPageDown, 99, u'3'},
      {vk::kEnd, 97, u'1'},    {vk::kHome, 103, u'7'},   {vk::kLeft, 100, u'4'},
      {vk::kUp, 104, u'8'},    {vk::kRight, 102, u'6'},  {vk::kDown, 98, u'2'},
      {vk::kInsert, 96, u'0'}, {vk::kDelete, 110, u'.'},
  };
  headless.SetKeyState(vk::kNumLock, {false, true});
  for (const Row& row : rows) {
    for (const std::uint32_t message : {kMsgKeyDown, kMsgKeyUp}) {
      const KeyboardEvent key = Translate(message, static_cast<std::uint64_t>(row.reported),
                                          Scan(static_cast<std::uint32_t>(row.keypad)));
      EXPECT_EQ(key.GetOSCode(), row.keypad) << row.reported;
      ASSERT_EQ(key.GetNumCharacters(), 1u);
      EXPECT_EQ(key.GetCharacter(0), row.character);
      EXPECT_TRUE(key.GetModKey().IsSet(kModifierShift));
    }
    // The dedicated navigation keys are extended and stay what they are.
    const KeyboardEvent extended = Translate(kMsgKeyDown, static_cast<std::uint64_t>(row.reported),
                                             Scan(static_cast<std::uint32_t>(row.reported), true));
    EXPECT_EQ(extended.GetOSCode(), -row.reported);
    EXPECT_FALSE(extended.GetModKey().IsSet(kModifierShift));
  }
  headless.SetKeyState(vk::kNumLock, {false, false});
  EXPECT_EQ(Translate(kMsgKeyDown, vk::kHome, Scan(103)).GetOSCode(), vk::kHome);
}

// ---- Keyboard through the window ----

TEST_F(WindowInputTest, KeysGoToTheFocusLeafOrElseToTheWindow) {
  view->wantsFocus = true;
  window->UI_Activate();
  headless.ProcessEvents();
  headless.PressKey(vk::kShift);
  headless.TypeKey('K');
  headless.ReleaseKey(vk::kShift);
  headless.ProcessEvents();
  // Nothing has focus: the window is the target; the view only sees what climbs.
  EXPECT_TRUE(view->keys.empty());
  view->UI_GainKeyboardFocus();
  headless.ProcessEvents();
  headless.TypeKey('K');
  headless.ProcessEvents();
  ASSERT_EQ(view->keys.size(), 3u);
  EXPECT_TRUE(view->keys[0].IsActionKeyDown());
  EXPECT_EQ(view->keys[0].GetCharacter(0), u'K');
  EXPECT_EQ(view->Typed(), u"k");
  EXPECT_TRUE(view->keys[2].IsActionKeyUp());
}

TEST_F(WindowInputTest, TheTabThatMovesFocusLosesOnlyItsOwnCharacter) {
  auto first = Recording(view.get(), {0, 0, 50, 20}, "first");
  auto second = Recording(view.get(), {0, 30, 50, 20}, "second");
  first->wantsFocus = true;
  second->wantsFocus = true;
  window->UI_Activate();
  headless.ProcessEvents();
  first->UI_GainKeyboardFocus();
  // Typed ahead of the focus move: Tab, then "x".
  headless.TypeKey(vk::kTab);
  headless.TypeKey('X');
  headless.ProcessEvents();
  EXPECT_TRUE(second->UI_HasKeyboardFocus(true));
  EXPECT_EQ(first->Typed(), u"");
  EXPECT_EQ(second->Typed(), u"x");
}

TEST_F(WindowInputTest, AltKeysArriveAsSystemMessagesWithTheirModifiers) {
  view->wantsFocus = true;
  window->UI_Activate();
  headless.ProcessEvents();
  view->UI_GainKeyboardFocus();
  headless.PressKey(vk::kAlt);
  headless.TypeKey('F');
  headless.ReleaseKey(vk::kAlt);
  headless.ProcessEvents();
  ASSERT_GE(view->keys.size(), 4u);
  const KeyboardEvent& press = view->keys[1];
  EXPECT_EQ(press.GetOSCode(), 'F');
  EXPECT_EQ(press.GetModKey(), ModifierKeys{kModifierAlt});
  ASSERT_NE(press.GetOSEvent(), nullptr);
  EXPECT_EQ(view->Typed(), u"f");
}

}  // namespace
}  // namespace velkui::ui::test
