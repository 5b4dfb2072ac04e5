#include <velkui/ui/UI_Container.h>

#include <algorithm>

#include <velkcore/Error.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeGeometry.h"

namespace velkui::ui {

void intrusive_ptr_add_ref(const UI_Node* node) {
  intrusive_ptr_add_ref(static_cast<const velkcore::RefCountedObject*>(node));
}

void intrusive_ptr_release(const UI_Node* node) {
  intrusive_ptr_release(static_cast<const velkcore::RefCountedObject*>(node));
}

UI_Container::UI_Container() : selfNode_(nullptr) {}

UI_Container::UI_Container(UI_Node* selfNode) : selfNode_(selfNode) {}

UI_Container::~UI_Container() {
  // A node empties itself in its own destructor; a bare container lets its
  // children go here so that none keeps a dangling parent pointer.
  DeleteChildren();
}

const UI_Container::NodePtr& UI_Container::ChildGet(std::size_t index) const {
  velkcore::RequireInput(index < children_.size());
  return children_[index];
}

UI_Container::const_iterator UI_Container::ChildFind(const UI_Node* node) const {
  if (node == nullptr || node->UI_GetParentContainer() != this) return children_.end();
  const std::int32_t index = node->UI_GetIndex();
  if (index >= 0 && static_cast<std::size_t>(index) < children_.size() &&
      children_[static_cast<std::size_t>(index)].get() == node) {
    return children_.begin() + index;
  }
  return std::find_if(children_.begin(), children_.end(),
                      [node](const NodePtr& child) { return child.get() == node; });
}

void UI_Container::RequireAdoptable(const UI_Node* node) const {
  velkcore::RequireInput(node != nullptr);
  if (selfNode_ != nullptr) {
    velkcore::RequireInput(node != selfNode_ && !selfNode_->UI_IsChildOf(node));
  }
}

void UI_Container::ChildPushBack(const NodePtr& node) {
  RequireAdoptable(node.get());
  const NodePtr keep = node;
  if (UI_Container* old = keep->UI_GetParentContainer()) old->ChildRemove(keep.get());
  InsertAt(children_.size(), keep);
}

void UI_Container::ChildInsert(const_iterator position, const NodePtr& node) {
  velkcore::RequireInput(position >= children_.begin() && position <= children_.end());
  ChildInsert(static_cast<std::int32_t>(position - children_.begin()), node);
}

void UI_Container::ChildInsert(std::int32_t index, const NodePtr& node) {
  RequireAdoptable(node.get());
  velkcore::RequireInput(index >= 0 && static_cast<std::size_t>(index) <= children_.size());
  const NodePtr keep = node;
  std::size_t target = static_cast<std::size_t>(index);
  if (UI_Container* old = keep->UI_GetParentContainer()) {
    // Moving within this list: the child's own slot disappears first.
    if (old == this && keep->UI_GetIndex() < index) --target;
    old->ChildRemove(keep.get());
  }
  InsertAt(target, keep);
}

void UI_Container::InsertAt(std::size_t index, const NodePtr& node) {
  node->UI_SetParent(this);
  // A handler of the parent change may have moved the node elsewhere already.
  if (node->UI_GetParentContainer() != this || ChildFind(node.get()) != children_.end()) return;
  index = std::min(index, children_.size());
  node->UI_SetIndex(static_cast<std::int32_t>(index));
  children_.insert(children_.begin() + static_cast<std::ptrdiff_t>(index), node);
  InvalidateChildBoxes();
  Renumber(index + 1, children_.size());
  ChildAdded(node.get());
}

UI_Container::NodePtr UI_Container::ChildRemove(const_iterator position) {
  velkcore::RequireInput(position >= children_.begin() && position < children_.end());
  NodePtr child = *position;
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->NodeLeavingTree(*child);
  // Handlers run above may have removed or moved the child themselves.
  const auto found = ChildFind(child.get());
  if (found == children_.end()) return child;
  const auto index = static_cast<std::size_t>(found - children_.begin());
  children_.erase(found);
  InvalidateChildBoxes();
  Renumber(index, children_.size());
  child->UI_SetParent(nullptr);
  child->UI_SetIndex(-1);
  ChildRemoved(child.get());
  return child;
}

UI_Container::NodePtr UI_Container::ChildRemove(const UI_Node* node) {
  const auto found = ChildFind(node);
  velkcore::RequireInput(found != children_.end());
  return ChildRemove(found);
}

bool UI_Container::ChildRequestRemove(UI_Node* node) {
  const auto found = ChildFind(node);
  if (found == children_.end()) return false;
  ChildRemove(found);
  return true;
}

void UI_Container::ChildMove(std::int32_t from, std::int32_t to) {
  const auto size = static_cast<std::int32_t>(children_.size());
  velkcore::RequireInput(from >= 0 && from < size && to >= 0 && to < size);
  if (from == to) return;
  const auto begin = children_.begin();
  if (from < to) {
    std::rotate(begin + from, begin + from + 1, begin + to + 1);
  } else {
    std::rotate(begin + to, begin + from, begin + from + 1);
  }
  Renumber(static_cast<std::size_t>(std::min(from, to)),
           static_cast<std::size_t>(std::max(from, to)) + 1);
  InvalidateChildBoxes();
  ChildOrderChanged();
}

void UI_Container::ChildSwapOrder(std::int32_t i, std::int32_t j) {
  const auto size = static_cast<std::int32_t>(children_.size());
  velkcore::RequireInput(i >= 0 && i < size && j >= 0 && j < size);
  if (i == j) return;
  std::swap(children_[static_cast<std::size_t>(i)], children_[static_cast<std::size_t>(j)]);
  children_[static_cast<std::size_t>(i)]->UI_SetIndex(i);
  children_[static_cast<std::size_t>(j)]->UI_SetIndex(j);
  InvalidateChildBoxes();
  ChildOrderChanged();
}

void UI_Container::DeleteChildren() {
  const ChildVector snapshot = children_;
  for (auto it = snapshot.rbegin(); it != snapshot.rend(); ++it) {
    const auto found = ChildFind(it->get());
    if (found != children_.end()) ChildRemove(found);
  }
}

void UI_Container::Renumber(std::size_t from, std::size_t to) {
  for (std::size_t i = from; i < to && i < children_.size(); ++i) {
    children_[i]->UI_SetIndex(static_cast<std::int32_t>(i));
  }
}

void UI_Container::InvalidateChildBox(std::int32_t index) const {
  if (index < 0 || static_cast<std::size_t>(index) >= boxes_.size()) {
    allBoxesStale_ = true;
    return;
  }
  boxes_[static_cast<std::size_t>(index)].stale = true;
  someBoxesStale_ = true;
}

void UI_Container::InvalidateChildBoxes() const {
  allBoxesStale_ = true;
}

UI_Container::ChildBox UI_Container::MeasureChild(const UI_Node& child) {
  ChildBox box;
  box.stale = false;
  box.ownsPlatformWindow = child.UI_ReceivesEventsFromOS();
  if (!child.UI_IsShown()) return box;
  const velkcore::ScaleMatrixT<float> m = child.UI_GetSelfToParentMatrix();
  if (detail::IsDegenerate(m)) return box;
  const velkcore::RectT<float> r = detail::TransformRect(m, child.UI_GetLocalRectF(false));
  box.left = r.left;
  box.top = r.top;
  box.right = r.left + r.width;
  box.bottom = r.top + r.height;
  box.toParent = m;
  box.visible = true;
  return box;
}

const std::vector<UI_Container::ChildBox>& UI_Container::GetChildBoxes() const {
  if (allBoxesStale_ || boxes_.size() != children_.size()) {
    boxes_.resize(children_.size());
    for (std::size_t i = 0; i < children_.size(); ++i) boxes_[i] = MeasureChild(*children_[i]);
  } else if (someBoxesStale_) {
    for (std::size_t i = 0; i < boxes_.size(); ++i) {
      if (boxes_[i].stale) boxes_[i] = MeasureChild(*children_[i]);
    }
  }
  allBoxesStale_ = false;
  someBoxesStale_ = false;
  return boxes_;
}

std::pair<bool, UI_Container::const_iterator> UI_Container::GetChildHit(
    bool recursive, bool skipOSChildren, velkcore::PointT<float>* point) const {
  velkcore::RequireInput(point != nullptr);
  // Float rounding must not lose a point on an edge: the exact test follows.
  constexpr float kSlack = 0.01f;
  std::pair<bool, const_iterator> result{false, children_.end()};
  const UI_Container* level = this;
  for (;;) {
    const std::vector<ChildBox>& boxes = level->GetChildBoxes();
    const velkcore::PointT<float> p = *point;
    bool hit = false;
    for (std::size_t i = boxes.size(); i-- > 0;) {
      const ChildBox& box = boxes[i];
      if (!box.visible || (skipOSChildren && box.ownsPlatformWindow)) continue;
      if (p.x < box.left - kSlack || p.x >= box.right + kSlack || p.y < box.top - kSlack ||
          p.y >= box.bottom + kSlack) {
        continue;
      }
      const UI_Node& child = *level->children_[i];
      const velkcore::PointT<float> local{(p.x - box.toParent.tx) / box.toParent.sx,
                                          (p.y - box.toParent.ty) / box.toParent.sy};
      if (!child.UI_HitTest(local)) continue;
      *point = local;
      result = {true, level->children_.begin() + static_cast<std::ptrdiff_t>(i)};
      level = &child;
      hit = true;
      break;
    }
    if (!hit || !recursive) return result;
  }
}

void UI_Container::ChildAdded(UI_Node*) {}

void UI_Container::ChildRemoved(UI_Node*) {}

void UI_Container::ChildOrderChanged() {}

void UI_Container::ChildGeometryChanged(const UI_Node&) {}

bool UI_Container::AllowFocusToAdvanceFromChildren() const {
  return false;
}

bool UI_Container::IsANode() const {
  return selfNode_ != nullptr;
}

}  // namespace velkui::ui
