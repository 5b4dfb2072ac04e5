#include <velkcore/Error.h>

#include <charconv>
#include <cmath>

#include <velkcore/Geometry.h>
#include <velkcore/Localizer.h>

namespace velkcore {

UTF16String ReplacementValue::FromNumber(double value) {
  if (std::isnan(value)) return u"NaN";
  if (std::isinf(value)) return value > 0 ? u"Infinity" : u"-Infinity";
  char buffer[32];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
  return AsciiToUTF16(std::string_view(buffer, static_cast<std::size_t>(result.ptr - buffer)));
}

Exception::Exception(ErrorLevel level, std::string key, std::int32_t category, std::int32_t number,
                     std::int32_t flag, std::array<UTF16String, 4> replacements)
    : level_(level),
      key_(std::move(key)),
      category_(category),
      number_(number),
      flag_(flag),
      replacements_(std::move(replacements)),
      what_(UTF16to8(GetMessage())) {}

UTF16String Exception::GetMessage() const {
  return Localizer::Get().Lookup(key_, replacements_);
}

const char* Exception::what() const noexcept { return what_.c_str(); }

void ThrowError(ErrorLevel level, std::string_view key, std::int32_t category, std::int32_t number,
                std::int32_t flag, const ReplacementValue& r0, const ReplacementValue& r1,
                const ReplacementValue& r2, const ReplacementValue& r3) {
  throw Exception(level, std::string(key), category, number, flag,
                  {r0.Text(), r1.Text(), r2.Text(), r3.Text()});
}

void ThrowInputContractViolation() {
  ThrowError(ErrorLevel::kContractViolation, kInputContractViolationKey, kCategoryUtilities,
             kInputContractViolationNumber);
}

void ThrowInvalidTypeConversion() {
  ThrowError(ErrorLevel::kContractViolation, kInvalidTypeConversionKey, kCategoryUtilities,
             kInvalidTypeConversionNumber);
}

void ThrowSingularMatrix() {
  ThrowError(ErrorLevel::kError, kSingularMatrixKey, kCategoryGeometry, kSingularMatrixNumber);
}

}  // namespace velkcore
