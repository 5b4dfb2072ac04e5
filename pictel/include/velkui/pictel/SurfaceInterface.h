#pragma once

#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/CacheInterface.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// A drawing surface: the current transformation matrix, the clip, the three
// rendering policies and a stack of saved states. The backend supplies the pure
// operations; the others are implemented here on top of them and may be
// overridden. Text is zero-terminated UTF-16; lengths and indices count 16-bit
// units; -1 as a length means "up to the terminating zero".
//
// Overloads: an implementation that overrides one DrawImage keeps the other
// visible with `using SurfaceInterface::DrawImage;`.
class SurfaceInterface : public virtual velkcore::RefCountedObject {
 public:
  // The surface holds a reference to its supplier for its whole life.
  explicit SurfaceInterface(const SupplierInterface* supplier);
  ~SurfaceInterface() override;

  // Saves transform, clip and the three policies.
  virtual void PushStateStack() = 0;
  // Restores what the matching push saved; without a saved state it does nothing.
  virtual void PopStateStack() = 0;

  // Starts caching the drawing of `rect`; null when the area covers no pixel
  // (the caller then draws directly).
  virtual boost::intrusive_ptr<CacheInterface> PushCacheStack(const velkcore::RectT<float>& rect);
  // Ends drawing into a cache from PushCacheStack (null is allowed).
  virtual void PopCacheStack(CacheInterface* cache);

  // A rectangle with width or height <= 0 draws nothing.
  virtual void PaintRect(const ColorRGBA& color, const velkcore::RectT<float>& rect) = 0;
  virtual void FillPath(const BrushInterface& brush, const PathInterface& path,
                        FillType fillType) = 0;
  // A pen of width <= 0 draws nothing.
  virtual void StrokePath(const PenInterface& pen, const PathInterface& path) = 0;
  virtual void ShadePath(const ShaderInterface& shader, const PathInterface& path,
                         FillType fillType) = 0;

  const SupplierInterface* GetSupplier() const;
  // The supplier of GetOutputSurface.
  virtual const SupplierInterface* GetOutputSupplier() const;
  // The surface that really receives pixels (itself unless it forwards).
  virtual SurfaceInterface* GetOutputSurface();
  virtual void GetOutputTransform(velkcore::MatrixT<float>* matrix) const;

  // Intersects the clip with the path.
  virtual void Clip(const PathInterface& path, FillType fillType) = 0;
  // Visible clip bounds in whole user units.
  virtual velkcore::RectT<std::int32_t> GetClipBounds() const = 0;
  // The part of `rect` that is inside the clip bounds: the bounding box of their
  // intersection, zero width and height when they do not meet.
  virtual velkcore::RectT<std::int32_t> GetMinimumClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const;
  // Narrows only the columns (keeps top and height).
  virtual velkcore::RectT<std::int32_t> GetMinimumHorizontalClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const;
  // Narrows only the rows (keeps left and width).
  virtual velkcore::RectT<std::int32_t> GetMinimumVerticalClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const;
  // The rectangle shares at least one whole unit with the clip bounds.
  virtual bool IsWithinClipBounds(const velkcore::RectT<std::int32_t>& rect) const;

  // current = current * matrix: `matrix` applies to user coordinates first.
  virtual void Transform(const velkcore::MatrixT<float>& matrix) = 0;
  virtual void GetTransform(velkcore::MatrixT<float>* matrix) const = 0;

  // One line with its baseline at point.y; truncated to maxWidth first unless
  // `truncation` is kNone.
  virtual void DrawString(const BrushInterface& brush, const FontInterface& font,
                          const char16_t* text, const velkcore::PointT<float>& point,
                          TextAlignment alignment, TextTruncation truncation, float maxWidth);
  // Text wrapped inside the rectangle.
  virtual void DrawMultiLineString(const BrushInterface& brush, const FontInterface& font,
                                   const char16_t* text, const velkcore::RectT<float>& rect,
                                   TextAlignment alignment);
  // Draws a line of text and underlines the units start..end (inclusive).
  // Nothing at all is drawn for empty text, a negative start or start > end.
  virtual void DrawStringWithUnderline(const BrushInterface& brush, const FontInterface& font,
                                       const PenInterface& pen, const char16_t* text,
                                       const velkcore::PointT<float>& point,
                                       TextAlignment alignment, TextTruncation truncation,
                                       float maxWidth, std::int32_t start, std::int32_t end);
  virtual float MeasureStringWidth(const FontInterface& font, const char16_t* text,
                                   std::int32_t length) const = 0;
  // Height of the text wrapped to `width`.
  virtual float MeasureMultiLineStringHeight(const FontInterface& font, const char16_t* text,
                                             float width, std::int32_t length) const = 0;
  // The widest of the text's lines (split at the platform line ending).
  virtual float MeasureMaximumMultiLineStringWidth(const FontInterface& font,
                                                   const velkcore::UTF16String& text) const;

  // The image scaled into `destination`. Only the size of `source` counts: the
  // image's own top-left pixel lands on the destination's top-left corner.
  virtual void DrawImage(const SupplierInterface& supplier, const ImageInterface& image,
                         const velkcore::RectT<float>& destination,
                         const velkcore::RectT<float>* source, float opacity);
  // The whole image at its pixel size; opacity 0..1 multiplies its alpha.
  virtual void DrawImage(const ImageInterface& image, const velkcore::PointT<float>& topLeft,
                         float opacity) = 0;
  // Blits a cache made by PushCacheStack (error 30 for any other kind of cache).
  virtual void DrawCache(const CacheInterface& cache);
  // The surface's pixels as an image (shares them, it is not a copy). A surface
  // without pixels of its own returns null, or raises error 35 on the platform backend.
  virtual boost::intrusive_ptr<ImageInterface> GetSurfaceImage() = 0;

  // Setters raise 23/24 for out-of-range values and then change nothing.
  virtual void SetInterpolationPolicy(InterpolationPolicy policy) = 0;
  virtual InterpolationPolicy GetInterpolationPolicy() const = 0;
  virtual void SetAntiAliasPolicy(AntiAliasPolicy policy) = 0;
  virtual AntiAliasPolicy GetAntiAliasPolicy() const = 0;
  virtual void SetTextDisplayPolicy(TextDisplayPolicy policy) = 0;
  virtual TextDisplayPolicy GetTextDisplayPolicy() const = 0;

  // Pushes pending output to the device.
  virtual void Flush() = 0;

 protected:
  // One line, no truncation, baseline at point.y.
  virtual void DrawStringImpl(const BrushInterface& brush, const FontInterface& font,
                              const char16_t* text, const velkcore::PointT<float>& point,
                              TextAlignment alignment) = 0;
  virtual void DrawMultiLineStringImpl(const BrushInterface& brush, const FontInterface& font,
                                       const char16_t* text, const velkcore::RectT<float>& rect,
                                       TextAlignment alignment) = 0;

 private:
  friend class BasicSurfaceReferenceInterface;

  boost::intrusive_ptr<const SupplierInterface> supplier_;
};

// Saves the surface state for a scope and restores it on every way out.
class ScopedSurfaceState {
 public:
  explicit ScopedSurfaceState(SurfaceInterface& surface) : surface_(surface) {
    surface_.PushStateStack();
  }
  ~ScopedSurfaceState() { surface_.PopStateStack(); }
  ScopedSurfaceState(const ScopedSurfaceState&) = delete;
  ScopedSurfaceState& operator=(const ScopedSurfaceState&) = delete;

 private:
  SurfaceInterface& surface_;
};

}  // namespace velkui::pictel
