#pragma once

#include <velkcore/Geometry.h>
#include <velkui/controls/ControlState.h>
#include <velkui/controls/UI_ColorChangeSupport.h>
#include <velkui/pictel/Pictel.h>

namespace velkui::controls {

// Draws the content of a button face (a glyph, a triangle, an image) inside
// the body that UI_Button::Draw has drawn.
class DrawButtonFace {
 public:
  DrawButtonFace() = default;
  DrawButtonFace(const DrawButtonFace&) = default;
  DrawButtonFace& operator=(const DrawButtonFace&) = default;
  virtual ~DrawButtonFace() = default;

  virtual void Draw(ControlState controlState, const velkcore::RectT<float>& rect,
                    const velkcore::PointT<float>& offset, pictel::Pictel* context,
                    const ColorChangeMap* colorChangeMap) const = 0;
};

}  // namespace velkui::controls
