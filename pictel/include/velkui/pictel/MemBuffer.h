#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// A block of pixels in memory.
class MemBuffer : public velkcore::RefCountedObject {
 public:
  MemBuffer(std::int32_t width, std::int32_t height, std::int32_t rowBytes, PixelLayout layout);

  std::int32_t GetWidth() const { return width_; }
  std::int32_t GetHeight() const { return height_; }
  std::int32_t GetRowBytes() const { return rowBytes_; }
  PixelLayout GetPixelLayout() const { return layout_; }
  // Row bytes × height.
  std::size_t GetDataSize() const;
  // Allocates GetDataSize() bytes (zeroed); replaces any earlier block.
  void Alloc();
  std::uint8_t* GetData() { return data_.get(); }
  const std::uint8_t* GetData() const { return data_.get(); }
  // Every byte 0.
  void ClearBuffer();
  // Exchanges the first and third byte of every whole four-byte pixel (red and blue).
  void SwapColorChannels();
  // A debugging hook; does nothing.
  void DebugMarkBuffer() {}

 private:
  std::int32_t width_;
  std::int32_t height_;
  std::int32_t rowBytes_;
  PixelLayout layout_;
  std::unique_ptr<std::uint8_t[]> data_;
};

}  // namespace velkui::pictel
