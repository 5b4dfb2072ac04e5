#pragma once

#include <velkui/ui/UI_NodeManager.h>

namespace velkui::ui {

// Raises the manager's updating-focus counter for a scope.
class UpdatingFocus {
 public:
  explicit UpdatingFocus(UI_NodeManager& manager) : manager_(manager) { ++manager_.updatingFocus_; }
  ~UpdatingFocus() { --manager_.updatingFocus_; }
  UpdatingFocus(const UpdatingFocus&) = delete;
  UpdatingFocus& operator=(const UpdatingFocus&) = delete;

 private:
  UI_NodeManager& manager_;
};

}  // namespace velkui::ui
