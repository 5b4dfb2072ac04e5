#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>

namespace velkui::ui {

// Boolean settings with dotted names ("velkui.controls.UI_Button.LoseFocusOnESC").
// A setting that was never set answers the default its reader gives.
class CustomSettingsManager {
 public:
  bool GetBoolean(std::string_view name, bool defaultValue) const;
  void SetBoolean(std::string_view name, bool value);
  bool HasSetting(std::string_view name) const;
  // True when the setting existed.
  bool RemoveSetting(std::string_view name);

 private:
  std::map<std::string, bool, std::less<>> booleans_;
};

}  // namespace velkui::ui
