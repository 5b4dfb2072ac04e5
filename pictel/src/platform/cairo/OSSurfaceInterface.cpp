#include "OSSurfaceInterface.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>

#include "CairoColor.h"
#include "OSBrushInterface.h"
#include "OSFontInterface.h"
#include "OSImageInterface.h"
#include "OSPathInterface.h"
#include "OSPenInterface.h"

namespace velkui::pictel::cairo {

using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;

namespace {

[[noreturn]] void ThrowWrongKind() {
  ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
}

template <typename Wanted, typename Given>
const Wanted& As(const Given& given) {
  const auto* wanted = dynamic_cast<const Wanted*>(&given);
  if (wanted == nullptr) ThrowWrongKind();
  return *wanted;
}

cairo_fill_rule_t ToCairo(FillType type) {
  return type == FillType::kEvenOdd ? CAIRO_FILL_RULE_EVEN_ODD : CAIRO_FILL_RULE_WINDING;
}

cairo_antialias_t ToCairo(AntiAliasPolicy policy) {
  switch (policy) {
    case AntiAliasPolicy::kOff:
      return CAIRO_ANTIALIAS_NONE;
    case AntiAliasPolicy::kHighQuality:
      return CAIRO_ANTIALIAS_BEST;
    case AntiAliasPolicy::kOn:
      break;
  }
  return CAIRO_ANTIALIAS_DEFAULT;
}

cairo_filter_t ToCairo(InterpolationPolicy policy) {
  switch (policy) {
    case InterpolationPolicy::kNearestNeighbor:
      return CAIRO_FILTER_NEAREST;
    case InterpolationPolicy::kLowQuality:
      return CAIRO_FILTER_BILINEAR;
    case InterpolationPolicy::kHighQuality:
      break;
  }
  return CAIRO_FILTER_GOOD;
}

cairo_matrix_t ToCairo(const MatrixT<float>& m) {
  cairo_matrix_t matrix;
  cairo_matrix_init(&matrix, m.a, m.b, m.c, m.d, m.tx, m.ty);
  return matrix;
}

// Whether Cairo can work with the matrix; a singular one maps everything to nothing.
bool IsUsable(const MatrixT<float>& m) {
  const float entries[6] = {m.a, m.b, m.c, m.d, m.tx, m.ty};
  if (!std::all_of(std::begin(entries), std::end(entries),
                   [](float v) { return std::isfinite(v); })) {
    return false;
  }
  const double determinant = static_cast<double>(m.a) * m.d - static_cast<double>(m.b) * m.c;
  return std::fabs(determinant) > 1e-12;
}

void RequireFinite(const RectT<float>& rect) {
  velkcore::RequireInput(std::isfinite(rect.left) && std::isfinite(rect.top) &&
                         std::isfinite(rect.width) && std::isfinite(rect.height));
}

std::int32_t ToIntClamped(double value) {
  constexpr double kLimit = 1 << 30;
  return static_cast<std::int32_t>(std::clamp(value, -kLimit, kLimit));
}

// A 1-unit stroke along whole-numbered coordinates straddles two pixel rows in
// Cairo's pixel-edge convention. Half a device pixel moves an odd-width line
// onto whole pixels, so that it covers exactly the row (or column) it names.
double HalfPixelShift(double deviceWidth) {
  const long rounded = std::lround(deviceWidth);
  return rounded % 2 == 1 ? 0.5 : 0.0;
}

}  // namespace

// Fills and strokes of a surface with a reference surface are drawn in the
// reference's coordinates.
class OSSurfaceInterface::DrawScope {
 public:
  explicit DrawScope(OSSurfaceInterface& surface) : surface_(surface) {
    if (surface_.reference_) {
      cairo_save(surface_.context_.get());
      cairo_translate(surface_.context_.get(), -surface_.referenceOffset_.x,
                      -surface_.referenceOffset_.y);
    }
  }
  ~DrawScope() {
    if (surface_.reference_) cairo_restore(surface_.context_.get());
  }
  DrawScope(const DrawScope&) = delete;
  DrawScope& operator=(const DrawScope&) = delete;

 private:
  OSSurfaceInterface& surface_;
};

OSSurfaceInterface::OSSurfaceInterface(const SupplierInterface* supplier, Target target)
    : SurfaceInterface(supplier),
      surface_(std::move(target.surface)),
      image_(std::move(target.image)),
      deviceContext_(std::move(target.deviceContext)),
      writeBack_(std::move(target.writeBack)) {
  if (!surface_ || cairo_surface_status(surface_.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowPictelError(kErrorUnableToCreateSurfaceKey, kErrorUnableToCreateSurface);
  }
  context_.reset(cairo_create(surface_.get()));
  if (cairo_status(context_.get()) != CAIRO_STATUS_SUCCESS) {
    ThrowPictelError(kErrorUnableToCreateSurfaceKey, kErrorUnableToCreateSurface);
  }
  if (deviceContext_) {
    deviceGraphics_.reset(cairo_create(deviceContext_.get()));
    if (cairo_status(deviceGraphics_.get()) != CAIRO_STATUS_SUCCESS) {
      ThrowPictelError(kErrorUnableToCreateSurfaceKey, kErrorUnableToCreateSurface);
    }
    cairo_set_operator(deviceGraphics_.get(), CAIRO_OPERATOR_SOURCE);
  }
  states_.emplace_back();
  ApplyClip(target);
  cairo_set_antialias(context_.get(), ToCairo(Top().antiAlias));
  if (target.clear) {
    cairo_set_operator(context_.get(), CAIRO_OPERATOR_CLEAR);
    cairo_paint(context_.get());
    cairo_set_operator(context_.get(), CAIRO_OPERATOR_OVER);
  }
  if (target.fillWhite) {
    cairo_set_source_rgb(context_.get(), 1, 1, 1);
    cairo_paint(context_.get());
  }
  CheckStatus();
}

OSSurfaceInterface::~OSSurfaceInterface() {
  // Pixels drawn into a shadow buffer reach the caller's memory even without a Flush.
  WriteBack();
}

void OSSurfaceInterface::ApplyClip(const Target& target) {
  const auto clipTo = [&](cairo_t* context) {
    if (target.clipRegion != nullptr) {
      cairo_new_path(context);
      for (const auto& r : target.clipRegion->rects) {
        cairo_rectangle(context, r.left, r.top, std::max(0, r.width), std::max(0, r.height));
      }
      cairo_set_fill_rule(context, CAIRO_FILL_RULE_WINDING);
      cairo_clip(context);
    }
    if (target.clipRect != nullptr) {
      const auto& r = *target.clipRect;
      cairo_rectangle(context, r.left, r.top, std::max(0, r.width), std::max(0, r.height));
      cairo_clip(context);
    }
  };
  clipTo(context_.get());
  if (deviceGraphics_) clipTo(deviceGraphics_.get());
}

void OSSurfaceInterface::CheckStatus() {
  cairo_status_t status = cairo_status(context_.get());
  if (status == CAIRO_STATUS_SUCCESS && deviceGraphics_)
    status = cairo_status(deviceGraphics_.get());
  if (status == CAIRO_STATUS_SUCCESS) return;
  lastStatus_ = status;
  ThrowPictelError(kErrorUnspecifiedKey, kErrorUnspecified);
}

void OSSurfaceInterface::WriteBack() {
  if (!writeBack_) return;
  cairo_surface_flush(surface_.get());
  writeBack_(surface_.get());
}

void OSSurfaceInterface::PushStateStack() {
  cairo_save(context_.get());
  states_.push_back(Top());
}

void OSSurfaceInterface::PopStateStack() {
  if (states_.size() <= 1) return;
  // Cairo's own state (matrix, clip, anti-aliasing) comes back with the restore.
  cairo_restore(context_.get());
  states_.pop_back();
}

bool OSSurfaceInterface::TextIsAntiAliased() const {
  // Glyphs are smoothed in grey whatever the text-display policy: sub-pixel
  // smoothing would tie the pixels to one screen's sub-pixel order.
  return Top().antiAlias != AntiAliasPolicy::kOff;
}

void OSSurfaceInterface::PaintRect(const ColorRGBA& color, const RectT<float>& rect) {
  RequireFinite(rect);
  if (!(rect.width > 0.0f) || !(rect.height > 0.0f) || Top().degenerate) return;
  DrawScope scope(*this);
  cairo_t* context = context_.get();
  SetSourceColor(context, color);
  cairo_rectangle(context, rect.left, rect.top, rect.width, rect.height);
  cairo_fill(context);
  dirty_ = true;
  CheckStatus();
}

void OSSurfaceInterface::FillCurrentPath(const BrushInterface& brush, FillType fillType) {
  cairo_t* context = context_.get();
  As<OSBrushInterface>(brush).ApplySource(context);
  cairo_set_fill_rule(context, ToCairo(fillType));
  cairo_fill(context);
  dirty_ = true;
  CheckStatus();
}

void OSSurfaceInterface::FillPath(const BrushInterface& brush, const PathInterface& path,
                                  FillType fillType) {
  ValidateFillType(fillType);
  const auto& figures = As<OSPathInterface>(path);
  As<OSBrushInterface>(brush);
  if (Top().degenerate || figures.IsEmpty()) return;
  DrawScope scope(*this);
  cairo_new_path(context_.get());
  figures.AppendTo(context_.get());
  FillCurrentPath(brush, fillType);
}

void OSSurfaceInterface::ShadePath(const ShaderInterface& shader, const PathInterface& path,
                                   FillType fillType) {
  ValidateFillType(fillType);
  const auto& figures = As<OSPathInterface>(path);
  const auto& gradient = As<OSBrushInterface>(shader);
  if (Top().degenerate || figures.IsEmpty()) return;
  DrawScope scope(*this);
  cairo_new_path(context_.get());
  figures.AppendTo(context_.get());
  FillCurrentPath(gradient, fillType);
}

void OSSurfaceInterface::StrokePath(const PenInterface& pen, const PathInterface& path) {
  const auto& osPen = As<OSPenInterface>(pen);
  const auto& figures = As<OSPathInterface>(path);
  if (!osPen.Draws() || Top().degenerate || figures.IsEmpty()) return;
  DrawScope scope(*this);
  cairo_t* context = context_.get();
  cairo_new_path(context);
  cairo_matrix_t matrix;
  cairo_get_matrix(context, &matrix);
  const bool axisAligned = matrix.xy == 0.0 && matrix.yx == 0.0;
  if (figures.IsWholeNumbered() && axisAligned) {
    // Only across the segments: a horizontal line keeps its ends on pixel edges.
    cairo_matrix_t shifted = matrix;
    if (figures.SpansY()) shifted.x0 += HalfPixelShift(osPen.GetWidth() * std::fabs(matrix.xx));
    if (figures.SpansX()) shifted.y0 += HalfPixelShift(osPen.GetWidth() * std::fabs(matrix.yy));
    cairo_set_matrix(context, &shifted);
    figures.AppendTo(context);
    cairo_set_matrix(context, &matrix);
  } else {
    figures.AppendTo(context);
  }
  osPen.Apply(context);
  cairo_stroke(context);
  dirty_ = true;
  CheckStatus();
}

void OSSurfaceInterface::Clip(const PathInterface& path, FillType fillType) {
  ValidateFillType(fillType);
  const auto& figures = As<OSPathInterface>(path);
  cairo_t* context = context_.get();
  cairo_new_path(context);
  // Under a singular matrix the path covers nothing, so the clip becomes empty.
  if (!Top().degenerate) figures.AppendTo(context);
  cairo_set_fill_rule(context, ToCairo(fillType));
  cairo_clip(context);
  CheckStatus();
}

RectT<std::int32_t> OSSurfaceInterface::GetClipBounds() const {
  if (Top().degenerate) return {};
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
  cairo_clip_extents(context_.get(), &x1, &y1, &x2, &y2);
  const std::int32_t left = ToIntClamped(std::floor(x1));
  const std::int32_t top = ToIntClamped(std::floor(y1));
  const std::int32_t right = ToIntClamped(std::ceil(x2));
  const std::int32_t bottom = ToIntClamped(std::ceil(y2));
  return {left, top, std::max(0, right - left), std::max(0, bottom - top)};
}

void OSSurfaceInterface::Transform(const MatrixT<float>& matrix) {
  State& state = Top();
  state.matrix = state.matrix.Concat(matrix);
  if (state.degenerate) return;
  if (!IsUsable(state.matrix)) {
    state.degenerate = true;
    return;
  }
  const cairo_matrix_t cairoMatrix = ToCairo(state.matrix);
  cairo_set_matrix(context_.get(), &cairoMatrix);
  CheckStatus();
}

void OSSurfaceInterface::GetTransform(MatrixT<float>* matrix) const {
  velkcore::RequireInput(matrix != nullptr);
  *matrix = Top().matrix;
}

float OSSurfaceInterface::MeasureStringWidth(const FontInterface& font, const char16_t* text,
                                             std::int32_t length) const {
  return font.MeasureStringWidth(text, length);
}

float OSSurfaceInterface::MeasureMultiLineStringHeight(const FontInterface& font,
                                                       const char16_t* text, float width,
                                                       std::int32_t length) const {
  return font.MeasureMultiLineStringHeight(text, length, width);
}

void OSSurfaceInterface::DrawImage(const ImageInterface& image, const PointT<float>& topLeft,
                                   float opacity) {
  const auto& osImage = As<OSImageInterface>(image);
  velkcore::RequireInput(std::isfinite(topLeft.x) && std::isfinite(topLeft.y));
  if (Top().degenerate || !(opacity > 0.0f)) return;
  DrawScope scope(*this);
  cairo_t* context = context_.get();
  cairo_set_source_surface(context, osImage.GetCairoSurface(), topLeft.x, topLeft.y);
  cairo_pattern_set_filter(cairo_get_source(context), ToCairo(Top().interpolation));
  if (opacity >= 1.0f) {
    cairo_paint(context);
  } else {
    cairo_paint_with_alpha(context, opacity);
  }
  // Let go of the image: the context must not keep its pixels alive.
  cairo_set_source_rgb(context, 0, 0, 0);
  dirty_ = true;
  CheckStatus();
}

boost::intrusive_ptr<ImageInterface> OSSurfaceInterface::GetSurfaceImage() {
  if (!image_) ThrowPictelError(kErrorInvalidSurfaceImageKey, kErrorInvalidSurfaceImage);
  cairo_surface_flush(surface_.get());
  return image_;
}

void OSSurfaceInterface::SetInterpolationPolicy(InterpolationPolicy policy) {
  ValidateInterpolationPolicy(policy);
  Top().interpolation = policy;
  if (reference_) reference_->SetInterpolationPolicy(policy);
}

void OSSurfaceInterface::SetAntiAliasPolicy(AntiAliasPolicy policy) {
  ValidateAntiAliasPolicy(policy);
  Top().antiAlias = policy;
  cairo_set_antialias(context_.get(), ToCairo(policy));
  if (reference_) reference_->SetAntiAliasPolicy(policy);
}

void OSSurfaceInterface::SetTextDisplayPolicy(TextDisplayPolicy policy) {
  Top().textDisplay = policy;
  if (reference_) reference_->SetTextDisplayPolicy(policy);
}

void OSSurfaceInterface::Flush() {
  cairo_surface_flush(surface_.get());
  WriteBack();
  if (deviceGraphics_) {
    cairo_t* device = deviceGraphics_.get();
    cairo_set_source_surface(device, surface_.get(), 0, 0);
    cairo_pattern_set_filter(cairo_get_source(device), CAIRO_FILTER_NEAREST);
    cairo_paint(device);
    cairo_set_source_rgb(device, 0, 0, 0);
    cairo_surface_flush(deviceContext_.get());
  }
  dirty_ = false;
  CheckStatus();
}

void OSSurfaceInterface::SetReferenceSurface(OSSurfaceInterface* reference,
                                             const PointT<std::int32_t>& offset) {
  velkcore::RequireInput(reference != this);
  reference_ = reference;
  referenceOffset_ = reference != nullptr ? offset : PointT<std::int32_t>{};
}

void OSSurfaceInterface::ApplyReferenceTransform(bool apply) {
  const float sign = apply ? -1.0f : 1.0f;
  Transform(MatrixT<float>::Translation(sign * static_cast<float>(referenceOffset_.x),
                                        sign * static_cast<float>(referenceOffset_.y)));
}

void OSSurfaceInterface::DrawStringImpl(const BrushInterface& brush, const FontInterface& font,
                                        const char16_t* text, const PointT<float>& point,
                                        TextAlignment alignment) {
  const auto& osFont = As<OSFontInterface>(font);
  const auto& osBrush = As<OSBrushInterface>(brush);
  velkcore::RequireInput(text != nullptr && std::isfinite(point.x) && std::isfinite(point.y));
  if (Top().degenerate || *text == 0) return;
  PangoLayout* layout = osFont.Layout(text, -1, TextIsAntiAliased());
  PangoRectangle logical;
  pango_layout_get_extents(layout, nullptr, &logical);
  double shift = 0.0;
  if (alignment == TextAlignment::kCenter) shift = logical.width / 2.0;
  if (alignment == TextAlignment::kEnd) shift = logical.width;
  const double x = point.x - (logical.x + shift) / PANGO_SCALE;
  const double y = point.y - static_cast<double>(pango_layout_get_baseline(layout)) / PANGO_SCALE;

  DrawScope scope(*this);
  cairo_t* context = context_.get();
  osBrush.ApplySource(context);
  cairo_move_to(context, x, y);
  pango_cairo_show_layout(context, layout);
  cairo_new_path(context);
  dirty_ = true;
  CheckStatus();
}

void OSSurfaceInterface::DrawMultiLineStringImpl(const BrushInterface& brush,
                                                 const FontInterface& font, const char16_t* text,
                                                 const RectT<float>& rect,
                                                 TextAlignment alignment) {
  const auto& osFont = As<OSFontInterface>(font);
  const auto& osBrush = As<OSBrushInterface>(brush);
  velkcore::RequireInput(text != nullptr);
  RequireFinite(rect);
  if (Top().degenerate || *text == 0 || !(rect.height > 0.0f)) return;
  PangoLayout* layout = osFont.Layout(text, -1, TextIsAntiAliased(), rect.width);
  if (alignment == TextAlignment::kCenter) pango_layout_set_alignment(layout, PANGO_ALIGN_CENTER);
  if (alignment == TextAlignment::kEnd) pango_layout_set_alignment(layout, PANGO_ALIGN_RIGHT);

  DrawScope scope(*this);
  cairo_t* context = context_.get();
  osBrush.ApplySource(context);
  // Only whole lines are shown: a line that would stick out of the bottom is left out.
  const double limit = static_cast<double>(rect.height) * PANGO_SCALE + PANGO_SCALE / 2.0;
  PangoLayoutIter* lines = pango_layout_get_iter(layout);
  do {
    PangoRectangle extent;
    pango_layout_iter_get_line_extents(lines, nullptr, &extent);
    if (extent.y + extent.height > limit) break;
    const double baseline = pango_layout_iter_get_baseline(lines);
    cairo_move_to(context, rect.left + static_cast<double>(extent.x) / PANGO_SCALE,
                  rect.top + baseline / PANGO_SCALE);
    pango_cairo_show_layout_line(context, pango_layout_iter_get_line_readonly(lines));
  } while (pango_layout_iter_next_line(lines));
  pango_layout_iter_free(lines);
  cairo_new_path(context);
  dirty_ = true;
  CheckStatus();
}

}  // namespace velkui::pictel::cairo
