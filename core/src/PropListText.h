#pragma once

// Text forms shared by the property-list reader and writer.

#include <optional>
#include <string>
#include <string_view>

#include <velkcore/Strings.h>

namespace velkcore::proplist_text {

// Whether XML 1.0 can carry the text as character data (a carriage return
// counts as carriable: it is written as a character reference).
bool IsCarriable(std::string_view utf8);
bool IsCarriable(std::u16string_view utf16);

// Lower-case hex: two digits per byte, four per UTF-16 code unit.
std::string HexOfBytes(std::string_view bytes);
std::string HexOfUnits(std::u16string_view units);
// Null when the text is not exactly such digits (either case).
std::optional<std::string> BytesOfHex(std::string_view hex);
std::optional<UTF16String> UnitsOfHex(std::string_view hex);

// Shortest text that reads back to the same bits; see PropListXML.h.
std::string FormatFloat(float value);
std::string FormatFloat(double value);

// Leading and trailing XML white space is ignored; anything else must be the
// number and nothing more.
std::optional<float> ParseFloat(std::string_view text);
std::optional<double> ParseDouble(std::string_view text);
std::optional<std::int32_t> ParseInt32(std::string_view text);
std::optional<std::uint32_t> ParseUInt32(std::string_view text);
std::optional<std::uint16_t> ParseUInt16(std::string_view text);

bool IsXMLSpace(char c);
bool IsAllXMLSpace(std::string_view text);

}  // namespace velkcore::proplist_text
