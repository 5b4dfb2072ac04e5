#pragma once

// The settings a desktop's XSETTINGS manager publishes, decoded from the bytes
// of its _XSETTINGS_SETTINGS property. No X11 types: the parser is tested
// without a display.

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <variant>

namespace velkui::ui::x11 {

struct XSettingColor {
  std::uint16_t red = 0;
  std::uint16_t green = 0;
  std::uint16_t blue = 0;
  std::uint16_t alpha = 0xFFFF;
  bool operator==(const XSettingColor&) const = default;
};

using XSettingValue = std::variant<std::int32_t, std::string, XSettingColor>;

struct XSettings {
  std::uint32_t serial = 0;
  // By name; when a name comes twice, the first one counts.
  std::map<std::string, XSettingValue, std::less<>> values;

  // The value of an integer setting; nullopt when it is missing or of another type.
  std::optional<std::int32_t> Integer(std::string_view name) const;
};

// Decodes a whole property. nullopt when the bytes are not one: an unknown byte
// order or setting type, or a count or length that runs past the end (the
// property read may have been cut short, so nothing of it is trusted). Bytes
// after the last setting are ignored.
std::optional<XSettings> ParseXSettings(std::span<const std::uint8_t> bytes);

}  // namespace velkui::ui::x11
