#include <velkui/pictel/SurfaceInterface.h>

#include <algorithm>
#include <cmath>
#include <string_view>

#include <velkcore/Error.h>
#include <velkui/pictel/BitmapCacheInterface.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/StringTruncation.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;

namespace {

float AlignmentShift(TextAlignment alignment, float width) {
  switch (alignment) {
    case TextAlignment::kCenter:
      return width * 0.5f;
    case TextAlignment::kEnd:
      return width;
    case TextAlignment::kStart:
      break;
  }
  return 0.0f;
}

bool IsUnitScale(float scale) {
  return std::fabs(static_cast<double>(scale) - 1.0) < 1e-12;
}

}  // namespace

SurfaceInterface::SurfaceInterface(const SupplierInterface* supplier) : supplier_(supplier) {
  velkcore::RequireInput(supplier != nullptr);
}

SurfaceInterface::~SurfaceInterface() = default;

boost::intrusive_ptr<CacheInterface> SurfaceInterface::PushCacheStack(const RectT<float>& rect) {
  auto cache = velkcore::MakeIntrusive<BitmapCacheInterface>(*this, rect);
  if (cache->GetSurface() == nullptr) return nullptr;
  return cache;
}

void SurfaceInterface::PopCacheStack(CacheInterface* cache) {
  if (cache == nullptr) return;
  if (SurfaceInterface* surface = cache->GetSurface()) surface->Flush();
}

const SupplierInterface* SurfaceInterface::GetSupplier() const {
  return supplier_.get();
}

const SupplierInterface* SurfaceInterface::GetOutputSupplier() const {
  return GetSupplier();
}

SurfaceInterface* SurfaceInterface::GetOutputSurface() {
  return this;
}

void SurfaceInterface::GetOutputTransform(MatrixT<float>* matrix) const {
  velkcore::RequireInput(matrix != nullptr);
  *matrix = MatrixT<float>::Identity();
}

// The literal column-by-column search of the clip narrowing can only find a
// one-unit strip; the intended result is the rectangle's overlap with the clip
// bounds, which is what these return.

RectT<std::int32_t> SurfaceInterface::GetMinimumClipBounds(const RectT<std::int32_t>& rect) const {
  return GetMinimumHorizontalClipBounds(GetMinimumVerticalClipBounds(rect));
}

RectT<std::int32_t> SurfaceInterface::GetMinimumHorizontalClipBounds(
    const RectT<std::int32_t>& rect) const {
  if (!IsWithinClipBounds(rect)) return {rect.left, rect.top, 0, rect.height};
  const RectT<std::int32_t> overlap = velkcore::Intersection(rect, GetClipBounds());
  return {overlap.left, rect.top, overlap.width, rect.height};
}

RectT<std::int32_t> SurfaceInterface::GetMinimumVerticalClipBounds(
    const RectT<std::int32_t>& rect) const {
  if (!IsWithinClipBounds(rect)) return {rect.left, rect.top, rect.width, 0};
  const RectT<std::int32_t> overlap = velkcore::Intersection(rect, GetClipBounds());
  return {rect.left, overlap.top, rect.width, overlap.height};
}

bool SurfaceInterface::IsWithinClipBounds(const RectT<std::int32_t>& rect) const {
  const RectT<std::int32_t> overlap = velkcore::Intersection(rect, GetClipBounds());
  return overlap.width >= 1 && overlap.height >= 1;
}

void SurfaceInterface::DrawString(const BrushInterface& brush, const FontInterface& font,
                                  const char16_t* text, const PointT<float>& point,
                                  TextAlignment alignment, TextTruncation truncation,
                                  float maxWidth) {
  velkcore::RequireInput(text != nullptr);
  if (truncation == TextTruncation::kNone) {
    if (*text != 0) DrawStringImpl(brush, font, text, point, alignment);
    return;
  }
  const velkcore::UTF16String shown = TruncateString(font, text, truncation, maxWidth);
  if (!shown.empty()) DrawStringImpl(brush, font, shown.c_str(), point, alignment);
}

void SurfaceInterface::DrawMultiLineString(const BrushInterface& brush, const FontInterface& font,
                                           const char16_t* text, const RectT<float>& rect,
                                           TextAlignment alignment) {
  velkcore::RequireInput(text != nullptr);
  if (*text == 0) return;
  DrawMultiLineStringImpl(brush, font, text, rect, alignment);
}

void SurfaceInterface::DrawStringWithUnderline(const BrushInterface& brush,
                                               const FontInterface& font, const PenInterface& pen,
                                               const char16_t* text, const PointT<float>& point,
                                               TextAlignment alignment, TextTruncation truncation,
                                               float maxWidth, std::int32_t start,
                                               std::int32_t end) {
  velkcore::RequireInput(text != nullptr);
  if (*text == 0 || start < 0 || start > end) return;

  velkcore::UTF16String shown(text);
  if (maxWidth != 0.0f && truncation != TextTruncation::kNone) {
    shown = TruncateString(font, text, truncation, maxWidth);
    if (shown.empty()) return;
  }
  const auto length = static_cast<std::int32_t>(shown.size());

  const float textWidth = MeasureStringWidth(font, shown.c_str(), length);
  const float originX = point.x - AlignmentShift(alignment, textWidth);

  // An underline that reaches past the text is clipped to it.
  const std::int32_t last = std::min(end, length - 1);
  const bool hasUnderline = start <= last;

  ScopedSurfaceState state(*this);
  if (hasUnderline) {
    const float before = start == 0 ? 0.0f : MeasureStringWidth(font, shown.c_str(), start);
    const float underlined = MeasureStringWidth(font, shown.c_str() + start, last - start + 1);
    const float left = originX + before;
    const auto y = static_cast<std::int32_t>(std::lround(point.y + 2.0f));
    const auto x0 = static_cast<std::int32_t>(std::lround(left));
    const auto x1 = static_cast<std::int32_t>(std::lround(left + underlined));

    auto path = GetSupplier()->NewPath();
    path->MoveTo(PointT<std::int32_t>{x0, y});
    path->LineTo(PointT<std::int32_t>{x1, y});
    const AntiAliasPolicy previous = GetAntiAliasPolicy();
    SetAntiAliasPolicy(AntiAliasPolicy::kOff);
    StrokePath(pen, *path);
    SetAntiAliasPolicy(previous);
  }
  DrawStringImpl(brush, font, shown.c_str(), point, alignment);
}

float SurfaceInterface::MeasureMaximumMultiLineStringWidth(
    const FontInterface& font, const velkcore::UTF16String& text) const {
  const std::u16string_view lineEnding = GetLineEnding();
  float widest = 0.0f;
  std::size_t from = 0;
  while (from <= text.size()) {
    std::size_t to = text.find(lineEnding, from);
    if (to == velkcore::UTF16String::npos) to = text.size();
    std::size_t lineEnd = to;
    // Text written elsewhere may carry "\r\n" endings.
    if (lineEnd > from && text[lineEnd - 1] == u'\r') --lineEnd;
    if (lineEnd > from) {
      widest = std::max(widest, MeasureStringWidth(font, text.c_str() + from,
                                                   static_cast<std::int32_t>(lineEnd - from)));
    }
    from = to + lineEnding.size();
  }
  return widest;
}

void SurfaceInterface::DrawImage(const SupplierInterface& supplier, const ImageInterface& image,
                                 const RectT<float>& destination, const RectT<float>* source,
                                 float opacity) {
  if (!(destination.width > 0.0f) || !(destination.height > 0.0f)) return;
  const float sourceWidth =
      source != nullptr ? source->width : static_cast<float>(image.GetWidth());
  const float sourceHeight =
      source != nullptr ? source->height : static_cast<float>(image.GetHeight());
  // A zero source would need a singular matrix: there is nothing to show.
  if (!(sourceWidth > 0.0f) || !(sourceHeight > 0.0f)) return;
  const float scaleX = destination.width / sourceWidth;
  const float scaleY = destination.height / sourceHeight;

  ScopedSurfaceState state(*this);
  auto clip = supplier.NewPath();
  clip->AddRect(destination);
  Clip(*clip, FillType::kWinding);
  // The translation is applied outermost so that the image's top-left pixel
  // lands on the destination's corner whatever the scale.
  Transform(MatrixT<float>::Translation(destination.left, destination.top));
  if (IsUnitScale(scaleX) && IsUnitScale(scaleY)) {
    SetAntiAliasPolicy(AntiAliasPolicy::kOff);
  } else {
    Transform(MatrixT<float>::Scale(scaleX, scaleY));
  }
  DrawImage(image, PointT<float>{0.0f, 0.0f}, opacity);
}

void SurfaceInterface::DrawCache(const CacheInterface& cache) {
  const auto* bitmapCache = dynamic_cast<const BitmapCacheInterface*>(&cache);
  if (bitmapCache == nullptr) ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
  auto* cacheSurface = bitmapCache->GetCacheSurface();
  if (cacheSurface == nullptr) return;
  const auto image = cacheSurface->GetSurfaceImage();
  if (!image) return;

  MatrixT<float> current;
  GetTransform(&current);
  if (current.Determinant() == 0.0f || !std::isfinite(current.Determinant())) return;

  // The bitmap holds device pixels: undo the current matrix only and blit it at
  // its recorded pixel origin (undoing the recorded matrix as well would apply
  // the inverse twice).
  ScopedSurfaceState state(*this);
  Transform(current.Inverted());
  SetInterpolationPolicy(InterpolationPolicy::kNearestNeighbor);
  const RectT<std::int32_t>& origin = bitmapCache->GetPixelBounds();
  DrawImage(*image, PointT<float>{static_cast<float>(origin.left), static_cast<float>(origin.top)},
            1.0f);
}

}  // namespace velkui::pictel
