#include <velkui/pictel/SupplierInterface.h>

#include <velkcore/Error.h>

namespace velkui::pictel {

boost::intrusive_ptr<LinearShaderInterface> SupplierInterface::NewLinearShader(
    const velkcore::PointT<float>& start, const velkcore::PointT<float>& end, const ColorRGBA& from,
    const ColorRGBA& to) const {
  const ColorRGBA colors[2] = {from, to};
  const float positions[2] = {0.0f, 1.0f};
  return CreateLinearShader(start, end, colors, positions, 2);
}

boost::intrusive_ptr<LinearShaderInterface> SupplierInterface::NewLinearShader(
    const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
    const std::vector<std::pair<float, ColorRGBA>>& stops) const {
  velkcore::RequireInput(!stops.empty());
  std::vector<float> positions;
  std::vector<ColorRGBA> colors;
  positions.reserve(stops.size() + 1);
  colors.reserve(stops.size() + 1);
  for (const auto& [position, color] : stops) {
    positions.push_back(position);
    colors.push_back(color);
  }
  if (positions.back() != 1.0f) {
    positions.push_back(1.0f);
    colors.push_back(colors.back());
  }
  return CreateLinearShader(start, end, colors.data(), positions.data(),
                            static_cast<std::int32_t>(positions.size()));
}

}  // namespace velkui::pictel
