#pragma once

#include <cstdint>
#include <string>

#include <velkui/controls/ButtonImageSource.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/UI_Button.h>

namespace velkui::controls {

// Where the picture sits relative to the text.
enum class PictureRelationship : std::int32_t {
  kPictureLeft = 0,
  kPictureRight = 1,
  kPictureAbove = 2,
  kPictureBelow = 3,
};

// A button with a picture and a caption side by side (or stacked).
class UI_PictureTextButton : public UI_Button {
 public:
  static constexpr float kDefaultCornerRadius = 4.0f;
  static constexpr float kDefaultSpacing = 5.0f;

  UI_PictureTextButton();
  UI_PictureTextButton(const velkcore::UTF16String& text, std::string imageBaseName);
  ~UI_PictureTextButton() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;

  const velkcore::UTF16String& GetText() const { return text_; }
  // Mnemonic markup ("&Open") is processed.
  void SetText(const velkcore::UTF16String& text);
  const velkcore::UTF16String& GetDisplayText() const { return displayText_; }
  const std::string& GetImageBaseName() const { return images_.GetBaseName(); }
  void SetImageBaseName(std::string name);
  void SetImageSupplyFunction(const ConstControlCallbackP& supply);
  pictel::ImageP GetImage(const pictel::Pictel& context) const;

  PictureRelationship GetRelationship() const { return relationship_; }
  void SetRelationship(PictureRelationship relationship);
  // Where the picture-and-text group sits in the button.
  ControlAlignment GetAlignment() const { return alignment_; }
  void SetAlignment(ControlAlignment alignment);
  float GetSpacing() const { return spacing_; }
  void SetSpacing(float spacing);
  float GetTextIndent() const { return textIndent_; }
  void SetTextIndent(float indent);
  float GetPictureVerticalOffset() const { return pictureVerticalOffset_; }
  void SetPictureVerticalOffset(float offset);
  const velkcore::PointT<float>& GetScale() const { return scale_; }
  void SetScale(const velkcore::PointT<float>& scale);
  float GetFontSize() const { return fontSize_; }
  // 0 is the theme's control text size.
  void SetFontSize(float size);
  float EffectiveFontSize() const;
  bool GetDisplayBorderNever() const { return borderNever_; }
  void SetDisplayBorderNever(bool never);

 protected:
  // The size of the picture as drawn (after scaling).
  virtual velkcore::PointT<float> GetPictureSize(const pictel::Pictel& context) const;
  // Draws the picture into `rect` (its size is GetPictureSize).
  virtual void DrawPicture(pictel::Pictel& context, const velkcore::RectT<float>& rect,
                           ControlState state) const;

 private:
  class Face;

  velkcore::UTF16String text_;
  velkcore::UTF16String displayText_;
  ButtonImageSource images_;
  PictureRelationship relationship_ = PictureRelationship::kPictureLeft;
  ControlAlignment alignment_ = kControlAlignCenter;
  float spacing_ = kDefaultSpacing;
  float textIndent_ = 0;
  float pictureVerticalOffset_ = 0;
  velkcore::PointT<float> scale_{1.0f, 1.0f};
  float fontSize_ = 0;
  bool borderNever_ = false;
};

}  // namespace velkui::controls
