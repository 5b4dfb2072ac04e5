#include "OSPenInterface.h"

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>

#include "CairoColor.h"

namespace velkui::pictel::cairo {

namespace {

cairo_line_cap_t ToCairo(LineCapType cap) {
  switch (cap) {
    case LineCapType::kRound:
      return CAIRO_LINE_CAP_ROUND;
    case LineCapType::kSquare:
      return CAIRO_LINE_CAP_SQUARE;
    case LineCapType::kFlat:
      break;
  }
  return CAIRO_LINE_CAP_BUTT;
}

cairo_line_join_t ToCairo(LineJoinType join) {
  switch (join) {
    case LineJoinType::kBevel:
      return CAIRO_LINE_JOIN_BEVEL;
    case LineJoinType::kRound:
      return CAIRO_LINE_JOIN_ROUND;
    case LineJoinType::kMiter:
      break;
  }
  return CAIRO_LINE_JOIN_MITER;
}

}  // namespace

OSPenInterface::OSPenInterface(const ColorRGBA& color, float width)
    : color_(color), width_(width) {}

void OSPenInterface::SetMiterLimit(float limit) {
  velkcore::RequireInput(std::isfinite(limit));
  miterLimit_ = limit;
}

void OSPenInterface::SetLineJoin(LineJoinType join) {
  ValidateLineJoinType(join);
  join_ = join;
}

void OSPenInterface::SetLineCap(LineCapType cap) {
  ValidateLineCapType(cap);
  cap_ = cap;
}

void OSPenInterface::SetDashArray(const float* dashes, std::int32_t count) {
  velkcore::RequireInput(count >= 0 && (count == 0 || dashes != nullptr));
  std::vector<float> pattern(dashes, dashes + count);
  // Negative or non-finite lengths, or only zeros, describe no dash pattern.
  const bool valid = std::all_of(pattern.begin(), pattern.end(),
                                 [](float d) { return std::isfinite(d) && d >= 0.0f; }) &&
                     (pattern.empty() ||
                      std::any_of(pattern.begin(), pattern.end(), [](float d) { return d > 0; }));
  velkcore::RequireInput(valid);
  dashes_ = std::move(pattern);
}

void OSPenInterface::GetDashArray(float* dashes, std::int32_t count) const {
  velkcore::RequireInput(count >= 0 && (count == 0 || dashes != nullptr));
  const auto n = std::min<std::size_t>(static_cast<std::size_t>(count), dashes_.size());
  std::copy_n(dashes_.begin(), n, dashes);
}

void OSPenInterface::Apply(cairo_t* context) const {
  SetSourceColor(context, color_);
  cairo_set_line_width(context, width_);
  cairo_set_line_cap(context, ToCairo(cap_));
  cairo_set_line_join(context, ToCairo(join_));
  cairo_set_miter_limit(context, std::max(1.0f, miterLimit_));
  if (dashes_.empty()) {
    cairo_set_dash(context, nullptr, 0, 0.0);
    return;
  }
  // Dash lengths are multiples of the pen width.
  double scaled[16];
  std::vector<double> large;
  double* lengths = scaled;
  if (dashes_.size() > std::size(scaled)) {
    large.resize(dashes_.size());
    lengths = large.data();
  }
  for (std::size_t i = 0; i < dashes_.size(); ++i) {
    lengths[i] = static_cast<double>(dashes_[i]) * width_;
  }
  cairo_set_dash(context, lengths, static_cast<int>(dashes_.size()), 0.0);
}

}  // namespace velkui::pictel::cairo
