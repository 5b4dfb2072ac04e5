#include <velkui/controls/UI_TextControlBase.h>

#include <cmath>

#include <velkcore/Error.h>
#include <velkui/controls/UI_ControlView.h>
#include <velkui/ui/Theme.h>

namespace velkui::controls {

void UI_TextControlBase::SetFontName(const velkcore::UTF16String& name) {
  if (fontName_ == name) return;
  fontName_ = name;
  TextSettingsChanged();
}

void UI_TextControlBase::SetFontSize(float size) {
  velkcore::RequireInput(std::isfinite(size) && size >= 0);
  if (fontSize_ == size) return;
  fontSize_ = size;
  TextSettingsChanged();
}

void UI_TextControlBase::SetFontStyleName(const velkcore::UTF16String& style) {
  if (fontStyleName_ == style) return;
  fontStyleName_ = style;
  TextSettingsChanged();
}

void UI_TextControlBase::SetLabelText(const velkcore::UTF16String& text) {
  if (labelText_ == text) return;
  labelText_ = text;
  TextSettingsChanged();
}

void UI_TextControlBase::SetTextAlignment(pictel::TextAlignment alignment) {
  if (textAlignment_ == alignment) return;
  textAlignment_ = alignment;
  TextSettingsChanged();
}

void UI_TextControlBase::SetTextTruncation(pictel::TextTruncation truncation) {
  if (truncation_ == truncation) return;
  truncation_ = truncation;
  TextSettingsChanged();
}

void UI_TextControlBase::SetMeasureCharacters(std::int32_t count) {
  velkcore::RequireInput(count >= 0);
  measureCharacters_ = count;
  TextSettingsChanged();
}

void UI_TextControlBase::SetTextControlFlags(velkcore::Flags<std::uint8_t> flags) {
  if (flags_ == flags) return;
  flags_ = flags;
  TextSettingsChanged();
}

float UI_TextControlBase::GetEffectiveFontSize() const {
  return fontSize_ > 0 ? fontSize_ : UI_ControlView::DefaultTextSize();
}

}  // namespace velkui::controls
