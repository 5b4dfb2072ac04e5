#include <velkui/controls/UI_InteractiveControlView.h>

#include <velkcore/Error.h>

namespace velkui::controls {

UI_InteractiveControlView::UI_InteractiveControlView() {
  UI_SetNodeID("UI_InteractiveControlView");
}

UI_InteractiveControlView::~UI_InteractiveControlView() = default;

void UI_InteractiveControlView::NotifyWhenChangedInteractively(const ControlCallbackP& callback) {
  interactiveListeners_.Add(callback);
}

void UI_InteractiveControlView::BeginInteractiveChange() {
  SendInteractive(kBeginChange, {});
}

void UI_InteractiveControlView::ContinueInteractiveChange(ui::ModifierKeys modKeys) {
  SendInteractive(kContinueChange, modKeys);
}

void UI_InteractiveControlView::FinishInteractiveChange() {
  SendInteractive(kFinishChange, {});
}

void UI_InteractiveControlView::CancelInteractiveChange() {
  SendInteractive(kCancelChange, {});
}

void UI_InteractiveControlView::SendInteractive(ChangeMessage change, ui::ModifierKeys modKeys) {
  UI_InteractiveControlChangedMessage message(this, change, modKeys);
  SendToListeners(interactiveListeners_, &message);
}

void UI_InteractiveControlView::ForwardInteractiveControlMessageFromChild(
    UI_InteractiveControlChangedMessage* message) {
  velkcore::RequireInput(message != nullptr);
  const auto keep = KeepAlive();
  switch (message->GetChangeMessage()) {
    case kBeginChange:
      BeginInteractiveChange();
      break;
    case kContinueChange:
      ContinueInteractiveChange(message->GetModKeys());
      break;
    case kFinishChange:
      FinishInteractiveChange();
      SendValueChangedMessage();
      break;
    case kCancelChange:
      CancelInteractiveChange();
      break;
  }
}

// ---- ScBeginAndEndInteractiveChange ----

UI_InteractiveControlView::ScBeginAndEndInteractiveChange::ScBeginAndEndInteractiveChange(
    UI_InteractiveControlView& control)
    : keep_(control.KeepAlive()), control_(control) {
  control_.BeginInteractiveChange();
}

UI_InteractiveControlView::ScBeginAndEndInteractiveChange::~ScBeginAndEndInteractiveChange() {
  if (finished_) return;
  try {
    control_.CancelInteractiveChange();
  } catch (...) {
    // A destructor cannot pass the exception on (it may run during unwinding).
  }
}

void UI_InteractiveControlView::ScBeginAndEndInteractiveChange::Continue(ui::ModifierKeys modKeys) {
  control_.ContinueInteractiveChange(modKeys);
}

void UI_InteractiveControlView::ScBeginAndEndInteractiveChange::Finish() {
  if (finished_) return;
  finished_ = true;
  control_.FinishInteractiveChange();
}

}  // namespace velkui::controls
