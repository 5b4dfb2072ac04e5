#include <velkcore/Resources.h>

#include <algorithm>
#include <cctype>

#include <velkcore/Error.h>

namespace velkcore {
namespace {
bool EqualsIgnoringAsciiCase(std::string_view a, std::string_view b) {
  return std::ranges::equal(a, b, [](char x, char y) {
    return std::tolower(static_cast<unsigned char>(x)) == std::tolower(static_cast<unsigned char>(y));
  });
}
}  // namespace

const EmbeddedResource* ResourceModule::Find(std::string_view name, std::string_view type) const {
  const auto found = std::ranges::find_if(entries, [&](const EmbeddedResource& e) {
    return e.name == name && EqualsIgnoringAsciiCase(e.type, type);
  });
  return found == entries.end() ? nullptr : &*found;
}

std::span<const unsigned char> GetBinaryFromModule(const ResourceModule& module,
                                                   std::string_view name, std::string_view type) {
  if (const EmbeddedResource* resource = module.Find(name, type)) return resource->bytes;
  // The detailed text fills ^1 and ^2; ^0 names the module.
  ThrowError(ErrorLevel::kError, kUnableToAccessResourceDetailedKey, kCategoryUtilities,
             kUnableToAccessResourceNumber, 0, module.moduleName, name, type);
}

}  // namespace velkcore
