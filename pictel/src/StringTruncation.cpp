#include <velkui/pictel/StringTruncation.h>

#include <string>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/pictel/FontInterface.h>

namespace velkui::pictel {

namespace {

using velkcore::UTF16String;

constexpr std::u16string_view kEllipsis = u"...";

bool IsHighSurrogate(char16_t c) {
  return c >= 0xD800 && c <= 0xDBFF;
}
bool IsLowSurrogate(char16_t c) {
  return c >= 0xDC00 && c <= 0xDFFF;
}

// Unit offsets at which a character starts, plus the text's end: cuts made
// only at these offsets never split a surrogate pair.
std::vector<std::size_t> CharacterBoundaries(std::u16string_view text) {
  std::vector<std::size_t> boundaries;
  boundaries.reserve(text.size() + 1);
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (i > 0 && IsLowSurrogate(text[i]) && IsHighSurrogate(text[i - 1])) continue;
    boundaries.push_back(i);
  }
  boundaries.push_back(text.size());
  return boundaries;
}

float Width(const FontInterface& font, std::u16string_view text) {
  const UTF16String terminated(text);
  return font.MeasureStringWidth(terminated.c_str(), static_cast<std::int32_t>(text.size()));
}

// The first index in [first, last) whose width reaches maxWidth (a width
// strictly below moves the search right); `last` when none does.
template <typename WidthAt>
std::size_t FirstReaching(std::size_t first, std::size_t last, float maxWidth,
                          const WidthAt& widthAt) {
  while (first < last) {
    const std::size_t middle = first + (last - first) / 2;
    if (widthAt(middle) < maxWidth) {
      first = middle + 1;
    } else {
      last = middle;
    }
  }
  return first;
}

UTF16String CutAtEnd(const FontInterface& font, std::u16string_view text, float maxWidth) {
  const auto bounds = CharacterBoundaries(text);
  const std::size_t characters = bounds.size() - 1;
  const std::size_t i = FirstReaching(0, characters, maxWidth, [&](std::size_t k) {
    return Width(font, text.substr(0, bounds[k + 1]));
  });
  return UTF16String(text.substr(0, bounds[i]));
}

UTF16String CutAtEndWithEllipsis(const FontInterface& font, std::u16string_view text,
                                 float maxWidth) {
  const auto bounds = CharacterBoundaries(text);
  const std::size_t characters = bounds.size() - 1;
  const auto withEllipsis = [&](std::size_t k) {
    UTF16String candidate(text.substr(0, bounds[k]));
    candidate += kEllipsis;
    return candidate;
  };
  const std::size_t i = FirstReaching(0, characters + 1, maxWidth,
                                      [&](std::size_t k) { return Width(font, withEllipsis(k)); });
  if (i == 0) return {};
  return withEllipsis(i - 1);
}

UTF16String CutInTheMiddle(const FontInterface& font, const UTF16String& text, float maxWidth) {
  // Largest n in 0..length whose path-ellipsis form is strictly narrower.
  std::size_t fits = 0;
  std::size_t low = 1;
  std::size_t high = text.size();
  UTF16String candidate;
  while (low <= high) {
    const std::size_t middle = low + (high - low) / 2;
    GeneratePathEllipsisString(text, static_cast<std::uint32_t>(middle), candidate);
    if (Width(font, candidate) < maxWidth) {
      fits = middle;
      low = middle + 1;
    } else {
      high = middle - 1;
    }
  }
  GeneratePathEllipsisString(text, static_cast<std::uint32_t>(fits), candidate);
  return candidate;
}

}  // namespace

UTF16String TruncateString(const FontInterface& font, const char16_t* text, TextTruncation mode,
                           float maxWidth) {
  velkcore::RequireInput(text != nullptr);
  const UTF16String whole(text);
  if (mode == TextTruncation::kNone) return whole;
  if (font.MeasureStringWidth(text, -1) <= maxWidth) return whole;
  switch (mode) {
    case TextTruncation::kEnd:
      return CutAtEnd(font, whole, maxWidth);
    case TextTruncation::kEndEllipsis:
      return CutAtEndWithEllipsis(font, whole, maxWidth);
    case TextTruncation::kPathEllipsis:
      return CutInTheMiddle(font, whole, maxWidth);
    case TextTruncation::kNone:
      break;
  }
  velkcore::ThrowInputContractViolation();
}

void GeneratePathEllipsisString(const UTF16String& text, std::uint32_t count, UTF16String& out) {
  out.clear();
  if (count == 0) return;
  if (count >= text.size()) {
    out = text;
    return;
  }
  if (count >= 8) {
    std::size_t head = 7;
    if (IsHighSurrogate(text[head - 1])) --head;
    out.assign(text, 0, head);
  }
  out += kEllipsis;
  if (count > out.size()) {
    std::size_t tail = count - out.size();
    std::size_t from = text.size() - tail;
    if (IsLowSurrogate(text[from]) && from > 0 && IsHighSurrogate(text[from - 1])) ++from;
    out.append(text, from, std::u16string::npos);
  }
}

}  // namespace velkui::pictel
