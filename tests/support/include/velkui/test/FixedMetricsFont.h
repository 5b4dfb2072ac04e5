#pragma once

#include <map>

#include <velkcore/Strings.h>
#include <velkui/pictel/FontInterface.h>

namespace velkui::test {

// A font whose measurements are plain arithmetic, for exact layout tests:
// every UTF-16 unit advances by size × advance ratio (unless given its own
// advance), ascent is 0.8 × size, descent 0.2 × size, and wrapped text breaks
// at spaces (or anywhere in a word longer than the width).
class FixedMetricsFont : public pictel::FontInterface {
 public:
  FixedMetricsFont(velkcore::UTF16String family, velkcore::UTF16String style, float size,
                   float advanceRatio = 0.5f);

  float GetAscent() const override { return size_ * 0.8f; }
  float GetDescent() const override { return size_ * 0.2f; }
  float MeasureStringWidth(const char16_t* text, std::int32_t length) const override;
  float MeasureMultiLineStringHeight(const char16_t* text, std::int32_t length,
                                     float width) const override;

  void SetAdvance(char16_t unit, float advance) { advances_[unit] = advance; }
  float GetAdvance(char16_t unit) const;
  float GetLineHeight() const { return size_; }
  float GetSize() const { return size_; }
  const velkcore::UTF16String& GetFamily() const { return family_; }
  const velkcore::UTF16String& GetStyle() const { return style_; }
  // The lines that wrapping `text` to `width` gives (no wrapping for width <= 0).
  std::vector<velkcore::UTF16String> WrapLines(std::u16string_view text, float width) const;

 private:
  velkcore::UTF16String family_;
  velkcore::UTF16String style_;
  float size_;
  float advanceRatio_;
  std::map<char16_t, float> advances_;
};

}  // namespace velkui::test
