#include <velkui/ui/MonitorInfo.h>

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <string>

#include <velkcore/Error.h>
#include <velkui/ui/Platform.h>

namespace velkui::ui {

using velkcore::PointT;
using velkcore::PropList;
using velkcore::RectT;

namespace {

constexpr std::int32_t kMinVisibleWidth = 32;
constexpr std::int32_t kMinVisibleHeight = 24;
constexpr const char* kCornerKeys[4] = {"0", "1", "2", "3"};

std::string MonitorKey(std::int32_t index) {
  return "Monitor-" + std::to_string(index);
}

std::int64_t Area(const RectT<std::int32_t>& r) {
  return r.IsEmpty() ? 0 : static_cast<std::int64_t>(r.width) * r.height;
}

// Squared distance from `p` to the rectangle (0 inside).
std::int64_t DistanceSquared(const RectT<std::int32_t>& r, const PointT<std::int32_t>& p) {
  const std::int64_t dx = p.x < r.left ? r.left - p.x : p.x >= r.Right() ? p.x - r.Right() + 1 : 0;
  const std::int64_t dy = p.y < r.top ? r.top - p.y : p.y >= r.Bottom() ? p.y - r.Bottom() + 1 : 0;
  return dx * dx + dy * dy;
}

}  // namespace

MonitorInfo::MonitorInfo() = default;

MonitorInfo::MonitorInfo(std::vector<RectT<std::int32_t>> monitors)
    : monitors_(monitors), workAreas_(std::move(monitors)) {}

MonitorInfo::MonitorInfo(std::vector<RectT<std::int32_t>> monitors,
                         std::vector<RectT<std::int32_t>> workAreas)
    : monitors_(std::move(monitors)), workAreas_(std::move(workAreas)) {
  velkcore::RequireInput(monitors_.size() == workAreas_.size());
}

MonitorInfo::~MonitorInfo() = default;

bool MonitorInfo::IsRectVisible(const RectT<std::int32_t>& rect) const {
  const std::int32_t needWidth = std::min(rect.width, kMinVisibleWidth);
  const std::int32_t needHeight = std::min(rect.height, kMinVisibleHeight);
  const RectT<std::int32_t> top{rect.left, rect.top, rect.width, needHeight};
  for (const RectT<std::int32_t>& area : workAreas_) {
    const RectT<std::int32_t> overlap = velkcore::Intersection(area, top);
    if (overlap.width >= std::max(needWidth, 1) && overlap.height >= std::max(needHeight, 1)) {
      return true;
    }
  }
  return false;
}

void MonitorInfo::EnsureRectIsVisible(RectT<std::int32_t>* rect, bool entirely) const {
  velkcore::RequireInput(rect != nullptr);
  if (workAreas_.empty()) return;
  if (!entirely && IsRectVisible(*rect)) return;
  const std::int32_t index = FindMonitorIndexForRect(*rect);
  const RectT<std::int32_t>& area = workAreas_[static_cast<std::size_t>(index)];
  rect->width = std::min(rect->width, area.width);
  rect->height = std::min(rect->height, area.height);
  rect->left = std::clamp(rect->left, area.left, area.Right() - rect->width);
  rect->top = std::clamp(rect->top, area.top, area.Bottom() - rect->height);
}

void MonitorInfo::Update() const {}

bool MonitorInfo::GetMonitorRect(std::int32_t index, RectT<std::int32_t>& rect) const {
  if (index < 0 || index >= GetMonitorCount()) return false;
  rect = monitors_[static_cast<std::size_t>(index)];
  return true;
}

bool MonitorInfo::GetWorkArea(std::int32_t index, RectT<std::int32_t>& rect) const {
  if (index < 0 || index >= GetMonitorCount()) return false;
  rect = workAreas_[static_cast<std::size_t>(index)];
  return true;
}

RectT<std::int32_t> MonitorInfo::GetMonitorRectFromPoint(const PointT<std::int32_t>& point,
                                                         bool nearest) const {
  std::int64_t best = std::numeric_limits<std::int64_t>::max();
  RectT<std::int32_t> result;
  for (const RectT<std::int32_t>& monitor : monitors_) {
    const std::int64_t distance = DistanceSquared(monitor, point);
    if (distance == 0) return monitor;
    if (nearest && distance < best) {
      best = distance;
      result = monitor;
    }
  }
  return result;
}

RectT<std::int32_t> MonitorInfo::GetMonitorRectFromRect(const RectT<std::int32_t>& rect) const {
  if (monitors_.empty()) return {};
  return monitors_[static_cast<std::size_t>(FindMonitorIndexForRect(rect))];
}

std::int32_t MonitorInfo::FindMonitorIndexForRect(const RectT<std::int32_t>& rect) const {
  std::int32_t best = 0;
  std::int64_t bestArea = 0;
  for (std::size_t i = 0; i < monitors_.size(); ++i) {
    const std::int64_t area = Area(velkcore::Intersection(monitors_[i], rect));
    if (area > bestArea) {
      bestArea = area;
      best = static_cast<std::int32_t>(i);
    }
  }
  if (bestArea > 0) return best;
  const PointT<std::int32_t> centre{rect.left + rect.width / 2, rect.top + rect.height / 2};
  std::int64_t bestDistance = std::numeric_limits<std::int64_t>::max();
  for (std::size_t i = 0; i < monitors_.size(); ++i) {
    const std::int64_t distance = DistanceSquared(monitors_[i], centre);
    if (distance < bestDistance) {
      bestDistance = distance;
      best = static_cast<std::int32_t>(i);
    }
  }
  return best;
}

void MonitorInfo::GetMaxBottomRight(PointT<std::int32_t>& point) const {
  if (monitors_.empty()) return;
  point = {std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::min()};
  for (const RectT<std::int32_t>& monitor : monitors_) {
    point.x = std::max(point.x, monitor.Right());
    point.y = std::max(point.y, monitor.Bottom());
  }
}

void MonitorInfo::SaveToPropList(PropList& list) const {
  list.Set("NumMonitors", GetMonitorCount());
  for (std::int32_t i = 0; i < GetMonitorCount(); ++i) {
    const RectT<std::int32_t>& r = monitors_[static_cast<std::size_t>(i)];
    PropList* corners = list.NewSubList(MonitorKey(i));
    const std::int32_t values[4] = {r.left, r.top, r.width, r.height};
    for (int k = 0; k < 4; ++k) corners->Set(kCornerKeys[k], values[k]);
  }
}

bool MonitorInfo::ReadMonitorRect(const PropList& list, std::int32_t index,
                                  RectT<std::int32_t>& rect) {
  try {
    const PropList* corners = list.GetSubList(MonitorKey(index));
    if (corners == nullptr) return false;
    std::int32_t values[4] = {};
    for (int k = 0; k < 4; ++k) {
      if (!corners->Get(kCornerKeys[k], values[k])) return false;
    }
    rect = {values[0], values[1], values[2], values[3]};
    return true;
  } catch (const velkcore::Exception&) {
    // A value of another type: as good as missing.
    return false;
  }
}

bool MonitorInfo::Equals(const PropList& list) const {
  std::int32_t count = 0;
  try {
    if (!list.Get("NumMonitors", count)) return false;
  } catch (const velkcore::Exception&) {
    return false;
  }
  if (count != GetMonitorCount()) return false;
  for (std::int32_t i = 0; i < count; ++i) {
    RectT<std::int32_t> stored;
    if (!ReadMonitorRect(list, i, stored) || stored != monitors_[static_cast<std::size_t>(i)]) {
      return false;
    }
  }
  return true;
}

// ---- OS_MonitorInfo ----

OS_MonitorInfo::OS_MonitorInfo() {
  Update();
}

void OS_MonitorInfo::Update() const {
  monitors_.clear();
  workAreas_.clear();
  const Platform* platform = GetPlatformIfAny();
  if (platform == nullptr) return;
  for (const MonitorDescription& monitor : platform->GetMonitors()) {
    monitors_.push_back(monitor.bounds);
    workAreas_.push_back(monitor.workArea.IsEmpty() ? monitor.bounds : monitor.workArea);
  }
}

std::int32_t OS_MonitorInfo::GetMonitorIDFromRect(const RectT<std::int32_t>& rect) const {
  std::int32_t best = -1;
  std::int64_t bestArea = 0;
  for (std::size_t i = 0; i < monitors_.size(); ++i) {
    const std::int64_t area = Area(velkcore::Intersection(monitors_[i], rect));
    if (area > bestArea) {
      bestArea = area;
      best = static_cast<std::int32_t>(i);
    }
  }
  return best;
}

}  // namespace velkui::ui
