#pragma once

#include <cstdint>
#include <string_view>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// The drawing errors: level 1, category 101.
inline constexpr std::int32_t kPictelErrorCategory = velkcore::kCategoryDrawing;

inline constexpr std::string_view kErrorStartupKey =
    "$$$/velkui/pictel/Error/OSSupplier/GDIPlus/Intitialization=Unable to initialize GDI+.";
inline constexpr std::string_view kErrorNotStartedKey =
    "$$$/velkui/pictel/Error/OSSupplier/GDIPlus/NotIntitialized=GDI+ not initialized.";
inline constexpr std::string_view kErrorUnsupportedPixelFormatKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnsupportedPixelFormat=Unsupported Pixel Format.";
inline constexpr std::string_view kErrorUnknownAntiAliasPolicyKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnknownAntiAliasPolicy=Unknown Anti-Alias Policy.";
inline constexpr std::string_view kErrorUnknownInterpolationPolicyKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnknownInterpolationPolicy=Unknown Interpolation Policy.";
inline constexpr std::string_view kErrorUnknownFillTypeKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnknownFillType=Unknown Fill Type.";
inline constexpr std::string_view kErrorUnknownLineCapTypeKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnknownLineCapType=Unknown Line Cap Type.";
inline constexpr std::string_view kErrorUnknownLineJoinTypeKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnknownLineJoinType=Unknown Line Join Type.";
inline constexpr std::string_view kErrorUnableToReadImageFileKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnableToReadImageFile=Unable to read image file.";
inline constexpr std::string_view kErrorUnableToCreateImageBufferKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnableToCreateImageBuffer=Unable to create image buffer.";
inline constexpr std::string_view kErrorUnspecifiedKey =
    "$$$/velkui/pictel/Error/OSSupplier/Unspecified=Unspecified drawing error.";
inline constexpr std::string_view kErrorUnableToCreateSurfaceKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnableToCreateSurface=Unable to create drawing surface.";
inline constexpr std::string_view kErrorUnableToCreateReferenceKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnableToCreateReference=Unable to create drawing "
    "reference.";
inline constexpr std::string_view kErrorUnableToCreateFontKey =
    "$$$/velkui/pictel/Error/OSSupplier/UnableToCreateFont=Unable to load font \"^0\" \"^1\"";
inline constexpr std::string_view kErrorInvalidSurfaceImageKey =
    "$$$/velkui/pictel/Error/OSSupplier/InvalidSurfaceImage=Invalid surface image.";
inline constexpr std::string_view kErrorNoColorManagementCallbackKey =
    "$$$/velkui/pictel/Error/ColorManagement/NoColorManagementCallback=Color management "
    "callback not registered.";

enum PictelErrorNumber : std::int32_t {
  kErrorStartup = 20,
  kErrorNotStarted = 21,
  kErrorUnsupportedPixelFormat = 22,
  kErrorUnknownAntiAliasPolicy = 23,
  kErrorUnknownInterpolationPolicy = 24,
  kErrorUnknownFillType = 25,
  kErrorUnknownLineCapType = 26,
  kErrorUnknownLineJoinType = 27,
  kErrorUnableToReadImageFile = 28,
  kErrorUnableToCreateImageBuffer = 29,
  kErrorUnspecified = 30,
  kErrorUnableToCreateSurface = 31,
  kErrorUnableToCreateReference = 33,
  kErrorUnableToCreateFont = 34,
  kErrorInvalidSurfaceImage = 35,
  kErrorNoColorManagementCallback = 36,
};

// Raises a drawing error (level 1, category 101).
[[noreturn]] void ThrowPictelError(std::string_view key, PictelErrorNumber number,
                                   std::int32_t flag = 1, const velkcore::ReplacementValue& r0 = {},
                                   const velkcore::ReplacementValue& r1 = {});

// Raise 23..27 (or 22) for enumeration values outside their range.
void ValidateAntiAliasPolicy(AntiAliasPolicy policy);
void ValidateInterpolationPolicy(InterpolationPolicy policy);
void ValidateFillType(FillType type);
void ValidateLineCapType(LineCapType type);
void ValidateLineJoinType(LineJoinType type);

}  // namespace velkui::pictel
