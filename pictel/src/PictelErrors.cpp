#include <velkui/pictel/PictelErrors.h>

namespace velkui::pictel {

void ThrowPictelError(std::string_view key, PictelErrorNumber number, std::int32_t flag,
                      const velkcore::ReplacementValue& r0, const velkcore::ReplacementValue& r1) {
  velkcore::ThrowError(velkcore::ErrorLevel::kError, key, kPictelErrorCategory, number, flag, r0,
                       r1);
}

namespace {

template <typename Enum>
bool IsInRange(Enum value, std::int32_t last) {
  const auto n = static_cast<std::int32_t>(value);
  return n >= 0 && n <= last;
}

}  // namespace

void ValidateAntiAliasPolicy(AntiAliasPolicy policy) {
  if (!IsInRange(policy, 2)) {
    ThrowPictelError(kErrorUnknownAntiAliasPolicyKey, kErrorUnknownAntiAliasPolicy);
  }
}

void ValidateInterpolationPolicy(InterpolationPolicy policy) {
  if (!IsInRange(policy, 2)) {
    ThrowPictelError(kErrorUnknownInterpolationPolicyKey, kErrorUnknownInterpolationPolicy);
  }
}

void ValidateFillType(FillType type) {
  if (!IsInRange(type, 1)) ThrowPictelError(kErrorUnknownFillTypeKey, kErrorUnknownFillType);
}

void ValidateLineCapType(LineCapType type) {
  if (!IsInRange(type, 2)) ThrowPictelError(kErrorUnknownLineCapTypeKey, kErrorUnknownLineCapType);
}

void ValidateLineJoinType(LineJoinType type) {
  if (!IsInRange(type, 2)) {
    ThrowPictelError(kErrorUnknownLineJoinTypeKey, kErrorUnknownLineJoinType);
  }
}

}  // namespace velkui::pictel
