#include <velkcore/Localizer.h>

#include <fstream>
#include <sstream>

#include <velkcore/Error.h>

namespace velkcore {
namespace {

constexpr std::string_view kKeyPrefix = "$$$/";
constexpr std::u16string_view kLineBreak = u"#{endl}";

std::string ReadWholeFile(const std::filesystem::path& file) {
  std::ifstream in(file, std::ios::binary);
  if (!in) {
    ThrowError(ErrorLevel::kError,
               "$$$/velkcore/Localizer/Error/CannotRead=Unable to read the translation file '^0'.",
               kCategoryUtilities, 30, 0, file.string());
  }
  std::ostringstream content;
  content << in.rdbuf();
  return content.str();
}

}  // namespace

Localizer& Localizer::Get() {
  static Localizer instance;
  return instance;
}

bool Localizer::IsKey(std::string_view text) { return text.starts_with(kKeyPrefix); }

std::string_view Localizer::KeyPath(std::string_view key) {
  return key.substr(0, key.find('='));
}

std::string_view Localizer::DefaultText(std::string_view key) {
  const std::size_t eq = key.find('=');
  return eq == std::string_view::npos ? std::string_view{} : key.substr(eq + 1);
}

UTF16String Localizer::Lookup(std::string_view key) const { return Lookup(key, {}, {}); }

UTF16String Localizer::Lookup(std::string_view key, std::span<const UTF16String> replacements,
                              std::span<const UTF16String> arguments) const {
  if (!IsKey(key)) return FillPlaceholders(UTF8to16(key), replacements, arguments);
  {
    const std::lock_guard lock(mutex_);
    const auto found = translations_.find(std::string(KeyPath(key)));
    if (found != translations_.end()) return FillPlaceholders(found->second, replacements, arguments);
  }
  return FillPlaceholders(UTF8to16(DefaultText(key)), replacements, arguments);
}

UTF16String Localizer::ResolveStoredText(std::u16string_view text) const {
  if (text.size() >= 6 && text.front() == u'(' && text.back() == u')' &&
      text.substr(1).starts_with(u"$$$/")) {
    return Lookup(UTF16to8(text.substr(1, text.size() - 2)));
  }
  return UTF16String(text);
}

void Localizer::LoadLanguage(const std::filesystem::path& directory, std::string_view language) {
  LoadTranslationFile(directory / (std::string(language) + ".txt"));
  const std::lock_guard lock(mutex_);
  language_ = language;
}

void Localizer::LoadTranslationFile(const std::filesystem::path& file) {
  LoadTranslationText(ReadWholeFile(file), file.string());
}

void Localizer::LoadTranslationText(std::string_view utf8, std::string_view origin) {
  // Parse everything first so a bad file changes nothing.
  std::unordered_map<std::string, UTF16String> parsed;
  std::size_t lineNumber = 0;
  while (!utf8.empty()) {
    ++lineNumber;
    const std::size_t end = utf8.find('\n');
    std::string_view line = utf8.substr(0, end);
    utf8 = end == std::string_view::npos ? std::string_view{} : utf8.substr(end + 1);
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    if (lineNumber == 1 && line.starts_with("\xEF\xBB\xBF")) line.remove_prefix(3);
    if (line.empty() || line.front() == '#') continue;
    const std::size_t eq = line.find('=');
    if (!IsKey(line) || eq == std::string_view::npos) {
      ThrowError(ErrorLevel::kError,
                 "$$$/velkcore/Localizer/Error/BadEntry=Translation file '^0', line ^1: an entry "
                 "reads \"$$$/area/entry=Text\".",
                 kCategoryUtilities, 31, 0, origin, static_cast<double>(lineNumber));
    }
    parsed[std::string(line.substr(0, eq))] = UTF8to16(line.substr(eq + 1));
  }
  const std::lock_guard lock(mutex_);
  for (auto& [k, v] : parsed) translations_[k] = std::move(v);
}

void Localizer::SetTranslation(std::string_view key, std::u16string_view text) {
  const std::lock_guard lock(mutex_);
  translations_[std::string(KeyPath(key))] = UTF16String(text);
}

void Localizer::ClearTranslations() {
  const std::lock_guard lock(mutex_);
  translations_.clear();
  language_.clear();
}

UTF16String FillPlaceholders(std::u16string_view text, std::span<const UTF16String> replacements,
                             std::span<const UTF16String> arguments) {
  UTF16String out;
  out.reserve(text.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    const char16_t c = text[i];
    const char16_t next = i + 1 < text.size() ? text[i + 1] : u'\0';
    if ((c == u'^' || c == u'@') && next >= u'0' && next <= u'3') {
      const auto index = static_cast<std::size_t>(next - u'0');
      const auto& values = c == u'^' ? replacements : arguments;
      if (index < values.size()) out += values[index];
      ++i;
    } else if (c == u'^' && next == u'^') {
      out.push_back(u'^');
      ++i;
    } else if (c == u'#' && text.substr(i).starts_with(kLineBreak)) {
      out.push_back(u'\n');
      i += kLineBreak.size() - 1;
    } else {
      out.push_back(c);
    }
  }
  return out;
}

UTF16String Localize(std::string_view key, std::initializer_list<UTF16String> replacements) {
  return Localizer::Get().Lookup(key, std::span<const UTF16String>(replacements.begin(),
                                                                   replacements.size()));
}

}  // namespace velkcore
