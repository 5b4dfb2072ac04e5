#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>

namespace velkui::pictel {
class SupplierInterface;
}

namespace velkui::ui {
class UI_GridView;
}

namespace velkui::layout {

// Computes the column widths and row heights of a grid view from the nodes in its cells and
// places the cells. Every formatter does nothing while its in-progress flag is set, so that
// the view's reaction to being resized by the formatter does not start it again.
//
// The base RecalcLayout only grows the view: when the cells holding nodes (together with the
// view's area inside its margins) reach beyond that area, the view is resized to hold them plus
// its margins on both sides.
class UI_LayoutFormatter : public velkcore::RefCountedObject {
 public:
  UI_LayoutFormatter();
  ~UI_LayoutFormatter() override;

  // A null supplier raises the contract violation.
  virtual void RecalcLayout(const pictel::SupplierInterface* supplier, ui::UI_GridView& view);

  bool IsFormatterInProgress() const { return inProgress_; }
  void SetFormatterProgressState(bool inProgress) { inProgress_ = inProgress; }

 protected:
  // Asks every cell the room its nodes need (with a temporary drawing context over a 1 × 1
  // offscreen surface, growing undersized nodes); makes each column the widest need of its
  // cells + 4 and raises each row lower than the tallest need of its cells to that need + 4.
  void CalculateCellSizes(const pictel::SupplierInterface* supplier, ui::UI_GridView& view);
  // Sets the view's size (its origin unchanged) to `rect`'s size plus twice the margins, with
  // the view's layout-children switch off meanwhile.
  void ResizeGridView(const pictel::SupplierInterface* supplier, const velkcore::RectT<float>& rect,
                      ui::UI_GridView& view);
  // The view's area inside its margins, in its own coordinates.
  static velkcore::RectT<float> InsetBounds(const ui::UI_GridView& view);

  // Room added to the largest need of a column or a row.
  static constexpr float kCellPadding = 4;

 private:
  bool inProgress_ = false;
};

// Lays the cells out on the grid: rows from the top of the inset area, columns from its left,
// each cell column width × row height; after the base step has grown the view, a cell is
// visible exactly when it overlaps the inset area.
class UI_SimpleLayoutFormatter : public UI_LayoutFormatter {
 public:
  void RecalcLayout(const pictel::SupplierInterface* supplier, ui::UI_GridView& view) override;
};

// Flows the cells that hold nodes like words of a text: in reading order (row by row, left to
// right), each cell column width × row height, from the inset area's left edge; a cell that
// would cross the inset area's right edge starts a new line below the tallest cell of the
// current line (a cell wider than the area gets a line of its own). Empty cells are hidden and
// get an empty rectangle at the inset corner.
class UI_FlowLayoutFormatter : public UI_LayoutFormatter {
 public:
  void RecalcLayout(const pictel::SupplierInterface* supplier, ui::UI_GridView& view) override;
};

using LayoutFormatterP = boost::intrusive_ptr<UI_LayoutFormatter>;

}  // namespace velkui::layout
