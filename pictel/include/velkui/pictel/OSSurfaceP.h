#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/PictelTypes.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::pictel {

// The one handle that owns its surface alone: it cannot be copied, and New
// replaces (and releases) the surface it held.
class OSSurfaceP {
 public:
  OSSurfaceP() = default;
  ~OSSurfaceP();
  OSSurfaceP(const OSSurfaceP&) = delete;
  OSSurfaceP& operator=(const OSSurfaceP&) = delete;

  // A surface on a platform device context through the platform supplier
  // (error 30 for any other supplier).
  void New(const SupplierInterface* supplier, OSDeviceContext context,
           const OSClipRegion* clipRegion, bool buffered = false);
  void Reset();

  SurfaceInterface* Get() const { return surface_.get(); }
  SurfaceInterface* operator->() const { return surface_.get(); }
  explicit operator bool() const { return surface_ != nullptr; }

 private:
  boost::intrusive_ptr<SurfaceInterface> surface_;
};

}  // namespace velkui::pictel
