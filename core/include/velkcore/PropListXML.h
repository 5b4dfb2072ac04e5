#pragma once

#include <cstdint>
#include <filesystem>
#include <span>
#include <string>
#include <string_view>

#include <velkcore/PropList.h>

namespace velkcore {

// The stored form of a property list:
//
//   <?xml version="1.0" encoding="UTF-8"?>
//   <prop.map version="4">
//     <prop.list>
//       <prop.pair>
//         <key>name</key>
//         value
//       </prop.pair>
//       ...
//     </prop.list>
//   </prop.map>
//
// where a value is one of
//   bool          <true/> or <false/>
//   int32         <int type="signed" size="32">-5</int>
//   uint32        <int type="unsigned" size="32">5</int>
//   uint16        <int type="unsigned" size="16">5</int>
//   float         <float>0.1</float>            (size="32" is accepted too)
//   double        <float size="64">0.1</float>
//   string        <string>UTF-8 text</string>
//   ustring       <ustring>text</ustring>
//   ustring array <array><array.type><ustring/></array.type><ustring>a</ustring>...</array>
//   list          <prop.list>...</prop.list>
//
// Floating-point numbers are written in the shortest text that reads back to
// the same bits; infinities are "inf" and "-inf", the default NaN "nan" or
// "-nan", any other NaN "nan(0x<bits in hex>)". A carriage return is written
// as "&#13;". Text that XML cannot carry (invalid UTF-8, control characters
// other than tab, line feed and carriage return, U+FFFE, U+FFFF, unpaired
// surrogates) is written with encoding="hex": the UTF-8 bytes of a key or
// string, or the UTF-16 code units of a ustring (four digits each).
// Keys are written in byte order; lists nest at most kMaxPropListDepth deep.

inline constexpr std::size_t kMaxPropListDepth = 256;

// Reads a stored property list. Anything that is not exactly the form above
// raises one of the errors below, with the line and column in "^0" and "^1".
PropList ReadPropList(std::string_view xml);
PropList ReadPropList(std::span<const unsigned char> xml);

// Raises kPropListWriteTooDeepKey when lists nest deeper than kMaxPropListDepth.
std::string WritePropList(const PropList& list);

// Writes atomically: a temporary file in the same directory, flushed to disk,
// then renamed over `path`. On failure the old file is left as it was.
void SavePropList(const PropList& list, const std::filesystem::path& path);
// A missing file is an empty list; a file that cannot be read or parsed raises
// kPropListBadFileKey with the path and the reason.
PropList LoadPropList(const std::filesystem::path& path);

inline constexpr std::string_view kPropListUnexpectedElementKey =
    "$$$/velkcore/PropList/Error/UnexpectedElement=Unexpected element <^2> in a property list at "
    "line ^0, column ^1.";
inline constexpr std::string_view kPropListUnexpectedTextKey =
    "$$$/velkcore/PropList/Error/UnexpectedText=Unexpected text in a property list at line ^0, "
    "column ^1.";
inline constexpr std::string_view kPropListUnexpectedAttributeKey =
    "$$$/velkcore/PropList/Error/UnexpectedAttribute=Unexpected attribute '^2' at line ^0, column "
    "^1.";
inline constexpr std::string_view kPropListMissingAttributeKey =
    "$$$/velkcore/PropList/Error/MissingAttribute=Missing attribute '^2' at line ^0, column ^1.";
inline constexpr std::string_view kPropListBadAttributeKey =
    "$$$/velkcore/PropList/Error/BadAttribute=Unknown value '^3' of attribute '^2' at line ^0, "
    "column ^1.";
inline constexpr std::string_view kPropListMissingPartKey =
    "$$$/velkcore/PropList/Error/MissingPart=The <^3> element at line ^0, column ^1 lacks its ^2.";
inline constexpr std::string_view kPropListDuplicateKeyKey =
    "$$$/velkcore/PropList/Error/DuplicateKey=The key '^2' appears twice in one list (line ^0, "
    "column ^1).";
inline constexpr std::string_view kPropListBadNumberKey =
    "$$$/velkcore/PropList/Error/BadNumber=The text '^2' at line ^0, column ^1 is not a valid ^3.";
inline constexpr std::string_view kPropListBadEncodedTextKey =
    "$$$/velkcore/PropList/Error/BadEncodedText=Invalid hex-encoded text at line ^0, column ^1.";
inline constexpr std::string_view kPropListTooDeepKey =
    "$$$/velkcore/PropList/Error/TooDeep=Lists nest deeper than ^2 levels at line ^0, column ^1.";
inline constexpr std::string_view kPropListWriteTooDeepKey =
    "$$$/velkcore/PropList/Error/WriteTooDeep=The list under '^0' nests deeper than ^1 levels and "
    "cannot be stored.";
inline constexpr std::string_view kPropListBadFileKey =
    "$$$/velkcore/PropList/Error/BadFile=Unable to load the property list '^0': ^1";
inline constexpr std::string_view kPropListCannotSaveKey =
    "$$$/velkcore/PropList/Error/CannotSave=Unable to save the property list '^0': ^1";

inline constexpr std::int32_t kPropListUnexpectedElementNumber = 53;
inline constexpr std::int32_t kPropListUnexpectedTextNumber = 54;
inline constexpr std::int32_t kPropListUnexpectedAttributeNumber = 55;
inline constexpr std::int32_t kPropListMissingAttributeNumber = 56;
inline constexpr std::int32_t kPropListBadAttributeNumber = 57;
inline constexpr std::int32_t kPropListMissingPartNumber = 58;
inline constexpr std::int32_t kPropListDuplicateKeyNumber = 59;
inline constexpr std::int32_t kPropListBadNumberNumber = 60;
inline constexpr std::int32_t kPropListBadEncodedTextNumber = 61;
inline constexpr std::int32_t kPropListTooDeepNumber = 62;
inline constexpr std::int32_t kPropListWriteTooDeepNumber = 63;
inline constexpr std::int32_t kPropListBadFileNumber = 64;
inline constexpr std::int32_t kPropListCannotSaveNumber = 65;

}  // namespace velkcore
