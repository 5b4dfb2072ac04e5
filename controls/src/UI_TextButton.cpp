#include <velkui/controls/UI_TextButton.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kDefaultLabel = 33;
constexpr ui::UI_Color kSelectedLabel = 349;
constexpr float kHorizontalPadding = 12.0f;

bool IsReturnOrEnter(const ui::KeyboardEvent& event) {
  const std::uint16_t key = event.GetKeyControlCode();
  return key == ui::kKeyReturn || key == ui::kKeyEnter;
}

}  // namespace

// The caption, drawn on the face.
class UI_TextButton::Face : public DrawButtonFace {
 public:
  Face(const UI_TextButton& button, bool selected) : button_(button), selected_(selected) {}

  void Draw(ControlState state, const velkcore::RectT<float>& rect,
            const velkcore::PointT<float>& offset, pictel::Pictel* context,
            const ColorChangeMap* map) const override {
    const velkcore::UTF16String& text = button_.GetDisplayText();
    if (text.empty()) return;
    ui::UI_Color color = detail::kLabelColor;
    if (state.IsSet(kControlStateDisabled)) {
      color = detail::kDisabledLabelColor;
    } else if (button_.GetDefaultAppearance() && !button_.GetDisplayBorderNever()) {
      color = kDefaultLabel;
    } else if (selected_) {
      color = kSelectedLabel;
    }
    const float indent = button_.GetTextIndent();
    velkcore::RectT<float> area{rect.left + offset.x + indent, rect.top + offset.y,
                                rect.width - 2 * indent, rect.height};
    const std::size_t mnemonic = button_.GetDisplayMnemonic() && !button_.IsModifiedNameShown()
                                     ? button_.GetMnemonicLocation()
                                     : UI_ControlView::kNoMnemonic;
    detail::DrawLabel(*context, text, area, button_.GetAlignment(),
                      detail::TextControlFont(*context, button_), detail::ThemeColor(color, map),
                      mnemonic);
  }

 private:
  const UI_TextButton& button_;
  bool selected_;
};

UI_TextButton::UI_TextButton() {
  UI_SetNodeID("UI_TextButton");
  SetCornerRadius(kDefaultCornerRadius);
}

UI_TextButton::UI_TextButton(const velkcore::UTF16String& text) : UI_TextButton() {
  SetText(text);
}

UI_TextButton::~UI_TextButton() = default;

void UI_TextButton::SetText(const velkcore::UTF16String& text) {
  text_ = text;
  UI_ProcessStringAndSetMnemonic(text, displayText_);
  InvalidateAll();
}

bool UI_TextButton::IsModifiedNameShown() const {
  return &GetDisplayText() != &displayText_;
}

const velkcore::UTF16String& UI_TextButton::GetDisplayText() const {
  const ui::ModifierKeys keys = GetCurrentModKeys();
  if (!keys.IsEmpty()) {
    for (const auto& [nameKeys, name] : modifiedNames_) {
      if (nameKeys == keys) return name;
    }
  }
  return displayText_;
}

void UI_TextButton::SetAlignment(ControlAlignment alignment) {
  if (alignment_ == alignment) return;
  alignment_ = alignment;
  InvalidateAll();
}

void UI_TextButton::SetTextIndent(float indent) {
  velkcore::RequireInput(std::isfinite(indent));
  if (textIndent_ == indent) return;
  textIndent_ = indent;
  InvalidateAll();
}

void UI_TextButton::InsertModifiedName(ui::ModifierKeys keys, const velkcore::UTF16String& text) {
  velkcore::RequireInput(!keys.IsEmpty());
  modifiedNames_.emplace_back(keys, velkcore::StripDisplayString(text));
  SetModifierKeyCallbackEnabled(true);
}

void UI_TextButton::SetDisplayBorderNever(bool never) {
  if (displayBorderNever_ == never) return;
  displayBorderNever_ = never;
  InvalidateAll();
}

void UI_TextButton::ModKeyChanged(ui::ModifierKeys modKeys) {
  const bool changes = modKeys != GetCurrentModKeys();
  UI_Button::ModKeyChanged(modKeys);
  if (changes && !modifiedNames_.empty()) InvalidateAll();
}

void UI_TextButton::TextSettingsChanged() {
  InvalidateAll();
}

bool UI_TextButton::UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) {
  if (legacyActivation_ && !IsDisabled() && IsReturnOrEnter(event) && !event.IsRepeat() &&
      (event.IsActionKeyDown() || event.IsActionKeyUp())) {
    return HandleControlActivateViaKeyboard(event);
  }
  return UI_Button::UI_DoKeyboardEvent(target, event);
}

void UI_TextButton::UI_Draw(pictel::Pictel* context) const {
  DrawButtonParameters parameters(this);
  velkcore::RectT<float> rect = parameters.GetRectF();
  if (!GetLabelText().empty()) {
    const pictel::FontP font = detail::TextControlFont(*context, *this);
    const float labelWidth =
        detail::MeasureText(*context, font, GetLabelText()) + detail::kLabelGap;
    const ui::UI_Color color = IsDisabled() ? detail::kDisabledLabelColor : detail::kLabelColor;
    detail::DrawLabel(*context, GetLabelText(), {rect.left, rect.top, labelWidth, rect.height},
                      kControlAlignLeft, font, detail::ThemeColor(color, &GetColorChangeMap()),
                      kNoMnemonic);
    rect.left += labelWidth;
    rect.width = std::max(rect.width - labelWidth, 0.0f);
    parameters.SetRectF(rect);
  }
  ApplyToggleAppearance(parameters);
  parameters.SetDrawContainer(!displayBorderNever_);
  const Face face(*this, parameters.GetSelectedAppearance());
  parameters.SetDrawButtonFace(&face);
  UI_Button::Draw(parameters, context);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_TextButton::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::FontP font = detail::TextControlFont(*context, *this);
  float width = detail::MeasureText(*context, font, displayText_);
  for (const auto& name : modifiedNames_) {
    width = std::max(width, detail::MeasureText(*context, font, name.second));
  }
  width += 2 * (kHorizontalPadding + std::max(textIndent_, 0.0f));
  if (!GetLabelText().empty())
    width += detail::MeasureText(*context, font, GetLabelText()) + detail::kLabelGap;
  const float height = std::ceil(font->GetAscent() + font->GetDescent()) + 10.0f;
  return {std::ceil(std::max(width, 64.0f)), std::max(height, 22.0f)};
}

}  // namespace velkui::controls
