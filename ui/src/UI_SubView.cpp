#include <velkui/ui/UI_SubView.h>

#include <cmath>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;
using velkcore::ScaleMatrixT;

namespace {

bool IsFinite(const RectT<float>& r) {
  return std::isfinite(r.left) && std::isfinite(r.top) && std::isfinite(r.width) &&
         std::isfinite(r.height);
}

}  // namespace

UI_SubView::UI_SubView() {
  asSubView_ = this;
  UI_SetNodeID("UI_SubView");
}

UI_SubView::~UI_SubView() {
  // The children removed by the base destructor must no longer take this
  // node for a sub-view (their matrices ask their parent's).
  asSubView_ = nullptr;
}

bool UI_SubView::UI_IsSubView() const {
  return true;
}

ScaleMatrixT<float> UI_SubView::UI_GetSelfToParentMatrix() const {
  ScaleMatrixT<float> m{localRect_.left, localRect_.top, 1.0f, 1.0f};
  if (!matrixOnlyForChildren_) m = detail::Concat(matrix_, m);
  const UI_Node* parent = UI_GetParentNode();
  if (parent != nullptr && parent->asSubView_ != nullptr &&
      parent->asSubView_->matrixOnlyForChildren_) {
    m = detail::Concat(parent->asSubView_->matrix_, m);
  }
  return m;
}

RectT<std::int32_t> UI_SubView::UI_GetLocalRect(bool inParent) const {
  return detail::RoundOut(UI_GetLocalRectF(inParent));
}

RectT<float> UI_SubView::UI_GetLocalRectF(bool inParent) const {
  if (inParent) return localRect_;
  return {0.0f, 0.0f, localRect_.width, localRect_.height};
}

void UI_SubView::UI_SetLocalRect(const RectT<std::int32_t>& rect) {
  UI_SetLocalRectF(detail::ToFloat(rect));
}

void UI_SubView::UI_SetLocalRectF(const RectT<float>& rect) {
  velkcore::RequireInput(IsFinite(rect));
  if (rect == localRect_) return;
  const NodeP keep = detail::Hold(this);
  UI_Invalidate(nullptr, InvalidateFlags{});
  const RectT<float> old = localRect_;
  localRect_ = rect;
  {
    struct DepthGuard {
      std::uint8_t& depth;
      ~DepthGuard() { --depth; }
    } guard{++frameChangeDepth_};
    UI_GeometryChanged();
    UI_Invalidate(nullptr, InvalidateFlags{});
    UI_SizeChanged(localRect_);
    UI_DispatchNodeChange(NodeChange::kFrameChanged);
  }
  // A frame set from inside this call (by a handler above) lays nothing out itself: the
  // outermost call moves the children once, from the size before to the size now.
  if (frameChangeDepth_ > 0) return;
  const RectT<float> now = localRect_;
  if (viewFlags_.IsSet(kViewLayoutsChildren)) {
    UI_LayoutChildren({old.width, old.height}, {now.width, now.height});
  } else if (now.width > 0.0f && now.height > 0.0f) {
    viewFlags_.Set(kViewHasBeenSized);
  }
}

void UI_SubView::UI_LayoutChildren(const PointT<float>& oldSize, const PointT<float>& newSize) {
  if (!viewFlags_.IsSet(kViewHasBeenSized)) {
    // The first real sizing places nothing: children stay where they were put.
    // An empty size does not count as that first sizing.
    if (newSize.x > 0.0f && newSize.y > 0.0f) viewFlags_.Set(kViewHasBeenSized);
    return;
  }
  const float dx = newSize.x - oldSize.x;
  const float dy = newSize.y - oldSize.y;
  const std::vector<NodeP> children(ChildBegin(), ChildEnd());
  for (const NodeP& child : children) {
    if (child->asSubView_ == nullptr || child->UI_GetParentContainer() != this) continue;
    UI_SubView& view = static_cast<UI_SubView&>(*child);
    RectT<float> frame = view.UI_GetLocalRectF(true);
    const LayoutBinding b = view.layoutBinding_;
    detail::FollowParentResize(newSize.x, dx, b.IsSet(kBindCenterHorizontally),
                               b.IsSet(kBindLeftToRight), b.IsSet(kBindRightToRight), &frame.left,
                               &frame.width);
    detail::FollowParentResize(newSize.y, dy, b.IsSet(kBindCenterVertically),
                               b.IsSet(kBindTopToBottom), b.IsSet(kBindBottomToBottom), &frame.top,
                               &frame.height);
    view.UI_SetLocalRectF(frame);
  }
}

void UI_SubView::UI_Show(bool show) {
  if (viewFlags_.IsSet(kViewShown) == show) return;
  const NodeP keep = detail::Hold(this);
  if (viewFlags_.IsSet(kViewShown)) UI_Invalidate(nullptr, InvalidateFlags{});
  viewFlags_.Set(kViewShown, show);
  UI_GeometryChanged();
  if (show) UI_Invalidate(nullptr, InvalidateFlags{});
  UI_InvalidatePictelCache(true);
  UI_DispatchNodeChange(NodeChange::kShownChanged);
}

bool UI_SubView::UI_IsShown() const {
  return viewFlags_.IsSet(kViewShown) && localRect_.width > 0.0f && localRect_.height > 0.0f;
}

void UI_SubView::UI_Invalidate(const RectT<std::int32_t>* localOrNull, InvalidateFlags flags) {
  UI_Node* parent = UI_GetParentNode();
  if (viewFlags_.IsSet(kViewShown) && parent != nullptr) {
    RectT<std::int32_t> area = detail::RoundOut(UI_GetLocalRectF(false));
    if (localOrNull != nullptr) area = velkcore::Intersection(area, *localOrNull);
    if (area.width > 0 && area.height > 0) {
      const RectT<std::int32_t> inParent = detail::RoundOut(
          detail::TransformRect(UI_GetSelfToParentMatrix(), detail::ToFloat(area)));
      if (inParent.width > 0 && inParent.height > 0 && !IsAreaAlreadyRequested(*parent, inParent)) {
        // Only the node that starts the request may keep its cached pixels:
        // every ancestor's cache holds this node's old drawing.
        InvalidateFlags parentFlags = flags;
        parentFlags.Clear(kInvalidateKeepOwnCache);
        parent->UI_Invalidate(&inParent, parentFlags);
      }
    }
  }
  UI_Node::UI_Invalidate(localOrNull, flags);
}

bool UI_SubView::IsAreaAlreadyRequested(const UI_Node& parent, const RectT<std::int32_t>& area) {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  if (manager == nullptr) return false;
  const std::uint64_t seed = manager->GetPictelCacheSeed();
  const bool covered = requestedSeed_ == seed && requestedParent_ == &parent &&
                       velkcore::Intersection(requestedArea_, area) == area;
  if (covered) return true;
  requestedSeed_ = seed;
  requestedParent_ = &parent;
  requestedArea_ = area;
  return false;
}

void UI_SubView::UI_UpdateNow(UpdateFlags flags) {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_UpdateNow(flags);
}

void UI_SubView::UI_SetOpacity(float) {}

void UI_SubView::UI_SetParent(UI_Container* parent) {
  const NodeP keep = detail::Hold(this);
  RemoveSubtreeTimers();
  UI_Node::UI_SetParent(parent);
  UI_DispatchNodeChange(NodeChange::kParentChanged);
}

void UI_SubView::RemoveSubtreeTimers() {
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager == nullptr) return;
  std::vector<UI_Node*> pending{this};
  while (!pending.empty()) {
    UI_Node* node = pending.back();
    pending.pop_back();
    if (node->asSubView_ == nullptr) continue;
    manager->RemoveNodeTimers(*node);
    for (auto it = node->ChildBegin(); it != node->ChildEnd(); ++it) pending.push_back(it->get());
  }
}

bool UI_SubView::UI_SupportsPictel() const {
  return true;
}

void UI_SubView::UI_SetCapture() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_SetCapture();
}

void UI_SubView::UI_ReleaseCapture() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_ReleaseCapture();
}

bool UI_SubView::UI_ReceivesEventsFromOS() const {
  return false;
}

void UI_SubView::UI_HandleOSEvent(OS_Event*) {}

bool UI_SubView::UI_DispatchEvent(OS_Event*) {
  return false;
}

void UI_SubView::UI_SetKeyboardFocusWithOS() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_SetKeyboardFocusWithOS();
}

ScaleMatrixT<float> UI_SubView::UI_GetMatrix() const {
  return matrix_;
}

void UI_SubView::UI_SetLayoutsChildren(bool layouts) {
  viewFlags_.Set(kViewLayoutsChildren, layouts);
}

void UI_SubView::UI_SetLayoutBinding(LayoutBinding binding) {
  if (layoutBinding_ == binding) return;
  layoutBinding_ = binding;
  // A parent that lays its children out reads the binding.
  UI_GeometryChanged();
}

void UI_SubView::UI_SetSubViewLayoutFlags(velkcore::Flags<std::uint8_t> flags) {
  subViewLayoutFlags_ = flags;
}

void UI_SubView::UI_SetMatrix(const ScaleMatrixT<float>& matrix) {
  const NodeP keep = detail::Hold(this);
  const InvalidateFlags keepOwnPixels{kInvalidateKeepOwnCache};
  UI_Invalidate(nullptr, keepOwnPixels);
  matrix_ = matrix;
  UI_GeometryChanged();
  if (matrixOnlyForChildren_) InvalidateChildBoxes();
  UI_Invalidate(nullptr, keepOwnPixels);
  UI_DispatchNodeChange(NodeChange::kFrameChanged);
}

void UI_SubView::UI_SetMatrixOnlyForChildren(bool onlyForChildren) {
  if (matrixOnlyForChildren_ == onlyForChildren) return;
  const NodeP keep = detail::Hold(this);
  // Both this node's pixels and its children's placement change.
  UI_Invalidate(nullptr, InvalidateFlags{});
  matrixOnlyForChildren_ = onlyForChildren;
  UI_GeometryChanged();
  InvalidateChildBoxes();
  UI_Invalidate(nullptr, InvalidateFlags{});
  UI_DispatchNodeChange(NodeChange::kFrameChanged);
}

}  // namespace velkui::ui
