#include "OSFontInterface.h"

#include <algorithm>
#include <cmath>
#include <string>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>

#include "TextEngine.h"

namespace velkui::pictel::cairo {

namespace {

std::int32_t ClampedLength(const char16_t* text, std::int32_t length) {
  // Never read past the terminating zero, whatever length the caller claims.
  const auto actual = static_cast<std::int32_t>(std::char_traits<char16_t>::length(text));
  return length < 0 ? actual : std::min(length, actual);
}

float FromPango(int units) {
  return static_cast<float>(units) / PANGO_SCALE;
}

}  // namespace

boost::intrusive_ptr<OSFontInterface> OSFontInterface::Create(const velkcore::UTF16String& family,
                                                              const velkcore::UTF16String& style,
                                                              float size) {
  velkcore::RequireInput(std::isfinite(size) && size > 0.0f && size < 10000.0f);
  TextEngine& engine = TextEngine::Get();
  const std::string familyName = velkcore::UTF16to8(family);
  if (familyName.empty() || !engine.HasFamily(familyName)) {
    ThrowPictelError(kErrorUnableToCreateFontKey, kErrorUnableToCreateFont, 1, family, style);
  }
  FontDescriptionPtr description(pango_font_description_new());
  pango_font_description_set_family(description.get(), familyName.c_str());
  const bool bold = style == u"Bold" || style == u"Bold Italic";
  const bool italic = style == u"Italic" || style == u"Bold Italic";
  pango_font_description_set_weight(description.get(),
                                    bold ? PANGO_WEIGHT_BOLD : PANGO_WEIGHT_NORMAL);
  pango_font_description_set_style(description.get(),
                                   italic ? PANGO_STYLE_ITALIC : PANGO_STYLE_NORMAL);
  pango_font_description_set_absolute_size(description.get(),
                                           static_cast<double>(size) * PANGO_SCALE);
  return boost::intrusive_ptr<OSFontInterface>(new OSFontInterface(std::move(description)));
}

OSFontInterface::OSFontInterface(FontDescriptionPtr description)
    : description_(std::move(description)) {
  PangoContext* context = TextEngine::Get().GetContext(true);
  PangoFontMetrics* metrics =
      pango_context_get_metrics(context, description_.get(), pango_context_get_language(context));
  ascent_ = FromPango(pango_font_metrics_get_ascent(metrics));
  descent_ = FromPango(pango_font_metrics_get_descent(metrics));
  pango_font_metrics_unref(metrics);
}

PangoLayout* OSFontInterface::Layout(const char16_t* text, std::int32_t length, bool antiAliased,
                                     float wrapWidth) const {
  PangoLayoutPtr& layout = antiAliased ? smoothLayout_ : monoLayout_;
  if (!layout) {
    layout.reset(pango_layout_new(TextEngine::Get().GetContext(antiAliased)));
    pango_layout_set_font_description(layout.get(), description_.get());
    pango_layout_set_wrap(layout.get(), PANGO_WRAP_WORD_CHAR);
  }
  const std::string utf8 =
      velkcore::UTF16to8(std::u16string_view(text, ClampedLength(text, length)));
  pango_layout_set_text(layout.get(), utf8.data(), static_cast<int>(utf8.size()));
  const bool wraps = wrapWidth > 0.0f && wrapWidth < 1.0e6f;
  pango_layout_set_width(layout.get(),
                         wraps ? static_cast<int>(std::lround(wrapWidth * PANGO_SCALE)) : -1);
  pango_layout_set_alignment(layout.get(), PANGO_ALIGN_LEFT);
  return layout.get();
}

float OSFontInterface::MeasureStringWidth(const char16_t* text, std::int32_t length) const {
  velkcore::RequireInput(text != nullptr);
  if (ClampedLength(text, length) == 0) return 0.0f;
  PangoRectangle logical;
  pango_layout_get_extents(Layout(text, length, true), nullptr, &logical);
  return FromPango(logical.width);
}

float OSFontInterface::MeasureMultiLineStringHeight(const char16_t* text, std::int32_t length,
                                                    float width) const {
  velkcore::RequireInput(text != nullptr);
  if (ClampedLength(text, length) == 0) return 0.0f;
  PangoRectangle logical;
  pango_layout_get_extents(Layout(text, length, true, width), nullptr, &logical);
  return FromPango(logical.height);
}

}  // namespace velkui::pictel::cairo
