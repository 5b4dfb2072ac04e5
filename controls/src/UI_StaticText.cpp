#include <velkui/controls/UI_StaticText.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/SurfaceInterface.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kStaticText = 179;
constexpr ui::UI_Color kDisabledStaticText = 180;
constexpr float kDefaultWrapWidth = 200.0f;

}  // namespace

UI_StaticText::UI_StaticText() {
  UI_SetNodeID("UI_StaticText");
}

UI_StaticText::UI_StaticText(const velkcore::UTF16String& text, bool multiLine) : UI_StaticText() {
  text_ = text;
  multiLine_ = multiLine;
}

UI_StaticText::~UI_StaticText() = default;

void UI_StaticText::SetText(const velkcore::UTF16String& text) {
  if (text_ == text) return;
  text_ = text;
  InvalidateAll();
}

void UI_StaticText::SetMultiLine(bool multiLine) {
  if (multiLine_ == multiLine) return;
  multiLine_ = multiLine;
  InvalidateAll();
}

void UI_StaticText::SetAlignment(ControlAlignment alignment, ControlVerticalAlignment vertical) {
  alignment_ = alignment;
  verticalAlignment_ = vertical;
  InvalidateAll();
}

void UI_StaticText::TextSettingsChanged() {
  InvalidateAll();
}

void UI_StaticText::UI_Draw(pictel::Pictel* context) const {
  if (!text_.empty()) {
    pictel::SurfaceInterface& surface = *context->GetSurface();
    const velkcore::RectT<float> r = UI_GetLocalRectF(false);
    const pictel::FontP font = detail::TextControlFont(*context, *this);
    const ui::UI_Color color = IsDisabled() ? kDisabledStaticText : kStaticText;
    const pictel::BrushP brush(*context->GetSupplier(), detail::ThemeColor(color, nullptr));
    const pictel::TextAlignment alignment = UI_GetPictelTextAlignment(alignment_, r, nullptr);
    const float lineHeight = std::ceil(font->GetAscent() + font->GetDescent());
    if (multiLine_) {
      const float height = std::min(
          surface.MeasureMultiLineStringHeight(*font, text_.c_str(), r.width, -1), r.height);
      float top = r.top;
      if (verticalAlignment_ == kControlAlignMiddle) top = r.top + (r.height - height) / 2;
      if (verticalAlignment_ == kControlAlignBottom) top = r.top + r.height - height;
      const pictel::ScopedSurfaceState saved(surface);
      UI_ClipToSelf(context);
      surface.DrawMultiLineString(*brush, *font, text_.c_str(), {r.left, top, r.width, height},
                                  alignment);
    } else {
      velkcore::RectT<float> line{r.left, r.top, r.width, std::min(lineHeight, r.height)};
      if (verticalAlignment_ == kControlAlignMiddle)
        line.top = r.top + (r.height - line.height) / 2;
      if (verticalAlignment_ == kControlAlignBottom) line.top = r.top + r.height - line.height;
      velkcore::PointT<float> anchor{};
      UI_GetPictelTextAlignment(alignment_, line, &anchor);
      anchor.y = GetFontBaseline(font, line);
      surface.DrawString(*brush, *font, text_.c_str(), anchor, alignment, GetTextTruncation(),
                         r.width);
    }
  }
  UI_ControlView::UI_Draw(context);
}

velkcore::PointT<float> UI_StaticText::UI_GetRecommendedSize(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const pictel::FontP font = detail::TextControlFont(*context, *this);
  const float lineHeight = std::ceil(font->GetAscent() + font->GetDescent());
  if (!multiLine_) {
    float width = detail::MeasureText(*context, font, text_);
    if (GetMeasureCharacters() > 0) {
      const velkcore::UTF16String sample(static_cast<std::size_t>(GetMeasureCharacters()), u'0');
      width = detail::MeasureText(*context, font, sample);
    }
    return {std::ceil(width) + 2.0f, lineHeight};
  }
  const float current = UI_GetLocalRectF(false).width;
  const float width = current > 0 ? current : kDefaultWrapWidth;
  const float height = text_.empty() ? lineHeight
                                     : context->GetSurface()->MeasureMultiLineStringHeight(
                                           *font, text_.c_str(), width, -1);
  return {width, std::ceil(std::max(height, lineHeight))};
}

}  // namespace velkui::controls
