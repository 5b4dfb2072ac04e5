#pragma once

#include <functional>
#include <memory>

#include <velkcore/SharedFunctions.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// Tells interested parties when the set of held modifier keys changes. One per
// process, created on first use.
class UI_ModKeyNotifier {
 public:
  using ModKeyChangedFunction = std::function<void(ModifierKeys)>;

  static UI_ModKeyNotifier& Get();
  static const UI_ModKeyNotifier& GetConst() { return Get(); }

  void InstallModKeyChangedFunction(const std::shared_ptr<ModKeyChangedFunction>& f);
  bool RemoveModKeyChangedFunction(const std::shared_ptr<ModKeyChangedFunction>& f);
  // Nothing when `modifiers` equal the last dispatched set; else every
  // installed function is called in order and the set is remembered.
  void DispatchModKeyEvent(ModifierKeys modifiers);
  // On activation the current modifier state is dispatched (keys may have been
  // pressed or released while another application was in front).
  void AppChanged(bool active, ModifierKeys current);
  ModifierKeys GetLastModifiers() const { return last_; }

 private:
  UI_ModKeyNotifier() = default;

  velkcore::SharedFunctions<void(ModifierKeys)> functions_;
  ModifierKeys last_;
};

}  // namespace velkui::ui
