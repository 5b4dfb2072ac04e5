#pragma once

#include <cstdint>

#include <velkui/ui/InputCapture.h>

namespace velkui::controls {

class UI_Button;

// Tracks a press of a button: the button looks down while the pointer is over
// it and fires on a release over it; a release elsewhere (or Escape) cancels.
// With a repeat interval the button also repeats while held: after 0.25 s,
// one continue step per interval.
class ButtonInputCapture : public ui::InputCapture {
 public:
  static constexpr double kRepeatDelay = 0.25;

  ButtonInputCapture(UI_Button* button, const ui::MouseEvent& initialEvent, float repeatInterval);
  ~ButtonInputCapture() override;

  void Begin() override;
  void End() override;
  bool DoMouseEvent(const ui::MouseEvent& event) override;
  bool DoTimerNotify(std::int32_t id) override;

  UI_Button* GetButton() const;
  bool GetInitialDownState() const { return initialDownState_; }
  float GetRepeatInterval() const { return repeatInterval_; }
  std::int32_t GetTimerID() const { return timerId_; }
  bool HasRepeated() const { return repeated_; }

 private:
  void StopRepeating();

  bool initialDownState_ = false;
  float repeatInterval_;
  ui::ModifierKeys modKeys_;
  double startTime_ = 0;
  std::int32_t timerId_;
  bool repeated_ = false;
  bool timerInstalled_ = false;
};

}  // namespace velkui::controls
