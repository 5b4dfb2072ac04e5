#include <velkui/ui/InputCapture.h>

#include <velkcore/Error.h>

namespace velkui::ui {

InputCapture::InputCapture(UI_Node* node, const MouseEvent& initialEvent)
    : node_(node), initialEvent_(initialEvent), previousEvent_(initialEvent) {
  velkcore::RequireInput(node != nullptr);
}

InputCapture::~InputCapture() = default;

void InputCapture::Begin() {}

void InputCapture::End() {}

bool InputCapture::DoMouseEvent(const MouseEvent&) {
  return false;
}

bool InputCapture::DoKeyboardEvent(const KeyboardEvent&) {
  return false;
}

bool InputCapture::DoCursor(const velkcore::PointT<float>&, ModifierKeys) {
  return false;
}

bool InputCapture::DoTimerNotify(std::int32_t) {
  return false;
}

}  // namespace velkui::ui
