#pragma once

// Dialogs on the headless backend: a dialog whose modal run can be scripted,
// text buttons in its content, and the main window it belongs to.

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <velkui/controls/UI_TextButton.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/UI_Dialog.h>

#include "WindowTestSupport.h"

namespace velkui::ui::test {

// A UI_Dialog that runs `during` right after BeginModal, when the dialog is
// shown and active: what a user does while the dialog is up goes there.
class ScriptedDialog : public UI_Dialog {
 public:
  using UI_Dialog::UI_Dialog;
  void BeginModal() override {
    UI_Dialog::BeginModal();
    ++runs;
    if (during) during();
  }
  std::function<void()> during;
  int runs = 0;
};

using ScriptedDialogP = boost::intrusive_ptr<ScriptedDialog>;

class DialogTest : public WindowTest {
 protected:
  DialogTest() { main = MakeWindow({100, 100, 800, 500}, kStyleOverlappedWindow); }

  static DialogParams Params(OS_Window* parent, std::u16string title = u"Dialog") {
    DialogParams params;
    params.title = std::move(title);
    params.size = {300, 160};
    params.parent = parent;
    return params;
  }
  ScriptedDialogP MakeDialog(OS_Window* parent) {
    return velkcore::MakeIntrusive<ScriptedDialog>(Params(parent));
  }
  // A shown text button in the dialog's content.
  static boost::intrusive_ptr<controls::UI_TextButton> AddButton(UI_Dialog& dialog,
                                                                 const std::u16string& text,
                                                                 const RectT<float>& frame) {
    return MakeView<controls::UI_TextButton>(&dialog.GetContentContainer(), frame, text);
  }
  // Counts the changed messages of `button`.
  std::shared_ptr<int> CountPresses(controls::UI_Button& button) {
    auto count = std::make_shared<int>(0);
    auto listener =
        std::make_shared<controls::ControlCallback>([count](MessageT<UI_Node>*) { ++*count; });
    button.NotifyWhenChanged(listener);
    listeners_.push_back(listener);
    return count;
  }
  // Clicks the middle of `node` (in `window`) with the left button.
  void ClickOn(OS_Window& window, const UI_Node& node) {
    const RectT<float> r = node.UI_LocalToGlobalF(node.UI_GetLocalRectF(false));
    MoveTo(window, static_cast<std::int32_t>(r.left + r.width / 2),
           static_cast<std::int32_t>(r.top + r.height / 2));
    headless.Click();
  }
  bool Enabled(OS_Window& window) { return headless.IsWindowEnabled(Handle(window)); }

  OS_WindowP main;

 private:
  std::vector<std::shared_ptr<controls::ControlCallback>> listeners_;
};

}  // namespace velkui::ui::test
