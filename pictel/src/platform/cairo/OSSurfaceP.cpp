#include <velkui/pictel/OSSurfaceP.h>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

OSSurfaceP::~OSSurfaceP() = default;

void OSSurfaceP::New(const SupplierInterface* supplier, OSDeviceContext context,
                     const OSClipRegion* clipRegion, bool buffered) {
  if (supplier == nullptr || !IsOSSupplier(*supplier)) {
    ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
  }
  // The old surface goes before the new one is bound to the context.
  surface_.reset();
  surface_ = supplier->NewOSSurface(context, clipRegion, buffered);
}

void OSSurfaceP::Reset() {
  surface_.reset();
}

}  // namespace velkui::pictel
