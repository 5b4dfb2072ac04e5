#include <velkui/ui/UI_ModKeyNotifier.h>

namespace velkui::ui {

UI_ModKeyNotifier& UI_ModKeyNotifier::Get() {
  static UI_ModKeyNotifier notifier;
  return notifier;
}

void UI_ModKeyNotifier::InstallModKeyChangedFunction(
    const std::shared_ptr<ModKeyChangedFunction>& f) {
  functions_.Add(f);
}

bool UI_ModKeyNotifier::RemoveModKeyChangedFunction(
    const std::shared_ptr<ModKeyChangedFunction>& f) {
  return functions_.Remove(f);
}

void UI_ModKeyNotifier::DispatchModKeyEvent(ModifierKeys modifiers) {
  if (modifiers == last_) return;
  last_ = modifiers;
  functions_.Call(modifiers);
}

void UI_ModKeyNotifier::AppChanged(bool active, ModifierKeys current) {
  if (active) DispatchModKeyEvent(current);
}

}  // namespace velkui::ui
