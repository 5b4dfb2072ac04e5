#include <velkui/ui/CustomSettingsManager.h>

namespace velkui::ui {

bool CustomSettingsManager::GetBoolean(std::string_view name, bool defaultValue) const {
  const auto found = booleans_.find(name);
  return found != booleans_.end() ? found->second : defaultValue;
}

void CustomSettingsManager::SetBoolean(std::string_view name, bool value) {
  booleans_.insert_or_assign(std::string(name), value);
}

bool CustomSettingsManager::HasSetting(std::string_view name) const {
  return booleans_.find(name) != booleans_.end();
}

bool CustomSettingsManager::RemoveSetting(std::string_view name) {
  const auto found = booleans_.find(name);
  if (found == booleans_.end()) return false;
  booleans_.erase(found);
  return true;
}

}  // namespace velkui::ui
