#pragma once

#include <functional>

namespace velkui::controls {

// The clock that timed control behaviour reads (the auto-repeat delay of a
// held button, the twirl of a disclosure triangle, popup toggling), in
// seconds: the installed platform's clock (Platform::GetTime, virtual on the
// headless backend), so that timing follows the node timers; without a
// platform a monotonic clock. A clock set here takes precedence (tests and
// hosts with a clock of their own); an empty function removes it.
using ControlClock = std::function<double()>;
void SetControlClock(ControlClock clock);
double GetControlTime();

}  // namespace velkui::controls
