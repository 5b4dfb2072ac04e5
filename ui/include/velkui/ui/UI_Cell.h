#pragma once

#include <cstddef>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/ui/UI_Node.h>

namespace velkui::ui {

// One cell of a UI_Grid: a rectangle in the grid view's coordinates, visible and selected
// flags, and the nodes placed in it, each at an offset from the cell's top-left corner. The
// nodes are children of the grid view; the cell only says where they go.
class UI_Cell : public velkcore::RefCountedObject {
 public:
  UI_Cell();
  ~UI_Cell() override;

  const velkcore::RectT<float>& GetLocalRectF() const { return rect_; }
  // Raises the contract violation for a rectangle that is not finite.
  void SetLocalRectF(const velkcore::RectT<float>& rect);
  bool IsVisible() const { return visible_; }
  void SetVisible(bool visible) { visible_ = visible; }
  bool IsSelected() const { return selected_; }
  void SetSelected(bool selected) { selected_ = selected; }

  std::size_t GetNodeCount() const { return entries_.size(); }
  // An index out of range raises the contract violation.
  const NodeP& GetNode(std::size_t index) const;
  velkcore::PointT<float> GetNodeOffset(std::size_t index) const;
  // Adds `node` at `offset` from the cell's corner; a node already in the cell only gets the new
  // offset. Null raises the contract violation.
  void AddNode(NodeP node, const velkcore::PointT<float>& offset);
  // False when the node is not in the cell.
  bool RemoveNode(const UI_Node* node);
  bool HasNode(const UI_Node* node) const;
  bool IsEmpty() const { return entries_.empty(); }

  // Replaces the cell's nodes by the children of `view` whose frame's top-left corner lies in
  // the cell's rectangle (left and top edges included, right and bottom excluded), each at its
  // offset from the cell's corner. Cells of one grid do not overlap, so a node lands in one
  // cell at most.
  void FetchNodes(const UI_Node& view);
  // Grows every node smaller than its recommended size (in either dimension) to that size,
  // each dimension to at least the recommended one, and returns the room the nodes need: the
  // largest offset + size over the cell's nodes in each dimension ((0, 0) for an empty cell).
  velkcore::PointT<float> RecalcCellSize(pictel::Pictel* context);
  // Moves every node to the cell's corner plus its offset, keeping its size.
  void UpdateNodesPosition();

 private:
  struct Entry {
    NodeP node;
    velkcore::PointT<float> offset;
  };

  velkcore::RectT<float> rect_{};
  bool visible_ = true;
  bool selected_ = false;
  std::vector<Entry> entries_;
};

using CellP = boost::intrusive_ptr<UI_Cell>;

}  // namespace velkui::ui
