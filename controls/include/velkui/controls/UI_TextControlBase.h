#pragma once

#include <cstdint>

#include <velkcore/Flags.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::controls {

// The text settings that text-showing controls share: font, label text,
// alignment, truncation, how many characters the recommended size is
// measured for, and a flag word. A font size of 0 and an empty font name
// mean the control font of the theme.
class UI_TextControlBase {
 public:
  UI_TextControlBase() = default;
  UI_TextControlBase(const UI_TextControlBase&) = default;
  UI_TextControlBase& operator=(const UI_TextControlBase&) = default;
  virtual ~UI_TextControlBase() = default;

  const velkcore::UTF16String& GetFontName() const { return fontName_; }
  void SetFontName(const velkcore::UTF16String& name);
  // The font size in pixels; 0 is the theme's control text size.
  float GetFontSize() const { return fontSize_; }
  // Negative or non-finite sizes are an input-contract violation.
  void SetFontSize(float size);
  const velkcore::UTF16String& GetFontStyleName() const { return fontStyleName_; }
  void SetFontStyleName(const velkcore::UTF16String& style);
  const velkcore::UTF16String& GetLabelText() const { return labelText_; }
  virtual void SetLabelText(const velkcore::UTF16String& text);
  pictel::TextAlignment GetTextAlignment() const { return textAlignment_; }
  void SetTextAlignment(pictel::TextAlignment alignment);
  pictel::TextTruncation GetTextTruncation() const { return truncation_; }
  void SetTextTruncation(pictel::TextTruncation truncation);
  std::int32_t GetMeasureCharacters() const { return measureCharacters_; }
  void SetMeasureCharacters(std::int32_t count);
  velkcore::Flags<std::uint8_t> GetTextControlFlags() const { return flags_; }
  void SetTextControlFlags(velkcore::Flags<std::uint8_t> flags);

  // The size to draw with: the own size, else the theme's control text size.
  float GetEffectiveFontSize() const;

 protected:
  // Called after any setting changed (controls redraw).
  virtual void TextSettingsChanged() {}

 private:
  velkcore::UTF16String fontName_;
  float fontSize_ = 0;
  velkcore::UTF16String fontStyleName_;
  velkcore::UTF16String labelText_;
  pictel::TextAlignment textAlignment_ = pictel::TextAlignment::kStart;
  pictel::TextTruncation truncation_ = pictel::TextTruncation::kEndEllipsis;
  std::int32_t measureCharacters_ = 0;
  velkcore::Flags<std::uint8_t> flags_;
};

}  // namespace velkui::controls
