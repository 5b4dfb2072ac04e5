#include <unordered_set>

#include <velkcore/Error.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeHold.h"

namespace velkui::ui {

namespace {

// One Tab search. Every container is visited at most once, so the search ends.
class FocusSearch {
 public:
  FocusSearch(bool forward, UI_Node* previous)
      : forward_(forward), previous_(previous), keepPrevious_(detail::Hold(previous)) {}

  void MarkVisited(const UI_Container* container) { visited_.insert(container); }

  // Searches `list` after `start`, then (when the list allows it) the lists
  // above it, then the beginning of `list` again.
  bool SearchFrom(UI_Container& list, int start, bool mayClimb) {
    const int size = static_cast<int>(list.ChildSize());
    if (forward_) {
      for (int i = start + 1; i < static_cast<int>(list.ChildSize()); ++i) {
        if (Visit(list, i)) return true;
      }
    } else {
      for (int i = (start < 0 ? size : start) - 1; i >= 0; --i) {
        if (Visit(list, i)) return true;
      }
    }
    if (start < 0) return false;
    if (mayClimb && Climb(list)) return true;
    // Wrap around within the same list.
    if (forward_) {
      for (int i = 0; i <= start && i < static_cast<int>(list.ChildSize()); ++i) {
        if (Visit(list, i)) return true;
      }
    } else {
      for (int i = static_cast<int>(list.ChildSize()) - 1; i >= start && i >= 0; --i) {
        if (Visit(list, i)) return true;
      }
    }
    return false;
  }

 private:
  bool Climb(UI_Container& list) {
    if (!list.AllowFocusToAdvanceFromChildren()) return false;
    UI_Node* node = list.GetAsANode();
    if (node == nullptr || node->UI_GetParentContainer() == nullptr) return false;
    const NodeP keep = detail::Hold(node);
    return SearchFrom(*node->UI_GetParentContainer(), node->UI_GetIndex(), true);
  }

  bool Visit(UI_Container& list, int index) {
    if (index < 0 || index >= static_cast<int>(list.ChildSize())) return false;
    const NodeP child = list.ChildGet(static_cast<std::size_t>(index));
    if (!visited_.insert(child.get()).second) return false;
    if (child->UI_IsEnabled() && child->UI_AreAllParentsVisible()) {
      child->UI_PrepareForKeyboardFocusFromAdvance(previous_);
      if (child->UI_GainKeyboardFocusFromAdvance()) return true;
    }
    return SearchFrom(*child, -1, false);
  }

  bool forward_;
  UI_Node* previous_;
  NodeP keepPrevious_;
  std::unordered_set<const UI_Container*> visited_;
};

}  // namespace

bool UI_AdvanceFocus(bool forward, int startIndex, UI_Container* parent) {
  velkcore::RequireInput(parent != nullptr && startIndex >= -1);
  UI_NodeManager* manager = UI_NodeManager::Get();
  FocusSearch search(forward, manager->GetKeyboardFocusLeafNode());
  search.MarkVisited(parent);
  if (UI_Node* node = parent->GetAsANode()) {
    for (UI_Node* ancestor : node->UI_GetNodeParents()) search.MarkVisited(ancestor);
  }
  if (!search.SearchFrom(*parent, startIndex, true)) return false;
  manager->RemovePendingKeyboardMessages();
  return true;
}

}  // namespace velkui::ui
