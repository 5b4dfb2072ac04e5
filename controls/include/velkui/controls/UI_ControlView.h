#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Strings.h>
#include <velkui/controls/ControlMessages.h>
#include <velkui/controls/ControlState.h>
#include <velkui/controls/ListenerList.h>
#include <velkui/ui/InputCapture.h>
#include <velkui/ui/KeyboardCode.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::controls {

// The base of every control: listener lists for value changes and hovering,
// the common control state (value unknown, down, focus wishes) and mnemonics.
class UI_ControlView : public ui::UI_SubView {
 public:
  static constexpr std::size_t kNoMnemonic = std::numeric_limits<std::size_t>::max();

  UI_ControlView();
  ~UI_ControlView() override;

  // ---- Node operations ----
  bool UI_DoPreKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) override;
  bool UI_InvalidateOnKeyboardFocusChange(bool isLeaf) const override;
  bool UI_WantsKeyboardFocus() const override;
  bool UI_GainKeyboardFocusFromAdvance() override;
  // Redraws: every control draws its disabled look.
  void UI_DisabledStateChanged() override;

  // ---- Virtual operations, in slot order ----
  virtual void SetValueUnknown();
  virtual void SetDownState(bool down);
  virtual void SetWantsKeyboardFocus(bool wants);
  virtual void SetSuppressFocusDrawing(bool suppress);
  // Whether a running capture lets this control draw its rollover: the
  // capture belongs to this control or to one of its descendants.
  virtual bool DoDrawRollover(const ui::InputCapture* capture) const;
  // `out` becomes `in` stripped of its mnemonic markup; answers whether a
  // mnemonic was set.
  virtual bool UI_ProcessStringAndSetMnemonic(const velkcore::UTF16String& in,
                                              velkcore::UTF16String& out);
  virtual bool UI_GainKeyboardFocusFromMnemonic();
  virtual bool UI_CanGainSingleKeyMnemonicFocus() const;
  virtual bool UI_AllowsSingleKeyMnemonic() const;
  virtual void SetValueKnown();
  virtual void KnownValueStateChanged();
  virtual void SendValueChangedMessage();
  virtual void SendHover(const ui::MouseEvent& event);
  virtual void UI_TurnOnMnemonicDisplay();
  virtual void UI_TurnOffMnemonicDisplay();

  // ---- Enabled state ----
  bool IsDisabled() const { return UI_IsDisabled(); }
  void SetDisabled(bool disabled) { UI_SetDisabled(disabled); }
  bool IsEnabled() const { return !IsDisabled(); }
  void SetEnabled(bool enabled = true) { UI_SetDisabled(!enabled); }

  // ---- Value known or unknown (mixed, indeterminate) ----
  bool IsValueUnknown() const { return valueUnknown_; }
  bool IsValueKnown() const { return !valueUnknown_; }

  // ---- Down state, focus wishes ----
  bool GetDownState() const { return downState_; }
  void ToggleDownState() { SetDownState(!GetDownState()); }
  bool GetWantsKeyboardFocus() const { return wantsFocus_; }
  bool GetSuppressFocusDrawing() const { return suppressFocusDrawing_; }

  // Down, rollover, disabled and focus bits. With `considerCapture`, rollover
  // during a capture is left to DoDrawRollover.
  ControlState GetControlState(bool considerCapture) const;

  // The theme's size of font 7.
  static float DefaultTextSize();

  // ---- Listeners ----
  void NotifyWhenChanged(const ControlCallbackP& callback);
  void NotifyHover(const ControlCallbackP& callback);
  std::size_t ChangedCallbackSize() const { return changedListeners_.Size(); }
  std::size_t HoverCallbackSize() const { return hoverListeners_.Size(); }
  // Re-targets a child's message to this control and sends it to this
  // control's changed-listeners: composite controls subscribe it to their parts.
  void ForwardControlMessageFromChild(UI_ControlChangedMessage* message);

  static void SendControlMessage(const ControlCallbackP& callback,
                                 ui::MessageT<ui::UI_Node>* message);
  static void SendControlMessage(const ConstControlCallbackP& callback,
                                 ui::MessageT<const ui::UI_Node>* message);
  static void SendControlMessages(const ControlListenerList& list,
                                  ui::MessageT<ui::UI_Node>* message);
  static void SendControlMessages(const ConstControlListenerList& list,
                                  ui::MessageT<const ui::UI_Node>* message);

  // ---- Mnemonics ----
  bool GetDisplayMnemonic() const { return displayMnemonic_; }
  std::size_t GetMnemonicLocation() const { return mnemonicLocation_; }
  void SetMnemonicLocation(std::size_t location) { mnemonicLocation_ = location; }
  ui::KeyboardCode GetMnemonicCode() const { return mnemonicCode_; }
  bool AllowMnemonics() const { return DoesPlatformAllowMnemonics(); }
  static bool DoesPlatformAllowMnemonics();

 protected:
  // Sends `message` to `list` while holding a reference to this control, so
  // that a listener may drop the last other reference to it.
  void SendToListeners(const ControlListenerList& list, ui::MessageT<ui::UI_Node>* message);
  const ControlListenerList& GetChangedListeners() const { return changedListeners_; }
  // A reference that keeps this control alive for a scope, or null while the
  // control is not (yet) held by any reference.
  boost::intrusive_ptr<UI_ControlView> KeepAlive();
  void InvalidateAll();

 private:
  bool MatchesMnemonic(const ui::KeyboardEvent& event) const;
  bool IsReachableForMnemonic(const ui::UI_Node* target) const;
  void RegisterKeyboardFilter();
  void UnregisterKeyboardFilter();

  ControlListenerList hoverListeners_;
  ControlListenerList changedListeners_;
  bool keyboardFilterRegistered_ = false;
  bool valueUnknown_ = true;
  bool downState_ = false;
  bool wantsFocus_ = false;
  bool suppressFocusDrawing_ = false;
  bool displayMnemonic_ = false;
  ui::KeyboardCode mnemonicCode_;
  std::size_t mnemonicLocation_ = kNoMnemonic;
};

using ControlViewP = boost::intrusive_ptr<UI_ControlView>;

}  // namespace velkui::controls
