#include <velkui/pictel/ScAcquireSurfaceHDC.h>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>

#include "OSSurfaceInterface.h"

namespace velkui::pictel {

namespace {

cairo::OSSurfaceInterface* PlatformSurface(SurfaceInterface* surface) {
  velkcore::RequireInput(surface != nullptr);
  auto* platform = dynamic_cast<cairo::OSSurfaceInterface*>(surface->GetOutputSurface());
  if (platform == nullptr) ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
  return platform;
}

}  // namespace

ScAcquireSurfaceHDC::ScAcquireSurfaceHDC(SurfaceInterface* surface)
    : context_(PlatformSurface(surface)->GetTargetSurface()) {
  cairo_surface_flush(static_cast<cairo_surface_t*>(context_));
}

ScAcquireSurfaceHDC::~ScAcquireSurfaceHDC() {
  cairo_surface_mark_dirty(static_cast<cairo_surface_t*>(context_));
}

}  // namespace velkui::pictel
