#pragma once

#include <filesystem>
#include <initializer_list>
#include <mutex>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>

#include <velkcore/Strings.h>

namespace velkcore {

// Maps localisation keys to text. A key reads "$$$/area/entry=Default text";
// without a loaded translation the default text is the result.
//
// Translation files are UTF-8 text, one entry per line in the same form as the
// keys ("$$$/velkui/dialogs/OK=Bestätigen"); blank lines and lines starting
// with '#' are ignored. Placeholders in texts: "^0".."^3" replacement values,
// "@0".."@3" arguments, "#{endl}" a line break, "^^" a literal caret.
class Localizer {
 public:
  static Localizer& Get();

  // The text for `key` (with or without its "=Default" part); a text that is
  // not a key is returned as it stands. "#{endl}" becomes a line break.
  UTF16String Lookup(std::string_view key) const;
  UTF16String Lookup(std::string_view key, std::span<const UTF16String> replacements,
                     std::span<const UTF16String> arguments = {}) const;

  // A stored text of the form "($$$/area/entry=Default)" is looked up; any
  // other text is returned unchanged.
  UTF16String ResolveStoredText(std::u16string_view text) const;

  // Loads `<directory>/<language>.txt` (throws when it cannot be read or parsed).
  void LoadLanguage(const std::filesystem::path& directory, std::string_view language);
  void LoadTranslationFile(const std::filesystem::path& file);
  // Adds the entries of a translation text; `origin` names it in error messages.
  void LoadTranslationText(std::string_view utf8, std::string_view origin);
  void SetTranslation(std::string_view key, std::u16string_view text);
  void ClearTranslations();
  const std::string& GetLanguage() const { return language_; }

  static bool IsKey(std::string_view text);
  // "$$$/a/b=Text" -> "$$$/a/b".
  static std::string_view KeyPath(std::string_view key);
  // "$$$/a/b=Text" -> "Text" (empty when there is no default).
  static std::string_view DefaultText(std::string_view key);

 private:
  Localizer() = default;

  mutable std::mutex mutex_;
  std::unordered_map<std::string, UTF16String> translations_;
  std::string language_;
};

// Fills "^0".."^3" (and "@0".."@3" from `arguments`), expands "#{endl}", "^^" -> "^".
UTF16String FillPlaceholders(std::u16string_view text, std::span<const UTF16String> replacements,
                             std::span<const UTF16String> arguments = {});

// Shorthand: Localizer::Get().Lookup(key, {values...}).
UTF16String Localize(std::string_view key, std::initializer_list<UTF16String> replacements = {});

}  // namespace velkcore
