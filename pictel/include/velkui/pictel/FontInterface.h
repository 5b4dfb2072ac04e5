#pragma once

#include <cstdint>

#include <velkcore/RefCountedObject.h>

namespace velkui::pictel {

// A font of one family, style and pixel size. Text is zero-terminated UTF-16;
// a length of -1 means "up to the terminating zero".
class FontInterface : public virtual velkcore::RefCountedObject {
 public:
  ~FontInterface() override = default;

  // In pixels: the face's ascent and descent scaled to the font size.
  virtual float GetAscent() const = 0;
  virtual float GetDescent() const = 0;
  virtual float MeasureStringWidth(const char16_t* text, std::int32_t length) const = 0;
  virtual float MeasureMultiLineStringHeight(const char16_t* text, std::int32_t length,
                                             float width) const = 0;
};

}  // namespace velkui::pictel
