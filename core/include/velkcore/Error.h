#pragma once

#include <array>
#include <cstdint>
#include <exception>
#include <string>
#include <string_view>
#include <type_traits>

#include <velkcore/Strings.h>

namespace velkcore {

enum class ErrorLevel : std::int32_t {
  kContractViolation = 0,
  kError = 1,
};

enum ErrorCategory : std::int32_t {
  kCategoryDrawing = 101,
  kCategoryUserInterface = 103,
  kCategoryUtilities = 105,
  kCategoryGeometry = 107,
};

// One value filling "^0".."^3" of an error's text.
class ReplacementValue {
 public:
  ReplacementValue() = default;
  ReplacementValue(UTF16String text) : text_(std::move(text)) {}            // NOLINT
  ReplacementValue(std::u16string_view text) : text_(text) {}               // NOLINT
  ReplacementValue(const char16_t* text) : text_(text ? text : u"") {}      // NOLINT
  ReplacementValue(std::string_view utf8) : text_(UTF8to16(utf8)) {}        // NOLINT
  ReplacementValue(const std::string& utf8) : text_(UTF8to16(utf8)) {}      // NOLINT
  ReplacementValue(const char* utf8) : text_(UTF8to16(utf8 ? utf8 : "")) {}  // NOLINT
  template <typename N, typename = std::enable_if_t<std::is_arithmetic_v<N>>>
  ReplacementValue(N number) : text_(FromNumber(static_cast<double>(number))) {}  // NOLINT

  const UTF16String& Text() const { return text_; }

 private:
  static UTF16String FromNumber(double value);
  UTF16String text_;
};

// The one exception type of velkcore and velkui.
class Exception : public std::exception {
 public:
  Exception(ErrorLevel level, std::string key, std::int32_t category, std::int32_t number,
            std::int32_t flag, std::array<UTF16String, 4> replacements);

  ErrorLevel GetLevel() const { return level_; }
  // The full localisation key with its default text ("$$$/.../Entry=Text").
  const std::string& GetKey() const { return key_; }
  std::int32_t GetCategory() const { return category_; }
  std::int32_t GetNumber() const { return number_; }
  std::int32_t GetFlag() const { return flag_; }
  const std::array<UTF16String, 4>& GetReplacements() const { return replacements_; }
  // The localised text with the replacement values filled in.
  UTF16String GetMessage() const;
  const char* what() const noexcept override;

 private:
  ErrorLevel level_;
  std::string key_;
  std::int32_t category_;
  std::int32_t number_;
  std::int32_t flag_;
  std::array<UTF16String, 4> replacements_;
  std::string what_;
};

[[noreturn]] void ThrowError(ErrorLevel level, std::string_view key, std::int32_t category,
                             std::int32_t number, std::int32_t flag = 0,
                             const ReplacementValue& r0 = {}, const ReplacementValue& r1 = {},
                             const ReplacementValue& r2 = {}, const ReplacementValue& r3 = {});

inline constexpr std::string_view kInputContractViolationKey =
    "$$$/velkcore/utility/Error/Contract/InputContractViolation=An input contract violation has "
    "occurred!";
inline constexpr std::string_view kInvalidTypeConversionKey =
    "$$$/velkcore/utility/Error/InvalidTypeConversion=Invalid type conversion.";
inline constexpr std::string_view kSingularMatrixKey =
    "$$$/velkcore/geometry/Error/SingularMatrix=The matrix cannot be inverted.";

inline constexpr std::int32_t kInputContractViolationNumber = 25;
inline constexpr std::int32_t kInvalidTypeConversionNumber = 26;
inline constexpr std::int32_t kSingularMatrixNumber = 0;

// Level 0, category 105, number 25.
[[noreturn]] void ThrowInputContractViolation();
// Raises the contract violation unless `condition` holds.
inline void RequireInput(bool condition) {
  if (!condition) ThrowInputContractViolation();
}
[[noreturn]] void ThrowInvalidTypeConversion();

// A verified down-cast: the invalid type conversion error instead of a wrong pointer.
template <typename To, typename From>
To* CheckedCast(From* from) {
  if (from == nullptr) return nullptr;
  To* to = dynamic_cast<To*>(from);
  if (to == nullptr) ThrowInvalidTypeConversion();
  return to;
}

}  // namespace velkcore
