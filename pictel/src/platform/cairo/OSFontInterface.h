#pragma once

#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/FontInterface.h>
#include <velkui/pictel/PictelTypes.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// A Pango font description with its metrics and two reusable layouts.
class OSFontInterface : public FontInterface {
 public:
  // Raises error 34 (family, style) when the font configuration lacks the family.
  static boost::intrusive_ptr<OSFontInterface> Create(const velkcore::UTF16String& family,
                                                      const velkcore::UTF16String& style,
                                                      float size);

  float GetAscent() const override { return ascent_; }
  float GetDescent() const override { return descent_; }
  float MeasureStringWidth(const char16_t* text, std::int32_t length) const override;
  float MeasureMultiLineStringHeight(const char16_t* text, std::int32_t length,
                                     float width) const override;

  // A layout holding the first `length` units of `text` (-1: all), wrapped to
  // `wrapWidth` when it is positive. Valid until the next call.
  PangoLayout* Layout(const char16_t* text, std::int32_t length, bool antiAliased,
                      float wrapWidth = -1.0f) const;

 private:
  explicit OSFontInterface(FontDescriptionPtr description);

  FontDescriptionPtr description_;
  float ascent_ = 0.0f;
  float descent_ = 0.0f;
  mutable PangoLayoutPtr smoothLayout_;
  mutable PangoLayoutPtr monoLayout_;
};

}  // namespace velkui::pictel::cairo
