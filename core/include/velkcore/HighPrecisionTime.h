#pragma once

#include <cstdint>

namespace velkcore {

// A monotonic clock for measuring intervals (never jumps with the wall clock).
class HighPrecisionTime {
 public:
  static std::uint64_t GetTickCount();
  // Ticks per second.
  static std::uint64_t GetFrequency();
  static double TicksToSeconds(std::uint64_t ticks) {
    return static_cast<double>(ticks) / static_cast<double>(GetFrequency());
  }
};

}  // namespace velkcore
