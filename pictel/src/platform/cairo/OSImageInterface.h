#pragma once

#include <cstddef>
#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PictelTypes.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// An image held as a Cairo image surface (ARGB32 or RGB24).
class OSImageInterface : public ImageInterface {
 public:
  explicit OSImageInterface(CairoSurfacePtr surface);

  std::int32_t GetWidth() const override;
  std::int32_t GetHeight() const override;
  cairo_surface_t* GetCairoSurface() const { return surface_.get(); }

 private:
  CairoSurfacePtr surface_;
};

// An image over caller memory: in place for the native layouts, else a copy
// made when the image is created.
class OSImageBufferInterface : public OSImageInterface {
 public:
  // Error 22 for layouts 4, 5 and unknown ones; 29 for a buffer that cannot hold the image.
  static boost::intrusive_ptr<OSImageBufferInterface> Create(std::int32_t width,
                                                             std::int32_t height,
                                                             std::int32_t rowBytes,
                                                             PixelLayout layout, void* pixels,
                                                             BufferDeleter deleter);

 private:
  using OSImageInterface::OSImageInterface;
};

// An image decoded from an encoded file held in memory.
class OSImageFileInterface : public OSImageInterface {
 public:
  // Error 28 for bytes that are not a readable image.
  static boost::intrusive_ptr<OSImageFileInterface> Decode(const void* bytes, std::size_t size,
                                                           ImageFileType type);

 private:
  using OSImageInterface::OSImageInterface;
};

// The caller's deleter runs when Cairo lets go of the surface that uses its pixels.
void AttachDeleter(cairo_surface_t* surface, void* pixels, BufferDeleter deleter);

// Validates a caller buffer description; false when it cannot describe an image.
bool IsUsableBuffer(std::int32_t width, std::int32_t height, std::int32_t rowBytes,
                    PixelLayout layout, const void* pixels);

// A new image surface holding the caller's pixels (shared for native layouts).
CairoSurfacePtr WrapCallerPixels(std::int32_t width, std::int32_t height, std::int32_t rowBytes,
                                 PixelLayout layout, void* pixels, bool* shared);

}  // namespace velkui::pictel::cairo
