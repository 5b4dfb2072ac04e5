#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/pictel/BrushInterface.h>
#include <velkui/pictel/PictelTypes.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// Every brush of this backend knows how to become the context's source.
class OSBrushInterface : public BrushInterface {
 public:
  virtual void ApplySource(cairo_t* context) const = 0;
};

class OSSolidBrushInterface : public OSBrushInterface {
 public:
  explicit OSSolidBrushInterface(const ColorRGBA& color) : color_(color) {}
  void ApplySource(cairo_t* context) const override;
  const ColorRGBA& GetColor() const { return color_; }

 private:
  ColorRGBA color_;
};

// A gradient is at once a shader (ShadePath) and a brush (FillPath, text).
class OSGradient : public OSBrushInterface {
 public:
  void ApplySource(cairo_t* context) const override;

 protected:
  // Adds the stops to `pattern` and takes it; beyond the ends the end colours continue.
  void SetPattern(cairo_pattern_t* pattern, const ColorRGBA* colors, const float* positions,
                  std::int32_t count);

 private:
  CairoPatternPtr pattern_;
};

class OSLinearShaderInterface : public LinearShaderInterface, public OSGradient {};

class OSLinearGradientBrushInterface : public OSLinearShaderInterface {
 public:
  OSLinearGradientBrushInterface(const velkcore::PointT<float>& start,
                                 const velkcore::PointT<float>& end, const ColorRGBA* colors,
                                 const float* positions, std::int32_t count);
};

class OSRadialShaderInterface : public RadialShaderInterface, public OSGradient {};

class OSRadialGradientBrushInterface : public OSRadialShaderInterface {
 public:
  OSRadialGradientBrushInterface(const velkcore::PointT<float>& centre, float radius,
                                 const ColorRGBA* colors, const float* positions,
                                 std::int32_t count);
};

}  // namespace velkui::pictel::cairo
