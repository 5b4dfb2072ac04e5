#include <velkui/ui/OS_ToolTip.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/Platform.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

constexpr ThemeColorIndex kToolTipBackground = 130;
constexpr ThemeColorIndex kToolTipText = 131;
constexpr ThemeColorIndex kToolTipOutline = 132;
constexpr ThemeFontIndex kToolTipFont = 0;
constexpr float kPaddingX = 7.0f;
constexpr float kPaddingY = 4.0f;
constexpr float kMaxAutoWidth = 400.0f;
constexpr float kCornerRadius = 3.0f;

pictel::ColorRGBA ThemeColor(ThemeColorIndex index, const pictel::ColorRGBA& fallback) {
  if (Theme::IsInitialized() && Theme::Get().HasColor(index)) return Theme::Get().GetColor(index);
  return fallback;
}

pictel::FontP ToolTipFont(const pictel::SupplierInterface& supplier) {
  if (Theme::IsInitialized() && Theme::Get().HasFont(kToolTipFont)) {
    return pictel::FontP(supplier, Theme::Get().GetFontName(kToolTipFont), u"",
                         Theme::Get().GetFontSize(kToolTipFont));
  }
  return pictel::FontP(supplier, pictel::GetPlatformUIFontFamily(), u"", Theme::kDefaultFontSize);
}

// The widest line of `text` in `font`.
float WidestLine(const pictel::FontInterface& font, const velkcore::UTF16String& text) {
  float widest = 0;
  std::size_t start = 0;
  while (start <= text.size()) {
    std::size_t end = text.find_first_of(u"\r\n", start);
    if (end == velkcore::UTF16String::npos) end = text.size();
    const velkcore::UTF16String line = text.substr(start, end - start);
    widest = std::max(widest, font.MeasureStringWidth(line.c_str(), -1));
    if (end >= text.size()) break;
    start = end + 1;
    if (text[end] == u'\r' && start < text.size() && text[start] == u'\n') ++start;
  }
  return widest;
}

// The bubble: the whole pop-up, drawn afresh on every paint.
class ToolTipBubble : public UI_SubView {
 public:
  explicit ToolTipBubble(const OS_ToolTip& tip) : tip_(tip) {}

  void UI_Draw(pictel::Pictel* context) const override {
    pictel::SurfaceInterface& surface = *context->GetSurface();
    const pictel::SupplierInterface& supplier = *context->GetSupplier();
    const RectT<float> bounds = UI_GetLocalRectF(false);
    pictel::PathP bubble;
    GetRoundedRectPath(
        &supplier,
        {bounds.left + 0.5f, bounds.top + 0.5f, bounds.width - 1.0f, bounds.height - 1.0f},
        kCornerRadius, &bubble);
    const pictel::BrushP fill(supplier, ThemeColor(kToolTipBackground, {0.25f, 0.25f, 0.25f, 1}));
    surface.FillPath(*fill, *bubble, pictel::FillType::kWinding);
    const pictel::PenP outline(supplier, ThemeColor(kToolTipOutline, {0.15f, 0.15f, 0.15f, 1}),
                               1.0f);
    surface.StrokePath(*outline, *bubble);
    const pictel::FontP font = ToolTipFont(supplier);
    const pictel::BrushP ink(supplier, ThemeColor(kToolTipText, {0.97f, 0.97f, 0.97f, 1}));
    surface.DrawMultiLineString(*ink, *font, tip_.GetText().c_str(),
                                {kPaddingX, kPaddingY, bounds.width - 2 * kPaddingX + 1.0f,
                                 bounds.height - 2 * kPaddingY + 1.0f},
                                pictel::TextAlignment::kStart);
  }

 private:
  const OS_ToolTip& tip_;
};

}  // namespace

OS_ToolTip::OS_ToolTip(velkcore::UTF16String text, UI_Node* owner, std::int32_t width)
    : UI_ToolTip(std::move(text), owner, width) {}

OS_ToolTip::~OS_ToolTip() {
  if (window_) {
    // The bubble refers to this tip: it must not outlive it.
    window_->DeleteChildren();
    window_->UI_Show(false);
  }
}

PointT<std::int32_t> OS_ToolTip::MeasureBubble() const {
  const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  const pictel::FontP font = ToolTipFont(*supplier);
  float textWidth = GetWidth() > 0 ? static_cast<float>(GetWidth())
                                   : std::min(WidestLine(*font, GetText()), kMaxAutoWidth);
  textWidth = std::max(textWidth, 1.0f);
  const float textHeight = font->MeasureMultiLineStringHeight(GetText().c_str(), -1, textWidth);
  return {static_cast<std::int32_t>(std::ceil(textWidth + 2 * kPaddingX)),
          static_cast<std::int32_t>(std::ceil(textHeight + 2 * kPaddingY))};
}

void OS_ToolTip::Place() {
  if (!window_) return;
  const PointT<std::int32_t> size = MeasureBubble();
  const Platform& platform = GetPlatform();
  const PointT<std::int32_t> pointer = platform.GetPointerPosition();
  PointT<std::int32_t> at;
  if (GetLocation()) {
    at = {static_cast<std::int32_t>(std::lround(GetLocation()->x)),
          static_cast<std::int32_t>(std::lround(GetLocation()->y))};
  } else {
    at = {pointer.x + GetTrackingOffset().x, pointer.y + GetTrackingOffset().y};
  }
  RectT<std::int32_t> frame{at.x, at.y, size.x, size.y};
  const OS_MonitorInfo monitors;
  if (monitors.GetMonitorCount() > 0) {
    const RectT<std::int32_t> monitor = monitors.GetMonitorRectFromPoint(pointer, true);
    RectT<std::int32_t> area = monitor;
    for (std::int32_t i = 0; i < monitors.GetMonitorCount(); ++i) {
      RectT<std::int32_t> candidate;
      if (monitors.GetMonitorRect(i, candidate) && candidate == monitor)
        monitors.GetWorkArea(i, area);
    }
    // Below the pointer when there is room, else above it.
    if (!GetLocation() && frame.Bottom() > area.Bottom()) {
      frame.top = pointer.y - size.y - 4;
    }
    monitors.EnsureRectIsVisible(&frame, true);
  }
  window_->UI_SetLocalRect(frame);
  if (window_->ChildSize() > 0) {
    window_->ChildGet(0)->UI_SetLocalRectF(
        {0, 0, static_cast<float>(frame.width), static_cast<float>(frame.height)});
  }
}

void OS_ToolTip::UpdateTooltipText() {
  if (!window_) return;
  Place();
  window_->UI_Invalidate(nullptr, InvalidateFlags{});
}

void OS_ToolTip::SetLocation(const PointT<float>& location) {
  UI_ToolTip::SetLocation(location);
  Place();
}

void OS_ToolTip::SetTrackingOffset(const PointT<std::int32_t>& offset) {
  UI_ToolTip::SetTrackingOffset(offset);
  Place();
}

void OS_ToolTip::Show() {
  if (!window_) {
    window_ = velkcore::MakeIntrusive<OS_PopupWindow>();
    window_->UI_SetNodeID("OS_ToolTip");
    // Transparent outside the rounded corners.
    window_->SetBackgroundColor(pictel::ColorRGBA{0, 0, 0, 0});
    window_->UI_CreatePopupWindow({0, 0, 1, 1});
    const boost::intrusive_ptr<ToolTipBubble> bubble =
        velkcore::MakeIntrusive<ToolTipBubble>(*this);
    bubble->UI_Show(true);
    window_->ChildPushBack(bubble);
  }
  Place();
  UI_ToolTip::Show();
  window_->UI_Show(true);
}

void OS_ToolTip::Hide() {
  UI_ToolTip::Hide();
  if (window_) window_->UI_Show(false);
}

}  // namespace velkui::ui
