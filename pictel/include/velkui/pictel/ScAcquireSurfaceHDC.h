#pragma once

#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// Flushes a platform surface and lends the device context it draws into (with
// the Cairo backend, its cairo_surface_t*) for the scope, so that native code
// can draw there too. Forwarding surfaces lend their output surface's context.
// Any other surface raises error 30.
class ScAcquireSurfaceHDC {
 public:
  explicit ScAcquireSurfaceHDC(SurfaceInterface* surface);
  // Tells the surface that its pixels may have changed behind its back.
  ~ScAcquireSurfaceHDC();
  ScAcquireSurfaceHDC(const ScAcquireSurfaceHDC&) = delete;
  ScAcquireSurfaceHDC& operator=(const ScAcquireSurfaceHDC&) = delete;

  OSDeviceContext Get() const { return context_; }
  operator OSDeviceContext() const { return context_; }  // NOLINT: used where a context is wanted

 private:
  OSDeviceContext context_;
};

}  // namespace velkui::pictel
