#pragma once

#include <cmath>
#include <vector>

#include <velkui/pictel/PenInterface.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

class OSPenInterface : public PenInterface {
 public:
  OSPenInterface(const ColorRGBA& color, float width);

  void SetWidth(float width) override { width_ = width; }
  float GetWidth() const override { return width_; }
  void SetMiterLimit(float limit) override;
  float GetMiterLimit() const override { return miterLimit_; }
  void SetLineJoin(LineJoinType join) override;
  LineJoinType GetLineJoin() const override { return join_; }
  void SetLineCap(LineCapType cap) override;
  LineCapType GetLineCap() const override { return cap_; }
  void SetDashArray(const float* dashes, std::int32_t count) override;
  void GetDashArray(float* dashes, std::int32_t count) const override;
  std::int32_t GetDashCount() const override { return static_cast<std::int32_t>(dashes_.size()); }

  const ColorRGBA& GetColor() const { return color_; }
  // Whether a stroke with this pen leaves any mark.
  bool Draws() const { return width_ > 0.0f && std::isfinite(width_); }
  // Colour, width, caps, joins and dashes onto the context.
  void Apply(cairo_t* context) const;

 private:
  ColorRGBA color_;
  float width_;
  float miterLimit_ = 10.0f;
  LineJoinType join_ = LineJoinType::kMiter;
  LineCapType cap_ = LineCapType::kFlat;
  std::vector<float> dashes_;
};

}  // namespace velkui::pictel::cairo
