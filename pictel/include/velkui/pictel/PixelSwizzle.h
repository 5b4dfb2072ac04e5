#pragma once

#include <cstddef>

#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// In-place conversion of `count` four-byte pixels between the layouts
// kARGB (4), kARGBPremultiplied (5) and kBGRA (6). The defined members:
//   <4, 5> premultiply, <5, 4> un-premultiply (clamped to 255),
//   <4, 6> and <6, 4> reverse the byte order.
template <PixelLayout From, PixelLayout To>
void inplace_swizzle(void* pixels, std::size_t count) = delete;

template <>
void inplace_swizzle<PixelLayout::kARGB, PixelLayout::kARGBPremultiplied>(void* pixels,
                                                                          std::size_t count);
template <>
void inplace_swizzle<PixelLayout::kARGBPremultiplied, PixelLayout::kARGB>(void* pixels,
                                                                          std::size_t count);
template <>
void inplace_swizzle<PixelLayout::kARGB, PixelLayout::kBGRA>(void* pixels, std::size_t count);
template <>
void inplace_swizzle<PixelLayout::kBGRA, PixelLayout::kARGB>(void* pixels, std::size_t count);

}  // namespace velkui::pictel
