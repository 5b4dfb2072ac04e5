#include <velkui/ui/UI_GridView.h>

#include <charconv>
#include <cmath>
#include <optional>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/layout/UI_LayoutFormatter.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

bool UI_GridView::sDrawCellBorders = false;

namespace {

constexpr pictel::ColorRGBA kBorderColor{0.55f, 0.58f, 0.62f, 1.0f};
constexpr pictel::ColorRGBA kSelectionColor{0.16f, 0.45f, 0.86f, 0.25f};
constexpr pictel::ColorRGBA kGuideColor{0.16f, 0.45f, 0.86f, 1.0f};

std::string FormatLengths(const std::vector<float>& lengths) {
  std::string text;
  for (std::size_t i = 0; i < lengths.size(); ++i) {
    if (i > 0) text += ',';
    char buffer[32];
    const auto result = std::to_chars(buffer, buffer + sizeof buffer, lengths[i]);
    text.append(buffer, result.ptr);
  }
  return text;
}

std::string_view Trim(std::string_view s) {
  const auto first = s.find_first_not_of(" \t\r\n");
  if (first == std::string_view::npos) return {};
  const auto last = s.find_last_not_of(" \t\r\n");
  return s.substr(first, last - first + 1);
}

// One entry per piece of `text` split at ","; empty pieces give no value. A piece that is not
// a finite, non-negative number raises the contract violation.
std::vector<std::optional<float>> ParseLengths(const velkcore::UTF16String& text) {
  const std::string narrow = velkcore::UTF16to8(text);
  std::vector<std::optional<float>> lengths;
  std::string_view rest = narrow;
  while (true) {
    const auto comma = rest.find(',');
    const std::string_view piece = Trim(rest.substr(0, comma));
    if (piece.empty()) {
      lengths.emplace_back();
    } else {
      float value = 0;
      const auto result = std::from_chars(piece.data(), piece.data() + piece.size(), value);
      velkcore::RequireInput(result.ec == std::errc() &&
                             result.ptr == piece.data() + piece.size() && std::isfinite(value) &&
                             value >= 0);
      lengths.emplace_back(value);
    }
    if (comma == std::string_view::npos) break;
    rest.remove_prefix(comma + 1);
  }
  return lengths;
}

void StrokeLine(pictel::Pictel* context, const pictel::PenInterface& pen, PointT<float> from,
                PointT<float> to) {
  const auto path = context->GetSupplier()->NewPath();
  path->MoveTo(from);
  path->LineTo(to);
  context->GetSurface()->StrokePath(pen, *path);
}

}  // namespace

UI_GridView::UI_GridView(const PointT<float>& size) : grid_(1, 1) {
  UI_SetLocalRectF({0, 0, size.x, size.y});
  grid_.SetColumnWidth(0, size.x);
  grid_.SetRowHeight(0, size.y);
}

UI_GridView::~UI_GridView() = default;

RectT<float> UI_GridView::GetGridRectF() const {
  const PointT<float> total = grid_.GetTotalSize();
  return {grid_.GetOrigin().x, grid_.GetOrigin().y, total.x, total.y};
}

void UI_GridView::SetMargins(std::int32_t horizontal, std::int32_t vertical) {
  velkcore::RequireInput(horizontal >= 0 && vertical >= 0);
  margins_ = {horizontal, vertical};
  grid_.SetOrigin({static_cast<float>(horizontal), static_cast<float>(vertical)});
}

void UI_GridView::UpdateGrid(const pictel::SupplierInterface* supplier) {
  const NodeP keep = detail::Hold(this);
  grid_.LayoutCells();
  for (const CellP& cell : grid_.GetCells()) cell->FetchNodes(*this);
  initialized_ = true;
  RecalcLayout(supplier);
}

void UI_GridView::RecalcLayout(const pictel::SupplierInterface* supplier) {
  // Held for the call: the formatter may be replaced while it works.
  const FormatterP formatter = formatter_;
  if (formatter) formatter->RecalcLayout(supplier, *this);
}

void UI_GridView::SetLayoutFormatter(FormatterP formatter) {
  formatter_ = std::move(formatter);
}

UI_GridView::FormatterP UI_GridView::GetLayoutFormatter() const {
  return formatter_;
}

void UI_GridView::AddNodeToSelectedCell(const NodeP& node) {
  velkcore::RequireInput(node != nullptr);
  if (node->UI_GetParentContainer() != this) ChildPushBack(node);
  UI_Cell* cell = addToSelectedCell_ ? grid_.GetSelectedCell() : nullptr;
  if (cell == nullptr) return;
  for (const CellP& other : grid_.GetCells()) other->RemoveNode(node.get());
  cell->AddNode(node, {0, 0});
  cell->UpdateNodesPosition();
}

bool UI_GridView::OwnsCell(const UI_Cell* cell) const {
  for (const CellP& own : grid_.GetCells()) {
    if (own.get() == cell) return true;
  }
  return false;
}

void UI_GridView::MoveNode(UI_Cell* from, UI_Cell* to, const NodeP& node) {
  velkcore::RequireInput(node != nullptr && from != nullptr && to != nullptr && OwnsCell(from) &&
                         OwnsCell(to));
  std::optional<PointT<float>> offset;
  for (std::size_t i = 0; i < from->GetNodeCount(); ++i) {
    if (from->GetNode(i) == node) offset = from->GetNodeOffset(i);
  }
  velkcore::RequireInput(offset.has_value());
  from->RemoveNode(node.get());
  to->AddNode(node, *offset);
  const RectT<float> frame = node->UI_GetLocalRectF(true);
  const RectT<float> cell = to->GetLocalRectF();
  node->UI_SetLocalRectF({cell.left + offset->x, cell.top + offset->y, frame.width, frame.height});
}

void UI_GridView::SetEditMode(bool on) {
  if (editMode_ == on) return;
  editMode_ = on;
  UI_Invalidate(nullptr, InvalidateFlags{});
}

std::int32_t UI_GridView::GetColumnGuideForPosition(const PointT<float>& point) const {
  const RectT<float> extent = GetGridRectF();
  if (point.y < extent.top || point.y > extent.top + extent.height) return -1;
  float boundary = extent.left;
  for (std::int32_t c = 0; c < grid_.GetNumberOfColumns(); ++c) {
    boundary += grid_.GetColumnWidth(c);
    if (std::fabs(point.x - boundary) <= kGuideTolerance) return c;
  }
  return -1;
}

std::int32_t UI_GridView::GetRowGuideForPosition(const PointT<float>& point) const {
  const RectT<float> extent = GetGridRectF();
  if (point.x < extent.left || point.x > extent.left + extent.width) return -1;
  float boundary = extent.top;
  for (std::int32_t r = 0; r < grid_.GetNumberOfRows(); ++r) {
    boundary += grid_.GetRowHeight(r);
    if (std::fabs(point.y - boundary) <= kGuideTolerance) return r;
  }
  return -1;
}

velkcore::UTF16String UI_GridView::GetColumnWidthsAsString() const {
  std::vector<float> widths;
  for (std::int32_t c = 0; c < grid_.GetNumberOfColumns(); ++c) {
    widths.push_back(grid_.GetColumnWidth(c));
  }
  return velkcore::UTF8to16(FormatLengths(widths));
}

velkcore::UTF16String UI_GridView::GetRowHeightsAsString() const {
  std::vector<float> heights;
  for (std::int32_t r = 0; r < grid_.GetNumberOfRows(); ++r)
    heights.push_back(grid_.GetRowHeight(r));
  return velkcore::UTF8to16(FormatLengths(heights));
}

void UI_GridView::SetColumnWidthsFromString(const velkcore::UTF16String& text) {
  const auto widths = ParseLengths(text);
  for (std::int32_t c = 0; c < grid_.GetNumberOfColumns(); ++c) {
    const auto index = static_cast<std::size_t>(c);
    if (index >= widths.size()) break;
    if (widths[index]) grid_.SetColumnWidth(c, *widths[index]);
  }
}

void UI_GridView::SetRowHeightsFromString(const velkcore::UTF16String& text) {
  const auto heights = ParseLengths(text);
  for (std::int32_t r = 0; r < grid_.GetNumberOfRows(); ++r) {
    const auto index = static_cast<std::size_t>(r);
    if (index >= heights.size()) break;
    if (heights[index]) grid_.SetRowHeight(r, *heights[index]);
  }
}

void UI_GridView::Draw(const RectT<float>& rect, const UI_Grid& grid, pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::SupplierInterface& supplier = *context->GetSupplier();
  pictel::SurfaceInterface& surface = *context->GetSurface();
  const PointT<float> total = grid.GetTotalSize();
  // Half-pixel offsets keep the 1-unit lines crisp on whole-numbered boundaries.
  float y = rect.top;
  for (std::int32_t r = 0; r < grid.GetNumberOfRows(); ++r) {
    float x = rect.left;
    for (std::int32_t c = 0; c < grid.GetNumberOfColumns(); ++c) {
      if (grid.GetCell(c, r)->IsSelected()) {
        surface.PaintRect(kSelectionColor, {x, y, grid.GetColumnWidth(c), grid.GetRowHeight(r)});
      }
      x += grid.GetColumnWidth(c);
    }
    y += grid.GetRowHeight(r);
  }
  const auto pen = supplier.NewPen(kBorderColor, 1.0f);
  float x = rect.left;
  for (std::int32_t c = 0; c <= grid.GetNumberOfColumns(); ++c) {
    StrokeLine(context, *pen, {x + 0.5f, rect.top}, {x + 0.5f, rect.top + total.y});
    if (c < grid.GetNumberOfColumns()) x += grid.GetColumnWidth(c);
  }
  y = rect.top;
  for (std::int32_t r = 0; r <= grid.GetNumberOfRows(); ++r) {
    StrokeLine(context, *pen, {rect.left, y + 0.5f}, {rect.left + total.x, y + 0.5f});
    if (r < grid.GetNumberOfRows()) y += grid.GetRowHeight(r);
  }
}

void UI_GridView::SetDrawCellBordersState(bool draw) {
  sDrawCellBorders = draw;
}

bool UI_GridView::CanDrawCellBorders() {
  return sDrawCellBorders;
}

void UI_GridView::UI_Draw(pictel::Pictel* context) const {
  if (sDrawCellBorders || editMode_) Draw(GetGridRectF(), grid_, context);
  if (editMode_) {
    const RectT<float> bounds = UI_GetLocalRectF(false);
    const RectT<float> extent = GetGridRectF();
    const auto pen = context->GetSupplier()->NewPen(kGuideColor, 1.0f);
    const float dashes[2] = {3, 3};
    pen->SetDashArray(dashes, 2);
    float x = extent.left;
    for (std::int32_t c = 0; c < grid_.GetNumberOfColumns(); ++c) {
      x += grid_.GetColumnWidth(c);
      StrokeLine(context, *pen, {x + 0.5f, bounds.top}, {x + 0.5f, bounds.top + bounds.height});
    }
    float y = extent.top;
    for (std::int32_t r = 0; r < grid_.GetNumberOfRows(); ++r) {
      y += grid_.GetRowHeight(r);
      StrokeLine(context, *pen, {bounds.left, y + 0.5f}, {bounds.left + bounds.width, y + 0.5f});
    }
  }
  UI_SubView::UI_Draw(context);
}

void UI_GridView::ChildRemoved(UI_Node* node) {
  for (const CellP& cell : grid_.GetCells()) cell->RemoveNode(node);
  UI_SubView::ChildRemoved(node);
}

}  // namespace velkui::ui
