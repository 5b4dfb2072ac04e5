#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <span>
#include <string_view>

#include <velkcore/AbstractParseHandler.h>
#include <velkui/ui/KeyframeThemeEditor.h>

namespace velkui::ui {

// Errors of theme files (category 103); "^0" and "^1" are the line and column.
inline constexpr std::string_view kThemeFileNotAThemeKey =
    "$$$/velkui/ui/Error/Theme/NotAThemeFile=Not a theme file: the root element is \"^2\" "
    "instead of \"ThemeColors\" (line ^0, column ^1).";
inline constexpr std::string_view kThemeFileInvalidValueKey =
    "$$$/velkui/ui/Error/Theme/InvalidValue=Invalid value \"^3\" of attribute \"^2\" in a theme "
    "file (line ^0, column ^1).";
inline constexpr std::string_view kThemeFileMissingAttributeKey =
    "$$$/velkui/ui/Error/Theme/MissingAttribute=Attribute \"^2\" is missing from element \"^3\" "
    "in a theme file (line ^0, column ^1).";
inline constexpr std::string_view kThemeFileUnknownElementKey =
    "$$$/velkui/ui/Error/Theme/UnknownElement=Unknown element \"^2\" in a theme file (line ^0, "
    "column ^1).";
inline constexpr std::int32_t kThemeFileNotAThemeNumber = 30;
inline constexpr std::int32_t kThemeFileInvalidValueNumber = 31;
inline constexpr std::int32_t kThemeFileMissingAttributeNumber = 32;
inline constexpr std::int32_t kThemeFileUnknownElementNumber = 33;

// Reads a theme file into the tracks of a KeyframeThemeEditor:
//
//   <ThemeColors>
//     <KeyFrame name="18" t="0.0" h="205" s="0.7" v="0.6"/>
//     <KeyFrame name="18" t="1.0" h="205" s="0.6" v="1.0" a="1" hold="true"/>
//     <Theme t="0.25"> <KeyFrame name="4" v="0.2"/> </Theme>
//   </ThemeColors>
//
// "name" is the colour index, "t" the brightness key (a "Theme" element's "t"
// replaces it for every key frame that follows), "v" the value; "h", "s" and
// "a" default to 0, 0 and 1; hold="true" holds the key's colour up to the next
// key. The first key frame of an index in a file replaces the index's whole
// track. Numbers are plain C notation, whatever the locale.
//
// A key frame without "name", "v" or (outside a "Theme") "t" adds no key, and
// unknown elements are skipped, unless the editor is in strict mode. A value
// that is not a number, and a root other than "ThemeColors", are always errors.
// The editor changes only when the whole file was read without error; then
// call its Update and NotifyThemeChanged to show the new colours.
class KeyframeThemeParser : public velkcore::AbstractParseHandler {
 public:
  explicit KeyframeThemeParser(KeyframeThemeEditor& editor) : editor_(editor) {}

  using AbstractParseHandler::Parse;
  // Reads a theme file from disk (the core's file errors pass through).
  void ParseFile(const std::filesystem::path& path);

 protected:
  void StartElement(std::string_view name,
                    std::span<const velkcore::XMLAttribute> attributes) override;
  void EndElement(std::string_view name) override;
  void StartDocument() override;
  void EndDocument() override;

 private:
  void ReadRoot(std::string_view name);
  void ReadTheme(std::span<const velkcore::XMLAttribute> attributes);
  void ReadKeyFrame(std::span<const velkcore::XMLAttribute> attributes);
  // The attribute's value, or nothing; a missing attribute raises in strict mode.
  std::optional<std::string_view> Required(std::span<const velkcore::XMLAttribute> attributes,
                                           std::string_view attribute, std::string_view element);
  float ReadFloat(std::string_view attribute, std::string_view text) const;
  ThemeColorIndex ReadIndex(std::string_view attribute, std::string_view text) const;
  [[noreturn]] void Raise(std::string_view key, std::int32_t number,
                          const velkcore::ReplacementValue& r2,
                          const velkcore::ReplacementValue& r3 = {}) const;

  KeyframeThemeEditor& editor_;
  // The tracks read so far, applied to the editor at the end of the document.
  std::map<ThemeColorIndex, KeyframeThemeEditor::ColorTrack> tracks_;
  std::optional<float> themeKey_;
  std::uint64_t depth_ = 0;
};

}  // namespace velkui::ui
