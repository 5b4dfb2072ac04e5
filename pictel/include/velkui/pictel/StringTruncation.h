#pragma once

#include <cstdint>

#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// The text shortened by `mode` to measure strictly below maxWidth with `font`;
// unchanged when it already fits (width <= maxWidth) or the mode is kNone.
// A surrogate pair is never split.
velkcore::UTF16String TruncateString(const FontInterface& font, const char16_t* text,
                                     TextTruncation mode, float maxWidth);

// The text shortened to `count` units with "..." in the middle: the first 7
// units (when count >= 8), "...", then the tail that fills up to count. A count
// of 0 gives an empty string, a count >= the text's length the text itself.
void GeneratePathEllipsisString(const velkcore::UTF16String& text, std::uint32_t count,
                                velkcore::UTF16String& out);

// Multi-line text is split at the core's platform line ending.
using velkcore::GetLineEnding;

}  // namespace velkui::pictel
