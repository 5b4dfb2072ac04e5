#include <velkui/controls/UI_Checkbox.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kCheckMark = 36;
constexpr ui::UI_Color kDisabledCheckMark = 37;

void DrawCheckMark(pictel::Pictel& context, const velkcore::RectT<float>& box,
                   const pictel::ColorRGBA& color) {
  const auto at = [&](float x, float y) {
    return velkcore::PointT<float>{box.left + box.width * x, box.top + box.height * y};
  };
  pictel::PathP path(*context.GetSupplier());
  path->MoveTo(at(0.24f, 0.52f));
  path->LineTo(at(0.43f, 0.71f));
  path->LineTo(at(0.77f, 0.29f));
  pictel::PenP pen(*context.GetSupplier(), color, std::max(1.6f, box.width / 7.0f));
  pen->SetLineCap(pictel::LineCapType::kRound);
  pen->SetLineJoin(pictel::LineJoinType::kRound);
  context.GetSurface()->StrokePath(*pen, *path);
}

void DrawMixedMark(pictel::Pictel& context, const velkcore::RectT<float>& box,
                   const pictel::ColorRGBA& color) {
  const float thickness = std::max(2.0f, std::round(box.height / 7.0f));
  const velkcore::RectT<float> bar{box.left + box.width * 0.25f,
                                   box.top + (box.height - thickness) / 2, box.width * 0.5f,
                                   thickness};
  detail::Fill(context, detail::RoundedPath(context, bar, thickness / 2), color);
}

}  // namespace

void UI_CheckButton::SetCheckValue(ButtonValue value) {
  velkcore::RequireInput(value == kButtonOff || value == kButtonOn);
  SetValueKnown();
  if (checkValue_ == value) return;
  checkValue_ = value;
  InvalidateAll();
}

void UI_CheckButton::SendButtonChangedMessage(ui::ModifierKeys modKeys) {
  SetCheckValue(IsChecked() ? kButtonOff : kButtonOn);
  UI_Button::SendButtonChangedMessage(modKeys);
}

UI_Checkbox::UI_Checkbox() {
  UI_SetNodeID("UI_Checkbox");
}

UI_Checkbox::UI_Checkbox(const velkcore::UTF16String& label) : UI_Checkbox() {
  SetLabelText(label);
}

UI_Checkbox::~UI_Checkbox() = default;

void UI_Checkbox::SetLabelText(const velkcore::UTF16String& text) {
  UI_ProcessStringAndSetMnemonic(text, displayText_);
  UI_TextControlBase::SetLabelText(text);
  InvalidateAll();
}

void UI_Checkbox::SetCheckSize(float size) {
  velkcore::RequireInput(std::isfinite(size) && size > 0);
  if (checkSize_ == size) return;
  checkSize_ = size;
  InvalidateAll();
}

void UI_Checkbox::TextSettingsChanged() {
  InvalidateAll();
}

velkcore::RectT<float> UI_Checkbox::GetMarkRect() const {
  const velkcore::RectT<float> r = UI_GetLocalRectF(false);
  return {r.left + 1.0f, std::round(r.top + (r.height - checkSize_) / 2), checkSize_, checkSize_};
}

void UI_Checkbox::DrawLabelText(pictel::Pictel& context, float left) const {
  const velkcore::RectT<float> r = UI_GetLocalRectF(false);
  const ui::UI_Color color = IsDisabled() ? detail::kDisabledLabelColor : detail::kLabelColor;
  const std::size_t mnemonic = GetDisplayMnemonic() ? GetMnemonicLocation() : kNoMnemonic;
  detail::DrawLabel(context, displayText_, {left, r.top, r.left + r.width - left, r.height},
                    kControlAlignLeft, detail::TextControlFont(context, *this),
                    detail::ThemeColor(color, &GetColorChangeMap()), mnemonic);
}

void UI_Checkbox::UI_Draw(pictel::Pictel* context) const {
  const velkcore::RectT<float> box = GetMarkRect();
  DrawButtonParameters parameters(this);
  parameters.SetRectF(detail::Inset(box, -1.0f, -1.0f));
  parameters.SetCornerRadius(std::round(checkSize_ / 4.5f));
  parameters.SetStrokeSize(1.0f);
  parameters.SetDefaultAppearance(false);
  parameters.SetSelectedAppearance(IsChecked() || IsValueUnknown());
  UI_Button::Draw(parameters, context);

  const ControlState state = parameters.GetControlState();
  const pictel::ColorRGBA mark = detail::ThemeColor(
      state.IsSet(kControlStateDisabled) ? kDisabledCheckMark : kCheckMark, &GetColorChangeMap());
  if (IsValueUnknown()) {
    DrawMixedMark(*context, box, mark);
  } else if (IsChecked()) {
    DrawCheckMark(*context, box, mark);
  }
  DrawLabelText(*context, box.left + box.width + kLabelGap);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_Checkbox::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::FontP font = detail::TextControlFont(*context, *this);
  const float text = detail::MeasureText(*context, font, displayText_);
  const float height = std::ceil(font->GetAscent() + font->GetDescent()) + 2.0f;
  return {std::ceil(checkSize_ + 2.0f + (text > 0 ? kLabelGap + text : 0.0f)),
          std::max(checkSize_ + 2.0f, height)};
}

// ---- UI_ImageCheckbox ----

UI_ImageCheckbox::UI_ImageCheckbox() : UI_ImageCheckbox("Checkbox") {}

UI_ImageCheckbox::UI_ImageCheckbox(std::string imageBaseName) {
  UI_SetNodeID("UI_ImageCheckbox");
  SetCornerRadius(4.0f);
  images_.SetBaseName(std::move(imageBaseName));
}

UI_ImageCheckbox::~UI_ImageCheckbox() = default;

void UI_ImageCheckbox::SetImageBaseName(std::string name) {
  images_.SetBaseName(std::move(name));
  InvalidateAll();
}

void UI_ImageCheckbox::SetImageSupplyFunction(const ConstControlCallbackP& supply) {
  images_.SetSupplyFunction(supply);
  InvalidateAll();
}

void UI_ImageCheckbox::SetDrawsLikeAButton(bool like) {
  if (drawsLikeAButton_ == like) return;
  drawsLikeAButton_ = like;
  InvalidateAll();
}

pictel::ImageP UI_ImageCheckbox::GetImage(const pictel::Pictel& context) const {
  return images_.GetImage(*this, context, GetControlState(true), GetCurrentModKeys(), IsChecked());
}

void UI_ImageCheckbox::UI_Draw(pictel::Pictel* context) const {
  DrawButtonParameters parameters(this);
  parameters.SetDrawContainer(drawsLikeAButton_);
  parameters.SetSelectedAppearance(IsChecked());
  UI_Button::Draw(parameters, context);
  if (const pictel::ImageP image = GetImage(*context)) {
    const velkcore::RectT<float> r = parameters.GetRectF();
    const velkcore::PointT<float> size{static_cast<float>(image->GetWidth()),
                                       static_cast<float>(image->GetHeight())};
    velkcore::RectT<float> at = UI_AlignRectInRect(size, r, kControlAlignCenter);
    at.left = std::round(at.left + parameters.GetOffset().x);
    at.top = std::round(at.top + parameters.GetOffset().y);
    detail::DrawImageIn(*context, *image, at, IsDisabled() ? 0.4f : 1.0f);
  }
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_ImageCheckbox::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::ImageP image = GetImage(*context);
  const float padding = drawsLikeAButton_ ? 10.0f : 0.0f;
  if (!image) return {16 + padding, 16 + padding};
  return {static_cast<float>(image->GetWidth()) + padding,
          static_cast<float>(image->GetHeight()) + padding};
}

}  // namespace velkui::controls
