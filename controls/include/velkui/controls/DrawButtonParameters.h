#pragma once

#include <velkcore/Geometry.h>
#include <velkui/controls/ControlState.h>
#include <velkui/controls/DrawButtonFace.h>
#include <velkui/controls/UI_ColorChangeSupport.h>

namespace velkui::controls {

class UI_Button;

// Everything UI_Button::Draw needs to draw a button body and its face.
class DrawButtonParameters {
 public:
  DrawButtonParameters() = default;
  // Filled from `button` (its state with the capture considered, default
  // appearance, stroke size, corner radius, local rectangle and content
  // offset); a null button gives the defaults.
  explicit DrawButtonParameters(const UI_Button* button);
  DrawButtonParameters(const DrawButtonParameters&) = default;
  DrawButtonParameters& operator=(const DrawButtonParameters&) = default;
  virtual ~DrawButtonParameters() = default;

  void SetDefaults() { *this = DrawButtonParameters(); }

  ControlState GetControlState() const { return controlState_; }
  void SetControlState(ControlState state) { controlState_ = state; }
  bool GetDrawContainer() const { return drawContainer_; }
  void SetDrawContainer(bool draw) { drawContainer_ = draw; }
  bool GetDefaultAppearance() const { return defaultAppearance_; }
  void SetDefaultAppearance(bool isDefault) { defaultAppearance_ = isDefault; }
  bool GetRotatedGradient() const { return rotatedGradient_; }
  void SetRotatedGradient(bool rotated) { rotatedGradient_ = rotated; }
  bool GetSemiRounded() const { return semiRounded_; }
  void SetSemiRounded(bool semiRounded) { semiRounded_ = semiRounded; }
  bool GetSelectedAppearance() const { return selectedAppearance_; }
  void SetSelectedAppearance(bool selected) { selectedAppearance_ = selected; }
  float GetStrokeSize() const { return strokeSize_; }
  void SetStrokeSize(float size) { strokeSize_ = size; }
  float GetCornerRadius() const { return cornerRadius_; }
  void SetCornerRadius(float radius) { cornerRadius_ = radius; }
  const velkcore::RectT<float>& GetRectF() const { return rect_; }
  void SetRectF(const velkcore::RectT<float>& rect) { rect_ = rect; }
  const velkcore::PointT<float>& GetOffset() const { return offset_; }
  void SetOffset(const velkcore::PointT<float>& offset) { offset_ = offset; }
  const DrawButtonFace* GetDrawButtonFace() const { return drawButtonFace_; }
  void SetDrawButtonFace(const DrawButtonFace* face) { drawButtonFace_ = face; }
  const ColorChangeMap* GetColorChangeMap() const { return colorChangeMap_; }
  void SetColorChangeMap(const ColorChangeMap* map) { colorChangeMap_ = map; }

 private:
  ControlState controlState_;
  bool drawContainer_ = true;
  bool defaultAppearance_ = false;
  bool rotatedGradient_ = false;
  bool semiRounded_ = false;
  bool selectedAppearance_ = false;
  float strokeSize_ = 1.0f;
  float cornerRadius_ = 0.0f;
  velkcore::RectT<float> rect_{};
  velkcore::PointT<float> offset_{};
  const DrawButtonFace* drawButtonFace_ = nullptr;  // not owned
  const ColorChangeMap* colorChangeMap_ = nullptr;  // not owned
};

}  // namespace velkui::controls
