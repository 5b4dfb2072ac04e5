#include <velkui/controls/UI_PictureTextButton.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kDefaultLabel = 33;
constexpr float kHorizontalPadding = 10.0f;

}  // namespace

// Picture and caption laid out as one group on the face.
class UI_PictureTextButton::Face : public DrawButtonFace {
 public:
  explicit Face(const UI_PictureTextButton& button) : button_(button) {}

  void Draw(ControlState state, const velkcore::RectT<float>& rect,
            const velkcore::PointT<float>& offset, pictel::Pictel* context,
            const ColorChangeMap* map) const override {
    const UI_PictureTextButton& b = button_;
    const pictel::FontP font = detail::ControlFont(*context, b.EffectiveFontSize());
    const velkcore::PointT<float> picture = b.GetPictureSize(*context);
    const float textWidth = detail::MeasureText(*context, font, b.displayText_);
    const float textHeight = std::ceil(font->GetAscent() + font->GetDescent());
    const bool hasText = !b.displayText_.empty();
    const bool hasPicture = picture.x > 0 && picture.y > 0;
    const float gap = hasText && hasPicture ? b.spacing_ : 0.0f;
    const velkcore::RectT<float> area{rect.left + offset.x + b.textIndent_, rect.top + offset.y,
                                      rect.width - 2 * b.textIndent_, rect.height};
    const bool stacked = b.relationship_ == PictureRelationship::kPictureAbove ||
                         b.relationship_ == PictureRelationship::kPictureBelow;

    velkcore::RectT<float> pictureRect{};
    velkcore::RectT<float> textRect{};
    if (stacked) {
      const float groupWidth = std::max(picture.x, textWidth);
      const float groupHeight = picture.y + gap + textHeight;
      const velkcore::RectT<float> group =
          UI_AlignRectInRect({groupWidth, groupHeight}, area, b.alignment_);
      const bool above = b.relationship_ == PictureRelationship::kPictureAbove;
      const float pictureTop = above ? group.top : group.top + textHeight + gap;
      const float textTop = above ? group.top + picture.y + gap : group.top;
      pictureRect = {group.left + (groupWidth - picture.x) / 2, pictureTop, picture.x, picture.y};
      textRect = {group.left, textTop, groupWidth, textHeight};
    } else {
      const float groupWidth = std::min(picture.x + gap + textWidth, std::max(area.width, 0.0f));
      const velkcore::RectT<float> group =
          UI_AlignRectInRect({groupWidth, area.height}, area, b.alignment_);
      const bool left = b.relationship_ == PictureRelationship::kPictureLeft;
      const float pictureLeft = left ? group.left : group.left + group.width - picture.x;
      pictureRect = {pictureLeft, area.top + (area.height - picture.y) / 2, picture.x, picture.y};
      const float textLeft = left ? group.left + picture.x + gap : group.left;
      textRect = {textLeft, area.top, std::max(group.width - picture.x - gap, 0.0f), area.height};
    }
    pictureRect.left = std::round(pictureRect.left);
    pictureRect.top = std::round(pictureRect.top + b.pictureVerticalOffset_);
    if (hasPicture) b.DrawPicture(*context, pictureRect, state);
    if (hasText) {
      ui::UI_Color color = detail::kLabelColor;
      if (state.IsSet(kControlStateDisabled)) {
        color = detail::kDisabledLabelColor;
      } else if (b.GetDefaultAppearance() && !b.borderNever_) {
        color = kDefaultLabel;
      }
      const std::size_t mnemonic =
          b.GetDisplayMnemonic() ? b.GetMnemonicLocation() : UI_ControlView::kNoMnemonic;
      detail::DrawLabel(*context, b.displayText_, textRect,
                        stacked ? kControlAlignCenter : kControlAlignLeft, font,
                        detail::ThemeColor(color, map), mnemonic);
    }
  }

 private:
  const UI_PictureTextButton& button_;
};

UI_PictureTextButton::UI_PictureTextButton() {
  UI_SetNodeID("UI_PictureTextButton");
  SetCornerRadius(kDefaultCornerRadius);
}

UI_PictureTextButton::UI_PictureTextButton(const velkcore::UTF16String& text,
                                           std::string imageBaseName)
    : UI_PictureTextButton() {
  SetText(text);
  SetImageBaseName(std::move(imageBaseName));
}

UI_PictureTextButton::~UI_PictureTextButton() = default;

void UI_PictureTextButton::SetText(const velkcore::UTF16String& text) {
  text_ = text;
  UI_ProcessStringAndSetMnemonic(text, displayText_);
  InvalidateAll();
}

void UI_PictureTextButton::SetImageBaseName(std::string name) {
  images_.SetBaseName(std::move(name));
  InvalidateAll();
}

void UI_PictureTextButton::SetImageSupplyFunction(const ConstControlCallbackP& supply) {
  images_.SetSupplyFunction(supply);
  InvalidateAll();
}

pictel::ImageP UI_PictureTextButton::GetImage(const pictel::Pictel& context) const {
  return images_.GetImage(*this, context, GetControlState(true), GetCurrentModKeys(),
                          GetDownState());
}

void UI_PictureTextButton::SetRelationship(PictureRelationship relationship) {
  if (relationship_ == relationship) return;
  relationship_ = relationship;
  InvalidateAll();
}

void UI_PictureTextButton::SetAlignment(ControlAlignment alignment) {
  if (alignment_ == alignment) return;
  alignment_ = alignment;
  InvalidateAll();
}

void UI_PictureTextButton::SetSpacing(float spacing) {
  velkcore::RequireInput(std::isfinite(spacing));
  if (spacing_ == spacing) return;
  spacing_ = spacing;
  InvalidateAll();
}

void UI_PictureTextButton::SetTextIndent(float indent) {
  velkcore::RequireInput(std::isfinite(indent));
  if (textIndent_ == indent) return;
  textIndent_ = indent;
  InvalidateAll();
}

void UI_PictureTextButton::SetPictureVerticalOffset(float offset) {
  velkcore::RequireInput(std::isfinite(offset));
  if (pictureVerticalOffset_ == offset) return;
  pictureVerticalOffset_ = offset;
  InvalidateAll();
}

void UI_PictureTextButton::SetScale(const velkcore::PointT<float>& scale) {
  detail::RequireScale(scale);
  if (scale_ == scale) return;
  scale_ = scale;
  InvalidateAll();
}

void UI_PictureTextButton::SetFontSize(float size) {
  velkcore::RequireInput(std::isfinite(size) && size >= 0);
  if (fontSize_ == size) return;
  fontSize_ = size;
  InvalidateAll();
}

float UI_PictureTextButton::EffectiveFontSize() const {
  return fontSize_ > 0 ? fontSize_ : DefaultTextSize();
}

void UI_PictureTextButton::SetDisplayBorderNever(bool never) {
  if (borderNever_ == never) return;
  borderNever_ = never;
  InvalidateAll();
}

velkcore::PointT<float> UI_PictureTextButton::GetPictureSize(const pictel::Pictel& context) const {
  const pictel::ImageP image = GetImage(context);
  if (!image) return {0, 0};
  return {static_cast<float>(image->GetWidth()) * scale_.x,
          static_cast<float>(image->GetHeight()) * scale_.y};
}

void UI_PictureTextButton::DrawPicture(pictel::Pictel& context, const velkcore::RectT<float>& rect,
                                       ControlState state) const {
  const pictel::ImageP image = GetImage(context);
  if (!image) return;
  detail::DrawImageIn(context, *image, rect, state.IsSet(kControlStateDisabled) ? 0.4f : 1.0f);
}

void UI_PictureTextButton::UI_Draw(pictel::Pictel* context) const {
  DrawButtonParameters parameters(this);
  ApplyToggleAppearance(parameters);
  parameters.SetDrawContainer(!borderNever_);
  const Face face(*this);
  parameters.SetDrawButtonFace(&face);
  UI_Button::Draw(parameters, context);
  UI_Button::UI_Draw(context);
}

velkcore::PointT<float> UI_PictureTextButton::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::FontP font = detail::ControlFont(*context, EffectiveFontSize());
  const velkcore::PointT<float> picture = GetPictureSize(*context);
  const float textWidth = detail::MeasureText(*context, font, displayText_);
  const float textHeight = std::ceil(font->GetAscent() + font->GetDescent());
  const float gap = !displayText_.empty() && picture.x > 0 ? spacing_ : 0.0f;
  const float padding = borderNever_ ? 2.0f : 2 * kHorizontalPadding;
  const bool stacked = relationship_ == PictureRelationship::kPictureAbove ||
                       relationship_ == PictureRelationship::kPictureBelow;
  if (stacked) {
    return {std::ceil(std::max(picture.x, textWidth) + padding + 2 * textIndent_),
            std::ceil(picture.y + gap + textHeight + 12.0f)};
  }
  return {std::ceil(picture.x + gap + textWidth + padding + 2 * textIndent_),
          std::max(22.0f, std::ceil(std::max(picture.y, textHeight) + 8.0f))};
}

}  // namespace velkui::controls
