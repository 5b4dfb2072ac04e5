#include <velkui/controls/ControlMessages.h>

#include <velkcore/Error.h>
#include <velkui/controls/UI_ControlView.h>

namespace velkui::controls {

UI_ControlMessage::UI_ControlMessage(UI_ControlView* control) : MessageT(control) {}

UI_ControlView* UI_ControlMessage::GetControl() const {
  return velkcore::CheckedCast<UI_ControlView>(GetSubject());
}

void UI_ControlMessage::SetControl(UI_ControlView* control) {
  SetSubject(control);
}

UI_ConstControlMessage::UI_ConstControlMessage(const UI_ControlView* control) : MessageT(control) {}

const UI_ControlView* UI_ConstControlMessage::GetControl() const {
  return velkcore::CheckedCast<const UI_ControlView>(GetSubject());
}

void UI_ConstControlMessage::SetControl(const UI_ControlView* control) {
  SetSubject(control);
}

}  // namespace velkui::controls
