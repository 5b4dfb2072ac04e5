#include "OSImageInterface.h"

#include <cstring>
#include <limits>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>

#include "PixelConversion.h"

namespace velkui::pictel::cairo {

namespace {

const cairo_user_data_key_t kDeleterKey{};

struct DeleterHolder {
  void* pixels;
  BufferDeleter deleter;
};

void RunDeleter(void* data) {
  std::unique_ptr<DeleterHolder> holder(static_cast<DeleterHolder*>(data));
  if (holder->deleter) holder->deleter(holder->pixels);
}

struct MemoryReader {
  const unsigned char* data;
  std::size_t size;
  std::size_t offset;
};

cairo_status_t ReadFromMemory(void* closure, unsigned char* buffer, unsigned int length) {
  auto* reader = static_cast<MemoryReader*>(closure);
  if (reader->size - reader->offset < length) return CAIRO_STATUS_READ_ERROR;
  std::memcpy(buffer, reader->data + reader->offset, length);
  reader->offset += length;
  return CAIRO_STATUS_SUCCESS;
}

bool StartsLikePNG(const void* bytes, std::size_t size) {
  static constexpr unsigned char kSignature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
  return size >= sizeof kSignature && std::memcmp(bytes, kSignature, sizeof kSignature) == 0;
}

// Decoded images are kept as ARGB32 or RGB24, the formats drawing and pixel
// copies expect.
CairoSurfacePtr AsColorImage(CairoSurfacePtr decoded) {
  const cairo_format_t format = cairo_image_surface_get_format(decoded.get());
  if (format == CAIRO_FORMAT_ARGB32 || format == CAIRO_FORMAT_RGB24) return decoded;
  CairoSurfacePtr converted(
      cairo_image_surface_create(CAIRO_FORMAT_ARGB32, cairo_image_surface_get_width(decoded.get()),
                                 cairo_image_surface_get_height(decoded.get())));
  CairoContextPtr context(cairo_create(converted.get()));
  cairo_set_source_surface(context.get(), decoded.get(), 0, 0);
  cairo_paint(context.get());
  return converted;
}

}  // namespace

OSImageInterface::OSImageInterface(CairoSurfacePtr surface) : surface_(std::move(surface)) {}

std::int32_t OSImageInterface::GetWidth() const {
  return cairo_image_surface_get_width(surface_.get());
}

std::int32_t OSImageInterface::GetHeight() const {
  return cairo_image_surface_get_height(surface_.get());
}

void AttachDeleter(cairo_surface_t* surface, void* pixels, BufferDeleter deleter) {
  auto holder = std::make_unique<DeleterHolder>(DeleterHolder{pixels, std::move(deleter)});
  if (cairo_surface_set_user_data(surface, &kDeleterKey, holder.get(), RunDeleter) ==
      CAIRO_STATUS_SUCCESS) {
    holder.release();
  }
}

bool IsUsableBuffer(std::int32_t width, std::int32_t height, std::int32_t rowBytes,
                    PixelLayout layout, const void* pixels) {
  const std::int32_t bytes = BytesPerPixel(layout);
  if (pixels == nullptr || width <= 0 || height <= 0 || bytes == 0) return false;
  // Cairo's own limit on image sides.
  constexpr std::int32_t kMaximumSide = 32767;
  if (width > kMaximumSide || height > kMaximumSide) return false;
  return rowBytes >= static_cast<std::int64_t>(width) * bytes;
}

CairoSurfacePtr WrapCallerPixels(std::int32_t width, std::int32_t height, std::int32_t rowBytes,
                                 PixelLayout layout, void* pixels, bool* shared) {
  const cairo_format_t format = CairoFormatFor(layout);
  *shared = IsDirectLayout(layout, rowBytes);
  if (*shared) {
    return CairoSurfacePtr(cairo_image_surface_create_for_data(static_cast<unsigned char*>(pixels),
                                                               format, width, height, rowBytes));
  }
  CairoSurfacePtr shadow(cairo_image_surface_create(format, width, height));
  if (cairo_surface_status(shadow.get()) == CAIRO_STATUS_SUCCESS) {
    CopyIntoCairo(layout, static_cast<const std::uint8_t*>(pixels), rowBytes, shadow.get());
  }
  return shadow;
}

boost::intrusive_ptr<OSImageBufferInterface> OSImageBufferInterface::Create(
    std::int32_t width, std::int32_t height, std::int32_t rowBytes, PixelLayout layout,
    void* pixels, BufferDeleter deleter) {
  if (BytesPerPixel(layout) == 0 || layout == PixelLayout::kARGB ||
      layout == PixelLayout::kARGBPremultiplied) {
    ThrowPictelError(kErrorUnsupportedPixelFormatKey, kErrorUnsupportedPixelFormat);
  }
  if (!IsUsableBuffer(width, height, rowBytes, layout, pixels)) {
    ThrowPictelError(kErrorUnableToCreateImageBufferKey, kErrorUnableToCreateImageBuffer);
  }
  bool shared = false;
  CairoSurfacePtr surface = WrapCallerPixels(width, height, rowBytes, layout, pixels, &shared);
  if (cairo_surface_status(surface.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowPictelError(kErrorUnableToCreateImageBufferKey, kErrorUnableToCreateImageBuffer);
  }
  AttachDeleter(surface.get(), pixels, std::move(deleter));
  return boost::intrusive_ptr<OSImageBufferInterface>(
      new OSImageBufferInterface(std::move(surface)));
}

boost::intrusive_ptr<OSImageFileInterface> OSImageFileInterface::Decode(const void* bytes,
                                                                        std::size_t size,
                                                                        ImageFileType type) {
  if (bytes == nullptr || type != ImageFileType::kPNG || !StartsLikePNG(bytes, size)) {
    ThrowPictelError(kErrorUnableToReadImageFileKey, kErrorUnableToReadImageFile);
  }
  MemoryReader reader{static_cast<const unsigned char*>(bytes), size, 0};
  CairoSurfacePtr decoded(cairo_image_surface_create_from_png_stream(ReadFromMemory, &reader));
  if (cairo_surface_status(decoded.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowPictelError(kErrorUnableToReadImageFileKey, kErrorUnableToReadImageFile);
  }
  return boost::intrusive_ptr<OSImageFileInterface>(
      new OSImageFileInterface(AsColorImage(std::move(decoded))));
}

}  // namespace velkui::pictel::cairo
