#include "TimerHeap.h"

#include <algorithm>
#include <cmath>

namespace velkui::ui::x11 {

namespace {

constexpr std::uint32_t kMinimumInterval = 10;

}  // namespace

void TimerHeap::Set(PlatformWindow window, std::uint32_t id, std::uint32_t milliseconds,
                    double now) {
  const double interval = static_cast<double>(std::max(milliseconds, kMinimumInterval)) / 1000.0;
  const Timer timer{interval, now + interval, nextGeneration_++};
  timers_[{window, id}] = timer;
  heap_.push({timer.due, window, id, timer.generation});
}

void TimerHeap::Kill(PlatformWindow window, std::uint32_t id) {
  timers_.erase({window, id});
}

void TimerHeap::KillAll(PlatformWindow window) {
  std::erase_if(timers_, [window](const auto& entry) { return entry.first.first == window; });
}

bool TimerHeap::IsCurrent(const Entry& entry) const {
  const auto found = timers_.find({entry.window, entry.id});
  return found != timers_.end() && found->second.generation == entry.generation;
}

void TimerHeap::DropStaleEntries() {
  while (!heap_.empty() && !IsCurrent(heap_.top())) heap_.pop();
  // Killed timers can leave a long tail of entries behind the live ones.
  if (timers_.empty()) heap_ = {};
}

std::optional<double> TimerHeap::NextDue() {
  DropStaleEntries();
  if (heap_.empty()) return std::nullopt;
  return heap_.top().due;
}

std::optional<TimerHeap::Tick> TimerHeap::TakeDue(double now) {
  DropStaleEntries();
  if (heap_.empty() || heap_.top().due > now) return std::nullopt;
  const Entry entry = heap_.top();
  heap_.pop();
  Timer& timer = timers_.at({entry.window, entry.id});
  timer.due += timer.interval;
  if (timer.due <= now) {
    const double missed = std::floor((now - timer.due) / timer.interval) + 1.0;
    timer.due += missed * timer.interval;
  }
  timer.generation = nextGeneration_++;
  heap_.push({timer.due, entry.window, entry.id, timer.generation});
  return Tick{entry.window, entry.id};
}

}  // namespace velkui::ui::x11
