#include <velkui/controls/UI_RadioButton.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kDot = 38;
constexpr ui::UI_Color kDisabledDot = 37;

velkcore::RectT<float> ButtonRect(const UI_RadioButton& radio, float size) {
  const velkcore::RectT<float> r = radio.UI_GetLocalRectF(false);
  return {r.left + 1.0f, std::round(r.top + (r.height - size) / 2), size, size};
}

void DrawRadioLabel(const UI_RadioButton& radio, pictel::Pictel& context, float left) {
  const velkcore::RectT<float> r = radio.UI_GetLocalRectF(false);
  const ui::UI_Color color = radio.IsDisabled() ? detail::kDisabledLabelColor : detail::kLabelColor;
  const std::size_t mnemonic =
      radio.GetDisplayMnemonic() ? radio.GetMnemonicLocation() : UI_ControlView::kNoMnemonic;
  detail::DrawLabel(context, radio.GetDisplayText(),
                    {left, r.top, r.left + r.width - left, r.height}, kControlAlignLeft,
                    detail::TextControlFont(context, radio),
                    detail::ThemeColor(color, &radio.GetColorChangeMap()), mnemonic);
}

}  // namespace

UI_RadioButton::UI_RadioButton() {
  UI_SetNodeID("UI_RadioButton");
}

UI_RadioButton::UI_RadioButton(const velkcore::UTF16String& label) : UI_RadioButton() {
  SetLabelText(label);
}

UI_RadioButton::~UI_RadioButton() = default;

void UI_RadioButton::SetRadioValue(ButtonValue value) {
  velkcore::RequireInput(value == kButtonOff || value == kButtonOn);
  SetValueKnown();
  if (radioValue_ == value) return;
  radioValue_ = value;
  InvalidateAll();
}

void UI_RadioButton::SendButtonChangedMessage(ui::ModifierKeys modKeys) {
  SetRadioValue(kButtonOn);
  UI_Button::SendButtonChangedMessage(modKeys);
}

void UI_RadioButton::SetLabelText(const velkcore::UTF16String& text) {
  UI_ProcessStringAndSetMnemonic(text, displayText_);
  UI_TextControlBase::SetLabelText(text);
  InvalidateAll();
}

void UI_RadioButton::SetButtonSize(float size) {
  velkcore::RequireInput(std::isfinite(size) && size > 0);
  if (buttonSize_ == size) return;
  buttonSize_ = size;
  InvalidateAll();
}

void UI_RadioButton::TextSettingsChanged() {
  InvalidateAll();
}

void UI_RadioButton::UI_Draw(pictel::Pictel* context) const {
  const velkcore::RectT<float> circle = ButtonRect(*this, buttonSize_);
  DrawButtonParameters parameters(this);
  parameters.SetRectF(detail::Inset(circle, -1.0f, -1.0f));
  parameters.SetCornerRadius(buttonSize_);
  parameters.SetStrokeSize(1.0f);
  parameters.SetDefaultAppearance(false);
  parameters.SetSelectedAppearance(IsOn());
  UI_Button::Draw(parameters, context);
  if (IsOn() && IsValueKnown()) {
    const float dot = std::max(4.0f, std::round(buttonSize_ * 0.43f));
    const velkcore::RectT<float> dotRect{circle.left + (circle.width - dot) / 2,
                                         circle.top + (circle.height - dot) / 2, dot, dot};
    const ui::UI_Color color = IsDisabled() ? kDisabledDot : kDot;
    detail::Fill(*context, detail::EllipsePath(*context, dotRect),
                 detail::ThemeColor(color, &GetColorChangeMap()));
  }
  DrawRadioLabel(*this, *context, circle.left + circle.width + detail::kLabelGap);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_RadioButton::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::FontP font = detail::TextControlFont(*context, *this);
  const float text = detail::MeasureText(*context, font, displayText_);
  const float height = std::ceil(font->GetAscent() + font->GetDescent()) + 2.0f;
  return {std::ceil(buttonSize_ + 2.0f + (text > 0 ? detail::kLabelGap + text : 0.0f)),
          std::max(buttonSize_ + 2.0f, height)};
}

// ---- UI_ImageRadioButton ----

UI_ImageRadioButton::UI_ImageRadioButton() : UI_ImageRadioButton("Radio") {}

UI_ImageRadioButton::UI_ImageRadioButton(std::string imageBaseName) {
  UI_SetNodeID("UI_ImageRadioButton");
  images_.SetBaseName(std::move(imageBaseName));
}

UI_ImageRadioButton::~UI_ImageRadioButton() = default;

void UI_ImageRadioButton::SetImageBaseName(std::string name) {
  images_.SetBaseName(std::move(name));
  InvalidateAll();
}

void UI_ImageRadioButton::SetImageSupplyFunction(const ConstControlCallbackP& supply) {
  images_.SetSupplyFunction(supply);
  InvalidateAll();
}

pictel::ImageP UI_ImageRadioButton::GetImage(const pictel::Pictel& context) const {
  return images_.GetImage(*this, context, GetControlState(true), GetCurrentModKeys(), IsOn());
}

void UI_ImageRadioButton::UI_Draw(pictel::Pictel* context) const {
  float labelLeft = UI_GetLocalRectF(false).left;
  if (const pictel::ImageP image = GetImage(*context)) {
    const velkcore::RectT<float> r = UI_GetLocalRectF(false);
    const float width = static_cast<float>(image->GetWidth());
    const float height = static_cast<float>(image->GetHeight());
    detail::DrawImageIn(*context, *image,
                        {r.left, std::round(r.top + (r.height - height) / 2), width, height},
                        IsDisabled() ? 0.4f : 1.0f);
    labelLeft += width + detail::kLabelGap;
  }
  DrawRadioLabel(*this, *context, labelLeft);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_ImageRadioButton::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::ImageP image = GetImage(*context);
  const pictel::FontP font = detail::TextControlFont(*context, *this);
  const float text = detail::MeasureText(*context, font, GetDisplayText());
  const float imageWidth = image ? static_cast<float>(image->GetWidth()) : 0.0f;
  const float imageHeight = image ? static_cast<float>(image->GetHeight()) : 0.0f;
  const float height = std::ceil(font->GetAscent() + font->GetDescent()) + 2.0f;
  return {std::ceil(imageWidth + (text > 0 ? detail::kLabelGap + text : 0.0f)),
          std::max(imageHeight, height)};
}

}  // namespace velkui::controls
