#include "PropListText.h"

#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>

namespace velkcore::proplist_text {
namespace {

constexpr char kHexDigits[] = "0123456789abcdef";

bool IsXMLChar(char32_t c) {
  return c == 0x9 || c == 0xA || c == 0xD || (c >= 0x20 && c <= 0xD7FF) ||
         (c >= 0xE000 && c <= 0xFFFD) || (c >= 0x10000 && c <= 0x10FFFF);
}

bool IsHighSurrogate(char16_t c) {
  return c >= 0xD800 && c <= 0xDBFF;
}
bool IsLowSurrogate(char16_t c) {
  return c >= 0xDC00 && c <= 0xDFFF;
}

// The code point of a strictly valid UTF-8 sequence at `text`, with its length;
// nullopt for anything malformed, overlong, a surrogate or beyond U+10FFFF.
std::optional<std::pair<char32_t, std::size_t>> DecodeUTF8(std::string_view text) {
  const auto lead = static_cast<unsigned char>(text[0]);
  if (lead < 0x80) return std::pair{char32_t{lead}, std::size_t{1}};
  std::size_t length = 0;
  char32_t code = 0;
  char32_t smallest = 0;
  if ((lead & 0xE0) == 0xC0) {
    length = 2, code = lead & 0x1F, smallest = 0x80;
  } else if ((lead & 0xF0) == 0xE0) {
    length = 3, code = lead & 0x0F, smallest = 0x800;
  } else if ((lead & 0xF8) == 0xF0) {
    length = 4, code = lead & 0x07, smallest = 0x10000;
  } else {
    return std::nullopt;
  }
  if (text.size() < length) return std::nullopt;
  for (std::size_t i = 1; i < length; ++i) {
    const auto next = static_cast<unsigned char>(text[i]);
    if ((next & 0xC0) != 0x80) return std::nullopt;
    code = (code << 6) | (next & 0x3F);
  }
  if (code < smallest || code > 0x10FFFF || (code >= 0xD800 && code <= 0xDFFF)) {
    return std::nullopt;
  }
  return std::pair{code, length};
}

std::string_view TrimXMLSpace(std::string_view text) {
  while (!text.empty() && IsXMLSpace(text.front())) text.remove_prefix(1);
  while (!text.empty() && IsXMLSpace(text.back())) text.remove_suffix(1);
  return text;
}

std::optional<unsigned> HexValue(char c) {
  if (c >= '0' && c <= '9') return static_cast<unsigned>(c - '0');
  if (c >= 'a' && c <= 'f') return static_cast<unsigned>(c - 'a' + 10);
  if (c >= 'A' && c <= 'F') return static_cast<unsigned>(c - 'A' + 10);
  return std::nullopt;
}

// Reads `hex` in groups of `digits` digits; null on any other character or a short group.
template <typename Unit, typename Text>
std::optional<Text> DecodeHexGroups(std::string_view hex, std::size_t digits) {
  if (hex.size() % digits != 0) return std::nullopt;
  Text result;
  result.reserve(hex.size() / digits);
  for (std::size_t i = 0; i < hex.size(); i += digits) {
    unsigned value = 0;
    for (std::size_t k = 0; k < digits; ++k) {
      const auto digit = HexValue(hex[i + k]);
      if (!digit) return std::nullopt;
      value = value * 16 + *digit;
    }
    result.push_back(static_cast<Unit>(value));
  }
  return result;
}

template <typename Unsigned>
void AppendHex(std::string& out, Unsigned value, std::size_t digits) {
  for (std::size_t k = digits; k-- > 0;) out.push_back(kHexDigits[(value >> (4 * k)) & 0xF]);
}

template <typename F>
using BitsOf = std::conditional_t<sizeof(F) == 4, std::uint32_t, std::uint64_t>;

template <typename F>
std::string FormatFloating(F value) {
  using Bits = BitsOf<F>;
  if (std::isnan(value)) {
    constexpr Bits kSign = Bits{1} << (sizeof(Bits) * 8 - 1);
    const Bits bits = std::bit_cast<Bits>(value);
    const Bits plain = std::bit_cast<Bits>(std::numeric_limits<F>::quiet_NaN());
    if ((bits & ~kSign) == plain) return (bits & kSign) != 0 ? "-nan" : "nan";
    std::string text = "nan(0x";
    AppendHex(text, bits, sizeof(Bits) * 2);
    text.push_back(')');
    return text;
  }
  char buffer[64];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
  return std::string(buffer, result.ptr);
}

bool StartsWithNaN(std::string_view text) {
  return text.size() >= 3 && (text[0] == 'n' || text[0] == 'N') &&
         (text[1] == 'a' || text[1] == 'A') && (text[2] == 'n' || text[2] == 'N');
}

// Any NaN spelling is handled here rather than by from_chars, whose reading
// of "nan(...)" is left to the library.
template <typename F>
std::optional<F> ParseNaN(std::string_view body, bool negative) {
  using Bits = BitsOf<F>;
  if (body.size() == 3) {
    const F nan = std::numeric_limits<F>::quiet_NaN();
    return negative ? -nan : nan;
  }
  constexpr std::string_view kPrefix = "nan(0x";
  if (negative || !body.starts_with(kPrefix) || !body.ends_with(')')) return std::nullopt;
  const std::string_view digits = body.substr(kPrefix.size(), body.size() - kPrefix.size() - 1);
  if (digits.empty() || digits.size() > sizeof(Bits) * 2) return std::nullopt;
  Bits bits = 0;
  for (const char c : digits) {
    const auto digit = HexValue(c);
    if (!digit) return std::nullopt;
    bits = static_cast<Bits>(bits * 16 + *digit);
  }
  const F value = std::bit_cast<F>(bits);
  if (!std::isnan(value)) return std::nullopt;
  return value;
}

template <typename F>
std::optional<F> ParseFloating(std::string_view text) {
  text = TrimXMLSpace(text);
  const bool negative = text.starts_with('-');
  const std::string_view body = negative ? text.substr(1) : text;
  if (StartsWithNaN(body)) return ParseNaN<F>(body, negative);
  F value{};
  const char* end = text.data() + text.size();
  const auto [ptr, error] = std::from_chars(text.data(), end, value, std::chars_format::general);
  if (error != std::errc() || ptr != end) return std::nullopt;
  return value;
}

template <typename I>
std::optional<I> ParseInteger(std::string_view text) {
  text = TrimXMLSpace(text);
  I value{};
  const char* end = text.data() + text.size();
  const auto [ptr, error] = std::from_chars(text.data(), end, value, 10);
  if (error != std::errc() || ptr != end) return std::nullopt;
  return value;
}

}  // namespace

bool IsXMLSpace(char c) {
  return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

bool IsAllXMLSpace(std::string_view text) {
  for (const char c : text) {
    if (!IsXMLSpace(c)) return false;
  }
  return true;
}

bool IsCarriable(std::string_view utf8) {
  while (!utf8.empty()) {
    const auto decoded = DecodeUTF8(utf8);
    if (!decoded || !IsXMLChar(decoded->first)) return false;
    utf8.remove_prefix(decoded->second);
  }
  return true;
}

bool IsCarriable(std::u16string_view utf16) {
  for (std::size_t i = 0; i < utf16.size(); ++i) {
    const char16_t unit = utf16[i];
    if (IsHighSurrogate(unit)) {
      if (i + 1 == utf16.size() || !IsLowSurrogate(utf16[i + 1])) return false;
      ++i;  // a proper pair is a code point beyond U+FFFF: always carriable
    } else if (IsLowSurrogate(unit) || !IsXMLChar(unit)) {
      return false;
    }
  }
  return true;
}

std::string HexOfBytes(std::string_view bytes) {
  std::string hex;
  hex.reserve(bytes.size() * 2);
  for (const char c : bytes) AppendHex(hex, static_cast<unsigned char>(c), 2);
  return hex;
}

std::string HexOfUnits(std::u16string_view units) {
  std::string hex;
  hex.reserve(units.size() * 4);
  for (const char16_t unit : units) AppendHex(hex, static_cast<unsigned>(unit), 4);
  return hex;
}

std::optional<std::string> BytesOfHex(std::string_view hex) {
  return DecodeHexGroups<char, std::string>(hex, 2);
}

std::optional<UTF16String> UnitsOfHex(std::string_view hex) {
  return DecodeHexGroups<char16_t, UTF16String>(hex, 4);
}

std::string FormatFloat(float value) {
  return FormatFloating(value);
}
std::string FormatFloat(double value) {
  return FormatFloating(value);
}

std::optional<float> ParseFloat(std::string_view text) {
  return ParseFloating<float>(text);
}
std::optional<double> ParseDouble(std::string_view text) {
  return ParseFloating<double>(text);
}
std::optional<std::int32_t> ParseInt32(std::string_view text) {
  return ParseInteger<std::int32_t>(text);
}
std::optional<std::uint32_t> ParseUInt32(std::string_view text) {
  return ParseInteger<std::uint32_t>(text);
}
std::optional<std::uint16_t> ParseUInt16(std::string_view text) {
  return ParseInteger<std::uint16_t>(text);
}

}  // namespace velkcore::proplist_text
