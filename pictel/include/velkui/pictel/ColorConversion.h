#pragma once

#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// Hue in degrees (any value; reduced modulo 360), saturation and brightness 0..1.
template <typename T>
ColorRGBA HSBtoRGB(T hue, T saturation, T brightness, float alpha);
// Hue 0..360; an undefined hue (black or grey) is -1 when `undefinedHueIsMinusOne`, else 0.
template <typename T>
void RGBtoHSB(const ColorRGBA& color, T& hue, T& saturation, T& brightness,
              bool undefinedHueIsMinusOne);

extern template ColorRGBA HSBtoRGB<float>(float, float, float, float);
extern template ColorRGBA HSBtoRGB<double>(double, double, double, float);
extern template void RGBtoHSB<float>(const ColorRGBA&, float&, float&, float&, bool);
extern template void RGBtoHSB<double>(const ColorRGBA&, double&, double&, double&, bool);

}  // namespace velkui::pictel
