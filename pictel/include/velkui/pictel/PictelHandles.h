#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Error.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

// One shared reference to a drawing resource; copying adds a reference.
template <typename Interface>
class ResourceHandle {
 public:
  using element_type = Interface;

  ResourceHandle() = default;
  explicit ResourceHandle(boost::intrusive_ptr<Interface> resource)
      : resource_(std::move(resource)) {}

  Interface* Get() const { return resource_.get(); }
  Interface* operator->() const { return resource_.get(); }
  // A null handle raises the input-contract violation instead of a null reference.
  Interface& operator*() const {
    velkcore::RequireInput(resource_ != nullptr);
    return *resource_;
  }
  explicit operator bool() const { return resource_ != nullptr; }
  const boost::intrusive_ptr<Interface>& GetPtr() const { return resource_; }
  void Reset(boost::intrusive_ptr<Interface> resource = {}) { resource_ = std::move(resource); }

  friend bool operator==(const ResourceHandle& a, const ResourceHandle& b) {
    return a.resource_ == b.resource_;
  }

 private:
  boost::intrusive_ptr<Interface> resource_;
};

class PenP : public ResourceHandle<PenInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  PenP(const SupplierInterface& supplier, const ColorRGBA& color, float width)
      : ResourceHandle(supplier.NewPen(color, width)) {}
};

class BrushP : public ResourceHandle<BrushInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  BrushP(const SupplierInterface& supplier, const ColorRGBA& color)
      : ResourceHandle(supplier.NewBrush(color)) {}
};

class PathP : public ResourceHandle<PathInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  explicit PathP(const SupplierInterface& supplier) : ResourceHandle(supplier.NewPath()) {}
};

class FontP : public ResourceHandle<FontInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  FontP(const SupplierInterface& supplier, const velkcore::UTF16String& family,
        const velkcore::UTF16String& style, float size)
      : ResourceHandle(supplier.NewFont(family, style, size)) {}
};

class ImageP : public ResourceHandle<ImageInterface> {
 public:
  using ResourceHandle::ResourceHandle;
};

// An image decoded from encoded bytes (a file's contents).
class FileImageP : public ImageP {
 public:
  using ImageP::ImageP;
  FileImageP(const SupplierInterface& supplier, const void* bytes, std::size_t size,
             ImageFileType type = ImageFileType::kPNG)
      : ImageP(supplier.NewFileImage(bytes, size, type)) {}
};

// An image over caller memory.
class BufferImageP : public ImageP {
 public:
  using ImageP::ImageP;
  BufferImageP(const SupplierInterface& supplier, std::int32_t width, std::int32_t height,
               std::int32_t rowBytes, PixelLayout layout, void* pixels, BufferDeleter deleter = {})
      : ImageP(
            supplier.NewBufferImage(width, height, rowBytes, layout, pixels, std::move(deleter))) {}
};

class LinearShaderP : public ResourceHandle<LinearShaderInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  LinearShaderP(const SupplierInterface& supplier, const velkcore::PointT<float>& start,
                const velkcore::PointT<float>& end, const ColorRGBA& from, const ColorRGBA& to)
      : ResourceHandle(supplier.NewLinearShader(start, end, from, to)) {}
  LinearShaderP(const SupplierInterface& supplier, const velkcore::PointT<float>& start,
                const velkcore::PointT<float>& end,
                const std::vector<std::pair<float, ColorRGBA>>& stops)
      : ResourceHandle(supplier.NewLinearShader(start, end, stops)) {}
};

class SurfaceP : public ResourceHandle<SurfaceInterface> {
 public:
  using ResourceHandle::ResourceHandle;
  // An offscreen surface.
  SurfaceP(const SupplierInterface& supplier, std::int32_t width, std::int32_t height,
           bool transparent = true)
      : ResourceHandle(supplier.NewSurface(width, height, transparent)) {}
};

}  // namespace velkui::pictel
