#include <velkui/controls/UI_ControlView.h>

#include <velkcore/Error.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>

namespace velkui::controls {

namespace {

using ui::KeyboardCode;
using ui::KeyboardEvent;
using ui::ModifierKeys;

ModifierKeys WithoutCapsLock(ModifierKeys keys) {
  keys.Clear(ui::kModifierCapsLock);
  return keys;
}

// The key an event stands for as a mnemonic: its first character upper-cased,
// or, when the platform delivered no character (as it may while Alt is
// held), the letter or digit printed on the key.
KeyboardCode MnemonicKeyOf(const KeyboardEvent& event) {
  if (event.GetNumCharacters() > 0 && event.GetCharacter(0) != 0) {
    return KeyboardCode::CreateFromKeyboardChar(velkcore::ToUpperCase(event.GetCharacter(0)),
                                                false);
  }
  const std::int16_t key = event.GetOSCode();
  if ((key >= '0' && key <= '9') || (key >= 'A' && key <= 'Z')) {
    return KeyboardCode::CreateFromKeyboardChar(static_cast<char16_t>(key), false);
  }
  return event.GetCode();
}

}  // namespace

UI_ControlView::UI_ControlView() {
  UI_SetNodeID("UI_ControlView");
}

UI_ControlView::~UI_ControlView() {
  UnregisterKeyboardFilter();
}

// ---- Node operations ----

bool UI_ControlView::UI_DoPreKeyboardEvent(ui::UI_Node* target, const KeyboardEvent& event) {
  if (!event.IsActionKeyDown()) {
    // The underlines go away with the Alt key that brought them.
    if (event.IsActionKeyUp() && displayMnemonic_ &&
        !event.GetModKey().IsAnySet(ui::kModifierAlt)) {
      UI_TurnOffMnemonicDisplay();
      InvalidateAll();
    }
    return false;
  }
  if (MatchesMnemonic(event) && IsReachableForMnemonic(target) && !IsDisabled()) {
    const auto keep = KeepAlive();
    SetWantsKeyboardFocus(true);
    UI_GainKeyboardFocusFromMnemonic();
    if (ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false)) {
      manager->RemovePendingKeyboardMessages();
    }
    return true;
  }
  if (WithoutCapsLock(event.GetModKey()) == ModifierKeys{ui::kModifierAlt} && AllowMnemonics() &&
      !displayMnemonic_) {
    UI_TurnOnMnemonicDisplay();
    InvalidateAll();
  }
  return false;
}

bool UI_ControlView::UI_InvalidateOnKeyboardFocusChange(bool) const {
  return true;
}

bool UI_ControlView::UI_WantsKeyboardFocus() const {
  return wantsFocus_ && !IsDisabled();
}

bool UI_ControlView::UI_GainKeyboardFocusFromAdvance() {
  return UI_GainKeyboardFocus();
}

void UI_ControlView::UI_DisabledStateChanged() {
  UI_SubView::UI_DisabledStateChanged();
  InvalidateAll();
}

// ---- Value and state ----

void UI_ControlView::SetValueUnknown() {
  if (valueUnknown_) return;
  valueUnknown_ = true;
  InvalidateAll();
  KnownValueStateChanged();
}

void UI_ControlView::SetValueKnown() {
  if (!valueUnknown_) return;
  valueUnknown_ = false;
  InvalidateAll();
  KnownValueStateChanged();
}

void UI_ControlView::KnownValueStateChanged() {}

void UI_ControlView::SetDownState(bool down) {
  if (downState_ == down) return;
  downState_ = down;
  InvalidateAll();
}

void UI_ControlView::SetWantsKeyboardFocus(bool wants) {
  if (wantsFocus_ == wants) return;
  wantsFocus_ = wants;
  InvalidateAll();
}

void UI_ControlView::SetSuppressFocusDrawing(bool suppress) {
  if (suppressFocusDrawing_ == suppress) return;
  suppressFocusDrawing_ = suppress;
  InvalidateAll();
}

bool UI_ControlView::DoDrawRollover(const ui::InputCapture* capture) const {
  if (capture == nullptr) return false;
  const ui::UI_Node* node = capture->GetNode();
  return node == this || (node != nullptr && node->UI_IsChildOf(this));
}

ControlState UI_ControlView::GetControlState(bool considerCapture) const {
  ControlState state;
  state.Set(kControlStateDown, downState_);
  bool rollover = UI_IsMouseOver(false);
  if (considerCapture && rollover) {
    const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
    if (manager != nullptr && manager->HasInputCapture()) {
      rollover = DoDrawRollover(manager->GetInputCapture());
    }
  }
  state.Set(kControlStateRollover, rollover);
  state.Set(kControlStateDisabled, IsDisabled());
  state.Set(kControlStateFocus, UI_HasKeyboardFocus(false) && !suppressFocusDrawing_);
  return state;
}

float UI_ControlView::DefaultTextSize() {
  return ui::Theme::Get().GetFontSize(7);
}

// ---- Listeners ----

void UI_ControlView::NotifyWhenChanged(const ControlCallbackP& callback) {
  changedListeners_.Add(callback);
}

void UI_ControlView::NotifyHover(const ControlCallbackP& callback) {
  hoverListeners_.Add(callback);
}

void UI_ControlView::SendValueChangedMessage() {
  UI_ControlChangedMessage message(this);
  SendToListeners(changedListeners_, &message);
}

void UI_ControlView::SendHover(const ui::MouseEvent& event) {
  if (hoverListeners_.Empty()) return;
  if (!event.IsAction(ui::MouseEvent::kMove) && !event.IsAction(ui::MouseEvent::kMouseOverUpdate)) {
    return;
  }
  UI_HoverMessage message(this, event);
  SendToListeners(hoverListeners_, &message);
}

void UI_ControlView::ForwardControlMessageFromChild(UI_ControlChangedMessage* message) {
  velkcore::RequireInput(message != nullptr);
  message->SetControl(this);
  SendToListeners(changedListeners_, message);
}

void UI_ControlView::SendControlMessage(const ControlCallbackP& callback,
                                        ui::MessageT<ui::UI_Node>* message) {
  if (callback && *callback) (*callback)(message);
}

void UI_ControlView::SendControlMessage(const ConstControlCallbackP& callback,
                                        ui::MessageT<const ui::UI_Node>* message) {
  if (callback && *callback) (*callback)(message);
}

void UI_ControlView::SendControlMessages(const ControlListenerList& list,
                                         ui::MessageT<ui::UI_Node>* message) {
  list.Send(message);
}

void UI_ControlView::SendControlMessages(const ConstControlListenerList& list,
                                         ui::MessageT<const ui::UI_Node>* message) {
  list.Send(message);
}

void UI_ControlView::SendToListeners(const ControlListenerList& list,
                                     ui::MessageT<ui::UI_Node>* message) {
  const auto keep = KeepAlive();
  list.Send(message);
}

boost::intrusive_ptr<UI_ControlView> UI_ControlView::KeepAlive() {
  // Taking a first reference would delete the control when it is released.
  if (GetRefCount() == 0) return nullptr;
  return boost::intrusive_ptr<UI_ControlView>(this);
}

void UI_ControlView::InvalidateAll() {
  UI_Invalidate(nullptr, {});
}

// ---- Mnemonics ----

bool UI_ControlView::DoesPlatformAllowMnemonics() {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  return manager != nullptr && manager->IsMnemonicEnabled();
}

bool UI_ControlView::UI_ProcessStringAndSetMnemonic(const velkcore::UTF16String& in,
                                                    velkcore::UTF16String& out) {
  out = in;
  // The markup is never shown, even where mnemonics are off.
  if (!DoesPlatformAllowMnemonics()) {
    out = velkcore::StripDisplayString(out);
    return false;
  }
  bool mnemonicSet = false;
  if (!out.empty()) {
    const std::size_t marker = velkcore::LocateSingleAmpersandInString(out);
    const char16_t key =
        marker == std::u16string::npos ? u'\0' : velkcore::ToUpperCase(out[marker + 1]);
    if (key != 0) {
      mnemonicCode_ = KeyboardCode::CreateFromKeyboardChar(key, false);
      mnemonicLocation_ =
          velkcore::StripDisplayString(std::u16string_view(out).substr(0, marker)).size();
      RegisterKeyboardFilter();
      mnemonicSet = true;
    } else {
      mnemonicCode_ = KeyboardCode();
      mnemonicLocation_ = kNoMnemonic;
    }
    out = velkcore::StripDisplayString(out);
  }
  return mnemonicSet;
}

bool UI_ControlView::UI_GainKeyboardFocusFromMnemonic() {
  return UI_GainKeyboardFocus();
}

bool UI_ControlView::UI_CanGainSingleKeyMnemonicFocus() const {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  if (manager == nullptr) return false;
  const auto* focused = dynamic_cast<const UI_ControlView*>(manager->GetKeyboardFocusLeafNode());
  return focused != nullptr && focused->UI_AllowsSingleKeyMnemonic();
}

bool UI_ControlView::UI_AllowsSingleKeyMnemonic() const {
  return true;
}

void UI_ControlView::UI_TurnOnMnemonicDisplay() {
  displayMnemonic_ = true;
}

void UI_ControlView::UI_TurnOffMnemonicDisplay() {
  displayMnemonic_ = false;
}

bool UI_ControlView::MatchesMnemonic(const KeyboardEvent& event) const {
  if (mnemonicCode_ == KeyboardCode() || mnemonicLocation_ == kNoMnemonic) return false;
  if (MnemonicKeyOf(event) != mnemonicCode_) return false;
  const ModifierKeys modifiers = WithoutCapsLock(event.GetModKey());
  if (modifiers == ModifierKeys{ui::kModifierAlt}) return true;
  return modifiers.IsEmpty() && UI_CanGainSingleKeyMnemonicFocus();
}

bool UI_ControlView::IsReachableForMnemonic(const ui::UI_Node* target) const {
  // Hidden controls, and controls of another window than the one the key was
  // typed in, do not answer.
  for (const ui::UI_Node* node = this; node != nullptr; node = node->UI_GetParentNode()) {
    if (!node->UI_IsShown()) return false;
  }
  return target == nullptr || target->UI_GetRootNode() == UI_GetRootNode();
}

void UI_ControlView::RegisterKeyboardFilter() {
  if (keyboardFilterRegistered_) return;
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false);
  if (manager == nullptr) return;
  manager->AddKeyboardEventFilterNode(this);
  keyboardFilterRegistered_ = true;
}

void UI_ControlView::UnregisterKeyboardFilter() {
  if (!keyboardFilterRegistered_) return;
  keyboardFilterRegistered_ = false;
  if (ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false)) {
    manager->RemoveKeyboardEventFilterNode(this);
  }
}

}  // namespace velkui::controls
