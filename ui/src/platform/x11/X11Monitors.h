#pragma once

#include <vector>

#include <velkui/ui/PlatformTypes.h>

#include "X11Connection.h"

namespace velkui::ui::x11 {

// The monitors as XRandR reports them (the whole screen as one monitor when
// it reports none), each with the part of the window manager's work area
// (_NET_WORKAREA of the current desktop) that lies on it.
std::vector<MonitorDescription> ReadMonitors(const X11Connection& connection);

}  // namespace velkui::ui::x11
