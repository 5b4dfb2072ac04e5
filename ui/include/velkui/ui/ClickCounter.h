#pragma once

#include <cstdint>
#include <functional>

#include <velkcore/Geometry.h>
#include <velkui/ui/MouseEvent.h>

namespace velkui::ui {

// Turns a platform window's presses and releases into click counts: the
// platform decides single and double clicks; further presses within the
// double-click time of the previous press or release, with the same button and
// without moving away, count 3, 4, ...; the matching releases carry the same
// count; any other action breaks the chain. One per platform window.
class ClickCounter {
 public:
  // Seconds on a monotonic clock.
  using Clock = std::function<double()>;

  // Without a clock the steady clock of the process is used.
  explicit ClickCounter(Clock clock = {});

  // The platform's double-click time in milliseconds and its double-click rectangle.
  void SetDoubleClickTime(std::uint32_t milliseconds) { doubleClickTimeMs_ = milliseconds; }
  void SetDoubleClickSize(std::int32_t width, std::int32_t height);
  std::uint32_t GetDoubleClickTime() const { return doubleClickTimeMs_; }

  // `baseCount`: 1 for a press or release, 2 for the platform's own
  // double-click message, 0 for moves. Other actions than press, release and
  // move break the chain.
  std::int32_t Count(std::int32_t baseCount, MouseEvent::Action action, std::int32_t button,
                     const velkcore::PointT<std::int32_t>& point);

 private:
  Clock clock_;
  std::uint32_t doubleClickTimeMs_ = 500;
  std::int32_t doubleClickWidth_ = 4;
  std::int32_t doubleClickHeight_ = 4;
  bool hasLast_ = false;
  MouseEvent::Action lastAction_ = MouseEvent::kMove;
  std::int32_t lastButton_ = 0;
  double lastTime_ = 0;
  std::int32_t storedCount_ = 0;
  velkcore::PointT<std::int32_t> storedPoint_;
};

}  // namespace velkui::ui
