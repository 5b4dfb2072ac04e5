#pragma once

#include <functional>

namespace velkui::controls {

// The clock that timed control behaviour reads (the auto-repeat delay of a
// held button, the twirl of a disclosure triangle, popup toggling), in
// seconds. By default a monotonic clock; a backend with a clock of its own
// (the headless backend's virtual clock) installs it here so that timing
// follows the timers it drives. An empty function restores the default.
using ControlClock = std::function<double()>;
void SetControlClock(ControlClock clock);
double GetControlTime();

}  // namespace velkui::controls
