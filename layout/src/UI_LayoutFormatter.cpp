#include <velkui/layout/UI_LayoutFormatter.h>

#include <algorithm>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/UI_GridView.h>

namespace velkui::layout {

using velkcore::PointT;
using velkcore::RectT;

namespace {

// Sets the in-progress flag for the lifetime of the scope.
class ProgressScope {
 public:
  explicit ProgressScope(UI_LayoutFormatter& formatter) : formatter_(formatter) {
    formatter_.SetFormatterProgressState(true);
  }
  ~ProgressScope() { formatter_.SetFormatterProgressState(false); }
  ProgressScope(const ProgressScope&) = delete;
  ProgressScope& operator=(const ProgressScope&) = delete;

 private:
  UI_LayoutFormatter& formatter_;
};

// Restores a sub-view's layout-children switch at the end of the scope.
class LayoutChildrenOff {
 public:
  explicit LayoutChildrenOff(ui::UI_SubView& view)
      : view_(view), was_(view.UI_GetLayoutsChildren()) {
    view_.UI_SetLayoutsChildren(false);
  }
  ~LayoutChildrenOff() { view_.UI_SetLayoutsChildren(was_); }
  LayoutChildrenOff(const LayoutChildrenOff&) = delete;
  LayoutChildrenOff& operator=(const LayoutChildrenOff&) = delete;

 private:
  ui::UI_SubView& view_;
  bool was_;
};

bool Overlaps(const RectT<float>& a, const RectT<float>& b) {
  const float left = std::max(a.left, b.left);
  const float top = std::max(a.top, b.top);
  const float right = std::min(a.left + a.width, b.left + b.width);
  const float bottom = std::min(a.top + a.height, b.top + b.height);
  return right - left > 0 && bottom - top > 0;
}

RectT<float> Union(const RectT<float>& a, const RectT<float>& b) {
  const float left = std::min(a.left, b.left);
  const float top = std::min(a.top, b.top);
  const float right = std::max(a.left + a.width, b.left + b.width);
  const float bottom = std::max(a.top + a.height, b.top + b.height);
  return {left, top, right - left, bottom - top};
}

}  // namespace

UI_LayoutFormatter::UI_LayoutFormatter() = default;
UI_LayoutFormatter::~UI_LayoutFormatter() = default;

RectT<float> UI_LayoutFormatter::InsetBounds(const ui::UI_GridView& view) {
  const RectT<float> bounds = view.UI_GetLocalRectF(false);
  const auto margins = view.GetMargins();
  const auto h = static_cast<float>(margins.x);
  const auto v = static_cast<float>(margins.y);
  return {bounds.left + h, bounds.top + v, bounds.width - 2 * h, bounds.height - 2 * v};
}

void UI_LayoutFormatter::RecalcLayout(const pictel::SupplierInterface* supplier,
                                      ui::UI_GridView& view) {
  velkcore::RequireInput(supplier != nullptr);
  if (inProgress_) return;
  // Measured inside the margins, so that adding them back on both sides fits the cells
  // exactly.
  const RectT<float> inset = InsetBounds(view);
  RectT<float> needed = inset;
  for (const ui::CellP& cell : view.GetGrid().GetCells()) {
    if (!cell->IsEmpty()) needed = Union(needed, cell->GetLocalRectF());
  }
  if (needed.width <= inset.width && needed.height <= inset.height) return;
  const ProgressScope progress(*this);
  ResizeGridView(supplier, needed, view);
}

void UI_LayoutFormatter::CalculateCellSizes(const pictel::SupplierInterface* supplier,
                                            ui::UI_GridView& view) {
  velkcore::RequireInput(supplier != nullptr);
  const auto surface = supplier->NewSurface(1, 1, true);
  pictel::Pictel context(supplier, surface.get());
  ui::UI_Grid& grid = view.GetGrid();
  const std::int32_t columns = grid.GetNumberOfColumns();
  const std::int32_t rows = grid.GetNumberOfRows();

  std::vector<PointT<float>> needs(static_cast<std::size_t>(columns) *
                                   static_cast<std::size_t>(rows));
  for (std::int32_t r = 0; r < rows; ++r) {
    for (std::int32_t c = 0; c < columns; ++c) {
      needs[static_cast<std::size_t>(r * columns + c)] =
          grid.GetCell(c, r)->RecalcCellSize(&context);
    }
  }
  auto need = [&](std::int32_t c, std::int32_t r) {
    return needs[static_cast<std::size_t>(r * columns + c)];
  };
  for (std::int32_t r = 0; r < rows; ++r) {
    float tallest = 0;
    for (std::int32_t c = 0; c < columns; ++c) tallest = std::max(tallest, need(c, r).y);
    if (grid.GetRowHeight(r) < tallest) grid.SetRowHeight(r, tallest + kCellPadding);
  }
  for (std::int32_t c = 0; c < columns; ++c) {
    float widest = 0;
    for (std::int32_t r = 0; r < rows; ++r) widest = std::max(widest, need(c, r).x);
    if (grid.GetColumnWidth(c) != widest + kCellPadding) {
      grid.SetColumnWidth(c, widest + kCellPadding);
    }
  }
}

void UI_LayoutFormatter::ResizeGridView(const pictel::SupplierInterface* /*supplier*/,
                                        const RectT<float>& rect, ui::UI_GridView& view) {
  const auto margins = view.GetMargins();
  RectT<float> frame = view.UI_GetLocalRectF(true);
  frame.width = rect.width + 2 * static_cast<float>(margins.x);
  frame.height = rect.height + 2 * static_cast<float>(margins.y);
  const LayoutChildrenOff off(view);
  view.UI_SetLocalRectF(frame);
}

void UI_SimpleLayoutFormatter::RecalcLayout(const pictel::SupplierInterface* supplier,
                                            ui::UI_GridView& view) {
  velkcore::RequireInput(supplier != nullptr);
  if (IsFormatterInProgress()) return;
  const RectT<float> inset = InsetBounds(view);
  CalculateCellSizes(supplier, view);
  ui::UI_Grid& grid = view.GetGrid();
  float y = inset.top;
  for (std::int32_t r = 0; r < grid.GetNumberOfRows(); ++r) {
    float x = inset.left;
    for (std::int32_t c = 0; c < grid.GetNumberOfColumns(); ++c) {
      ui::UI_Cell& cell = *grid.GetCell(c, r);
      const RectT<float> rect{x, y, grid.GetColumnWidth(c), grid.GetRowHeight(r)};
      cell.SetLocalRectF(rect);
      cell.UpdateNodesPosition();
      x += rect.width;
    }
    y += grid.GetRowHeight(r);
  }
  UI_LayoutFormatter::RecalcLayout(supplier, view);
  // Judged against the area after the base step, which may have grown the view.
  const RectT<float> shown = InsetBounds(view);
  for (const ui::CellP& cell : grid.GetCells()) {
    cell->SetVisible(Overlaps(cell->GetLocalRectF(), shown));
  }
}

void UI_FlowLayoutFormatter::RecalcLayout(const pictel::SupplierInterface* supplier,
                                          ui::UI_GridView& view) {
  velkcore::RequireInput(supplier != nullptr);
  if (IsFormatterInProgress()) return;
  const RectT<float> inset = InsetBounds(view);
  CalculateCellSizes(supplier, view);
  ui::UI_Grid& grid = view.GetGrid();
  const float right = inset.left + inset.width;
  float x = inset.left;
  float y = inset.top;
  float lineHeight = 0;
  for (std::int32_t r = 0; r < grid.GetNumberOfRows(); ++r) {
    for (std::int32_t c = 0; c < grid.GetNumberOfColumns(); ++c) {
      ui::UI_Cell& cell = *grid.GetCell(c, r);
      if (cell.IsEmpty()) {
        cell.SetLocalRectF({inset.left, inset.top, 0, 0});
        cell.SetVisible(false);
        continue;
      }
      const float width = grid.GetColumnWidth(c);
      const float height = grid.GetRowHeight(r);
      if (x > inset.left && x + width > right) {
        x = inset.left;
        y += lineHeight;
        lineHeight = 0;
      }
      const RectT<float> rect{x, y, width, height};
      cell.SetLocalRectF(rect);
      cell.UpdateNodesPosition();
      cell.SetVisible(true);
      x += width;
      lineHeight = std::max(lineHeight, height);
    }
  }
  UI_LayoutFormatter::RecalcLayout(supplier, view);
}

}  // namespace velkui::layout
