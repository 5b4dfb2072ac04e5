#include <velkui/ui/OS_Dialog.h>

#include <algorithm>
#include <limits>

#include <velkcore/Error.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/ui/KeyboardCode.h>
#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/NodeManagerGuards.h>
#include <velkui/ui/Platform.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

constexpr std::int32_t kUnlimited = std::numeric_limits<std::int32_t>::max();

bool ShowsCloseBox() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager == nullptr ||
         manager->GetCustomSettingsManager().GetBoolean(OS_Dialog::kShowCloseBoxSetting, true);
}

// The platform window that owns a dialog of `parent`: that of its top-level window.
PlatformWindow OwnerHandle(OS_Window* parent) {
  if (parent == nullptr) return kNoPlatformWindow;
  auto* root = dynamic_cast<OS_Window*>(parent->UI_GetRootNode());
  return (root != nullptr ? root : parent)->GetPlatformWindow(false);
}

bool IsOwnedBy(const UI_Window& window, const UI_Window* owner) {
  for (const UI_Window* w = window.GetOwner(); w != nullptr; w = w->GetOwner()) {
    if (w == owner) return true;
  }
  return false;
}

RectT<std::int32_t> PrimaryWorkArea(const Platform& platform) {
  const std::vector<MonitorDescription> monitors = platform.GetMonitors();
  if (monitors.empty()) return {};
  const auto primary = std::find_if(monitors.begin(), monitors.end(),
                                    [](const MonitorDescription& m) { return m.primary; });
  return (primary != monitors.end() ? *primary : monitors.front()).workArea;
}

}  // namespace

// ---- Construction ----

std::uint32_t OS_Dialog::DefaultStyle(const DialogParams& params) {
  if (params.popup) return kPopupStyle;
  std::uint32_t style = kModalFrameStyle;
  if (ShowsCloseBox()) style |= kStyleSystemMenu;
  if (params.resizable) style |= kStyleSizingFrame;
  return style;
}

OS_Dialog::OS_Dialog(const DialogParams& params, SubViewP content)
    : maximumSize_{kUnlimited, kUnlimited} {
  velkcore::RequireInput(params.size.x >= 0 && params.size.y >= 0);
  UI_SetNodeID("OS_Dialog");
  if (params.parent != nullptr) SetOwner(params.parent);
  const std::uint32_t style = params.style.value_or(DefaultStyle(params));
  const std::uint32_t exStyle =
      params.extendedStyle.value_or(params.popup ? kPopupExStyle : kModalFrameExStyle);
  UI_CreateWindow(params.title, OwnerHandle(params.parent),
                  {params.position.x, params.position.y, params.size.x, params.size.y}, style,
                  exStyle);
  // The frame was given the content's size: give it to the client area instead.
  SetContentSize(params.size);
  if (params.center) Center();
  content_ = content != nullptr ? std::move(content) : velkcore::MakeIntrusive<UI_SubView>();
  content_->UI_SetLocalRectF(UI_GetLocalRectF(false));
  content_->UI_Show(true);
  ChildPushBack(content_);
}

OS_Dialog::~OS_Dialog() {
  try {
    OS_Dialog::EndModal();
  } catch (...) {
    // A destructor must not throw; the run is over either way.
  }
}

// ---- Node operations ----

bool OS_Dialog::UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) {
  if (event.IsActionKeyDown() && !event.IsRepeat()) {
    const std::uint16_t key = event.GetKeyControlCode();
    const NodeP keep = detail::Hold(this);
    if (key == kKeyReturn || key == kKeyEnter) {
      if (OnReturnKey(event.GetModKey())) return true;
    } else if (key == kKeyEscape) {
      if (OnEscapeKey(event.GetModKey())) return true;
    }
  }
  return OS_Window::UI_DoKeyboardEvent(target, event);
}

void OS_Dialog::UI_HandleOSEvent(OS_Event* event) {
  if (event == nullptr || event->GetMsg() != kMsgClose) {
    OS_Window::UI_HandleOSEvent(event);
    return;
  }
  const NodeP keep = detail::Hold(this);
  if (!RunCloseFunctions()) OnCloseButton();
}

void OS_Dialog::UI_SizeChanged(const RectT<float>& newLocalRect) {
  OS_Window::UI_SizeChanged(newLocalRect);
  if (content_) content_->UI_SetLocalRectF({0, 0, newLocalRect.width, newLocalRect.height});
}

void OS_Dialog::UI_Show(bool show) {
  if (show && !modal_ && !UI_IsShown()) closing_ = false;
  OS_Window::UI_Show(show);
}

// ---- Modal run ----

void OS_Dialog::RunModal() {
  velkcore::RequireInput(!modal_);
  const NodeP keep = detail::Hold(this);
  BeginModal();
  try {
    ModalLoop();
  } catch (...) {
    EndModal();
    throw;
  }
  EndModal();
}

void OS_Dialog::BeginModal() {
  velkcore::RequireInput(!modal_);
  const NodeP keep = detail::Hold(this);
  Platform& platform = GetPlatform();
  closing_ = false;
  endedByQuit_ = false;
  modal_ = true;
  try {
    previousActive_ = platform.GetActiveWindow();
    // Windows are blocked only when the run will unblock them again: a
    // dialog of the desktop blocks nothing.
    if (GetDialogParent() != nullptr) BlockOtherWindows();
    if (UI_NodeManager* manager = UI_NodeManager::Get(false)) {
      modalGuard_ = std::make_unique<SetModalWindow>(*manager, this);
    }
    OS_Window::UI_Show(true);
    if (ActivatesWindowOnBeginModal()) UI_Activate();
  } catch (...) {
    EndModal();
    throw;
  }
}

bool OS_Dialog::ModalDuring() {
  const NodeP keep = detail::Hold(this);
  while (!closing_) {
    const PumpResult result = OS_PumpEvent(false);
    if (result == PumpResult::kQuit) endedByQuit_ = true;
    if (result != PumpResult::kDispatched) break;
  }
  return !closing_ && !endedByQuit_;
}

PumpResult OS_Dialog::ModalLoop() {
  const PumpResult result = OS_RunMessageLoop([this] { return closing_; });
  if (result == PumpResult::kQuit) endedByQuit_ = true;
  return result;
}

void OS_Dialog::EndModal() {
  if (!modal_) return;
  const NodeP keep = detail::Hold(this);
  // Whatever fails below, the run is over and the modal-window role goes.
  modal_ = false;
  try {
    UnblockWindows();
    if (ActivatesWindowOnBeginModal()) ReactivatePreviousWindow();
    previousActive_ = kNoPlatformWindow;
    OS_Window::UI_Show(false);
  } catch (...) {
    modalGuard_.reset();
    throw;
  }
  modalGuard_.reset();
}

void OS_Dialog::BlockOtherWindows() {
  for (OS_Window* window : UI_EnumerateAllWindows()) {
    const PlatformWindow handle = window->GetPlatformWindow(false);
    const bool blocks = window != this && handle != kNoPlatformWindow && !window->IsEmbedded() &&
                        (window->GetStyle() & kStyleChild) == 0 &&
                        (window->GetExStyle() & kExStyleNoActivate) == 0 &&
                        !IsOwnedBy(*window, this) && !window->UI_IsDisabled();
    if (!blocks) continue;
    blocked_.push_back({handle, window});
    const NodeP keepWindow = detail::Hold(window);
    window->UI_SetDisabled(true);
  }
}

void OS_Dialog::UnblockWindows() {
  const std::vector<BlockedWindow> blocked = std::move(blocked_);
  blocked_.clear();
  for (const BlockedWindow& entry : blocked) {
    // A window destroyed meanwhile is gone from the registry.
    OS_Window* window = UI_GetWindow(entry.handle);
    if (window == nullptr || window != entry.window) continue;
    const NodeP keepWindow = detail::Hold(window);
    window->UI_SetDisabled(false);
  }
}

void OS_Dialog::ReactivatePreviousWindow() {
  const PlatformWindow previous = previousActive_;
  if (previous == kNoPlatformWindow || previous == GetPlatformWindow(false)) return;
  Platform& platform = GetPlatform();
  if (platform.IsWindow(previous) && platform.IsWindowVisible(previous)) {
    platform.ActivateWindow(previous, false);
  }
}

bool OS_Dialog::OnReturnKey(ModifierKeys) {
  return false;
}

bool OS_Dialog::OnEscapeKey(ModifierKeys) {
  PostClose();
  return true;
}

void OS_Dialog::OnCloseButton() {
  PostClose();
}

void OS_Dialog::PostClose() {
  closing_ = true;
  if (!modal_) OS_Window::UI_Show(false);
}

bool OS_Dialog::ActivatesWindowOnBeginModal() const {
  return true;
}

// ---- Placement and size ----

OS_Window* OS_Dialog::GetDialogParent() const {
  return dynamic_cast<OS_Window*>(GetOwner());
}

void OS_Dialog::Center() {
  Platform& platform = GetPlatform();
  RectT<std::int32_t> frame = UI_GetGlobalStructureRect();
  RectT<std::int32_t> area = PrimaryWorkArea(platform);
  if (OS_Window* parent = GetDialogParent()) {
    if (parent->UI_IsShown() && !parent->UI_IsMinimized()) {
      area = parent->UI_GetGlobalStructureRect();
    }
  }
  frame.left = area.left + (area.width - frame.width) / 2;
  frame.top = area.top + (area.height - frame.height) / 2;
  const OS_MonitorInfo monitors;
  if (monitors.GetMonitorCount() > 0) monitors.EnsureRectIsVisible(&frame, false);
  UI_Move({frame.left, frame.top});
}

PointT<std::int32_t> OS_Dialog::ClampToLimits(PointT<std::int32_t> size) const {
  size.x = std::clamp(size.x, minimumSize_.x, maximumSize_.x);
  size.y = std::clamp(size.y, minimumSize_.y, maximumSize_.y);
  return size;
}

void OS_Dialog::SetContentSize(const PointT<std::int32_t>& size) {
  velkcore::RequireInput(size.x >= 0 && size.y >= 0);
  const PointT<std::int32_t> clamped = ClampToLimits(size);
  const RectT<std::int32_t> client = UI_GetLocalRect(true);
  UI_SetLocalRect({client.left, client.top, clamped.x, clamped.y});
}

void OS_Dialog::SetMinimumSize(const PointT<std::int32_t>& size) {
  velkcore::RequireInput(size.x >= 0 && size.y >= 0 && size.x <= maximumSize_.x &&
                         size.y <= maximumSize_.y);
  minimumSize_ = size;
}

void OS_Dialog::SetMaximumSize(const PointT<std::int32_t>& size) {
  velkcore::RequireInput(size.x >= minimumSize_.x && size.y >= minimumSize_.y);
  maximumSize_ = size;
}

}  // namespace velkui::ui
