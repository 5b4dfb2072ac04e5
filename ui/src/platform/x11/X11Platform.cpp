#include "X11Platform.h"

#include <X11/Xatom.h>
#include <X11/extensions/XTest.h>
#include <X11/extensions/Xrandr.h>
#include <X11/extensions/shape.h>
#include <poll.h>
#include <unistd.h>
#include "X11Headers.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <limits>

#include <velkcore/Error.h>

#include "../common/PixelBuffer.h"
#include "../common/QueueSearch.h"
#include "X11Monitors.h"
#include "X11PlatformImpl.h"

namespace velkui::ui {

using platform::AddPendingArea;
using platform::ClientWithin;
using velkcore::PointT;
using velkcore::RectT;
using x11::Insets;
using x11::QueuedMessage;
using x11::WindowRecord;

namespace {

constexpr long kTopLevelEvents = ExposureMask | StructureNotifyMask | PropertyChangeMask |
                                 FocusChangeMask | ButtonPressMask | ButtonReleaseMask |
                                 PointerMotionMask | EnterWindowMask | LeaveWindowMask |
                                 KeyPressMask | KeyReleaseMask | KeymapStateMask;
constexpr long kChildEvents = ExposureMask | StructureNotifyMask | ButtonPressMask |
                              ButtonReleaseMask | PointerMotionMask | EnterWindowMask |
                              LeaveWindowMask;
constexpr unsigned kGrabEvents =
    ButtonPressMask | ButtonReleaseMask | PointerMotionMask | EnterWindowMask | LeaveWindowMask;

// _MOTIF_WM_HINTS
constexpr long kMotifFunctions = 1L << 0;
constexpr long kMotifDecorations = 1L << 1;
constexpr long kMotifFunctionResize = 1L << 1;
constexpr long kMotifFunctionMove = 1L << 2;
constexpr long kMotifFunctionMinimize = 1L << 3;
constexpr long kMotifFunctionMaximize = 1L << 4;
constexpr long kMotifFunctionClose = 1L << 5;
constexpr long kMotifDecorBorder = 1L << 1;
constexpr long kMotifDecorResize = 1L << 2;
constexpr long kMotifDecorTitle = 1L << 3;
constexpr long kMotifDecorMenu = 1L << 4;
constexpr long kMotifDecorMinimize = 1L << 5;
constexpr long kMotifDecorMaximize = 1L << 6;

bool HasCaption(std::uint32_t style) {
  return (style & kStyleCaption) == kStyleCaption;
}

bool IsResizable(std::uint32_t style) {
  return (style & kStyleSizingFrame) != 0;
}

std::string Latin1Of(const velkcore::UTF16String& text) {
  std::string latin1;
  for (const char16_t c : text) latin1.push_back(c < 0x100 ? static_cast<char>(c) : '?');
  return latin1;
}

void SetAtomProperty(Display* display, Window window, Atom property, Atom type,
                     const std::vector<long>& values) {
  XChangeProperty(display, window, property, type, 32, PropModeReplace,
                  reinterpret_cast<const unsigned char*>(values.data()),
                  static_cast<int>(values.size()));
}

// A window with a modal frame and an owner: a dialog the window manager keeps
// above its owner.
bool IsModalFrame(const WindowRecord& record) {
  return record.parent != kNoPlatformWindow &&
         ((record.exStyle & kExStyleModalFrame) != 0 || (record.style & kStyleModalFrame) != 0);
}

// _NET_WM_STATE as a managed window asks for it before it is mapped. A window
// manager removes the property when the window is withdrawn, so every map
// writes it again.
void WriteInitialStates(Display* display, const x11::X11Atoms& atoms, Window window,
                        const WindowRecord& record) {
  std::vector<long> states;
  if (IsModalFrame(record)) states.push_back(static_cast<long>(atoms.netWmStateModal));
  if ((record.exStyle & kExStyleTopmost) != 0) {
    states.push_back(static_cast<long>(atoms.netWmStateAbove));
  }
  if ((record.exStyle & kExStyleToolWindow) != 0) {
    states.push_back(static_cast<long>(atoms.netWmStateSkipTaskbar));
  }
  if (states.empty()) {
    XDeleteProperty(display, window, atoms.netWmState);
  } else {
    SetAtomProperty(display, window, atoms.netWmState, XA_ATOM, states);
  }
}

struct PropertyOfWindow {
  Window window;
  Atom property;
};

Bool IsPropertyChangeOf(Display*, XEvent* event, XPointer argument) {
  const auto* wanted = reinterpret_cast<const PropertyOfWindow*>(argument);
  return event->type == PropertyNotify && event->xproperty.window == wanted->window &&
         event->xproperty.atom == wanted->property;
}

}  // namespace

// ---- Impl: records ----

X11Platform::Impl::Impl()
    : display(connection.Get()),
      keyboard(display),
      cursors(display),
      clipboard(connection),
      xsettings(connection) {
  int eventBase = 0;
  int errorBase = 0;
  if (XRRQueryExtension(display, &eventBase, &errorBase)) {
    randrEventBase = eventBase;
    XRRSelectInput(display, connection.Root(), RRScreenChangeNotifyMask);
  }
  shapeAvailable = XShapeQueryExtension(display, &eventBase, &errorBase) != 0;
  int major = 0;
  int minor = 0;
  xtestAvailable = XTestQueryExtension(display, &eventBase, &errorBase, &major, &minor) != 0;
  // The work area and the window manager are properties of the root; a new
  // settings manager announces itself to its StructureNotify clients.
  XSelectInput(display, connection.Root(), PropertyChangeMask | StructureNotifyMask);
  if (const char* time = XGetDefault(display, "velkui", "multiClickTime")) {
    const long value = std::strtol(time, nullptr, 10);
    if (value > 0) resourceDoubleClickTime = static_cast<std::uint32_t>(value);
  }
  xsettings.Refresh();
  ApplyDoubleClickSettings();
  CreateClientLeader();
  // The lock keys as they are now.
  Window root = None;
  Window child = None;
  int x = 0;
  int y = 0;
  unsigned state = 0;
  XQueryPointer(display, connection.Root(), &root, &child, &x, &y, &x, &y, &state);
  keys[vk::kCapsLock].toggled = (state & LockMask) != 0;
  keys[vk::kNumLock].toggled = (state & keyboard.NumLockMask()) != 0;
}

X11Platform::Impl::~Impl() {
  if (capture != kNoPlatformWindow) XUngrabPointer(display, CurrentTime);
  // Surfaces and input contexts go before the windows they draw on.
  const std::vector<PlatformWindow> tops = windows.TopLevels();
  windows.Clear();
  for (const PlatformWindow top : tops) XDestroyWindow(display, top);
  if (clientLeader != None) XDestroyWindow(display, clientLeader);
  XSync(display, False);
}

void X11Platform::Impl::CreateClientLeader() {
  clientLeader = XCreateSimpleWindow(display, connection.Root(), -1, -1, 1, 1, 0, 0, 0);
  const x11::X11Atoms& atoms = connection.Atoms();
  XClassHint classHint{const_cast<char*>("velkui"), const_cast<char*>("Velkui")};
  XSetClassHint(display, clientLeader, &classHint);
  SetAtomProperty(display, clientLeader, atoms.wmClientLeader, XA_WINDOW,
                  {static_cast<long>(clientLeader)});
  SetAtomProperty(display, clientLeader, atoms.netWmPid, XA_CARDINAL,
                  {static_cast<long>(getpid())});
}

RectT<std::int32_t> X11Platform::Impl::ScreenFrame(const WindowRecord& record) const {
  return platform::FrameAround(windows.ScreenClient(record), record.frame);
}

// ---- Impl: queue ----

double X11Platform::Impl::Now() const {
  return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

void X11Platform::Impl::Post(PlatformWindow window, std::uint32_t message, std::uint64_t w,
                             std::int64_t l) {
  queue.push_back({OS_Event(window, message, w, l, Now()), {}, 0, std::nullopt});
}

void X11Platform::Impl::Enqueue(QueuedMessage message) {
  queue.push_back(std::move(message));
}

void X11Platform::Impl::SyncModifiers(unsigned state, bool locks) {
  // The server's word wins over presses and releases we missed (while
  // another application had the focus, say).
  const auto sync = [this](bool held, std::int16_t left, std::int16_t right) {
    if (!held) {
      keys[static_cast<std::size_t>(left)].down = false;
      keys[static_cast<std::size_t>(right)].down = false;
    } else if (!keys[static_cast<std::size_t>(left)].down &&
               !keys[static_cast<std::size_t>(right)].down) {
      keys[static_cast<std::size_t>(left)].down = true;
    }
  };
  sync((state & ShiftMask) != 0, vk::kLeftShift, vk::kRightShift);
  sync((state & ControlMask) != 0, vk::kLeftControl, vk::kRightControl);
  // AltGr (the right Alt of most layouts) is Mod5, not Mod1.
  sync((state & (Mod1Mask | Mod5Mask)) != 0, vk::kLeftAlt, vk::kRightAlt);
  platform::SyncGenericModifiers(keys);
  if (!locks) return;
  keys[vk::kCapsLock].toggled = (state & LockMask) != 0;
  if (keyboard.NumLockMask() != 0) {
    keys[vk::kNumLock].toggled = (state & keyboard.NumLockMask()) != 0;
  }
}

void X11Platform::Impl::UpdateKeyState(const QueuedMessage& message) {
  const OS_Event& event = message.event;
  const std::uint32_t msg = event.GetMsg();
  if (message.modifierState) {
    // The state of a lock key's release may still show the lock it is about
    // to change; before a press it is the lock's state until now.
    const bool lockKeyRelease =
        (msg == kMsgKeyUp || msg == kMsgSysKeyUp) &&
        platform::IsLockKey(static_cast<std::int16_t>(event.GetWParam() & 0xFFu));
    SyncModifiers(*message.modifierState, !lockKeyRelease);
  }
  if (platform::ApplyButtonMessage(keys, msg)) return;
  platform::ApplyKeyMessage(keys, event, message.sideKey);
}

void X11Platform::Impl::ApplyClientRect(WindowRecord& record, const RectT<std::int32_t>& relative) {
  if (platform::MoveClient(record, relative) && record.buffer) {
    record.buffer->Resize(relative.width, relative.height);
  }
}

bool X11Platform::Impl::HasMessage() {
  if (!queue.empty() || quitPending) return true;
  const std::optional<double> due = timers.NextDue();
  if (due && *due <= Now()) return true;
  return std::any_of(windows.begin(), windows.end(),
                     [this](const auto& entry) { return windows.IsPaintable(entry.second); });
}

bool X11Platform::Impl::Wait(double seconds) {
  XFlush(display);
  if (XEventsQueued(display, QueuedAlready) > 0) return true;
  pollfd descriptor{connection.FileDescriptor(), POLLIN, 0};
  const int timeout =
      seconds < 0 ? -1 : static_cast<int>(std::ceil(std::max(seconds, 0.0) * 1000.0));
  return poll(&descriptor, 1, timeout) > 0;
}

// ---- Impl: activation and focus ----

void X11Platform::Impl::SetFocus(PlatformWindow handle) {
  if (handle == focus) return;
  const PlatformWindow old = focus;
  focus = handle;
  const WindowRecord* oldTop = windows.Find(windows.TopLevelOf(old));
  const WindowRecord* newTop = windows.Find(windows.TopLevelOf(handle));
  if (oldTop != newTop) {
    if (oldTop != nullptr && oldTop->inputContext) XUnsetICFocus(oldTop->inputContext.get());
    if (newTop != nullptr && newTop->inputContext) XSetICFocus(newTop->inputContext.get());
  }
  if (windows.Find(old) != nullptr) Post(old, kMsgKillFocus, handle);
  if (handle != kNoPlatformWindow) Post(handle, kMsgSetFocus, old);
}

void X11Platform::Impl::Activate(PlatformWindow handle, bool byClick, bool askServer) {
  const PlatformWindow top = windows.TopLevelOf(handle);
  const WindowRecord* record = windows.Find(top);
  if (record == nullptr || !record->visible || (record->exStyle & kExStyleNoActivate) != 0) {
    return;
  }
  if (askServer) {
    ownActivationTime = Now();
    // A window manager activates only the windows it manages; a pop-up that
    // bypasses it takes the focus from us directly.
    if (connection.HasWindowManager() && !record->overrideRedirect) {
      XEvent request{};
      request.xclient.type = ClientMessage;
      request.xclient.window = top;
      request.xclient.message_type = connection.Atoms().netActiveWindow;
      request.xclient.format = 32;
      request.xclient.data.l[0] = 1;  // from an application
      request.xclient.data.l[1] = static_cast<long>(lastInputTime);
      XSendEvent(display, connection.Root(), False,
                 SubstructureNotifyMask | SubstructureRedirectMask, &request);
    } else {
      XRaiseWindow(display, top);
      XSetInputFocus(display, top, RevertToParent, CurrentTime);
    }
  }
  std::erase(activationOrder, top);
  activationOrder.push_back(top);
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

void X11Platform::Impl::ActivateNextAfter(PlatformWindow leaving) {
  if (active != leaving) return;
  active = kNoPlatformWindow;
  for (auto it = activationOrder.rbegin(); it != activationOrder.rend(); ++it) {
    const WindowRecord* record = windows.Find(*it);
    if (*it != leaving && record != nullptr && record->visible && !record->minimized &&
        (record->exStyle & kExStyleNoActivate) == 0) {
      Activate(*it, false, true);
      return;
    }
  }
  if (windows.IsWithin(focus, leaving)) SetFocus(kNoPlatformWindow);
  if (applicationActive) {
    applicationActive = false;
    if (windows.Find(leaving) != nullptr) Post(leaving, kMsgActivateApp, 0);
  }
}

PlatformWindow X11Platform::Impl::UsableWindowInsteadOf(PlatformWindow blocked) const {
  for (auto it = activationOrder.rbegin(); it != activationOrder.rend(); ++it) {
    const WindowRecord* record = windows.Find(*it);
    if (*it != blocked && record != nullptr && record->visible && !record->minimized &&
        record->enabled && (record->exStyle & kExStyleNoActivate) == 0) {
      return *it;
    }
  }
  return kNoPlatformWindow;
}

void X11Platform::Impl::DeactivateApplication() {
  if (capture != kNoPlatformWindow) LoseCapture();
  const PlatformWindow old = active;
  active = kNoPlatformWindow;
  SetFocus(kNoPlatformWindow);
  if (windows.Find(old) != nullptr) Post(old, kMsgActivate, 0);
  if (applicationActive) {
    applicationActive = false;
    if (windows.Find(old) != nullptr) Post(old, kMsgActivateApp, 0);
  }
}

void X11Platform::Impl::PostLeaveIfTracked(PlatformWindow handle) {
  WindowRecord* record = windows.Find(handle);
  if (record == nullptr || !record->trackLeave) return;
  record->trackLeave = false;
  Post(handle, kMsgPointerLeft);
}

void X11Platform::Impl::LoseCapture() {
  const PlatformWindow old = capture;
  capture = kNoPlatformWindow;
  XUngrabPointer(display, CurrentTime);
  if (windows.Find(old) != nullptr) Post(old, kMsgCaptureLost);
}

bool X11Platform::Impl::WaitForFrameExtents(Window window) {
  PropertyOfWindow wanted{window, connection.Atoms().netFrameExtents};
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::milliseconds(200);
  XFlush(display);
  for (;;) {
    XEvent event;
    if (XCheckIfEvent(display, &event, IsPropertyChangeOf, reinterpret_cast<XPointer>(&wanted))) {
      return true;
    }
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
        deadline - std::chrono::steady_clock::now());
    if (left.count() <= 0) return false;
    pollfd descriptor{connection.FileDescriptor(), POLLIN, 0};
    poll(&descriptor, 1, static_cast<int>(left.count()));
  }
}

// ---- Impl: pointer ----

PlatformWindow X11Platform::Impl::WindowAtScreen(const PointT<std::int32_t>& point) const {
  // Down the window tree from the root; the deepest of our windows wins, and
  // another application's window on top hides ours.
  PlatformWindow found = kNoPlatformWindow;
  Window current = connection.Root();
  for (int depth = 0; depth < 64; ++depth) {
    Window child = None;
    int x = 0;
    int y = 0;
    if (!XTranslateCoordinates(display, connection.Root(), current, point.x, point.y, &x, &y,
                               &child) ||
        child == None) {
      break;
    }
    current = child;
    if (windows.Find(child) != nullptr) found = child;
  }
  return found;
}

PointT<std::int32_t> X11Platform::Impl::QueryPointer() const {
  Window root = None;
  Window child = None;
  PointT<std::int32_t> screen{0, 0};
  int x = 0;
  int y = 0;
  unsigned state = 0;
  XQueryPointer(display, connection.Root(), &root, &child, &screen.x, &screen.y, &x, &y, &state);
  return screen;
}

PlatformWindow X11Platform::Impl::PointerTarget(PlatformWindow eventWindow,
                                                const PointT<std::int32_t>& eventPoint,
                                                const PointT<std::int32_t>& screen) const {
  if (capture != kNoPlatformWindow) return capture;
  const WindowRecord* record = windows.Find(eventWindow);
  const bool inside = record != nullptr && eventPoint.x >= 0 && eventPoint.y >= 0 &&
                      eventPoint.x < record->client.width && eventPoint.y < record->client.height;
  // A press holds the pointer in its window; outside it, the event belongs to
  // the window under the pointer.
  const PlatformWindow under = inside ? eventWindow : WindowAtScreen(screen);
  return windows.IsEnabledForInput(under) ? under : kNoPlatformWindow;
}

PointT<std::int32_t> X11Platform::Impl::ClientPoint(PlatformWindow target,
                                                    PlatformWindow eventWindow,
                                                    const PointT<std::int32_t>& eventPoint,
                                                    const PointT<std::int32_t>& screen) const {
  if (target == eventWindow) return eventPoint;
  const WindowRecord* record = windows.Find(target);
  if (record == nullptr) return eventPoint;
  const PointT<std::int32_t> origin = windows.ClientOrigin(*record);
  return {screen.x - origin.x, screen.y - origin.y};
}

void X11Platform::Impl::ApplyCursor() {
  const Cursor shape = cursors.Get(cursor);
  for (const PlatformWindow top : windows.TopLevels()) XDefineCursor(display, top, shape);
  if (capture != kNoPlatformWindow) {
    XChangeActivePointerGrab(display, kGrabEvents, shape, CurrentTime);
  }
  XFlush(display);
}

void X11Platform::Impl::ApplyDoubleClickSettings() {
  const x11::XSettings& settings = xsettings.Settings();
  const std::optional<std::int32_t> time = settings.Integer("Net/DoubleClickTime");
  doubleClickTime = resourceDoubleClickTime.value_or(
      time && *time > 0 ? static_cast<std::uint32_t>(*time) : kDefaultDoubleClickTime);
  // A distance each way from the first click: the size spans it on both sides.
  const std::optional<std::int32_t> distance = settings.Integer("Net/DoubleClickDistance");
  const std::int32_t size =
      distance && *distance >= 0 && *distance <= std::numeric_limits<std::int32_t>::max() / 2
          ? *distance * 2
          : kDefaultDoubleClickSize;
  doubleClickSize = {size, size};
}

// ---- X11Platform ----

X11Platform::X11Platform() : impl_(std::make_unique<Impl>()) {}

X11Platform::~X11Platform() = default;

X11Platform& X11Platform::Get() {
  return *velkcore::CheckedCast<X11Platform>(&GetPlatform());
}

std::string_view X11Platform::GetName() const {
  return "x11";
}

bool X11Platform::WaitForActivity(double seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0);
  Impl& d = *impl_;
  const double end = d.Now() + seconds;
  for (;;) {
    // X events that make no message (a property change, say) wake the wait
    // but do not end it.
    d.DrainConnection();
    if (d.HasMessage()) return true;
    double limit = end - d.Now();
    if (limit <= 0) return false;
    if (const std::optional<double> due = d.timers.NextDue()) {
      limit = std::min(limit, std::max(0.0, *due - d.Now()));
    }
    d.Wait(limit);
  }
}

void X11Platform::Sync() {
  XSync(impl_->display, False);
  impl_->DrainConnection();
}

boost::intrusive_ptr<pictel::ImageInterface> X11Platform::CaptureWindowPixels(
    PlatformWindow window) const {
  const Impl& d = *impl_;
  const WindowRecord* record = d.windows.Find(window);
  velkcore::RequireInput(record != nullptr);
  platform::PixelBuffer pixels(record->client.width, record->client.height);
  XSync(d.display, False);
  XImage* image = XGetImage(d.display, window, 0, 0, static_cast<unsigned>(pixels.Width()),
                            static_cast<unsigned>(pixels.Height()), AllPlanes, ZPixmap);
  if (image != nullptr) {
    const auto channel = [](unsigned long pixel, unsigned long mask) -> std::uint32_t {
      if (mask == 0) return 0;
      int shift = 0;
      while (((mask >> shift) & 1u) == 0) ++shift;
      const unsigned long max = mask >> shift;
      return static_cast<std::uint32_t>(((pixel & mask) >> shift) * 255u / max);
    };
    for (std::int32_t y = 0; y < pixels.Height(); ++y) {
      auto* row = reinterpret_cast<std::uint32_t*>(pixels.Row(y));
      for (std::int32_t x = 0; x < pixels.Width(); ++x) {
        const unsigned long pixel = XGetPixel(image, x, y);
        row[x] = 0xFF000000u | (channel(pixel, image->red_mask) << 16) |
                 (channel(pixel, image->green_mask) << 8) | channel(pixel, image->blue_mask);
      }
    }
    XDestroyImage(image);
  }
  return pixels.ToImage();
}

void X11Platform::ResizeFromOutside(PlatformWindow window, const RectT<std::int32_t>& client) {
  velkcore::RequireInput(client.width > 0 && client.height > 0);
  const WindowRecord* record = impl_->windows.Find(window);
  velkcore::RequireInput(record != nullptr && !record->IsChild());
  const x11::X11Connection other(DisplayString(impl_->display));
  XMoveResizeWindow(other.Get(), window, client.left, client.top,
                    static_cast<unsigned>(client.width), static_cast<unsigned>(client.height));
  XSync(other.Get(), False);
}

bool X11Platform::HasWindowManager() const {
  return impl_->connection.HasWindowManager();
}

std::string X11Platform::GetDisplayName() const {
  return DisplayString(impl_->display);
}

std::int32_t X11Platform::GetPaintCount(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->paintCount : 0;
}

// ---- Windows ----

PlatformWindow X11Platform::CreateWindow(const WindowCreateParams& params) {
  Impl& d = *impl_;
  velkcore::RequireInput(params.frame.width >= 0 && params.frame.height >= 0);
  const bool child = (params.style & kStyleChild) != 0;
  const WindowRecord* parent = d.windows.Find(params.parent);
  velkcore::RequireInput(child ? parent != nullptr
                               : params.parent == kNoPlatformWindow || parent != nullptr);
  const x11::X11Atoms& atoms = d.connection.Atoms();
  WindowRecord record;
  record.parent = params.parent;
  record.overrideRedirect =
      !child && (params.style & kStylePopup) != 0 && !HasCaption(params.style);
  record.title = params.title;
  record.style = params.style;
  record.exStyle = params.exStyle;
  record.enabled = (params.style & kStyleDisabled) == 0;
  const bool managed = !child && !record.overrideRedirect;
  if (managed && d.connection.HasWindowManager() && HasCaption(params.style)) {
    // Until the window manager says otherwise, frames look like the last one.
    for (const auto& [h, other] : d.windows) {
      if (!other.IsChild() && !other.overrideRedirect && HasCaption(other.style))
        record.frame = other.frame;
    }
  }
  record.client = child ? d.windows.InParentClient(params.parent, params.frame)
                        : ClientWithin(params.frame, record.frame);

  XSetWindowAttributes attributes{};
  attributes.background_pixmap = None;
  attributes.bit_gravity = NorthWestGravity;
  attributes.override_redirect = record.overrideRedirect ? True : False;
  attributes.save_under = record.overrideRedirect ? True : False;
  attributes.event_mask = child ? kChildEvents : kTopLevelEvents;
  attributes.cursor = d.cursors.Get(d.cursor);
  const Window xParent = child ? parent->handle : d.connection.Root();
  const Window window = XCreateWindow(d.display, xParent, record.client.left, record.client.top,
                                      static_cast<unsigned>(std::max(record.client.width, 1)),
                                      static_cast<unsigned>(std::max(record.client.height, 1)), 0,
                                      CopyFromParent, InputOutput, CopyFromParent,
                                      CWBackPixmap | CWBitGravity | CWOverrideRedirect |
                                          CWSaveUnder | CWEventMask | (child ? 0 : CWCursor),
                                      &attributes);
  record.handle = window;
  record.buffer = std::make_unique<x11::X11BackBuffer>(
      d.display, window, DefaultVisual(d.display, d.connection.Screen()),
      DefaultDepth(d.display, d.connection.Screen()), record.client.width, record.client.height);

  if (managed) {
    XClassHint classHint{const_cast<char*>("velkui"), const_cast<char*>("Velkui")};
    XSetClassHint(d.display, window, &classHint);
    std::vector<Atom> protocols{atoms.wmDeleteWindow, atoms.netWmPing};
    XSetWMProtocols(d.display, window, protocols.data(), static_cast<int>(protocols.size()));
    SetAtomProperty(d.display, window, atoms.netWmPid, XA_CARDINAL, {static_cast<long>(getpid())});
    XWMHints hints{};
    hints.flags = InputHint | StateHint | WindowGroupHint;
    hints.input = (params.exStyle & kExStyleNoActivate) != 0 ? False : True;
    hints.initial_state = NormalState;
    hints.window_group = d.clientLeader;
    XSetWMHints(d.display, window, &hints);
    SetAtomProperty(d.display, window, atoms.wmClientLeader, XA_WINDOW,
                    {static_cast<long>(d.clientLeader)});
    if (params.parent != kNoPlatformWindow) {
      XSetTransientForHint(d.display, window, d.windows.TopLevelOf(params.parent));
    }
    const bool caption = HasCaption(params.style);
    long functions = kMotifFunctionMove;
    long decorations = 0;
    if (IsResizable(params.style)) functions |= kMotifFunctionResize;
    if ((params.style & kStyleMinimizeBox) != 0) functions |= kMotifFunctionMinimize;
    if ((params.style & kStyleMaximizeBox) != 0) functions |= kMotifFunctionMaximize;
    if ((params.style & kStyleSystemMenu) != 0) functions |= kMotifFunctionClose;
    if (caption) {
      decorations = kMotifDecorBorder | kMotifDecorTitle;
      if ((params.style & kStyleSystemMenu) != 0) decorations |= kMotifDecorMenu;
      if (IsResizable(params.style)) decorations |= kMotifDecorResize;
      if ((params.style & kStyleMinimizeBox) != 0) decorations |= kMotifDecorMinimize;
      if ((params.style & kStyleMaximizeBox) != 0) decorations |= kMotifDecorMaximize;
    }
    SetAtomProperty(d.display, window, atoms.motifWmHints, atoms.motifWmHints,
                    {kMotifFunctions | kMotifDecorations, functions, decorations, 0, 0});
    const Atom type = (params.exStyle & kExStyleToolWindow) != 0 ? atoms.netWmWindowTypeUtility
                      : IsModalFrame(record)                     ? atoms.netWmWindowTypeDialog
                                                                 : atoms.netWmWindowTypeNormal;
    SetAtomProperty(d.display, window, atoms.netWmWindowType, XA_ATOM, {static_cast<long>(type)});
    WriteInitialStates(d.display, atoms, window, record);
    record.inputContext.reset(d.keyboard.CreateContext(window));
    if (record.inputContext) {
      XSelectInput(d.display, window,
                   kTopLevelEvents | x11::X11Keyboard::FilterEvents(record.inputContext.get()));
    }
    if (d.connection.HasWindowManager() && HasCaption(params.style)) {
      // Ask now what frame the window will get, so that the frame asked for is
      // the frame it gets.
      XEvent request{};
      request.xclient.type = ClientMessage;
      request.xclient.window = window;
      request.xclient.message_type = atoms.netRequestFrameExtents;
      request.xclient.format = 32;
      XSendEvent(d.display, d.connection.Root(), False,
                 SubstructureNotifyMask | SubstructureRedirectMask, &request);
      if (d.WaitForFrameExtents(window)) {
        d.ReadFrameExtentsOf(window, record.frame);
      }
    }
  } else if (record.overrideRedirect) {
    SetAtomProperty(d.display, window, atoms.netWmWindowType, XA_ATOM,
                    {static_cast<long>(atoms.netWmWindowTypePopupMenu)});
  }
  WindowRecord& stored = d.windows.Add(std::move(record));
  SetWindowTitle(window, params.title);
  if (managed) {
    // Size hints and placement: the client area goes where it was asked,
    // inside the frame the window manager announced.
    SetClientRect(window, ClientWithin(params.frame, stored.frame));
  }
  AddPendingArea(stored, nullptr);
  if ((params.style & kStyleVisible) != 0) ShowWindow(window, true, false);
  XFlush(d.display);
  return window;
}

void X11Platform::DestroyWindow(PlatformWindow window) {
  Impl& d = *impl_;
  if (d.windows.Find(window) == nullptr) return;
  const bool wasActive = d.active == window;
  const bool hadCapture = d.windows.IsWithin(d.capture, window);
  std::function<void(PlatformWindow)> forget = [&](PlatformWindow handle) {
    for (const PlatformWindow child : d.windows.ChildrenOf(handle)) forget(child);
    if (d.capture == handle) d.capture = kNoPlatformWindow;
    if (d.hover == handle) d.hover = kNoPlatformWindow;
    if (d.focus == handle) d.focus = kNoPlatformWindow;
    if (d.lastPress && d.lastPress->window == handle) d.lastPress.reset();
    if (d.lastKeyPress && d.lastKeyPress->event.GetWindow() == handle) d.lastKeyPress.reset();
    std::erase_if(d.queue,
                  [handle](const QueuedMessage& m) { return m.event.GetWindow() == handle; });
    std::erase(d.activationOrder, handle);
    d.timers.KillAll(handle);
    d.windows.Erase(handle);
  };
  forget(window);
  if (hadCapture) XUngrabPointer(d.display, CurrentTime);
  XDestroyWindow(d.display, window);
  XFlush(d.display);
  if (wasActive) d.ActivateNextAfter(window);
}

bool X11Platform::IsWindow(PlatformWindow window) const {
  return impl_->windows.Find(window) != nullptr;
}

void X11Platform::SetWindowTitle(PlatformWindow window, const velkcore::UTF16String& title) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->title = title;
  const std::string utf8 = velkcore::UTF16to8(title);
  XChangeProperty(d.display, window, d.connection.Atoms().netWmName,
                  d.connection.Atoms().utf8String, 8, PropModeReplace,
                  reinterpret_cast<const unsigned char*>(utf8.data()),
                  static_cast<int>(utf8.size()));
  // For window managers that only read the old property (Latin-1).
  const std::string latin1 = Latin1Of(title);
  XChangeProperty(d.display, window, XA_WM_NAME, XA_STRING, 8, PropModeReplace,
                  reinterpret_cast<const unsigned char*>(latin1.data()),
                  static_cast<int>(latin1.size()));
  XFlush(d.display);
}

velkcore::UTF16String X11Platform::GetWindowTitle(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->title : velkcore::UTF16String();
}

void X11Platform::ShowWindow(PlatformWindow window, bool show, bool activate) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  if (record->visible != show) {
    record->visible = show;
    if (show) {
      if (!record->IsChild() && !record->overrideRedirect) {
        WriteInitialStates(d.display, d.connection.Atoms(), window, *record);
        // Shown without being activated: a user time of 0 tells the window manager.
        if (!activate) {
          SetAtomProperty(d.display, window, d.connection.Atoms().netWmUserTime, XA_CARDINAL, {0});
        }
      }
      if (!record->minimized) {
        if (record->IsChild()) {
          XMapWindow(d.display, window);
        } else {
          XMapRaised(d.display, window);
        }
      }
      AddPendingArea(*record, nullptr);
    } else {
      if (d.windows.IsWithin(d.capture, window)) d.LoseCapture();
      if (d.windows.IsWithin(d.hover, window)) {
        d.PostLeaveIfTracked(d.hover);
        d.hover = kNoPlatformWindow;
      }
      if (record->IsChild()) {
        XUnmapWindow(d.display, window);
      } else {
        XWithdrawWindow(d.display, window, d.connection.Screen());
      }
      if (!record->IsChild()) {
        d.ActivateNextAfter(window);
      } else if (d.windows.IsWithin(d.focus, window)) {
        d.SetFocus(d.windows.TopLevelOf(window));
      }
    }
  }
  if (show && activate && !record->IsChild()) d.Activate(window, false, true);
  XFlush(d.display);
}

bool X11Platform::IsWindowVisible(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->visible;
}

void X11Platform::MinimizeWindow(PlatformWindow window, bool minimize) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || record->IsChild() || record->minimized == minimize) return;
  record->minimized = minimize;
  if (minimize) {
    if (record->visible) {
      // Without a window manager nobody would act on the iconify request.
      if (d.connection.HasWindowManager() && !record->overrideRedirect) {
        XIconifyWindow(d.display, window, d.connection.Screen());
        record->iconifyPending = true;
        record->restoredWhileIconifying = -1.0;
      } else {
        XUnmapWindow(d.display, window);
      }
    }
    d.ActivateNextAfter(window);
  } else {
    // A restore that overtakes the window manager's iconify would be undone by it.
    record->restoredWhileIconifying = record->iconifyPending ? d.Now() : -1.0;
    if (record->visible) XMapRaised(d.display, window);
    AddPendingArea(*record, nullptr);
  }
  XFlush(d.display);
}

bool X11Platform::IsWindowMinimized(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->minimized;
}

void X11Platform::ActivateWindow(PlatformWindow window, bool byClick) {
  impl_->Activate(window, byClick, true);
  XFlush(impl_->display);
}

PlatformWindow X11Platform::GetActiveWindow() const {
  return impl_->active;
}

void X11Platform::EnableWindow(PlatformWindow window, bool enable) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->enabled = enable;
  if (!enable && d.windows.IsWithin(d.capture, window)) d.LoseCapture();
}

bool X11Platform::IsWindowEnabled(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && record->enabled;
}

void X11Platform::SetWindowOpacity(PlatformWindow window, float opacity) {
  velkcore::RequireInput(std::isfinite(opacity));
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->opacity = std::clamp(opacity, 0.0f, 1.0f);
  // A compositing manager reads the property; X itself has no opacity.
  const Atom property = d.connection.Atoms().netWmWindowOpacity;
  if (record->opacity >= 1.0f) {
    XDeleteProperty(d.display, window, property);
  } else {
    const auto value = static_cast<long>(
        std::lround(static_cast<double>(record->opacity) * static_cast<double>(0xFFFFFFFFu)));
    SetAtomProperty(d.display, window, property, XA_CARDINAL, {value});
  }
  XFlush(d.display);
}

void X11Platform::SetTransparentColorKey(PlatformWindow window,
                                         const std::optional<pictel::ColorRGBA>& key) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  record->colorKey = key;
  if (d.shapeAvailable && record->buffer) {
    record->buffer->ApplyShape(key, record->overrideRedirect);
    XFlush(d.display);
  }
}

void X11Platform::SetWindowParent(PlatformWindow window, PlatformWindow parent) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || !record->IsChild() || d.windows.Find(parent) == nullptr) return;
  velkcore::RequireInput(!d.windows.IsWithin(parent, window));
  record->parent = parent;
  XReparentWindow(d.display, window, parent, record->client.left, record->client.top);
  if (record->visible) XMapWindow(d.display, window);
  XFlush(d.display);
}

PlatformWindow X11Platform::GetWindowParent(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? record->parent : kNoPlatformWindow;
}

// ---- Geometry ----

RectT<std::int32_t> X11Platform::GetClientRect(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? impl_->windows.ScreenClient(*record) : RectT<std::int32_t>{};
}

void X11Platform::SetClientRect(PlatformWindow window, const RectT<std::int32_t>& rect) {
  velkcore::RequireInput(rect.width >= 0 && rect.height >= 0);
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr) return;
  const RectT<std::int32_t> relative =
      record->IsChild() ? d.windows.InParentClient(record->parent, rect) : rect;
  // Asking for the geometry the window has brings no answer to wait for.
  const bool unchanged = relative == record->client;
  d.ApplyClientRect(*record, relative);
  const auto width = static_cast<unsigned>(std::max(relative.width, 1));
  const auto height = static_cast<unsigned>(std::max(relative.height, 1));
  if (!record->IsChild() && !unchanged) {
    // The server's answers to these requests are no news.
    record->configureRequests.push_back(relative);
    while (record->configureRequests.size() > 8) record->configureRequests.pop_front();
  }
  if (!record->IsChild() && !record->overrideRedirect) {
    XSizeHints hints{};
    // Static gravity: the position asked for is the client area's, whatever the frame.
    hints.flags = USPosition | PPosition | USSize | PSize | PWinGravity;
    hints.x = relative.left;
    hints.y = relative.top;
    hints.width = static_cast<int>(width);
    hints.height = static_cast<int>(height);
    hints.win_gravity = StaticGravity;
    if (!IsResizable(record->style)) {
      hints.flags |= PMinSize | PMaxSize;
      hints.min_width = hints.max_width = static_cast<int>(width);
      hints.min_height = hints.max_height = static_cast<int>(height);
    }
    XSetWMNormalHints(d.display, window, &hints);
  }
  if (!unchanged) XMoveResizeWindow(d.display, window, relative.left, relative.top, width, height);
  XFlush(d.display);
}

RectT<std::int32_t> X11Platform::GetFrameRect(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr ? impl_->ScreenFrame(*record) : RectT<std::int32_t>{};
}

void X11Platform::SetFrameRect(PlatformWindow window, const RectT<std::int32_t>& rect) {
  const WindowRecord* record = impl_->windows.Find(window);
  if (record == nullptr) return;
  SetClientRect(window, ClientWithin(rect, record->frame));
}

// ---- Painting ----

void X11Platform::InvalidateRect(PlatformWindow window, const RectT<std::int32_t>* clientRect) {
  if (WindowRecord* record = impl_->windows.Find(window)) AddPendingArea(*record, clientRect);
}

bool X11Platform::HasPendingPaint(PlatformWindow window) const {
  const WindowRecord* record = impl_->windows.Find(window);
  return record != nullptr && impl_->windows.IsPaintable(*record);
}

std::optional<PaintTarget> X11Platform::BeginPaint(PlatformWindow window) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || !d.windows.IsPaintable(*record)) return std::nullopt;
  return platform::TakePendingPaint(*record, record->buffer->Image());
}

void X11Platform::EndPaint(PlatformWindow window, const PaintTarget& target) {
  Impl& d = *impl_;
  WindowRecord* record = d.windows.Find(window);
  if (record == nullptr || !record->buffer) return;
  record->buffer->Present(target.rects);
  const RectT<std::int32_t> whole{0, 0, record->client.width, record->client.height};
  if (std::any_of(target.rects.begin(), target.rects.end(), [&whole](const RectT<std::int32_t>& r) {
        return platform::Contains(r, whole);
      })) {
    record->buffer->MarkComplete();
  }
  // Pop-ups without a frame show their transparent corners as holes.
  if (d.shapeAvailable && (record->colorKey || record->overrideRedirect)) {
    record->buffer->ApplyShape(record->colorKey, record->overrideRedirect);
  }
  XFlush(d.display);
}

// ---- Pointer and keyboard ----

void X11Platform::SetCapture(PlatformWindow window) {
  Impl& d = *impl_;
  if (d.windows.Find(window) == nullptr || d.capture == window) return;
  if (d.capture != kNoPlatformWindow) d.Post(d.capture, kMsgCaptureLost);
  d.capture = window;
  XGrabPointer(d.display, window, False, kGrabEvents, GrabModeAsync, GrabModeAsync, None,
               d.cursors.Get(d.cursor), CurrentTime);
  XFlush(d.display);
}

void X11Platform::ReleaseCapture() {
  Impl& d = *impl_;
  const PlatformWindow old = d.capture;
  if (old == kNoPlatformWindow) return;
  d.capture = kNoPlatformWindow;
  XUngrabPointer(d.display, CurrentTime);
  XFlush(d.display);
  // The pointer may have left the window while it held the capture.
  const PlatformWindow under = d.WindowAtScreen(d.QueryPointer());
  if (under != old) d.PostLeaveIfTracked(old);
  d.hover = under;
}

PlatformWindow X11Platform::GetCapture() const {
  return impl_->capture;
}

void X11Platform::SetFocus(PlatformWindow window) {
  if (window != kNoPlatformWindow && impl_->windows.Find(window) == nullptr) return;
  impl_->SetFocus(window);
}

PlatformWindow X11Platform::GetFocus() const {
  return impl_->focus;
}

PointT<std::int32_t> X11Platform::GetPointerPosition() const {
  return impl_->QueryPointer();
}

PlatformWindow X11Platform::GetWindowFromPoint(const PointT<std::int32_t>& screenPoint) const {
  return impl_->WindowAtScreen(screenPoint);
}

void X11Platform::TrackPointerLeave(PlatformWindow window) {
  if (WindowRecord* record = impl_->windows.Find(window)) record->trackLeave = true;
}

bool X11Platform::HasPendingPointerMove(PlatformWindow window) const {
  impl_->DrainConnection();
  return platform::HasPointerMoveFor(impl_->queue, window);
}

bool X11Platform::RemovePendingCharacter(char16_t character) {
  impl_->DrainConnection();
  return platform::RemoveLeadingCharacter(impl_->queue, character);
}

KeyState X11Platform::GetKeyState(std::int16_t virtualKey) const {
  if (virtualKey <= 0 || virtualKey >= 256) return {};
  return impl_->keys[static_cast<std::size_t>(virtualKey)];
}

std::int16_t X11Platform::MapScanCodeToVirtualKey(std::uint32_t scanCode) const {
  return impl_->keyboard.VirtualKeyOfKeycode(scanCode & 0xFFu);
}

char16_t X11Platform::GetUnshiftedCharacter(std::int16_t virtualKey) const {
  return x11::UnshiftedCharacterOfVirtualKey(virtualKey);
}

std::uint32_t X11Platform::GetDoubleClickTime() const {
  return impl_->doubleClickTime;
}

PointT<std::int32_t> X11Platform::GetDoubleClickSize() const {
  return impl_->doubleClickSize;
}

void X11Platform::SetCursor(CursorShape shape) {
  if (impl_->cursor == shape) return;
  impl_->cursor = shape;
  impl_->ApplyCursor();
}

CursorShape X11Platform::GetCursor() const {
  return impl_->cursor;
}

// ---- Time and timers ----

double X11Platform::GetTime() const {
  return impl_->Now();
}

void X11Platform::SetTimer(PlatformWindow window, std::uint32_t id, std::uint32_t milliseconds) {
  if (impl_->windows.Find(window) == nullptr) return;
  impl_->timers.Set(window, id, milliseconds, impl_->Now());
}

void X11Platform::KillTimer(PlatformWindow window, std::uint32_t id) {
  impl_->timers.Kill(window, id);
}

std::vector<MonitorDescription> X11Platform::GetMonitors() const {
  Impl& d = *impl_;
  if (!d.monitorsValid) {
    d.monitors = x11::ReadMonitors(d.connection);
    d.monitorsValid = true;
  }
  return d.monitors;
}

// ---- Message queue ----

bool X11Platform::GetNextEvent(OS_Event& event, bool wait) {
  Impl& d = *impl_;
  for (;;) {
    d.DrainConnection();
    if (!d.queue.empty()) {
      QueuedMessage message = std::move(d.queue.front());
      d.queue.pop_front();
      d.UpdateKeyState(message);
      event = message.event;
      const std::uint32_t msg = event.GetMsg();
      if (msg == kMsgKeyDown || msg == kMsgSysKeyDown) d.lastKeyPress = std::move(message);
      return true;
    }
    if (d.quitPending) {
      d.quitPending = false;
      event =
          OS_Event(kNoPlatformWindow, kMsgQuit, static_cast<std::uint64_t>(d.quitCode), 0, d.Now());
      return true;
    }
    if (const std::optional<x11::TimerHeap::Tick> tick = d.timers.TakeDue(d.Now())) {
      event = OS_Event(tick->window, kMsgTimer, tick->id, 0, d.Now());
      return true;
    }
    for (const auto& [handle, record] : d.windows) {
      if (d.windows.IsPaintable(record)) {
        event = OS_Event(handle, kMsgPaint, 0, 0, d.Now());
        return true;
      }
    }
    if (!wait) return false;
    const std::optional<double> due = d.timers.NextDue();
    d.Wait(due ? std::max(0.0, *due - d.Now()) : -1.0);
  }
}

void X11Platform::TranslateEvent(const OS_Event& event) {
  Impl& d = *impl_;
  const std::uint32_t message = event.GetMsg();
  if (message != kMsgKeyDown && message != kMsgSysKeyDown) return;
  if (!d.lastKeyPress) return;
  const OS_Event& press = d.lastKeyPress->event;
  if (press.GetWindow() != event.GetWindow() || press.GetMsg() != message ||
      press.GetLParam() != event.GetLParam() || press.GetTime() != event.GetTime()) {
    return;
  }
  const std::u16string text = std::move(d.lastKeyPress->text);
  d.lastKeyPress.reset();
  const std::uint32_t charMessage = message == kMsgKeyDown ? kMsgChar : kMsgSysChar;
  for (auto it = text.rbegin(); it != text.rend(); ++it) {
    d.queue.push_front({OS_Event(event.GetWindow(), charMessage, static_cast<std::uint64_t>(*it),
                                 event.GetLParam(), d.Now()),
                        {},
                        0,
                        std::nullopt});
  }
}

void X11Platform::PostEvent(const OS_Event& event) {
  impl_->queue.push_back({event, {}, 0, std::nullopt});
}

void X11Platform::PostQuit(std::int32_t exitCode) {
  impl_->quitPending = true;
  impl_->quitCode = exitCode;
}

// ---- Clipboard ----

void X11Platform::SetClipboard(std::vector<ClipboardItem> items) {
  impl_->clipboard.Set(std::move(items));
}

std::optional<std::string> X11Platform::GetClipboard(std::string_view type) const {
  return impl_->clipboard.Get(type);
}

std::vector<std::string> X11Platform::GetClipboardTypes() const {
  return impl_->clipboard.Types();
}

// ---- Synthetic input ----

namespace x11 {

namespace {

constexpr std::string_view kNoKeyKey =
    "$$$/velkui/ui/Error/NoKeyForVirtualKey=No key of this keyboard makes the virtual key ^0.";
constexpr std::int32_t kNoKeyNumber = 60;
constexpr std::string_view kNoSyntheticInputKey =
    "$$$/velkui/ui/Error/NoSyntheticInput=Synthetic input is not available on this display (the "
    "XTEST extension is missing).";
constexpr std::int32_t kNoSyntheticInputNumber = 62;

}  // namespace

void RequireSyntheticInput(bool available) {
  if (!available) {
    velkcore::ThrowError(velkcore::ErrorLevel::kError, kNoSyntheticInputKey,
                         velkcore::kCategoryUserInterface, kNoSyntheticInputNumber);
  }
}

KeyCode RequireKeycode(Display* display, std::int16_t virtualKey, bool extended, bool numLockOn) {
  const std::optional<KeyCode> code = KeycodeOfVirtualKey(display, virtualKey, extended, numLockOn);
  if (!code) {
    velkcore::ThrowError(velkcore::ErrorLevel::kError, kNoKeyKey, velkcore::kCategoryUserInterface,
                         kNoKeyNumber, 0, static_cast<std::int32_t>(virtualKey));
  }
  return *code;
}

}  // namespace x11

using x11::RequireSyntheticInput;

void X11Platform::InjectPointerMove(const PointT<std::int32_t>& screenPoint) {
  Impl& d = *impl_;
  RequireSyntheticInput(d.xtestAvailable);
  XTestFakeMotionEvent(d.display, -1, screenPoint.x, screenPoint.y, CurrentTime);
  XSync(d.display, False);
}

void X11Platform::InjectButton(std::int32_t button, bool down) {
  velkcore::RequireInput(button == 1 || button == 2 || button == 4);
  Impl& d = *impl_;
  RequireSyntheticInput(d.xtestAvailable);
  const unsigned xButton = button == 1 ? Button1 : button == 2 ? Button2 : Button3;
  XTestFakeButtonEvent(d.display, xButton, down ? True : False, CurrentTime);
  XSync(d.display, False);
}

void X11Platform::InjectWheel(std::int32_t delta, bool horizontal) {
  Impl& d = *impl_;
  RequireSyntheticInput(d.xtestAvailable);
  // X knows whole notches only; the rest waits for the next turn.
  std::int32_t& remainder = d.wheelRemainder[horizontal ? 1 : 0];
  remainder += delta;
  const std::int32_t notches = remainder / 120;
  remainder -= notches * 120;
  const unsigned button = horizontal ? (notches > 0 ? 7u : 6u) : (notches > 0 ? 4u : 5u);
  for (std::int32_t i = 0; i < std::abs(notches); ++i) {
    XTestFakeButtonEvent(d.display, button, True, CurrentTime);
    XTestFakeButtonEvent(d.display, button, False, CurrentTime);
  }
  XSync(d.display, False);
}

void X11Platform::InjectKey(std::int16_t virtualKey, bool extended, bool down) {
  velkcore::RequireInput(virtualKey > 0 && virtualKey < 256);
  Impl& d = *impl_;
  RequireSyntheticInput(d.xtestAvailable);
  const KeyCode code =
      x11::RequireKeycode(d.display, virtualKey, extended, d.keys[vk::kNumLock].toggled);
  XTestFakeKeyEvent(d.display, code, down ? True : False, CurrentTime);
  XSync(d.display, False);
}

}  // namespace velkui::ui
