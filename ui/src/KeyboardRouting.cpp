#include <algorithm>

#include <velkcore/Error.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/UI_ModKeyNotifier.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "ManagerInternals.h"
#include "NodeHold.h"

namespace velkui::ui {

namespace {

ModifierKeys WithoutCapsLock(ModifierKeys modifiers) {
  modifiers.Clear(kModifierCapsLock);
  return modifiers;
}

bool IsKey(const KeyboardEvent& event, std::uint16_t code) {
  return event.GetKeyControlCode() == code || event.GetCode().GetControlCode() == code;
}

}  // namespace

// ---- UI_Node entry points ----

bool UI_Node::UI_DispatchKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  return UI_NodeManager::Get()->DispatchKeyboardEvent(target, event);
}

UI_Node* UI_Node::UI_GetKeyboardFocusLeafNode() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr ? manager->GetKeyboardFocusLeafNode() : nullptr;
}

UI_Node* UI_Node::UI_GetPreviousKeyboardFocusNode() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr ? manager->GetPreviousKeyboardFocusNode() : nullptr;
}

void UI_Node::UI_ClearPreviousKeyboardFocus() {
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->ClearPreviousKeyboardFocus();
}

bool UI_Node::UI_TextEditControlHasFocus() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr && manager->TextEditControlHasFocus();
}

bool UI_Node::UI_GainKeyboardFocus(UI_Node* node) {
  velkcore::RequireInput(node != nullptr);
  const NodeP keep = detail::Hold(node);
  if (!node->UI_WantsKeyboardFocus()) {
    if (UI_Node* parent = node->UI_GetParentNode()) {
      const NodeP keepParent = detail::Hold(parent);
      parent->UI_GainKeyboardFocus();
    }
    return false;
  }
  return UI_NodeManager::Get()->GainKeyboardFocus(*node);
}

void UI_Node::UI_LoseKeyboardFocus(UI_Node* node) {
  velkcore::RequireInput(node != nullptr);
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  // Nothing to lose unless the focus leaf really is this node or below it.
  if (manager == nullptr || !detail::IsInSubtree(manager->GetKeyboardFocusLeafNode(), *node)) {
    return;
  }
  const NodeP keep = detail::Hold(node);
  if (UI_Node* parent = node->UI_GetParentNode()) {
    const NodeP keepParent = detail::Hold(parent);
    if (parent->UI_GainKeyboardFocus()) return;
  }
  // An ancestor may have taken focus even though the parent declined.
  if (!detail::IsInSubtree(manager->GetKeyboardFocusLeafNode(), *node)) return;
  node->UI_UpdateKeyboardFocusStateDueToLoss();
}

// ---- Keyboard dispatch ----

bool UI_NodeManager::DispatchKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  velkcore::RequireInput(target != nullptr);
  const NodeP keepTarget = detail::Hold(target);
  if (const std::shared_ptr<UI_EventRecorder> recorder = recorder_) {
    recorder->RecordKeyboardEvent(target, event);
  }
  UI_ModKeyNotifier::Get().DispatchModKeyEvent(event.GetModKey());
  if (GetActiveInputCapture() != nullptr) return DispatchCapturedKeyboardEvent(event);
  if (DispatchPreKeyboardEvent(target, event)) return true;

  ChainLink current{target, keepTarget};
  while (current.node != nullptr) {
    UI_Node& node = *current.node;
    if (!node.UI_IsDisabled()) {
      bool result = false;
      if (node.CallCustomKeyboardFunction(event, &result)) {
        if (result) return true;
      } else if (node.UI_DoKeyboardEvent(target, event)) {
        return true;
      }
    }
    if (event.IsActionKeyChar() && !node.UI_DispatchKeyboardCharEventToParent()) return false;
    UI_Node* parent = node.UI_GetParentNode();
    current = {parent, detail::Hold(parent)};
  }
  return false;
}

bool UI_NodeManager::DispatchCapturedKeyboardEvent(const KeyboardEvent& event) {
  const InputCaptureP capture = capture_;
  DispatchCapturedCursor(*capture, capture->GetPreviousMouseEvent().GetPosition(),
                         event.GetModKey());
  const bool handled = capture->DoKeyboardEvent(event);
  if (!handled && event.IsActionKeyDown() && IsKey(event, kKeyEscape) &&
      WithoutCapsLock(event.GetModKey()).IsEmpty() && capture_ == capture) {
    EndInputCapture(true);
  }
  return true;
}

bool UI_NodeManager::DispatchPreKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  if (event.GetModKey() != lastModifiers_) {
    lastModifiers_ = event.GetModKey();
    // The pointer shape may depend on the modifier keys.
    if (mouseOverRoot_ != nullptr) {
      const ChainLink root{mouseOverRoot_, detail::Hold(mouseOverRoot_)};
      if (const auto position = QueryPointerPosition(*root.node)) {
        root.node->UI_DispatchCursor(*position, lastModifiers_, true);
      }
    }
  }
  if (keyboardFilters_.empty()) return false;
  const std::vector<UI_Node*> snapshot = keyboardFilters_;
  for (UI_Node* filter : snapshot) {
    if (std::find(keyboardFilters_.begin(), keyboardFilters_.end(), filter) ==
        keyboardFilters_.end()) {
      continue;
    }
    const NodeP keep = detail::Hold(filter);
    if (filter->UI_DoPreKeyboardEvent(target, event)) return true;
  }
  return false;
}

// ---- Focus ----

bool UI_NodeManager::GainKeyboardFocus(UI_Node& node) {
  if (focusLeaf_ != &node) {
    previousFocusLeaf_ = focusLeaf_;
    ChangeFocusLeaf(&node, !IsGroupingFocusChanges());
  }
  return true;
}

void UI_NodeManager::UpdateKeyboardFocusStateDueToLoss(UI_Node& node) {
  if (!detail::IsInSubtree(focusLeaf_, node)) return;
  previousFocusLeaf_ = focusLeaf_;
  ChangeFocusLeaf(nullptr, !IsGroupingFocusChanges());
}

void UI_NodeManager::ChangeFocusLeaf(UI_Node* newLeaf, bool notify) {
  UI_Node* const oldLeaf = focusLeaf_;
  if (oldLeaf == newLeaf) return;
  const NodeP keepOld = detail::Hold(oldLeaf);
  const NodeP keepNew = detail::Hold(newLeaf);
  NodeChain oldChain = BuildChain(oldLeaf);
  NodeChain newChain = BuildChain(newLeaf);
  bool oldLeafShared = false;
  bool newLeafShared = false;
  StripCommonAncestors(oldChain, newChain, &oldLeafShared, &newLeafShared);

  NodeChain changed;
  {
    const UpdatingFocus updating(*this);
    focusLeaf_ = newLeaf;
    for (const ChainLink& link : oldChain) {
      if (!link.node->UI_HasKeyboardFocusState()) continue;
      link.node->SetKeyboardFocusState(false);
      changed.push_back(link);
    }
    // A leaf that stays in the chain changes only its leaf status.
    if (oldLeafShared && !oldLeaf->dying_) changed.push_back({oldLeaf, keepOld});
    for (const ChainLink& link : newChain) {
      if (link.node->UI_HasKeyboardFocusState()) continue;
      link.node->SetKeyboardFocusState(true);
      changed.push_back(link);
    }
    if (newLeafShared) changed.push_back({newLeaf, keepNew});
    for (const ChainLink& link : changed) {
      const bool isLeaf = link.node == oldLeaf || link.node == newLeaf;
      if (link.node->UI_InvalidateOnKeyboardFocusChange(isLeaf)) {
        link.node->UI_Invalidate(nullptr, InvalidateFlags{});
      }
    }
  }
  if (!notify) return;
  for (const ChainLink& link : changed) link.node->NotifyFocusChanged();
}

void UI_NodeManager::ClearFocusQuietly() {
  NodeChain chain = BuildChain(focusLeaf_);
  for (const ChainLink& link : chain) link.node->SetKeyboardFocusState(false);
  focusLeaf_ = nullptr;
}

// ---- Focus advance ----

bool UI_Node::UI_DoAdvanceKeyboardFocus(UI_Node* node, const KeyboardEvent& event) {
  velkcore::RequireInput(node != nullptr);
  if (!event.IsActionKeyDown() || !IsKey(event, kKeyTab)) return false;
  const ModifierKeys modifiers = WithoutCapsLock(event.GetModKey());
  bool forward = true;
  if (modifiers == ModifierKeys{kModifierShift}) {
    forward = false;
  } else if (!modifiers.IsEmpty()) {
    return false;
  }
  const NodeP keep = detail::Hold(node);
  if (UI_Container* parent = node->UI_GetParentContainer()) {
    return UI_AdvanceFocus(forward, node->UI_GetIndex(), parent);
  }
  // A root has no siblings: advance among its own children.
  return UI_AdvanceFocus(forward, -1, node);
}

}  // namespace velkui::ui
