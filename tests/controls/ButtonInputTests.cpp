#include <gtest/gtest.h>

#include <velkui/controls/ButtonInputCapture.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/ui/CustomSettingsManager.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

class ButtonInputTest : public ControlTest {
 protected:
  boost::intrusive_ptr<UI_TextButton> button = Add<UI_TextButton>({10, 10, 80, 22}, u"OK");
  MessageLog log;

  void SetUp() override { log.Watch(*button); }
};

TEST_F(ButtonInputTest, APressReleasedInsideFiresOnceInOrderAndPopsBackUp) {
  Move(20, 20);
  Press(20, 20, ui::kModifierShift);
  EXPECT_TRUE(button->GetDownState());
  EXPECT_TRUE(UI_Button::IsButtonCaptured());
  EXPECT_EQ(log.Entries(), Log{"begin"});
  Release(21, 21, ui::kModifierControl);
  // The release's modifiers travel with the message and the continue step.
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(4)", "continue(4)", "finish"}));
  EXPECT_FALSE(button->GetDownState());
  EXPECT_EQ(button->GetValue(), kButtonOff);
  EXPECT_TRUE(button->IsValueKnown());
  EXPECT_FALSE(manager.HasInputCapture());
  EXPECT_TRUE(button->UI_HasKeyboardFocus(true)) << "a click takes the focus";
}

TEST_F(ButtonInputTest, DraggingOffAndBackTracksTheDownStateAndReleaseOutsideCancels) {
  Press(20, 20);
  Move(200, 200);
  EXPECT_FALSE(button->GetDownState());
  Move(30, 25);
  EXPECT_TRUE(button->GetDownState());
  Move(300, 20);
  Release(300, 20);
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
  EXPECT_FALSE(button->GetDownState());

  // The same for a toggle that was on: its down state comes back.
  log.Clear();
  button->SetSpringLoaded(false);
  button->SetValue(kButtonOn);
  Press(20, 20);
  EXPECT_FALSE(button->GetDownState());
  Release(300, 20);
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
  EXPECT_TRUE(button->GetDownState());
  EXPECT_EQ(button->GetValue(), kButtonOn);
}

TEST_F(ButtonInputTest, EscapeDuringThePressCancels) {
  Press(20, 20);
  KeyDown(kVkEscape);
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
  Release(20, 20);
  EXPECT_EQ(log.Entries().size(), 2u) << "the release after a cancel does nothing";
}

TEST_F(ButtonInputTest, AToggleFlipsItsValueOnEachClick) {
  button->SetSpringLoaded(false);
  Click(20, 20);
  EXPECT_EQ(button->GetValue(), kButtonOn);
  EXPECT_TRUE(button->GetDownState());
  Click(20, 20);
  EXPECT_EQ(button->GetValue(), kButtonOff);
  EXPECT_FALSE(button->GetDownState());
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish", "begin",
                                "changed(0)", "continue(0)", "finish"}));
}

TEST_F(ButtonInputTest, NotificationOnMouseDownOrUpFiresOnThatEventOnly) {
  button->SetNotificationOnMouseDown(true);
  Press(20, 20, ui::kModifierAlt);
  EXPECT_EQ(log.Entries(), Log{"changed(16)"});
  EXPECT_FALSE(manager.HasInputCapture());
  Release(20, 20);
  EXPECT_EQ(log.Entries(), Log{"changed(16)"});

  log.Clear();
  button->SetNotificationOnMouseDown(false);
  button->SetNotificationOnMouseUp(true);
  Release(20, 20);
  EXPECT_EQ(log.Entries(), Log{"changed(0)"});
}

TEST_F(ButtonInputTest, ADisabledButtonIgnoresPressesAndKeys) {
  button->SetDisabled(true);
  Click(20, 20);
  button->UI_GainKeyboardFocus();
  KeyDown(kVkSpace);
  KeyUp(kVkSpace);
  EXPECT_TRUE(log.Entries().empty());
  EXPECT_FALSE(button->GetDownState());
}

TEST_F(ButtonInputTest, SpaceActivatesAFocusedButtonOnRelease) {
  button->UI_GainKeyboardFocus();
  EXPECT_TRUE(KeyDown(kVkSpace));
  EXPECT_TRUE(button->GetDownState());
  EXPECT_TRUE(log.Entries().empty());
  EXPECT_TRUE(KeyUp(kVkSpace));
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish"}));
  EXPECT_FALSE(button->GetDownState());
  // A release without a press does nothing for a push button.
  log.Clear();
  EXPECT_FALSE(KeyUp(kVkSpace));
  EXPECT_TRUE(log.Entries().empty());
}

TEST_F(ButtonInputTest, ReturnActivatesATextButtonOnlyWithLegacyActivation) {
  button->UI_GainKeyboardFocus();
  KeyDown(kVkReturn);
  KeyUp(kVkReturn);
  EXPECT_TRUE(log.Entries().empty());
  button->SetSupportLegacyWindowsKeyboardActivation(true);
  KeyDown(kVkReturn);
  Key(KeyboardEvent::kKeyDown, kVkReturn, {}, {}, true);  // auto-repeated: ignored
  KeyUp(kVkReturn);
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish"}));
}

TEST_F(ButtonInputTest, EscapeRemovesTheFocusUnlessTheSettingIsOff) {
  button->UI_GainKeyboardFocus();
  EXPECT_FALSE(KeyDown(kVkEscape)) << "the key is left for others";
  EXPECT_FALSE(button->UI_HasKeyboardFocus(true));

  manager.GetCustomSettingsManager().SetBoolean("velkui.controls.UI_Button.LoseFocusOnESC", false);
  button->UI_GainKeyboardFocus();
  KeyDown(kVkEscape);
  EXPECT_TRUE(button->UI_HasKeyboardFocus(true));
}

TEST_F(ButtonInputTest, HoverMessagesGoOutForMovesOnly) {
  log.WatchHover(*button);
  Move(20, 20);
  Press(20, 20);
  Release(20, 20);
  EXPECT_EQ(log.Entries().front(), "hover(3)");
  EXPECT_EQ(std::count(log.Entries().begin(), log.Entries().end(), "hover(3)"), 1);
}

// ---- Auto-repeat on the virtual clock ----

class AutoRepeatTest : public ButtonInputTest {
 protected:
  int Continues() const {
    return static_cast<int>(
        std::count_if(log.Entries().begin(), log.Entries().end(),
                      [](const std::string& e) { return e.starts_with("continue"); }));
  }
};

TEST_F(AutoRepeatTest, HoldingRepeatsAfterAQuarterSecondAndTheReleaseAddsNoContinue) {
  Press(20, 20);
  ASSERT_EQ(LiveTimers(*button), 1u) << "interactive listeners ask for auto-repeat";
  Advance(*button, 0.25, 0.05);
  EXPECT_EQ(Continues(), 0) << "nothing within the first quarter second";
  Advance(*button, 0.75, 0.05);
  EXPECT_EQ(Continues(), 15);
  Release(20, 20);
  EXPECT_EQ(log.Entries().front(), "begin");
  EXPECT_EQ(log.Entries()[1], "continue(0)");
  const Log tail(log.Entries().end() - 2, log.Entries().end());
  EXPECT_EQ(tail, (Log{"changed(0)", "finish"}));
  EXPECT_EQ(Continues(), 15);
  EXPECT_EQ(LiveTimers(*button), 0u);
}

TEST_F(AutoRepeatTest, NoRepeatWhileThePointerIsOffTheButton) {
  Press(20, 20);
  Move(300, 300);
  Advance(*button, 1.0, 0.05);
  EXPECT_EQ(Continues(), 0);
  Release(300, 300);
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
  EXPECT_EQ(LiveTimers(*button), 0u) << "a cancelled capture removes its timer";
}

TEST_F(AutoRepeatTest, ADisabledButtonStopsRepeatingAndReturnsToItsInitialState) {
  Press(20, 20);
  Advance(*button, 0.5, 0.05);
  const int before = Continues();
  EXPECT_GT(before, 0);
  button->SetDisabled(true);
  Advance(*button, 0.5, 0.05);
  EXPECT_EQ(Continues(), before);
  Release(20, 20);
  EXPECT_FALSE(button->GetDownState());
  EXPECT_EQ(log.Entries().back(), "finish");
  EXPECT_EQ(std::count_if(log.Entries().begin(), log.Entries().end(),
                          [](const std::string& e) { return e.starts_with("changed"); }),
            0);
  EXPECT_EQ(LiveTimers(*button), 0u);
}

TEST_F(AutoRepeatTest, WithoutInteractiveListenersThereIsNoTimer) {
  auto plain = Add<UI_TextButton>({200, 10, 80, 22}, u"Plain");
  Press(210, 20);
  EXPECT_EQ(LiveTimers(*plain), 0u);
  auto* capture = dynamic_cast<ButtonInputCapture*>(manager.GetInputCapture());
  ASSERT_NE(capture, nullptr);
  EXPECT_EQ(capture->GetRepeatInterval(), 0.0f);
  Release(210, 20);
}

// ---- Listeners that change things while a message is sent ----

TEST_F(ButtonInputTest, AListenerMayDestroyTheButtonWhileTheMessageIsSent) {
  auto gone = std::make_shared<ControlCallback>([this](ui::MessageT<ui::UI_Node>*) {
    root->ChildRemove(button.get());
    button.reset();
  });
  button->NotifyWhenChanged(gone);
  Click(20, 20);
  EXPECT_EQ(button, nullptr);
  EXPECT_EQ(root->ChildSize(), 0u);
  EXPECT_FALSE(manager.HasInputCapture());
}

TEST_F(ButtonInputTest, AThrowingListenerEndsThePressWithACancel) {
  button->NotifyWhenChanged(std::make_shared<ControlCallback>(
      [](ui::MessageT<ui::UI_Node>*) { throw std::runtime_error("listener failed"); }));
  Press(20, 20);
  EXPECT_THROW(Release(20, 20), std::runtime_error);
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "cancel"}));
  EXPECT_FALSE(manager.HasInputCapture());
}

TEST_F(ButtonInputTest, PerformActionIsTheProgrammaticPress) {
  button->PerformAction(true, ui::kModifierShift, true);
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(2)", "continue(2)", "finish"}));
  log.Clear();
  button->PerformAction(true, {}, false);
  EXPECT_EQ(log.Entries(), Log{"changed(0)"});
  log.Clear();
  button->SetDisabled(true);
  button->PerformAction(true, {}, true);
  EXPECT_TRUE(log.Entries().empty());
}

TEST_F(ButtonInputTest, SetValueMakesTheValueKnownAndSendsNothing) {
  button->SetSpringLoaded(false);
  EXPECT_TRUE(button->IsValueUnknown());
  button->SetValue(kButtonOn);
  EXPECT_TRUE(button->IsValueKnown());
  EXPECT_TRUE(button->GetDownState());
  button->SetValue(kButtonOff);
  EXPECT_FALSE(button->GetDownState());
  EXPECT_TRUE(log.Entries().empty());
}

}  // namespace
}  // namespace velkui::controls::test
