#pragma once

namespace velkui::controls {

// Keeps the click that closed a popup from opening it again: a popup control
// calls EndPopup when its popup closes and opens it only when DoPopup agrees
// (never set, or more than 0.1 s ago).
class PopupToggler {
 public:
  static constexpr double kReopenDelay = 0.1;

  bool DoPopup() const;
  void EndPopup();

 private:
  double closedAt_ = -1.0;
  bool valid_ = false;
};

}  // namespace velkui::controls
