#pragma once

#include <cstdint>
#include <typeindex>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkui/pictel/CacheInterface.h>

namespace velkui::pictel {

// A drawing cache kept as an offscreen bitmap in device pixels.
class BitmapCacheInterface : public CacheInterface {
 public:
  // Records what the cache depends on and, when `rect` covers at least one
  // device pixel, makes the offscreen surface, set up so that drawing into it
  // with the caller's usual coordinates lands in the bitmap.
  BitmapCacheInterface(SurfaceInterface& surface, const velkcore::RectT<float>& rect);
  ~BitmapCacheInterface() override;

  SurfaceInterface* GetSurface() override { return cacheSurface_.get(); }
  SurfaceInterface* GetCacheSurface() const { return cacheSurface_.get(); }
  bool IsValid(const SurfaceInterface& surface, const velkcore::RectT<float>& rect) const override;

  const velkcore::RectT<float>& GetRect() const { return rect_; }
  const velkcore::MatrixT<float>& GetRecordedTransform() const { return transform_; }
  // The device-pixel bounds of the bitmap (empty when the cache has no surface).
  const velkcore::RectT<std::int32_t>& GetPixelBounds() const { return pixelBounds_; }

 private:
  velkcore::RectT<float> rect_;
  std::type_index supplierType_;
  AntiAliasPolicy antiAlias_;
  InterpolationPolicy interpolation_;
  velkcore::MatrixT<float> transform_;
  velkcore::RectT<std::int32_t> pixelBounds_;
  boost::intrusive_ptr<SurfaceInterface> cacheSurface_;
};

}  // namespace velkui::pictel
