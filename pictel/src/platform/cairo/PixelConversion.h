#pragma once

#include <cstdint>

#include <velkui/pictel/PictelTypes.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// Bytes per pixel of a caller layout (0 for layouts this backend does not take).
std::int32_t BytesPerPixel(PixelLayout layout);
// Whether Cairo can use caller pixels in place (no shadow copy).
bool IsDirectLayout(PixelLayout layout, std::int32_t rowBytes);
cairo_format_t CairoFormatFor(PixelLayout layout);

// Copies a caller buffer into a Cairo image surface of the same size, and back.
// Only width × bytes-per-pixel bytes of each row are touched.
void CopyIntoCairo(PixelLayout layout, const std::uint8_t* pixels, std::int32_t rowBytes,
                   cairo_surface_t* image);
void CopyFromCairo(cairo_surface_t* image, PixelLayout layout, std::uint8_t* pixels,
                   std::int32_t rowBytes);

}  // namespace velkui::pictel::cairo
