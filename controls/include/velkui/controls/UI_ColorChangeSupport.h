#pragma once

#include <cstddef>
#include <map>

#include <velkui/ui/Theme.h>

namespace velkui::controls {

// Theme colour substitutions: from theme colour number to theme colour number.
using ColorChangeMap = std::map<std::size_t, std::size_t>;

// A mixin that lets a host recolour a control by swapping theme colours.
class UI_ColorChangeSupport {
 public:
  UI_ColorChangeSupport() = default;
  UI_ColorChangeSupport(const UI_ColorChangeSupport&) = default;
  UI_ColorChangeSupport& operator=(const UI_ColorChangeSupport&) = default;
  virtual ~UI_ColorChangeSupport() = default;

  // Inserts or overwrites the substitution of `from`.
  void ReplaceColor(ui::UI_Color from, ui::UI_Color to);
  void ResetColors() { colorChangeMap_.clear(); }
  const ColorChangeMap& GetColorChangeMap() const { return colorChangeMap_; }

 private:
  ColorChangeMap colorChangeMap_;
};

// The colour `color` maps to in `map`, or `color` itself when the map is null
// or has no entry for it.
ui::UI_Color UI_GetColorFromChangeMap(ui::UI_Color color, const ColorChangeMap* map);

}  // namespace velkui::controls
