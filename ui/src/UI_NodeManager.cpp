#include <velkui/ui/UI_NodeManager.h>

#include <algorithm>

#include <velkcore/Error.h>
#include <velkcore/MainThread.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/NodeManagerGuards.h>
#include <velkui/ui/UI_ModKeyNotifier.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/utility/LibraryResources.h>

#include "ManagerInternals.h"
#include "NodeHold.h"

namespace velkui::ui {

namespace {

UI_NodeManager* gInstalled = nullptr;

void ReplaceInList(std::vector<UI_Node*>& list, UI_Node* oldNode, UI_Node* newNode) {
  for (UI_Node*& entry : list) {
    if (entry == oldNode) entry = newNode;
  }
  std::erase(list, nullptr);
}

}  // namespace

UI_NodeManager::UI_NodeManager() {
  if (!velkcore::IsMainThreadRegistered()) velkcore::RegisterMainThread();
}

UI_NodeManager::~UI_NodeManager() {
  if (gInstalled == this) gInstalled = nullptr;
}

void UI_NodeManager::Set(UI_NodeManager* manager) {
  gInstalled = manager;
}

UI_NodeManager* UI_NodeManager::Get(bool required) {
  if (required) velkcore::RequireInput(gInstalled != nullptr);
  return gInstalled;
}

const UI_NodeManager* UI_NodeManager::GetConst(bool required) {
  return Get(required);
}

// ---- Roles ----

void UI_NodeManager::ReplaceWindowFocusNode(UI_Node* oldNode, UI_Node* newNode, bool updateState) {
  velkcore::RequireInput(oldNode != nullptr);
  for (auto& entry : modalStack_) {
    if (entry.second == oldNode) entry.second = newNode;
  }
  if (previousFocusLeaf_ == oldNode) previousFocusLeaf_ = newNode;
  if (focusLeaf_ != oldNode) return;
  if (updateState) {
    ChangeFocusLeaf(newNode, !IsGroupingFocusChanges());
  } else {
    focusLeaf_ = newNode;
  }
}

void UI_NodeManager::ReplaceInAllCachedNodes(UI_Node* oldNode, UI_Node* newNode, bool updateState) {
  velkcore::RequireInput(oldNode != nullptr);
  ReplaceWindowFocusNode(oldNode, newNode, updateState);
  if (mouseOverLeaf_ == oldNode) {
    if (updateState) {
      SetMouseOverLeafNode(newNode, nullptr, nullptr);
    } else {
      mouseOverLeaf_ = newNode;
    }
  }
  if (mouseOverRoot_ == oldNode) {
    mouseOverRoot_ = newNode;
    lastPointer_.reset();
  }
  ReplaceInList(mouseFilters_, oldNode, newNode);
  ReplaceInList(keyboardFilters_, oldNode, newNode);
}

// ---- Input capture ----

void UI_NodeManager::BeginInputCapture(const InputCaptureP& capture) {
  velkcore::RequireInput(capture != nullptr && capture->GetNode() != nullptr);
  const InputCaptureP keep = capture;
  if (capture_) EndInputCapture(true);
  capture_ = keep;
  SuspendToolTips(true);
  keep->toolTipsSuspended_ = true;
  keep->begun_ = true;
  keep->Begin();
  // Begin may have ended the capture already.
  if (capture_ != keep) return;
  const NodeP node = keep->node_;
  node->UI_SetCapture();
  keep->platformCapture_ = true;
}

void UI_NodeManager::EndInputCapture(bool cancelled) {
  const InputCaptureP capture = std::move(capture_);
  capture_.reset();
  if (!capture) return;
  if (capture->toolTipsSuspended_) {
    capture->toolTipsSuspended_ = false;
    SuspendToolTips(false);
  }
  if (capture->platformCapture_) {
    capture->platformCapture_ = false;
    const NodeP node = capture->node_;
    node->UI_ReleaseCapture();
  }
  if (cancelled) capture->cancelled_ = true;
  if (capture->begun_ && !capture->ended_) {
    capture->ended_ = true;
    capture->End();
  }
  UI_Node::UI_InvalidateMouseOverNodes();
}

UI_Node* UI_NodeManager::GetActiveInputCapture() const {
  if (!capture_ || capture_->HasBeenCancelled()) return nullptr;
  return capture_->GetNode();
}

// ---- Filters ----

void UI_NodeManager::AddMouseEventFilterNode(UI_Node* node) {
  velkcore::RequireInput(node != nullptr);
  mouseFilters_.push_back(node);
}

bool UI_NodeManager::RemoveMouseEventFilterNode(UI_Node* node) {
  const auto found = std::find(mouseFilters_.begin(), mouseFilters_.end(), node);
  if (found == mouseFilters_.end()) return false;
  mouseFilters_.erase(found);
  return true;
}

void UI_NodeManager::AddKeyboardEventFilterNode(UI_Node* node) {
  velkcore::RequireInput(node != nullptr);
  keyboardFilters_.push_back(node);
}

bool UI_NodeManager::RemoveKeyboardEventFilterNode(UI_Node* node) {
  const auto found = std::find(keyboardFilters_.begin(), keyboardFilters_.end(), node);
  if (found == keyboardFilters_.end()) return false;
  keyboardFilters_.erase(found);
  return true;
}

// ---- Modal windows ----

void UI_NodeManager::PushModalWindow(OS_Window* window) {
  velkcore::RequireInput(window != nullptr);
  if (!modalStack_.empty() && modalStack_.back().first == window) return;
  modalStack_.emplace_back(window, focusLeaf_);
}

void UI_NodeManager::PopModalWindow(OS_Window* window) {
  const auto found = std::find_if(modalStack_.rbegin(), modalStack_.rend(),
                                  [window](const auto& entry) { return entry.first == window; });
  if (found == modalStack_.rend()) return;
  UI_Node* const saved = found->second;
  const bool wasTop = found == modalStack_.rbegin();
  const auto position = std::next(found).base();
  if (!wasTop) {
    // The window above was pushed while focus sat in `window`, which goes
    // away: when it pops, focus returns to where it was before `window`.
    std::next(position)->second = saved;
    modalStack_.erase(position);
    return;
  }
  modalStack_.erase(position);
  const UpdatingFocus updating(*this);
  if (saved != nullptr) {
    const NodeP keep = detail::Hold(saved);
    saved->UI_GainKeyboardFocus();
  } else if (focusLeaf_ != nullptr) {
    previousFocusLeaf_ = focusLeaf_;
    ChangeFocusLeaf(nullptr, !IsGroupingFocusChanges());
  }
}

OS_Window* UI_NodeManager::GetModalWindow() const {
  return modalStack_.empty() ? nullptr : modalStack_.back().first;
}

bool UI_NodeManager::IsSuspendingOSMouseActivates(const OS_Window* window) const {
  if (window == nullptr) return !suspendedMouseActivates_.empty();
  return std::find(suspendedMouseActivates_.begin(), suspendedMouseActivates_.end(), window) !=
         suspendedMouseActivates_.end();
}

// ---- Application state ----

void UI_NodeManager::SetApplicationFrontmost(bool frontmost) {
  const bool changed = frontmost_ != frontmost;
  frontmost_ = frontmost;
  if (changed && !IsUpdatingFocus()) {
    if (frontmost) {
      if (previousFocusLeaf_ != nullptr) {
        const NodeP keep = detail::Hold(previousFocusLeaf_);
        previousFocusLeaf_->UI_GainKeyboardFocus();
      }
    } else if (focusLeaf_ != nullptr) {
      const NodeP root = detail::Hold(focusLeaf_->UI_GetRootNode());
      focusLeaf_->UI_GetRootNode()->UI_UpdateKeyboardFocusStateDueToLoss();
    }
  }
  if (frontmost) UI_ModKeyNotifier::Get().AppChanged(true, QueryModifierKeys());
  activationChanged_.Call(frontmost);
}

void UI_NodeManager::InstallApplicationActivationChangedFunction(
    const std::shared_ptr<ActivationChangedFunction>& f) {
  activationChanged_.Add(f);
}

void UI_NodeManager::InstallTextEditFocusChangedFunction(
    const std::shared_ptr<TextEditFocusChangedFunction>& f) {
  textEditFocusChanged_.Add(f);
}

void UI_NodeManager::InstallUserResizeFunction(const std::shared_ptr<UserResizeFunction>& f) {
  userResize_.Add(f);
}

void UI_NodeManager::UnregisterFunctions() {
  activationChanged_.Clear();
  textEditFocusChanged_.Clear();
  userResize_.Clear();
}

void UI_NodeManager::SetTextEditControlHasFocus(bool hasFocus) {
  if (textEditHasFocus_ == hasFocus) return;
  textEditHasFocus_ = hasFocus;
  textEditFocusChanged_.Call(hasFocus);
}

void UI_NodeManager::BeginUserResizing(UI_Node* node, bool live) {
  ++userResizing_;
  userResize_.Call(true, node, live);
}

void UI_NodeManager::EndUserResizing(UI_Node* node, bool live) {
  if (userResizing_ > 0) --userResizing_;
  userResize_.Call(false, node, live);
  if (userResizing_ == 0) InvalidateResizedNodes();
}

void UI_NodeManager::InvalidateNodeAfterUserResize(UI_Node* node) {
  velkcore::RequireInput(node != nullptr);
  if (!IsUserResizing()) {
    const NodeP keep = detail::Hold(node);
    node->UI_Invalidate(nullptr, InvalidateFlags{});
    return;
  }
  if (std::find(resizedNodes_.begin(), resizedNodes_.end(), node) == resizedNodes_.end()) {
    resizedNodes_.push_back(detail::Hold(node));
  }
}

void UI_NodeManager::InvalidateResizedNodes() {
  const std::vector<NodeP> nodes = std::move(resizedNodes_);
  resizedNodes_.clear();
  for (const NodeP& node : nodes) {
    if (node) node->UI_Invalidate(nullptr, InvalidateFlags{});
  }
}

void UI_NodeManager::NotifyUserResize(UI_Node* node, bool) {
  if (node != nullptr) node->UI_Invalidate(nullptr, InvalidateFlags{});
}

// ---- Hooks ----

std::optional<velkcore::PointT<float>> UI_NodeManager::QueryPointerPosition(
    const UI_Node& root) const {
  if (&root != mouseOverRoot_) return std::nullopt;
  return lastPointer_;
}

ModifierKeys UI_NodeManager::QueryModifierKeys() const {
  return lastModifiers_;
}

void UI_NodeManager::RemovePendingKeyboardMessages() {}

void UI_NodeManager::MouseOverLeafChangedForToolTips(UI_Node*) {}

void UI_NodeManager::DisposeToolTipOwnedBy(UI_Node&) {}

void UI_NodeManager::ToolTipChanged(UI_Node&) {}

void UI_NodeManager::SuspendToolTips(bool) {}

void UI_NodeManager::RemoveNodeTimers(UI_Node& node) {
  node.UI_RemoveAllTimers();
}

UI_ToolTipManager* UI_NodeManager::GetToolTipManager() {
  return nullptr;
}

utility::PictelImageResourceCache::ImagePtr UI_NodeManager::GetImage(
    const pictel::SupplierInterface& supplier, std::string_view name, pictel::ImageFileType type) {
  return imageCache_.GetImage(utility::LibraryResources(), supplier, name, type);
}

// ---- Lifecycle of nodes ----

void UI_NodeManager::NodeLeavingTree(UI_Node& subtreeRoot) {
  if (capture_ && detail::IsInSubtree(capture_->GetNode(), subtreeRoot)) EndInputCapture(true);
  if (detail::IsInSubtree(mouseOverLeaf_, subtreeRoot)) {
    // The pointer is now over whatever lies under the removed subtree; until
    // the next move, its parent stands in.
    UI_Node* parent = subtreeRoot.UI_GetParentNode();
    if (parent != nullptr && parent->dying_) parent = nullptr;
    SetMouseOverLeafNode(parent, nullptr, nullptr);
  }
  if (detail::IsInSubtree(mouseOverRoot_, subtreeRoot)) {
    mouseOverRoot_ = nullptr;
    lastPointer_.reset();
  }
  if (detail::IsInSubtree(focusLeaf_, subtreeRoot))
    ChangeFocusLeaf(nullptr, !IsGroupingFocusChanges());
  if (detail::IsInSubtree(previousFocusLeaf_, subtreeRoot)) previousFocusLeaf_ = nullptr;
}

void UI_NodeManager::NodeDestroyed(UI_Node& node) {
  DisposeToolTipOwnedBy(node);
  if (mouseOverLeaf_ == &node) mouseOverLeaf_ = nullptr;
  if (mouseOverRoot_ == &node) {
    mouseOverRoot_ = nullptr;
    lastPointer_.reset();
  }
  if (focusLeaf_ == &node) focusLeaf_ = nullptr;
  if (previousFocusLeaf_ == &node) previousFocusLeaf_ = nullptr;
  for (auto& entry : modalStack_) {
    if (entry.second == &node) entry.second = nullptr;
  }
  std::erase(mouseFilters_, &node);
  std::erase(keyboardFilters_, &node);
}

// ---- Keyboard helpers ----

bool UI_NodeManager::CompareControlActivateShortcut(const KeyboardEvent& event) {
  const std::uint16_t key = event.GetKeyControlCode();
  ModifierKeys modifiers = event.GetModKey();
  modifiers.Clear(kModifierCapsLock);
  const bool none = modifiers.IsEmpty();
  const bool returnOrEnter = key == kKeyReturn || key == kKeyEnter;
  if (event.IsActionKeyDown() && !event.IsRepeat()) {
    return (key == kKeySpace && none) ||
           (returnOrEnter && modifiers == ModifierKeys{kModifierControl});
  }
  if (event.IsActionKeyUp()) return (key == kKeySpace && none) || returnOrEnter;
  return false;
}

}  // namespace velkui::ui
