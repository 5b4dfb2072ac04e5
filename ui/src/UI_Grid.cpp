#include <velkui/ui/UI_Grid.h>

#include <cmath>

#include <velkcore/Error.h>

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

bool Contains(const RectT<float>& r, const PointT<float>& p) {
  return p.x >= r.left && p.x < r.left + r.width && p.y >= r.top && p.y < r.top + r.height;
}

void RequireLength(float length) {
  velkcore::RequireInput(std::isfinite(length) && length >= 0);
}

}  // namespace

UI_Grid::UI_Grid(std::int32_t columns, std::int32_t rows) {
  SetGridSize(columns, rows);
}

UI_Grid::~UI_Grid() = default;

void UI_Grid::SetGridSize(std::int32_t columns, std::int32_t rows) {
  velkcore::RequireInput(columns >= 0 && rows >= 0 && columns <= kMaxColumnsOrRows &&
                         rows <= kMaxColumnsOrRows &&
                         static_cast<std::int64_t>(columns) * rows <= kMaxCells);
  std::vector<CellP> cells;
  cells.reserve(static_cast<std::size_t>(columns) * static_cast<std::size_t>(rows));
  for (std::int32_t row = 0; row < rows; ++row) {
    for (std::int32_t column = 0; column < columns; ++column) {
      const bool kept = column < columns_ && row < rows_;
      cells.push_back(kept ? cells_[static_cast<std::size_t>(row * columns_ + column)]
                           : CellP(new UI_Cell()));
    }
  }
  cells_.swap(cells);
  widths_.resize(static_cast<std::size_t>(columns), kDefaultColumnWidth);
  heights_.resize(static_cast<std::size_t>(rows), kDefaultRowHeight);
  columns_ = columns;
  rows_ = rows;
  LayoutCells();
}

void UI_Grid::SetColumnWidth(std::int32_t column, float width) {
  velkcore::RequireInput(column >= 0 && column < columns_);
  RequireLength(width);
  widths_[static_cast<std::size_t>(column)] = width;
  LayoutCells();
}

float UI_Grid::GetColumnWidth(std::int32_t column) const {
  velkcore::RequireInput(column >= 0 && column < columns_);
  return widths_[static_cast<std::size_t>(column)];
}

void UI_Grid::SetRowHeight(std::int32_t row, float height) {
  velkcore::RequireInput(row >= 0 && row < rows_);
  RequireLength(height);
  heights_[static_cast<std::size_t>(row)] = height;
  LayoutCells();
}

float UI_Grid::GetRowHeight(std::int32_t row) const {
  velkcore::RequireInput(row >= 0 && row < rows_);
  return heights_[static_cast<std::size_t>(row)];
}

PointT<float> UI_Grid::GetTotalSize() const {
  PointT<float> total{0, 0};
  for (float w : widths_) total.x += w;
  for (float h : heights_) total.y += h;
  return total;
}

void UI_Grid::SetOrigin(const PointT<float>& origin) {
  velkcore::RequireInput(std::isfinite(origin.x) && std::isfinite(origin.y));
  origin_ = origin;
  LayoutCells();
}

UI_Cell* UI_Grid::GetCell(std::int32_t column, std::int32_t row) const {
  velkcore::RequireInput(column >= 0 && column < columns_ && row >= 0 && row < rows_);
  return cells_[static_cast<std::size_t>(row * columns_ + column)].get();
}

UI_Cell* UI_Grid::GetCellForPoint(const PointT<float>& point, std::int32_t& column,
                                  std::int32_t& row) const {
  for (std::int32_t r = 0; r < rows_; ++r) {
    for (std::int32_t c = 0; c < columns_; ++c) {
      UI_Cell* cell = GetCell(c, r);
      if (Contains(cell->GetLocalRectF(), point)) {
        column = c;
        row = r;
        return cell;
      }
    }
  }
  column = -1;
  row = -1;
  return nullptr;
}

bool UI_Grid::SelectCell(const PointT<float>& point, bool select) {
  std::int32_t column = -1;
  std::int32_t row = -1;
  UI_Cell* hit = GetCellForPoint(point, column, row);
  if (hit == nullptr) return false;
  if (select) {
    for (const CellP& cell : cells_) cell->SetSelected(false);
  }
  hit->SetSelected(select);
  return true;
}

UI_Cell* UI_Grid::GetSelectedCell(std::int32_t* column, std::int32_t* row) const {
  for (std::int32_t r = 0; r < rows_; ++r) {
    for (std::int32_t c = 0; c < columns_; ++c) {
      UI_Cell* cell = GetCell(c, r);
      if (!cell->IsSelected()) continue;
      if (column != nullptr) *column = c;
      if (row != nullptr) *row = r;
      return cell;
    }
  }
  if (column != nullptr) *column = -1;
  if (row != nullptr) *row = -1;
  return nullptr;
}

void UI_Grid::LayoutCells() {
  float y = origin_.y;
  for (std::int32_t r = 0; r < rows_; ++r) {
    const float height = heights_[static_cast<std::size_t>(r)];
    float x = origin_.x;
    for (std::int32_t c = 0; c < columns_; ++c) {
      const float width = widths_[static_cast<std::size_t>(c)];
      GetCell(c, r)->SetLocalRectF({x, y, width, height});
      x += width;
    }
    y += height;
  }
}

}  // namespace velkui::ui
