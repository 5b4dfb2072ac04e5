#pragma once

// The window bookkeeping both backends share: what a window record holds
// whatever the window system, the queries over the window tree, and the
// pending paint area.

#include <cstdint>
#include <map>
#include <optional>
#include <utility>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui::platform {

using velkcore::PointT;
using velkcore::RectT;

// A frame's width on each side of the client area.
struct Insets {
  std::int32_t left = 0;
  std::int32_t right = 0;
  std::int32_t top = 0;
  std::int32_t bottom = 0;
};

RectT<std::int32_t> FrameAround(const RectT<std::int32_t>& client, const Insets& frame);
// The client area inside `outer` (never of negative size).
RectT<std::int32_t> ClientWithin(const RectT<std::int32_t>& outer, const Insets& frame);
bool Contains(const RectT<std::int32_t>& outer, const RectT<std::int32_t>& inner);

struct WindowRecordBase {
  PlatformWindow handle = kNoPlatformWindow;
  // The parent of a child window, the owner of any other.
  PlatformWindow parent = kNoPlatformWindow;
  velkcore::UTF16String title;
  // Screen coordinates for top-level windows; relative to the parent's client
  // origin for child windows.
  RectT<std::int32_t> client;
  std::uint32_t style = 0;
  std::uint32_t exStyle = 0;
  bool visible = false;
  bool enabled = true;
  bool minimized = false;
  float opacity = 1.0f;
  std::optional<pictel::ColorRGBA> colorKey;
  // Client rectangles waiting for a paint, none inside another.
  std::vector<RectT<std::int32_t>> pending;
  bool trackLeave = false;
  std::int32_t paintCount = 0;

  bool IsChild() const { return (style & kStyleChild) != 0; }
};

// Adds `rect` (client pixels; null: the whole client area) to the pending area.
void AddPendingArea(WindowRecordBase& record, const RectT<std::int32_t>* rect);
// Moves the client area (relative as `client` is); a new size throws away
// what was pending and makes the whole window pending. True when the size changed.
bool MoveClient(WindowRecordBase& record, const RectT<std::int32_t>& relative);
// The bounds of the pending area (empty when none).
RectT<std::int32_t> PendingBounds(const WindowRecordBase& record);
// The paint of the pending area into `context`; the area is no longer pending.
PaintTarget TakePendingPaint(WindowRecordBase& record, pictel::OSDeviceContext context);

// The windows of one backend by handle. `Record` derives from WindowRecordBase.
template <typename Record>
class WindowTable {
 public:
  using Map = std::map<PlatformWindow, Record>;

  Record* Find(PlatformWindow handle) {
    const auto found = records_.find(handle);
    return found != records_.end() ? &found->second : nullptr;
  }
  const Record* Find(PlatformWindow handle) const {
    const auto found = records_.find(handle);
    return found != records_.end() ? &found->second : nullptr;
  }
  Record& Add(Record record) {
    const PlatformWindow handle = record.handle;
    return records_.emplace(handle, std::move(record)).first->second;
  }
  void Erase(PlatformWindow handle) { records_.erase(handle); }
  void Clear() { records_.clear(); }

  typename Map::iterator begin() { return records_.begin(); }
  typename Map::iterator end() { return records_.end(); }
  typename Map::const_iterator begin() const { return records_.begin(); }
  typename Map::const_iterator end() const { return records_.end(); }

  PointT<std::int32_t> ClientOrigin(const WindowRecordBase& record) const {
    PointT<std::int32_t> origin{record.client.left, record.client.top};
    if (record.IsChild()) {
      if (const Record* parent = Find(record.parent)) {
        const PointT<std::int32_t> base = ClientOrigin(*parent);
        origin.x += base.x;
        origin.y += base.y;
      }
    }
    return origin;
  }
  RectT<std::int32_t> ScreenClient(const WindowRecordBase& record) const {
    const PointT<std::int32_t> origin = ClientOrigin(record);
    return {origin.x, origin.y, record.client.width, record.client.height};
  }
  // `screen` relative to the client origin of `parent` (unchanged without one).
  RectT<std::int32_t> InParentClient(PlatformWindow parent,
                                     const RectT<std::int32_t>& screen) const {
    const Record* record = Find(parent);
    const PointT<std::int32_t> base =
        record != nullptr ? ClientOrigin(*record) : PointT<std::int32_t>{};
    return {screen.left - base.x, screen.top - base.y, screen.width, screen.height};
  }

  // Shown with every ancestor, not minimized.
  bool IsShownOnScreen(const WindowRecordBase& record) const {
    if (!record.visible || record.minimized) return false;
    if (!record.IsChild()) return true;
    const Record* parent = Find(record.parent);
    return parent != nullptr && IsShownOnScreen(*parent);
  }
  bool IsPaintable(const WindowRecordBase& record) const {
    return !record.pending.empty() && IsShownOnScreen(record) && record.client.width > 0 &&
           record.client.height > 0;
  }
  // The window and every ancestor enabled.
  bool IsEnabledForInput(PlatformWindow handle) const {
    for (const Record* record = Find(handle); record != nullptr; record = ParentOf(*record)) {
      if (!record->enabled) return false;
    }
    return Find(handle) != nullptr;
  }
  PlatformWindow TopLevelOf(PlatformWindow handle) const {
    const Record* record = Find(handle);
    while (record != nullptr && record->IsChild()) record = Find(record->parent);
    return record != nullptr ? record->handle : kNoPlatformWindow;
  }
  // `handle` is `ancestor` or lies inside it.
  bool IsWithin(PlatformWindow handle, PlatformWindow ancestor) const {
    for (const Record* record = Find(handle); record != nullptr; record = ParentOf(*record)) {
      if (record->handle == ancestor) return true;
    }
    return false;
  }
  std::vector<PlatformWindow> ChildrenOf(PlatformWindow handle) const {
    std::vector<PlatformWindow> children;
    for (const auto& [h, record] : records_) {
      if (record.IsChild() && record.parent == handle) children.push_back(h);
    }
    return children;
  }
  std::vector<PlatformWindow> TopLevels() const {
    std::vector<PlatformWindow> tops;
    for (const auto& [h, record] : records_) {
      if (!record.IsChild()) tops.push_back(h);
    }
    return tops;
  }

 private:
  const Record* ParentOf(const Record& record) const {
    return record.IsChild() ? Find(record.parent) : nullptr;
  }

  Map records_;
};

}  // namespace velkui::ui::platform
