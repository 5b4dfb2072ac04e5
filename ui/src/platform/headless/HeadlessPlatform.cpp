#include <velkui/ui/HeadlessPlatform.h>

#include <cairo.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <map>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/OS_MessagePump.h>

#include "../common/PixelBuffer.h"
#include "../common/QueueSearch.h"
#include "../common/WindowTable.h"
#include "HeadlessKeyboard.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

using platform::AddPendingArea;
using platform::Insets;

constexpr std::uint32_t kMinimumTimerInterval = 10;
constexpr std::int32_t kTitleBarHeight = 24;
constexpr std::int32_t kBorder = 1;
constexpr std::int32_t kSizingBorder = 4;
constexpr std::string_view kEndlessMessagesKey =
    "$$$/velkui/ui/Error/EndlessMessages=The message queue did not run dry after ^0 messages.";
constexpr std::int32_t kEndlessMessagesNumber = 22;

struct CairoSurfaceDeleter {
  void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};
using SurfacePtr = std::unique_ptr<cairo_surface_t, CairoSurfaceDeleter>;

struct Timer {
  std::uint32_t interval = kMinimumTimerInterval;
  double due = 0;
};

struct WindowRecord : platform::WindowRecordBase {
  SurfacePtr surface;
  std::map<std::uint32_t, Timer> timers;
};

Insets InsetsFor(std::uint32_t style) {
  if ((style & kStyleChild) != 0) return {};
  Insets insets;
  const bool caption = (style & kStyleCaption) == kStyleCaption;
  const std::int32_t border = (style & kStyleSizingFrame) != 0             ? kSizingBorder
                              : caption || (style & kStyleModalFrame) != 0 ? kBorder
                                                                           : 0;
  insets = {border, border, border, border};
  if (caption) insets.top += kTitleBarHeight;
  return insets;
}

std::uint32_t ButtonMessage(std::int32_t button, int kind) {
  // kind: 0 down, 1 up, 2 double click.
  const std::uint32_t base = button == 1   ? kMsgLeftButtonDown
                             : button == 2 ? kMsgMiddleButtonDown
                                           : kMsgRightButtonDown;
  return base + static_cast<std::uint32_t>(kind);
}

// Copies a Cairo image into a new image of the platform supplier.
boost::intrusive_ptr<pictel::ImageInterface> CopyToImage(cairo_surface_t* source,
                                                         std::int32_t width, std::int32_t height) {
  platform::PixelBuffer pixels(width, height);
  if (source != nullptr) {
    cairo_surface_flush(source);
    const unsigned char* data = cairo_image_surface_get_data(source);
    const std::int32_t sourceStride = cairo_image_surface_get_stride(source);
    const std::int32_t rows = std::min(pixels.Height(), cairo_image_surface_get_height(source));
    const std::int32_t bytes = std::min(pixels.Width(), cairo_image_surface_get_width(source)) * 4;
    for (std::int32_t y = 0; y < rows; ++y) {
      std::memcpy(pixels.Row(y), data + static_cast<std::ptrdiff_t>(y) * sourceStride,
                  static_cast<std::size_t>(bytes));
    }
  }
  return pixels.ToImage();
}

}  // namespace

struct HeadlessPlatform::Impl {
  platform::WindowTable<WindowRecord> windows;
  // Top-level windows, bottom to top.
  std::vector<PlatformWindow> stacking;
  PlatformWindow nextHandle = 1;
  std::deque<OS_Event> queue;
  double now = 0;
  PointT<std::int32_t> pointer{0, 0};
  PlatformWindow capture = kNoPlatformWindow;
  PlatformWindow focus = kNoPlatformWindow;
  PlatformWindow active = kNoPlatformWindow;
  PlatformWindow hover = kNoPlatformWindow;
  bool applicationActive = false;
  // What GetKeyState answers (as of the messages taken) and the keyboard as
  // the injected input left it.
  std::array<KeyState, 256> keys{};
  std::array<KeyState, 256> physical{};
  std::int32_t buttons = 0;
  std::uint32_t doubleClickTime = 500;
  PointT<std::int32_t> doubleClickSize{4, 4};
  struct Press {
    PlatformWindow window;
    std::int32_t button;
    double time;
    PointT<std::int32_t> point;
    bool wasDouble;
  };
  std::optional<Press> lastPress;
  std::vector<MonitorDescription> monitors;
  std::vector<ClipboardItem> clipboard;
  CursorShape cursor = CursorShape::kArrow;
  bool quitPending = false;
  std::int32_t quitCode = 0;
  std::int64_t messageLimit = 100000;

  void Post(PlatformWindow window, std::uint32_t message, std::uint64_t w = 0, std::int64_t l = 0) {
    queue.emplace_back(window, message, w, l, now);
  }

  RectT<std::int32_t> ScreenFrame(const WindowRecord& record) const {
    return platform::FrameAround(windows.ScreenClient(record), InsetsFor(record.style));
  }

  // The first window, in the order of GetWindows, that `wanted` accepts.
  template <typename Predicate>
  PlatformWindow FindInStackingOrder(const Predicate& wanted) const {
    return FindAmong(stacking, wanted);
  }
  template <typename Predicate>
  PlatformWindow FindAmong(const std::vector<PlatformWindow>& handles,
                           const Predicate& wanted) const {
    for (const PlatformWindow handle : handles) {
      if (wanted(handle)) return handle;
      if (const PlatformWindow found = FindAmong(windows.ChildrenOf(handle), wanted)) return found;
    }
    return kNoPlatformWindow;
  }

  PlatformWindow DeepestAt(PlatformWindow handle, const PointT<std::int32_t>& p) const {
    const std::vector<PlatformWindow> children = windows.ChildrenOf(handle);
    // Later children lie on top.
    for (auto it = children.rbegin(); it != children.rend(); ++it) {
      const WindowRecord& child = *windows.Find(*it);
      if (child.visible && windows.ScreenClient(child).Contains(p)) return DeepestAt(*it, p);
    }
    return handle;
  }
  PlatformWindow WindowAt(const PointT<std::int32_t>& p) const {
    for (auto it = stacking.rbegin(); it != stacking.rend(); ++it) {
      const WindowRecord& record = *windows.Find(*it);
      if (!windows.IsShownOnScreen(record)) continue;
      if (windows.ScreenClient(record).Contains(p)) return DeepestAt(*it, p);
      // The decoration hides whatever lies below it.
      if (ScreenFrame(record).Contains(p)) return kNoPlatformWindow;
    }
    return kNoPlatformWindow;
  }

  void PostLeaveIfTracked(PlatformWindow handle) {
    WindowRecord* record = windows.Find(handle);
    if (record == nullptr || !record->trackLeave) return;
    record->trackLeave = false;
    Post(handle, kMsgPointerLeft);
  }

  void PostPointer(PlatformWindow target, std::uint32_t message) {
    const WindowRecord* record = windows.Find(target);
    if (record == nullptr) return;
    const PointT<std::int32_t> origin = windows.ClientOrigin(*record);
    Post(target, message, static_cast<std::uint64_t>(buttons),
         MakePointParam({pointer.x - origin.x, pointer.y - origin.y}));
  }

  PlatformWindow PointerTarget() const {
    if (capture != kNoPlatformWindow) return capture;
    const PlatformWindow under = WindowAt(pointer);
    return windows.IsEnabledForInput(under) ? under : kNoPlatformWindow;
  }

  PlatformWindow KeyboardTarget() const {
    const PlatformWindow target = focus != kNoPlatformWindow ? focus : active;
    return windows.IsEnabledForInput(target) ? target : kNoPlatformWindow;
  }

  void SetFocus(PlatformWindow handle) {
    if (handle == focus) return;
    const PlatformWindow old = focus;
    focus = handle;
    if (windows.Find(old) != nullptr) Post(old, kMsgKillFocus, handle);
    if (handle != kNoPlatformWindow) Post(handle, kMsgSetFocus, old);
  }

  void Raise(PlatformWindow top) {
    const auto found = std::find(stacking.begin(), stacking.end(), top);
    if (found == stacking.end()) return;
    stacking.erase(found);
    // Topmost windows stay above the others.
    const bool topmost = (windows.Find(top)->exStyle & kExStyleTopmost) != 0;
    auto position = stacking.end();
    if (!topmost) {
      position = std::find_if(stacking.begin(), stacking.end(), [this](PlatformWindow h) {
        return (windows.Find(h)->exStyle & kExStyleTopmost) != 0;
      });
    }
    stacking.insert(position, top);
  }

  void Activate(PlatformWindow handle, bool byClick) {
    const PlatformWindow top = windows.TopLevelOf(handle);
    const WindowRecord* record = windows.Find(top);
    if (record == nullptr || !record->visible || (record->exStyle & kExStyleNoActivate) != 0) {
      return;
    }
    Raise(top);
    if (active != top) {
      const PlatformWindow old = active;
      active = top;
      if (windows.Find(old) != nullptr) Post(old, kMsgActivate, 0);
      if (!applicationActive) {
        applicationActive = true;
        Post(top, kMsgActivateApp, 1);
      }
      Post(top, kMsgActivate, byClick ? 2 : 1);
    }
    if (!windows.IsWithin(focus, top)) SetFocus(top);
  }

  // The active window went away or was hidden: the next shown top-level
  // window that may be active takes over, else the application is inactive.
  void ActivateNextAfter(PlatformWindow leaving) {
    if (active != leaving) return;
    active = kNoPlatformWindow;
    for (auto it = stacking.rbegin(); it != stacking.rend(); ++it) {
      const WindowRecord& record = *windows.Find(*it);
      if (*it != leaving && record.visible && !record.minimized &&
          (record.exStyle & kExStyleNoActivate) == 0) {
        Activate(*it, false);
        return;
      }
    }
    if (windows.IsWithin(focus, leaving)) SetFocus(kNoPlatformWindow);
    if (applicationActive) {
      applicationActive = false;
      if (windows.Find(leaving) != nullptr) Post(leaving, kMsgActivateApp, 0);
    }
  }

  void UpdateKeyState(const OS_Event& event) {
    if (platform::ApplyButtonMessage(keys, event.GetMsg())) return;
    // The scan codes are the keys' sides.
    platform::ApplyKeyMessage(keys, event,
                              static_cast<std::int16_t>(GetKeyParam(event.GetLParam()).scanCode));
  }

  std::optional<double> NextDue() const {
    std::optional<double> next;
    for (const auto& [handle, record] : windows) {
      for (const auto& [id, timer] : record.timers) {
        if (!next || timer.due < *next) next = timer.due;
      }
    }
    return next;
  }

  bool PostDueTimer() {
    WindowRecord* best = nullptr;
    std::uint32_t bestID = 0;
    for (auto& [handle, record] : windows) {
      for (const auto& [id, timer] : record.timers) {
        if (timer.due > now) continue;
        if (best == nullptr || timer.due < best->timers.at(bestID).due) {
          best = &record;
          bestID = id;
        }
      }
    }
    if (best == nullptr) return false;
    Timer& timer = best->timers.at(bestID);
    const double interval = static_cast<double>(timer.interval) / 1000.0;
    timer.due += interval;
    // Ticks missed while the clock jumped are not made up.
    while (timer.due <= now) timer.due += interval;
    Post(best->handle, kMsgTimer, bestID);
    return true;
  }

  void EnsureSurface(WindowRecord& record) {
    const std::int32_t width = std::max(record.client.width, 1);
    const std::int32_t height = std::max(record.client.height, 1);
    if (record.surface && cairo_image_surface_get_width(record.surface.get()) == width &&
        cairo_image_surface_get_height(record.surface.get()) == height) {
      return;
    }
    record.surface.reset(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height));
    if (cairo_surface_status(record.surface.get()) != CAIRO_STATUS_SUCCESS) {
      record.surface.reset();
      throw std::bad_alloc();
    }
  }

  void DestroyRecursive(PlatformWindow handle) {
    for (const PlatformWindow child : windows.ChildrenOf(handle)) DestroyRecursive(child);
    if (capture == handle) capture = kNoPlatformWindow;
    if (hover == handle) hover = kNoPlatformWindow;
    if (focus == handle) focus = kNoPlatformWindow;
    if (lastPress && lastPress->window == handle) lastPress.reset();
    std::erase_if(queue, [handle](const OS_Event& e) { return e.GetWindow() == handle; });
    std::erase(stacking, handle);
    windows.Erase(handle);
  }

  void DrawDecoration(cairo_t* cr, const WindowRecord& record,
                      const PointT<std::int32_t>& screenOrigin) const;
  void Composite(cairo_t* cr, const WindowRecord& record,
                 const PointT<std::int32_t>& screenOrigin) const;
};

// ---- Rendering of the whole screen ----

void HeadlessPlatform::Impl::DrawDecoration(cairo_t* cr, const WindowRecord& record,
                                            const PointT<std::int32_t>& screenOrigin) const {
  const Insets insets = InsetsFor(record.style);
  if (insets.left == 0 && insets.top == 0) return;
  const RectT<std::int32_t> frame = ScreenFrame(record);
  const double x = frame.left - screenOrigin.x;
  const double y = frame.top - screenOrigin.y;
  const bool isActive = record.handle == active;
  // A soft shadow, the border and the title bar.
  for (int i = 1; i <= 6; ++i) {
    cairo_set_source_rgba(cr, 0, 0, 0, 0.035);
    cairo_rectangle(cr, x - i + 2, y - i + 4, frame.width + 2 * i - 4, frame.height + 2 * i - 4);
    cairo_fill(cr);
  }
  cairo_set_source_rgb(cr, isActive ? 0.20 : 0.42, isActive ? 0.24 : 0.44, isActive ? 0.30 : 0.48);
  cairo_rectangle(cr, x, y, frame.width, frame.height);
  cairo_fill(cr);
  if (insets.top > insets.left) {
    cairo_pattern_t* band = cairo_pattern_create_linear(0, y, 0, y + insets.top);
    cairo_pattern_add_color_stop_rgb(band, 0, isActive ? 0.27 : 0.55, isActive ? 0.33 : 0.57,
                                     isActive ? 0.42 : 0.60);
    cairo_pattern_add_color_stop_rgb(band, 1, isActive ? 0.20 : 0.47, isActive ? 0.25 : 0.49,
                                     isActive ? 0.33 : 0.52);
    cairo_set_source(cr, band);
    cairo_rectangle(cr, x + insets.left, y + insets.left, frame.width - insets.left - insets.right,
                    insets.top - insets.left);
    cairo_fill(cr);
    cairo_pattern_destroy(band);
    // The close box.
    const double cx = x + frame.width - insets.right - 16;
    const double cy = y + insets.left + (insets.top - insets.left) / 2.0;
    cairo_set_source_rgb(cr, 0.85, 0.88, 0.92);
    cairo_set_line_width(cr, 1.5);
    cairo_move_to(cr, cx - 4, cy - 4);
    cairo_line_to(cr, cx + 4, cy + 4);
    cairo_move_to(cr, cx + 4, cy - 4);
    cairo_line_to(cr, cx - 4, cy + 4);
    cairo_stroke(cr);
  }
}

void HeadlessPlatform::Impl::Composite(cairo_t* cr, const WindowRecord& record,
                                       const PointT<std::int32_t>& screenOrigin) const {
  if (!record.visible || record.minimized) return;
  const RectT<std::int32_t> client = windows.ScreenClient(record);
  cairo_save(cr);
  cairo_rectangle(cr, client.left - screenOrigin.x, client.top - screenOrigin.y, client.width,
                  client.height);
  cairo_clip(cr);
  if (record.surface) {
    cairo_set_source_surface(cr, record.surface.get(), client.left - screenOrigin.x,
                             client.top - screenOrigin.y);
    cairo_paint_with_alpha(cr, std::clamp(static_cast<double>(record.opacity), 0.0, 1.0));
  }
  for (const PlatformWindow child : windows.ChildrenOf(record.handle)) {
    Composite(cr, *windows.Find(child), screenOrigin);
  }
  cairo_restore(cr);
}

// ---- HeadlessPlatform ----

HeadlessPlatform::HeadlessPlatform() : impl_(std::make_unique<Impl>()) {
  impl_->monitors.push_back({{0, 0, 1440, 900}, {0, 0, 1440, 860}, 1, true});
}

HeadlessPlatform::~HeadlessPlatform() = default;

HeadlessPlatform& HeadlessPlatform::Get() {
  return *velkcore::CheckedCast<HeadlessPlatform>(&GetPlatform());
}

std::string_view HeadlessPlatform::GetName() const {
  return "headless";
}

// ---- Clock ----

void HeadlessPlatform::SetMessageLimit(std::int64_t limit) {
  velkcore::RequireInput(limit > 0);
  impl_->messageLimit = limit;
}

void HeadlessPlatform::AdvanceTime(double seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0);
  impl_->now += seconds;
}

void HeadlessPlatform::RunFor(double seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0);
  const double end = impl_->now + seconds;
  if (!ProcessEvents()) return;
  for (;;) {
    const std::optional<double> next = impl_->NextDue();
    if (!next || *next > end) break;
    impl_->now = std::max(impl_->now, *next);
    if (!ProcessEvents()) return;
  }
  impl_->now = end;
  ProcessEvents();
}

bool HeadlessPlatform::ProcessEvents() {
  // Dispatching goes through the installed platform's pump.
  velkcore::RequireInput(GetPlatformIfAny() == this);
  for (std::int64_t turn = 0; turn < impl_->messageLimit; ++turn) {
    switch (OS_PumpEvent(false)) {
      case PumpResult::kDispatched:
        break;
      case PumpResult::kIdle:
        return true;
      case PumpResult::kQuit:
        return false;
    }
  }
  // A handler that keeps posting (or repainting from its own paint) would
  // otherwise hang the caller.
  velkcore::ThrowError(velkcore::ErrorLevel::kError, kEndlessMessagesKey,
                       velkcore::kCategoryUserInterface, kEndlessMessagesNumber, 0,
                       impl_->messageLimit);
}

// ---- Native-level input ----

void HeadlessPlatform::MovePointer(const PointT<std::int32_t>& screenPoint) {
  Impl& d = *impl_;
  d.pointer = screenPoint;
  const PlatformWindow under = d.WindowAt(screenPoint);
  if (d.hover != kNoPlatformWindow && d.hover != under && d.hover != d.capture) {
    d.PostLeaveIfTracked(d.hover);
  }
  d.hover = under;
  if (const PlatformWindow target = d.PointerTarget()) d.PostPointer(target, kMsgPointerMove);
}

void HeadlessPlatform::PressButton(std::int32_t button) {
  velkcore::RequireInput(button == 1 || button == 2 || button == 4);
  Impl& d = *impl_;
  d.buttons |= button;
  const PlatformWindow target = d.PointerTarget();
  if (target == kNoPlatformWindow) {
    d.lastPress.reset();
    return;
  }
  bool isDouble = false;
  if (d.lastPress && d.lastPress->window == target && d.lastPress->button == button &&
      !d.lastPress->wasDouble &&
      (d.now - d.lastPress->time) * 1000.0 < static_cast<double>(d.doubleClickTime) &&
      std::abs(d.pointer.x - d.lastPress->point.x) <= d.doubleClickSize.x / 2 &&
      std::abs(d.pointer.y - d.lastPress->point.y) <= d.doubleClickSize.y / 2) {
    isDouble = true;
  }
  d.lastPress = Impl::Press{target, button, d.now, d.pointer, isDouble};
  d.PostPointer(target, ButtonMessage(button, isDouble ? 2 : 0));
}

void HeadlessPlatform::ReleaseButton(std::int32_t button) {
  velkcore::RequireInput(button == 1 || button == 2 || button == 4);
  Impl& d = *impl_;
  d.buttons &= ~button;
  if (const PlatformWindow target = d.PointerTarget()) {
    d.PostPointer(target, ButtonMessage(button, 1));
  }
}

void HeadlessPlatform::Click(std::int32_t button) {
  PressButton(button);
  ReleaseButton(button);
}

void HeadlessPlatform::TurnWheel(std::int32_t delta, bool horizontal) {
  Impl& d = *impl_;
  PlatformWindow target = d.KeyboardTarget();
  if (target == kNoPlatformWindow) target = d.PointerTarget();
  if (target == kNoPlatformWindow) return;
  d.Post(target, horizontal ? kMsgHorizontalWheel : kMsgWheel, MakeWheelParam(delta, d.buttons),
         MakePointParam(d.pointer));
}

void HeadlessPlatform::PressKey(std::int16_t virtualKey, bool extended) {
  Impl& d = *impl_;
  const headless::KeyStroke stroke =
      headless::PressPhysicalKey(d.physical, virtualKey, extended, /*down=*/true);
  if (const PlatformWindow target = d.KeyboardTarget()) {
    d.Post(target, stroke.message, static_cast<std::uint64_t>(stroke.virtualKey),
           MakeKeyParam(stroke.data));
  }
}

void HeadlessPlatform::ReleaseKey(std::int16_t virtualKey, bool extended) {
  Impl& d = *impl_;
  const headless::KeyStroke stroke =
      headless::PressPhysicalKey(d.physical, virtualKey, extended, /*down=*/false);
  if (const PlatformWindow target = d.KeyboardTarget()) {
    d.Post(target, stroke.message, static_cast<std::uint64_t>(stroke.virtualKey),
           MakeKeyParam(stroke.data));
  }
}

void HeadlessPlatform::TypeKey(std::int16_t virtualKey, bool extended) {
  PressKey(virtualKey, extended);
  ReleaseKey(virtualKey, extended);
}

void HeadlessPlatform::SetKeyState(std::int16_t virtualKey, KeyState state) {
  velkcore::RequireInput(virtualKey > 0 && virtualKey < 256);
  const auto index = static_cast<std::size_t>(virtualKey);
  impl_->keys[index] = state;
  impl_->physical[index] = state;
  headless::SyncSides(impl_->keys, virtualKey, state.down);
  headless::SyncSides(impl_->physical, virtualKey, state.down);
}

void HeadlessPlatform::SetDoubleClickTime(std::uint32_t milliseconds) {
  impl_->doubleClickTime = milliseconds;
}

void HeadlessPlatform::SetDoubleClickSize(std::int32_t width, std::int32_t height) {
  velkcore::RequireInput(width >= 0 && height >= 0);
  impl_->doubleClickSize = {width, height};
}

// ---- Window manager ----

void HeadlessPlatform::UserSetClientRect(PlatformWindow window,
                                         const RectT<std::int32_t>& screenRect) {
  WindowRecord* record = impl_->windows.Find(window);
  if (record == nullptr) return;
  const RectT<std::int32_t> before = impl_->windows.ScreenClient(*record);
  SetClientRect(window, screenRect);
  const RectT<std::int32_t> after = impl_->windows.ScreenClient(*record);
  if (after.width != before.width || after.height != before.height) {
    impl_->Post(window, kMsgSize, 0, MakePointParam({after.width, after.height}));
  }
  if (after.left != before.left || after.top != before.top) {
    impl_->Post(window, kMsgMove, 0, MakePointParam({after.left, after.top}));
  }
}

void HeadlessPlatform::UserClose(PlatformWindow window) {
  if (impl_->windows.Find(window) != nullptr) impl_->Post(window, kMsgClose);
}

void HeadlessPlatform::DeactivateApplication() {
  Impl& d = *impl_;
  if (d.capture != kNoPlatformWindow) {
    d.Post(d.capture, kMsgCaptureLost);
    d.capture = kNoPlatformWindow;
  }
  const PlatformWindow old = d.active;
  d.active = kNoPlatformWindow;
  d.SetFocus(kNoPlatformWindow);
  if (d.windows.Find(old) != nullptr) d.Post(old, kMsgActivate, 0);
  if (d.applicationActive) {
    d.applicationActive = false;
    if (d.windows.Find(old) != nullptr) d.Post(old, kMsgActivateApp, 0);
  }
}

void HeadlessPlatform::SetMonitors(std::vector<MonitorDescription> monitors) {
  velkcore::RequireInput(!monitors.empty());
  for (const MonitorDescription& monitor : monitors) {
    velkcore::RequireInput(!monitor.bounds.IsEmpty());
  }
  impl_->monitors = std::move(monitors);
  for (const PlatformWindow window : impl_->stacking) impl_->Post(window, kMsgDisplayChange);
}

// ---- Inspection ----

std::vector<PlatformWindow> HeadlessPlatform::GetWindows() const {
  std::vector<PlatformWindow> result;
  impl_->FindInStackingOrder([&result](PlatformWindow handle) {
    result.push_back(handle);
    return false;
  });
  return result;
}

std::uint32_t HeadlessPlatform::GetWindowStyle(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->style : 0;
}

std::uint32_t HeadlessPlatform::GetWindowExStyle(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->exStyle : 0;
}

float HeadlessPlatform::GetWindowOpacity(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->opacity : 0.0f;
}

RectT<std::int32_t> HeadlessPlatform::GetPendingPaintBounds(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? platform::PendingBounds(*record) : RectT<std::int32_t>{};
}

std::int32_t HeadlessPlatform::GetPaintCount(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->paintCount : 0;
}

boost::intrusive_ptr<pictel::ImageInterface> HeadlessPlatform::GetWindowImage(
    PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  velkcore::RequireInput(record != nullptr);
  return CopyToImage(record->surface.get(), record->client.width, record->client.height);
}

boost::intrusive_ptr<pictel::ImageInterface> HeadlessPlatform::RenderScreen() const {
  const Impl& d = *impl_;
  RectT<std::int32_t> desktop;
  for (const MonitorDescription& monitor : d.monitors) {
    desktop = velkcore::Union(desktop, monitor.bounds);
  }
  SurfacePtr screen(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, desktop.width, desktop.height));
  if (cairo_surface_status(screen.get()) != CAIRO_STATUS_SUCCESS) throw std::bad_alloc();
  cairo_t* cr = cairo_create(screen.get());
  const PointT<std::int32_t> origin{desktop.left, desktop.top};
  for (const MonitorDescription& monitor : d.monitors) {
    const double x = monitor.bounds.left - origin.x;
    const double y = monitor.bounds.top - origin.y;
    cairo_pattern_t* wallpaper = cairo_pattern_create_linear(x, y, x, y + monitor.bounds.height);
    cairo_pattern_add_color_stop_rgb(wallpaper, 0, 0.36, 0.45, 0.58);
    cairo_pattern_add_color_stop_rgb(wallpaper, 1, 0.18, 0.23, 0.32);
    cairo_set_source(cr, wallpaper);
    cairo_rectangle(cr, x, y, monitor.bounds.width, monitor.bounds.height);
    cairo_fill(cr);
    cairo_pattern_destroy(wallpaper);
  }
  for (const PlatformWindow handle : d.stacking) {
    const WindowRecord& record = *d.windows.Find(handle);
    if (!record.visible || record.minimized) continue;
    d.DrawDecoration(cr, record, origin);
    d.Composite(cr, record, origin);
  }
  cairo_destroy(cr);
  // Titles go through the drawing supplier, which owns the text engine.
  const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  const boost::intrusive_ptr<pictel::SurfaceInterface> surface =
      supplier->NewOSSurface(screen.get(), nullptr, false);
  const pictel::FontP font(*supplier, pictel::GetPlatformUIFontFamily(), u"Bold", 12);
  const pictel::BrushP white(*supplier, {0.95f, 0.96f, 0.98f, 1});
  for (const PlatformWindow handle : d.stacking) {
    const WindowRecord& record = *d.windows.Find(handle);
    const Insets insets = InsetsFor(record.style);
    if (!record.visible || record.minimized || insets.top <= insets.left) continue;
    const RectT<std::int32_t> frame = d.ScreenFrame(record);
    const float baseline = static_cast<float>(frame.top - origin.y + insets.left) +
                           static_cast<float>(insets.top - insets.left) / 2.0f + 4.0f;
    surface->DrawString(*white, *font, record.title.c_str(),
                        {static_cast<float>(frame.left - origin.x + insets.left + 10), baseline},
                        pictel::TextAlignment::kStart, pictel::TextTruncation::kEndEllipsis,
                        static_cast<float>(frame.width - insets.left - insets.right - 40));
  }
  surface->Flush();
  return CopyToImage(screen.get(), desktop.width, desktop.height);
}

std::vector<std::pair<std::uint32_t, double>> HeadlessPlatform::GetTimers(
    PlatformWindow window) const {
  std::vector<std::pair<std::uint32_t, double>> timers;
  if (const WindowRecord* record = impl_->windows.Find(window)) {
    for (const auto& [id, timer] : record->timers) timers.emplace_back(id, timer.due);
  }
  return timers;
}

std::size_t HeadlessPlatform::GetQueueLength() const {
  return impl_->queue.size();
}

// ---- Windows ----

PlatformWindow HeadlessPlatform::CreateWindow(const WindowCreateParams& params) {
  Impl& d = *impl_;
  velkcore::RequireInput(params.frame.width >= 0 && params.frame.height >= 0);
  const bool child = (params.style & kStyleChild) != 0;
  const WindowRecord* parent = d.windows.Find(params.parent);
  // A child needs a parent; an owner, when given, must exist.
  velkcore::RequireInput(child ? parent != nullptr
                               : params.parent == kNoPlatformWindow || parent != nullptr);
  WindowRecord record;
  record.handle = d.nextHandle++;
  record.parent = params.parent;
  record.title = params.title;
  record.style = params.style;
  record.exStyle = params.exStyle;
  record.visible = (params.style & kStyleVisible) != 0;
  record.enabled = (params.style & kStyleDisabled) == 0;
  record.client = child ? d.windows.InParentClient(params.parent, params.frame)
                        : platform::ClientWithin(params.frame, InsetsFor(params.style));
  WindowRecord& stored = d.windows.Add(std::move(record));
  if (!child) {
    d.stacking.push_back(stored.handle);
    d.Raise(stored.handle);
  }
  AddPendingArea(stored, nullptr);
  return stored.handle;
}

void HeadlessPlatform::DestroyWindow(PlatformWindow window) {
  Impl& d = *impl_;
  if (d.windows.Find(window) == nullptr) return;
  const bool wasActive = d.active == window;
  d.DestroyRecursive(window);
  if (wasActive) d.ActivateNextAfter(window);
}

bool HeadlessPlatform::IsWindow(PlatformWindow window) const {
  return impl_->windows.Find(window) != nullptr;
}

void HeadlessPlatform::SetWindowTitle(PlatformWindow window, const velkcore::UTF16String& title) {
  if (WindowRecord* record = impl_->windows.Find(window)) record->title = title;
}

velkcore::UTF16String HeadlessPlatform::GetWindowTitle(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->title : velkcore::UTF16String();
}

void HeadlessPlatform::ShowWindow(PlatformWindow window, bool show, bool activate) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  if (record->visible != show) {
    record->visible = show;
    if (show) {
      AddPendingArea(*record, nullptr);
    } else {
      if (d.windows.IsWithin(d.capture, window)) {
        d.Post(d.capture, kMsgCaptureLost);
        d.capture = kNoPlatformWindow;
      }
      if (d.windows.IsWithin(d.hover, window)) {
        d.PostLeaveIfTracked(d.hover);
        d.hover = kNoPlatformWindow;
      }
      if (!record->IsChild()) {
        d.ActivateNextAfter(window);
      } else if (d.windows.IsWithin(d.focus, window)) {
        d.SetFocus(d.windows.TopLevelOf(window));
      }
    }
  }
  if (show && activate && !record->IsChild()) d.Activate(window, false);
}

bool HeadlessPlatform::IsWindowVisible(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->visible;
}

void HeadlessPlatform::MinimizeWindow(PlatformWindow window, bool minimize) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || record->IsChild() || record->minimized == minimize) return;
  record->minimized = minimize;
  if (minimize) {
    d.ActivateNextAfter(window);
  } else {
    AddPendingArea(*record, nullptr);
  }
}

bool HeadlessPlatform::IsWindowMinimized(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->minimized;
}

void HeadlessPlatform::ActivateWindow(PlatformWindow window, bool byClick) {
  impl_->Activate(window, byClick);
}

PlatformWindow HeadlessPlatform::GetActiveWindow() const {
  return impl_->active;
}

void HeadlessPlatform::EnableWindow(PlatformWindow window, bool enable) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->enabled = enable;
  if (!enable && d.windows.IsWithin(d.capture, window)) {
    d.Post(d.capture, kMsgCaptureLost);
    d.capture = kNoPlatformWindow;
  }
}

bool HeadlessPlatform::IsWindowEnabled(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->enabled;
}

void HeadlessPlatform::SetWindowOpacity(PlatformWindow window, float opacity) {
  velkcore::RequireInput(std::isfinite(opacity));
  if (WindowRecord* record = impl_->windows.Find(window))
    record->opacity = std::clamp(opacity, 0.0f, 1.0f);
}

void HeadlessPlatform::SetTransparentColorKey(PlatformWindow window,
                                              const std::optional<pictel::ColorRGBA>& key) {
  if (WindowRecord* record = impl_->windows.Find(window)) record->colorKey = key;
}

void HeadlessPlatform::SetWindowParent(PlatformWindow window, PlatformWindow parent) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || !record->IsChild() || d.windows.Find(parent) == nullptr) return;
  // A window cannot go inside itself.
  velkcore::RequireInput(!d.windows.IsWithin(parent, window));
  record->parent = parent;
}

PlatformWindow HeadlessPlatform::GetWindowParent(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->parent : kNoPlatformWindow;
}

// ---- Geometry ----

RectT<std::int32_t> HeadlessPlatform::GetClientRect(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? impl_->windows.ScreenClient(*record) : RectT<std::int32_t>{};
}

void HeadlessPlatform::SetClientRect(PlatformWindow window, const RectT<std::int32_t>& rect) {
  velkcore::RequireInput(rect.width >= 0 && rect.height >= 0);
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  platform::MoveClient(*record,
                       record->IsChild() ? d.windows.InParentClient(record->parent, rect) : rect);
}

RectT<std::int32_t> HeadlessPlatform::GetFrameRect(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? impl_->ScreenFrame(*record) : RectT<std::int32_t>{};
}

void HeadlessPlatform::SetFrameRect(PlatformWindow window, const RectT<std::int32_t>& rect) {
  const WindowRecord* record = impl_->windows.Find(window);
  if (record == nullptr) return;
  SetClientRect(window, platform::ClientWithin(rect, InsetsFor(record->style)));
}

// ---- Painting ----

void HeadlessPlatform::InvalidateRect(PlatformWindow window,
                                      const RectT<std::int32_t>* clientRect) {
  if (WindowRecord* record = impl_->windows.Find(window)) AddPendingArea(*record, clientRect);
}

bool HeadlessPlatform::HasPendingPaint(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && impl_->windows.IsPaintable(*record);
}

std::optional<PaintTarget> HeadlessPlatform::BeginPaint(PlatformWindow window) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || !d.windows.IsPaintable(*record)) return std::nullopt;
  d.EnsureSurface(*record);
  return platform::TakePendingPaint(*record, record->surface.get());
}

void HeadlessPlatform::EndPaint(PlatformWindow window, const PaintTarget&) {
  if (WindowRecord* record = impl_->windows.Find(window)) {
    if (record->surface) cairo_surface_flush(record->surface.get());
  }
}

// ---- Pointer and keyboard ----

void HeadlessPlatform::SetCapture(PlatformWindow window) {
  Impl& d = *impl_;
  if (d.windows.Find(window) == nullptr || d.capture == window) return;
  if (d.capture != kNoPlatformWindow) d.Post(d.capture, kMsgCaptureLost);
  d.capture = window;
}

void HeadlessPlatform::ReleaseCapture() {
  Impl& d = *impl_;
  const PlatformWindow old = d.capture;
  d.capture = kNoPlatformWindow;
  // The pointer may have left the window while it held the capture.
  if (old != kNoPlatformWindow && d.WindowAt(d.pointer) != old) d.PostLeaveIfTracked(old);
  d.hover = d.WindowAt(d.pointer);
}

PlatformWindow HeadlessPlatform::GetCapture() const {
  return impl_->capture;
}

void HeadlessPlatform::SetFocus(PlatformWindow window) {
  if (window != kNoPlatformWindow && impl_->windows.Find(window) == nullptr) return;
  impl_->SetFocus(window);
}

PlatformWindow HeadlessPlatform::GetFocus() const {
  return impl_->focus;
}

PointT<std::int32_t> HeadlessPlatform::GetPointerPosition() const {
  return impl_->pointer;
}

PlatformWindow HeadlessPlatform::GetWindowFromPoint(const PointT<std::int32_t>& screenPoint) const {
  return impl_->WindowAt(screenPoint);
}

void HeadlessPlatform::TrackPointerLeave(PlatformWindow window) {
  if (WindowRecord* record = impl_->windows.Find(window)) record->trackLeave = true;
}

bool HeadlessPlatform::HasPendingPointerMove(PlatformWindow window) const {
  return platform::HasPointerMoveFor(impl_->queue, window);
}

bool HeadlessPlatform::RemovePendingCharacter(char16_t character) {
  return platform::RemoveLeadingCharacter(impl_->queue, character);
}

KeyState HeadlessPlatform::GetKeyState(std::int16_t virtualKey) const {
  if (virtualKey <= 0 || virtualKey >= 256) return {};
  return impl_->keys[static_cast<std::size_t>(virtualKey)];
}

std::int16_t HeadlessPlatform::MapScanCodeToVirtualKey(std::uint32_t scanCode) const {
  return headless::VirtualKeyOfScanCode(scanCode);
}

char16_t HeadlessPlatform::GetUnshiftedCharacter(std::int16_t virtualKey) const {
  return headless::UnshiftedCharacter(virtualKey);
}

std::uint32_t HeadlessPlatform::GetDoubleClickTime() const {
  return impl_->doubleClickTime;
}

PointT<std::int32_t> HeadlessPlatform::GetDoubleClickSize() const {
  return impl_->doubleClickSize;
}

void HeadlessPlatform::SetCursor(CursorShape shape) {
  impl_->cursor = shape;
}

CursorShape HeadlessPlatform::GetCursor() const {
  return impl_->cursor;
}

// ---- Time and timers ----

double HeadlessPlatform::GetTime() const {
  return impl_->now;
}

void HeadlessPlatform::SetTimer(PlatformWindow window, std::uint32_t id,
                                std::uint32_t milliseconds) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  const std::uint32_t interval = std::max(milliseconds, kMinimumTimerInterval);
  record->timers[id] = Timer{interval, d.now + static_cast<double>(interval) / 1000.0};
}

void HeadlessPlatform::KillTimer(PlatformWindow window, std::uint32_t id) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->timers.erase(id);
  std::erase_if(d.queue, [window, id](const OS_Event& e) {
    return e.GetWindow() == window && e.GetMsg() == kMsgTimer && e.GetWParam() == id;
  });
}

std::vector<MonitorDescription> HeadlessPlatform::GetMonitors() const {
  return impl_->monitors;
}

// ---- Message queue ----

bool HeadlessPlatform::GetNextEvent(OS_Event& event, bool) {
  Impl& d = *impl_;
  if (d.queue.empty() && d.quitPending) {
    d.quitPending = false;
    event = OS_Event(kNoPlatformWindow, kMsgQuit, static_cast<std::uint64_t>(d.quitCode), 0, d.now);
    return true;
  }
  if (d.queue.empty()) d.PostDueTimer();
  if (d.queue.empty()) {
    const PlatformWindow paintable = d.FindInStackingOrder(
        [&d](PlatformWindow handle) { return d.windows.IsPaintable(*d.windows.Find(handle)); });
    if (paintable == kNoPlatformWindow) return false;
    event = OS_Event(paintable, kMsgPaint, 0, 0, d.now);
    return true;
  }
  event = d.queue.front();
  d.queue.pop_front();
  d.UpdateKeyState(event);
  return true;
}

void HeadlessPlatform::TranslateEvent(const OS_Event& event) {
  Impl& d = *impl_;
  const std::uint32_t message = event.GetMsg();
  if (message != kMsgKeyDown && message != kMsgSysKeyDown) return;
  const char16_t character =
      headless::CharacterOfKey(static_cast<std::int16_t>(event.GetWParam()), d.keys);
  if (character == 0) return;
  d.queue.emplace_front(event.GetWindow(), message == kMsgKeyDown ? kMsgChar : kMsgSysChar,
                        static_cast<std::uint64_t>(character), event.GetLParam(), d.now);
}

void HeadlessPlatform::PostEvent(const OS_Event& event) {
  impl_->queue.push_back(event);
}

void HeadlessPlatform::PostQuit(std::int32_t exitCode) {
  impl_->quitPending = true;
  impl_->quitCode = exitCode;
}

// ---- Clipboard ----

void HeadlessPlatform::SetClipboard(std::vector<ClipboardItem> items) {
  impl_->clipboard = std::move(items);
}

std::optional<std::string> HeadlessPlatform::GetClipboard(std::string_view type) const {
  for (const ClipboardItem& item : impl_->clipboard) {
    if (item.type == type) return item.bytes;
  }
  return std::nullopt;
}

std::vector<std::string> HeadlessPlatform::GetClipboardTypes() const {
  std::vector<std::string> types;
  for (const ClipboardItem& item : impl_->clipboard) types.push_back(item.type);
  return types;
}

// ---- Synthetic input ----

void HeadlessPlatform::InjectPointerMove(const PointT<std::int32_t>& screenPoint) {
  MovePointer(screenPoint);
}

void HeadlessPlatform::InjectButton(std::int32_t button, bool down) {
  if (down) {
    PressButton(button);
  } else {
    ReleaseButton(button);
  }
}

void HeadlessPlatform::InjectWheel(std::int32_t delta, bool horizontal) {
  TurnWheel(delta, horizontal);
}

void HeadlessPlatform::InjectKey(std::int16_t virtualKey, bool extended, bool down) {
  if (down) {
    PressKey(virtualKey, extended);
  } else {
    ReleaseKey(virtualKey, extended);
  }
}

}  // namespace velkui::ui
