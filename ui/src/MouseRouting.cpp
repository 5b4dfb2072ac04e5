#include <algorithm>
#include <optional>

#include <velkcore/Error.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;

namespace {

// `p` in `from`'s coordinates, expressed in `to`'s (through their common
// global space); none when `to` has a degenerate transform.
std::optional<PointT<float>> MapBetween(const UI_Node& from, const UI_Node& to,
                                        const PointT<float>& p) {
  if (&from == &to) return p;
  const PointT<float> global = from.UI_GetSelfToRootMatrix().Transform(p);
  return detail::InverseTransform(to.UI_GetSelfToRootMatrix(), global);
}

void MoveEventTo(const UI_Node& from, const UI_Node& to, MouseEvent* event) {
  if (const auto p = MapBetween(from, to, event->GetPosition())) event->SetPosition(*p);
}

}  // namespace

// ---- UI_Node entry points ----

bool UI_Node::UI_DispatchMouseEvent(const MouseEvent& event, bool skipOSChildren) {
  return UI_NodeManager::Get()->DispatchMouseEvent(*this, event, skipOSChildren);
}

void UI_Node::UI_UpdateMouseOverState(const MouseEvent& event) {
  UI_NodeManager::Get()->UpdateMouseOverState(*this, event);
}

void UI_Node::UI_MouseExited(const MouseEvent* event, UI_Node* root) {
  UI_NodeManager::Get()->MouseExited(event, root);
}

UI_Node* UI_Node::UI_GetMouseOverLeafNode() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr ? manager->GetMouseOverLeafNode() : nullptr;
}

void UI_Node::UI_InvalidateMouseOverNodes() {
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->InvalidateMouseOverNodes();
}

// ---- Chains ----

UI_NodeManager::ChainLink UI_NodeManager::MakeLink(UI_Node* node) {
  return {node, detail::Hold(node)};
}

UI_NodeManager::NodeChain UI_NodeManager::BuildChain(UI_Node* leaf) {
  NodeChain chain;
  // A node being destroyed has already left its tree as far as roles go.
  for (UI_Node* node = leaf; node != nullptr && !node->dying_; node = node->UI_GetParentNode()) {
    chain.push_back(MakeLink(node));
  }
  return chain;
}

void UI_NodeManager::StripCommonAncestors(NodeChain& a, NodeChain& b, bool* aLeafShared,
                                          bool* bLeafShared) {
  UI_Node* const aLeaf = a.empty() ? nullptr : a.front().node;
  UI_Node* const bLeaf = b.empty() ? nullptr : b.front().node;
  while (!a.empty() && !b.empty() && a.back().node == b.back().node) {
    a.pop_back();
    b.pop_back();
  }
  *aLeafShared = aLeaf != nullptr && (a.empty() || a.front().node != aLeaf);
  *bLeafShared = bLeaf != nullptr && (b.empty() || b.front().node != bLeaf);
}

// ---- Mouse dispatch ----

bool UI_NodeManager::DispatchMouseEvent(UI_Node& root, const MouseEvent& event,
                                        bool skipOSChildren) {
  const NodeP keepRoot = detail::Hold(&root);
  MouseEvent routed = event;
  UI_Node* proxy = root.UI_GetMouseProxy(&routed);
  const ChainLink target = MakeLink(proxy != nullptr ? proxy : &root);
  if (target.node != &root) MoveEventTo(root, *target.node, &routed);

  if (const std::shared_ptr<UI_EventRecorder> recorder = recorder_) {
    recorder->RecordMouseEvent(target.node, routed);
  }
  if (routed.IsAction(MouseEvent::kMove)) {
    mouseOverRoot_ = target.node;
    lastPointer_ = routed.GetPosition();
  }
  if (GetActiveInputCapture() != nullptr) return DispatchCapturedMouseEvent(*target.node, routed);

  ChainLink leaf{nullptr, nullptr};
  if (DispatchTowardsLeaf(*target.node, routed, skipOSChildren, &leaf)) return true;

  // Above the target (windows nested in windows): each ancestor in turn.
  MouseEvent upward = routed;
  ChainLink current = target;
  while (UI_Node* parent = current.node->UI_GetParentNode()) {
    upward.SetPosition(current.node->UI_GetSelfToParentMatrix().Transform(upward.GetPosition()));
    current = MakeLink(parent);
    if (DeliverMouseEvent(*parent, leaf.node, upward)) return true;
  }
  return false;
}

bool UI_NodeManager::DispatchTowardsLeaf(UI_Node& node, const MouseEvent& event,
                                         bool skipOSChildren, ChainLink* leaf) {
  if (node.stateFlags_.IsSet(kStateWantsPreMouseEvents) &&
      DeliverMouseEvent(node, nullptr, event)) {
    return true;
  }
  PointT<float> local = event.GetPosition();
  const auto [found, position] = node.GetChildHit(false, skipOSChildren, &local);
  if (!found) {
    *leaf = MakeLink(&node);
    return DeliverMouseEvent(node, &node, event);
  }
  const ChainLink child = MakeLink(position->get());
  MouseEvent childEvent = event;
  childEvent.SetPosition(local);
  if (DispatchTowardsLeaf(*child.node, childEvent, skipOSChildren, leaf)) return true;
  return DeliverMouseEvent(node, leaf->node, event);
}

bool UI_NodeManager::DeliverMouseEvent(UI_Node& node, UI_Node* leaf, const MouseEvent& event) {
  if (leaf == &node && RunMouseFilters(node, event)) return true;
  // A disabled node neither handles nor consumes the event.
  if (node.UI_IsDisabled()) return false;
  bool result = false;
  if (node.CallCustomMouseFunction(event, &result)) return result;
  return node.UI_DoMouseEvent(leaf, event);
}

bool UI_NodeManager::RunMouseFilters(UI_Node& leaf, const MouseEvent& event) {
  if (mouseFilters_.empty()) return false;
  const std::vector<UI_Node*> snapshot = mouseFilters_;
  for (UI_Node* filter : snapshot) {
    // A filter removed (or destroyed) by an earlier one is skipped.
    if (std::find(mouseFilters_.begin(), mouseFilters_.end(), filter) == mouseFilters_.end()) {
      continue;
    }
    const NodeP keep = detail::Hold(filter);
    if (filter->UI_DoPreMouseEvent(&leaf, event)) return true;
  }
  return false;
}

// ---- Capture ----

bool UI_NodeManager::DispatchCapturedMouseEvent(UI_Node& target, const MouseEvent& event) {
  const InputCaptureP capture = capture_;
  const NodeP node = capture->node_;
  MouseEvent captured = event;
  if (node.get() != &target) MoveEventTo(target, *node, &captured);
  DispatchCapturedCursor(*capture, captured.GetPosition(), captured.GetModKey());
  const bool handled = capture->DoMouseEvent(captured);
  // Only the capture that is still installed may be ended here.
  if (!handled && captured.IsEndDragEvent(capture->GetInitialMouseEvent()) && capture_ == capture) {
    EndInputCapture(false);
  }
  if (!captured.IsAction(MouseEvent::kMouseOverUpdate)) capture->previousEvent_ = captured;
  return true;
}

void UI_NodeManager::DispatchCapturedCursor(InputCapture& capture, const PointT<float>& point,
                                            ModifierKeys modifiers) {
  const InputCaptureP keep(&capture);
  if (capture.DoCursor(point, modifiers)) return;
  UI_Node* const captureNode = capture.GetNode();
  ChainLink current = MakeLink(captureNode);
  PointT<float> position = point;
  for (;;) {
    if (!current.node->UI_IsDisabled() &&
        current.node->UI_DoCursor(captureNode, position, modifiers)) {
      return;
    }
    UI_Node* parent = current.node->UI_GetParentNode();
    if (parent == nullptr) return;
    position = current.node->UI_GetSelfToParentMatrix().Transform(position);
    current = MakeLink(parent);
  }
}

// ---- Cursor ----

bool UI_NodeManager::DispatchCursor(UI_Node& root, const PointT<float>& point,
                                    ModifierKeys modifiers, bool skipOSChildren) {
  const NodeP keepRoot = detail::Hold(&root);
  if (UI_Node* captureNode = GetActiveInputCapture()) {
    const InputCaptureP capture = capture_;
    const auto inCapture = MapBetween(root, *captureNode, point);
    DispatchCapturedCursor(*capture, inCapture.value_or(point), modifiers);
    return true;
  }
  ChainLink leaf{nullptr, nullptr};
  if (DispatchCursorTowardsLeaf(root, point, modifiers, skipOSChildren, &leaf)) return true;
  PointT<float> position = point;
  ChainLink current = MakeLink(&root);
  while (UI_Node* parent = current.node->UI_GetParentNode()) {
    position = current.node->UI_GetSelfToParentMatrix().Transform(position);
    current = MakeLink(parent);
    if (!parent->UI_IsDisabled() && parent->UI_DoCursor(leaf.node, position, modifiers)) {
      return true;
    }
  }
  return false;
}

bool UI_NodeManager::DispatchCursorTowardsLeaf(UI_Node& node, const PointT<float>& point,
                                               ModifierKeys modifiers, bool skipOSChildren,
                                               ChainLink* leaf) {
  PointT<float> local = point;
  const auto [found, position] = node.GetChildHit(false, skipOSChildren, &local);
  if (found) {
    const ChainLink child = MakeLink(position->get());
    if (DispatchCursorTowardsLeaf(*child.node, local, modifiers, skipOSChildren, leaf)) {
      return true;
    }
  } else {
    *leaf = MakeLink(&node);
  }
  return !node.UI_IsDisabled() && node.UI_DoCursor(leaf->node, point, modifiers);
}

// ---- Mouse-over state ----

void UI_NodeManager::UpdateMouseOverState(UI_Node& root, const MouseEvent& event) {
  if (IsSuspendingMouseOverUpdates()) return;
  const NodeP keepRoot = detail::Hold(&root);
  if (&root == mouseOverRoot_) lastPointer_ = event.GetPosition();
  // A handler may change the tree or the state meanwhile: then the leaf under
  // the pointer is looked for once more.
  for (int attempt = 0; attempt < 2; ++attempt) {
    PointT<float> local = event.GetPosition();
    const auto [found, position] = root.GetChildHit(true, true, &local);
    UI_Node* leaf = found ? position->get() : &root;
    if (leaf == mouseOverLeaf_ || SetMouseOverLeafNode(leaf, &event, &root)) return;
  }
}

void UI_NodeManager::MouseExited(const MouseEvent* event, UI_Node* root) {
  // The pointer may already be over another window whose enter came first.
  if (root != nullptr && mouseOverLeaf_ != nullptr && mouseOverLeaf_->UI_GetRootNode() != root) {
    return;
  }
  SetMouseOverLeafNode(nullptr, event, root);
  if (root != nullptr && root == mouseOverRoot_) {
    mouseOverRoot_ = nullptr;
    lastPointer_.reset();
  }
}

void UI_NodeManager::InvalidateMouseOverNodes() {
  if (mouseOverRoot_ == nullptr) return;
  const ChainLink root = MakeLink(mouseOverRoot_);
  const auto position = QueryPointerPosition(*root.node);
  if (!position) return;
  root.node->UI_UpdateMouseOverState(
      MouseEvent(MouseEvent::kMouseOverUpdate, 0, 0, *position, lastModifiers_));
}

bool UI_NodeManager::SetMouseOverLeafNode(UI_Node* newLeaf, const MouseEvent* event,
                                          const UI_Node* eventRoot) {
  UI_Node* const oldLeaf = mouseOverLeaf_;
  if (newLeaf == oldLeaf) return true;
  const std::uint64_t generation = ++mouseOverGeneration_;
  const NodeP keepOld = detail::Hold(oldLeaf);
  const NodeP keepNew = detail::Hold(newLeaf);
  NodeChain oldChain = BuildChain(oldLeaf);
  NodeChain newChain = BuildChain(newLeaf);
  bool oldLeafShared = false;
  bool newLeafShared = false;
  StripCommonAncestors(oldChain, newChain, &oldLeafShared, &newLeafShared);

  // Held by the chains (and the two leaves by keepOld and keepNew).
  NodeList changed;
  const auto invalidateIfAsked = [](UI_Node& node, bool isLeaf) {
    if (node.UI_InvalidateOnMouseOverChange(isLeaf)) node.UI_Invalidate(nullptr, InvalidateFlags{});
  };
  for (const ChainLink& link : oldChain) {
    UI_Node& node = *link.node;
    const bool isLeaf = &node == oldLeaf;
    const bool wasOver = node.stateFlags_.IsSet(kStateMouseOver);
    if (!wasOver && !isLeaf) continue;
    invalidateIfAsked(node, isLeaf);
    if (wasOver) {
      node.SetMouseOverState(false);
      changed.push_back(&node);
    }
    if (event != nullptr) {
      DeliverExitNotice(node, *event, eventRoot);
      // A handler moved the mouse-over state itself; that update stands.
      if (mouseOverGeneration_ != generation) return false;
    }
  }
  // A leaf that stays in the chain (an ancestor of the other leaf) changes
  // only its leaf status.
  if (oldLeafShared && !oldLeaf->dying_) {
    invalidateIfAsked(*oldLeaf, true);
    changed.push_back(oldLeaf);
  }
  for (const ChainLink& link : newChain) {
    UI_Node& node = *link.node;
    const bool isLeaf = &node == newLeaf;
    const bool wasOver = node.stateFlags_.IsSet(kStateMouseOver);
    if (wasOver && !isLeaf) continue;
    invalidateIfAsked(node, isLeaf);
    if (!wasOver) {
      node.SetMouseOverState(true);
      changed.push_back(&node);
    }
  }
  if (newLeafShared) {
    invalidateIfAsked(*newLeaf, true);
    changed.push_back(newLeaf);
  }
  mouseOverLeaf_ = newLeaf;
  for (UI_Node* node : changed) node->UI_MouseOverChanged();
  if (mouseOverGeneration_ != generation) return false;
  MouseOverLeafChangedForToolTips(mouseOverLeaf_);
  return true;
}

void UI_NodeManager::DeliverExitNotice(UI_Node& node, const MouseEvent& event,
                                       const UI_Node* eventRoot) {
  MouseEvent notice = event;
  if (eventRoot != nullptr) MoveEventTo(*eventRoot, node, &notice);
  bool result = false;
  if (!node.CallCustomMouseFunction(notice, &result)) node.UI_DoMouseEvent(&node, notice);
}

}  // namespace velkui::ui
