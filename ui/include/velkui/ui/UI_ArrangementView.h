#pragma once

#include <memory>
#include <unordered_map>
#include <vector>

#include <velkui/arrange/DefaultGroup.h>
#include <velkui/arrange/DynamicGroup.h>
#include <velkui/arrange/ISeparator.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

// A sub-view whose children are sized and placed by the arrangement engine: the view is a
// group of the engine (its kind, spacing, alignments and margins are the group's), each child
// node is a leaf, and a child that is itself an arrangement view is a nested group.
//
// Leaves: a child's natural size is its size when it was added (or last changed by anyone but
// this view), 0 × 0 while it is hidden; it may grow horizontally with layout binding
// kBindRightToRight and vertically with kBindBottomToBottom (nodes that are not sub-views never
// grow). The bindings mean nothing else here: the view never applies them as edge constraints.
//
// Only the root arrangement view (one that is not nested in another) arranges, and only while
// it has a parent node and is shown: whenever its size changes, when it is shown or attached,
// and whenever its tree of groups is invalidated (children added, removed or reordered,
// parameters changed). The engine works in global coordinates (the root view's origin in the
// window's client area, in the view's own units); every node is placed in its own parent's
// coordinates. A nested view's origin and size are set from what the engine reports.
//
// A child that changes size, visibility or binding on its own (anything but this view setting
// its frame) is noticed as it happens, through ChildGeometryChanged, and the tree of groups is
// arranged again at once. A change made while the tree is being arranged (a child that
// resizes itself when it is placed) only marks it: the arrangement under way runs another pass
// with what the child has become, and never re-enters itself. Changes an override keeps from
// UI_GeometryChanged are noticed when the child is next placed, or by UpdateChildSizes.
class UI_ArrangementView : public UI_SubView, public arrange::DefaultGroup<arrange::DynamicGroup> {
 public:
  explicit UI_ArrangementView(
      arrange::GroupArrangementType type = arrange::GroupArrangementType::Row);
  ~UI_ArrangementView() override;

  using DynamicGroup::SetArrangementType;
  // Changes the kind and keeps the view where it is in the tree of groups.
  void SetArrangementType(arrange::GroupArrangementType type);

  // Separators between the children (off by default). While off, no separator node exists.
  void EnableSeparators(bool enable);
  bool HasSeparators() const { return separatorsEnabled_; }

  // Re-reads every child's size, visibility and binding and re-arranges when one changed.
  void UpdateChildSizes();

  bool IsRootArrangement() const { return Parent() == nullptr; }

  // ---- Group callbacks of the engine ----
  // A nested view moves its origin to `origin` (global). The root view ignores it.
  void Position(const arrange::PointF& origin) override;
  // A nested view takes `size` when both values are >= 0. The root view ignores it.
  void SetDimensions(const arrange::PointF& size) override;
  // Null while separators are off; otherwise a new separator node (NewSeparatorNode) added as a
  // child of the view.
  arrange::ISeparator* BuildSeparator() override;
  // Removes the separator nodes.
  void ClearSeparators() override;

  // ---- Node hooks ----
  void ChildAdded(UI_Node* node) override;
  void ChildRemoved(UI_Node* node) override;
  void ChildOrderChanged() override;
  // Records what a child became and arranges again when it changed.
  void ChildGeometryChanged(const UI_Node& child) override;
  void UI_NodeChanged(NodeChange change) override;

  // The number of separator nodes the view holds.
  std::size_t GetSeparatorNodeCount() const { return separators_.size(); }

 protected:
  // Arranges when this view is the root arrangement; never applies edge bindings.
  void UI_LayoutChildren(const velkcore::PointT<float>& oldSize,
                         const velkcore::PointT<float>& newSize) override;
  // Makes the node drawn between two children: by default a divider control
  // (controls::UI_Divider). It must implement arrange::ISeparator, whose SetSeparatorFrame
  // receives the frame in this view's coordinates (a zero size when the gap is not in use).
  // Returning null leaves that gap without a separator.
  virtual NodeP NewSeparatorNode();

 private:
  class NodeBridge;
  class SeparatorBridge;
  friend class NodeBridge;
  friend class SeparatorBridge;

  void RebuildArrangeables();
  // Arranges from this view's bounds when it is the root, attached and shown.
  void ArrangeAsRootView();
  bool CanArrangeAsRoot() const;
  UI_ArrangementView* RootView();
  // A point of the engine's coordinates in the coordinates of `target` (this view, or a node of
  // the tree of nodes whose root arrangement view is this view's).
  velkcore::PointT<float> EngineToLocal(const UI_Node& target, const velkcore::PointT<float>& p);
  bool IsSeparatorNode(const UI_Node* node) const;
  NodeBridge* FindBridge(const UI_Node& node) const;

  bool separatorsEnabled_ = false;
  bool changingSeparators_ = false;
  std::vector<std::unique_ptr<NodeBridge>> bridges_;
  // The leaf of each child node, for the notices of ChildGeometryChanged: by the child's index
  // when the list was last rebuilt (separators come and go without a rebuild and may shift
  // later children), and by node.
  std::vector<NodeBridge*> bridgeAtIndex_;
  std::unordered_map<const UI_Node*, NodeBridge*> bridgeOfNode_;
  std::vector<UI_ArrangementView*> nested_;
  std::vector<std::unique_ptr<SeparatorBridge>> separators_;
  // What the last look at this view's place in the tree found, so that only real changes
  // arrange again.
  const UI_Node* lastParentNode_ = nullptr;
  bool lastShown_ = false;
};

using ArrangementViewP = boost::intrusive_ptr<UI_ArrangementView>;

}  // namespace velkui::ui
