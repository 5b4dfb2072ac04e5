#pragma once

#include <cstdint>
#include <cstdlib>
#include <memory>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>

namespace velkui::ui::platform {

// Zeroed 32-bit BGRA pixels (at least 1 × 1) that become an image of the
// platform supplier, which then owns them.
class PixelBuffer {
 public:
  PixelBuffer(std::int32_t width, std::int32_t height);

  std::int32_t Width() const { return width_; }
  std::int32_t Height() const { return height_; }
  std::int32_t Stride() const { return width_ * 4; }
  unsigned char* Row(std::int32_t y) {
    return pixels_.get() + static_cast<std::ptrdiff_t>(y) * Stride();
  }

  // Hands the pixels over (premultiplied); the buffer is empty afterwards.
  boost::intrusive_ptr<pictel::ImageInterface> ToImage();

 private:
  struct Free {
    void operator()(unsigned char* p) const { std::free(p); }
  };

  std::int32_t width_;
  std::int32_t height_;
  std::unique_ptr<unsigned char, Free> pixels_;
};

}  // namespace velkui::ui::platform
