#include <velkui/controls/UI_Button.h>

#include <algorithm>
#include <exception>
#include <optional>

#include <velkcore/Error.h>
#include <velkui/controls/ButtonInputCapture.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/UI_ModKeyNotifier.h>
#include <velkui/ui/UI_NodeManager.h>

#include "ControlDrawing.h"

namespace velkui::controls {

namespace {

using velkcore::PointT;
using velkcore::RectT;

constexpr std::string_view kLoseFocusOnEscSetting = "velkui.controls.UI_Button.LoseFocusOnESC";

// Theme colours of the button body.
constexpr ui::UI_Color kSheen = 0;
constexpr ui::UI_Color kPressedVeil = 17;
constexpr ui::UI_Color kFocusRing = 18;
constexpr ui::UI_Color kOutline = 19;
constexpr ui::UI_Color kFaceTop = 20;
constexpr ui::UI_Color kFaceBottom = 21;
constexpr ui::UI_Color kHoverTop = 22;
constexpr ui::UI_Color kHoverBottom = 23;
constexpr ui::UI_Color kPressedTop = 24;
constexpr ui::UI_Color kPressedBottom = 25;
constexpr ui::UI_Color kDisabledTop = 26;
constexpr ui::UI_Color kDisabledBottom = 27;
constexpr ui::UI_Color kDefaultOutline = 30;
constexpr ui::UI_Color kDefaultTop = 31;
constexpr ui::UI_Color kDefaultBottom = 32;
constexpr ui::UI_Color kDisabledOutline = 48;
constexpr ui::UI_Color kDisabledRing = 309;
constexpr ui::UI_Color kSelectedTop = 347;
constexpr ui::UI_Color kSelectedBottom = 348;
constexpr ui::UI_Color kSelectedOutline = 350;
constexpr ui::UI_Color kHoverSelectedTop = 351;
constexpr ui::UI_Color kHoverSelectedBottom = 352;
constexpr ui::UI_Color kPressedSelectedTop = 353;
constexpr ui::UI_Color kPressedSelectedBottom = 354;
constexpr ui::UI_Color kDisabledSelectedOutline = 355;
constexpr ui::UI_Color kDisabledSelectedFace = 356;

// Room kept around the body for the focus halo.
constexpr float kHaloWidth = 1.0f;

struct FaceColors {
  pictel::ColorRGBA top;
  pictel::ColorRGBA bottom;
};

FaceColors ChooseFaceColors(const DrawButtonParameters& p) {
  const ControlState s = p.GetControlState();
  const ColorChangeMap* map = p.GetColorChangeMap();
  const auto pair = [map](ui::UI_Color top, ui::UI_Color bottom) {
    return FaceColors{detail::ThemeColor(top, map), detail::ThemeColor(bottom, map)};
  };
  const bool down = s.IsSet(kControlStateDown);
  const bool rollover = s.IsSet(kControlStateRollover);
  if (s.IsSet(kControlStateDisabled)) {
    if (p.GetSelectedAppearance()) return pair(kDisabledSelectedFace, kDisabledSelectedFace);
    return pair(kDisabledTop, kDisabledBottom);
  }
  if (p.GetSelectedAppearance()) {
    if (down) return pair(kPressedSelectedTop, kPressedSelectedBottom);
    if (rollover) return pair(kHoverSelectedTop, kHoverSelectedBottom);
    return pair(kSelectedTop, kSelectedBottom);
  }
  if (p.GetDefaultAppearance()) {
    FaceColors colors = pair(kDefaultTop, kDefaultBottom);
    const pictel::ColorRGBA black{0, 0, 0, 1};
    const pictel::ColorRGBA white{1, 1, 1, 1};
    if (down)
      return {detail::Mix(colors.bottom, black, 0.12f), detail::Mix(colors.top, black, 0.05f)};
    if (rollover)
      return {detail::Mix(colors.top, white, 0.15f), detail::Mix(colors.bottom, white, 0.1f)};
    return colors;
  }
  if (down) return pair(kPressedTop, kPressedBottom);
  if (rollover) return pair(kHoverTop, kHoverBottom);
  return pair(kFaceTop, kFaceBottom);
}

ui::UI_Color ChooseFrameColor(const DrawButtonParameters& p) {
  const ControlState s = p.GetControlState();
  if (s.IsSet(kControlStateDisabled)) {
    return p.GetSelectedAppearance() ? kDisabledSelectedOutline : kDisabledOutline;
  }
  if (s.IsSet(kControlStateFocus)) return kFocusRing;
  if (p.GetSelectedAppearance()) return kSelectedOutline;
  if (p.GetDefaultAppearance()) return kDefaultOutline;
  return kOutline;
}

pictel::ColorRGBA FrameColor(const DrawButtonParameters& p) {
  const ControlState s = p.GetControlState();
  const ColorChangeMap* map = p.GetColorChangeMap();
  const pictel::ColorRGBA frame = detail::ThemeColor(ChooseFrameColor(p), map);
  // A hovered button's frame leans towards the accent.
  const bool hoverTint =
      s.IsSet(kControlStateRollover) &&
      !s.IsAnySet(kControlStateDisabled | kControlStateFocus | kControlStateDown) &&
      !p.GetSelectedAppearance() && !p.GetDefaultAppearance();
  return hoverTint ? detail::Mix(frame, detail::ThemeColor(kFocusRing, map), 0.55f) : frame;
}

// The body of a button in layers: ring or frame, face gradient, highlight,
// disabled outline, pressed veil. Answers the rectangle of the face.
RectT<float> DrawBody(const DrawButtonParameters& p, pictel::Pictel& context) {
  const ControlState s = p.GetControlState();
  const ColorChangeMap* map = p.GetColorChangeMap();
  const bool disabled = s.IsSet(kControlStateDisabled);
  const bool down = s.IsSet(kControlStateDown);
  const bool focus = s.IsSet(kControlStateFocus);
  const bool semi = p.GetSemiRounded();
  const float stroke = std::max(p.GetStrokeSize(), 0.0f);
  const float radius = std::max(p.GetCornerRadius(), 0.0f);
  const RectT<float>& rect = p.GetRectF();
  const RectT<float> body = detail::Inset(rect, kHaloWidth, kHaloWidth);

  // 1. The outline ring of a focused or default button, else a plain frame.
  if (focus || p.GetDefaultAppearance()) {
    const ui::UI_Color ring = focus ? kFocusRing : disabled ? kDisabledRing : kOutline;
    detail::Fill(context, detail::RoundedPath(context, rect, radius + kHaloWidth, semi),
                 detail::WithAlpha(detail::ThemeColor(ring, map), focus ? 0.5f : 0.3f));
  }
  detail::Fill(context, detail::RoundedPath(context, body, radius, semi), FrameColor(p));

  const RectT<float> face = detail::Inset(body, stroke, stroke);
  if (face.width <= 0 || face.height <= 0) return face;
  const float faceRadius = std::max(radius - stroke, 0.0f);
  pictel::PathP facePath = detail::RoundedPath(context, face, faceRadius, semi);

  // 2. The face gradient; a pressed face darkens sooner.
  const FaceColors colors = ChooseFaceColors(p);
  detail::FillGradient(context, facePath, face, colors.top, colors.bottom, down ? 0.3f : 0.5f,
                       p.GetRotatedGradient());

  pictel::SurfaceInterface& surface = *context.GetSurface();
  // 3. A sheen on the upper half and a bright first line.
  if (!disabled) {
    const pictel::ScopedSurfaceState clipped(surface);
    surface.Clip(*facePath, pictel::FillType::kWinding);
    const pictel::ColorRGBA sheen = detail::ThemeColor(kSheen, map);
    const float strength = down ? 0.25f : 1.0f;
    pictel::PathP upper(*context.GetSupplier());
    upper->AddRect(RectT<float>{face.left, face.top, face.width, face.height / 2});
    detail::FillGradient(context, upper, {face.left, face.top, face.width, face.height / 2},
                         detail::WithAlpha(sheen, 0.45f * strength), detail::WithAlpha(sheen, 0.0f),
                         0.5f, false);
    surface.PaintRect(detail::WithAlpha(sheen, 0.8f * strength),
                      {face.left, face.top, face.width, 1.0f});
  }
  // 4. A disabled button keeps a quiet outline.
  if (disabled && !down) {
    const ui::UI_Color outline =
        p.GetSelectedAppearance() ? kDisabledSelectedOutline : kDisabledOutline;
    detail::Stroke(context,
                   detail::RoundedPath(context, detail::Inset(body, 0.5f, 0.5f),
                                       std::max(radius - 0.5f, 0.0f), semi),
                   detail::ThemeColor(outline, map), 1.0f);
  }
  // 5. A pressed button is shaded from the top, as if sunk in.
  if (down) {
    const pictel::ScopedSurfaceState clipped(surface);
    surface.Clip(*facePath, pictel::FillType::kWinding);
    const pictel::ColorRGBA veil = detail::ThemeColor(kPressedVeil, map);
    const RectT<float> shade{face.left, face.top, face.width, std::max(face.height * 0.4f, 2.0f)};
    pictel::PathP shadePath(*context.GetSupplier());
    shadePath->AddRect(shade);
    detail::FillGradient(context, shadePath, shade, detail::WithAlpha(veil, 1.6f),
                         detail::WithAlpha(veil, 0.0f), 0.4f, false);
  }
  return face;
}

}  // namespace

UI_Button::UI_Button() {
  UI_SetNodeID("UI_Button");
  SetWantsKeyboardFocus(true);
}

UI_Button::~UI_Button() {
  SetModifierKeyCallbackEnabled(false);
}

// ---- Value ----

void UI_Button::SetValue(ButtonValue value) {
  const bool wasUnknown = IsValueUnknown();
  if (wasUnknown) SetValueKnown();
  const bool changed = value_ != value;
  value_ = value;
  if (!wasUnknown && !changed && GetDownState() == (value == kButtonOn)) return;
  InvalidateAll();
  SetDownState(value == kButtonOn);
}

void UI_Button::SetDefaultAppearance(bool isDefault) {
  if (defaultAppearance_ == isDefault) return;
  defaultAppearance_ = isDefault;
  InvalidateAll();
}

void UI_Button::SetCornerRadius(float radius) {
  if (cornerRadius_ == radius) return;
  cornerRadius_ = radius;
  InvalidateAll();
}

void UI_Button::SetStrokeSizes(const std::pair<float, float>& sizes) {
  if (strokeSizes_ == sizes) return;
  strokeSizes_ = sizes;
  InvalidateAll();
}

void UI_Button::SetDownOffset(const PointT<float>& offset) {
  if (downOffset_ == offset) return;
  downOffset_ = offset;
  InvalidateAll();
}

void UI_Button::SetContentOffset(const PointT<float>& offset) {
  if (contentOffset_ == offset) return;
  contentOffset_ = offset;
  InvalidateAll();
}

void UI_Button::ApplyToggleAppearance(DrawButtonParameters& parameters) const {
  if (springLoaded_ || value_ != kButtonOn || !GetDownState()) return;
  // An "on" toggle at rest shows the selected face rather than a pressed one.
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  if (manager != nullptr && manager->GetActiveInputCapture() == this) return;
  ControlState state = parameters.GetControlState();
  state.Clear(kControlStateDown);
  parameters.SetControlState(state);
  parameters.SetSelectedAppearance(true);
}

PointT<float> UI_Button::GetCurrentContentOffset() const {
  if (!GetDownState()) return contentOffset_;
  return {contentOffset_.x + downOffset_.x, contentOffset_.y + downOffset_.y};
}

// ---- Pressing ----

void UI_Button::PerformAction(bool down, ui::ModifierKeys modKeys, bool interactive) {
  if (IsDisabled()) return;
  const auto keep = KeepAlive();
  std::optional<ScBeginAndEndInteractiveChange> change;
  if (interactive) change.emplace(*this);
  SetValueKnown();
  SetDownState(springLoaded_ ? false : down);
  SendButtonChangedMessage(modKeys);
  if (change) {
    change->Continue(modKeys);
    change->Finish();
  }
}

void UI_Button::SendButtonChangedMessage(ui::ModifierKeys modKeys) {
  SetValue(GetDownState() ? kButtonOn : kButtonOff);
  UI_ButtonChangedMessage message(this, modKeys);
  SendToListeners(GetChangedListeners(), &message);
}

bool UI_Button::IsButtonCaptured() {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  return manager != nullptr &&
         dynamic_cast<const ButtonInputCapture*>(manager->GetInputCapture()) != nullptr;
}

float UI_Button::GetRepeatInterval() const {
  return InteractiveCallbackSize() > 0 ? kRepeatInterval : 0.0f;
}

void UI_Button::BeginButtonCapture(const ui::MouseEvent& event) {
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(true);
  manager->BeginInputCapture(
      velkcore::MakeIntrusive<ButtonInputCapture>(this, event, GetRepeatInterval()));
}

// ---- Mouse ----

bool UI_Button::UI_DoMouseEvent(ui::UI_Node* target, const ui::MouseEvent& event) {
  if (IsDisabled()) return UI_InteractiveControlView::UI_DoMouseEvent(target, event);
  const auto keep = KeepAlive();
  SendHover(event);
  // Every press counts: the second press of a double click is a press too.
  if (event.IsAction(ui::MouseEvent::kButtonDown) && event.IsButton(ui::MouseEvent::kLeftButton)) {
    // A button that wants no focus leaves it where it is (asking would hand
    // the focus to an ancestor).
    if (changeFocusOnClick_ && UI_WantsKeyboardFocus()) UI_GainKeyboardFocus();
    if (springLoaded_) SetDownState(false);
    if (notificationOnMouseDown_) {
      ToggleDownState();
      PerformAction(GetDownState(), event.GetModKey(), false);
      return true;
    }
    BeginButtonCapture(event);
    return true;
  }
  if (event.IsAction(ui::MouseEvent::kButtonUp) && event.IsButton(ui::MouseEvent::kLeftButton) &&
      notificationOnMouseUp_) {
    const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
    if (manager == nullptr || !manager->HasInputCapture()) {
      PerformAction(false, event.GetModKey(), false);
      return true;
    }
  }
  return UI_InteractiveControlView::UI_DoMouseEvent(target, event);
}

bool UI_Button::UI_InvalidateOnMouseOverChange(bool) const {
  return true;
}

// ---- Keyboard ----

bool UI_Button::LosesFocusOnEscape() const {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst(false);
  return manager == nullptr ||
         manager->GetCustomSettingsManager().GetBoolean(kLoseFocusOnEscSetting, true);
}

bool UI_Button::UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) {
  if (IsDisabled()) return false;
  if (event.IsActionKeyDown() && event.GetKeyControlCode() == ui::kKeyEscape) {
    if (LosesFocusOnEscape() && UI_HasKeyboardFocus(false)) UI_LoseKeyboardFocus();
    return false;
  }
  if (ui::UI_NodeManager::CompareControlActivateShortcut(event)) {
    return HandleControlActivateViaKeyboard(event);
  }
  return UI_InteractiveControlView::UI_DoKeyboardEvent(target, event);
}

bool UI_Button::HandleControlActivateViaKeyboard(const ui::KeyboardEvent& event) {
  if (event.IsActionKeyDown()) {
    if (springLoaded_) {
      SetDownState(true);
    } else {
      ToggleDownState();
    }
    return true;
  }
  if (!event.IsActionKeyUp()) return false;
  if (springLoaded_ && !GetDownState()) return false;
  const auto keep = KeepAlive();
  ScBeginAndEndInteractiveChange change(*this);
  if (!IsDisabled()) {
    SetValueKnown();
    SetDownState(springLoaded_ ? false : GetDownState());
    SendButtonChangedMessage(event.GetModKey());
  }
  change.Continue(event.GetModKey());
  change.Finish();
  return true;
}

bool UI_Button::UI_GainKeyboardFocusFromMnemonic() {
  if (!UI_GainKeyboardFocus()) return false;
  // A toggle pressed by its mnemonic flips.
  PerformAction(springLoaded_ ? true : !GetDownState(), currentModKeys_, true);
  return true;
}

// ---- Tooltips ----

void UI_Button::InsertModifiedToolTip(ui::ModifierKeys keys, const velkcore::UTF16String& text) {
  if (keys.IsEmpty()) {
    defaultToolTip_ = text;
  } else {
    toolTipModKeyMask_ |= keys;
    modifiedToolTips_.emplace_back(keys, text);
  }
  SetModifierKeyCallbackEnabled(true);
  // Show the right tooltip now rather than at the next change of keys.
  UI_SetToolTip(ToolTipForKeys(currentModKeys_), kToolTipWidth);
}

const velkcore::UTF16String& UI_Button::ToolTipForKeys(ui::ModifierKeys keys) const {
  const ui::ModifierKeys relevant = toolTipModKeyMask_ & keys;
  if (!relevant.IsEmpty()) {
    for (const ModifiedToolTip& tip : modifiedToolTips_) {
      if (tip.first == relevant) return tip.second;
    }
  }
  return defaultToolTip_;
}

void UI_Button::ModKeyChanged(ui::ModifierKeys keys) {
  if (keys == currentModKeys_) return;
  currentModKeys_ = keys;
  UI_SetToolTip(ToolTipForKeys(keys), kToolTipWidth);
}

void UI_Button::SetModifierKeyCallbackEnabled(bool enabled) {
  if (enabled == (modKeyCallback_ != nullptr)) return;
  ui::UI_ModKeyNotifier& notifier = ui::UI_ModKeyNotifier::Get();
  if (enabled) {
    modKeyCallback_ = std::make_shared<std::function<void(ui::ModifierKeys)>>(
        [this](ui::ModifierKeys keys) { ModKeyChanged(keys); });
    notifier.InstallModKeyChangedFunction(modKeyCallback_);
  } else {
    notifier.RemoveModKeyChangedFunction(modKeyCallback_);
    // Emptied too, so that a dispatch already under way skips it.
    *modKeyCallback_ = nullptr;
    modKeyCallback_.reset();
  }
}

// ---- Drag and drop ----

void UI_Button::SetWantsDragDropEvents(bool wants) {
  wantsDragDropEvents_ = wants;
}

void UI_Button::SetDragSupportFxn(const DragSupportFunctionP& function) {
  dragSupport_ = function;
}

bool UI_Button::UI_WantsDragDropEvents() const {
  return wantsDragDropEvents_;
}

bool UI_Button::CallDragSupport(DropAction action, const PointT<float>& point,
                                datatransfer::OS_ReceiveData* data, std::int32_t& effect) {
  if (!dragSupport_ || !*dragSupport_ || IsDisabled()) return false;
  const auto keep = KeepAlive();
  const DragSupportFunction call = *dragSupport_;
  return call(*this, action, point, data, effect);
}

bool UI_Button::UI_HandleDragEnter(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                                   std::int32_t& effect) {
  return CallDragSupport(DropAction::kEnter, point, &data, effect);
}

bool UI_Button::UI_HandleDragOver(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                                  std::int32_t& effect) {
  return CallDragSupport(DropAction::kOver, point, &data, effect);
}

void UI_Button::UI_HandleDragLeave() {
  std::int32_t effect = 0;
  CallDragSupport(DropAction::kLeave, {}, nullptr, effect);
}

bool UI_Button::UI_HandleDrop(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                              std::int32_t& effect) {
  return CallDragSupport(DropAction::kDrop, point, &data, effect);
}

// ---- Drawing ----

void UI_Button::Draw(const DrawButtonParameters& parameters, pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr && context->GetSurface() != nullptr);
  pictel::SurfaceInterface& surface = *context->GetSurface();
  const pictel::ScopedSurfaceState saved(surface);
  surface.SetAntiAliasPolicy(pictel::AntiAliasPolicy::kOn);
  const RectT<float>& rect = parameters.GetRectF();
  pictel::PathP clip(*context->GetSupplier());
  clip->AddRect(rect);
  surface.Clip(*clip, pictel::FillType::kWinding);

  const float stroke = parameters.GetStrokeSize();
  if (!(rect.width - stroke > 0) || !(rect.height - stroke > 0)) return;
  RectT<float> content = rect;
  if (parameters.GetDrawContainer()) content = DrawBody(parameters, *context);
  if (const DrawButtonFace* face = parameters.GetDrawButtonFace()) {
    face->Draw(parameters.GetControlState(), content, parameters.GetOffset(), context,
               parameters.GetColorChangeMap());
  }
}

void UI_Button::Draw(ControlState controlState, bool drawContainer, bool defaultAppearance,
                     bool rotatedGradient, float strokeSize, float cornerRadius,
                     const RectT<float>& rect, const PointT<float>& offset,
                     const DrawButtonFace* face, const ColorChangeMap* colorChangeMap,
                     pictel::Pictel* context, bool semiRounded) {
  DrawButtonParameters parameters;
  parameters.SetControlState(controlState);
  parameters.SetDrawContainer(drawContainer);
  parameters.SetDefaultAppearance(defaultAppearance);
  parameters.SetRotatedGradient(rotatedGradient);
  parameters.SetStrokeSize(strokeSize);
  parameters.SetCornerRadius(cornerRadius);
  parameters.SetRectF(rect);
  parameters.SetOffset(offset);
  parameters.SetDrawButtonFace(face);
  parameters.SetColorChangeMap(colorChangeMap);
  parameters.SetSemiRounded(semiRounded);
  Draw(parameters, context);
}

// ---- DrawButtonParameters ----

DrawButtonParameters::DrawButtonParameters(const UI_Button* button) {
  if (button == nullptr) return;
  controlState_ = button->GetControlState(true);
  defaultAppearance_ = button->GetDefaultAppearance();
  strokeSize_ =
      defaultAppearance_ ? button->GetStrokeSizes().second : button->GetStrokeSizes().first;
  cornerRadius_ = button->GetCornerRadius();
  rect_ = button->UI_GetLocalRectF(false);
  offset_ = button->GetCurrentContentOffset();
  colorChangeMap_ = &button->GetColorChangeMap();
}

}  // namespace velkui::controls
