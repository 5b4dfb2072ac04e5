#include <velkui/ui/UI_Dialog.h>

#include <velkcore/RefCountedObject.h>
#include <velkui/controls/UI_Button.h>
#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/PrefManager.h>

#include "NodeHold.h"

namespace velkui::ui {

namespace {

constexpr const char* kDefaultNodeID = "UI_Dialog";

}  // namespace

UI_Dialog::UI_Dialog(const DialogParams& params)
    : OS_Dialog(params, velkcore::MakeIntrusive<UI_DialogViewContainer>()) {
  UI_SetNodeID(kDefaultNodeID);
  container_ = DialogViewContainerP(static_cast<UI_DialogViewContainer*>(&GetContentContainer()));
}

UI_Dialog::~UI_Dialog() {
  // The buttons may outlive the dialog: their listeners must not reach it.
  if (okListener_) *okListener_ = nullptr;
  if (cancelListener_) *cancelListener_ = nullptr;
}

// ---- Modal run and keys ----

void UI_Dialog::BeginModal() {
  SetResponse(initialResponse_);
  container_->ResetCloseHandled();
  OS_Dialog::BeginModal();
}

bool UI_Dialog::OnReturnKey(ModifierKeys modifiers) {
  return container_->HandleReturnKey(modifiers);
}

bool UI_Dialog::OnEscapeKey(ModifierKeys modifiers) {
  return container_->HandleEscapeKey(modifiers);
}

void UI_Dialog::OnCloseButton() {
  container_->HandleEscapeKey({});
}

// ---- Response and default closes ----

void UI_Dialog::SetResponse(Response response) {
  container_->SetResponse(response);
}

void UI_Dialog::DefaultCloseOk() {
  if (IsClosing()) return;
  const NodeP keep = detail::Hold(this);
  SavePosition();
  container_->DefaultCloseOk();
  if (!container_->GetOkCloseHandled()) PostClose();
}

void UI_Dialog::DefaultCloseCancel() {
  if (IsClosing()) return;
  const NodeP keep = detail::Hold(this);
  SavePosition();
  container_->DefaultCloseCancel();
  if (!container_->GetCancelCloseHandled()) PostClose();
}

// ---- Buttons ----

void UI_Dialog::Subscribe(const boost::intrusive_ptr<controls::UI_Button>& button,
                          std::shared_ptr<ButtonCallback>& listener, void (UI_Dialog::*close)()) {
  // An emptied callback is how a listener leaves the button's list.
  if (listener) *listener = nullptr;
  listener.reset();
  if (!button) return;
  listener =
      std::make_shared<ButtonCallback>([this, close](MessageT<UI_Node>*) { (this->*close)(); });
  button->NotifyWhenChanged(listener);
}

void UI_Dialog::SetOkButton(boost::intrusive_ptr<controls::UI_Button> button) {
  if (const auto& previous = container_->GetOkButton(); previous && previous != button) {
    previous->SetDefaultAppearance(false);
  }
  if (button) button->SetDefaultAppearance(true);
  Subscribe(button, okListener_, &UI_Dialog::DefaultCloseOk);
  container_->SetOkButton(std::move(button));
}

void UI_Dialog::SetCancelButton(boost::intrusive_ptr<controls::UI_Button> button) {
  Subscribe(button, cancelListener_, &UI_Dialog::DefaultCloseCancel);
  container_->SetCancelButton(std::move(button));
}

void UI_Dialog::SetButtons(boost::intrusive_ptr<controls::UI_Button> ok,
                           boost::intrusive_ptr<controls::UI_Button> cancel) {
  SetOkButton(std::move(ok));
  SetCancelButton(std::move(cancel));
}

void UI_Dialog::SetOkButtonOnFocus() {
  if (const auto button = container_->GetOkButton()) button->UI_GainKeyboardFocus();
}

void UI_Dialog::SetCancelButtonOnFocus() {
  if (const auto button = container_->GetCancelButton()) button->UI_GainKeyboardFocus();
}

void UI_Dialog::SetPostCloseCallback(PostCloseCallback callback) {
  container_->SetPostCloseCallback(std::move(callback));
}

// ---- Placement ----

bool UI_Dialog::RemembersPosition() const {
  return UI_GetNodeID() != kDefaultNodeID && PrefManager::GetPrefManager() != nullptr;
}

velkcore::UTF16String UI_Dialog::PositionKey() const {
  return velkcore::UTF8to16(UI_GetNodeID());
}

void UI_Dialog::Position() {
  if (!RemembersPosition()) {
    Center();
    return;
  }
  velkcore::RectT<std::int32_t> frame = UI_GetGlobalStructureRect();
  if (!PrefManager::GetPrefManager()->GetWindowPosition(PositionKey(), frame)) {
    Center();
    return;
  }
  const OS_MonitorInfo monitors;
  if (monitors.GetMonitorCount() > 0) monitors.EnsureRectIsVisible(&frame, false);
  UI_SetGlobalStructureRect(frame);
}

void UI_Dialog::SavePosition() const {
  if (!RemembersPosition()) return;
  PrefManager::GetPrefManager()->SetWindowPosition(PositionKey(), UI_GetGlobalStructureRect());
}

}  // namespace velkui::ui
