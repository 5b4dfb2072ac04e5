#pragma once

#include <cstdint>

#include <velkui/controls/DrawButtonFace.h>
#include <velkui/controls/UI_OwnerDrawButton.h>
#include <velkui/controls/UI_PictureTextButton.h>

namespace velkui::controls {

// A triangle pointing right when `angle` is 0 and turned clockwise by `angle`
// degrees (90 points down), centred in the face rectangle.
class DrawTrianglePicture : public DrawButtonFace {
 public:
  static constexpr float kDefaultSize = 9.0f;

  explicit DrawTrianglePicture(float angle = 0.0f, float size = kDefaultSize)
      : angle_(angle), size_(size) {}

  void Draw(ControlState controlState, const velkcore::RectT<float>& rect,
            const velkcore::PointT<float>& offset, pictel::Pictel* context,
            const ColorChangeMap* colorChangeMap) const override;

  float GetAngle() const { return angle_; }
  float GetSize() const { return size_; }

 private:
  float angle_;
  float size_;
};

// A toggle drawn as a disclosure triangle (closed: pointing right; open:
// pointing down) with an optional caption. A change of state turns the
// triangle over the twirl duration, driven by a node timer.
class UI_DisclosureTriangleButton : public UI_PictureTextButton {
 public:
  static constexpr float kDefaultTwirlDuration = 0.15f;
  static constexpr float kTwirlFrameInterval = 1.0f / 60.0f;

  UI_DisclosureTriangleButton();
  explicit UI_DisclosureTriangleButton(const velkcore::UTF16String& text);
  ~UI_DisclosureTriangleButton() override;

  void SetDownState(bool down) override;
  bool UI_DoTimerNotify(std::int32_t id) override;

  bool IsOpen() const { return GetValue() == kButtonOn; }
  float GetTwirlDuration() const { return twirlDuration_; }
  // Seconds, finite and not negative; 0 turns at once.
  void SetTwirlDuration(float seconds);
  // The triangle's angle now: 0 closed, 90 open, in between while twirling.
  float GetCurrentAngle() const;
  bool IsTwirling() const;

 protected:
  velkcore::PointT<float> GetPictureSize(const pictel::Pictel& context) const override;
  void DrawPicture(pictel::Pictel& context, const velkcore::RectT<float>& rect,
                   ControlState state) const override;

 private:
  bool ShowsOpen() const;

  float twirlDuration_ = kDefaultTwirlDuration;
  // The direction the triangle last turned to.
  bool shownOpen_ = false;
  double twirlStart_ = -1.0;
  std::int32_t twirlTimerId_ = 0;
};

}  // namespace velkui::controls
