#pragma once

#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// The drawing context handed to every draw and measure call: a supplier and the
// surface being drawn on. It owns neither; whoever starts a redraw builds it on
// the stack for that redraw.
class Pictel {
 public:
  Pictel(const SupplierInterface* supplier, SurfaceInterface* surface)
      : supplier_(supplier), surface_(surface) {}
  Pictel(const Pictel&) = default;
  Pictel& operator=(const Pictel&) = default;
  virtual ~Pictel() = default;

  const SupplierInterface* GetSupplier() const { return supplier_; }
  SurfaceInterface* GetSurface() const { return surface_; }

 private:
  const SupplierInterface* supplier_;
  SurfaceInterface* surface_;
};

}  // namespace velkui::pictel
