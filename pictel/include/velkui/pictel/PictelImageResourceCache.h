#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <tuple>
#include <typeindex>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Resources.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::utility {

// Images are cached per supplier type: images made by different kinds of
// supplier never share an entry.
struct PictelImageResourceCacheKey {
  std::type_index supplierType;
  std::string name;
  pictel::ImageFileType type;

  friend bool operator<(const PictelImageResourceCacheKey& a,
                        const PictelImageResourceCacheKey& b) {
    return std::tie(a.supplierType, a.name, a.type) < std::tie(b.supplierType, b.name, b.type);
  }
};

// Decoded resource images, by supplier type, name and file type.
class PictelImageResourceCache {
 public:
  using ImagePtr = boost::intrusive_ptr<pictel::ImageInterface>;
  // Finds the encoded bytes of a named resource (raising when there is none).
  using ResourceLoader =
      std::function<std::span<const unsigned char>(std::string_view name, std::string_view type)>;

  ImagePtr FindImage(const pictel::SupplierInterface& supplier, std::string_view name,
                     pictel::ImageFileType type) const;
  // The cached image, or else the resource read through `loader`, decoded, cached.
  ImagePtr GetImage(const ResourceLoader& loader, const pictel::SupplierInterface& supplier,
                    std::string_view name, pictel::ImageFileType type);
  // The same, reading the resource from a compiled-in resource module.
  ImagePtr GetImage(const velkcore::ResourceModule& module,
                    const pictel::SupplierInterface& supplier, std::string_view name,
                    pictel::ImageFileType type);
  // The same, decoding `bytes` on a miss.
  ImagePtr GetImage(const void* bytes, std::size_t size, const pictel::SupplierInterface& supplier,
                    std::string_view name, pictel::ImageFileType type);
  // Stores or replaces.
  void CacheImage(const pictel::SupplierInterface& supplier, std::string_view name,
                  pictel::ImageFileType type, ImagePtr image);
  // True when something was removed.
  bool RemoveCachedImage(const pictel::SupplierInterface& supplier, std::string_view name,
                         pictel::ImageFileType type);
  void Clear() { images_.clear(); }
  std::size_t GetSize() const { return images_.size(); }

  // The file extension of a type ("png").
  static std::string_view GetTypeExtension(pictel::ImageFileType type);

 private:
  static PictelImageResourceCacheKey MakeKey(const pictel::SupplierInterface& supplier,
                                             std::string_view name, pictel::ImageFileType type);

  std::map<PictelImageResourceCacheKey, ImagePtr> images_;
};

}  // namespace velkui::utility
