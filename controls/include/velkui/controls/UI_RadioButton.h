#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include <velkui/controls/ButtonImageSource.h>
#include <velkui/controls/UI_Checkbox.h>

namespace velkui::controls {

// A radio button with a label. A press turns it on, never off: clicking a
// radio button that is already on sends the message again and it stays on.
// A UI_RadioGroup turns the others off.
class UI_RadioButton : public UI_Button, public UI_TextControlBase {
 public:
  static constexpr float kDefaultButtonSize = 14.0f;

  UI_RadioButton();
  explicit UI_RadioButton(const velkcore::UTF16String& label);
  ~UI_RadioButton() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  void SendButtonChangedMessage(ui::ModifierKeys modKeys) override;

  ButtonValue GetRadioValue() const { return radioValue_; }
  // Sets the value (and makes it known); sends nothing.
  void SetRadioValue(ButtonValue value);
  bool IsOn() const { return radioValue_ == kButtonOn; }
  void SetOn(bool on) { SetRadioValue(on ? kButtonOn : kButtonOff); }

  void SetLabelText(const velkcore::UTF16String& text) override;
  const velkcore::UTF16String& GetDisplayText() const { return displayText_; }
  float GetButtonSize() const { return buttonSize_; }
  void SetButtonSize(float size);

 protected:
  void TextSettingsChanged() override;

 private:
  velkcore::UTF16String displayText_;
  ButtonValue radioValue_ = kButtonOff;
  float buttonSize_ = kDefaultButtonSize;
};

// A radio button drawn with pictures: "<base>" off and "<base>_D" on (by
// default the library's "Radio" art), or from an image supply function.
class UI_ImageRadioButton : public UI_RadioButton {
 public:
  UI_ImageRadioButton();
  explicit UI_ImageRadioButton(std::string imageBaseName);
  ~UI_ImageRadioButton() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;

  const std::string& GetImageBaseName() const { return images_.GetBaseName(); }
  void SetImageBaseName(std::string name);
  void SetImageSupplyFunction(const ConstControlCallbackP& supply);
  pictel::ImageP GetImage(const pictel::Pictel& context) const;

 private:
  ButtonImageSource images_;
};

}  // namespace velkui::controls
