#include <velkui/pictel/ColorConversion.h>

#include <algorithm>
#include <cmath>

namespace velkui::pictel {

template <typename T>
ColorRGBA HSBtoRGB(T hue, T saturation, T brightness, float alpha) {
  const auto color = [alpha](T r, T g, T b) {
    return ColorRGBA{static_cast<float>(r), static_cast<float>(g), static_cast<float>(b), alpha};
  };
  if (saturation == T(0)) return color(brightness, brightness, brightness);

  T h = std::isfinite(hue) ? std::fmod(hue, T(360)) : T(0);
  if (h < T(0)) h += T(360);
  h /= T(60);
  int sector = static_cast<int>(std::floor(h));
  T fraction = h - static_cast<T>(sector);
  if (sector >= 6) {
    sector = 0;
    fraction = T(0);
  }
  const T p = (T(1) - saturation) * brightness;
  const T q = (T(1) - saturation * fraction) * brightness;
  const T t = (T(1) - saturation * (T(1) - fraction)) * brightness;
  switch (sector) {
    case 0:
      return color(brightness, t, p);
    case 1:
      return color(q, brightness, p);
    case 2:
      return color(p, brightness, t);
    case 3:
      return color(p, q, brightness);
    case 4:
      return color(t, p, brightness);
    default:
      return color(brightness, p, q);
  }
}

template <typename T>
void RGBtoHSB(const ColorRGBA& color, T& hue, T& saturation, T& brightness,
              bool undefinedHueIsMinusOne) {
  const T r = color.red;
  const T g = color.green;
  const T b = color.blue;
  const T maximum = std::max({r, g, b});
  const T minimum = std::min({r, g, b});
  brightness = maximum;
  saturation = T(0);
  if (maximum != T(0)) saturation = (maximum - minimum) / maximum;
  if (saturation == T(0)) {
    hue = undefinedHueIsMinusOne ? T(-1) : T(0);
    return;
  }
  const T delta = maximum - minimum;
  T h;
  if (r == maximum) {
    h = (g - b) / delta;
  } else if (g == maximum) {
    h = (b - r) / delta + T(2);
  } else {
    h = (r - g) / delta + T(4);
  }
  h *= T(60);
  if (h < T(0)) h += T(360);
  hue = h;
}

template ColorRGBA HSBtoRGB<float>(float, float, float, float);
template ColorRGBA HSBtoRGB<double>(double, double, double, float);
template void RGBtoHSB<float>(const ColorRGBA&, float&, float&, float&, bool);
template void RGBtoHSB<double>(const ColorRGBA&, double&, double&, double&, bool);

}  // namespace velkui::pictel
