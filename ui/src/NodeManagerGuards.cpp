#include <velkui/ui/NodeManagerGuards.h>

#include <algorithm>

#include <velkui/ui/UI_NodeManager.h>

#include "NodeHold.h"

namespace velkui::ui {

GroupingFocusChanges::GroupingFocusChanges(UI_NodeManager& manager, bool restoreToCurrent)
    : manager_(manager), outermost_(manager.groupingFocus_ == 0) {
  if (!outermost_) return;
  if (UI_Node* leaf = manager_.GetKeyboardFocusLeafNode()) {
    if (restoreToCurrent) restore_ = detail::Hold(leaf);
    const NodeP root = detail::Hold(leaf->UI_GetRootNode());
    leaf->UI_GetRootNode()->UI_LoseKeyboardFocus();
  }
  ++manager_.groupingFocus_;
}

GroupingFocusChanges::~GroupingFocusChanges() {
  if (!outermost_) return;
  --manager_.groupingFocus_;
  UI_Node* target =
      restore_ && restore_->UI_IsShown() ? restore_.get() : manager_.GetKeyboardFocusLeafNode();
  if (target == nullptr) return;
  const NodeP keep = detail::Hold(target);
  // Listeners heard nothing while grouped: clear quietly and announce the
  // final focus as one change.
  manager_.ClearFocusQuietly();
  target->UI_GainKeyboardFocus();
}

SuspendOSFocusUpdates::SuspendOSFocusUpdates(UI_NodeManager& manager) : manager_(manager) {
  ++manager_.suspendOSFocus_;
}

SuspendOSFocusUpdates::~SuspendOSFocusUpdates() {
  --manager_.suspendOSFocus_;
}

SuspendMouseOverUpdates::SuspendMouseOverUpdates(UI_NodeManager& manager) : manager_(manager) {
  ++manager_.suspendMouseOver_;
}

SuspendMouseOverUpdates::~SuspendMouseOverUpdates() {
  --manager_.suspendMouseOver_;
}

SuspendOSMouseActivates::SuspendOSMouseActivates(UI_NodeManager& manager, const OS_Window* window)
    : manager_(manager), window_(window) {
  manager_.suspendedMouseActivates_.push_back(window_);
}

SuspendOSMouseActivates::~SuspendOSMouseActivates() {
  auto& list = manager_.suspendedMouseActivates_;
  const auto found = std::find(list.rbegin(), list.rend(), window_);
  if (found != list.rend()) list.erase(std::next(found).base());
}

SetModalWindow::SetModalWindow(UI_NodeManager& manager, OS_Window* window)
    : manager_(manager), window_(window) {
  manager_.PushModalWindow(window_);
}

SetModalWindow::~SetModalWindow() {
  manager_.PopModalWindow(window_);
}

NotifyUserResizing::NotifyUserResizing(UI_NodeManager& manager, UI_Node* node, bool live)
    : manager_(manager), node_(detail::Hold(node)), live_(live) {
  manager_.BeginUserResizing(node, live_);
}

NotifyUserResizing::~NotifyUserResizing() {
  manager_.EndUserResizing(node_.get(), live_);
}

AddAndRemoveMouseEventFilterNode::AddAndRemoveMouseEventFilterNode(UI_NodeManager& manager,
                                                                   UI_Node* node)
    : manager_(manager), node_(node) {
  manager_.AddMouseEventFilterNode(node_);
}

AddAndRemoveMouseEventFilterNode::~AddAndRemoveMouseEventFilterNode() {
  manager_.RemoveMouseEventFilterNode(node_);
}

AddAndRemoveKeyboardEventFilterNode::AddAndRemoveKeyboardEventFilterNode(UI_NodeManager& manager,
                                                                         UI_Node* node)
    : manager_(manager), node_(node) {
  manager_.AddKeyboardEventFilterNode(node_);
}

AddAndRemoveKeyboardEventFilterNode::~AddAndRemoveKeyboardEventFilterNode() {
  manager_.RemoveKeyboardEventFilterNode(node_);
}

}  // namespace velkui::ui
