#pragma once

#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel::cairo {

// The platform supplier: Cairo for geometry and images, Pango for text.
class OSSupplier : public SupplierInterface {
 public:
  boost::intrusive_ptr<SurfaceInterface> NewOSSurface(OSDeviceContext context,
                                                      const OSClipRegion* clipRegion,
                                                      bool buffered) const override;
  boost::intrusive_ptr<SurfaceInterface> NewImageSurface(
      ImageInterface* image, bool clear,
      const velkcore::RectT<std::int32_t>* bounds) const override;
  boost::intrusive_ptr<SurfaceInterface> NewSurface(std::int32_t width, std::int32_t height,
                                                    bool transparent) const override;
  boost::intrusive_ptr<SurfaceInterface> NewBufferSurface(std::int32_t width, std::int32_t height,
                                                          std::int32_t rowBytes, PixelLayout layout,
                                                          void* pixels,
                                                          BufferDeleter deleter) const override;
  boost::intrusive_ptr<PenInterface> NewPen(const ColorRGBA& color, float width) const override;
  boost::intrusive_ptr<BrushInterface> NewBrush(const ColorRGBA& color) const override;
  bool SupportsLinearShaders() const override { return GetShadersEnabled(); }
  boost::intrusive_ptr<LinearShaderInterface> CreateLinearShader(
      const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
      const ColorRGBA* colors, const float* positions, std::int32_t count) const override;
  bool SupportsRadialShaders() const override { return GetShadersEnabled(); }
  boost::intrusive_ptr<RadialShaderInterface> CreateRadialShader(
      const velkcore::PointT<float>& centre, float radius, const ColorRGBA* colors,
      const float* positions, std::int32_t count) const override;
  bool SupportsAntiAliasing() const override { return true; }
  boost::intrusive_ptr<FontInterface> NewFont(const velkcore::UTF16String& family,
                                              const velkcore::UTF16String& style,
                                              float size) const override;
  boost::intrusive_ptr<ImageInterface> NewFileImage(const void* bytes, std::size_t size,
                                                    ImageFileType type) const override;
  boost::intrusive_ptr<ImageInterface> NewBufferImage(std::int32_t width, std::int32_t height,
                                                      std::int32_t rowBytes, PixelLayout layout,
                                                      void* pixels,
                                                      BufferDeleter deleter) const override;
  boost::intrusive_ptr<PathInterface> NewPath() const override;
  bool SupportsPixelLayoutBGRA() const override { return true; }
  bool PrefersPixelLayoutBGRA() const override { return true; }
};

}  // namespace velkui::pictel::cairo
