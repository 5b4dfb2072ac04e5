// The modal run: what it blocks and gives back, runs one after the other, the
// quit request, handlers that throw, and the dialog window itself (styles,
// size, centring).
#include <gtest/gtest.h>

#include <algorithm>
#include <stdexcept>

#include <velkcore/Error.h>
#include <velkui/ui/MonitorInfo.h>

#include "DialogTestSupport.h"

namespace velkui::ui::test {
namespace {

class DialogModalTest : public DialogTest {
 protected:
  // Escape, which closes a dialog without buttons.
  void CloseWithEscape(ScriptedDialog& dialog) {
    dialog.during = [this] { headless.TypeKey(vk::kEscape); };
  }
};

TEST_F(DialogModalTest, ASecondRunWorksAndStartsAsCancel) {
  auto dialog = MakeDialog(main.get());
  dialog->during = [&] { headless.TypeKey(vk::kReturn); };
  dialog->RunModal();
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk);
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_FALSE(dialog->IsModal());

  // The closing flag of the first run does not end the second at once.
  UI_Dialog::Response atStart = -1;
  dialog->during = [&] {
    atStart = dialog->GetResponse();
    EXPECT_FALSE(dialog->IsClosing());
    EXPECT_TRUE(dialog->IsModal());
    headless.TypeKey(vk::kEscape);
  };
  dialog->RunModal();
  EXPECT_EQ(atStart, UI_Dialog::kCancel);
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
  EXPECT_EQ(dialog->runs, 2);

  // A host's initial response is where every run starts.
  dialog->SetInitialResponse(7);
  dialog->during = {};
  dialog->RunModal();
  EXPECT_EQ(dialog->GetResponse(), 7);
}

TEST_F(DialogModalTest, TheQuitRequestEndsTheRunAsCancelAndReachesTheOuterLoop) {
  auto dialog = MakeDialog(main.get());
  dialog->during = [&] { headless.TypeKey(vk::kReturn); };
  dialog->RunModal();
  ASSERT_EQ(dialog->GetResponse(), UI_Dialog::kOk);

  int keysAfterQuit = 0;
  dialog->GetDialogViewContainer().SetOnEscapeKeyCallback([&] { ++keysAfterQuit; });
  dialog->during = [&] {
    OS_PostQuit(5);
    // The quit request comes once the queue is idle: this key is handled first.
    headless.TypeKey(vk::kEscape);
  };
  dialog->RunModal();
  EXPECT_TRUE(dialog->WasEndedByQuit());
  EXPECT_FALSE(dialog->IsClosing());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel) << "not the OK of the run before";
  EXPECT_EQ(keysAfterQuit, 1);
  EXPECT_FALSE(dialog->UI_IsShown());
  EXPECT_TRUE(Enabled(*main));
  // The application's own loop ends too.
  EXPECT_TRUE(headless.IsQuitting());
  EXPECT_EQ(headless.GetExitCode(), 5);
  EXPECT_EQ(OS_RunMessageLoop([] { return false; }), PumpResult::kQuit);
  // A dialog run while quitting ends at once.
  dialog->during = [&] { headless.TypeKey(vk::kReturn); };
  dialog->RunModal();
  EXPECT_TRUE(dialog->WasEndedByQuit());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
  headless.ClearQuitting();
}

TEST_F(DialogModalTest, TheRunBlocksTheOtherWindowsAndGivesThemBack) {
  auto other = MakeWindow({950, 100, 200, 200}, kStyleOverlappedWindow);
  auto alreadyDisabled = MakeWindow({950, 400, 200, 100}, kStyleOverlappedWindow);
  alreadyDisabled->UI_SetDisabled(true);
  auto tip = MakeWindow({10, 10, 50, 20}, kStylePopup, kExStyleNoActivate);
  auto dialog = MakeDialog(main.get());
  auto owned = MakeWindow({20, 20, 40, 40}, kStylePopup);
  owned->SetOwner(dialog.get());
  auto focused = View(main.get(), {10, 10, 50, 20}, "focused");
  focused->wantsFocus = true;
  main->UI_Activate();
  headless.ProcessEvents();
  focused->UI_GainKeyboardFocus();
  dialog->during = [&] {
    EXPECT_FALSE(Enabled(*main));
    EXPECT_FALSE(Enabled(*other));
    EXPECT_TRUE(main->UI_IsDisabled());
    EXPECT_TRUE(Enabled(*tip)) << "pop-ups that never activate are left alone";
    EXPECT_TRUE(Enabled(*owned)) << "the dialog's own windows stay usable";
    EXPECT_TRUE(Enabled(*dialog));
    EXPECT_EQ(session.GetNodeManager().GetModalWindow(), dialog.get());
    EXPECT_EQ(headless.GetActiveWindow(), Handle(*dialog));
    // Clicks on the blocked main window do not arrive.
    focused->handlesMouse = true;
    ClickOn(*main, *focused);
    headless.TypeKey(vk::kEscape);
  };
  ClearLog();
  dialog->RunModal();
  EXPECT_TRUE(std::none_of(log->begin(), log->end(),
                           [](const std::string& e) { return e.starts_with("focused:mouse"); }));
  EXPECT_TRUE(Enabled(*main));
  EXPECT_FALSE(main->UI_IsDisabled());
  EXPECT_TRUE(Enabled(*other));
  EXPECT_FALSE(Enabled(*alreadyDisabled)) << "it was disabled before the run";
  EXPECT_FALSE(session.GetNodeManager().HasModalWindow());
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetActiveWindow(), Handle(*main));
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), focused.get()) << "the focus comes back";
}

TEST_F(DialogModalTest, ADialogOfTheDesktopBlocksNothing) {
  auto dialog = MakeDialog(nullptr);
  EXPECT_EQ(dialog->GetDialogParent(), nullptr);
  dialog->during = [&] {
    EXPECT_TRUE(Enabled(*main));
    headless.TypeKey(vk::kEscape);
  };
  dialog->RunModal();
  EXPECT_TRUE(Enabled(*main));
  // A window the host disabled itself stays disabled after the run.
  main->UI_SetDisabled(true);
  dialog->during = [&] { headless.TypeKey(vk::kEscape); };
  dialog->RunModal();
  EXPECT_FALSE(Enabled(*main));
}

TEST_F(DialogModalTest, BlockedWindowsComeBackEvenWhenTheParentDiesDuringTheRun) {
  auto other = MakeWindow({950, 100, 200, 200}, kStyleOverlappedWindow);
  auto doomed = MakeWindow({950, 400, 200, 100}, kStyleOverlappedWindow);
  auto dialog = MakeDialog(main.get());
  dialog->during = [&] {
    ASSERT_FALSE(Enabled(*other));
    main.reset();
    doomed.reset();
    headless.TypeKey(vk::kEscape);
  };
  dialog->RunModal();
  EXPECT_EQ(dialog->GetDialogParent(), nullptr);
  EXPECT_TRUE(Enabled(*other));
}

TEST_F(DialogModalTest, AHandlerThatThrowsStillEndsTheRun) {
  auto dialog = MakeDialog(main.get());
  dialog->GetDialogViewContainer().SetOnEscapeKeyCallback(
      [] { throw std::runtime_error("handler failed"); });
  dialog->during = [&] { headless.TypeKey(vk::kEscape); };
  EXPECT_THROW(dialog->RunModal(), std::runtime_error);
  EXPECT_FALSE(dialog->IsModal());
  EXPECT_TRUE(Enabled(*main));
  EXPECT_FALSE(session.GetNodeManager().HasModalWindow());
  EXPECT_FALSE(dialog->UI_IsShown());
  headless.ProcessEvents();  // what the throw left in the queue
}

TEST_F(DialogModalTest, AHostCanDriveTheRunItself) {
  auto other = MakeWindow({950, 100, 200, 200}, kStyleOverlappedWindow);
  auto dialog = MakeDialog(main.get());
  dialog->BeginModal();
  EXPECT_TRUE(dialog->ModalDuring()) << "nothing to do yet";
  EXPECT_FALSE(Enabled(*other));
  headless.TypeKey(vk::kReturn);
  EXPECT_FALSE(dialog->ModalDuring());
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_TRUE(dialog->UI_IsShown()) << "still shown until the run ends";
  dialog->EndModal();
  EXPECT_FALSE(dialog->UI_IsShown());
  EXPECT_TRUE(Enabled(*other));
  dialog->EndModal();  // nothing left to end

  // A dialog destroyed in the middle of a run gives the windows back.
  dialog->BeginModal();
  EXPECT_FALSE(Enabled(*other));
  dialog.reset();
  EXPECT_TRUE(Enabled(*other));
  EXPECT_TRUE(Enabled(*main));
  EXPECT_FALSE(session.GetNodeManager().HasModalWindow());
}

TEST_F(DialogModalTest, AModelessDialogClosesByHidingAndOpensAgainWhenShown) {
  auto dialog = MakeDialog(main.get());
  dialog->UI_Show(true);
  headless.ProcessEvents();
  headless.TypeKey(vk::kReturn);
  headless.ProcessEvents();
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_FALSE(dialog->UI_IsShown());
  dialog->UI_Show(true);
  EXPECT_FALSE(dialog->IsClosing());
  headless.ProcessEvents();
  headless.TypeKey(vk::kEscape);
  headless.ProcessEvents();
  EXPECT_FALSE(dialog->UI_IsShown());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
}

TEST_F(DialogModalTest, FrameStylesFollowTheKindAndTheCloseBoxSetting) {
  auto styleOf = [&](DialogParams params) {
    auto dialog = velkcore::MakeIntrusive<OS_Dialog>(params);
    return std::make_pair(dialog->GetStyle(), dialog->GetExStyle());
  };
  DialogParams params = Params(main.get());
  EXPECT_EQ(styleOf(params), std::make_pair(0x86C80080u, 0x10101u));
  params.resizable = true;
  EXPECT_EQ(styleOf(params), std::make_pair(0x86CC0080u, 0x10101u));
  session.GetNodeManager().GetCustomSettingsManager().SetBoolean(OS_Dialog::kShowCloseBoxSetting,
                                                                 false);
  params.resizable = false;
  EXPECT_EQ(styleOf(params), std::make_pair(0x86C00080u, 0x10101u));
  params.popup = true;
  EXPECT_EQ(styleOf(params), std::make_pair(0x84000000u, 0x10000u));
  params.style = kStylePopup | kStyleCaption;
  params.extendedStyle = 0u;
  EXPECT_EQ(styleOf(params), std::make_pair(kStylePopup | kStyleCaption, 0u));
  // The platform sees the dialog as owned by its parent's window.
  auto dialog = MakeDialog(main.get());
  EXPECT_EQ(dialog->GetOwner(), main.get());
}

TEST_F(DialogModalTest, TheContentFillsTheClientAreaWithinTheSizeLimits) {
  DialogParams params = Params(main.get());
  params.center = false;
  params.position = {40, 30};
  params.resizable = true;
  auto dialog = velkcore::MakeIntrusive<UI_Dialog>(params);
  const RectT<std::int32_t> client = headless.GetClientRect(Handle(*dialog));
  EXPECT_EQ(client.width, 300);
  EXPECT_EQ(client.height, 160);
  const RectT<std::int32_t> frame = dialog->UI_GetGlobalStructureRect();
  EXPECT_EQ(frame.left, 40);
  EXPECT_EQ(frame.top, 30);
  UI_SubView& content = dialog->GetContentContainer();
  EXPECT_EQ(content.UI_GetLocalRectF(true), (RectT<float>{0, 0, 300, 160}));
  ASSERT_EQ(dialog->ChildSize(), 1u);

  dialog->SetContentSize({420, 200});
  EXPECT_EQ(content.UI_GetLocalRectF(true), (RectT<float>{0, 0, 420, 200}));
  EXPECT_EQ(dialog->UI_GetGlobalStructureRect().left, 40) << "the frame keeps its corner";
  dialog->SetMinimumSize({200, 100});
  dialog->SetMaximumSize({500, 400});
  dialog->SetContentSize({100, 900});
  EXPECT_EQ(content.UI_GetLocalRectF(true), (RectT<float>{0, 0, 200, 400}));
  EXPECT_THROW(dialog->SetMinimumSize({600, 100}), velkcore::Exception);
  EXPECT_THROW(dialog->SetContentSize({-1, 10}), velkcore::Exception);

  // The user resizes the frame: the content follows.
  dialog->UI_Show(true);
  headless.ProcessEvents();
  const RectT<std::int32_t> now = headless.GetClientRect(Handle(*dialog));
  headless.UserSetClientRect(Handle(*dialog), {now.left, now.top, 350, 250});
  headless.ProcessEvents();
  EXPECT_EQ(content.UI_GetLocalRectF(true), (RectT<float>{0, 0, 350, 250}));
}

TEST_F(DialogModalTest, CentringUsesTheShownParentElseThePrimaryMonitor) {
  // main: client (100, 100) 800 x 500 inside a captioned frame.
  auto dialog = MakeDialog(main.get());
  const RectT<std::int32_t> parent = main->UI_GetGlobalStructureRect();
  RectT<std::int32_t> frame = dialog->UI_GetGlobalStructureRect();
  EXPECT_EQ(frame.left, parent.left + (parent.width - frame.width) / 2);
  EXPECT_EQ(frame.top, parent.top + (parent.height - frame.height) / 2);

  main->UI_Show(false);
  dialog->Center();
  frame = dialog->UI_GetGlobalStructureRect();
  // The default monitor: 1440 x 900 with a 40-pixel panel at the bottom.
  EXPECT_EQ(frame.left, (1440 - frame.width) / 2);
  EXPECT_EQ(frame.top, (860 - frame.height) / 2);

  // A parent mostly off screen: the dialog stays reachable.
  main->UI_Show(true);
  main->UI_Move({1300, 800});
  dialog->Center();
  EXPECT_TRUE(OS_MonitorInfo().IsRectVisible(dialog->UI_GetGlobalStructureRect()));
}

}  // namespace
}  // namespace velkui::ui::test
