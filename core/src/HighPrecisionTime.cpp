#include <velkcore/HighPrecisionTime.h>

#include <chrono>

namespace velkcore {

std::uint64_t HighPrecisionTime::GetTickCount() {
  const auto now = std::chrono::steady_clock::now().time_since_epoch();
  return static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::nanoseconds>(now).count());
}

std::uint64_t HighPrecisionTime::GetFrequency() { return 1'000'000'000ULL; }

}  // namespace velkcore
