#pragma once

#include <functional>
#include <memory>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Strings.h>
#include <velkui/controls/MessageT.h>
#include <velkui/ui/OS_Dialog.h>
#include <velkui/ui/UI_DialogViewContainer.h>

namespace velkui::controls {
class UI_Button;
}

namespace velkui::ui {

// A dialog with OK and cancel buttons, the Return and Escape keys, a response
// and a remembered place on the screen.
//
// Its content container is a UI_DialogViewContainer. The OK and cancel
// buttons close the dialog when pressed (DefaultCloseOk, DefaultCloseCancel);
// so do Return and Escape through them, or by themselves when the dialog has
// no such button (see UI_DialogViewContainer). A post-close callback may keep
// the dialog open. The close box acts like Escape.
//
// Every modal run starts with the initial response (cancel, 0, unless set):
// a run ended by the quit request, or (headless) by an empty queue, reports it.
//
// Placement: a dialog whose node ID is not the default "UI_Dialog" remembers
// where the user left it through the PrefManager (when there is one), under
// its node ID. Call Position before showing it; closing it saves the place.
class UI_Dialog : public OS_Dialog {
 public:
  using Response = UI_DialogViewContainer::Response;
  static constexpr Response kOk = UI_DialogViewContainer::kOk;
  static constexpr Response kCancel = UI_DialogViewContainer::kCancel;
  using PostCloseCallback = UI_DialogViewContainer::PostCloseCallback;

  explicit UI_Dialog(const DialogParams& params);
  ~UI_Dialog() override;

  // ---- OS_Dialog ----
  // Resets the response to the initial one and the close-handled flags.
  void BeginModal() override;
  bool OnReturnKey(ModifierKeys modifiers) override;
  bool OnEscapeKey(ModifierKeys modifiers) override;
  void OnCloseButton() override;

  // ---- Appended virtual operations, in slot order ----
  virtual void SetResponse(Response response);
  // Ignored while the dialog is closing: saves the placement, sets the
  // response through the container's default close and closes the dialog
  // (PostClose) unless the post-close callback answered true.
  virtual void DefaultCloseOk();
  virtual void DefaultCloseCancel();

  Response GetResponse() const { return container_->GetResponse(); }
  // The response every modal run starts with.
  void SetInitialResponse(Response response) { initialResponse_ = response; }
  Response GetInitialResponse() const { return initialResponse_; }
  UI_DialogViewContainer& GetDialogViewContainer() const { return *container_; }

  // ---- Buttons ----
  // The OK button gets the default appearance (a previous one loses it);
  // pressing it closes the dialog with OK. Null removes it.
  void SetOkButton(boost::intrusive_ptr<controls::UI_Button> button);
  // Pressing the cancel button closes the dialog with cancel. Null removes it.
  void SetCancelButton(boost::intrusive_ptr<controls::UI_Button> button);
  void SetButtons(boost::intrusive_ptr<controls::UI_Button> ok,
                  boost::intrusive_ptr<controls::UI_Button> cancel);
  // Gives the keyboard focus to the OK (cancel) button, when there is one.
  void SetOkButtonOnFocus();
  void SetCancelButtonOnFocus();
  void SetPostCloseCallback(PostCloseCallback callback);

  // ---- Placement ----
  // Whether the placement is remembered: a node ID of its own and a PrefManager.
  bool RemembersPosition() const;
  // Moves the dialog to its remembered position (kept reachable on the
  // current monitors), or centres it when there is none.
  void Position();
  // Stores the frame's position (when the placement is remembered).
  void SavePosition() const;

 private:
  using ButtonCallback = std::function<void(MessageT<UI_Node>*)>;

  // A listener on `button` that calls `close`; the old listener is emptied.
  void Subscribe(const boost::intrusive_ptr<controls::UI_Button>& button,
                 std::shared_ptr<ButtonCallback>& listener, void (UI_Dialog::*close)());
  velkcore::UTF16String PositionKey() const;

  DialogViewContainerP container_;
  Response initialResponse_ = kCancel;
  std::shared_ptr<ButtonCallback> okListener_;
  std::shared_ptr<ButtonCallback> cancelListener_;
};

using UI_DialogP = boost::intrusive_ptr<UI_Dialog>;

}  // namespace velkui::ui
