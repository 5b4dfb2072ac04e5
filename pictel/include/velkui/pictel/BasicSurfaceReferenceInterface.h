#pragma once

#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::pictel {

// A forwarding surface: every operation goes to the target, which really
// receives the pixels. GetSupplier stays the reference's own supplier.
class BasicSurfaceReferenceInterface : public SurfaceInterface {
 public:
  // A null target raises error 33. With `saveTargetState` the target's state is
  // saved now and restored when the reference dies, so that transforms, clips and
  // policies set through the reference do not outlive it. `bounds` (null: all
  // zero) is the area ClipToReferenceSurface clips to.
  BasicSurfaceReferenceInterface(const SupplierInterface* supplier, SurfaceInterface* target,
                                 bool saveTargetState, const velkcore::RectT<std::int32_t>* bounds);
  ~BasicSurfaceReferenceInterface() override;

  // Clips the target to the stored bounds (a path made by `supplier`).
  void ClipToReferenceSurface(const SupplierInterface* supplier);
  const velkcore::RectT<std::int32_t>& GetReferenceBounds() const { return bounds_; }
  SurfaceInterface* GetTarget() const { return target_.get(); }

  void PushStateStack() override;
  void PopStateStack() override;
  boost::intrusive_ptr<CacheInterface> PushCacheStack(const velkcore::RectT<float>& rect) override;
  void PopCacheStack(CacheInterface* cache) override;
  void PaintRect(const ColorRGBA& color, const velkcore::RectT<float>& rect) override;
  void FillPath(const BrushInterface& brush, const PathInterface& path, FillType fillType) override;
  void StrokePath(const PenInterface& pen, const PathInterface& path) override;
  void ShadePath(const ShaderInterface& shader, const PathInterface& path,
                 FillType fillType) override;
  const SupplierInterface* GetOutputSupplier() const override;
  SurfaceInterface* GetOutputSurface() override;
  void GetOutputTransform(velkcore::MatrixT<float>* matrix) const override;
  void Clip(const PathInterface& path, FillType fillType) override;
  velkcore::RectT<std::int32_t> GetClipBounds() const override;
  velkcore::RectT<std::int32_t> GetMinimumClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const override;
  velkcore::RectT<std::int32_t> GetMinimumHorizontalClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const override;
  velkcore::RectT<std::int32_t> GetMinimumVerticalClipBounds(
      const velkcore::RectT<std::int32_t>& rect) const override;
  bool IsWithinClipBounds(const velkcore::RectT<std::int32_t>& rect) const override;
  void Transform(const velkcore::MatrixT<float>& matrix) override;
  void GetTransform(velkcore::MatrixT<float>* matrix) const override;
  void DrawString(const BrushInterface& brush, const FontInterface& font, const char16_t* text,
                  const velkcore::PointT<float>& point, TextAlignment alignment,
                  TextTruncation truncation, float maxWidth) override;
  void DrawMultiLineString(const BrushInterface& brush, const FontInterface& font,
                           const char16_t* text, const velkcore::RectT<float>& rect,
                           TextAlignment alignment) override;
  void DrawStringWithUnderline(const BrushInterface& brush, const FontInterface& font,
                               const PenInterface& pen, const char16_t* text,
                               const velkcore::PointT<float>& point, TextAlignment alignment,
                               TextTruncation truncation, float maxWidth, std::int32_t start,
                               std::int32_t end) override;
  float MeasureStringWidth(const FontInterface& font, const char16_t* text,
                           std::int32_t length) const override;
  float MeasureMultiLineStringHeight(const FontInterface& font, const char16_t* text, float width,
                                     std::int32_t length) const override;
  float MeasureMaximumMultiLineStringWidth(const FontInterface& font,
                                           const velkcore::UTF16String& text) const override;
  void DrawImage(const SupplierInterface& supplier, const ImageInterface& image,
                 const velkcore::RectT<float>& destination, const velkcore::RectT<float>* source,
                 float opacity) override;
  void DrawImage(const ImageInterface& image, const velkcore::PointT<float>& topLeft,
                 float opacity) override;
  void DrawCache(const CacheInterface& cache) override;
  boost::intrusive_ptr<ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(InterpolationPolicy policy) override;
  InterpolationPolicy GetInterpolationPolicy() const override;
  void SetAntiAliasPolicy(AntiAliasPolicy policy) override;
  AntiAliasPolicy GetAntiAliasPolicy() const override;
  void SetTextDisplayPolicy(TextDisplayPolicy policy) override;
  TextDisplayPolicy GetTextDisplayPolicy() const override;
  void Flush() override;

 protected:
  void DrawStringImpl(const BrushInterface& brush, const FontInterface& font, const char16_t* text,
                      const velkcore::PointT<float>& point, TextAlignment alignment) override;
  void DrawMultiLineStringImpl(const BrushInterface& brush, const FontInterface& font,
                               const char16_t* text, const velkcore::RectT<float>& rect,
                               TextAlignment alignment) override;

 private:
  boost::intrusive_ptr<SurfaceInterface> target_;
  velkcore::RectT<std::int32_t> bounds_;
  bool restoreTargetState_;
};

}  // namespace velkui::pictel
