#include <velkui/pictel/ColorManagement.h>

#include <cmath>
#include <memory>
#include <mutex>
#include <vector>

#include <velkcore/Error.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/PixelSwizzle.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::pictel {

using velkcore::PointT;
using velkcore::RectT;

namespace {

struct ProcessHooks {
  std::mutex mutex;
  ColorManagementCallback colorManagement;
  MonitorEnumerator monitors;
};

ProcessHooks& Hooks() {
  static ProcessHooks hooks;
  return hooks;
}

ColorManagementCallback CurrentColorManagementCallback() {
  std::lock_guard lock(Hooks().mutex);
  return Hooks().colorManagement;
}

MonitorEnumerator CurrentMonitorEnumerator() {
  std::lock_guard lock(Hooks().mutex);
  return Hooks().monitors;
}

RectT<std::int32_t> RoundOutwards(const RectT<float>& rect) {
  constexpr float kLimit = 1e9f;
  const bool representable = std::fabs(rect.left) < kLimit && std::fabs(rect.top) < kLimit &&
                             std::fabs(rect.Right()) < kLimit && std::fabs(rect.Bottom()) < kLimit;
  if (!representable) return {};
  const auto left = static_cast<std::int32_t>(std::floor(rect.left));
  const auto top = static_cast<std::int32_t>(std::floor(rect.top));
  const auto right = static_cast<std::int32_t>(std::ceil(rect.Right()));
  const auto bottom = static_cast<std::int32_t>(std::ceil(rect.Bottom()));
  return {left, top, right - left, bottom - top};
}

RectT<std::int32_t> Offset(const RectT<std::int32_t>& rect, std::int32_t dx, std::int32_t dy) {
  return {rect.left + dx, rect.top + dy, rect.width, rect.height};
}

RectT<float> ToFloat(const RectT<std::int32_t>& rect) {
  return {static_cast<float>(rect.left), static_cast<float>(rect.top),
          static_cast<float>(rect.width), static_cast<float>(rect.height)};
}

// Draws the piece of a managed image that falls into `piece` (surface units) of
// the image scaled into `rect`.
void DrawManagedImagePiece(Pictel& pictel, const ManagedImage& image, const RectT<float>& rect,
                           const RectT<std::int32_t>& piece, void* display) {
  const std::int32_t imageWidth = image.GetWidth();
  const std::int32_t imageHeight = image.GetHeight();
  if (imageWidth <= 0 || imageHeight <= 0) return;
  const double scaleX = imageWidth / static_cast<double>(rect.width);
  const double scaleY = imageHeight / static_cast<double>(rect.height);
  const auto left = static_cast<std::int32_t>(std::floor((piece.left - rect.left) * scaleX));
  const auto top = static_cast<std::int32_t>(std::floor((piece.top - rect.top) * scaleY));
  const auto right = static_cast<std::int32_t>(std::ceil((piece.Right() - rect.left) * scaleX));
  const auto bottom = static_cast<std::int32_t>(std::ceil((piece.Bottom() - rect.top) * scaleY));
  const RectT<std::int32_t> subregion =
      velkcore::Intersection(RectT<std::int32_t>{left, top, right - left, bottom - top},
                             RectT<std::int32_t>{0, 0, imageWidth, imageHeight});
  if (subregion.IsEmpty()) return;

  ImageDestinationProfile profile;
  profile.SetDisplayID(display);
  profile.SetPixelLayout(PixelLayout::kARGB);
  profile.SetDepth(8);
  profile.SetBounds({0, 0, imageWidth, imageHeight});
  profile.SetSubregion(subregion);

  const std::size_t pixelCount =
      static_cast<std::size_t>(subregion.width) * static_cast<std::size_t>(subregion.height);
  auto pixels = std::make_shared<std::vector<std::uint8_t>>(pixelCount * 4);
  image.Convert(profile, pixels->data());
  inplace_swizzle<PixelLayout::kARGB, PixelLayout::kBGRA>(pixels->data(), pixelCount);

  const SupplierInterface& supplier = *pictel.GetSupplier();
  auto converted = supplier.NewBufferImage(subregion.width, subregion.height, subregion.width * 4,
                                           PixelLayout::kBGRA, pixels->data(),
                                           [pixels](void*) mutable { pixels.reset(); });
  SurfaceInterface& surface = *pictel.GetSurface();
  ScopedSurfaceState state(surface);
  auto clip = supplier.NewPath();
  clip->AddRect(piece);
  surface.Clip(*clip, FillType::kWinding);
  const RectT<float> destination{static_cast<float>(rect.left + subregion.left / scaleX),
                                 static_cast<float>(rect.top + subregion.top / scaleY),
                                 static_cast<float>(subregion.width / scaleX),
                                 static_cast<float>(subregion.height / scaleY)};
  surface.DrawImage(supplier, *converted, destination, nullptr, 1.0f);
}

}  // namespace

std::int32_t ColorDestinationProfile::GetBytesPerPixel() const {
  const std::int32_t product = depth_ / 8 * static_cast<std::int32_t>(layout_);
  if (product == 0 || layout_ == PixelLayout::kBGR) return 3;
  return 4;
}

void SetColorManagementCallback(ColorManagementCallback callback) {
  std::lock_guard lock(Hooks().mutex);
  Hooks().colorManagement = std::move(callback);
}

void AbstractVisual::Manage(const ColorDestinationProfile& profile,
                            const OpaqueApplicationData& data, void* destination) const {
  const ColorManagementCallback callback = CurrentColorManagementCallback();
  if (!IsManaged() || !callback) {
    ThrowPictelError(kErrorNoColorManagementCallbackKey, kErrorNoColorManagementCallback);
  }
  callback(profile, data, destination);
}

UnManagedImage::UnManagedImage(boost::intrusive_ptr<ImageInterface> image)
    : image_(std::move(image)) {
  velkcore::RequireInput(image_ != nullptr);
}

UnManagedImage::~UnManagedImage() = default;

std::int32_t UnManagedImage::GetWidth() const {
  return image_->GetWidth();
}
std::int32_t UnManagedImage::GetHeight() const {
  return image_->GetHeight();
}

void SetMonitorEnumerator(MonitorEnumerator enumerator) {
  std::lock_guard lock(Hooks().mutex);
  Hooks().monitors = std::move(enumerator);
}

std::vector<MonitorPiece> SubdivideByMonitor(const RectT<std::int32_t>& rect) {
  const MonitorEnumerator enumerator = CurrentMonitorEnumerator();
  if (!enumerator) return {{rect, nullptr}};
  std::vector<MonitorPiece> pieces;
  for (const auto& [bounds, display] : enumerator()) {
    const RectT<std::int32_t> part = velkcore::Intersection(rect, bounds);
    if (!part.IsEmpty()) pieces.emplace_back(part, display);
  }
  // A rectangle on no display at all (an offscreen surface) is still drawn.
  if (pieces.empty()) pieces.emplace_back(rect, nullptr);
  return pieces;
}

void PaintColorManagedRect(Pictel& pictel, const RectT<float>& rect,
                           const PointT<std::int32_t>& screenOffset,
                           const boost::intrusive_ptr<AbstractColor>& color) {
  velkcore::RequireInput(color != nullptr && pictel.GetSurface() != nullptr);
  const RectT<std::int32_t> area = RoundOutwards(rect);
  if (area.IsEmpty()) return;
  for (const auto& [piece, display] :
       SubdivideByMonitor(Offset(area, screenOffset.x, screenOffset.y))) {
    ColorDestinationProfile profile;
    profile.SetDisplayID(display);
    profile.SetPixelLayout(PixelLayout::kARGB);
    profile.SetDepth(8);
    const ColorRGBA converted = color->Convert(profile);
    pictel.GetSurface()->PaintRect(converted,
                                   ToFloat(Offset(piece, -screenOffset.x, -screenOffset.y)));
  }
}

void PaintColorManagedImage(Pictel& pictel, const RectT<float>& rect,
                            const PointT<std::int32_t>& screenOffset,
                            const boost::intrusive_ptr<AbstractImage>& image) {
  velkcore::RequireInput(image != nullptr && pictel.GetSurface() != nullptr &&
                         pictel.GetSupplier() != nullptr);
  if (!(rect.width > 0.0f) || !(rect.height > 0.0f)) return;
  if (const auto* plain = dynamic_cast<const UnManagedImage*>(image.get())) {
    pictel.GetSurface()->DrawImage(*pictel.GetSupplier(), *plain->GetImage(), rect, nullptr, 1.0f);
    return;
  }
  const auto* managed = dynamic_cast<const ManagedImage*>(image.get());
  velkcore::RequireInput(managed != nullptr);
  const RectT<std::int32_t> area = RoundOutwards(rect);
  for (const auto& [piece, display] :
       SubdivideByMonitor(Offset(area, screenOffset.x, screenOffset.y))) {
    DrawManagedImagePiece(pictel, *managed, rect, Offset(piece, -screenOffset.x, -screenOffset.y),
                          display);
  }
}

}  // namespace velkui::pictel
