#pragma once

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// A drawing cache made by SurfaceInterface::PushCacheStack.
class CacheInterface : public virtual velkcore::RefCountedObject {
 public:
  ~CacheInterface() override = default;

  // The offscreen surface to draw into, or null.
  virtual SurfaceInterface* GetSurface() = 0;
  // Whether the cache may still stand in for drawing `rect` on `surface`.
  virtual bool IsValid(const SurfaceInterface& surface,
                       const velkcore::RectT<float>& rect) const = 0;
};

}  // namespace velkui::pictel
