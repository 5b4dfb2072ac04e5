#include <velkui/ui/UI_DialogViewContainer.h>

#include <velkui/controls/UI_Button.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/KeyboardCode.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_Dialog.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeHold.h"

namespace velkui::ui {

namespace {

constexpr ThemeColorIndex kWindowBackground = 4;

bool IsReturn(const KeyboardEvent& event) {
  const std::uint16_t key = event.GetKeyControlCode();
  return key == kKeyReturn || key == kKeyEnter;
}

bool IsEscape(const KeyboardEvent& event) {
  return event.GetKeyControlCode() == kKeyEscape;
}

controls::UI_Button* FindDefaultBelow(const UI_Node& node) {
  for (auto child = node.ChildBegin(); child != node.ChildEnd(); ++child) {
    if (!(*child)->UI_IsShown()) continue;
    auto* button = dynamic_cast<controls::UI_Button*>(child->get());
    if (button != nullptr && button->GetDefaultAppearance()) return button;
    if (controls::UI_Button* found = FindDefaultBelow(**child)) return found;
  }
  return nullptr;
}

}  // namespace

UI_DialogViewContainer::UI_DialogViewContainer() {
  // Offered every key first, for the keys that edit fields would keep.
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) {
    manager->AddKeyboardEventFilterNode(this);
    filterRegistered_ = true;
  }
}

UI_DialogViewContainer::~UI_DialogViewContainer() {
  if (!filterRegistered_) return;
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) {
    manager->RemoveKeyboardEventFilterNode(this);
  }
}

// ---- Node operations ----

bool UI_DialogViewContainer::UI_DoPreKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  if (!event.IsActionKeyDown() || event.IsRepeat() || !UI_TextEditControlHasFocus() ||
      !detail::IsInSubtree(target, *this) || UI_IsDisabled()) {
    return false;
  }
  if (IsReturn(event) && !textfieldReturnDoesNotClose_) return HandleReturnKey(event.GetModKey());
  if (IsEscape(event)) return HandleEscapeKey(event.GetModKey());
  return false;
}

bool UI_DialogViewContainer::UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  if (event.IsActionKeyDown() && !event.IsRepeat()) {
    if (IsReturn(event)) return HandleReturnKey(event.GetModKey());
    if (IsEscape(event)) return HandleEscapeKey(event.GetModKey());
  }
  return UI_SubView::UI_DoKeyboardEvent(target, event);
}

bool UI_DialogViewContainer::UI_WantsKeyboardFocus() const {
  return true;
}

bool UI_DialogViewContainer::UI_GainKeyboardFocusFromAdvance() {
  return false;
}

void UI_DialogViewContainer::UI_Draw(pictel::Pictel* context) const {
  if (Theme::IsInitialized()) {
    const Theme& theme = Theme::Get();
    const ThemeColorIndex index =
        theme.HasColor(kBackgroundColor) ? kBackgroundColor : kWindowBackground;
    if (theme.HasColor(index)) {
      context->GetSurface()->PaintRect(theme.GetColor(index), UI_GetLocalRectF(false));
    }
  }
  UI_SubView::UI_Draw(context);
}

// ---- Keys ----

controls::UI_Button* UI_DialogViewContainer::FindDefaultButton() const {
  return FindDefaultBelow(*this);
}

bool UI_DialogViewContainer::HandleReturnKey(ModifierKeys modifiers) {
  const NodeP keep = detail::Hold(this);
  boost::intrusive_ptr<controls::UI_Button> button(FindDefaultButton());
  if (!button) button = okButton_;
  if (button) {
    PressButton(*button, modifiers);
  } else if (onReturnKey_) {
    const KeyCallback callback = onReturnKey_;
    callback();
  } else {
    // Closing with OK keeps what a field was editing: it commits as it loses the focus.
    UI_GainKeyboardFocus();
    CloseOk();
  }
  return true;
}

bool UI_DialogViewContainer::HandleEscapeKey(ModifierKeys modifiers) {
  const NodeP keep = detail::Hold(this);
  if (const boost::intrusive_ptr<controls::UI_Button> button = cancelButton_) {
    PressButton(*button, modifiers);
  } else if (onEscapeKey_) {
    const KeyCallback callback = onEscapeKey_;
    callback();
  } else {
    CloseCancel();
  }
  return true;
}

void UI_DialogViewContainer::PressButton(controls::UI_Button& button, ModifierKeys modifiers) {
  UI_GainKeyboardFocus();
  button.PerformAction(true, modifiers, true);
}

void UI_DialogViewContainer::CloseOk() {
  if (auto* dialog = dynamic_cast<UI_Dialog*>(UI_GetParentNode())) {
    dialog->DefaultCloseOk();
  } else {
    DefaultCloseOk();
  }
}

void UI_DialogViewContainer::CloseCancel() {
  if (auto* dialog = dynamic_cast<UI_Dialog*>(UI_GetParentNode())) {
    dialog->DefaultCloseCancel();
  } else {
    DefaultCloseCancel();
  }
}

// ---- Default closes ----

bool UI_DialogViewContainer::RunPostCloseCallback(Response response) {
  if (!postClose_) return false;
  // A copy: the callback may replace itself.
  const PostCloseCallback callback = postClose_;
  return callback(response);
}

void UI_DialogViewContainer::DefaultCloseOk() {
  const NodeP keep = detail::Hold(this);
  response_ = kOk;
  okCloseHandled_ = RunPostCloseCallback(kOk);
}

void UI_DialogViewContainer::DefaultCloseCancel() {
  const NodeP keep = detail::Hold(this);
  response_ = kCancel;
  cancelCloseHandled_ = RunPostCloseCallback(kCancel);
}

void UI_DialogViewContainer::ResetCloseHandled() {
  okCloseHandled_ = false;
  cancelCloseHandled_ = false;
}

// ---- Buttons ----

void UI_DialogViewContainer::SetOkButton(boost::intrusive_ptr<controls::UI_Button> button) {
  okButton_ = std::move(button);
}

void UI_DialogViewContainer::SetCancelButton(boost::intrusive_ptr<controls::UI_Button> button) {
  cancelButton_ = std::move(button);
}

}  // namespace velkui::ui
