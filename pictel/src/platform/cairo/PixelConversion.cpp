#include "PixelConversion.h"

#include <algorithm>
#include <bit>
#include <cstring>

namespace velkui::pictel::cairo {

namespace {

constexpr bool kLittleEndian = std::endian::native == std::endian::little;

std::uint32_t Premultiply(std::uint32_t channel, std::uint32_t alpha) {
  return (channel * alpha + 127) / 255;
}

std::uint32_t Unpremultiply(std::uint32_t channel, std::uint32_t alpha) {
  if (alpha == 0) return 0;
  return std::min<std::uint32_t>(255, (channel * 255 + alpha / 2) / alpha);
}

std::uint32_t Pack(std::uint32_t a, std::uint32_t r, std::uint32_t g, std::uint32_t b) {
  return (a << 24) | (r << 16) | (g << 8) | b;
}

// Cairo's ARGB32 and RGB24 are native-endian 32-bit words 0xAARRGGBB.
std::uint32_t ToWord(PixelLayout layout, const std::uint8_t* p) {
  switch (layout) {
    case PixelLayout::kBGR:
      return Pack(255, p[2], p[1], p[0]);
    case PixelLayout::kBGRX:
      return Pack(255, p[2], p[1], p[0]);
    case PixelLayout::kBGRA:
      return Pack(p[3], Premultiply(p[2], p[3]), Premultiply(p[1], p[3]), Premultiply(p[0], p[3]));
    case PixelLayout::kBGRAPremultiplied:
      return Pack(p[3], p[2], p[1], p[0]);
    case PixelLayout::kARGB:
      return Pack(p[0], Premultiply(p[1], p[0]), Premultiply(p[2], p[0]), Premultiply(p[3], p[0]));
    case PixelLayout::kARGBPremultiplied:
      return Pack(p[0], p[1], p[2], p[3]);
  }
  return 0;
}

void FromWord(std::uint32_t word, bool hasAlpha, PixelLayout layout, std::uint8_t* p) {
  const std::uint32_t a = hasAlpha ? word >> 24 : 255;
  const std::uint32_t r = (word >> 16) & 0xFF;
  const std::uint32_t g = (word >> 8) & 0xFF;
  const std::uint32_t b = word & 0xFF;
  const auto byte = [](std::uint32_t v) { return static_cast<std::uint8_t>(v); };
  switch (layout) {
    case PixelLayout::kBGR:
      p[0] = byte(b), p[1] = byte(g), p[2] = byte(r);
      return;
    case PixelLayout::kBGRX:
      p[0] = byte(b), p[1] = byte(g), p[2] = byte(r), p[3] = 255;
      return;
    case PixelLayout::kBGRA:
      p[0] = byte(Unpremultiply(b, a)), p[1] = byte(Unpremultiply(g, a));
      p[2] = byte(Unpremultiply(r, a)), p[3] = byte(a);
      return;
    case PixelLayout::kBGRAPremultiplied:
      p[0] = byte(b), p[1] = byte(g), p[2] = byte(r), p[3] = byte(a);
      return;
    case PixelLayout::kARGB:
      p[0] = byte(a), p[1] = byte(Unpremultiply(r, a)), p[2] = byte(Unpremultiply(g, a));
      p[3] = byte(Unpremultiply(b, a));
      return;
    case PixelLayout::kARGBPremultiplied:
      p[0] = byte(a), p[1] = byte(r), p[2] = byte(g), p[3] = byte(b);
      return;
  }
}

}  // namespace

std::int32_t BytesPerPixel(PixelLayout layout) {
  switch (layout) {
    case PixelLayout::kBGR:
      return 3;
    case PixelLayout::kBGRX:
    case PixelLayout::kARGB:
    case PixelLayout::kARGBPremultiplied:
    case PixelLayout::kBGRA:
    case PixelLayout::kBGRAPremultiplied:
      return 4;
  }
  return 0;
}

bool IsDirectLayout(PixelLayout layout, std::int32_t rowBytes) {
  const bool nativeLayout =
      layout == PixelLayout::kBGRAPremultiplied || layout == PixelLayout::kBGRX;
  return kLittleEndian && nativeLayout && rowBytes % 4 == 0;
}

cairo_format_t CairoFormatFor(PixelLayout layout) {
  return layout == PixelLayout::kBGRX || layout == PixelLayout::kBGR ? CAIRO_FORMAT_RGB24
                                                                     : CAIRO_FORMAT_ARGB32;
}

void CopyIntoCairo(PixelLayout layout, const std::uint8_t* pixels, std::int32_t rowBytes,
                   cairo_surface_t* image) {
  cairo_surface_flush(image);
  const int width = cairo_image_surface_get_width(image);
  const int height = cairo_image_surface_get_height(image);
  const int stride = cairo_image_surface_get_stride(image);
  std::uint8_t* data = cairo_image_surface_get_data(image);
  const std::int32_t bytes = BytesPerPixel(layout);
  for (int y = 0; y < height; ++y) {
    const std::uint8_t* source = pixels + static_cast<std::ptrdiff_t>(y) * rowBytes;
    auto* target = reinterpret_cast<std::uint32_t*>(data + static_cast<std::ptrdiff_t>(y) * stride);
    for (int x = 0; x < width; ++x) target[x] = ToWord(layout, source + x * bytes);
  }
  cairo_surface_mark_dirty(image);
}

void CopyFromCairo(cairo_surface_t* image, PixelLayout layout, std::uint8_t* pixels,
                   std::int32_t rowBytes) {
  cairo_surface_flush(image);
  const int width = cairo_image_surface_get_width(image);
  const int height = cairo_image_surface_get_height(image);
  const int stride = cairo_image_surface_get_stride(image);
  const bool hasAlpha = cairo_image_surface_get_format(image) == CAIRO_FORMAT_ARGB32;
  const std::uint8_t* data = cairo_image_surface_get_data(image);
  const std::int32_t bytes = BytesPerPixel(layout);
  for (int y = 0; y < height; ++y) {
    const auto* source =
        reinterpret_cast<const std::uint32_t*>(data + static_cast<std::ptrdiff_t>(y) * stride);
    std::uint8_t* target = pixels + static_cast<std::ptrdiff_t>(y) * rowBytes;
    for (int x = 0; x < width; ++x) FromWord(source[x], hasAlpha, layout, target + x * bytes);
  }
}

}  // namespace velkui::pictel::cairo
