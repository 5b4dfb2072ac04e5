#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace velkcore {

// All user-visible text: UTF-16 code units.
using UTF16String = std::u16string;

inline constexpr char16_t kReplacementCharacter = 0xFFFD;

// Conversions never fail: malformed input (invalid UTF-8, unpaired surrogates)
// becomes U+FFFD.
UTF16String AsciiToUTF16(std::string_view ascii);
UTF16String UTF8to16(std::string_view utf8);
std::string UTF16to8(std::u16string_view utf16);

// Locale-independent (root locale) case mapping through ICU.
UTF16String ToLowerCase(std::u16string_view text);
UTF16String ToUpperCase(std::u16string_view text);
UTF16String FoldCase(std::u16string_view text);
char16_t ToUpperCase(char16_t c);

// Replaces every occurrence of `find` (nothing when `find` is empty); returns the count.
std::size_t ReplaceAllStringInString(UTF16String& text, std::u16string_view find,
                                     std::u16string_view replacement);
std::size_t ReplaceAllStringInString(std::string& text, std::string_view find,
                                     std::string_view replacement);

// Replaces the first occurrence at or after `from`; returns whether one was found.
bool ReplaceInString(UTF16String& text, std::u16string_view find, std::u16string_view replacement,
                     std::size_t from = 0);

// Position of the first single '&' (the mnemonic marker; "&&" is a literal
// ampersand), or npos when there is none or it is the last character.
std::size_t LocateSingleAmpersandInString(std::u16string_view text);

// The text as it is shown: single ampersands removed and "&&" collapsed to "&".
UTF16String StripDisplayString(std::u16string_view text);

// The platform's line ending in multi-line text ("\n" on Linux).
const UTF16String& GetLineEnding();

// True when the text holds at least one decimal digit.
bool HasNumericChars(std::u16string_view text);

// Converts text that is known to be ASCII at compile time (keys, literals).
inline UTF16String operator""_u16(const char* s, std::size_t n) {
  return AsciiToUTF16(std::string_view(s, n));
}

}  // namespace velkcore
