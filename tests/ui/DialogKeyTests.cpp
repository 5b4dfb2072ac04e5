// Return, Escape, the close box and the dialog's buttons: which button is
// pressed, which response results, and when the dialog closes.
#include <gtest/gtest.h>

#include <velkui/ui/UI_DialogViewContainer.h>

#include "DialogTestSupport.h"

namespace velkui::ui::test {
namespace {

using Response = UI_Dialog::Response;

class DialogKeyTest : public DialogTest {
 protected:
  // Runs `dialog` modally while `keys` are typed into it.
  void RunTyping(ScriptedDialog& dialog, std::vector<std::int16_t> keys) {
    dialog.during = [this, keys] {
      for (const std::int16_t key : keys) headless.TypeKey(key);
    };
    dialog.RunModal();
  }
};

TEST_F(DialogKeyTest, WithoutButtonsReturnAndEscapeCloseAndACallbackMayKeepTheDialogOpen) {
  auto dialog = MakeDialog(main.get());
  RunTyping(*dialog, {vk::kReturn});
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk);
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_FALSE(dialog->UI_IsShown());
  RunTyping(*dialog, {vk::kEscape});
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
  EXPECT_TRUE(dialog->IsClosing());

  std::vector<Response> asked;
  dialog->SetPostCloseCallback([&](Response response) {
    asked.push_back(response);
    return asked.size() == 1;  // the first close is refused
  });
  RunTyping(*dialog, {vk::kReturn});
  EXPECT_EQ(asked, (std::vector<Response>{UI_Dialog::kOk}));
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk) << "the response is set all the same";
  EXPECT_FALSE(dialog->IsClosing()) << "the queue ran dry with the dialog still open";
  EXPECT_TRUE(dialog->GetDialogViewContainer().GetOkCloseHandled());

  // Keypad Enter is Return too; this time the callback lets it close.
  dialog->during = [this] { headless.TypeKey(vk::kReturn, /*extended=*/true); };
  dialog->RunModal();
  EXPECT_EQ(asked.size(), 2u);
  EXPECT_TRUE(dialog->IsClosing());
  RunTyping(*dialog, {vk::kEscape});
  EXPECT_EQ(asked.back(), UI_Dialog::kCancel);
  EXPECT_TRUE(dialog->IsClosing());
}

TEST_F(DialogKeyTest, ReturnAndEscapePressTheOkAndCancelButtons) {
  auto dialog = MakeDialog(main.get());
  auto ok = AddButton(*dialog, u"OK", {120, 120, 80, 24});
  auto cancel = AddButton(*dialog, u"Cancel", {210, 120, 80, 24});
  const auto okPresses = CountPresses(*ok);
  const auto cancelPresses = CountPresses(*cancel);
  dialog->SetButtons(ok, cancel);
  EXPECT_TRUE(ok->GetDefaultAppearance());

  RunTyping(*dialog, {vk::kReturn});
  EXPECT_EQ(*okPresses, 1);
  EXPECT_EQ(*cancelPresses, 0);
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk);
  EXPECT_TRUE(dialog->IsClosing());

  RunTyping(*dialog, {vk::kEscape});
  EXPECT_EQ(*okPresses, 1);
  EXPECT_EQ(*cancelPresses, 1);
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
  EXPECT_TRUE(dialog->IsClosing());
}

TEST_F(DialogKeyTest, ClickingTheButtonsClosesWithTheirResponse) {
  auto dialog = MakeDialog(main.get());
  auto ok = AddButton(*dialog, u"OK", {120, 120, 80, 24});
  auto cancel = AddButton(*dialog, u"Cancel", {210, 120, 80, 24});
  dialog->SetButtons(ok, cancel);
  dialog->during = [&] { ClickOn(*dialog, *ok); };
  dialog->RunModal();
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk);
  EXPECT_TRUE(dialog->IsClosing());
  dialog->during = [&] { ClickOn(*dialog, *cancel); };
  dialog->RunModal();
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
  EXPECT_TRUE(dialog->IsClosing());

  // Replaced buttons no longer close the dialog; a new OK button is the default one.
  auto apply = AddButton(*dialog, u"Apply", {20, 120, 80, 24});
  dialog->SetOkButton(apply);
  EXPECT_FALSE(ok->GetDefaultAppearance());
  EXPECT_TRUE(apply->GetDefaultAppearance());
  dialog->during = [&] { ClickOn(*dialog, *ok); };
  dialog->RunModal();
  EXPECT_FALSE(dialog->IsClosing());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel) << "each run starts as cancel";
}

TEST_F(DialogKeyTest, EscapePressesTheCancelButtonWithoutTouchingTheResponseItself) {
  // A container that is not inside a UI_Dialog: nothing ties its buttons to
  // closing, so only the key rule itself is at work.
  auto dialog = velkcore::MakeIntrusive<OS_Dialog>(
      Params(main.get()), velkcore::MakeIntrusive<UI_DialogViewContainer>());
  auto& container = static_cast<UI_DialogViewContainer&>(dialog->GetContentContainer());
  auto cancel = MakeView<controls::UI_TextButton>(&container, {10, 10, 80, 24}, u"Cancel");
  const auto presses = CountPresses(*cancel);
  UI_Node* focusWhenPressed = nullptr;
  cancel->NotifyWhenChanged(std::make_shared<controls::ControlCallback>(
      [&](MessageT<UI_Node>*) { focusWhenPressed = UI_Node::UI_GetKeyboardFocusLeafNode(); }));
  container.SetCancelButton(cancel);
  container.SetResponse(UI_DialogViewContainer::kOk);
  bool escapeCallback = false;
  container.SetOnEscapeKeyCallback([&] { escapeCallback = true; });

  dialog->BeginModal();
  container.UI_GainKeyboardFocus();
  headless.TypeKey(vk::kEscape);
  EXPECT_TRUE(dialog->ModalDuring()) << "nothing closed the dialog";
  EXPECT_EQ(*presses, 1);
  EXPECT_EQ(focusWhenPressed, &container) << "the container takes the focus before the press";
  EXPECT_FALSE(escapeCallback) << "the button comes before the callback";
  EXPECT_EQ(container.GetResponse(), UI_DialogViewContainer::kOk);

  // Without the button, the callback; without either, the default close.
  container.SetCancelButton(nullptr);
  headless.TypeKey(vk::kEscape);
  dialog->ModalDuring();
  EXPECT_TRUE(escapeCallback);
  EXPECT_EQ(container.GetResponse(), UI_DialogViewContainer::kOk);
  container.SetOnEscapeKeyCallback(nullptr);
  headless.TypeKey(vk::kEscape);
  dialog->ModalDuring();
  EXPECT_EQ(container.GetResponse(), UI_DialogViewContainer::kCancel);
  EXPECT_FALSE(container.GetCancelCloseHandled());
  dialog->EndModal();
}

TEST_F(DialogKeyTest, ReturnPressesTheShownDefaultButtonBeforeTheOkButton) {
  auto dialog = MakeDialog(main.get());
  auto ok = AddButton(*dialog, u"OK", {120, 120, 80, 24});
  dialog->SetOkButton(ok);
  auto panel = MakeView<UI_SubView>(nullptr, {0, 0, 300, 100});
  dialog->GetContentContainer().ChildInsert(dialog->GetContentContainer().ChildBegin(), panel);
  auto search = MakeView<controls::UI_TextButton>(panel.get(), {10, 10, 80, 24}, u"Search");
  search->SetDefaultAppearance(true);
  const auto searchPresses = CountPresses(*search);
  const auto okPresses = CountPresses(*ok);
  std::vector<Response> asked;
  dialog->SetPostCloseCallback([&](Response r) {
    asked.push_back(r);
    return false;
  });

  EXPECT_EQ(dialog->GetDialogViewContainer().FindDefaultButton(), search.get());
  RunTyping(*dialog, {vk::kReturn});
  EXPECT_EQ(*searchPresses, 1);
  EXPECT_EQ(*okPresses, 0);
  EXPECT_TRUE(asked.empty()) << "the search button does not close the dialog";
  EXPECT_FALSE(dialog->IsClosing());

  // A hidden default button (here: inside a hidden panel) is passed over.
  panel->UI_Show(false);
  EXPECT_EQ(dialog->GetDialogViewContainer().FindDefaultButton(), ok.get());
  RunTyping(*dialog, {vk::kReturn});
  EXPECT_EQ(*searchPresses, 1);
  EXPECT_EQ(*okPresses, 1);
  EXPECT_EQ(asked, (std::vector<Response>{UI_Dialog::kOk}));
}

TEST_F(DialogKeyTest, TheReturnCallbackStandsInForAMissingButtonAndRepeatsAreIgnored) {
  auto dialog = MakeDialog(main.get());
  int returns = 0;
  dialog->GetDialogViewContainer().SetOnReturnKeyCallback([&] { ++returns; });
  dialog->during = [&] {
    headless.PressKey(vk::kReturn);
    headless.PressKey(vk::kReturn);  // auto-repeat
    headless.ReleaseKey(vk::kReturn);
  };
  dialog->RunModal();
  EXPECT_EQ(returns, 1);
  EXPECT_FALSE(dialog->IsClosing());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
}

TEST_F(DialogKeyTest, TheCloseBoxActsLikeEscapeUnlessACloseFunctionKeepsTheDialog) {
  auto dialog = MakeDialog(main.get());
  auto cancel = AddButton(*dialog, u"Cancel", {210, 120, 80, 24});
  dialog->SetCancelButton(cancel);
  const auto presses = CountPresses(*cancel);
  bool veto = true;
  dialog->InstallCloseFunction(
      std::make_shared<OS_Window::CloseFunction>([&](OS_Window&) { return veto; }));
  dialog->during = [&] { headless.UserClose(Handle(*dialog)); };
  dialog->RunModal();
  EXPECT_EQ(*presses, 0);
  EXPECT_FALSE(dialog->IsClosing());
  veto = false;
  dialog->RunModal();
  EXPECT_EQ(*presses, 1);
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kCancel);
}

TEST_F(DialogKeyTest, AFieldBeingEditedGivesUpReturnUnlessItKeepsIt) {
  auto dialog = MakeDialog(main.get());
  auto field = MakeView(&dialog->GetContentContainer(), {10, 10, 120, 22}, "field", log);
  field->wantsFocus = true;
  field->handlesKeyboard = true;  // an edit field keeps Return and Escape
  UI_DialogViewContainer& container = dialog->GetDialogViewContainer();
  UI_Node* focusAtClose = nullptr;
  dialog->SetPostCloseCallback([&](Response) {
    focusAtClose = UI_Node::UI_GetKeyboardFocusLeafNode();
    return false;
  });
  dialog->during = [&] {
    field->UI_GainKeyboardFocus();
    session.GetNodeManager().SetTextEditControlHasFocus(true);
    headless.TypeKey(vk::kReturn);
  };
  container.SetTextfieldReturnDoNotCloseDialog(true);
  dialog->RunModal();
  EXPECT_FALSE(dialog->IsClosing()) << "the field kept Return";
  container.SetTextfieldReturnDoNotCloseDialog(false);
  dialog->RunModal();
  EXPECT_TRUE(dialog->IsClosing());
  EXPECT_EQ(dialog->GetResponse(), UI_Dialog::kOk);
  EXPECT_EQ(focusAtClose, &container) << "the field lost the focus (and committed) first";
  session.GetNodeManager().SetTextEditControlHasFocus(false);
}

TEST_F(DialogKeyTest, ButtonsThatOutliveTheirDialogNoLongerReachIt) {
  boost::intrusive_ptr<controls::UI_TextButton> ok;
  {
    auto dialog = MakeDialog(main.get());
    ok = AddButton(*dialog, u"OK", {120, 120, 80, 24});
    dialog->SetOkButton(ok);
    dialog->GetContentContainer().ChildRemove(dialog->GetContentContainer().ChildFind(ok.get()));
  }
  // The listener was emptied: pressing the button must not reach the dead
  // dialog (the address sanitizer build would report it).
  ok->PerformAction(true, {}, true);
  EXPECT_EQ(ok->GetValue(), controls::kButtonOff);
}

}  // namespace
}  // namespace velkui::ui::test
