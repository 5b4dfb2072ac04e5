#pragma once

#include <cstdint>
#include <string_view>

#include <velkcore/Flags.h>
#include <velkcore/Strings.h>

namespace velkcore {

// Flags of NumberToString / StringToNumber / Calculate.
enum NumberFormatFlag : std::uint16_t {
  kFormatNormal = 0x00,
  kFormatNoLocalization = 0x01,  // '.' and ',' whatever the locale
  kFormatLeadingSpaces = 0x02,   // right-aligned in kLeadingSpacesWidth characters
  kFormatNoTrailingZeros = 0x04,
  kFormatUseSeparator = 0x08,  // group thousands
  kFormatAlwaysSign = 0x10,    // "+" before positive numbers
  kFormatPadSign = 0x20,       // a space where a positive number has no sign
};
using NumberFormatFlags = Flags<std::uint16_t>;

inline constexpr std::size_t kLeadingSpacesWidth = 12;
inline constexpr std::int32_t kMaxDecimalPlaces = 30;

// The separators of localised number text. The process locale (setlocale) is
// never consulted: the default comes from ICU's default locale, and hosts or
// tests set it explicitly.
struct NumberLocale {
  char16_t decimalSeparator = u'.';
  char16_t groupingSeparator = u',';

  friend bool operator==(const NumberLocale&, const NumberLocale&) = default;
};

NumberLocale GetNumberLocale();
void SetNumberLocale(const NumberLocale& locale);
// The separators of an ICU locale name such as "de_DE" (the default: "." and ",").
NumberLocale NumberLocaleForLanguage(const char* icuLocaleName);

// The value rounded to `decimalPlaces` (0..kMaxDecimalPlaces, else the input
// contract violation). NaN is "NaN", infinities "∞" and "-∞"; a value that
// rounds to zero has no minus sign.
UTF16String NumberToString(double value, std::int32_t decimalPlaces, NumberFormatFlags flags = {});

// Parses every text NumberToString makes (signs, padding, grouping, "NaN",
// "∞") and plain C notation ("1.5e-3"). The whole text, apart from surrounding
// white space, must be the number; on failure `value` is left unchanged.
bool StringToNumber(std::u16string_view text, double& value, NumberFormatFlags flags = {});

// Evaluates a typed expression: numbers as StringToNumber reads them, + - * /
// (also × ÷), ^ (power, right-associative), unary minus and plus, parentheses,
// and an optional trailing "=". False for malformed input or a result that is
// not finite; `result` is then left unchanged.
bool Calculate(std::u16string_view expression, double& result, NumberFormatFlags flags = {});

// '.' <-> the locale's decimal separator and ',' <-> its grouping separator.
UTF16String InternationalizeNum(std::u16string_view text);
UTF16String DeInternationalizeNum(std::u16string_view text);

}  // namespace velkcore
