#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkui/pictel/SurfaceInterface.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

class OSImageInterface;

// A surface drawing with Cairo into an image surface (offscreen, an image, a
// caller buffer or its shadow) or straight onto a platform device context.
class OSSurfaceInterface : public SurfaceInterface {
 public:
  using SurfaceInterface::DrawImage;

  struct Target {
    // Where drawing lands.
    CairoSurfacePtr surface;
    // The image that GetSurfaceImage shows (null: the surface has none).
    boost::intrusive_ptr<OSImageInterface> image;
    // A device context that Flush copies `surface` onto (buffered surfaces).
    CairoSurfacePtr deviceContext;
    // Called on Flush and at the end with the drawn pixels (shadow buffers).
    std::function<void(cairo_surface_t*)> writeBack;
    // Device-pixel clip for the whole life of the surface.
    const OSClipRegion* clipRegion = nullptr;
    const velkcore::RectT<std::int32_t>* clipRect = nullptr;
    // Erase the drawable area first / fill it with white first.
    bool clear = false;
    bool fillWhite = false;
  };

  // Error 31 when Cairo cannot draw on the target.
  OSSurfaceInterface(const SupplierInterface* supplier, Target target);
  ~OSSurfaceInterface() override;

  void PushStateStack() override;
  void PopStateStack() override;
  void PaintRect(const ColorRGBA& color, const velkcore::RectT<float>& rect) override;
  void FillPath(const BrushInterface& brush, const PathInterface& path, FillType fillType) override;
  void StrokePath(const PenInterface& pen, const PathInterface& path) override;
  void ShadePath(const ShaderInterface& shader, const PathInterface& path,
                 FillType fillType) override;
  void Clip(const PathInterface& path, FillType fillType) override;
  velkcore::RectT<std::int32_t> GetClipBounds() const override;
  void Transform(const velkcore::MatrixT<float>& matrix) override;
  void GetTransform(velkcore::MatrixT<float>* matrix) const override;
  float MeasureStringWidth(const FontInterface& font, const char16_t* text,
                           std::int32_t length) const override;
  float MeasureMultiLineStringHeight(const FontInterface& font, const char16_t* text, float width,
                                     std::int32_t length) const override;
  void DrawImage(const ImageInterface& image, const velkcore::PointT<float>& topLeft,
                 float opacity) override;
  boost::intrusive_ptr<ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(InterpolationPolicy policy) override;
  InterpolationPolicy GetInterpolationPolicy() const override { return Top().interpolation; }
  void SetAntiAliasPolicy(AntiAliasPolicy policy) override;
  AntiAliasPolicy GetAntiAliasPolicy() const override { return Top().antiAlias; }
  void SetTextDisplayPolicy(TextDisplayPolicy policy) override;
  TextDisplayPolicy GetTextDisplayPolicy() const override { return Top().textDisplay; }
  void Flush() override;

  // The Cairo context drawing goes through, and the surface it draws into.
  cairo_t* GetOutputGraphics() const { return context_.get(); }
  cairo_surface_t* GetTargetSurface() const { return surface_.get(); }
  // Another surface that mirrors this one's policies, and the offset of this
  // surface's origin within it (drawing is translated by minus the offset).
  void SetReferenceSurface(OSSurfaceInterface* reference,
                           const velkcore::PointT<std::int32_t>& offset);
  velkcore::PointT<std::int32_t> GetReferenceOffset() const { return referenceOffset_; }
  void ApplyReferenceTransform(bool apply);
  bool IsDirty() const { return dirty_; }
  void ClearDirty() { dirty_ = false; }
  // Number of saved states above the bottom entry.
  std::size_t GetStateDepth() const { return states_.size() - 1; }

 protected:
  void DrawStringImpl(const BrushInterface& brush, const FontInterface& font, const char16_t* text,
                      const velkcore::PointT<float>& point, TextAlignment alignment) override;
  void DrawMultiLineStringImpl(const BrushInterface& brush, const FontInterface& font,
                               const char16_t* text, const velkcore::RectT<float>& rect,
                               TextAlignment alignment) override;

 private:
  struct State {
    AntiAliasPolicy antiAlias = AntiAliasPolicy::kOn;
    InterpolationPolicy interpolation = InterpolationPolicy::kHighQuality;
    TextDisplayPolicy textDisplay = TextDisplayPolicy::kAntiAliased;
    velkcore::MatrixT<float> matrix;
    // A singular (or non-finite) matrix maps everything to nothing: no drawing
    // until the state that set it is popped.
    bool degenerate = false;
  };

  class DrawScope;

  const State& Top() const { return states_.back(); }
  State& Top() { return states_.back(); }
  bool TextIsAntiAliased() const;
  void ApplyClip(const Target& target);
  void FillCurrentPath(const BrushInterface& brush, FillType fillType);
  void CheckStatus();
  void WriteBack();

  CairoSurfacePtr surface_;
  boost::intrusive_ptr<OSImageInterface> image_;
  CairoSurfacePtr deviceContext_;
  CairoContextPtr deviceGraphics_;
  std::function<void(cairo_surface_t*)> writeBack_;
  CairoContextPtr context_;
  std::vector<State> states_;
  boost::intrusive_ptr<OSSurfaceInterface> reference_;
  velkcore::PointT<std::int32_t> referenceOffset_{};
  cairo_status_t lastStatus_ = CAIRO_STATUS_SUCCESS;
  bool dirty_ = false;
};

}  // namespace velkui::pictel::cairo
