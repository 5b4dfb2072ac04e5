#include <velkcore/Numbers.h>

#include <unicode/unum.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <mutex>
#include <optional>
#include <string>

#include <velkcore/Error.h>

namespace velkcore {
namespace {

constexpr char16_t kInfinity = 0x221E;
constexpr char16_t kMinusSign = 0x2212;
constexpr char16_t kMultiply = 0x00D7;
constexpr char16_t kDivide = 0x00F7;
constexpr int kMaxExpressionDepth = 256;

std::mutex gLocaleMutex;
std::optional<NumberLocale> gLocale;

NumberLocale SeparatorsFor(NumberFormatFlags flags) {
  return flags.IsSet(kFormatNoLocalization) ? NumberLocale{} : GetNumberLocale();
}

bool IsSpace(char16_t c) { return c == u' ' || c == u'\t' || c == 0x00A0 || c == 0x202F; }
bool IsDigit(char16_t c) { return c >= u'0' && c <= u'9'; }

std::u16string_view Trim(std::u16string_view text) {
  while (!text.empty() && IsSpace(text.front())) text.remove_prefix(1);
  while (!text.empty() && IsSpace(text.back())) text.remove_suffix(1);
  return text;
}

bool EqualsAsciiIgnoringCase(std::u16string_view text, std::string_view ascii) {
  if (text.size() != ascii.size()) return false;
  for (std::size_t i = 0; i < text.size(); ++i) {
    char16_t c = text[i];
    if (c >= u'A' && c <= u'Z') c = static_cast<char16_t>(c - u'A' + u'a');
    if (c != static_cast<char16_t>(ascii[i])) return false;
  }
  return true;
}


// Groups the integer digits of `digits` (ASCII) in threes.
UTF16String GroupThousands(std::string_view digits, char16_t separator) {
  UTF16String out;
  out.reserve(digits.size() + digits.size() / 3);
  for (std::size_t i = 0; i < digits.size(); ++i) {
    if (i > 0 && (digits.size() - i) % 3 == 0) out.push_back(separator);
    out.push_back(static_cast<char16_t>(digits[i]));
  }
  return out;
}

// For a decimal text that from_chars found out of range: whether it is tiny
// (underflows to zero) rather than huge.
bool IsUnderflow(std::string_view ascii) {
  const std::size_t e = ascii.find('e');
  const std::string_view mantissa = ascii.substr(0, e);
  long exponent = 0;
  if (e != std::string_view::npos) {
    std::string_view digits = ascii.substr(e + 1);
    if (!digits.empty() && digits.front() == '+') digits.remove_prefix(1);
    const auto r = std::from_chars(digits.data(), digits.data() + digits.size(), exponent);
    if (r.ec == std::errc::result_out_of_range) return digits.front() == '-';
  }
  // Decimal magnitude of the first significant digit.
  const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
  const std::size_t first = mantissa.find_first_of("123456789");
  if (first == std::string_view::npos) return true;
  const long position = first < point ? static_cast<long>(point - first) - 1
                                      : -static_cast<long>(first - point);
  return position + exponent < 0;
}

// Reads one number at the front of `text` (no sign) and advances past it.
// Grouping separators are accepted between integer digits.
std::optional<double> ReadUnsignedNumber(std::u16string_view& text, const NumberLocale& locale) {
  std::string ascii;
  std::size_t i = 0;
  bool digitsSeen = false;
  while (i < text.size()) {
    const char16_t c = text[i];
    if (IsDigit(c)) {
      ascii.push_back(static_cast<char>(c));
      digitsSeen = true;
    } else if (c == locale.groupingSeparator && digitsSeen && i + 1 < text.size() &&
               IsDigit(text[i + 1])) {
      // a thousands separator between digits
    } else {
      break;
    }
    ++i;
  }
  if (i < text.size() && text[i] == locale.decimalSeparator) {
    ascii.push_back('.');
    ++i;
    while (i < text.size() && IsDigit(text[i])) {
      ascii.push_back(static_cast<char>(text[i]));
      digitsSeen = true;
      ++i;
    }
  }
  if (!digitsSeen) return std::nullopt;
  if (i < text.size() && (text[i] == u'e' || text[i] == u'E')) {
    std::size_t j = i + 1;
    std::string exponent = "e";
    if (j < text.size() && (text[j] == u'+' || text[j] == u'-')) {
      exponent.push_back(static_cast<char>(text[j]));
      ++j;
    }
    const std::size_t firstDigit = j;
    while (j < text.size() && IsDigit(text[j])) exponent.push_back(static_cast<char>(text[j++]));
    if (j > firstDigit) {  // "2e" is not an exponent; leave the 'e' to the caller
      ascii += exponent;
      i = j;
    }
  }
  double value = 0;
  const auto result = std::from_chars(ascii.data(), ascii.data() + ascii.size(), value);
  if (result.ec == std::errc::result_out_of_range) {
    if (!IsUnderflow(ascii)) return std::nullopt;  // too large to be a usable number
    value = 0;
  } else if (result.ec != std::errc{} || result.ptr != ascii.data() + ascii.size()) {
    return std::nullopt;
  }
  text.remove_prefix(i);
  return value;
}

class ExpressionParser {
 public:
  ExpressionParser(std::u16string_view text, NumberLocale locale) : text_(text), locale_(locale) {}

  std::optional<double> Parse() {
    auto value = Sum(0);
    SkipSpace();
    if (!text_.empty() && text_.front() == u'=') text_.remove_prefix(1);
    SkipSpace();
    if (!value || !text_.empty() || !std::isfinite(*value)) return std::nullopt;
    return value;
  }

 private:
  void SkipSpace() {
    while (!text_.empty() && IsSpace(text_.front())) text_.remove_prefix(1);
  }
  bool Take(std::initializer_list<char16_t> choices, char16_t& taken) {
    SkipSpace();
    if (text_.empty()) return false;
    for (const char16_t c : choices) {
      if (text_.front() == c) {
        taken = c;
        text_.remove_prefix(1);
        return true;
      }
    }
    return false;
  }

  std::optional<double> Sum(int depth) {
    auto left = Product(depth);
    char16_t op = 0;
    while (left && Take({u'+', u'-', kMinusSign}, op)) {
      const auto right = Product(depth);
      if (!right) return std::nullopt;
      left = op == u'+' ? *left + *right : *left - *right;
    }
    return left;
  }

  std::optional<double> Product(int depth) {
    auto left = Unary(depth);
    char16_t op = 0;
    while (left && Take({u'*', u'/', kMultiply, kDivide}, op)) {
      const auto right = Unary(depth);
      if (!right) return std::nullopt;
      left = (op == u'*' || op == kMultiply) ? *left * *right : *left / *right;
    }
    return left;
  }

  std::optional<double> Unary(int depth) {
    if (depth > kMaxExpressionDepth) return std::nullopt;
    char16_t sign = 0;
    if (Take({u'-', kMinusSign, u'+'}, sign)) {
      const auto operand = Unary(depth + 1);
      if (!operand) return std::nullopt;
      return sign == u'+' ? *operand : -*operand;
    }
    return Power(depth);
  }

  std::optional<double> Power(int depth) {
    const auto base = Primary(depth);
    char16_t op = 0;
    if (!base || !Take({u'^'}, op)) return base;
    const auto exponent = Unary(depth + 1);  // right-associative: 2^3^2 = 2^9
    if (!exponent) return std::nullopt;
    return std::pow(*base, *exponent);
  }

  std::optional<double> Primary(int depth) {
    char16_t paren = 0;
    if (Take({u'('}, paren)) {
      const auto inner = Sum(depth + 1);
      if (!inner || !Take({u')'}, paren)) return std::nullopt;
      return inner;
    }
    SkipSpace();
    return ReadUnsignedNumber(text_, locale_);
  }

  std::u16string_view text_;
  NumberLocale locale_;
};

NumberLocale LocaleFromICU(const char* name) {
  NumberLocale locale;
  UErrorCode status = U_ZERO_ERROR;
  UNumberFormat* format = unum_open(UNUM_DECIMAL, nullptr, 0, name, nullptr, &status);
  if (U_FAILURE(status) || format == nullptr) return locale;
  UChar buffer[8];
  const auto symbol = [&](UNumberFormatSymbol which, char16_t fallback) {
    UErrorCode s = U_ZERO_ERROR;
    const int32_t n = unum_getSymbol(format, which, buffer, 8, &s);
    return (U_SUCCESS(s) && n == 1) ? static_cast<char16_t>(buffer[0]) : fallback;
  };
  locale.decimalSeparator = symbol(UNUM_DECIMAL_SEPARATOR_SYMBOL, u'.');
  locale.groupingSeparator = symbol(UNUM_GROUPING_SEPARATOR_SYMBOL, u',');
  unum_close(format);
  if (locale.decimalSeparator == locale.groupingSeparator) return NumberLocale{};
  return locale;
}

}  // namespace

NumberLocale GetNumberLocale() {
  const std::lock_guard lock(gLocaleMutex);
  if (!gLocale) gLocale = LocaleFromICU(nullptr);
  return *gLocale;
}

void SetNumberLocale(const NumberLocale& locale) {
  RequireInput(locale.decimalSeparator != locale.groupingSeparator &&
               !IsDigit(locale.decimalSeparator) && !IsDigit(locale.groupingSeparator));
  const std::lock_guard lock(gLocaleMutex);
  gLocale = locale;
}

NumberLocale NumberLocaleForLanguage(const char* icuLocaleName) {
  return LocaleFromICU(icuLocaleName);
}

UTF16String NumberToString(double value, std::int32_t decimalPlaces, NumberFormatFlags flags) {
  RequireInput(decimalPlaces >= 0 && decimalPlaces <= kMaxDecimalPlaces);
  const NumberLocale locale = SeparatorsFor(flags);
  UTF16String sign;
  UTF16String body;
  if (std::isnan(value)) {
    body = u"NaN";
  } else {
    char buffer[400];  // the largest double in fixed notation with 30 places fits
    const auto result = std::isinf(value)
                            ? std::to_chars_result{buffer, std::errc{}}
                            : std::to_chars(buffer, buffer + sizeof buffer, std::fabs(value),
                                            std::chars_format::fixed, decimalPlaces);
    std::string_view digits(buffer, static_cast<std::size_t>(result.ptr - buffer));
    const bool roundsToZero = !std::isinf(value) && digits.find_first_not_of("0.") == digits.npos;
    if (std::signbit(value) && !roundsToZero) {
      sign = u"-";
    } else if (flags.IsSet(kFormatAlwaysSign) && value > 0 && !roundsToZero) {
      sign = u"+";
    } else if (flags.IsSet(kFormatPadSign)) {
      sign = u" ";
    }
    if (std::isinf(value)) {
      body = UTF16String(1, kInfinity);
    } else {
      std::string_view integer = digits.substr(0, digits.find('.'));
      std::string_view fraction =
          integer.size() < digits.size() ? digits.substr(integer.size() + 1) : std::string_view{};
      if (flags.IsSet(kFormatNoTrailingZeros)) {
        while (!fraction.empty() && fraction.back() == '0') fraction.remove_suffix(1);
      }
      body = flags.IsSet(kFormatUseSeparator) ? GroupThousands(integer, locale.groupingSeparator)
                                              : AsciiToUTF16(integer);
      if (!fraction.empty()) {
        body.push_back(locale.decimalSeparator);
        body += AsciiToUTF16(fraction);
      }
    }
  }
  UTF16String text = sign + body;
  if (flags.IsSet(kFormatLeadingSpaces) && text.size() < kLeadingSpacesWidth) {
    text.insert(0, kLeadingSpacesWidth - text.size(), u' ');
  }
  return text;
}

bool StringToNumber(std::u16string_view text, double& value, NumberFormatFlags flags) {
  text = Trim(text);
  bool negative = false;
  if (!text.empty() && (text.front() == u'-' || text.front() == kMinusSign || text.front() == u'+')) {
    negative = text.front() != u'+';
    text = Trim(text.substr(1));
  }
  double parsed = 0;
  if (EqualsAsciiIgnoringCase(text, "nan")) {
    parsed = std::nan("");
  } else if ((text.size() == 1 && text.front() == kInfinity) ||
             EqualsAsciiIgnoringCase(text, "inf") || EqualsAsciiIgnoringCase(text, "infinity")) {
    parsed = HUGE_VAL;
  } else {
    const auto number = ReadUnsignedNumber(text, SeparatorsFor(flags));
    if (!number || !text.empty()) return false;
    parsed = *number;
  }
  value = negative ? -parsed : parsed;
  return true;
}

bool Calculate(std::u16string_view expression, double& result, NumberFormatFlags flags) {
  const auto value = ExpressionParser(expression, SeparatorsFor(flags)).Parse();
  if (!value) return false;
  result = *value;
  return true;
}

namespace {
UTF16String SwapSeparators(std::u16string_view text, char16_t fromDecimal, char16_t fromGrouping,
                           char16_t toDecimal, char16_t toGrouping) {
  UTF16String out(text);
  for (char16_t& c : out) {
    if (c == fromDecimal) {
      c = toDecimal;
    } else if (c == fromGrouping) {
      c = toGrouping;
    }
  }
  return out;
}
}  // namespace

UTF16String InternationalizeNum(std::u16string_view text) {
  const NumberLocale locale = GetNumberLocale();
  return SwapSeparators(text, u'.', u',', locale.decimalSeparator, locale.groupingSeparator);
}

UTF16String DeInternationalizeNum(std::u16string_view text) {
  const NumberLocale locale = GetNumberLocale();
  return SwapSeparators(text, locale.decimalSeparator, locale.groupingSeparator, u'.', u',');
}

}  // namespace velkcore
