#include <velkui/test/PixelProbe.h>

#include <algorithm>

#include <velkcore/Error.h>
#include <velkui/pictel/ImageIO.h>

namespace velkui::test {

std::ostream& operator<<(std::ostream& out, const Pixel& pixel) {
  return out << "rgba(" << int{pixel.red} << "," << int{pixel.green} << "," << int{pixel.blue}
             << "," << int{pixel.alpha} << ")";
}

PixelProbe::PixelProbe(const pictel::ImageInterface& image)
    : pixels_(pictel::CopyImagePixels(image, pictel::PixelLayout::kBGRA)) {}

PixelProbe::PixelProbe(pictel::SurfaceInterface& surface)
    : PixelProbe(*surface.GetSurfaceImage()) {}

Pixel PixelProbe::At(std::int32_t x, std::int32_t y) const {
  velkcore::RequireInput(x >= 0 && y >= 0 && x < GetWidth() && y < GetHeight());
  const std::uint8_t* p = pixels_->GetData() + static_cast<std::ptrdiff_t>(y) * pixels_->GetRowBytes() + x * 4;
  return {p[2], p[1], p[0], p[3]};
}

std::int32_t PixelProbe::Count(const Pixel& pixel, std::int32_t left, std::int32_t top,
                               std::int32_t width, std::int32_t height) const {
  std::int32_t count = 0;
  for (std::int32_t y = std::max(0, top); y < std::min(GetHeight(), top + height); ++y) {
    for (std::int32_t x = std::max(0, left); x < std::min(GetWidth(), left + width); ++x) {
      if (At(x, y) == pixel) ++count;
    }
  }
  return count;
}

std::int32_t PixelProbe::CountVisible() const {
  std::int32_t count = 0;
  for (std::int32_t y = 0; y < GetHeight(); ++y) {
    for (std::int32_t x = 0; x < GetWidth(); ++x) {
      if (At(x, y).alpha != 0) ++count;
    }
  }
  return count;
}

}  // namespace velkui::test
