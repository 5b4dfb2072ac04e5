#include <velkui/pictel/BasicSurfaceReferenceInterface.h>

#include <velkui/pictel/CacheInterface.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;

namespace {

SurfaceInterface* RequireTarget(SurfaceInterface* target) {
  if (target == nullptr) {
    ThrowPictelError(kErrorUnableToCreateReferenceKey, kErrorUnableToCreateReference);
  }
  return target;
}

}  // namespace

BasicSurfaceReferenceInterface::BasicSurfaceReferenceInterface(const SupplierInterface* supplier,
                                                               SurfaceInterface* target,
                                                               bool saveTargetState,
                                                               const RectT<std::int32_t>* bounds)
    : SurfaceInterface(supplier),
      target_(RequireTarget(target)),
      bounds_(bounds != nullptr ? *bounds : RectT<std::int32_t>{}),
      restoreTargetState_(saveTargetState) {
  if (restoreTargetState_) target_->PushStateStack();
}

BasicSurfaceReferenceInterface::~BasicSurfaceReferenceInterface() {
  if (restoreTargetState_) target_->PopStateStack();
}

void BasicSurfaceReferenceInterface::ClipToReferenceSurface(const SupplierInterface* supplier) {
  const SupplierInterface* pathSupplier = supplier != nullptr ? supplier : GetSupplier();
  auto path = pathSupplier->NewPath();
  path->AddRect(bounds_);
  target_->Clip(*path, FillType::kWinding);
}

void BasicSurfaceReferenceInterface::PushStateStack() {
  target_->PushStateStack();
}
void BasicSurfaceReferenceInterface::PopStateStack() {
  target_->PopStateStack();
}

boost::intrusive_ptr<CacheInterface> BasicSurfaceReferenceInterface::PushCacheStack(
    const RectT<float>& rect) {
  return target_->PushCacheStack(rect);
}

void BasicSurfaceReferenceInterface::PopCacheStack(CacheInterface* cache) {
  target_->PopCacheStack(cache);
}

void BasicSurfaceReferenceInterface::PaintRect(const ColorRGBA& color, const RectT<float>& rect) {
  target_->PaintRect(color, rect);
}

void BasicSurfaceReferenceInterface::FillPath(const BrushInterface& brush,
                                              const PathInterface& path, FillType fillType) {
  target_->FillPath(brush, path, fillType);
}

void BasicSurfaceReferenceInterface::StrokePath(const PenInterface& pen,
                                                const PathInterface& path) {
  target_->StrokePath(pen, path);
}

void BasicSurfaceReferenceInterface::ShadePath(const ShaderInterface& shader,
                                               const PathInterface& path, FillType fillType) {
  target_->ShadePath(shader, path, fillType);
}

const SupplierInterface* BasicSurfaceReferenceInterface::GetOutputSupplier() const {
  return target_->GetSupplier();
}

SurfaceInterface* BasicSurfaceReferenceInterface::GetOutputSurface() {
  return target_.get();
}

void BasicSurfaceReferenceInterface::GetOutputTransform(MatrixT<float>* matrix) const {
  target_->GetOutputTransform(matrix);
}

void BasicSurfaceReferenceInterface::Clip(const PathInterface& path, FillType fillType) {
  target_->Clip(path, fillType);
}

RectT<std::int32_t> BasicSurfaceReferenceInterface::GetClipBounds() const {
  return target_->GetClipBounds();
}

RectT<std::int32_t> BasicSurfaceReferenceInterface::GetMinimumClipBounds(
    const RectT<std::int32_t>& rect) const {
  return target_->GetMinimumClipBounds(rect);
}

RectT<std::int32_t> BasicSurfaceReferenceInterface::GetMinimumHorizontalClipBounds(
    const RectT<std::int32_t>& rect) const {
  return target_->GetMinimumHorizontalClipBounds(rect);
}

RectT<std::int32_t> BasicSurfaceReferenceInterface::GetMinimumVerticalClipBounds(
    const RectT<std::int32_t>& rect) const {
  return target_->GetMinimumVerticalClipBounds(rect);
}

bool BasicSurfaceReferenceInterface::IsWithinClipBounds(const RectT<std::int32_t>& rect) const {
  return target_->IsWithinClipBounds(rect);
}

void BasicSurfaceReferenceInterface::Transform(const MatrixT<float>& matrix) {
  target_->Transform(matrix);
}

void BasicSurfaceReferenceInterface::GetTransform(MatrixT<float>* matrix) const {
  target_->GetTransform(matrix);
}

void BasicSurfaceReferenceInterface::DrawString(const BrushInterface& brush,
                                                const FontInterface& font, const char16_t* text,
                                                const PointT<float>& point, TextAlignment alignment,
                                                TextTruncation truncation, float maxWidth) {
  target_->DrawString(brush, font, text, point, alignment, truncation, maxWidth);
}

void BasicSurfaceReferenceInterface::DrawMultiLineString(const BrushInterface& brush,
                                                         const FontInterface& font,
                                                         const char16_t* text,
                                                         const RectT<float>& rect,
                                                         TextAlignment alignment) {
  target_->DrawMultiLineString(brush, font, text, rect, alignment);
}

void BasicSurfaceReferenceInterface::DrawStringWithUnderline(
    const BrushInterface& brush, const FontInterface& font, const PenInterface& pen,
    const char16_t* text, const PointT<float>& point, TextAlignment alignment,
    TextTruncation truncation, float maxWidth, std::int32_t start, std::int32_t end) {
  target_->DrawStringWithUnderline(brush, font, pen, text, point, alignment, truncation, maxWidth,
                                   start, end);
}

float BasicSurfaceReferenceInterface::MeasureStringWidth(const FontInterface& font,
                                                         const char16_t* text,
                                                         std::int32_t length) const {
  return target_->MeasureStringWidth(font, text, length);
}

float BasicSurfaceReferenceInterface::MeasureMultiLineStringHeight(const FontInterface& font,
                                                                   const char16_t* text,
                                                                   float width,
                                                                   std::int32_t length) const {
  return target_->MeasureMultiLineStringHeight(font, text, width, length);
}

float BasicSurfaceReferenceInterface::MeasureMaximumMultiLineStringWidth(
    const FontInterface& font, const velkcore::UTF16String& text) const {
  return target_->MeasureMaximumMultiLineStringWidth(font, text);
}

void BasicSurfaceReferenceInterface::DrawImage(const SupplierInterface& supplier,
                                               const ImageInterface& image,
                                               const RectT<float>& destination,
                                               const RectT<float>* source, float opacity) {
  target_->DrawImage(supplier, image, destination, source, opacity);
}

void BasicSurfaceReferenceInterface::DrawImage(const ImageInterface& image,
                                               const PointT<float>& topLeft, float opacity) {
  target_->DrawImage(image, topLeft, opacity);
}

void BasicSurfaceReferenceInterface::DrawCache(const CacheInterface& cache) {
  target_->DrawCache(cache);
}

boost::intrusive_ptr<ImageInterface> BasicSurfaceReferenceInterface::GetSurfaceImage() {
  return target_->GetSurfaceImage();
}

void BasicSurfaceReferenceInterface::SetInterpolationPolicy(InterpolationPolicy policy) {
  target_->SetInterpolationPolicy(policy);
}

InterpolationPolicy BasicSurfaceReferenceInterface::GetInterpolationPolicy() const {
  return target_->GetInterpolationPolicy();
}

void BasicSurfaceReferenceInterface::SetAntiAliasPolicy(AntiAliasPolicy policy) {
  target_->SetAntiAliasPolicy(policy);
}

AntiAliasPolicy BasicSurfaceReferenceInterface::GetAntiAliasPolicy() const {
  return target_->GetAntiAliasPolicy();
}

void BasicSurfaceReferenceInterface::SetTextDisplayPolicy(TextDisplayPolicy policy) {
  target_->SetTextDisplayPolicy(policy);
}

TextDisplayPolicy BasicSurfaceReferenceInterface::GetTextDisplayPolicy() const {
  return target_->GetTextDisplayPolicy();
}

void BasicSurfaceReferenceInterface::Flush() {
  target_->Flush();
}

void BasicSurfaceReferenceInterface::DrawStringImpl(const BrushInterface& brush,
                                                    const FontInterface& font, const char16_t* text,
                                                    const PointT<float>& point,
                                                    TextAlignment alignment) {
  target_->DrawStringImpl(brush, font, text, point, alignment);
}

void BasicSurfaceReferenceInterface::DrawMultiLineStringImpl(const BrushInterface& brush,
                                                             const FontInterface& font,
                                                             const char16_t* text,
                                                             const RectT<float>& rect,
                                                             TextAlignment alignment) {
  target_->DrawMultiLineStringImpl(brush, font, text, rect, alignment);
}

}  // namespace velkui::pictel
