#include <velkui/controls/UI_ColorChangeSupport.h>

namespace velkui::controls {

void UI_ColorChangeSupport::ReplaceColor(ui::UI_Color from, ui::UI_Color to) {
  colorChangeMap_.insert_or_assign(static_cast<std::size_t>(from), static_cast<std::size_t>(to));
}

ui::UI_Color UI_GetColorFromChangeMap(ui::UI_Color color, const ColorChangeMap* map) {
  if (map == nullptr) return color;
  const auto found = map->find(static_cast<std::size_t>(color));
  return found == map->end() ? color : static_cast<ui::UI_Color>(found->second);
}

}  // namespace velkui::controls
