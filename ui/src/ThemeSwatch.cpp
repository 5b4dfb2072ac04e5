#include <velkui/ui/ThemeSwatch.h>

#include <cmath>

#include <velkcore/Error.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {

namespace {

constexpr pictel::ColorRGBA kWhite{1, 1, 1, 1};
constexpr pictel::ColorRGBA kBlack{0, 0, 0, 1};

struct SwatchGrid {
  float cellWidth;
  float cellHeight;
};

SwatchGrid GridOf(const velkcore::RectT<float>& area, std::int32_t columns) {
  velkcore::RequireInput(columns >= 1);
  const auto perRow = static_cast<ThemeColorIndex>(columns);
  const ThemeColorIndex rows = (kThemePaletteSize + perRow - 1) / perRow;
  return {area.width / static_cast<float>(columns), area.height / static_cast<float>(rows)};
}

velkcore::RectT<float> CellOf(const velkcore::RectT<float>& area, std::int32_t columns,
                              const SwatchGrid& grid, ThemeColorIndex index) {
  const auto perRow = static_cast<ThemeColorIndex>(columns);
  return {area.left + static_cast<float>(index % perRow) * grid.cellWidth,
          area.top + static_cast<float>(index / perRow) * grid.cellHeight, grid.cellWidth,
          grid.cellHeight};
}

// A one-unit gap between cells once they are big enough to spare it.
velkcore::RectT<float> Inset(const velkcore::RectT<float>& cell) {
  if (cell.width < 4 || cell.height < 4) return cell;
  return {cell.left + 0.5f, cell.top + 0.5f, cell.width - 1, cell.height - 1};
}

}  // namespace

void DrawThemeSwatches(pictel::SurfaceInterface& surface, const Theme& theme,
                       const velkcore::RectT<float>& area, std::int32_t columns) {
  const SwatchGrid grid = GridOf(area, columns);
  for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
    if (!theme.HasColor(index)) continue;
    const velkcore::RectT<float> cell = Inset(CellOf(area, columns, grid, index));
    const float half = cell.width / 2;
    surface.PaintRect(kWhite, {cell.left, cell.top, half, cell.height});
    surface.PaintRect(kBlack, {cell.left + half, cell.top, cell.width - half, cell.height});
    surface.PaintRect(theme.GetColor(index), cell);
  }
}

velkcore::RectT<float> GetThemeSwatchCell(const velkcore::RectT<float>& area, std::int32_t columns,
                                          ThemeColorIndex index) {
  velkcore::RequireInput(index < kThemePaletteSize);
  return CellOf(area, columns, GridOf(area, columns), index);
}

std::int64_t FindThemeSwatchIndex(const velkcore::RectT<float>& area, std::int32_t columns,
                                  const velkcore::PointT<float>& point) {
  const SwatchGrid grid = GridOf(area, columns);
  if (!area.Contains(point) || !(grid.cellWidth > 0) || !(grid.cellHeight > 0)) return -1;
  const auto column = static_cast<std::int64_t>(std::floor((point.x - area.left) / grid.cellWidth));
  const auto row = static_cast<std::int64_t>(std::floor((point.y - area.top) / grid.cellHeight));
  if (column >= columns) return -1;
  const std::int64_t index = row * columns + column;
  return index < static_cast<std::int64_t>(kThemePaletteSize) ? index : -1;
}

}  // namespace velkui::ui
