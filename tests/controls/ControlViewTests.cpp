#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/PopupToggler.h>
#include <velkui/controls/UI_ContainerControlView.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/test/ErrorOf.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

// A control that counts what its hooks see.
class CountingControl : public UI_InteractiveControlView {
 public:
  ~CountingControl() override {
    if (onDestroy) onDestroy();
  }
  std::function<void()> onDestroy;
  int knownChanges = 0;
  int invalidations = 0;
  void KnownValueStateChanged() override { ++knownChanges; }
  void UI_Invalidate(const RectT<std::int32_t>* rect, ui::InvalidateFlags flags) override {
    ++invalidations;
    UI_InteractiveControlView::UI_Invalidate(rect, flags);
  }
  using UI_InteractiveControlView::BeginInteractiveChange;
  using UI_InteractiveControlView::CancelInteractiveChange;
  using UI_InteractiveControlView::ContinueInteractiveChange;
  using UI_InteractiveControlView::FinishInteractiveChange;
};

class ControlViewTest : public ControlTest {
 protected:
  boost::intrusive_ptr<CountingControl> control = Add<CountingControl>({10, 10, 50, 20});
  MessageLog log;
  void SetUp() override { log.Watch(*control); }
  ControlCallbackP Listen(std::function<void()> f) {
    auto p = std::make_shared<ControlCallback>([f](ui::MessageT<ui::UI_Node>*) { f(); });
    control->NotifyWhenChanged(p);
    return p;
  }
};

TEST_F(ControlViewTest, ValueUnknownSettersActOnlyOnAChange) {
  EXPECT_TRUE(control->IsValueUnknown());
  control->invalidations = 0;
  control->SetValueUnknown();
  EXPECT_EQ(control->invalidations, 0);
  EXPECT_EQ(control->knownChanges, 0);
  control->SetValueKnown();
  control->SetValueKnown();
  EXPECT_TRUE(control->IsValueKnown());
  EXPECT_EQ(control->invalidations, 1);
  EXPECT_EQ(control->knownChanges, 1);
  control->SetValueUnknown();
  EXPECT_EQ(control->knownChanges, 2);
}

TEST_F(ControlViewTest, ControlStateBits) {
  EXPECT_EQ(control->GetControlState(true).Get(), 0u);
  control->SetDownState(true);
  control->SetWantsKeyboardFocus(true);
  control->UI_GainKeyboardFocus();
  Move(20, 20);
  EXPECT_EQ(control->GetControlState(true).Get(),
            kControlStateDown | kControlStateRollover | kControlStateFocus);
  control->SetSuppressFocusDrawing(true);
  EXPECT_FALSE(control->GetControlState(true).IsSet(kControlStateFocus));
  control->SetDisabled(true);
  EXPECT_TRUE(control->GetControlState(false).IsSet(kControlStateDisabled));
  EXPECT_FALSE(control->UI_WantsKeyboardFocus()) << "a disabled control wants no focus";
}

TEST_F(ControlViewTest, AnotherControlsCaptureHidesTheRollover) {
  auto other = Add<CountingControl>({100, 10, 50, 20});
  Move(20, 20);
  manager.BeginInputCapture(velkcore::MakeIntrusive<ui::InputCapture>(
      other.get(), MouseEvent(MouseEvent::kButtonDown, 1, 1, {0, 0}, {})));
  EXPECT_FALSE(control->GetControlState(true).IsSet(kControlStateRollover));
  EXPECT_TRUE(control->GetControlState(false).IsSet(kControlStateRollover));
  manager.EndInputCapture(true);
  EXPECT_TRUE(control->GetControlState(true).IsSet(kControlStateRollover));
}

TEST_F(ControlViewTest, AnEmptiedSubscriberIsSkippedAndDroppedAtTheNextSubscription) {
  int calls = 0;
  auto first = Listen([&] { ++calls; });
  control->SendValueChangedMessage();
  EXPECT_EQ(calls, 1);
  *first = nullptr;
  control->SendValueChangedMessage();
  EXPECT_EQ(calls, 1);
  EXPECT_EQ(control->ChangedCallbackSize(), 2u) << "the log's listener and the emptied one";
  Listen([] {});
  EXPECT_EQ(control->ChangedCallbackSize(), 2u);
}

TEST_F(ControlViewTest, ListenersChangedDuringASendFollowTheSnapshot) {
  std::vector<std::string> calls;
  ControlCallbackP second;
  ControlCallbackP added;
  auto first = Listen([&] {
    calls.push_back("first");
    *second = nullptr;  // not reached yet: not called
    added = std::make_shared<ControlCallback>(
        [&](ui::MessageT<ui::UI_Node>*) { calls.push_back("added"); });
    control->NotifyWhenChanged(added);
  });
  second = Listen([&] { calls.push_back("second"); });
  control->SendValueChangedMessage();
  EXPECT_EQ(calls, Log{"first"});
  calls.clear();
  control->SendValueChangedMessage();
  EXPECT_EQ(calls, (Log{"first", "added"}));
}

TEST_F(ControlViewTest, AControlDroppedByAListenerLivesUntilTheSendEnds) {
  bool destroyed = false;
  bool aliveForLaterListener = false;
  control->onDestroy = [&] { destroyed = true; };
  Listen([&] {
    root->ChildRemove(control.get());
    control.reset();
  });
  Listen([&] { aliveForLaterListener = !destroyed; });
  CountingControl* raw = control.get();
  raw->SendValueChangedMessage();
  EXPECT_TRUE(aliveForLaterListener);
  EXPECT_TRUE(destroyed);
}

TEST_F(ControlViewTest, AThrowingListenerEndsTheSendAndThrowsToTheSender) {
  int later = 0;
  Listen([] { throw std::runtime_error("no"); });
  Listen([&] { ++later; });
  EXPECT_THROW(control->SendValueChangedMessage(), std::runtime_error);
  EXPECT_EQ(later, 0);
}

TEST_F(ControlViewTest, MessagesCheckTheirSubject) {
  UI_ControlChangedMessage message(control.get());
  EXPECT_EQ(message.GetControl(), control.get());
  message.SetSubject(root.get());
  const auto error = velkui::test::ErrorOf([&] { message.GetControl(); });  // a root is no control
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetNumber(), velkcore::kInvalidTypeConversionNumber);
}

TEST_F(ControlViewTest, ForwardedMessagesComeFromTheParentControl) {
  auto parent = Add<CountingControl>({100, 100, 100, 100});
  MessageLog parentLog;
  parentLog.SetPrefixed(true);
  parent->UI_SetNodeID("parent");
  parentLog.Watch(*parent);
  UI_ButtonChangedMessage message(control.get(), ui::kModifierShift);
  parent->ForwardControlMessageFromChild(&message);
  EXPECT_EQ(parentLog.Entries(), Log{"parent:changed(2)"});

  UI_InteractiveControlChangedMessage step(control.get(), kContinueChange, ui::kModifierAlt);
  parent->ForwardInteractiveControlMessageFromChild(&step);
  UI_InteractiveControlChangedMessage finish(control.get(), kFinishChange, {});
  parent->ForwardInteractiveControlMessageFromChild(&finish);
  EXPECT_EQ(parentLog.Entries(),
            (Log{"parent:changed(2)", "parent:continue(16)", "parent:finish", "parent:changed"}));
}

TEST_F(ControlViewTest, TheScopedChangeCancelsUnlessFinished) {
  {
    UI_InteractiveControlView::ScBeginAndEndInteractiveChange change(*control);
    change.Continue(ui::kModifierShift);
    change.Finish();
    change.Finish();
  }
  EXPECT_EQ(log.Entries(), (Log{"begin", "continue(2)", "finish"}));
  log.Clear();
  try {
    UI_InteractiveControlView::ScBeginAndEndInteractiveChange change(*control);
    throw std::runtime_error("interrupted");
  } catch (const std::runtime_error&) {
  }
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
}

TEST_F(ControlViewTest, AListenerThrowingOnTheScopedCancelDoesNotTerminate) {
  auto throwing = std::make_shared<ControlCallback>([](ui::MessageT<ui::UI_Node>* m) {
    if (static_cast<UI_InteractiveControlChangedMessage*>(m)->GetChangeMessage() == kCancelChange) {
      throw std::runtime_error("cancel failed");
    }
  });
  control->NotifyWhenChangedInteractively(throwing);
  EXPECT_THROW(
      {
        UI_InteractiveControlView::ScBeginAndEndInteractiveChange change(*control);
        throw std::logic_error("first failure");
      },
      std::logic_error);
  EXPECT_EQ(log.Entries(), (Log{"begin", "cancel"}));
  EXPECT_EQ(control->InteractiveCallbackSize(), 2u);
}

TEST_F(ControlViewTest, TheContainerControlKeepsItsContainerFilled) {
  auto container = Add<UI_ContainerControlView>({0, 0, 10, 10});
  container->UI_SetLocalRectF({20, 30, 200, 100});
  ASSERT_NE(container->GetContainer(), nullptr);
  EXPECT_EQ(container->GetContainer()->UI_GetLocalRectF(true), (RectT<float>{0, 0, 200, 100}));
}

TEST(ControlAlignmentTest, AnchorsFollowTheAlignment) {
  const RectT<float> r{10, 20, 100, 40};
  PointT<float> anchor{};
  EXPECT_EQ(UI_GetPictelTextAlignment(kControlAlignLeft, r, &anchor),
            pictel::TextAlignment::kStart);
  EXPECT_EQ(anchor, (PointT<float>{10, 20}));
  EXPECT_EQ(UI_GetPictelTextAlignment(kControlAlignCenter, r, &anchor),
            pictel::TextAlignment::kCenter);
  EXPECT_EQ(anchor, (PointT<float>{60, 40}));
  EXPECT_EQ(UI_GetPictelTextAlignment(kControlAlignRight, r, &anchor), pictel::TextAlignment::kEnd);
  EXPECT_EQ(anchor, (PointT<float>{110, 60}));
  EXPECT_EQ(UI_GetPictelTextAlignment(static_cast<ControlAlignment>(7), r, &anchor),
            pictel::TextAlignment::kStart);
  EXPECT_EQ(anchor, (PointT<float>{10, 20}));
}

TEST(ColorChangeTest, TheLastReplacementWinsAndAResetClearsTheMap) {
  UI_ColorChangeSupport support;
  support.ReplaceColor(18, 41);
  support.ReplaceColor(18, 42);
  EXPECT_EQ(UI_GetColorFromChangeMap(18, &support.GetColorChangeMap()), 42u);
  support.ResetColors();
  EXPECT_EQ(UI_GetColorFromChangeMap(18, &support.GetColorChangeMap()), 18u);
}

TEST_F(ControlViewTest, ThePopupTogglerIgnoresTheClickThatClosedThePopup) {
  PopupToggler toggler;
  EXPECT_TRUE(toggler.DoPopup());
  toggler.EndPopup();
  now += 0.05;
  EXPECT_FALSE(toggler.DoPopup());
  now += 0.06;
  EXPECT_TRUE(toggler.DoPopup());
}

TEST_F(ControlViewTest, DrawButtonParametersComeFromTheButton) {
  auto button = Add<UI_TextButton>({5, 6, 70, 20}, u"Go");
  button->SetDefaultAppearance(true);
  button->SetStrokeSizes({1.5f, 2.5f});
  button->SetContentOffset({1, 0});
  button->SetDownOffset({0, 1});
  button->SetDownState(true);
  DrawButtonParameters p(button.get());
  EXPECT_TRUE(p.GetDefaultAppearance());
  EXPECT_EQ(p.GetStrokeSize(), 2.5f);
  EXPECT_EQ(p.GetCornerRadius(), UI_TextButton::kDefaultCornerRadius);
  EXPECT_EQ(p.GetRectF(), (RectT<float>{0, 0, 70, 20}));
  EXPECT_EQ(p.GetOffset(), (PointT<float>{1, 1}));
  EXPECT_TRUE(p.GetControlState().IsSet(kControlStateDown));
}

}  // namespace
}  // namespace velkui::controls::test
