#include <velkui/pictel/PictelImageResourceCache.h>

#include <typeinfo>

#include <velkcore/Error.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::utility {

using ImagePtr = PictelImageResourceCache::ImagePtr;

PictelImageResourceCacheKey PictelImageResourceCache::MakeKey(
    const pictel::SupplierInterface& supplier, std::string_view name, pictel::ImageFileType type) {
  return {std::type_index(typeid(supplier)), std::string(name), type};
}

std::string_view PictelImageResourceCache::GetTypeExtension(pictel::ImageFileType type) {
  switch (type) {
    case pictel::ImageFileType::kPNG:
      break;
  }
  return "png";
}

ImagePtr PictelImageResourceCache::FindImage(const pictel::SupplierInterface& supplier,
                                             std::string_view name,
                                             pictel::ImageFileType type) const {
  const auto found = images_.find(MakeKey(supplier, name, type));
  return found == images_.end() ? nullptr : found->second;
}

ImagePtr PictelImageResourceCache::GetImage(const ResourceLoader& loader,
                                            const pictel::SupplierInterface& supplier,
                                            std::string_view name, pictel::ImageFileType type) {
  if (ImagePtr cached = FindImage(supplier, name, type)) return cached;
  velkcore::RequireInput(static_cast<bool>(loader));
  const std::span<const unsigned char> bytes = loader(name, GetTypeExtension(type));
  return GetImage(bytes.data(), bytes.size(), supplier, name, type);
}

ImagePtr PictelImageResourceCache::GetImage(const velkcore::ResourceModule& module,
                                            const pictel::SupplierInterface& supplier,
                                            std::string_view name, pictel::ImageFileType type) {
  return GetImage(
      [&module](std::string_view resource, std::string_view extension) {
        return velkcore::GetBinaryFromModule(module, resource, extension);
      },
      supplier, name, type);
}

ImagePtr PictelImageResourceCache::GetImage(const void* bytes, std::size_t size,
                                            const pictel::SupplierInterface& supplier,
                                            std::string_view name, pictel::ImageFileType type) {
  if (ImagePtr cached = FindImage(supplier, name, type)) return cached;
  ImagePtr image = supplier.NewFileImage(bytes, size, type);
  CacheImage(supplier, name, type, image);
  return image;
}

void PictelImageResourceCache::CacheImage(const pictel::SupplierInterface& supplier,
                                          std::string_view name, pictel::ImageFileType type,
                                          ImagePtr image) {
  velkcore::RequireInput(image != nullptr);
  images_.insert_or_assign(MakeKey(supplier, name, type), std::move(image));
}

bool PictelImageResourceCache::RemoveCachedImage(const pictel::SupplierInterface& supplier,
                                                 std::string_view name,
                                                 pictel::ImageFileType type) {
  return images_.erase(MakeKey(supplier, name, type)) > 0;
}

}  // namespace velkui::utility
