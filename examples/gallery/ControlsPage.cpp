// The controls page of the gallery: every button kind in the light and the
// dark control colours, side by side.
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

#include "ControlsGallery.h"
#include "GalleryPage.h"

namespace gallery {
namespace {

constexpr float kPageMargin = 24;
constexpr float kPanelGap = 24;

boost::intrusive_ptr<velkui::pictel::ImageInterface> RenderControlsPage() {
  const auto supplier = velkui::pictel::NewOSSupplier();
  const float width = 2 * kControlsShowcaseWidth + kPanelGap + 2 * kPageMargin;
  const float height = kControlsShowcaseHeight + 2 * kPageMargin;
  const auto surface = supplier->NewSurface(static_cast<std::int32_t>(width),
                                            static_cast<std::int32_t>(height), false);
  surface->PaintRect({0.86f, 0.87f, 0.89f, 1}, {0, 0, width, height});
  velkui::pictel::Pictel context(supplier.get(), surface.get());
  DrawControlsPage(context,
                   {kPageMargin, kPageMargin, width - 2 * kPageMargin, kControlsShowcaseHeight});
  return surface->GetSurfaceImage();
}

const PageRegistration kControlsPage{{"controls", 30, &RenderControlsPage}};

}  // namespace
}  // namespace gallery
