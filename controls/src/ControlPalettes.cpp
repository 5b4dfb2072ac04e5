#include <velkui/controls/ControlPalettes.h>

#include <velkui/ui/DefaultKeyframeTheme.h>

namespace velkui::controls {

void ApplyDarkControlColors(ui::Theme& theme) {
  for (const auto& [index, color] :
       ui::GetDefaultKeyframeThemeColors(ui::kDarkInterfaceBrightness)) {
    theme.SetColor(index, color);
  }
}

}  // namespace velkui::controls
