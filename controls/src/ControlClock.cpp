#include <velkui/controls/ControlClock.h>

#include <utility>

#include <velkcore/HighPrecisionTime.h>

namespace velkui::controls {

namespace {

ControlClock& InstalledClock() {
  static ControlClock clock;
  return clock;
}

}  // namespace

void SetControlClock(ControlClock clock) {
  InstalledClock() = std::move(clock);
}

double GetControlTime() {
  if (const ControlClock& clock = InstalledClock()) return clock();
  return velkcore::HighPrecisionTime::TicksToSeconds(velkcore::HighPrecisionTime::GetTickCount());
}

}  // namespace velkui::controls
