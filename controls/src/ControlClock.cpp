#include <velkui/controls/ControlClock.h>

#include <utility>

#include <velkcore/HighPrecisionTime.h>
#include <velkui/ui/Platform.h>

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
  // The platform's clock drives the node timers (virtual on the headless backend).
  if (const ui::Platform* platform = ui::GetPlatformIfAny()) return platform->GetTime();
  return velkcore::HighPrecisionTime::TicksToSeconds(velkcore::HighPrecisionTime::GetTickCount());
}

}  // namespace velkui::controls
