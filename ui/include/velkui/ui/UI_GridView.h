#pragma once

#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/ui/UI_Grid.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::layout {
class UI_LayoutFormatter;
}

namespace velkui::ui {

// A sub-view whose children are placed in the cells of a grid. The grid starts with one cell
// as large as the view; its cells follow the view's margins. A formatter (see
// velkui::layout::UI_LayoutFormatter) computes the column widths and row heights and moves
// the nodes; without one, RecalcLayout moves nothing.
class UI_GridView : public UI_SubView {
 public:
  using FormatterP = boost::intrusive_ptr<layout::UI_LayoutFormatter>;

  explicit UI_GridView(const velkcore::PointT<float>& size);
  ~UI_GridView() override;

  UI_Grid& GetGrid() { return grid_; }
  const UI_Grid& GetGrid() const { return grid_; }
  // Where the grid lies in the view: at the margins, as large as its widths and heights.
  velkcore::RectT<float> GetGridRectF() const;

  // Negative margins raise the contract violation.
  void SetMargins(std::int32_t horizontal, std::int32_t vertical);
  // (horizontal, vertical).
  velkcore::PointT<std::int32_t> GetMargins() const { return margins_; }

  // Every cell takes the view's children that lie in it, then the layout is recomputed.
  void UpdateGrid(const pictel::SupplierInterface* supplier);
  // Hands the work to the formatter; nothing moves without one.
  void RecalcLayout(const pictel::SupplierInterface* supplier);
  void SetLayoutFormatter(FormatterP formatter);
  FormatterP GetLayoutFormatter() const;
  // True once UpdateGrid has run.
  bool IsInitialized() const { return initialized_; }

  // Makes `node` a child of the view. In add-node-to-selected-cell mode, when a cell is
  // selected, the node also goes into that cell at its corner. Null raises the contract
  // violation.
  void AddNodeToSelectedCell(const NodeP& node);
  void SetAddNodeToSelectedCellMode(bool on) { addToSelectedCell_ = on; }
  bool GetAddNodeToSelectedCellMode() const { return addToSelectedCell_; }
  // Moves `node` from one cell of this grid to another, keeping its offset, and places it.
  // Cells of another grid, or a node that is not in `from`, raise the contract violation.
  void MoveNode(UI_Cell* from, UI_Cell* to, const NodeP& node);

  void SetEditMode(bool on);
  bool IsEditMode() const { return editMode_; }
  // The column (row) whose right (bottom) boundary lies within kGuideTolerance of `point`
  // (view coordinates, inside the grid's extent across), or -1: the guide to drag in edit mode.
  std::int32_t GetColumnGuideForPosition(const velkcore::PointT<float>& point) const;
  std::int32_t GetRowGuideForPosition(const velkcore::PointT<float>& point) const;
  static constexpr float kGuideTolerance = 3;

  // Column widths (row heights) as numbers separated by ",", such as "120,80.5,60".
  velkcore::UTF16String GetColumnWidthsAsString() const;
  velkcore::UTF16String GetRowHeightsAsString() const;
  // Reads one number per piece into the widths in order: numbers beyond the column count are
  // ignored, missing or empty pieces leave their widths unchanged. A piece that is not a
  // finite, non-negative number raises the contract violation and changes nothing.
  void SetColumnWidthsFromString(const velkcore::UTF16String& text);
  void SetRowHeightsFromString(const velkcore::UTF16String& text);

  // Paints the borders of the grid's cells (laid out from the corner of `rect`) and tints the
  // selected one.
  static void Draw(const velkcore::RectT<float>& rect, const UI_Grid& grid,
                   pictel::Pictel* context);
  // Whether grid views draw their cell borders (process-wide; off by default).
  static void SetDrawCellBordersState(bool draw);
  static bool CanDrawCellBorders();

  // Cell borders when they are switched on or in edit mode; in edit mode also the guides,
  // across the whole view. Then the children.
  void UI_Draw(pictel::Pictel* context) const override;
  // A removed child leaves its cell.
  void ChildRemoved(UI_Node* node) override;

 private:
  bool OwnsCell(const UI_Cell* cell) const;

  UI_Grid grid_;
  velkcore::PointT<std::int32_t> margins_{0, 0};
  bool editMode_ = false;
  bool addToSelectedCell_ = false;
  bool initialized_ = false;
  FormatterP formatter_;

  static bool sDrawCellBorders;
};

using GridViewP = boost::intrusive_ptr<UI_GridView>;

}  // namespace velkui::ui
