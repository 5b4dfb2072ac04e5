#pragma once

#include <cstdint>
#include <filesystem>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/MemBuffer.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// These work on images made by the platform supplier (error 30 for others).

// The image encoded as PNG.
std::vector<std::uint8_t> EncodeImageAsPNG(const ImageInterface& image);
// Writes the image as a PNG file (error 30 when the file cannot be written).
void WriteImageToPNGFile(const ImageInterface& image, const std::filesystem::path& file);
// A copy of the image's pixels in `layout`, rows packed tightly
// (width × bytes per pixel); any layout of PixelLayout.
boost::intrusive_ptr<MemBuffer> CopyImagePixels(const ImageInterface& image, PixelLayout layout);

}  // namespace velkui::pictel
