#include "XSettingsParser.h"

namespace velkui::ui::x11 {

namespace {

// The byte-order byte takes X's values.
constexpr std::uint8_t kLeastSignificantFirst = 0;
constexpr std::uint8_t kMostSignificantFirst = 1;

constexpr std::uint8_t kTypeInteger = 0;
constexpr std::uint8_t kTypeString = 1;
constexpr std::uint8_t kTypeColor = 2;

// Reads fields in the property's byte order. A read past the end marks the
// reader failed and gives zeros or an empty string from then on.
class FieldReader {
 public:
  explicit FieldReader(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  bool Failed() const { return failed_; }
  void SetMostSignificantFirst(bool value) { mostSignificantFirst_ = value; }

  std::uint8_t Card8() { return static_cast<std::uint8_t>(Unsigned(1)); }
  std::uint16_t Card16() { return static_cast<std::uint16_t>(Unsigned(2)); }
  std::uint32_t Card32() { return Unsigned(4); }
  void Skip(std::size_t count) {
    if (Take(count)) offset_ += count;
  }
  // `length` bytes of text and the padding to the next multiple of four.
  std::string Text(std::size_t length) {
    if (!Take(length)) return {};
    const auto* first = reinterpret_cast<const char*>(bytes_.data() + offset_);
    std::string text(first, length);
    offset_ += length;
    Skip((4 - length % 4) % 4);
    return text;
  }

 private:
  // Whether `count` more bytes are there.
  bool Take(std::size_t count) {
    if (!failed_ && count > bytes_.size() - offset_) failed_ = true;
    return !failed_;
  }
  std::uint32_t Unsigned(std::size_t size) {
    if (!Take(size)) return 0;
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < size; ++i) {
      const std::size_t index = mostSignificantFirst_ ? i : size - 1 - i;
      value = (value << 8) | bytes_[offset_ + index];
    }
    offset_ += size;
    return value;
  }

  std::span<const std::uint8_t> bytes_;
  std::size_t offset_ = 0;
  bool mostSignificantFirst_ = false;
  bool failed_ = false;
};

std::optional<XSettingValue> ReadValue(std::uint8_t type, FieldReader& reader) {
  switch (type) {
    case kTypeInteger:
      return static_cast<std::int32_t>(reader.Card32());
    case kTypeString:
      return reader.Text(reader.Card32());
    case kTypeColor: {
      XSettingColor color;
      color.red = reader.Card16();
      color.green = reader.Card16();
      color.blue = reader.Card16();
      color.alpha = reader.Card16();
      return color;
    }
    default:
      // Its length is unknown, so nothing after it can be found.
      return std::nullopt;
  }
}

}  // namespace

std::optional<std::int32_t> XSettings::Integer(std::string_view name) const {
  const auto found = values.find(name);
  if (found == values.end()) return std::nullopt;
  if (const auto* value = std::get_if<std::int32_t>(&found->second)) return *value;
  return std::nullopt;
}

std::optional<XSettings> ParseXSettings(std::span<const std::uint8_t> bytes) {
  FieldReader reader(bytes);
  const std::uint8_t order = reader.Card8();
  if (reader.Failed() || (order != kLeastSignificantFirst && order != kMostSignificantFirst)) {
    return std::nullopt;
  }
  reader.SetMostSignificantFirst(order == kMostSignificantFirst);
  reader.Skip(3);
  XSettings settings;
  settings.serial = reader.Card32();
  const std::uint32_t count = reader.Card32();
  // Every setting takes at least twelve bytes, so an absurd count runs out of
  // bytes long before it runs out of iterations.
  for (std::uint32_t i = 0; i < count && !reader.Failed(); ++i) {
    const std::uint8_t type = reader.Card8();
    reader.Skip(1);
    std::string name = reader.Text(reader.Card16());
    reader.Skip(4);  // the serial of its last change
    std::optional<XSettingValue> value = ReadValue(type, reader);
    if (!value || reader.Failed()) return std::nullopt;
    settings.values.emplace(std::move(name), std::move(*value));
  }
  if (reader.Failed()) return std::nullopt;
  return settings;
}

}  // namespace velkui::ui::x11
