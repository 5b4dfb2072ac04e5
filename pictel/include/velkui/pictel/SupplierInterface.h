#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/BrushInterface.h>
#include <velkui/pictel/FontInterface.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/PictelTypes.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::pictel {

// The factory of drawing resources of a window. Every factory returns a new
// object; the returned pointer holds the first reference. Suppliers live on the
// heap (surfaces keep a reference to theirs).
class SupplierInterface : public virtual velkcore::RefCountedObject {
 public:
  ~SupplierInterface() override = default;

  // A surface on a platform device context, clipped to `clipRegion` when given.
  // `buffered` draws into an offscreen copy that Flush writes to the context.
  virtual boost::intrusive_ptr<SurfaceInterface> NewOSSurface(OSDeviceContext context,
                                                              const OSClipRegion* clipRegion,
                                                              bool buffered) const = 0;
  // A surface that draws into `image` (one made by this supplier); `clear`
  // erases the image first; `bounds` (image pixels) limits drawing when given.
  virtual boost::intrusive_ptr<SurfaceInterface> NewImageSurface(
      ImageInterface* image, bool clear, const velkcore::RectT<std::int32_t>* bounds) const = 0;
  // An offscreen surface; it starts fully transparent when `transparent` is set,
  // else opaque white.
  virtual boost::intrusive_ptr<SurfaceInterface> NewSurface(std::int32_t width, std::int32_t height,
                                                            bool transparent) const = 0;
  // A surface over caller memory; `deleter` runs when the last user of the pixels
  // dies (not when the factory fails: the caller still owns the memory then).
  virtual boost::intrusive_ptr<SurfaceInterface> NewBufferSurface(std::int32_t width,
                                                                  std::int32_t height,
                                                                  std::int32_t rowBytes,
                                                                  PixelLayout layout, void* pixels,
                                                                  BufferDeleter deleter) const = 0;
  virtual boost::intrusive_ptr<PenInterface> NewPen(const ColorRGBA& color, float width) const = 0;
  virtual boost::intrusive_ptr<BrushInterface> NewBrush(const ColorRGBA& color) const = 0;
  virtual bool SupportsLinearShaders() const = 0;
  // Colour stops at positions 0..1 along start -> end.
  virtual boost::intrusive_ptr<LinearShaderInterface> CreateLinearShader(
      const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
      const ColorRGBA* colors, const float* positions, std::int32_t count) const = 0;
  virtual bool SupportsRadialShaders() const = 0;
  // Colour stops at positions 0 (centre) .. 1 (radius).
  virtual boost::intrusive_ptr<RadialShaderInterface> CreateRadialShader(
      const velkcore::PointT<float>& centre, float radius, const ColorRGBA* colors,
      const float* positions, std::int32_t count) const = 0;
  // Whether drawing is anti-aliased when the surface's policy asks for it.
  virtual bool SupportsAntiAliasing() const = 0;
  // Style "Bold", "Italic", "Bold Italic"; anything else is regular. Size in pixels.
  virtual boost::intrusive_ptr<FontInterface> NewFont(const velkcore::UTF16String& family,
                                                      const velkcore::UTF16String& style,
                                                      float size) const = 0;
  // Decodes an encoded image held in memory.
  virtual boost::intrusive_ptr<ImageInterface> NewFileImage(const void* bytes, std::size_t size,
                                                            ImageFileType type) const = 0;
  // An image over caller memory; `deleter` runs when the last user of the pixels dies.
  virtual boost::intrusive_ptr<ImageInterface> NewBufferImage(std::int32_t width,
                                                              std::int32_t height,
                                                              std::int32_t rowBytes,
                                                              PixelLayout layout, void* pixels,
                                                              BufferDeleter deleter) const = 0;
  virtual boost::intrusive_ptr<PathInterface> NewPath() const = 0;
  virtual bool PrefersToCacheAggressively() const { return false; }
  virtual bool SupportsPixelLayoutBGRA() const { return false; }
  virtual bool PrefersPixelLayoutBGRA() const { return false; }
  virtual bool SupportsPixelLayoutARGB() const { return false; }
  virtual bool PrefersPixelLayoutARGB() const { return false; }

  bool GetShadersEnabled() const { return shadersEnabled_; }
  void SetShadersEnabled(bool enabled) { shadersEnabled_ = enabled; }

  // Two stops, `from` at 0 and `to` at 1.
  boost::intrusive_ptr<LinearShaderInterface> NewLinearShader(const velkcore::PointT<float>& start,
                                                              const velkcore::PointT<float>& end,
                                                              const ColorRGBA& from,
                                                              const ColorRGBA& to) const;
  // (position, colour) stops; a last stop before 1 is extended to 1 with its colour.
  boost::intrusive_ptr<LinearShaderInterface> NewLinearShader(
      const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
      const std::vector<std::pair<float, ColorRGBA>>& stops) const;

 private:
  bool shadersEnabled_ = true;
};

}  // namespace velkui::pictel
