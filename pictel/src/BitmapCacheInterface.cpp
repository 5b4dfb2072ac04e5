#include <velkui/pictel/BitmapCacheInterface.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <typeinfo>

#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::pictel {

using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;

namespace {

std::type_index SupplierType(const SurfaceInterface& surface) {
  const SupplierInterface& supplier = *surface.GetSupplier();
  return std::type_index(typeid(supplier));
}

// Larger bitmaps than this are not worth caching (and exceed what the
// backend's image surfaces hold): such a node simply draws directly.
constexpr double kMaximumCacheSide = 16384.0;

// `rect` mapped through `matrix`, rounded outwards to whole device pixels.
RectT<std::int32_t> DevicePixelBounds(const RectT<float>& rect, const MatrixT<float>& matrix) {
  const PointT<float> corners[4] = {
      matrix.Transform({rect.left, rect.top}),
      matrix.Transform({rect.Right(), rect.top}),
      matrix.Transform({rect.left, rect.Bottom()}),
      matrix.Transform({rect.Right(), rect.Bottom()}),
  };
  double left = std::numeric_limits<double>::infinity();
  double top = left;
  double right = -left;
  double bottom = -left;
  for (const auto& corner : corners) {
    left = std::min(left, static_cast<double>(corner.x));
    top = std::min(top, static_cast<double>(corner.y));
    right = std::max(right, static_cast<double>(corner.x));
    bottom = std::max(bottom, static_cast<double>(corner.y));
  }
  left = std::floor(left);
  top = std::floor(top);
  right = std::ceil(right);
  bottom = std::ceil(bottom);
  const bool usable = std::isfinite(left) && std::isfinite(top) && std::isfinite(right) &&
                      std::isfinite(bottom) && right - left <= kMaximumCacheSide &&
                      bottom - top <= kMaximumCacheSide && std::fabs(left) < 1e9 &&
                      std::fabs(top) < 1e9;
  if (!usable) return {};
  return {static_cast<std::int32_t>(left), static_cast<std::int32_t>(top),
          static_cast<std::int32_t>(right - left), static_cast<std::int32_t>(bottom - top)};
}

}  // namespace

BitmapCacheInterface::BitmapCacheInterface(SurfaceInterface& surface, const RectT<float>& rect)
    : rect_(rect),
      supplierType_(SupplierType(surface)),
      antiAlias_(surface.GetAntiAliasPolicy()),
      interpolation_(surface.GetInterpolationPolicy()) {
  surface.GetTransform(&transform_);
  if (rect.IsEmpty()) return;
  const RectT<std::int32_t> pixels = DevicePixelBounds(rect, transform_);
  if (pixels.IsEmpty()) return;
  pixelBounds_ = pixels;
  cacheSurface_ = surface.GetSupplier()->NewSurface(pixels.width, pixels.height, true);
  cacheSurface_->SetAntiAliasPolicy(antiAlias_);
  cacheSurface_->SetInterpolationPolicy(interpolation_);
  cacheSurface_->Transform(MatrixT<float>::Translation(static_cast<float>(-pixels.left),
                                                       static_cast<float>(-pixels.top)));
  cacheSurface_->Transform(transform_);
}

BitmapCacheInterface::~BitmapCacheInterface() = default;

bool BitmapCacheInterface::IsValid(const SurfaceInterface& surface,
                                   const RectT<float>& rect) const {
  if (SupplierType(surface) != supplierType_) return false;
  if (!(rect == rect_)) return false;
  MatrixT<float> current;
  surface.GetTransform(&current);
  return current == transform_ && surface.GetAntiAliasPolicy() == antiAlias_ &&
         surface.GetInterpolationPolicy() == interpolation_;
}

}  // namespace velkui::pictel
