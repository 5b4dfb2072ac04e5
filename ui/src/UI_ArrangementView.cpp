#include <velkui/ui/UI_ArrangementView.h>

#include <algorithm>
#include <cmath>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/arrange/Single.h>
#include <velkui/controls/UI_Divider.h>

#include "NodeHold.h"

namespace velkui::ui {

using arrange::PointF;
using arrange::RectF;
using velkcore::PointT;
using velkcore::RectT;

namespace {

// The bindings that make a leaf expandable.
constexpr std::uint8_t kExpandingBindings = kBindRightToRight | kBindBottomToBottom;

// What a leaf knows of its node: whether it takes part, how large it is and how it may grow.
struct NodeState {
  bool visible = false;
  PointF size{};
  std::uint8_t growth = 0;
};

NodeState ReadState(const UI_Node& node) {
  const RectT<float> frame = node.UI_GetLocalRectF(true);
  if (!node.UI_IsSubView()) return {node.UI_IsShown(), {frame.width, frame.height}, 0};
  const auto& view = static_cast<const UI_SubView&>(node);
  return {view.UI_GetViewFlags().IsSet(kViewShown),
          {frame.width, frame.height},
          static_cast<std::uint8_t>(view.UI_GetLayoutBinding().Get() & kExpandingBindings)};
}

// Exact comparison in which a NaN length equals another NaN: a node that answers NaN is not
// taken for one that changes all the time.
bool SameLength(float a, float b) {
  return a == b || (std::isnan(a) && std::isnan(b));
}

// Sizes the engine may measure: finite and not negative.
float Measurable(float length) {
  return std::isfinite(length) && length > 0 ? length : 0.0f;
}

}  // namespace

// The leaf of one child node.
class UI_ArrangementView::NodeBridge : public arrange::Single {
 public:
  NodeBridge(UI_ArrangementView& view, UI_Node& node)
      : view_(view), node_(node), recorded_(ReadState(node)), seen_(recorded_.size) {}

  UI_Node& Node() const { return node_; }

  float NaturalWidth() const override {
    return recorded_.visible ? Measurable(recorded_.size.x) : 0.0f;
  }
  float NaturalHeight() const override {
    return recorded_.visible ? Measurable(recorded_.size.y) : 0.0f;
  }
  bool HorizontallyExpandable() const override {
    return (recorded_.growth & kBindRightToRight) != 0;
  }
  bool VerticallyExpandable() const override {
    return (recorded_.growth & kBindBottomToBottom) != 0;
  }

  // Records a size, visibility or binding the node took on its own since it was last looked
  // at, and marks the leaf out of date; true when it did. A size this bridge gave the node is no
  // change, and each axis counts on its own: a stretched child that changes its height keeps
  // its natural width, not the stretched one.
  bool RecordChanges() {
    const NodeState now = ReadState(node_);
    const bool widthChanged = !SameLength(now.size.x, seen_.x);
    const bool heightChanged = !SameLength(now.size.y, seen_.y);
    if (!widthChanged && !heightChanged && now.visible == recorded_.visible &&
        now.growth == recorded_.growth) {
      return false;
    }
    if (widthChanged) recorded_.size.x = now.size.x;
    if (heightChanged) recorded_.size.y = now.size.y;
    seen_ = now.size;
    recorded_.visible = now.visible;
    recorded_.growth = now.growth;
    MarkInvalid();
    return true;
  }

  void Place(const RectF& rect) override {
    // A node changed meanwhile is measured again in the next pass instead.
    if (RecordChanges()) return;
    if (!recorded_.visible) return;
    const PointT<float> origin = view_.EngineToLocal(view_, {rect.left, rect.top});
    const RectT<float> frame{origin.x, origin.y, ExpandedWidth(rect.width),
                             ExpandedHeight(rect.height)};
    seen_ = PointF{frame.width, frame.height};
    // Last: the node's reaction may remove it from the view, which destroys this bridge.
    const NodeP keep = detail::Hold(&node_);
    node_.UI_SetLocalRectF(frame);
  }

 private:
  UI_ArrangementView& view_;
  UI_Node& node_;
  NodeState recorded_;
  // The node's size when this bridge last set or read it.
  PointF seen_;
};

// The engine's separator of one gap: hands the frame, in the view's coordinates, to the node
// drawn there.
class UI_ArrangementView::SeparatorBridge : public arrange::ISeparator {
 public:
  SeparatorBridge(UI_ArrangementView& view, NodeP node, arrange::ISeparator& target)
      : view_(view), node_(std::move(node)), target_(target) {}

  const NodeP& Node() const { return node_; }

  void SetSeparatorFrame(bool acrossColumn, const RectF& frame) override {
    const PointT<float> origin = view_.EngineToLocal(view_, {frame.left, frame.top});
    const NodeP keep = node_;
    target_.SetSeparatorFrame(acrossColumn, {origin.x, origin.y, frame.width, frame.height});
  }

 private:
  UI_ArrangementView& view_;
  NodeP node_;
  arrange::ISeparator& target_;
};

UI_ArrangementView::UI_ArrangementView(arrange::GroupArrangementType type)
    : DefaultGroup(nullptr, type) {
  UI_SetLayoutsChildren(true);
}

UI_ArrangementView::~UI_ArrangementView() {
  // The leaves and separators go while the group they belong to is still whole.
  bridgeAtIndex_.clear();
  bridgeOfNode_.clear();
  bridges_.clear();
  for (UI_ArrangementView* nested : nested_) {
    if (nested->Parent() == this) nested->SetParent(nullptr);
  }
  nested_.clear();
  separators_.clear();
}

void UI_ArrangementView::SetArrangementType(arrange::GroupArrangementType type) {
  SetArrangementType(type, Parent());
}

void UI_ArrangementView::EnableSeparators(bool enable) {
  if (separatorsEnabled_ == enable) return;
  separatorsEnabled_ = enable;
  const NodeP keep = detail::Hold(this);
  BuildSeparators();
}

void UI_ArrangementView::UpdateChildSizes() {
  bool changed = false;
  for (const auto& bridge : bridges_) changed = bridge->RecordChanges() || changed;
  if (changed) Invalidate();
}

// ---- Coordinates ----

UI_ArrangementView* UI_ArrangementView::RootView() {
  arrange::IArrangeable* top = this;
  while (top->Parent() != nullptr) top = top->Parent();
  return dynamic_cast<UI_ArrangementView*>(top);
}

PointT<float> UI_ArrangementView::EngineToLocal(const UI_Node& target, const PointT<float>& p) {
  UI_ArrangementView* root = RootView();
  if (root == nullptr) return target.UI_GlobalToLocalF(p);
  // Relative to where the root stood when it was last arranged: a tree that has moved since
  // keeps its layout when it is re-arranged at that rectangle.
  const RectF& last = root->LastRectangle();
  const PointT<float> inRoot{p.x - last.left, p.y - last.top};
  if (&target == root) return inRoot;
  const velkcore::ScaleMatrixT<float> m = target.UI_GetSelfToSpecificParentMatrix(root);
  const float sx = std::fabs(m.sx) > 1e-6f ? m.sx : 1.0f;
  const float sy = std::fabs(m.sy) > 1e-6f ? m.sy : 1.0f;
  return {(inRoot.x - m.tx) / sx, (inRoot.y - m.ty) / sy};
}

// ---- Group callbacks ----

void UI_ArrangementView::Position(const PointF& origin) {
  if (IsRootArrangement()) return;
  UI_Node* parent = UI_GetParentNode();
  if (parent == nullptr) return;
  const PointT<float> local = EngineToLocal(*parent, origin);
  RectT<float> frame = UI_GetLocalRectF(true);
  frame.left = local.x;
  frame.top = local.y;
  UI_SetLocalRectF(frame);
}

void UI_ArrangementView::SetDimensions(const PointF& size) {
  if (IsRootArrangement() || !(size.x >= 0 && size.y >= 0)) return;
  RectT<float> frame = UI_GetLocalRectF(true);
  frame.width = size.x;
  frame.height = size.y;
  UI_SetLocalRectF(frame);
}

NodeP UI_ArrangementView::NewSeparatorNode() {
  return velkcore::MakeIntrusive<controls::UI_Divider>();
}

arrange::ISeparator* UI_ArrangementView::BuildSeparator() {
  if (!separatorsEnabled_) return nullptr;
  const NodeP node = NewSeparatorNode();
  if (node == nullptr) return nullptr;
  auto* target = dynamic_cast<arrange::ISeparator*>(node.get());
  velkcore::RequireInput(target != nullptr);
  separators_.push_back(std::make_unique<SeparatorBridge>(*this, node, *target));
  changingSeparators_ = true;
  try {
    ChildPushBack(node);
  } catch (...) {
    changingSeparators_ = false;
    separators_.pop_back();
    throw;
  }
  changingSeparators_ = false;
  if (node->UI_IsSubView()) static_cast<UI_SubView&>(*node).UI_Show(true);
  return separators_.back().get();
}

void UI_ArrangementView::ClearSeparators() {
  DefaultGroup::ClearSeparators();
  std::vector<std::unique_ptr<SeparatorBridge>> old;
  old.swap(separators_);
  changingSeparators_ = true;
  for (const auto& separator : old) {
    if (separator->Node()->UI_GetParentContainer() == this) ChildRemove(separator->Node().get());
  }
  changingSeparators_ = false;
}

bool UI_ArrangementView::IsSeparatorNode(const UI_Node* node) const {
  return std::any_of(separators_.begin(), separators_.end(),
                     [node](const auto& s) { return s->Node().get() == node; });
}

// ---- Children ----

void UI_ArrangementView::RebuildArrangeables() {
  const NodeP keep = detail::Hold(this);
  std::vector<arrange::IArrangeable*> arrangeables;
  std::vector<std::unique_ptr<NodeBridge>> bridges;
  std::vector<UI_ArrangementView*> nested;
  for (auto it = ChildBegin(); it != ChildEnd(); ++it) {
    UI_Node* child = it->get();
    if (IsSeparatorNode(child)) continue;
    if (auto* view = dynamic_cast<UI_ArrangementView*>(child)) {
      nested.push_back(view);
      arrangeables.push_back(view);
      continue;
    }
    const auto found = std::find_if(bridges_.begin(), bridges_.end(),
                                    [child](const auto& b) { return b && &b->Node() == child; });
    if (found != bridges_.end()) {
      bridges.push_back(std::move(*found));
    } else {
      bridges.push_back(std::make_unique<NodeBridge>(*this, *child));
    }
    arrangeables.push_back(bridges.back().get());
  }
  // Leaves of nodes that left go first (the group forgets them as they are destroyed), and
  // views no longer nested here become roots of their own.
  bridgeAtIndex_.clear();
  bridgeOfNode_.clear();
  bridges_.clear();
  bridges_ = std::move(bridges);
  bridgeAtIndex_.resize(ChildSize(), nullptr);
  for (const auto& bridge : bridges_) {
    const auto index = static_cast<std::size_t>(bridge->Node().UI_GetIndex());
    if (index < bridgeAtIndex_.size()) bridgeAtIndex_[index] = bridge.get();
    bridgeOfNode_.emplace(&bridge->Node(), bridge.get());
  }
  for (UI_ArrangementView* old : nested_) {
    if (std::find(nested.begin(), nested.end(), old) == nested.end() && old->Parent() == this) {
      old->SetParent(nullptr);
    }
  }
  nested_ = std::move(nested);
  SetChildren(arrangeables);
}

void UI_ArrangementView::ChildAdded(UI_Node* node) {
  UI_SubView::ChildAdded(node);
  if (changingSeparators_) return;
  RebuildArrangeables();
}

void UI_ArrangementView::ChildRemoved(UI_Node* node) {
  UI_SubView::ChildRemoved(node);
  if (changingSeparators_) return;
  if (IsSeparatorNode(node)) {
    // Someone else took a separator away: drop them all, so that the engine keeps no separator
    // whose node is gone; the next arrangement makes them again.
    const NodeP keep = detail::Hold(this);
    ClearSeparators();
    Invalidate();
    return;
  }
  RebuildArrangeables();
  // A view that left becomes a root: it arranges itself where it lands.
  if (auto* view = dynamic_cast<UI_ArrangementView*>(node)) view->ArrangeAsRootView();
}

void UI_ArrangementView::ChildOrderChanged() {
  UI_SubView::ChildOrderChanged();
  RebuildArrangeables();
}

UI_ArrangementView::NodeBridge* UI_ArrangementView::FindBridge(const UI_Node& node) const {
  const auto index = static_cast<std::size_t>(node.UI_GetIndex());
  if (index < bridgeAtIndex_.size()) {
    NodeBridge* bridge = bridgeAtIndex_[index];
    if (bridge != nullptr && &bridge->Node() == &node) return bridge;
  }
  const auto found = bridgeOfNode_.find(&node);
  return found != bridgeOfNode_.end() ? found->second : nullptr;
}

void UI_ArrangementView::ChildGeometryChanged(const UI_Node& child) {
  UI_SubView::ChildGeometryChanged(child);
  // Separators and nested views are sized by the engine itself; a frame this view gave is no
  // change either (RecordChanges knows it).
  NodeBridge* bridge = FindBridge(child);
  if (bridge == nullptr || !bridge->RecordChanges()) return;
  // A tree that cannot arrange now (hidden or detached) stays marked until it can.
  const UI_ArrangementView* root = RootView();
  if (root != nullptr && !root->CanArrangeAsRoot()) return;
  // While the tree is being arranged this only asks the arrangement under way for another pass.
  const NodeP keep = detail::Hold(this);
  Invalidate();
}

// ---- Arranging ----

bool UI_ArrangementView::CanArrangeAsRoot() const {
  return IsRootArrangement() && UI_GetParentNode() != nullptr && UI_IsShown();
}

void UI_ArrangementView::ArrangeAsRootView() {
  lastParentNode_ = UI_GetParentNode();
  lastShown_ = UI_IsShown();
  if (!CanArrangeAsRoot()) return;
  const NodeP keep = detail::Hold(this);
  const RectT<float> bounds = UI_GetLocalRectF(false);
  const PointT<float> origin = UI_LocalToGlobalF(PointT<float>{0, 0});
  Arrange({origin.x, origin.y, bounds.width, bounds.height});
}

void UI_ArrangementView::UI_LayoutChildren(const PointT<float>& /*oldSize*/,
                                           const PointT<float>& /*newSize*/) {
  if (IsRootArrangement()) ArrangeAsRootView();
}

void UI_ArrangementView::UI_NodeChanged(NodeChange change) {
  UI_SubView::UI_NodeChanged(change);
  if (change != NodeChange::kParentChanged && change != NodeChange::kShownChanged) return;
  // Also sent when an ancestor changes; only this view's own attachment and visibility matter.
  const UI_Node* parent = UI_GetParentNode();
  if (parent == lastParentNode_ && UI_IsShown() == lastShown_) return;
  // A view put into another arrangement view is nested by it right after.
  if (dynamic_cast<const UI_ArrangementView*>(parent) != nullptr) {
    lastParentNode_ = parent;
    lastShown_ = UI_IsShown();
    return;
  }
  if (IsRootArrangement()) ArrangeAsRootView();
}

}  // namespace velkui::ui
