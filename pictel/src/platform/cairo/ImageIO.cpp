#include <velkui/pictel/ImageIO.h>

#include <fstream>

#include <velkui/pictel/PictelErrors.h>

#include "OSImageInterface.h"
#include "PixelConversion.h"

namespace velkui::pictel {

namespace {

[[noreturn]] void ThrowUnspecified() {
  ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
}

const cairo::OSImageInterface& PlatformImage(const ImageInterface& image) {
  const auto* platform = dynamic_cast<const cairo::OSImageInterface*>(&image);
  if (platform == nullptr) ThrowUnspecified();
  return *platform;
}

cairo_status_t AppendToVector(void* closure, const unsigned char* data, unsigned int length) {
  auto* bytes = static_cast<std::vector<std::uint8_t>*>(closure);
  bytes->insert(bytes->end(), data, data + length);
  return CAIRO_STATUS_SUCCESS;
}

}  // namespace

std::vector<std::uint8_t> EncodeImageAsPNG(const ImageInterface& image) {
  cairo_surface_t* surface = PlatformImage(image).GetCairoSurface();
  cairo_surface_flush(surface);
  std::vector<std::uint8_t> bytes;
  if (cairo_surface_write_to_png_stream(surface, AppendToVector, &bytes) != CAIRO_STATUS_SUCCESS) {
    ThrowUnspecified();
  }
  return bytes;
}

void WriteImageToPNGFile(const ImageInterface& image, const std::filesystem::path& file) {
  const std::vector<std::uint8_t> bytes = EncodeImageAsPNG(image);
  std::ofstream out(file, std::ios::binary | std::ios::trunc);
  out.write(reinterpret_cast<const char*>(bytes.data()),
            static_cast<std::streamsize>(bytes.size()));
  out.close();
  if (!out) ThrowUnspecified();
}

boost::intrusive_ptr<MemBuffer> CopyImagePixels(const ImageInterface& image, PixelLayout layout) {
  cairo_surface_t* surface = PlatformImage(image).GetCairoSurface();
  const std::int32_t bytesPerPixel = cairo::BytesPerPixel(layout);
  if (bytesPerPixel == 0) {
    ThrowPictelError(kErrorUnsupportedPixelFormatKey, kErrorUnsupportedPixelFormat);
  }
  const std::int32_t width = cairo_image_surface_get_width(surface);
  const std::int32_t height = cairo_image_surface_get_height(surface);
  auto buffer = velkcore::MakeIntrusive<MemBuffer>(width, height, width * bytesPerPixel, layout);
  buffer->Alloc();
  cairo::CopyFromCairo(surface, layout, buffer->GetData(), buffer->GetRowBytes());
  return buffer;
}

}  // namespace velkui::pictel
