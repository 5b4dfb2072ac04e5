#include <velkui/ui/OS_Window.h>

#include <algorithm>
#include <cmath>
#include <unordered_map>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/Platform.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_NodeTimerManager.h>
#include <velkui/ui/UI_SubView.h>
#include <velkui/ui/UI_ToolTipManager.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;
using velkcore::ScaleMatrixT;

namespace {

// ---- The registry of the library's windows ----

struct WindowRegistry {
  std::unordered_map<PlatformWindow, OS_Window*> byHandle;
  // In the order the windows got their platform window.
  std::vector<OS_Window*> ordered;
};

WindowRegistry& Registry() {
  static WindowRegistry registry;
  return registry;
}

const boost::intrusive_ptr<pictel::SupplierInterface>& SharedSupplier() {
  static const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  return supplier;
}

double PlatformTime() {
  const Platform* platform = GetPlatformIfAny();
  return platform != nullptr ? platform->GetTime() : 0.0;
}

// The timer data of a window: it owns a platform timer whose id is its serial.
class OS_NodeTimerData : public UI_NodeTimerData {
 public:
  OS_NodeTimerData(OS_Window* window, UI_Node* node, std::int32_t id, float seconds)
      : UI_NodeTimerData(window, node, id, seconds), window_(window) {}
  ~OS_NodeTimerData() override { StopPlatformTimer(); }

  void StartPlatformTimer() {
    Platform* platform = GetPlatformIfAny();
    const PlatformWindow handle = window_->GetPlatformWindow(false);
    if (platform == nullptr || handle == kNoPlatformWindow) return;
    const double milliseconds = std::ceil(static_cast<double>(GetSeconds()) * 1000.0);
    platform->SetTimer(handle, GetSerial(),
                       static_cast<std::uint32_t>(std::min(milliseconds, 4.0e9)));
    running_ = handle;
  }

 protected:
  void Start() override { StartPlatformTimer(); }
  void Stop() override { StopPlatformTimer(); }

 private:
  void StopPlatformTimer() {
    if (running_ == kNoPlatformWindow) return;
    if (Platform* platform = GetPlatformIfAny()) platform->KillTimer(running_, GetSerial());
    running_ = kNoPlatformWindow;
  }

  OS_Window* window_;
  PlatformWindow running_ = kNoPlatformWindow;
};

MouseEvent::Action ButtonAction(std::uint32_t message, std::int32_t* button,
                                std::int32_t* baseCount) {
  const std::uint32_t offset = message - kMsgLeftButtonDown;
  const std::uint32_t kind = offset % 3;  // down, up, double click
  static constexpr std::int32_t kButtons[3] = {MouseEvent::kLeftButton, MouseEvent::kMiddleButton,
                                               MouseEvent::kRightButton};
  *button = kButtons[offset / 3];
  *baseCount = kind == 2 ? 2 : 1;
  return kind == 1 ? MouseEvent::kButtonUp : MouseEvent::kButtonDown;
}

PointT<float> ToFloat(const PointT<std::int32_t>& p) {
  return {static_cast<float>(p.x), static_cast<float>(p.y)};
}

// Pieces of `a` outside `b`.
void SubtractRect(const RectT<std::int32_t>& a, const RectT<std::int32_t>& b,
                  std::vector<RectT<std::int32_t>>* out) {
  const RectT<std::int32_t> cut = velkcore::Intersection(a, b);
  if (cut.IsEmpty()) {
    out->push_back(a);
    return;
  }
  if (cut.top > a.top) out->push_back({a.left, a.top, a.width, cut.top - a.top});
  if (cut.Bottom() < a.Bottom()) {
    out->push_back({a.left, cut.Bottom(), a.width, a.Bottom() - cut.Bottom()});
  }
  if (cut.left > a.left) out->push_back({a.left, cut.top, cut.left - a.left, cut.height});
  if (cut.Right() < a.Right()) {
    out->push_back({cut.Right(), cut.top, a.Right() - cut.Right(), cut.height});
  }
}

}  // namespace

// ---- UI_Window ----

UI_Window::~UI_Window() = default;

void UI_Window::SetOwner(UI_Window* owner) {
  // An owner chain must not loop.
  for (const UI_Window* w = owner; w != nullptr; w = w->owner_) {
    velkcore::RequireInput(w != this);
  }
  owner_ = owner;
}

bool UI_Window::OwnedByModalWindow() const {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  const OS_Window* modal = manager != nullptr ? manager->GetModalWindow() : nullptr;
  if (modal == nullptr) return false;
  for (const UI_Window* w = this; w != nullptr; w = w->owner_) {
    if (w == static_cast<const UI_Window*>(modal)) return true;
  }
  return false;
}

// ---- Construction ----

OS_Window::OS_Window() : clickCounter_(&PlatformTime), supplier_(SharedSupplier()) {
  UI_SetNodeID("OS_Window");
  if (Theme::IsInitialized()) {
    themeChanged_ = std::make_shared<ThemeChangedFunction>([this] {
      if (handle_ != kNoPlatformWindow) UI_Invalidate(nullptr, InvalidateFlags{});
    });
    Theme::Get().InstallThemeChangedFunction(themeChanged_);
  }
}

OS_Window::OS_Window(const velkcore::UTF16String& title, const RectT<std::int32_t>& frame,
                     std::uint32_t style, std::uint32_t exStyle, PlatformWindow parent)
    : OS_Window() {
  OS_Window::UI_CreateWindow(title, parent, frame, style, exStyle);
}

OS_Window::~OS_Window() {
  DetachPlatformWindowPreDelete();
  // The children go while this is still a window, so that their last
  // notifications reach a complete object.
  DeleteChildren();
  if (handle_ != kNoPlatformWindow) {
    if (Platform* platform = GetPlatformIfAny()) platform->DestroyWindow(handle_);
    handle_ = kNoPlatformWindow;
  }
}

void OS_Window::DetachPlatformWindowPreDelete() {
  if (themeChanged_) {
    if (Theme::IsInitialized()) Theme::Get().RemoveThemeChangedFunction(themeChanged_);
    themeChanged_.reset();
  }
  for (OS_Window* other : Registry().ordered) {
    if (other->GetOwner() == this) other->SetOwner(nullptr);
  }
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->PopModalWindow(this);
  Unregister();
  // Stops the platform timers while the platform window still exists.
  timers_.reset();
  Platform* platform = GetPlatformIfAny();
  if (platform != nullptr && handle_ != kNoPlatformWindow && platform->GetCapture() == handle_) {
    platform->ReleaseCapture();
  }
}

void OS_Window::Register() {
  WindowRegistry& registry = Registry();
  registry.byHandle[handle_] = this;
  registry.ordered.push_back(this);
}

void OS_Window::Unregister() {
  WindowRegistry& registry = Registry();
  const auto found = registry.byHandle.find(handle_);
  if (found != registry.byHandle.end() && found->second == this) registry.byHandle.erase(found);
  std::erase(registry.ordered, this);
}

// ---- Creating and adopting platform windows ----

void OS_Window::UI_CreateWindow(const velkcore::UTF16String& title, PlatformWindow parent,
                                const RectT<std::int32_t>& frame, std::uint32_t style,
                                std::uint32_t extendedStyle) {
  velkcore::RequireInput(handle_ == kNoPlatformWindow);
  Platform& platform = GetPlatform();
  WindowCreateParams params;
  params.title = title;
  params.parent = parent;
  params.frame = frame;
  params.style = style;
  params.exStyle = extendedStyle;
  if (UI_IsDisabled()) params.style |= kStyleDisabled;
  const PlatformWindow handle = platform.CreateWindow(params);
  style_ = params.style;
  exStyle_ = params.exStyle;
  UI_AttachOSWindow(handle);
}

void OS_Window::UI_AttachWindow(PlatformWindow window) {
  velkcore::RequireInput(handle_ == kNoPlatformWindow);
  velkcore::RequireInput(GetPlatform().IsWindow(window) && UI_GetWindow(window) == nullptr);
  UI_AttachOSWindow(window);
}

void OS_Window::UI_AttachOSWindow(PlatformWindow window) {
  velkcore::RequireInput(window != kNoPlatformWindow && handle_ == kNoPlatformWindow);
  Platform& platform = GetPlatform();
  const NodeP keep = detail::Hold(this);
  handle_ = window;
  Register();
  // A visible window adopted shows the node; a node shown before it had its
  // window shows the window.
  const bool wasShown = shown_;
  shown_ = shown_ || platform.IsWindowVisible(window);
  if (!IsEmbedded()) ReadClientRect();
  RefreshClickMetrics();
  StartPlatformTimers();
  UI_GeometryChanged();
  if (IsEmbedded()) {
    SyncEmbeddedGeometry();
  } else {
    SyncPlatformVisibility();
  }
  if (wasShown != shown_) UI_DispatchNodeChange(NodeChange::kShownChanged);
  SynchronizeEmbeddedDescendants(*this);
}

PlatformWindow OS_Window::GetPlatformWindow(bool create) {
  if (handle_ == kNoPlatformWindow && create) {
    if (IsEmbedded()) {
      UI_SynchronizeParent();
    } else {
      UI_CreateWindow({}, kNoPlatformWindow, {0, 0, 0, 0}, kStyleOverlappedWindow, 0);
    }
  }
  return handle_;
}

PlatformMenu OS_Window::GetPlatformMenu() const {
  return kNoPlatformMenu;
}

void OS_Window::StartPlatformTimers() {
  if (!timers_) return;
  for (UI_NodeTimerData* data : timers_->GetTimers()) {
    static_cast<OS_NodeTimerData*>(data)->StartPlatformTimer();
  }
}

void OS_Window::RefreshClickMetrics() {
  const Platform* platform = GetPlatformIfAny();
  if (platform == nullptr) return;
  clickCounter_.SetDoubleClickTime(platform->GetDoubleClickTime());
  const PointT<std::int32_t> size = platform->GetDoubleClickSize();
  clickCounter_.SetDoubleClickSize(std::max(size.x, 0), std::max(size.y, 0));
}

// ---- The library's windows ----

void OS_Window::UI_Initialize() {
  GetPlatform();
}

bool OS_Window::UI_IsOSWindowType(PlatformWindow window) {
  return UI_GetWindow(window) != nullptr;
}

OS_Window* OS_Window::UI_GetWindow(PlatformWindow window) {
  const WindowRegistry& registry = Registry();
  const auto found = registry.byHandle.find(window);
  return found != registry.byHandle.end() ? found->second : nullptr;
}

std::vector<OS_Window*> OS_Window::UI_EnumerateAllWindows() {
  return Registry().ordered;
}

OS_Window* OS_Window::UI_FindWindowFromID(const std::string& id) {
  for (OS_Window* window : Registry().ordered) {
    if (window->UI_GetNodeID() == id) return window;
  }
  return nullptr;
}

std::vector<OS_Window*> OS_Window::UI_FindAllWindowsMatchingID(const std::string& id) {
  std::vector<OS_Window*> found;
  for (OS_Window* window : Registry().ordered) {
    if (window->UI_GetNodeID() == id) found.push_back(window);
  }
  return found;
}

OS_Window* OS_Window::GetWindowFromMouse() {
  const Platform* platform = GetPlatformIfAny();
  if (platform == nullptr) return nullptr;
  return UI_GetWindow(platform->GetWindowFromPoint(platform->GetPointerPosition()));
}

// ---- UI_Window operations ----

void OS_Window::UI_SetTitle(const velkcore::UTF16String& title) {
  if (handle_ != kNoPlatformWindow) GetPlatform().SetWindowTitle(handle_, title);
}

bool OS_Window::UI_IsMinimized() const {
  return handle_ != kNoPlatformWindow && GetPlatform().IsWindowMinimized(handle_);
}

void OS_Window::UI_Minimize(bool minimize) {
  if (handle_ == kNoPlatformWindow || IsEmbedded()) return;
  const NodeP keep = detail::Hold(this);
  GetPlatform().MinimizeWindow(handle_, minimize);
  UI_DispatchNodeChange(NodeChange::kShownChanged);
}

bool OS_Window::UI_DuringClose() const {
  return closing_;
}

void OS_Window::UI_PostClose() {
  if (handle_ == kNoPlatformWindow) return;
  Platform& platform = GetPlatform();
  platform.PostEvent(OS_Event(handle_, kMsgClose, 0, 0, platform.GetTime()));
}

RectT<std::int32_t> OS_Window::UI_GetGlobalStructureRect() const {
  if (handle_ == kNoPlatformWindow) return {};
  return GetPlatform().GetFrameRect(handle_);
}

void OS_Window::UI_SetGlobalStructureRect(const RectT<std::int32_t>& frame) {
  velkcore::RequireInput(frame.width >= 0 && frame.height >= 0);
  if (handle_ == kNoPlatformWindow || IsEmbedded()) return;
  const NodeP keep = detail::Hold(this);
  const RectT<std::int32_t> before = client_;
  GetPlatform().SetFrameRect(handle_, frame);
  ReadClientRect();
  ClientAreaChanged(before);
}

void OS_Window::UI_Move(const PointT<std::int32_t>& topLeft) {
  RectT<std::int32_t> frame = UI_GetGlobalStructureRect();
  frame.left = topLeft.x;
  frame.top = topLeft.y;
  UI_SetGlobalStructureRect(frame);
}

void OS_Window::UI_Activate() {
  if (handle_ != kNoPlatformWindow) GetPlatform().ActivateWindow(handle_, false);
}

// ---- Geometry ----

void OS_Window::ReadClientRect() {
  client_ = GetPlatform().GetClientRect(handle_);
}

ScaleMatrixT<float> OS_Window::UI_GetSelfToParentMatrix() const {
  if (IsEmbedded()) return {frame_.left, frame_.top, 1.0f, 1.0f};
  return {static_cast<float>(client_.left), static_cast<float>(client_.top), 1.0f, 1.0f};
}

RectT<std::int32_t> OS_Window::UI_GetLocalRect(bool inParent) const {
  return detail::RoundOut(UI_GetLocalRectF(inParent));
}

RectT<float> OS_Window::UI_GetLocalRectF(bool inParent) const {
  const RectT<float> inParentRect = IsEmbedded() ? frame_ : detail::ToFloat(client_);
  if (inParent) return inParentRect;
  return {0.0f, 0.0f, inParentRect.width, inParentRect.height};
}

void OS_Window::UI_SetLocalRect(const RectT<std::int32_t>& rect) {
  UI_SetLocalRectF(detail::ToFloat(rect));
}

void OS_Window::UI_SetLocalRectF(const RectT<float>& rect) {
  velkcore::RequireInput(std::isfinite(rect.left) && std::isfinite(rect.top) &&
                         std::isfinite(rect.width) && std::isfinite(rect.height) &&
                         rect.width >= 0.0f && rect.height >= 0.0f);
  const NodeP keep = detail::Hold(this);
  if (IsEmbedded()) {
    if (rect == frame_) return;
    const RectT<float> old = frame_;
    frame_ = rect;
    UI_GeometryChanged();
    if (UI_Node* parent = UI_GetParentNode()) {
      const RectT<std::int32_t> oldArea = detail::RoundOut(old);
      parent->UI_Invalidate(&oldArea, InvalidateFlags{});
    }
    SyncEmbeddedGeometry();
    if (old.width != rect.width || old.height != rect.height)
      UI_SizeChanged(UI_GetLocalRectF(false));
    UI_DispatchNodeChange(NodeChange::kFrameChanged);
    return;
  }
  // Kept as the frame for when the window becomes a child node.
  frame_ = rect;
  const RectT<std::int32_t> wanted = detail::RoundOut(rect);
  if (handle_ == kNoPlatformWindow) {
    const RectT<std::int32_t> before = client_;
    client_ = wanted;
    ClientAreaChanged(before);
    return;
  }
  const RectT<std::int32_t> before = client_;
  GetPlatform().SetClientRect(handle_, wanted);
  ReadClientRect();
  ClientAreaChanged(before);
}

void OS_Window::ClientAreaChanged(const RectT<std::int32_t>& before) {
  if (before == client_) return;
  const NodeP keep = detail::Hold(this);
  UI_GeometryChanged();
  const bool resized = before.width != client_.width || before.height != client_.height;
  if (resized) {
    UI_SizeChanged(UI_GetLocalRectF(false));
    // Sub-view children follow their layout binding.
    const float dx = static_cast<float>(client_.width - before.width);
    const float dy = static_cast<float>(client_.height - before.height);
    const std::vector<NodeP> children(ChildBegin(), ChildEnd());
    for (const NodeP& child : children) {
      if (!child->UI_IsSubView() || child->UI_GetParentContainer() != this) continue;
      auto& view = static_cast<UI_SubView&>(*child);
      const LayoutBinding b = view.UI_GetLayoutBinding();
      if (b.IsEmpty()) continue;
      RectT<float> frame = view.UI_GetLocalRectF(true);
      detail::FollowParentResize(static_cast<float>(client_.width), dx,
                                 b.IsSet(kBindCenterHorizontally), b.IsSet(kBindLeftToRight),
                                 b.IsSet(kBindRightToRight), &frame.left, &frame.width);
      detail::FollowParentResize(static_cast<float>(client_.height), dy,
                                 b.IsSet(kBindCenterVertically), b.IsSet(kBindTopToBottom),
                                 b.IsSet(kBindBottomToBottom), &frame.top, &frame.height);
      view.UI_SetLocalRectF(frame);
    }
  }
  UI_DispatchNodeChange(NodeChange::kFrameChanged);
}

PlatformWindow OS_Window::GetHostPlatformWindow() const {
  const UI_Node* host = UI_GetParentEventRecipientNode();
  const auto* hostWindow = dynamic_cast<const OS_Window*>(host);
  return hostWindow != nullptr ? hostWindow->handle_ : kNoPlatformWindow;
}

RectT<std::int32_t> OS_Window::GetEmbeddedScreenRect() const {
  const UI_Node* host = UI_GetParentEventRecipientNode();
  const auto* hostWindow = dynamic_cast<const OS_Window*>(host);
  if (hostWindow == nullptr || hostWindow->handle_ == kNoPlatformWindow) return {};
  const RectT<std::int32_t> hostClient = GetPlatform().GetClientRect(hostWindow->handle_);
  const RectT<float> inHost =
      detail::TransformRect(UI_GetSelfToSpecificParentMatrix(hostWindow), UI_GetLocalRectF(false));
  const RectT<std::int32_t> rounded = detail::RoundOut(inHost);
  return {hostClient.left + rounded.left, hostClient.top + rounded.top, rounded.width,
          rounded.height};
}

void OS_Window::SyncEmbeddedGeometry() {
  if (!IsEmbedded() || handle_ == kNoPlatformWindow) return;
  Platform& platform = GetPlatform();
  const RectT<std::int32_t> screen = GetEmbeddedScreenRect();
  if (platform.GetClientRect(handle_) != screen) platform.SetClientRect(handle_, screen);
  SyncPlatformVisibility();
}

void OS_Window::SyncPlatformVisibility() {
  if (handle_ == kNoPlatformWindow) return;
  Platform& platform = GetPlatform();
  const bool visible =
      IsEmbedded() ? UI_AreAllParentsVisible() && GetHostPlatformWindow() != 0 : shown_;
  if (platform.IsWindowVisible(handle_) == visible) return;
  const bool activate = !IsEmbedded() && (exStyle_ & kExStyleNoActivate) == 0;
  platform.ShowWindow(handle_, visible, visible && activate);
}

void OS_Window::UI_SynchronizeParent() {
  if (handle_ == kNoPlatformWindow || !IsEmbedded()) {
    SyncPlatformVisibility();
    return;
  }
  Platform& platform = GetPlatform();
  const PlatformWindow host = GetHostPlatformWindow();
  if (host != kNoPlatformWindow && (style_ & kStyleChild) != 0 &&
      platform.GetWindowParent(handle_) != host) {
    platform.SetWindowParent(handle_, host);
  }
  SyncEmbeddedGeometry();
  SyncPlatformVisibility();
}

void OS_Window::SynchronizeEmbeddedDescendants(UI_Node& node) {
  const std::vector<NodeP> children(node.ChildBegin(), node.ChildEnd());
  for (const NodeP& child : children) {
    if (auto* window = dynamic_cast<OS_Window*>(child.get())) {
      window->UI_SynchronizeParent();
    } else {
      SynchronizeEmbeddedDescendants(*child);
    }
  }
}

// ---- Visibility ----

void OS_Window::UI_Show(bool show) {
  if (shown_ == show) {
    SyncPlatformVisibility();
    return;
  }
  const NodeP keep = detail::Hold(this);
  shown_ = show;
  UI_GeometryChanged();
  if (IsEmbedded()) {
    if (UI_Node* parent = UI_GetParentNode()) {
      const RectT<std::int32_t> area = detail::RoundOut(frame_);
      parent->UI_Invalidate(&area, InvalidateFlags{});
    }
  }
  SyncPlatformVisibility();
  UI_DispatchNodeChange(NodeChange::kShownChanged);
}

bool OS_Window::UI_IsShown() const {
  return shown_;
}

bool OS_Window::UI_AreAllParentsVisible() const {
  if (!shown_ || UI_IsMinimized()) return false;
  const UI_Node* parent = UI_GetParentNode();
  return parent == nullptr || parent->UI_AreAllParentsVisible();
}

void OS_Window::UI_SetOpacity(float opacity) {
  velkcore::RequireInput(std::isfinite(opacity));
  if (handle_ != kNoPlatformWindow) GetPlatform().SetWindowOpacity(handle_, opacity);
}

void OS_Window::UI_SetTransparentColorKey(const pictel::ColorRGBA& key) {
  if (handle_ != kNoPlatformWindow) GetPlatform().SetTransparentColorKey(handle_, key);
}

void OS_Window::UI_SetOpacityAndTransparentColorKey(float opacity, const pictel::ColorRGBA& key) {
  UI_SetOpacity(opacity);
  UI_SetTransparentColorKey(key);
}

void OS_Window::UI_SetParent(UI_Container* parent) {
  const NodeP keep = detail::Hold(this);
  UI_Node::UI_SetParent(parent);
  if (IsEmbedded()) {
    UI_SynchronizeParent();
  } else if (handle_ != kNoPlatformWindow && (style_ & kStyleChild) != 0) {
    // A child window without a host cannot be shown.
    GetPlatform().ShowWindow(handle_, false, false);
  }
  UI_DispatchNodeChange(NodeChange::kParentChanged);
}

void OS_Window::UI_NodeChanged(NodeChange change) {
  // Changes of the tree around an embedded window move its platform window.
  if (!IsEmbedded()) return;
  switch (change) {
    case NodeChange::kParentChanged:
    case NodeChange::kWindowMembershipChanged:
      UI_SynchronizeParent();
      break;
    case NodeChange::kFrameChanged:
      SyncEmbeddedGeometry();
      break;
    case NodeChange::kShownChanged:
      SyncPlatformVisibility();
      break;
    case NodeChange::kUnused:
      break;
  }
}

void OS_Window::UI_DisabledStateChanged() {
  if (handle_ != kNoPlatformWindow) GetPlatform().EnableWindow(handle_, !UI_IsDisabled());
}

// ---- Painting ----

bool OS_Window::UI_SupportsPictel() const {
  return true;
}

const pictel::SupplierInterface* OS_Window::UI_GetDrawSupplier() const {
  return supplier_.get();
}

void OS_Window::SetDrawSupplier(boost::intrusive_ptr<pictel::SupplierInterface> supplier) {
  velkcore::RequireInput(supplier != nullptr);
  supplier_ = std::move(supplier);
  UI_Invalidate(nullptr, InvalidateFlags{});
}

void OS_Window::SetBackgroundColor(const std::optional<pictel::ColorRGBA>& color) {
  background_ = color;
  UI_Invalidate(nullptr, InvalidateFlags{});
}

pictel::ColorRGBA OS_Window::GetBackgroundColor() const {
  if (background_) return *background_;
  constexpr ThemeColorIndex kWindowBackground = 4;
  if (Theme::IsInitialized() && Theme::Get().HasColor(kWindowBackground)) {
    return Theme::Get().GetColor(kWindowBackground);
  }
  return {1, 1, 1, 1};
}

void OS_Window::UI_Invalidate(const RectT<std::int32_t>* localOrNull, InvalidateFlags flags) {
  UI_Node::UI_Invalidate(localOrNull, flags);
  if (handle_ == kNoPlatformWindow) return;
  if (Platform* platform = GetPlatformIfAny()) platform->InvalidateRect(handle_, localOrNull);
}

void OS_Window::UI_UpdateNow(UpdateFlags) {
  if (handle_ == kNoPlatformWindow) return;
  Platform& platform = GetPlatform();
  if (!platform.HasPendingPaint(handle_)) return;
  OS_Event paint(handle_, kMsgPaint, 0, 0, platform.GetTime());
  UI_Paint(&paint);
}

bool OS_Window::UI_Paint(OS_Event*) const {
  if (handle_ == kNoPlatformWindow) return false;
  Platform& platform = GetPlatform();
  const std::optional<PaintTarget> target = platform.BeginPaint(handle_);
  if (!target) return false;
  // The area is taken: it is handed back to the platform whatever happens.
  struct EndPaintGuard {
    Platform& platform;
    PlatformWindow window;
    const PaintTarget& target;
    ~EndPaintGuard() { platform.EndPaint(window, target); }
  } guard{platform, handle_, *target};
  if (!UI_SupportsPictel() || client_.width < 1 || client_.height < 1 || supplier_ == nullptr) {
    return false;
  }

  // The clip: the pending rectangles, within the draw segments when the window
  // reports any, minus the platform windows of embedded children (UI_ClipOSControls).
  std::vector<RectT<std::int32_t>> clip = target->rects;
  std::vector<RectT<std::int32_t>> segments;
  UI_GetDrawSegments(segments);
  if (!segments.empty()) {
    std::vector<RectT<std::int32_t>> within;
    for (const RectT<std::int32_t>& r : clip) {
      for (const RectT<std::int32_t>& s : segments) {
        const RectT<std::int32_t> piece = velkcore::Intersection(r, s);
        if (!piece.IsEmpty()) within.push_back(piece);
      }
    }
    clip = std::move(within);
  }
  UI_ClipOSControls(clip);
  if (clip.empty()) return false;

  pictel::OSClipRegion region;
  region.rects = clip;
  const boost::intrusive_ptr<pictel::SurfaceInterface> surface =
      supplier_->NewOSSurface(target->context, &region, target->buffered || paintBuffered_);
  pictel::Pictel context(supplier_.get(), surface.get());
  UI_DispatchDrawFromRoot(GetBackgroundColor(), &context, true);
  surface->Flush();
  return true;
}

void OS_Window::UI_ClipOSControls(std::vector<RectT<std::int32_t>>& clip) const {
  OSControlClipRects controls;
  UI_GetOSControlClipRects(&controls);
  for (const auto& [node, rect] : controls) {
    std::vector<RectT<std::int32_t>> remaining;
    for (const RectT<std::int32_t>& r : clip) SubtractRect(r, detail::RoundOut(rect), &remaining);
    clip = std::move(remaining);
  }
}

// ---- Capture and focus ----

void OS_Window::UI_SetCapture() {
  if (handle_ != kNoPlatformWindow) GetPlatform().SetCapture(handle_);
}

void OS_Window::UI_ReleaseCapture() {
  if (handle_ == kNoPlatformWindow) return;
  Platform* platform = GetPlatformIfAny();
  if (platform != nullptr && platform->GetCapture() == handle_) platform->ReleaseCapture();
}

bool OS_Window::UI_ReceivesEventsFromOS() const {
  return true;
}

bool OS_Window::IsNearestWindowOf(const UI_Node* node) const {
  if (node == nullptr) return false;
  if (node == this) return true;
  return node->UI_GetParentEventRecipientNode() == this;
}

void OS_Window::UI_FocusChanged() {
  UI_Node::UI_FocusChanged();
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager == nullptr) return;
  if (UI_HasKeyboardFocus(false)) {
    if (IsNearestWindowOf(manager->GetKeyboardFocusLeafNode())) UI_SetKeyboardFocusWithOS();
    return;
  }
  // Focus left this window: remember where it was, for when it comes back.
  UI_Node* previous = manager->GetPreviousKeyboardFocusNode();
  if (IsNearestWindowOf(previous)) focusMemory_ = detail::Hold(previous);
}

void OS_Window::UI_SetKeyboardFocusWithOS() {
  if (handle_ == kNoPlatformWindow) return;
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  if (manager != nullptr && manager->IsSuspendingOSFocusChanges()) return;
  Platform& platform = GetPlatform();
  if (platform.GetFocus() != handle_) platform.SetFocus(handle_);
}

void OS_Window::UI_OSSetFocus() {
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager == nullptr) return;
  UI_Node* leaf = manager->GetKeyboardFocusLeafNode();
  if (leaf != nullptr && detail::IsInSubtree(leaf, *this)) return;
  const NodeP remembered = std::move(focusMemory_);
  focusMemory_.reset();
  if (remembered && IsNearestWindowOf(remembered.get()) && remembered->UI_IsEnabled() &&
      remembered->UI_AreAllParentsVisible()) {
    remembered->UI_GainKeyboardFocus();
  }
}

void OS_Window::UI_OSKillFocus(PlatformWindow newFocus) {
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager == nullptr) return;
  UI_Node* leaf = manager->GetKeyboardFocusLeafNode();
  if (!IsNearestWindowOf(leaf)) return;
  // Focus going to another application is the application's deactivation,
  // which the node manager handles; focus going to a window of ours inside
  // this one keeps this window's chain.
  const OS_Window* target = UI_GetWindow(newFocus);
  if (target == nullptr || detail::IsInSubtree(target, *this)) return;
  const NodeP keep = detail::Hold(this);
  UI_UpdateKeyboardFocusStateDueToLoss();
}

// ---- Timers ----

UI_NodeTimerManager* OS_Window::UI_GetTimerManager(bool create) {
  if (!timers_ && create) {
    timers_ = std::make_unique<UI_NodeTimerManager>(
        this, [](UI_Node* managerNode, UI_Node* node, std::int32_t id, float seconds) {
          return UI_NodeTimerDataP(
              new OS_NodeTimerData(static_cast<OS_Window*>(managerNode), node, id, seconds));
        });
  }
  return timers_.get();
}

const UI_NodeTimerManager* OS_Window::UI_GetTimerManager(bool) const {
  return timers_.get();
}

bool OS_Window::HandleTimerMessage(const OS_Event& event) {
  if (!timers_) return false;
  UI_NodeTimerData* data =
      timers_->FindTimerBySerial(static_cast<std::uint32_t>(event.GetWParam()));
  return data != nullptr && timers_->DispatchPossibleTimer(data);
}

// ---- Children ----

void OS_Window::ChildAdded(UI_Node* node) {
  UI_Node::ChildAdded(node);
  if (node != nullptr) node->UI_DispatchNodeChange(NodeChange::kWindowMembershipChanged);
}

void OS_Window::ChildRemoved(UI_Node* node) {
  UI_Node::ChildRemoved(node);
  if (node != nullptr) node->UI_DispatchNodeChange(NodeChange::kWindowMembershipChanged);
}

// ---- Closing ----

void OS_Window::InstallCloseFunction(const std::shared_ptr<CloseFunction>& f) {
  closeFunctions_.Add(f);
}

void OS_Window::RemoveCloseFunction(const std::shared_ptr<CloseFunction>& f) {
  closeFunctions_.Remove(f);
}

bool OS_Window::RunCloseFunctions() {
  if (closing_) return true;
  const NodeP keep = detail::Hold(this);
  closing_ = true;
  bool vetoed = false;
  try {
    vetoed = closeFunctions_.CallUntilTrue(*this);
  } catch (...) {
    closing_ = false;
    throw;
  }
  closing_ = false;
  return vetoed;
}

void OS_Window::HandleCloseRequest() {
  if (closing_) return;
  const NodeP keep = detail::Hold(this);
  if (RunCloseFunctions()) return;
  closing_ = true;
  UI_Show(false);
  closing_ = false;
}

void OS_Window::DisplayChanged() {
  if (IsEmbedded() || handle_ == kNoPlatformWindow || !shown_) return;
  const OS_MonitorInfo monitors;
  RectT<std::int32_t> frame = UI_GetGlobalStructureRect();
  if (monitors.GetMonitorCount() == 0 || monitors.IsRectVisible(frame)) return;
  monitors.EnsureRectIsVisible(&frame, false);
  UI_SetGlobalStructureRect(frame);
}

// ---- Messages ----

bool OS_Window::UI_DispatchEvent(OS_Event* event) {
  velkcore::RequireInput(event != nullptr);
  const NodeP keep = detail::Hold(this);
  if (const ClientOSEventFunc client = UI_GetClientOSEventFunc()) client(event);
  const std::uint32_t message = event->GetMsg();
  if (IsPointerMessage(message)) return UI_DispatchMouseEventFromOS(event);
  if (IsKeyboardMessage(message)) return UI_DispatchKeyboardEventFromOS(event);
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  switch (message) {
    case kMsgPaint:
      UI_Paint(event);
      return true;
    case kMsgTimer:
      return HandleTimerMessage(*event);
    case kMsgSize:
    case kMsgMove:
      if (!IsEmbedded() && handle_ != kNoPlatformWindow) {
        const RectT<std::int32_t> before = client_;
        ReadClientRect();
        ClientAreaChanged(before);
      }
      return true;
    case kMsgActivate:
      UI_ActivationChanged(static_cast<WindowActivation>(event->GetWParam()));
      return true;
    case kMsgActivateApp:
      if (manager != nullptr) manager->SetApplicationFrontmost(event->GetWParam() != 0);
      return true;
    case kMsgSetFocus:
      UI_OSSetFocus();
      return true;
    case kMsgKillFocus:
      UI_OSKillFocus(static_cast<PlatformWindow>(event->GetWParam()));
      return true;
    case kMsgCaptureLost:
      if (manager != nullptr && IsNearestWindowOf(manager->GetActiveInputCapture())) {
        manager->EndInputCapture(true);
      }
      return true;
    case kMsgDisplayChange:
      DisplayChanged();
      return true;
    default:
      UI_HandleOSEvent(event);
      return message == kMsgClose;
  }
}

void OS_Window::UI_HandleOSEvent(OS_Event* event) {
  if (event != nullptr && event->GetMsg() == kMsgClose) HandleCloseRequest();
}

// ---- Mouse translation ----

bool OS_Window::UI_DispatchMouseEventFromOS(OS_Event* event) {
  velkcore::RequireInput(event != nullptr);
  if (handle_ == kNoPlatformWindow || UI_NodeManager::Get(false) == nullptr) return false;
  const NodeP keep = detail::Hold(this);
  RefreshClickMetrics();
  switch (event->GetMsg()) {
    case kMsgPointerMove:
      return DispatchPointerMove(event);
    case kMsgWheel:
    case kMsgHorizontalWheel:
      return DispatchWheel(event);
    case kMsgPointerLeft:
      return DispatchPointerLeft(event);
    default:
      return DispatchButton(event);
  }
}

bool OS_Window::DispatchPointerMove(OS_Event* event) {
  Platform& platform = GetPlatform();
  const PointT<std::int32_t> client = GetPointParam(event->GetLParam());
  const PointT<float> point = ToFloat(client);
  const auto held = static_cast<std::int32_t>(event->GetWParam() & 7u);
  const ModifierKeys modifiers = platform.GetModifierKeys();
  lastPointer_ = point;
  UI_UpdateMouseOverState(MouseEvent(MouseEvent::kMouseOverUpdate, 0, 0, point, modifiers, event));
  if (handle_ == kNoPlatformWindow) return true;
  platform.TrackPointerLeave(handle_);
  // Only the newest of the waiting moves is dispatched.
  if (platform.HasPendingPointerMove(handle_)) return true;
  const std::int32_t count = clickCounter_.Count(0, MouseEvent::kMove, held, client);
  const bool handled = UI_DispatchMouseEvent(
      MouseEvent(MouseEvent::kMove, held, count, point, modifiers, event), true);
  DispatchCursorAt(point, modifiers);
  return handled;
}

void OS_Window::DispatchCursorAt(const PointT<float>& point, ModifierKeys modifiers) {
  if (!UI_DispatchCursor(point, modifiers, true)) OS_SetCursor(CursorShape::kArrow);
}

void OS_Window::ActivateOnClick() {
  if (IsEmbedded() || (exStyle_ & kExStyleNoActivate) != 0) return;
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  if (manager != nullptr && manager->IsSuspendingOSMouseActivates(this)) return;
  Platform& platform = GetPlatform();
  if (platform.GetActiveWindow() != handle_) platform.ActivateWindow(handle_, true);
}

bool OS_Window::DispatchButton(OS_Event* event) {
  Platform& platform = GetPlatform();
  std::int32_t button = 0;
  std::int32_t baseCount = 1;
  const MouseEvent::Action action = ButtonAction(event->GetMsg(), &button, &baseCount);
  const PointT<std::int32_t> client = GetPointParam(event->GetLParam());
  const ModifierKeys modifiers = platform.GetModifierKeys();
  if (action == MouseEvent::kButtonDown) {
    if (UI_ToolTipManager* tips = UI_NodeManager::Get()->GetToolTipManager()) {
      tips->DismissForInput();
    }
    ActivateOnClick();
  }
  const std::int32_t count = clickCounter_.Count(baseCount, action, button, client);
  lastPointer_ = ToFloat(client);
  return UI_DispatchMouseEvent(MouseEvent(action, button, count, ToFloat(client), modifiers, event),
                               true);
}

bool OS_Window::DispatchWheel(OS_Event* event) {
  Platform& platform = GetPlatform();
  const PointT<std::int32_t> screen = GetPointParam(event->GetLParam());
  const std::int32_t notches = WheelDeltaToNotches(GetWheelDelta(event->GetWParam()));
  const std::int32_t held = GetWheelButtons(event->GetWParam()) & 7;
  const std::int32_t axis =
      event->GetMsg() == kMsgWheel ? MouseEvent::kVerticalAxis : MouseEvent::kHorizontalAxis;
  // The wheel turns what is under the pointer, unless that window is disabled.
  OS_Window* target = UI_GetWindow(platform.GetWindowFromPoint(screen));
  if (target == nullptr || target->UI_IsDisabled() || !platform.IsWindowEnabled(target->handle_)) {
    target = this;
  }
  const NodeP keepTarget = detail::Hold(target);
  const RectT<std::int32_t> origin = platform.GetClientRect(target->handle_);
  const PointT<std::int32_t> client{screen.x - origin.left, screen.y - origin.top};
  const ModifierKeys modifiers = platform.GetModifierKeys();
  const std::int32_t count = target->clickCounter_.Count(0, MouseEvent::kWheel, held, client);
  return target->UI_DispatchMouseEvent(
      MouseEvent(MouseEvent::kWheel, held, count, ToFloat(client), modifiers, event, notches, axis),
      false);
}

bool OS_Window::DispatchPointerLeft(OS_Event* event) {
  Platform& platform = GetPlatform();
  const PointT<std::int32_t> screen = platform.GetPointerPosition();
  const ModifierKeys modifiers = platform.GetModifierKeys();
  OS_Window* under = UI_GetWindow(platform.GetWindowFromPoint(screen));
  if (under != nullptr) {
    const NodeP keepUnder = detail::Hold(under);
    const RectT<std::int32_t> origin = platform.GetClientRect(under->handle_);
    under->UI_UpdateMouseOverState(
        MouseEvent(MouseEvent::kMouseOverUpdate, 0, 0,
                   PointT<float>{static_cast<float>(screen.x - origin.left),
                                 static_cast<float>(screen.y - origin.top)},
                   modifiers, event));
    return true;
  }
  const MouseEvent left(MouseEvent::kMouseOverUpdate, 0, 0, lastPointer_, modifiers, event);
  UI_MouseExited(&left, this);
  return true;
}

// ---- Keyboard translation ----

bool OS_Window::UI_DispatchKeyboardEventFromOS(OS_Event* event) {
  velkcore::RequireInput(event != nullptr);
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager == nullptr) return false;
  const std::optional<KeyboardEvent> key = UI_GetKeyboardEventFromOSEvent(*event, GetPlatform());
  if (!key) return false;
  const NodeP keep = detail::Hold(this);
  if (key->IsActionKeyDown()) {
    if (UI_ToolTipManager* tips = manager->GetToolTipManager()) tips->DismissForInput();
  }
  UI_Node* target = manager->GetKeyboardFocusLeafNode();
  if (target == nullptr) target = this;
  const NodeP keepTarget = detail::Hold(target);
  if (UI_DispatchKeyboardEvent(target, *key)) return true;
  // An unhandled Tab moves the focus.
  if (key->IsActionKeyDown() && key->GetKeyControlCode() == kKeyTab) {
    return UI_DoAdvanceKeyboardFocus(target, *key);
  }
  return false;
}

namespace {

// Keypad keys that the platform reports as navigation keys while Shift is
// held with Num Lock on, and the digit (or decimal point) each stands for.
struct KeypadTwin {
  std::int16_t navigation;
  std::int16_t keypad;
  char16_t character;
};
constexpr KeypadTwin kKeypadTwins[] = {
    {vk::kClear, vk::kNumpad0 + 5, u'5'},    {vk::kPageUp, vk::kNumpad0 + 9, u'9'},
    {vk::kPageDown, vk::kNumpad0 + 3, u'3'}, {vk::kEnd, vk::kNumpad0 + 1, u'1'},
    {vk::kHome, vk::kNumpad0 + 7, u'7'},     {vk::kLeft, vk::kNumpad0 + 4, u'4'},
    {vk::kUp, vk::kNumpad0 + 8, u'8'},       {vk::kRight, vk::kNumpad0 + 6, u'6'},
    {vk::kDown, vk::kNumpad0 + 2, u'2'},     {vk::kInsert, vk::kNumpad0, u'0'},
    {vk::kDelete, vk::kDecimal, u'.'},
};

bool IsModifierKey(std::int16_t key) {
  return key == vk::kShift || key == vk::kControl || key == vk::kAlt;
}

}  // namespace

std::optional<KeyboardEvent> UI_GetKeyboardEventFromOSEvent(const OS_Event& event,
                                                            const Platform& platform) {
  const std::uint32_t message = event.GetMsg();
  KeyboardEvent::Action action;
  switch (message) {
    case kMsgKeyDown:
    case kMsgSysKeyDown:
      action = KeyboardEvent::kKeyDown;
      break;
    case kMsgKeyUp:
    case kMsgSysKeyUp:
      action = KeyboardEvent::kKeyUp;
      break;
    case kMsgChar:
    case kMsgSysChar:
      action = KeyboardEvent::kCharacter;
      break;
    case kMsgDeadChar:
    case kMsgSysDeadChar:
      action = KeyboardEvent::kDeadCharacter;
      break;
    default:
      return std::nullopt;
  }
  const KeyData data = GetKeyParam(event.GetLParam());
  ModifierKeys modifiers = platform.GetModifierKeys();
  const bool repeat = action != KeyboardEvent::kKeyUp && data.previouslyDown;
  std::int16_t key = 0;
  char16_t character = 0;
  if (action == KeyboardEvent::kKeyDown || action == KeyboardEvent::kKeyUp) {
    key = static_cast<std::int16_t>(event.GetWParam() & 0x7FFFu);
    character = platform.GetUnshiftedCharacter(key);
    if (!data.extended && platform.GetKeyState(vk::kNumLock).toggled) {
      for (const KeypadTwin& twin : kKeypadTwins) {
        if (twin.navigation != key) continue;
        key = twin.keypad;
        character = twin.character;
        modifiers.Set(kModifierShift);
        break;
      }
    }
  } else {
    character = static_cast<char16_t>(event.GetWParam() & 0xFFFFu);
    key = platform.MapScanCodeToVirtualKey(data.scanCode);
    // AltGr is Control with the right Alt: its characters are no shortcuts.
    if (platform.GetKeyState(vk::kRightAlt).down) modifiers.Clear(kModifierControl);
    const bool controlCharacter = character < 32 || character == 127;
    if (modifiers.IsSet(kModifierControl) && controlCharacter &&
        character != static_cast<char16_t>(key)) {
      character = static_cast<char16_t>(key);
    }
  }
  const std::int16_t osCode =
      data.extended && !IsModifierKey(key) ? static_cast<std::int16_t>(-key) : key;
  std::vector<char16_t> characters;
  if (character != 0) characters.push_back(character);
  return KeyboardEvent(action, std::move(characters), osCode, modifiers, repeat, &event);
}

}  // namespace velkui::ui
