#include "X11Monitors.h"

#include <X11/Xatom.h>
#include <X11/extensions/Xrandr.h>
#include "X11Headers.h"

#include <optional>

namespace velkui::ui::x11 {

namespace {

using velkcore::RectT;

std::vector<long> ReadCardinals(const X11Connection& connection, Atom property) {
  Atom type = None;
  int format = 0;
  unsigned long count = 0;
  unsigned long after = 0;
  unsigned char* data = nullptr;
  std::vector<long> values;
  if (XGetWindowProperty(connection.Get(), connection.Root(), property, 0, 1024, False, XA_CARDINAL,
                         &type, &format, &count, &after, &data) == Success &&
      data != nullptr && type == XA_CARDINAL && format == 32) {
    const auto* longs = reinterpret_cast<const long*>(data);
    values.assign(longs, longs + count);
  }
  if (data != nullptr) XFree(data);
  return values;
}

std::optional<RectT<std::int32_t>> ReadWorkArea(const X11Connection& connection) {
  const std::vector<long> areas = ReadCardinals(connection, connection.Atoms().netWorkarea);
  if (areas.size() < 4) return std::nullopt;
  std::size_t desktop = 0;
  const std::vector<long> current = ReadCardinals(connection, connection.Atoms().netCurrentDesktop);
  if (!current.empty() && current[0] >= 0) desktop = static_cast<std::size_t>(current[0]);
  if (desktop * 4 + 3 >= areas.size()) desktop = 0;
  const long* a = areas.data() + desktop * 4;
  return RectT<std::int32_t>{static_cast<std::int32_t>(a[0]), static_cast<std::int32_t>(a[1]),
                             static_cast<std::int32_t>(a[2]), static_cast<std::int32_t>(a[3])};
}

}  // namespace

std::vector<MonitorDescription> ReadMonitors(const X11Connection& connection) {
  Display* display = connection.Get();
  std::vector<MonitorDescription> monitors;
  int eventBase = 0;
  int errorBase = 0;
  if (XRRQueryExtension(display, &eventBase, &errorBase)) {
    int count = 0;
    XRRMonitorInfo* infos = XRRGetMonitors(display, connection.Root(), True, &count);
    for (int i = 0; i < count; ++i) {
      const XRRMonitorInfo& info = infos[i];
      MonitorDescription monitor;
      monitor.bounds = {info.x, info.y, info.width, info.height};
      monitor.id = info.noutput > 0 ? static_cast<std::uintptr_t>(info.outputs[0])
                                    : static_cast<std::uintptr_t>(info.name);
      monitor.primary = info.primary != 0;
      if (!monitor.bounds.IsEmpty()) monitors.push_back(monitor);
    }
    if (infos != nullptr) XRRFreeMonitors(infos);
  }
  if (monitors.empty()) {
    MonitorDescription whole;
    whole.bounds = {0, 0, DisplayWidth(display, connection.Screen()),
                    DisplayHeight(display, connection.Screen())};
    whole.id = 1;
    monitors.push_back(whole);
  }
  bool anyPrimary = false;
  for (const MonitorDescription& monitor : monitors) anyPrimary = anyPrimary || monitor.primary;
  if (!anyPrimary) monitors.front().primary = true;

  const std::optional<RectT<std::int32_t>> workArea = ReadWorkArea(connection);
  for (MonitorDescription& monitor : monitors) {
    monitor.workArea = monitor.bounds;
    if (workArea) {
      const RectT<std::int32_t> part = velkcore::Intersection(monitor.bounds, *workArea);
      if (!part.IsEmpty()) monitor.workArea = part;
    }
  }
  return monitors;
}

}  // namespace velkui::ui::x11
