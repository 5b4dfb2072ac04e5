#pragma once

#include <cstdint>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkui/ui/UI_Cell.h>

namespace velkui::ui {

// A table of cells: a column count and a row count, one width per column and one height per
// row. The grid sits at an origin (its owner's margins) and keeps every cell's rectangle on its
// geometry: whenever the size, a width, a height or the origin changes, the cells are laid out
// again row by row. A formatter may place them otherwise afterwards.
//
// Points given to the hit tests are in the same coordinates as the cells' rectangles.
class UI_Grid {
 public:
  static constexpr float kDefaultColumnWidth = 50;
  static constexpr float kDefaultRowHeight = 20;
  // Counts above these (or a total above kMaxCells) raise the contract violation.
  static constexpr std::int32_t kMaxColumnsOrRows = 10000;
  static constexpr std::int32_t kMaxCells = 1000000;

  // New columns are kDefaultColumnWidth wide, new rows kDefaultRowHeight high.
  UI_Grid(std::int32_t columns, std::int32_t rows);
  UI_Grid(const UI_Grid&) = delete;
  UI_Grid& operator=(const UI_Grid&) = delete;
  ~UI_Grid();

  // Keeps the cells, widths and heights whose column and row remain; adds fresh ones.
  void SetGridSize(std::int32_t columns, std::int32_t rows);
  velkcore::PointT<std::int32_t> GetGridSize() const { return {columns_, rows_}; }
  std::int32_t GetNumberOfColumns() const { return columns_; }
  std::int32_t GetNumberOfRows() const { return rows_; }

  // Indices out of range and negative or non-finite sizes raise the contract violation.
  void SetColumnWidth(std::int32_t column, float width);
  float GetColumnWidth(std::int32_t column) const;
  void SetRowHeight(std::int32_t row, float height);
  float GetRowHeight(std::int32_t row) const;
  // The sum of the widths and of the heights.
  velkcore::PointT<float> GetTotalSize() const;

  void SetOrigin(const velkcore::PointT<float>& origin);
  const velkcore::PointT<float>& GetOrigin() const { return origin_; }

  UI_Cell* GetCell(std::int32_t column, std::int32_t row) const;
  // The cell whose rectangle holds `point` (left and top edges included), with its column and
  // row; null, and -1 for both, when there is none.
  UI_Cell* GetCellForPoint(const velkcore::PointT<float>& point, std::int32_t& column,
                           std::int32_t& row) const;
  // Selects the cell under `point` (deselecting every other one) or, with `select` false,
  // deselects it. False when no cell lies under the point.
  bool SelectCell(const velkcore::PointT<float>& point, bool select);
  // The selected cell or null; `column` and `row` (when given) receive its place, or -1.
  UI_Cell* GetSelectedCell(std::int32_t* column = nullptr, std::int32_t* row = nullptr) const;
  // Every cell, row by row.
  const std::vector<CellP>& GetCells() const { return cells_; }

  // Puts every cell's rectangle back on the grid's geometry.
  void LayoutCells();

 private:
  std::int32_t columns_ = 0;
  std::int32_t rows_ = 0;
  std::vector<float> widths_;
  std::vector<float> heights_;
  std::vector<CellP> cells_;
  velkcore::PointT<float> origin_{0, 0};
};

}  // namespace velkui::ui
