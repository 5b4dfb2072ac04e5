#pragma once

#include <cstdint>
#include <ostream>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/MemBuffer.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::test {

// One pixel as straight-alpha bytes.
struct Pixel {
  std::uint8_t red = 0;
  std::uint8_t green = 0;
  std::uint8_t blue = 0;
  std::uint8_t alpha = 0;

  friend bool operator==(const Pixel&, const Pixel&) = default;
};
std::ostream& operator<<(std::ostream& out, const Pixel& pixel);

// Reads back the pixels of an image (or of a surface's image) made by the
// platform supplier.
class PixelProbe {
 public:
  explicit PixelProbe(const pictel::ImageInterface& image);
  explicit PixelProbe(pictel::SurfaceInterface& surface);

  std::int32_t GetWidth() const { return pixels_->GetWidth(); }
  std::int32_t GetHeight() const { return pixels_->GetHeight(); }
  Pixel At(std::int32_t x, std::int32_t y) const;
  // Number of pixels in the rectangle (clipped to the image) equal to `pixel`.
  std::int32_t Count(const Pixel& pixel, std::int32_t left, std::int32_t top, std::int32_t width,
                     std::int32_t height) const;
  // Pixels of the whole image that are not fully transparent.
  std::int32_t CountVisible() const;

 private:
  boost::intrusive_ptr<pictel::MemBuffer> pixels_;
};

}  // namespace velkui::test
