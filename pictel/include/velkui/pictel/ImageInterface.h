#pragma once

#include <cstdint>

#include <velkcore/RefCountedObject.h>

namespace velkui::pictel {

class ImageInterface : public virtual velkcore::RefCountedObject {
 public:
  ~ImageInterface() override = default;

  // In whole pixels.
  virtual std::int32_t GetWidth() const = 0;
  virtual std::int32_t GetHeight() const = 0;
};

}  // namespace velkui::pictel
