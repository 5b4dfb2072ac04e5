#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <queue>
#include <utility>
#include <vector>

#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui::x11 {

// The timers of every window as one heap of deadlines, so that the message
// loop knows how long it may sleep. Restarting or killing a timer leaves its
// old heap entry behind; entries that no longer match their timer are skipped
// when they come up.
class TimerHeap {
 public:
  struct Tick {
    PlatformWindow window = kNoPlatformWindow;
    std::uint32_t id = 0;
  };

  // Starts or restarts a timer: first tick at now + interval.
  void Set(PlatformWindow window, std::uint32_t id, std::uint32_t milliseconds, double now);
  void Kill(PlatformWindow window, std::uint32_t id);
  void KillAll(PlatformWindow window);
  // The earliest deadline of a running timer.
  std::optional<double> NextDue();
  // The earliest timer that is due at `now`, moved on to its next deadline.
  // Ticks missed while the loop was busy are not made up.
  std::optional<Tick> TakeDue(double now);
  std::size_t RunningCount() const { return timers_.size(); }

 private:
  struct Timer {
    double interval = 0;
    double due = 0;
    std::uint64_t generation = 0;
  };
  struct Entry {
    double due = 0;
    PlatformWindow window = kNoPlatformWindow;
    std::uint32_t id = 0;
    std::uint64_t generation = 0;
    bool operator>(const Entry& other) const { return due > other.due; }
  };
  using Key = std::pair<PlatformWindow, std::uint32_t>;

  bool IsCurrent(const Entry& entry) const;
  void DropStaleEntries();

  std::map<Key, Timer> timers_;
  std::priority_queue<Entry, std::vector<Entry>, std::greater<>> heap_;
  std::uint64_t nextGeneration_ = 1;
};

}  // namespace velkui::ui::x11
