#include <velkui/ui/ClickCounter.h>

#include <chrono>
#include <cstdlib>
#include <utility>

#include <velkcore/Error.h>

namespace velkui::ui {

namespace {

double SteadySeconds() {
  using Seconds = std::chrono::duration<double>;
  return std::chrono::duration_cast<Seconds>(std::chrono::steady_clock::now().time_since_epoch())
      .count();
}

bool IsPressOrRelease(MouseEvent::Action action) {
  return action == MouseEvent::kButtonDown || action == MouseEvent::kButtonUp;
}

}  // namespace

ClickCounter::ClickCounter(Clock clock)
    : clock_(clock ? std::move(clock) : Clock(&SteadySeconds)) {}

void ClickCounter::SetDoubleClickSize(std::int32_t width, std::int32_t height) {
  velkcore::RequireInput(width >= 0 && height >= 0);
  doubleClickWidth_ = width;
  doubleClickHeight_ = height;
}

std::int32_t ClickCounter::Count(std::int32_t baseCount, MouseEvent::Action action,
                                 std::int32_t button, const velkcore::PointT<std::int32_t>& point) {
  const double now = clock_();
  const double elapsed = hasLast_ ? now - lastTime_ : 0.0;
  const double window = static_cast<double>(doubleClickTimeMs_) / 1000.0;

  std::int32_t result = baseCount;
  if (hasLast_ && elapsed < window && IsPressOrRelease(lastAction_)) {
    if (action == MouseEvent::kMove) {
      if (storedCount_ < 3) return storedCount_;
      const bool near =
          std::abs(static_cast<std::int64_t>(point.x) - storedPoint_.x) <= doubleClickWidth_ / 2 &&
          std::abs(static_cast<std::int64_t>(point.y) - storedPoint_.y) <= doubleClickHeight_ / 2;
      if (near) return storedCount_;
    } else if (IsPressOrRelease(action) && button == lastButton_ && storedCount_ != 1) {
      result = storedCount_ + (action == MouseEvent::kButtonDown ? 1 : 0);
    }
  }

  hasLast_ = true;
  lastAction_ = action;
  lastButton_ = button;
  lastTime_ = now;
  if (action == MouseEvent::kButtonDown) {
    storedCount_ = result;
    storedPoint_ = point;
  }
  return result;
}

}  // namespace velkui::ui
