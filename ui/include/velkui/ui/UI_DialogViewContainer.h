#pragma once

#include <cstdint>
#include <functional>

#include <boost/intrusive_ptr.hpp>

#include <velkui/ui/UI_SubView.h>

namespace velkui::controls {
class UI_Button;
}

namespace velkui::ui {

// The content node of a dialog: it fills the dialog, draws its background
// and implements the dialog's keys. Return presses the default button (the
// first shown button in the content whose default appearance is set, else the
// OK button); Escape presses the cancel button. Without such a button Return
// and Escape run the installed key callback, else close the dialog with OK or
// cancel (UI_Dialog::DefaultCloseOk and DefaultCloseCancel when the container
// sits in a UI_Dialog, else its own default closes).
//
// Before pressing a button, and before closing with OK by itself, the
// container takes the keyboard focus, so that a field being edited commits
// its text first. Repeated key presses are ignored.
class UI_DialogViewContainer : public UI_SubView {
 public:
  // Dialog responses; subclasses may use further values of their own.
  using Response = std::int32_t;
  static constexpr Response kCancel = 0;
  static constexpr Response kOk = 1;
  // Asked when the dialog closes by default: true keeps it open.
  using PostCloseCallback = std::function<bool(Response response)>;
  using KeyCallback = std::function<void()>;

  // Theme colour of the background (falls back to the window background, 4).
  static constexpr std::uint64_t kBackgroundColor = 140;

  UI_DialogViewContainer();
  ~UI_DialogViewContainer() override;

  // ---- Node operations ----
  // Return or Escape typed into a text field of the dialog (edit fields keep
  // those keys otherwise) is taken before the field sees it, unless
  // SetTextfieldReturnDoNotCloseDialog leaves Return to the field.
  bool UI_DoPreKeyboardEvent(UI_Node* target, const KeyboardEvent& event) override;
  bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) override;
  // The container takes the focus when a key presses a button; Tab passes it by.
  bool UI_WantsKeyboardFocus() const override;
  bool UI_GainKeyboardFocusFromAdvance() override;
  void UI_Draw(pictel::Pictel* context) const override;

  // ---- Keys ----
  bool HandleReturnKey(ModifierKeys modifiers);
  bool HandleEscapeKey(ModifierKeys modifiers);
  // The first shown button below the container, depth first, whose default
  // appearance is set; null when there is none.
  controls::UI_Button* FindDefaultButton() const;

  // ---- Default closes ----
  // Response 1 (OK) and the OK-close-handled flag set to the post-close
  // callback's answer (false without a callback).
  virtual void DefaultCloseOk();
  // Response 0 (cancel) and the cancel-close-handled flag likewise.
  virtual void DefaultCloseCancel();

  // ---- Buttons, response, callbacks ----
  void SetOkButton(boost::intrusive_ptr<controls::UI_Button> button);
  void SetCancelButton(boost::intrusive_ptr<controls::UI_Button> button);
  const boost::intrusive_ptr<controls::UI_Button>& GetOkButton() const { return okButton_; }
  const boost::intrusive_ptr<controls::UI_Button>& GetCancelButton() const { return cancelButton_; }
  Response GetResponse() const { return response_; }
  void SetResponse(Response response) { response_ = response; }
  bool GetOkCloseHandled() const { return okCloseHandled_; }
  bool GetCancelCloseHandled() const { return cancelCloseHandled_; }
  // Clears both close-handled flags.
  void ResetCloseHandled();
  void SetPostCloseCallback(PostCloseCallback callback) { postClose_ = std::move(callback); }
  void SetOnReturnKeyCallback(KeyCallback callback) { onReturnKey_ = std::move(callback); }
  void SetOnEscapeKeyCallback(KeyCallback callback) { onEscapeKey_ = std::move(callback); }
  void SetTextfieldReturnDoNotCloseDialog(bool keep) { textfieldReturnDoesNotClose_ = keep; }
  bool GetTextfieldReturnDoNotCloseDialog() const { return textfieldReturnDoesNotClose_; }

 private:
  // Focus to the container, then the button's own press.
  void PressButton(controls::UI_Button& button, ModifierKeys modifiers);
  bool RunPostCloseCallback(Response response);
  void CloseOk();
  void CloseCancel();

  boost::intrusive_ptr<controls::UI_Button> okButton_;
  boost::intrusive_ptr<controls::UI_Button> cancelButton_;
  Response response_ = kCancel;
  bool okCloseHandled_ = false;
  bool cancelCloseHandled_ = false;
  PostCloseCallback postClose_;
  KeyCallback onReturnKey_;
  KeyCallback onEscapeKey_;
  bool textfieldReturnDoesNotClose_ = false;
  bool filterRegistered_ = false;
};

using DialogViewContainerP = boost::intrusive_ptr<UI_DialogViewContainer>;

}  // namespace velkui::ui
