#pragma once

#include <string>
#include <utility>
#include <vector>

#include <velkui/controls/ButtonImageSource.h>
#include <velkui/controls/UI_Button.h>

namespace velkui::controls {

// A button that shows a picture: a library image by base name (the "_D"
// picture while down) or whatever an image supply function answers. By
// default the body is drawn only while the pointer is over the button, while
// it is down or focused (the toolbar look); SetDisplayBorderAlways and
// SetDisplayBorderNever change that. Other pictures may be shown while
// modifier keys are held (InsertModifiedPicture).
class UI_PictureButton : public UI_Button {
 public:
  static constexpr float kDefaultCornerRadius = 4.0f;
  static constexpr float kDisabledOpacity = 0.4f;

  UI_PictureButton();
  explicit UI_PictureButton(std::string imageBaseName);
  ~UI_PictureButton() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  bool UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) override;
  void ModKeyChanged(ui::ModifierKeys modKeys) override;

  const std::string& GetImageBaseName() const { return images_.GetBaseName(); }
  void SetImageBaseName(std::string name);
  // The supply function gets a UI_PictureSupplyMessage with the control state
  // and answers with SetImage; it takes precedence over the base name.
  void SetImageSupplyFunction(const ConstControlCallbackP& supply);
  const ConstControlCallbackP& GetImageSupplyFunction() const {
    return images_.GetSupplyFunction();
  }
  // The picture to draw now; null when there is none.
  pictel::ImageP GetImage(const pictel::Pictel& context) const;

  const velkcore::PointT<float>& GetScale() const { return scale_; }
  // Positive, finite factors.
  void SetScale(const velkcore::PointT<float>& scale);
  bool GetDisplayBorderAlways() const { return borderAlways_; }
  void SetDisplayBorderAlways(bool always);
  bool GetDisplayBorderNever() const { return borderNever_; }
  void SetDisplayBorderNever(bool never);
  void InsertModifiedPicture(ui::ModifierKeys keys, std::string imageBaseName);

  // Return and keypad Enter without modifiers press the button too, unless the
  // custom setting "velkui.controls.UI_PictureButton.ActivateOnReturnEnter" is off.
  bool GetSupportLegacyWindowsKeyboardActivation() const { return legacyActivation_; }
  void SetSupportLegacyWindowsKeyboardActivation(bool support) { legacyActivation_ = support; }

 protected:
  // Whether the "on" picture shows: while the button is down.
  virtual bool ShowsOnPicture() const { return GetDownState(); }
  bool ShouldDrawBody(ControlState state) const;
  const std::string& CurrentBaseName() const;

 private:
  ButtonImageSource images_;
  std::vector<std::pair<ui::ModifierKeys, std::string>> modifiedPictures_;
  velkcore::PointT<float> scale_{1.0f, 1.0f};
  bool borderAlways_ = false;
  bool borderNever_ = false;
  bool legacyActivation_ = false;
};

// A toggle showing a padlock: on is locked. Its picture comes from the image
// supply function when the host gives one, else from the library's "Lock" art.
class UI_LockButton : public UI_PictureButton {
 public:
  UI_LockButton();
  ~UI_LockButton() override;
  pictel::ImageP GetLockImage(const pictel::Pictel& context) const { return GetImage(context); }
};

// A toggle showing a chain link: on is linked (two values move together). Its
// picture comes from the image supply function when the host gives one, else
// from the library's "Link" art.
class UI_LinkButton : public UI_PictureButton {
 public:
  UI_LinkButton();
  ~UI_LinkButton() override;
  pictel::ImageP GetLinkImage(const pictel::Pictel& context) const { return GetImage(context); }
};

}  // namespace velkui::controls
