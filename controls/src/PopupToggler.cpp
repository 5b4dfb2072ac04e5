#include <velkui/controls/PopupToggler.h>

#include <velkui/controls/ControlClock.h>

namespace velkui::controls {

bool PopupToggler::DoPopup() const {
  return !valid_ || GetControlTime() - closedAt_ > kReopenDelay;
}

void PopupToggler::EndPopup() {
  closedAt_ = GetControlTime();
  valid_ = true;
}

}  // namespace velkui::controls
