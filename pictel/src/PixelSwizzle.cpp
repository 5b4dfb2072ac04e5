#include <velkui/pictel/PixelSwizzle.h>

#include <algorithm>
#include <cstdint>
#include <utility>

namespace velkui::pictel {

namespace {

std::uint8_t Premultiplied(std::uint8_t value, std::uint8_t alpha) {
  return static_cast<std::uint8_t>(static_cast<double>(value) * alpha / 255.0);
}

// A colour byte larger than its alpha (invalid premultiplied data) would give
// more than 255: it saturates instead of wrapping.
std::uint8_t Unpremultiplied(std::uint8_t value, std::uint8_t alpha) {
  const double straight = static_cast<double>(value) / (alpha / 255.0);
  return static_cast<std::uint8_t>(std::min(straight, 255.0));
}

void ReverseEachPixel(void* pixels, std::size_t count) {
  auto* bytes = static_cast<std::uint8_t*>(pixels);
  for (std::size_t i = 0; i < count; ++i, bytes += 4) {
    std::swap(bytes[0], bytes[3]);
    std::swap(bytes[1], bytes[2]);
  }
}

}  // namespace

template <>
void inplace_swizzle<PixelLayout::kARGB, PixelLayout::kARGBPremultiplied>(void* pixels,
                                                                          std::size_t count) {
  auto* bytes = static_cast<std::uint8_t*>(pixels);
  for (std::size_t i = 0; i < count; ++i, bytes += 4) {
    const std::uint8_t alpha = bytes[0];
    if (alpha == 255) continue;
    for (int c = 1; c < 4; ++c) bytes[c] = Premultiplied(bytes[c], alpha);
  }
}

template <>
void inplace_swizzle<PixelLayout::kARGBPremultiplied, PixelLayout::kARGB>(void* pixels,
                                                                          std::size_t count) {
  auto* bytes = static_cast<std::uint8_t*>(pixels);
  for (std::size_t i = 0; i < count; ++i, bytes += 4) {
    const std::uint8_t alpha = bytes[0];
    if (alpha == 255 || alpha == 0) continue;
    for (int c = 1; c < 4; ++c) bytes[c] = Unpremultiplied(bytes[c], alpha);
  }
}

template <>
void inplace_swizzle<PixelLayout::kARGB, PixelLayout::kBGRA>(void* pixels, std::size_t count) {
  ReverseEachPixel(pixels, count);
}

template <>
void inplace_swizzle<PixelLayout::kBGRA, PixelLayout::kARGB>(void* pixels, std::size_t count) {
  ReverseEachPixel(pixels, count);
}

}  // namespace velkui::pictel
