#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

void intrusive_ptr_add_ref(const UI_Node* node);
void intrusive_ptr_release(const UI_Node* node);

// The ordered child list of a node (z-order: index 0 is drawn first and lies at
// the bottom; the last child is on top and is hit first). A container holds one
// reference to each child.
class UI_Container {
 public:
  using NodePtr = boost::intrusive_ptr<UI_Node>;
  using ChildVector = std::vector<NodePtr>;
  using const_iterator = ChildVector::const_iterator;
  using const_reverse_iterator = ChildVector::const_reverse_iterator;

  UI_Container();
  UI_Container(const UI_Container&) = delete;
  UI_Container& operator=(const UI_Container&) = delete;
  virtual ~UI_Container();

  std::size_t ChildSize() const { return children_.size(); }
  // Raises the input-contract violation for an index out of range.
  const NodePtr& ChildGet(std::size_t index) const;
  const_iterator ChildBegin() const { return children_.begin(); }
  const_iterator ChildEnd() const { return children_.end(); }
  // Top-most child first.
  const_reverse_iterator ChildRBegin() const { return children_.rbegin(); }
  const_reverse_iterator ChildREnd() const { return children_.rend(); }
  const_iterator ChildFind(const UI_Node* node) const;

  // Appends `node` on top. A node that sits in another container (or in this
  // one) is detached from it first. Adding null, the container's own node or
  // one of its ancestors is an input-contract violation.
  virtual void ChildPushBack(const NodePtr& node);
  // Inserts `node` before `position`; the same rules as ChildPushBack.
  void ChildInsert(const_iterator position, const NodePtr& node);
  void ChildInsert(std::int32_t index, const NodePtr& node);

  // Removes the child and returns it: the caller's reference may be the last one.
  NodePtr ChildRemove(const_iterator position);
  // Raises the input-contract violation when `node` is not a child.
  NodePtr ChildRemove(const UI_Node* node);
  // False when `node` is not a child; subclasses may refuse.
  virtual bool ChildRequestRemove(UI_Node* node);
  void ChildMove(std::int32_t from, std::int32_t to);
  void ChildSwapOrder(std::int32_t i, std::int32_t j);
  void DeleteChildren();

  // The node that this container is, or null for a bare container.
  UI_Node* GetAsANode() { return selfNode_; }
  const UI_Node* GetAsANode() const { return selfNode_; }

  // The top-most shown child under `*point` (given in this container's
  // coordinates); with `recursive`, the deepest node under it. On success
  // `*point` is rewritten into the coordinates of the node found, which is
  // `*position` (an iterator into the child list of that node's parent).
  // Only points inside a child's own rectangle are offered to its UI_HitTest.
  std::pair<bool, const_iterator> GetChildHit(bool recursive, bool skipOSChildren,
                                              velkcore::PointT<float>* point) const;

  // Children's boxes are cached for hit testing and clip tests. A child whose
  // answers to UI_IsShown, UI_GetSelfToParentMatrix, UI_GetLocalRectF or
  // UI_ReceivesEventsFromOS change calls UI_Node::UI_GeometryChanged (the
  // sub-view setters do); these mark the cached box stale.
  void InvalidateChildBox(std::int32_t index) const;
  void InvalidateChildBoxes() const;

  virtual void ChildAdded(UI_Node* node);
  virtual void ChildRemoved(UI_Node* node);
  virtual void ChildOrderChanged();
  // A child's place, size or visibility changed (or something else its parent reads to lay
  // it out, such as a sub-view's layout binding): called by the child's
  // UI_Node::UI_GeometryChanged, after its cached box was marked stale. It runs in the middle of
  // the child's change (the child's own size and node-change handlers come after it), and on
  // every frame change of every child, so an override should be quick. Does nothing by default.
  virtual void ChildGeometryChanged(const UI_Node& child);
  // Whether focus advancing with Tab may leave this container's children for
  // the siblings of this container.
  virtual bool AllowFocusToAdvanceFromChildren() const;
  virtual bool IsANode() const;

 protected:
  // Used by UI_Node so that GetAsANode needs no virtual call.
  explicit UI_Container(UI_Node* selfNode);

  // Where a child lies in this container's coordinates (its frame through its
  // self-to-parent matrix, which is kept too), and whether it can be hit or
  // drawn at all.
  struct ChildBox {
    float left = 0;
    float top = 0;
    float right = 0;
    float bottom = 0;
    velkcore::ScaleMatrixT<float> toParent;
    bool visible = false;  // shown with a non-degenerate scale
    bool ownsPlatformWindow = false;
    bool stale = true;
  };
  const std::vector<ChildBox>& GetChildBoxes() const;

 private:
  void InsertAt(std::size_t index, const NodePtr& node);
  void RequireAdoptable(const UI_Node* node) const;
  void Renumber(std::size_t from, std::size_t to);

  static ChildBox MeasureChild(const UI_Node& child);

  ChildVector children_;
  UI_Node* const selfNode_;
  mutable std::vector<ChildBox> boxes_;
  mutable bool allBoxesStale_ = true;
  mutable bool someBoxesStale_ = true;
};

}  // namespace velkui::ui
