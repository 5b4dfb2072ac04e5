#include <velkui/ui/KeyframeThemeParser.h>

#include <charconv>
#include <cmath>

#include <velkcore/Error.h>
#include <velkcore/File.h>

namespace velkui::ui {

namespace {

constexpr std::string_view kRootElement = "ThemeColors";
constexpr std::string_view kThemeElement = "Theme";
constexpr std::string_view kKeyFrameElement = "KeyFrame";

std::string_view TrimSpaces(std::string_view text) {
  constexpr std::string_view kSpaces = " \t\r\n";
  const auto first = text.find_first_not_of(kSpaces);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kSpaces) - first + 1);
}

std::optional<float> ParseFloat(std::string_view text) {
  text = TrimSpaces(text);
  if (text.starts_with('+')) text.remove_prefix(1);
  float value = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
  if (text.empty() || error != std::errc{} || end != text.data() + text.size() ||
      !std::isfinite(value)) {
    return std::nullopt;
  }
  return value;
}

std::optional<ThemeColorIndex> ParseIndex(std::string_view text) {
  text = TrimSpaces(text);
  ThemeColorIndex value = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
  if (text.empty() || error != std::errc{} || end != text.data() + text.size()) {
    return std::nullopt;
  }
  return value;
}

}  // namespace

void KeyframeThemeParser::ParseFile(const std::filesystem::path& path) {
  Parse(velkcore::ReadFileContents(path));
}

void KeyframeThemeParser::StartDocument() {
  tracks_.clear();
  themeKey_.reset();
  depth_ = 0;
}

void KeyframeThemeParser::StartElement(std::string_view name,
                                       std::span<const velkcore::XMLAttribute> attributes) {
  if (depth_ == 0) {
    ReadRoot(name);
  } else if (name == kKeyFrameElement) {
    ReadKeyFrame(attributes);
  } else if (name == kThemeElement) {
    ReadTheme(attributes);
  } else if (editor_.GetStrictMode()) {
    Raise(kThemeFileUnknownElementKey, kThemeFileUnknownElementNumber, name);
  }
  ++depth_;
}

void KeyframeThemeParser::EndElement(std::string_view) {
  --depth_;
}

void KeyframeThemeParser::EndDocument() {
  for (const auto& [index, track] : tracks_) {
    if (track.empty()) {
      editor_.ClearColorKeyValue(index);
    } else {
      editor_.SetColorTrack(index, track);
    }
  }
  tracks_.clear();
}

void KeyframeThemeParser::ReadRoot(std::string_view name) {
  if (name != kRootElement) Raise(kThemeFileNotAThemeKey, kThemeFileNotAThemeNumber, name);
}

// From here on every key frame sits at the Theme's brightness.
void KeyframeThemeParser::ReadTheme(std::span<const velkcore::XMLAttribute> attributes) {
  if (const auto t = Required(attributes, "t", kThemeElement)) themeKey_ = ReadFloat("t", *t);
}

void KeyframeThemeParser::ReadKeyFrame(std::span<const velkcore::XMLAttribute> attributes) {
  const auto name = Required(attributes, "name", kKeyFrameElement);
  if (!name) return;
  const ThemeColorIndex index = ReadIndex("name", *name);
  // The first key frame of an index replaces its track, even one that adds no key.
  KeyframeThemeEditor::ColorTrack& track = tracks_[index];

  std::optional<float> key = themeKey_;
  if (!key) {
    const auto t = Required(attributes, "t", kKeyFrameElement);
    if (!t) return;
    key = ReadFloat("t", *t);
  }
  const auto v = Required(attributes, "v", kKeyFrameElement);
  if (!v) return;

  KeyframeThemeEditor::KeyValue keyValue;
  keyValue.value = ReadFloat("v", *v);
  if (const auto h = FindAttribute(attributes, "h")) keyValue.hue = ReadFloat("h", *h);
  if (const auto s = FindAttribute(attributes, "s")) keyValue.saturation = ReadFloat("s", *s);
  if (const auto a = FindAttribute(attributes, "a")) keyValue.alpha = ReadFloat("a", *a);
  keyValue.hold = FindAttribute(attributes, "hold") == "true";
  track.insert_or_assign(*key, keyValue);
}

std::optional<std::string_view> KeyframeThemeParser::Required(
    std::span<const velkcore::XMLAttribute> attributes, std::string_view attribute,
    std::string_view element) {
  const auto value = FindAttribute(attributes, attribute);
  if (!value && editor_.GetStrictMode()) {
    Raise(kThemeFileMissingAttributeKey, kThemeFileMissingAttributeNumber, attribute, element);
  }
  return value;
}

float KeyframeThemeParser::ReadFloat(std::string_view attribute, std::string_view text) const {
  const auto value = ParseFloat(text);
  if (!value) Raise(kThemeFileInvalidValueKey, kThemeFileInvalidValueNumber, attribute, text);
  return *value;
}

ThemeColorIndex KeyframeThemeParser::ReadIndex(std::string_view attribute,
                                               std::string_view text) const {
  const auto value = ParseIndex(text);
  if (!value) Raise(kThemeFileInvalidValueKey, kThemeFileInvalidValueNumber, attribute, text);
  return *value;
}

void KeyframeThemeParser::Raise(std::string_view key, std::int32_t number,
                                const velkcore::ReplacementValue& r2,
                                const velkcore::ReplacementValue& r3) const {
  RaiseAt(CurrentPosition(), key, velkcore::kCategoryUserInterface, number, r2, r3);
}

}  // namespace velkui::ui
