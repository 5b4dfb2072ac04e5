#pragma once

#include <string>

#include <velkui/controls/ButtonImageSource.h>
#include <velkui/controls/UI_Button.h>
#include <velkui/controls/UI_TextControlBase.h>

namespace velkui::controls {

// A button that keeps its own check value: every press flips it (an unknown,
// mixed value becomes checked) before the button message goes out.
class UI_CheckButton : public UI_Button {
 public:
  void SendButtonChangedMessage(ui::ModifierKeys modKeys) override;

  ButtonValue GetCheckValue() const { return checkValue_; }
  // Sets the check value (and makes the value known); sends nothing.
  void SetCheckValue(ButtonValue value);
  bool IsChecked() const { return checkValue_ == kButtonOn; }
  void SetChecked(bool checked) { SetCheckValue(checked ? kButtonOn : kButtonOff); }

 private:
  ButtonValue checkValue_ = kButtonOff;
};

// A check box with a label, which may carry a mnemonic ("&Remember").
class UI_Checkbox : public UI_CheckButton, public UI_TextControlBase {
 public:
  static constexpr float kDefaultCheckSize = 14.0f;
  static constexpr float kLabelGap = 6.0f;

  UI_Checkbox();
  explicit UI_Checkbox(const velkcore::UTF16String& label);
  ~UI_Checkbox() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;

  // Mnemonic markup is processed; GetLabelText answers the text as given.
  void SetLabelText(const velkcore::UTF16String& text) override;
  const velkcore::UTF16String& GetDisplayText() const { return displayText_; }
  float GetCheckSize() const { return checkSize_; }
  void SetCheckSize(float size);

 protected:
  void TextSettingsChanged() override;
  // The box (or circle) rectangle in local coordinates.
  velkcore::RectT<float> GetMarkRect() const;
  void DrawLabelText(pictel::Pictel& context, float left) const;

 private:
  velkcore::UTF16String displayText_;
  float checkSize_ = kDefaultCheckSize;
};

// A check box drawn with pictures: "<base>" unchecked and "<base>_D" checked
// (by default the library's "Checkbox" art), or from an image supply
// function. It can draw like a button, with the body behind the picture.
class UI_ImageCheckbox : public UI_CheckButton {
 public:
  UI_ImageCheckbox();
  explicit UI_ImageCheckbox(std::string imageBaseName);
  ~UI_ImageCheckbox() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;

  const std::string& GetImageBaseName() const { return images_.GetBaseName(); }
  void SetImageBaseName(std::string name);
  void SetImageSupplyFunction(const ConstControlCallbackP& supply);
  pictel::ImageP GetImage(const pictel::Pictel& context) const;
  bool GetDrawsLikeAButton() const { return drawsLikeAButton_; }
  void SetDrawsLikeAButton(bool like);

 private:
  ButtonImageSource images_;
  bool drawsLikeAButton_ = false;
};

}  // namespace velkui::controls
