#include "PixelBuffer.h"

#include <algorithm>
#include <new>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::ui::platform {

PixelBuffer::PixelBuffer(std::int32_t width, std::int32_t height)
    : width_(std::max(width, 1)), height_(std::max(height, 1)) {
  // calloc: the image's deleter frees the pixels with free().
  pixels_.reset(
      static_cast<unsigned char*>(std::calloc(static_cast<std::size_t>(Stride()) * height_, 1)));
  if (!pixels_) throw std::bad_alloc();
}

boost::intrusive_ptr<pictel::ImageInterface> PixelBuffer::ToImage() {
  const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  auto image =
      supplier->NewBufferImage(width_, height_, Stride(), pictel::PixelLayout::kBGRAPremultiplied,
                               pixels_.get(), [](void* p) { std::free(p); });
  pixels_.release();
  return image;
}

}  // namespace velkui::ui::platform
