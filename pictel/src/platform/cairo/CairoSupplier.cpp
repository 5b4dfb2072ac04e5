#include "CairoSupplier.h"

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/StartupShutdownGdiPlus.h>

#include "OSBrushInterface.h"
#include "OSFontInterface.h"
#include "OSImageInterface.h"
#include "OSPathInterface.h"
#include "OSPenInterface.h"
#include "OSSurfaceInterface.h"
#include "PixelConversion.h"
#include "TextEngine.h"

namespace velkui::pictel::cairo {

using velkcore::RectT;

namespace {

[[noreturn]] void ThrowCannotCreateSurface() {
  ThrowPictelError(kErrorUnableToCreateSurfaceKey, kErrorUnableToCreateSurface);
}

std::int32_t DeviceWidth(cairo_surface_t* surface, double* height) {
  CairoContextPtr probe(cairo_create(surface));
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
  cairo_clip_extents(probe.get(), &x1, &y1, &x2, &y2);
  *height = y2;
  return static_cast<std::int32_t>(x2);
}

boost::intrusive_ptr<SurfaceInterface> MakeSurface(const SupplierInterface* supplier,
                                                   OSSurfaceInterface::Target target) {
  return boost::intrusive_ptr<SurfaceInterface>(
      new OSSurfaceInterface(supplier, std::move(target)));
}

}  // namespace

boost::intrusive_ptr<SurfaceInterface> OSSupplier::NewOSSurface(OSDeviceContext context,
                                                                const OSClipRegion* clipRegion,
                                                                bool buffered) const {
  if (!utility::StartupShutdownGdiPlus::IsStarted()) {
    ThrowPictelError(kErrorNotStartedKey, kErrorNotStarted);
  }
  auto* device = static_cast<cairo_surface_t*>(context);
  if (device == nullptr || cairo_surface_status(device) != CAIRO_STATUS_SUCCESS) {
    ThrowCannotCreateSurface();
  }
  const bool isImage = cairo_surface_get_type(device) == CAIRO_SURFACE_TYPE_IMAGE;
  OSSurfaceInterface::Target target;
  target.clipRegion = clipRegion;
  if (!buffered) {
    target.surface = ShareSurface(device);
    if (isImage) target.image = new OSImageInterface(ShareSurface(device));
    return MakeSurface(this, std::move(target));
  }
  double height = 0;
  const std::int32_t width = DeviceWidth(device, &height);
  const cairo_format_t format = cairo_surface_get_content(device) == CAIRO_CONTENT_COLOR
                                    ? CAIRO_FORMAT_RGB24
                                    : CAIRO_FORMAT_ARGB32;
  target.surface.reset(
      cairo_image_surface_create(format, width, static_cast<std::int32_t>(height)));
  target.image = new OSImageInterface(ShareSurface(target.surface.get()));
  target.deviceContext = ShareSurface(device);
  return MakeSurface(this, std::move(target));
}

boost::intrusive_ptr<SurfaceInterface> OSSupplier::NewImageSurface(
    ImageInterface* image, bool clear, const RectT<std::int32_t>* bounds) const {
  auto* osImage = dynamic_cast<OSImageInterface*>(image);
  if (osImage == nullptr) ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
  OSSurfaceInterface::Target target;
  target.surface = ShareSurface(osImage->GetCairoSurface());
  target.image = osImage;
  target.clipRect = bounds;
  target.clear = clear;
  return MakeSurface(this, std::move(target));
}

boost::intrusive_ptr<SurfaceInterface> OSSupplier::NewSurface(std::int32_t width,
                                                              std::int32_t height,
                                                              bool transparent) const {
  if (width < 0 || height < 0) ThrowCannotCreateSurface();
  OSSurfaceInterface::Target target;
  target.surface.reset(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height));
  if (cairo_surface_status(target.surface.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowCannotCreateSurface();
  }
  target.image = new OSImageInterface(ShareSurface(target.surface.get()));
  target.fillWhite = !transparent;
  return MakeSurface(this, std::move(target));
}

boost::intrusive_ptr<SurfaceInterface> OSSupplier::NewBufferSurface(
    std::int32_t width, std::int32_t height, std::int32_t rowBytes, PixelLayout layout,
    void* pixels, BufferDeleter deleter) const {
  if (BytesPerPixel(layout) == 0 || layout == PixelLayout::kARGB ||
      layout == PixelLayout::kARGBPremultiplied) {
    ThrowPictelError(kErrorUnsupportedPixelFormatKey, kErrorUnsupportedPixelFormat);
  }
  if (!IsUsableBuffer(width, height, rowBytes, layout, pixels)) ThrowCannotCreateSurface();
  bool shared = false;
  OSSurfaceInterface::Target target;
  target.surface = WrapCallerPixels(width, height, rowBytes, layout, pixels, &shared);
  if (cairo_surface_status(target.surface.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowCannotCreateSurface();
  }
  AttachDeleter(target.surface.get(), pixels, std::move(deleter));
  target.image = new OSImageInterface(ShareSurface(target.surface.get()));
  if (!shared) {
    target.writeBack = [layout, pixels, rowBytes](cairo_surface_t* shadow) {
      CopyFromCairo(shadow, layout, static_cast<std::uint8_t*>(pixels), rowBytes);
    };
  }
  return MakeSurface(this, std::move(target));
}

boost::intrusive_ptr<PenInterface> OSSupplier::NewPen(const ColorRGBA& color, float width) const {
  return new OSPenInterface(color, width);
}

boost::intrusive_ptr<BrushInterface> OSSupplier::NewBrush(const ColorRGBA& color) const {
  return new OSSolidBrushInterface(color);
}

boost::intrusive_ptr<LinearShaderInterface> OSSupplier::CreateLinearShader(
    const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
    const ColorRGBA* colors, const float* positions, std::int32_t count) const {
  return new OSLinearGradientBrushInterface(start, end, colors, positions, count);
}

boost::intrusive_ptr<RadialShaderInterface> OSSupplier::CreateRadialShader(
    const velkcore::PointT<float>& centre, float radius, const ColorRGBA* colors,
    const float* positions, std::int32_t count) const {
  return new OSRadialGradientBrushInterface(centre, radius, colors, positions, count);
}

boost::intrusive_ptr<FontInterface> OSSupplier::NewFont(const velkcore::UTF16String& family,
                                                        const velkcore::UTF16String& style,
                                                        float size) const {
  return OSFontInterface::Create(family, style, size);
}

boost::intrusive_ptr<ImageInterface> OSSupplier::NewFileImage(const void* bytes, std::size_t size,
                                                              ImageFileType type) const {
  return OSImageFileInterface::Decode(bytes, size, type);
}

boost::intrusive_ptr<ImageInterface> OSSupplier::NewBufferImage(std::int32_t width,
                                                                std::int32_t height,
                                                                std::int32_t rowBytes,
                                                                PixelLayout layout, void* pixels,
                                                                BufferDeleter deleter) const {
  return OSImageBufferInterface::Create(width, height, rowBytes, layout, pixels,
                                        std::move(deleter));
}

boost::intrusive_ptr<PathInterface> OSSupplier::NewPath() const {
  return new OSPathInterface();
}

}  // namespace velkui::pictel::cairo

namespace velkui::pictel {

boost::intrusive_ptr<SupplierInterface> NewOSSupplier() {
  return boost::intrusive_ptr<SupplierInterface>(new cairo::OSSupplier());
}

bool IsOSSupplier(const SupplierInterface& supplier) {
  return dynamic_cast<const cairo::OSSupplier*>(&supplier) != nullptr;
}

bool HasFontFamily(const velkcore::UTF16String& family) {
  const std::string name = velkcore::UTF16to8(family);
  return !name.empty() && cairo::TextEngine::Get().HasFamily(name);
}

velkcore::UTF16String GetPlatformUIFontFamily() {
  for (const char16_t* candidate : {u"Tahoma", u"DejaVu Sans"}) {
    if (HasFontFamily(candidate)) return candidate;
  }
  return velkcore::UTF8to16(cairo::TextEngine::Get().GetDefaultSansFamily());
}

}  // namespace velkui::pictel
