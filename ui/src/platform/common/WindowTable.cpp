#include "WindowTable.h"

#include <algorithm>

namespace velkui::ui::platform {

namespace {

// More separate pending rectangles than this are merged into their bounds.
constexpr std::size_t kMaxPendingRects = 16;

}  // namespace

RectT<std::int32_t> FrameAround(const RectT<std::int32_t>& client, const Insets& frame) {
  return {client.left - frame.left, client.top - frame.top, client.width + frame.left + frame.right,
          client.height + frame.top + frame.bottom};
}

RectT<std::int32_t> ClientWithin(const RectT<std::int32_t>& outer, const Insets& frame) {
  return {outer.left + frame.left, outer.top + frame.top,
          std::max(0, outer.width - frame.left - frame.right),
          std::max(0, outer.height - frame.top - frame.bottom)};
}

bool Contains(const RectT<std::int32_t>& outer, const RectT<std::int32_t>& inner) {
  return inner.left >= outer.left && inner.top >= outer.top && inner.Right() <= outer.Right() &&
         inner.Bottom() <= outer.Bottom();
}

void AddPendingArea(WindowRecordBase& record, const RectT<std::int32_t>* rect) {
  const RectT<std::int32_t> whole{0, 0, record.client.width, record.client.height};
  const RectT<std::int32_t> area = rect != nullptr ? velkcore::Intersection(whole, *rect) : whole;
  if (area.IsEmpty()) return;
  for (const RectT<std::int32_t>& existing : record.pending) {
    if (Contains(existing, area)) return;
  }
  std::erase_if(record.pending,
                [&area](const RectT<std::int32_t>& existing) { return Contains(area, existing); });
  record.pending.push_back(area);
  if (record.pending.size() > kMaxPendingRects) record.pending = {PendingBounds(record)};
}

bool MoveClient(WindowRecordBase& record, const RectT<std::int32_t>& relative) {
  const bool resized =
      relative.width != record.client.width || relative.height != record.client.height;
  record.client = relative;
  if (resized) {
    record.pending.clear();
    AddPendingArea(record, nullptr);
  }
  return resized;
}

RectT<std::int32_t> PendingBounds(const WindowRecordBase& record) {
  RectT<std::int32_t> bounds;
  for (const RectT<std::int32_t>& r : record.pending) bounds = velkcore::Union(bounds, r);
  return bounds;
}

PaintTarget TakePendingPaint(WindowRecordBase& record, pictel::OSDeviceContext context) {
  PaintTarget target;
  target.context = context;
  target.bounds = PendingBounds(record);
  target.rects = std::move(record.pending);
  record.pending.clear();
  ++record.paintCount;
  return target;
}

}  // namespace velkui::ui::platform
