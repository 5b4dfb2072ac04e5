#include <velkui/pictel/Gradients.h>

#include <mutex>

#include <velkcore/Error.h>

namespace velkui::utils {

using pictel::ColorRGBA;
using velkcore::PointT;

namespace {

struct BrightnessSource {
  std::mutex mutex;
  std::function<float()> function;
};

BrightnessSource& Brightness() {
  static BrightnessSource source;
  return source;
}

float CurrentBrightness() {
  std::function<float()> function;
  {
    std::lock_guard lock(Brightness().mutex);
    function = Brightness().function;
  }
  constexpr float kDefaultBrightness = 0.5f;
  return function ? function() : kDefaultBrightness;
}

ColorRGBA Blend(const ColorRGBA& first, const ColorRGBA& last, float amount) {
  return {first.red + (last.red - first.red) * amount,
          first.green + (last.green - first.green) * amount,
          first.blue + (last.blue - first.blue) * amount,
          first.alpha + (last.alpha - first.alpha) * amount};
}

}  // namespace

void SetGradientBrightnessFunction(std::function<float()> brightness) {
  std::lock_guard lock(Brightness().mutex);
  Brightness().function = std::move(brightness);
}

void HandleGradient(pictel::Pictel* pictel, pictel::PathP& path, const PointT<float>& start,
                    const PointT<float>& end, const ColorRGBA* colors, const float* positions,
                    std::int32_t count) {
  velkcore::RequireInput(pictel != nullptr && pictel->GetSupplier() != nullptr &&
                         pictel->GetSurface() != nullptr && colors != nullptr &&
                         positions != nullptr && count > 0);
  const pictel::SupplierInterface& supplier = *pictel->GetSupplier();
  pictel::SurfaceInterface& surface = *pictel->GetSurface();
  const pictel::PathInterface& figure = *path;
  if (supplier.SupportsLinearShaders()) {
    const auto shader = supplier.CreateLinearShader(start, end, colors, positions, count);
    surface.ShadePath(*shader, figure, pictel::FillType::kWinding);
    return;
  }
  const auto brush = supplier.NewBrush(Blend(colors[0], colors[count - 1], CurrentBrightness()));
  surface.FillPath(*brush, figure, pictel::FillType::kWinding);
}

void HandleGradient(pictel::Pictel* pictel, pictel::PathP& path, const PointT<float>& start,
                    const PointT<float>& end, const ColorRGBA& from, const ColorRGBA& to) {
  const ColorRGBA colors[2] = {from, to};
  const float positions[2] = {0.0f, 1.0f};
  HandleGradient(pictel, path, start, end, colors, positions, 2);
}

}  // namespace velkui::utils
