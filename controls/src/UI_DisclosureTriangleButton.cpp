#include <velkui/controls/UI_DisclosureTriangleButton.h>

#include <algorithm>
#include <cmath>
#include <numbers>

#include <velkcore/Error.h>
#include <velkui/controls/ControlClock.h>
#include <velkui/ui/UI_NodeManager.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

constexpr ui::UI_Color kTriangle = 80;
constexpr ui::UI_Color kDisabledTriangle = 29;
constexpr ui::UI_Color kFocusRing = 18;

}  // namespace

// ---- DrawTrianglePicture ----

void DrawTrianglePicture::Draw(ControlState state, const velkcore::RectT<float>& rect,
                               const velkcore::PointT<float>& offset, pictel::Pictel* context,
                               const ColorChangeMap* map) const {
  const float cx = rect.left + rect.width / 2 + offset.x;
  const float cy = rect.top + rect.height / 2 + offset.y;
  const float radians = angle_ * std::numbers::pi_v<float> / 180.0f;
  const float c = std::cos(radians);
  const float s = std::sin(radians);
  const auto at = [&](float x, float y) {
    return velkcore::PointT<float>{cx + x * c - y * s, cy + x * s + y * c};
  };
  const float h = size_ / 2;
  pictel::PathP path(*context->GetSupplier());
  path->MoveTo(at(-h * 0.6f, -h));
  path->LineTo(at(h * 0.85f, 0));
  path->LineTo(at(-h * 0.6f, h));
  path->Close();
  const ui::UI_Color color = state.IsSet(kControlStateDisabled) ? kDisabledTriangle : kTriangle;
  pictel::ColorRGBA fill = detail::ThemeColor(color, map);
  if (state.IsSet(kControlStateRollover) && !state.IsSet(kControlStateDisabled)) {
    fill = detail::Mix(fill, detail::ThemeColor(kFocusRing, map), 0.45f);
  }
  detail::Fill(*context, path, fill);
}

// ---- UI_DisclosureTriangleButton ----

UI_DisclosureTriangleButton::UI_DisclosureTriangleButton() {
  UI_SetNodeID("UI_DisclosureTriangleButton");
  SetSpringLoaded(false);
  SetDisplayBorderNever(true);
  SetAlignment(kControlAlignLeft);
}

UI_DisclosureTriangleButton::UI_DisclosureTriangleButton(const velkcore::UTF16String& text)
    : UI_DisclosureTriangleButton() {
  SetText(text);
}

UI_DisclosureTriangleButton::~UI_DisclosureTriangleButton() = default;

void UI_DisclosureTriangleButton::SetTwirlDuration(float seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0);
  twirlDuration_ = seconds;
}

bool UI_DisclosureTriangleButton::ShowsOpen() const {
  // While a press is tracked the triangle keeps showing the value.
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  if (manager != nullptr && manager->GetActiveInputCapture() == this) return IsOpen();
  return GetDownState();
}

void UI_DisclosureTriangleButton::SetDownState(bool down) {
  UI_PictureTextButton::SetDownState(down);
  const bool open = ShowsOpen();
  if (open == shownOpen_) return;
  shownOpen_ = open;
  // Without a window there is no timer to animate with: the triangle turns at once.
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false);
  if (twirlDuration_ <= 0 || manager == nullptr || UI_GetTimerManager(true) == nullptr) {
    twirlStart_ = -1.0;
    return;
  }
  twirlStart_ = GetControlTime();
  if (twirlTimerId_ == 0) twirlTimerId_ = manager->GetUniqueTimerID();
  UI_InstallTimer(kTwirlFrameInterval, twirlTimerId_);
}

bool UI_DisclosureTriangleButton::UI_DoTimerNotify(std::int32_t id) {
  if (twirlTimerId_ == 0 || id != twirlTimerId_) {
    return UI_PictureTextButton::UI_DoTimerNotify(id);
  }
  InvalidateAll();
  // The timer goes once the twirl is over.
  return IsTwirling();
}

bool UI_DisclosureTriangleButton::IsTwirling() const {
  return twirlStart_ >= 0 && GetControlTime() - twirlStart_ < twirlDuration_;
}

float UI_DisclosureTriangleButton::GetCurrentAngle() const {
  const float target = ShowsOpen() ? 90.0f : 0.0f;
  if (!IsTwirling()) return target;
  const float progress =
      std::clamp(static_cast<float>((GetControlTime() - twirlStart_) / twirlDuration_), 0.0f, 1.0f);
  return ShowsOpen() ? 90.0f * progress : 90.0f * (1.0f - progress);
}

velkcore::PointT<float> UI_DisclosureTriangleButton::GetPictureSize(const pictel::Pictel&) const {
  const velkcore::PointT<float> scale = GetScale();
  return {DrawTrianglePicture::kDefaultSize * scale.x + 4,
          DrawTrianglePicture::kDefaultSize * scale.y + 4};
}

void UI_DisclosureTriangleButton::DrawPicture(pictel::Pictel& context,
                                              const velkcore::RectT<float>& rect,
                                              ControlState state) const {
  const DrawTrianglePicture triangle(GetCurrentAngle(),
                                     DrawTrianglePicture::kDefaultSize * GetScale().y);
  triangle.Draw(state, rect, {0, 0}, &context, &GetColorChangeMap());
  if (state.IsSet(kControlStateFocus)) {
    detail::Stroke(context, detail::RoundedPath(context, detail::Inset(rect, -1.5f, -1.5f), 3.0f),
                   detail::WithAlpha(detail::ThemeColor(kFocusRing, &GetColorChangeMap()), 0.8f),
                   1.5f);
  }
}

}  // namespace velkui::controls
