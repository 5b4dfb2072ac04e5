#include <velkui/test/FixedMetricsFont.h>

#include <cmath>
#include <string>

#include <velkcore/Error.h>

namespace velkui::test {

FixedMetricsFont::FixedMetricsFont(velkcore::UTF16String family, velkcore::UTF16String style,
                                   float size, float advanceRatio)
    : family_(std::move(family)), style_(std::move(style)), size_(size),
      advanceRatio_(advanceRatio) {}

float FixedMetricsFont::GetAdvance(char16_t unit) const {
  const auto found = advances_.find(unit);
  return found != advances_.end() ? found->second : size_ * advanceRatio_;
}

float FixedMetricsFont::MeasureStringWidth(const char16_t* text, std::int32_t length) const {
  velkcore::RequireInput(text != nullptr);
  const auto actual = static_cast<std::int32_t>(std::char_traits<char16_t>::length(text));
  const std::int32_t count = length < 0 ? actual : std::min(length, actual);
  float width = 0.0f;
  for (std::int32_t i = 0; i < count; ++i) width += GetAdvance(text[i]);
  return width;
}

std::vector<velkcore::UTF16String> FixedMetricsFont::WrapLines(std::u16string_view text,
                                                               float width) const {
  std::vector<velkcore::UTF16String> lines;
  std::size_t start = 0;
  while (start <= text.size()) {
    std::size_t end = text.find(u'\n', start);
    if (end == std::u16string_view::npos) end = text.size();
    std::u16string_view paragraph = text.substr(start, end - start);
    if (width <= 0.0f) {
      lines.emplace_back(paragraph);
    } else {
      // Greedy: the longest run that fits, broken after a space when there is one.
      while (!paragraph.empty()) {
        float used = 0.0f;
        std::size_t fit = 0;
        while (fit < paragraph.size() && used + GetAdvance(paragraph[fit]) <= width) {
          used += GetAdvance(paragraph[fit]);
          ++fit;
        }
        if (fit == paragraph.size()) {
          lines.emplace_back(paragraph);
          break;
        }
        std::size_t cut = paragraph.rfind(u' ', fit);
        cut = (cut == std::u16string_view::npos || cut == 0) ? std::max<std::size_t>(fit, 1)
                                                             : cut + 1;
        lines.emplace_back(paragraph.substr(0, cut));
        paragraph.remove_prefix(cut);
      }
    }
    start = end + 1;
  }
  return lines;
}

float FixedMetricsFont::MeasureMultiLineStringHeight(const char16_t* text, std::int32_t length,
                                                     float width) const {
  velkcore::RequireInput(text != nullptr);
  const auto actual = static_cast<std::int32_t>(std::char_traits<char16_t>::length(text));
  const std::int32_t count = length < 0 ? actual : std::min(length, actual);
  if (count == 0) return 0.0f;
  const auto lines = WrapLines(std::u16string_view(text, static_cast<std::size_t>(count)), width);
  return static_cast<float>(lines.size()) * GetLineHeight();
}

}  // namespace velkui::test
