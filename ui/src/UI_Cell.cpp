#include <velkui/ui/UI_Cell.h>

#include <algorithm>
#include <cmath>
#include <utility>

#include <velkcore/Error.h>

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

bool IsFinite(const RectT<float>& r) {
  return std::isfinite(r.left) && std::isfinite(r.top) && std::isfinite(r.width) &&
         std::isfinite(r.height);
}

bool Contains(const RectT<float>& r, const PointT<float>& p) {
  return p.x >= r.left && p.x < r.left + r.width && p.y >= r.top && p.y < r.top + r.height;
}

}  // namespace

UI_Cell::UI_Cell() = default;
UI_Cell::~UI_Cell() = default;

void UI_Cell::SetLocalRectF(const RectT<float>& rect) {
  velkcore::RequireInput(IsFinite(rect));
  rect_ = rect;
}

const NodeP& UI_Cell::GetNode(std::size_t index) const {
  velkcore::RequireInput(index < entries_.size());
  return entries_[index].node;
}

PointT<float> UI_Cell::GetNodeOffset(std::size_t index) const {
  velkcore::RequireInput(index < entries_.size());
  return entries_[index].offset;
}

void UI_Cell::AddNode(NodeP node, const PointT<float>& offset) {
  velkcore::RequireInput(node != nullptr && std::isfinite(offset.x) && std::isfinite(offset.y));
  for (Entry& entry : entries_) {
    if (entry.node == node) {
      entry.offset = offset;
      return;
    }
  }
  entries_.push_back({std::move(node), offset});
}

bool UI_Cell::RemoveNode(const UI_Node* node) {
  const auto found = std::find_if(entries_.begin(), entries_.end(),
                                  [node](const Entry& e) { return e.node.get() == node; });
  if (found == entries_.end()) return false;
  entries_.erase(found);
  return true;
}

bool UI_Cell::HasNode(const UI_Node* node) const {
  return std::any_of(entries_.begin(), entries_.end(),
                     [node](const Entry& e) { return e.node.get() == node; });
}

void UI_Cell::FetchNodes(const UI_Node& view) {
  entries_.clear();
  for (auto it = view.ChildBegin(); it != view.ChildEnd(); ++it) {
    const RectT<float> frame = (*it)->UI_GetLocalRectF(true);
    if (!Contains(rect_, {frame.left, frame.top})) continue;
    entries_.push_back({*it, {frame.left - rect_.left, frame.top - rect_.top}});
  }
}

PointT<float> UI_Cell::RecalcCellSize(pictel::Pictel* context) {
  PointT<float> needed{0, 0};
  // A node's resizing may run code that changes the cell: work on a copy.
  const std::vector<Entry> entries = entries_;
  for (const Entry& entry : entries) {
    UI_Node& node = *entry.node;
    RectT<float> frame = node.UI_GetLocalRectF(true);
    const PointT<float> recommended = node.UI_GetRecommendedSize(context);
    if (frame.width < recommended.x || frame.height < recommended.y) {
      frame.width = std::max(frame.width, recommended.x);
      frame.height = std::max(frame.height, recommended.y);
      node.UI_SetLocalRectF(frame);
    }
    needed.x = std::max(needed.x, entry.offset.x + frame.width);
    needed.y = std::max(needed.y, entry.offset.y + frame.height);
  }
  return needed;
}

void UI_Cell::UpdateNodesPosition() {
  const std::vector<Entry> entries = entries_;
  for (const Entry& entry : entries) {
    const RectT<float> frame = entry.node->UI_GetLocalRectF(true);
    entry.node->UI_SetLocalRectF(
        {rect_.left + entry.offset.x, rect_.top + entry.offset.y, frame.width, frame.height});
  }
}

}  // namespace velkui::ui
