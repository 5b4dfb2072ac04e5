#include <velkui/pictel/MemBuffer.h>

#include <algorithm>
#include <utility>

#include <velkcore/Error.h>

namespace velkui::pictel {

MemBuffer::MemBuffer(std::int32_t width, std::int32_t height, std::int32_t rowBytes,
                     PixelLayout layout)
    : width_(width), height_(height), rowBytes_(rowBytes), layout_(layout) {
  velkcore::RequireInput(width >= 0 && height >= 0 && rowBytes >= 0);
}

std::size_t MemBuffer::GetDataSize() const {
  return static_cast<std::size_t>(rowBytes_) * static_cast<std::size_t>(height_);
}

void MemBuffer::Alloc() {
  data_ = std::make_unique<std::uint8_t[]>(GetDataSize());
}

void MemBuffer::ClearBuffer() {
  if (data_) std::fill_n(data_.get(), GetDataSize(), std::uint8_t{0});
}

void MemBuffer::SwapColorChannels() {
  if (!data_) return;
  // Only whole pixels: a block whose size is not a multiple of 4 keeps its tail.
  const std::size_t pixels = GetDataSize() / 4;
  std::uint8_t* p = data_.get();
  for (std::size_t i = 0; i < pixels; ++i, p += 4) std::swap(p[0], p[2]);
}

}  // namespace velkui::pictel
