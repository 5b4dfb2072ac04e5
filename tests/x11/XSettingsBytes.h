#pragma once

// Encodes _XSETTINGS_SETTINGS properties as a settings manager writes them,
// in either byte order; the raw appenders build malformed ones.

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

namespace velkui::ui::x11test {

class XSettingsBytes {
 public:
  static constexpr std::uint8_t kInteger = 0;
  static constexpr std::uint8_t kString = 1;
  static constexpr std::uint8_t kColor = 2;

  explicit XSettingsBytes(bool mostSignificantFirst = false)
      : mostSignificantFirst_(mostSignificantFirst) {}

  XSettingsBytes& Integer(std::string_view name, std::int32_t value) {
    Start(kInteger, name);
    Card32(static_cast<std::uint32_t>(value));
    return *this;
  }
  XSettingsBytes& String(std::string_view name, std::string_view value) {
    Start(kString, name);
    Card32(static_cast<std::uint32_t>(value.size()));
    Text(value);
    return *this;
  }
  XSettingsBytes& Color(std::string_view name, std::uint16_t red, std::uint16_t green,
                        std::uint16_t blue, std::uint16_t alpha) {
    Start(kColor, name);
    for (const std::uint16_t channel : {red, green, blue, alpha}) Card16(channel);
    return *this;
  }

  // A setting's header; the caller appends its value.
  void Start(std::uint8_t type, std::string_view name) {
    ++count_;
    body_.push_back(type);
    body_.push_back(0);
    Card16(static_cast<std::uint16_t>(name.size()));
    Text(name);
    Card32(1);  // last-change serial
  }
  void Card8(std::uint8_t value) { body_.push_back(value); }
  void Card16(std::uint16_t value) { Append(body_, value, 2); }
  void Card32(std::uint32_t value) { Append(body_, value, 4); }
  // Text and its padding to a multiple of four.
  void Text(std::string_view text) {
    body_.insert(body_.end(), text.begin(), text.end());
    body_.resize(body_.size() + (4 - text.size() % 4) % 4, 0);
  }

  // The property; `declaredCount` replaces the number of settings written.
  std::vector<std::uint8_t> Bytes(std::uint32_t serial = 7,
                                  std::optional<std::uint32_t> declaredCount = {}) const {
    std::vector<std::uint8_t> bytes{mostSignificantFirst_ ? std::uint8_t{1} : std::uint8_t{0}, 0, 0,
                                    0};
    Append(bytes, serial, 4);
    Append(bytes, declaredCount.value_or(count_), 4);
    bytes.insert(bytes.end(), body_.begin(), body_.end());
    return bytes;
  }

 private:
  void Append(std::vector<std::uint8_t>& out, std::uint32_t value, int size) const {
    for (int i = 0; i < size; ++i) {
      const int shift = 8 * (mostSignificantFirst_ ? size - 1 - i : i);
      out.push_back(static_cast<std::uint8_t>(value >> shift));
    }
  }

  bool mostSignificantFirst_;
  std::uint32_t count_ = 0;
  std::vector<std::uint8_t> body_;
};

}  // namespace velkui::ui::x11test
