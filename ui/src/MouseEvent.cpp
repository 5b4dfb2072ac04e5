#include <velkui/ui/MouseEvent.h>

namespace velkui::ui {

MouseEvent::MouseEvent(Action action, std::int32_t button, std::int32_t clickCount,
                       const velkcore::PointT<float>& position, ModifierKeys modifiers,
                       const OS_Event* osEvent, std::int32_t wheelDelta, std::int32_t wheelAxis)
    : action_(action),
      button_(button),
      physicalButton_(button),
      clickCount_(clickCount),
      position_(position),
      modifiers_(modifiers),
      osEvent_(osEvent),
      wheelDelta_(wheelDelta),
      wheelAxis_(wheelAxis) {}

bool MouseEvent::IsButtonSingleDown(std::int32_t mask) const {
  return action_ == kButtonDown && IsButton(mask) && clickCount_ == 1;
}

bool MouseEvent::IsButtonDoubleClick(std::int32_t mask) const {
  return action_ == kButtonUp && IsButton(mask) && clickCount_ == 2;
}

bool MouseEvent::IsContextMenuClick() const {
  return action_ == kButtonDown && IsButton(kRightButton) && clickCount_ == 1;
}

bool MouseEvent::IsEndDragEvent(const MouseEvent& initial) const {
  return action_ == kButtonUp && physicalButton_ == initial.physicalButton_;
}

bool MouseEvent::IsHorizontalScroll() const {
  return wheelAxis_ == kHorizontalAxis || modifiers_.IsSet(kModifierShift);
}

std::int32_t WheelDeltaToNotches(std::int32_t rawDelta) {
  constexpr std::int32_t kNotch = 120;
  if (rawDelta == 0) return 0;
  const std::int32_t notches = rawDelta / kNotch;
  if (notches != 0) return notches;
  return rawDelta > 0 ? 1 : -1;
}

}  // namespace velkui::ui
