#include <velkcore/Strings.h>

#include <unicode/uchar.h>
#include <unicode/ustring.h>
#include <unicode/utypes.h>

#include <climits>
#include <functional>

namespace velkcore {
namespace {

constexpr UChar32 kSubstitute = 0xFFFD;

int32_t LengthForICU(std::size_t size) {
  // ICU lengths are int32_t; text beyond 2 GiB is not user-interface text.
  return size > static_cast<std::size_t>(INT32_MAX / 4) ? INT32_MAX / 4
                                                          : static_cast<int32_t>(size);
}

using CaseMapper = std::function<int32_t(UChar*, int32_t, const UChar*, int32_t, UErrorCode*)>;

UTF16String MapCase(std::u16string_view text, const CaseMapper& map) {
  if (text.empty()) return {};
  const int32_t length = LengthForICU(text.size());
  UTF16String out(static_cast<std::size_t>(length) + 8, u'\0');
  UErrorCode status = U_ZERO_ERROR;
  int32_t needed = map(out.data(), static_cast<int32_t>(out.size()), text.data(), length, &status);
  if (status == U_BUFFER_OVERFLOW_ERROR) {
    out.assign(static_cast<std::size_t>(needed), u'\0');
    status = U_ZERO_ERROR;
    needed = map(out.data(), needed, text.data(), length, &status);
  }
  if (U_FAILURE(status)) return UTF16String(text);
  out.resize(static_cast<std::size_t>(needed));
  return out;
}

}  // namespace

UTF16String AsciiToUTF16(std::string_view ascii) {
  UTF16String out;
  out.reserve(ascii.size());
  for (const char c : ascii) {
    const auto byte = static_cast<unsigned char>(c);
    out.push_back(byte < 0x80 ? static_cast<char16_t>(byte) : kReplacementCharacter);
  }
  return out;
}

UTF16String UTF8to16(std::string_view utf8) {
  if (utf8.empty()) return {};
  const int32_t length = LengthForICU(utf8.size());
  // Every UTF-8 byte yields at most one UTF-16 unit.
  UTF16String out(static_cast<std::size_t>(length), u'\0');
  int32_t written = 0;
  UErrorCode status = U_ZERO_ERROR;
  u_strFromUTF8WithSub(out.data(), length, &written, utf8.data(), length, kSubstitute, nullptr,
                       &status);
  if (U_FAILURE(status)) return {};
  out.resize(static_cast<std::size_t>(written));
  return out;
}

std::string UTF16to8(std::u16string_view utf16) {
  if (utf16.empty()) return {};
  const int32_t length = LengthForICU(utf16.size());
  // Every UTF-16 unit yields at most three UTF-8 bytes.
  std::string out(static_cast<std::size_t>(length) * 3, '\0');
  int32_t written = 0;
  UErrorCode status = U_ZERO_ERROR;
  u_strToUTF8WithSub(out.data(), static_cast<int32_t>(out.size()), &written, utf16.data(), length,
                     kSubstitute, nullptr, &status);
  if (U_FAILURE(status)) return {};
  out.resize(static_cast<std::size_t>(written));
  return out;
}

UTF16String ToLowerCase(std::u16string_view text) {
  return MapCase(text, [](UChar* d, int32_t cap, const UChar* s, int32_t n, UErrorCode* e) {
    return u_strToLower(d, cap, s, n, "", e);
  });
}

UTF16String ToUpperCase(std::u16string_view text) {
  return MapCase(text, [](UChar* d, int32_t cap, const UChar* s, int32_t n, UErrorCode* e) {
    return u_strToUpper(d, cap, s, n, "", e);
  });
}

UTF16String FoldCase(std::u16string_view text) {
  return MapCase(text, [](UChar* d, int32_t cap, const UChar* s, int32_t n, UErrorCode* e) {
    return u_strFoldCase(d, cap, s, n, U_FOLD_CASE_DEFAULT, e);
  });
}

char16_t ToUpperCase(char16_t c) {
  if (c >= 0xD800 && c <= 0xDFFF) return c;
  const UChar32 upper = u_toupper(c);
  return upper > 0xFFFF ? c : static_cast<char16_t>(upper);
}

namespace {
template <typename S, typename V>
std::size_t ReplaceAll(S& text, V find, V replacement) {
  if (find.empty()) return 0;
  std::size_t count = 0;
  std::size_t pos = 0;
  while ((pos = text.find(find.data(), pos, find.size())) != S::npos) {
    text.replace(pos, find.size(), replacement.data(), replacement.size());
    pos += replacement.size();
    ++count;
  }
  return count;
}
}  // namespace

std::size_t ReplaceAllStringInString(UTF16String& text, std::u16string_view find,
                                     std::u16string_view replacement) {
  return ReplaceAll(text, find, replacement);
}

std::size_t ReplaceAllStringInString(std::string& text, std::string_view find,
                                     std::string_view replacement) {
  return ReplaceAll(text, find, replacement);
}

bool ReplaceInString(UTF16String& text, std::u16string_view find, std::u16string_view replacement,
                     std::size_t from) {
  if (find.empty() || from > text.size()) return false;
  const std::size_t pos = text.find(find.data(), from, find.size());
  if (pos == UTF16String::npos) return false;
  text.replace(pos, find.size(), replacement.data(), replacement.size());
  return true;
}

std::size_t LocateSingleAmpersandInString(std::u16string_view text) {
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] != u'&') continue;
    if (i + 1 >= text.size()) return std::u16string_view::npos;
    if (text[i + 1] == u'&') {
      ++i;  // a literal ampersand
      continue;
    }
    return i;
  }
  return std::u16string_view::npos;
}

UTF16String StripDisplayString(std::u16string_view text) {
  UTF16String out;
  out.reserve(text.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == u'&') {
      if (i + 1 < text.size() && text[i + 1] == u'&') {
        out.push_back(u'&');
        ++i;
      }
      continue;
    }
    out.push_back(text[i]);
  }
  return out;
}

const UTF16String& GetLineEnding() {
  static const UTF16String lineEnding = u"\n";
  return lineEnding;
}

bool HasNumericChars(std::u16string_view text) {
  for (const char16_t c : text) {
    if (c >= u'0' && c <= u'9') return true;
  }
  return false;
}

}  // namespace velkcore
