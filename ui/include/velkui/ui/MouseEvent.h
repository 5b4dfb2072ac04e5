#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// One mouse event as the node manager routes it. The position is in the
// coordinates of the node that receives it; the dispatch rewrites it at every level.
class MouseEvent {
 public:
  enum Action : std::int32_t {
    kButtonDown = 1,
    kButtonUp = 2,
    kMove = 3,
    kWheel = 4,
    // The pointer entered or left a window; carries no button.
    kMouseOverUpdate = 5,
  };
  static constexpr std::int32_t kLeftButton = 1;
  static constexpr std::int32_t kMiddleButton = 2;
  static constexpr std::int32_t kRightButton = 4;
  static constexpr std::int32_t kHorizontalAxis = 0;
  static constexpr std::int32_t kVerticalAxis = 1;

  MouseEvent(Action action, std::int32_t button, std::int32_t clickCount,
             const velkcore::PointT<float>& position, ModifierKeys modifiers,
             const OS_Event* osEvent = nullptr, std::int32_t wheelDelta = 0,
             std::int32_t wheelAxis = kVerticalAxis);
  MouseEvent(const MouseEvent&) = default;
  MouseEvent& operator=(const MouseEvent&) = default;
  virtual ~MouseEvent() = default;

  Action GetAction() const { return action_; }
  bool IsAction(Action action) const { return action_ == action; }
  std::int32_t GetButton() const { return button_; }
  bool IsButton(std::int32_t mask) const { return (button_ & mask) != 0; }
  std::int32_t GetPhysicalButton() const { return physicalButton_; }
  // For a remapped (swapped) mouse: IsEndDragEvent keeps comparing this one.
  void SetPhysicalButton(std::int32_t button) { physicalButton_ = button; }
  std::int32_t GetClickCount() const { return clickCount_; }
  const velkcore::PointT<float>& GetPosition() const { return position_; }
  void SetPosition(const velkcore::PointT<float>& position) { position_ = position; }
  ModifierKeys GetModKey() const { return modifiers_; }
  const OS_Event* GetOSEvent() const { return osEvent_; }
  // In notches.
  std::int32_t GetMouseWheelDelta() const { return wheelDelta_; }
  std::int32_t GetMouseWheelAxis() const { return wheelAxis_; }

  bool IsButtonSingleDown(std::int32_t mask) const;
  // The release that ends a double click (not the second press).
  bool IsButtonDoubleClick(std::int32_t mask) const;
  bool IsLeftButtonSingleDown() const { return IsButtonSingleDown(kLeftButton); }
  bool IsMiddleButtonSingleDown() const { return IsButtonSingleDown(kMiddleButton); }
  bool IsRightButtonSingleDown() const { return IsButtonSingleDown(kRightButton); }
  bool IsLeftButtonDoubleClick() const { return IsButtonDoubleClick(kLeftButton); }
  bool IsMiddleButtonDoubleClick() const { return IsButtonDoubleClick(kMiddleButton); }
  bool IsRightButtonDoubleClick() const { return IsButtonDoubleClick(kRightButton); }
  bool IsContextMenuClick() const;
  // A release of the physical button that started `initial`.
  bool IsEndDragEvent(const MouseEvent& initial) const;
  bool IsHorizontalScroll() const;

 private:
  Action action_;
  std::int32_t button_;
  std::int32_t physicalButton_;
  std::int32_t clickCount_;
  velkcore::PointT<float> position_;
  ModifierKeys modifiers_;
  const OS_Event* osEvent_;
  std::int32_t wheelDelta_;
  std::int32_t wheelAxis_;
};

// A raw wheel delta in notches: 120 per notch, truncated toward zero; a
// non-zero delta smaller than one notch counts as one notch in its direction.
std::int32_t WheelDeltaToNotches(std::int32_t rawDelta);

}  // namespace velkui::ui
