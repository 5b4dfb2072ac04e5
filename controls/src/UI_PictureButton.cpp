#include <velkui/controls/UI_PictureButton.h>

#include <cmath>

#include <velkcore/Error.h>
#include <velkui/ui/UI_NodeManager.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr std::string_view kActivateOnReturnEnterSetting =
    "velkui.controls.UI_PictureButton.ActivateOnReturnEnter";
constexpr float kBodyPadding = 4.0f;

// The picture, centred on the face.
class PictureFace : public DrawButtonFace {
 public:
  PictureFace(pictel::ImageP image, const velkcore::PointT<float>& scale)
      : image_(std::move(image)), scale_(scale) {}

  void Draw(ControlState state, const velkcore::RectT<float>& rect,
            const velkcore::PointT<float>& offset, pictel::Pictel* context,
            const ColorChangeMap*) const override {
    if (!image_) return;
    const float width = static_cast<float>(image_->GetWidth()) * scale_.x;
    const float height = static_cast<float>(image_->GetHeight()) * scale_.y;
    // Whole pixels keep unscaled art crisp.
    const float left = std::round(rect.left + (rect.width - width) / 2 + offset.x);
    const float top = std::round(rect.top + (rect.height - height) / 2 + offset.y);
    const float opacity =
        state.IsSet(kControlStateDisabled) ? UI_PictureButton::kDisabledOpacity : 1.0f;
    detail::DrawImageIn(*context, *image_, {left, top, width, height}, opacity);
  }

 private:
  pictel::ImageP image_;
  velkcore::PointT<float> scale_;
};

}  // namespace

UI_PictureButton::UI_PictureButton() {
  UI_SetNodeID("UI_PictureButton");
  SetCornerRadius(kDefaultCornerRadius);
  SetWantsKeyboardFocus(false);
}

UI_PictureButton::UI_PictureButton(std::string imageBaseName) : UI_PictureButton() {
  SetImageBaseName(std::move(imageBaseName));
}

UI_PictureButton::~UI_PictureButton() = default;

void UI_PictureButton::SetImageBaseName(std::string name) {
  images_.SetBaseName(std::move(name));
  InvalidateAll();
}

void UI_PictureButton::SetImageSupplyFunction(const ConstControlCallbackP& supply) {
  images_.SetSupplyFunction(supply);
  InvalidateAll();
}

void UI_PictureButton::SetScale(const velkcore::PointT<float>& scale) {
  detail::RequireScale(scale);
  if (scale_ == scale) return;
  scale_ = scale;
  InvalidateAll();
}

void UI_PictureButton::SetDisplayBorderAlways(bool always) {
  if (borderAlways_ == always) return;
  borderAlways_ = always;
  InvalidateAll();
}

void UI_PictureButton::SetDisplayBorderNever(bool never) {
  if (borderNever_ == never) return;
  borderNever_ = never;
  InvalidateAll();
}

void UI_PictureButton::InsertModifiedPicture(ui::ModifierKeys keys, std::string imageBaseName) {
  velkcore::RequireInput(!keys.IsEmpty());
  modifiedPictures_.emplace_back(keys, std::move(imageBaseName));
  SetModifierKeyCallbackEnabled(true);
}

const std::string& UI_PictureButton::CurrentBaseName() const {
  const ui::ModifierKeys keys = GetCurrentModKeys();
  if (!keys.IsEmpty()) {
    for (const auto& [pictureKeys, name] : modifiedPictures_) {
      if (pictureKeys == keys) return name;
    }
  }
  return images_.GetBaseName();
}

pictel::ImageP UI_PictureButton::GetImage(const pictel::Pictel& context) const {
  return images_.GetImage(*this, context, GetControlState(true), GetCurrentModKeys(),
                          ShowsOnPicture(), CurrentBaseName());
}

void UI_PictureButton::ModKeyChanged(ui::ModifierKeys modKeys) {
  const bool changes = modKeys != GetCurrentModKeys();
  UI_Button::ModKeyChanged(modKeys);
  if (changes && !modifiedPictures_.empty()) InvalidateAll();
}

bool UI_PictureButton::ShouldDrawBody(ControlState state) const {
  if (borderNever_) return false;
  if (borderAlways_) return true;
  return state.IsAnySet(kControlStateRollover | kControlStateDown | kControlStateFocus);
}

bool UI_PictureButton::UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) {
  if (legacyActivation_ && !IsDisabled() && !event.IsRepeat() &&
      (event.IsActionKeyDown() || event.IsActionKeyUp())) {
    const std::uint16_t key = event.GetKeyControlCode();
    ui::ModifierKeys modifiers = event.GetModKey();
    modifiers.Clear(ui::kModifierCapsLock);
    const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
    const bool enabledBySetting =
        manager == nullptr ||
        manager->GetCustomSettingsManager().GetBoolean(kActivateOnReturnEnterSetting, true);
    if ((key == ui::kKeyReturn || key == ui::kKeyEnter) && modifiers.IsEmpty() &&
        enabledBySetting) {
      return HandleControlActivateViaKeyboard(event);
    }
  }
  return UI_Button::UI_DoKeyboardEvent(target, event);
}

void UI_PictureButton::UI_Draw(pictel::Pictel* context) const {
  DrawButtonParameters parameters(this);
  ApplyToggleAppearance(parameters);
  parameters.SetDrawContainer(ShouldDrawBody(parameters.GetControlState()) ||
                              parameters.GetSelectedAppearance());
  const PictureFace face(GetImage(*context), scale_);
  parameters.SetDrawButtonFace(&face);
  UI_Button::Draw(parameters, context);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_PictureButton::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::ImageP image = GetImage(*context);
  if (!image) return {22, 22};
  const float padding = 2 * (kBodyPadding + GetStrokeSizes().first + 1.0f);
  return {std::ceil(static_cast<float>(image->GetWidth()) * scale_.x + padding),
          std::ceil(static_cast<float>(image->GetHeight()) * scale_.y + padding)};
}

// ---- Lock and link ----

UI_LockButton::UI_LockButton() : UI_PictureButton("Lock") {
  UI_SetNodeID("UI_LockButton");
  SetSpringLoaded(false);
}

UI_LockButton::~UI_LockButton() = default;

UI_LinkButton::UI_LinkButton() : UI_PictureButton("Link") {
  UI_SetNodeID("UI_LinkButton");
  SetSpringLoaded(false);
}

UI_LinkButton::~UI_LinkButton() = default;

}  // namespace velkui::controls
