#pragma once

#include <velkui/ui/UI_Node.h>

namespace velkui::ui::detail {

// A reference that keeps `node` alive across calls that may drop the tree's own
// reference. Nodes that nobody holds yet (a constructor at work, a node on the
// stack) are not held: a first reference taken and given back would delete them.
inline NodeP Hold(const UI_Node* node) {
  if (node == nullptr || node->GetRefCount() <= 0) return NodeP();
  return NodeP(const_cast<UI_Node*>(node));
}

// A node pointer together with the reference that keeps it alive.
struct HeldNode {
  HeldNode() = default;
  explicit HeldNode(UI_Node* n) : node(n), hold(Hold(n)) {}
  UI_Node* node = nullptr;
  NodeP hold;
};

// `node` is `subtreeRoot` or lies below it.
inline bool IsInSubtree(const UI_Node* node, const UI_Node& subtreeRoot) {
  return node != nullptr && (node == &subtreeRoot || node->UI_IsChildOf(&subtreeRoot));
}

}  // namespace velkui::ui::detail
