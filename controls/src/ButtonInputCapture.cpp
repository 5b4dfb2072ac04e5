#include <velkui/controls/ButtonInputCapture.h>

#include <velkcore/Error.h>
#include <velkui/controls/UI_Button.h>
#include <velkui/ui/UI_NodeManager.h>

#include <velkui/controls/ControlClock.h>

namespace velkui::controls {

namespace {

bool IsOver(const UI_Button& button, const velkcore::PointT<float>& local) {
  const velkcore::RectT<float> r = button.UI_GetLocalRectF(false);
  const bool inside = local.x >= r.left && local.y >= r.top && local.x < r.left + r.width &&
                      local.y < r.top + r.height;
  return inside && button.UI_HitTest(local);
}

}  // namespace

ButtonInputCapture::ButtonInputCapture(UI_Button* button, const ui::MouseEvent& initialEvent,
                                       float repeatInterval)
    : InputCapture(button, initialEvent),
      repeatInterval_(repeatInterval),
      modKeys_(initialEvent.GetModKey()),
      timerId_(ui::UI_NodeManager::Get(true)->GetUniqueTimerID()) {
  velkcore::RequireInput(repeatInterval >= 0);
}

ButtonInputCapture::~ButtonInputCapture() {
  StopRepeating();
}

UI_Button* ButtonInputCapture::GetButton() const {
  return static_cast<UI_Button*>(GetNode());
}

void ButtonInputCapture::Begin() {
  UI_Button& button = *GetButton();
  // Without a window there is no timer to repeat with.
  if (repeatInterval_ != 0 && button.UI_GetTimerManager(true) != nullptr) {
    startTime_ = GetControlTime();
    button.UI_InstallTimer(repeatInterval_, timerId_);
    timerInstalled_ = true;
  }
  initialDownState_ = button.GetDownState();
  button.SetDownState(!initialDownState_);
  button.BeginInteractiveChange();
  button.UI_Invalidate(nullptr, {});
}

bool ButtonInputCapture::DoMouseEvent(const ui::MouseEvent& event) {
  UI_Button& button = *GetButton();
  if (event.IsEndDragEvent(GetInitialMouseEvent())) {
    modKeys_ = event.GetModKey();
    const bool inside = IsOver(button, event.GetPosition());
    if (ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false);
        manager != nullptr && manager->GetInputCapture() == this) {
      manager->EndInputCapture(!inside);
    }
    return true;
  }
  if (event.IsAction(ui::MouseEvent::kMove) || event.IsAction(ui::MouseEvent::kMouseOverUpdate)) {
    const bool over = IsOver(button, event.GetPosition());
    button.SetDownState(over ? !initialDownState_ : initialDownState_);
  }
  return true;
}

bool ButtonInputCapture::DoTimerNotify(std::int32_t id) {
  if (id != timerId_) return false;
  UI_Button& button = *GetButton();
  if (button.IsDisabled()) return true;
  const bool held = button.GetDownState() != initialDownState_;
  if (held && GetControlTime() - startTime_ > kRepeatDelay) {
    repeated_ = true;
    button.ContinueInteractiveChange({});
  }
  return true;
}

void ButtonInputCapture::End() {
  StopRepeating();
  UI_Button& button = *GetButton();
  const auto keep = boost::intrusive_ptr<UI_Button>(&button);
  if (HasBeenCancelled()) {
    button.SetDownState(initialDownState_);
    button.CancelInteractiveChange();
    return;
  }
  try {
    if (!button.IsDisabled()) {
      button.SetValueKnown();
      button.SetDownState(button.IsSpringLoaded() ? false : !initialDownState_);
      button.SendButtonChangedMessage(modKeys_);
    } else {
      // Disabled while held (during auto-repeat, say): it does not fire.
      button.SetDownState(initialDownState_);
    }
    if (!repeated_) button.ContinueInteractiveChange(modKeys_);
  } catch (...) {
    // The change stays bracketed even when a listener fails.
    try {
      button.CancelInteractiveChange();
    } catch (...) {
    }
    throw;
  }
  button.FinishInteractiveChange();
  button.UI_Invalidate(nullptr, {});
}

void ButtonInputCapture::StopRepeating() {
  if (!timerInstalled_) return;
  timerInstalled_ = false;
  GetButton()->UI_RemoveTimer(timerId_);
}

}  // namespace velkui::controls
