// X events into library messages: input, exposure, geometry reported by the
// server or the window manager, focus, selection and monitor changes.
#include <X11/Xatom.h>
#include <X11/extensions/Xrandr.h>
#include "X11Headers.h"

#include <algorithm>
#include <cstdlib>

#include "X11PlatformImpl.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;
using x11::QueuedMessage;
using x11::WindowRecord;

namespace {

constexpr double kActivationGrace = 0.5;

std::int32_t ButtonsHeld(unsigned state) {
  std::int32_t held = 0;
  if ((state & Button1Mask) != 0) held |= 1;
  if ((state & Button2Mask) != 0) held |= 2;
  if ((state & Button3Mask) != 0) held |= 4;
  return held;
}

std::int32_t LibraryButton(unsigned xButton) {
  switch (xButton) {
    case Button1:
      return 1;
    case Button2:
      return 2;
    case Button3:
      return 4;
    default:
      return 0;
  }
}

std::uint32_t ButtonMessage(std::int32_t button, int kind) {
  // kind: 0 down, 1 up, 2 double click.
  const std::uint32_t base = button == 1   ? kMsgLeftButtonDown
                             : button == 2 ? kMsgMiddleButtonDown
                                           : kMsgRightButtonDown;
  return base + static_cast<std::uint32_t>(kind);
}

}  // namespace

void X11Platform::Impl::DrainConnection() {
  while (XPending(display) > 0) {
    XEvent event;
    XNextEvent(display, &event);
    // The input method sees everything first and may keep key presses.
    if (XFilterEvent(&event, None)) continue;
    HandleEvent(event);
  }
  if (focusCheckPending) ReconcileFocus();
}

void X11Platform::Impl::HandleEvent(XEvent& event) {
  if (clipboard.HandleEvent(event)) return;
  if (xsettings.HandleEvent(event)) {
    ApplyDoubleClickSettings();
    return;
  }
  if (randrEventBase >= 0 && event.type == randrEventBase + RRScreenChangeNotify) {
    XRRUpdateConfiguration(&event);
    DisplayChanged();
    return;
  }
  switch (event.type) {
    case ButtonPress:
    case ButtonRelease:
      HandleButton(event.xbutton, event.type == ButtonPress);
      break;
    case MotionNotify:
      HandleMotion(event.xmotion);
      break;
    case EnterNotify:
    case LeaveNotify:
      HandleCrossing(event.xcrossing);
      break;
    case KeyPress:
    case KeyRelease:
      HandleKey(event.xkey, event.type == KeyPress);
      break;
    case KeymapNotify:
      for (std::size_t code = 0; code < keycodeDown.size(); ++code) {
        keycodeDown[code] = (event.xkeymap.key_vector[code / 8] & (1 << (code % 8))) != 0;
      }
      break;
    case MappingNotify:
      if (event.xmapping.request != MappingPointer) keyboard.RefreshMapping(event.xmapping);
      break;
    case Expose:
      HandleExpose(event.xexpose);
      break;
    case ConfigureNotify:
      HandleConfigure(event.xconfigure);
      break;
    case ReparentNotify:
      if (WindowRecord* record = windows.Find(event.xreparent.window)) {
        if (!record->IsChild()) record->reparented = event.xreparent.parent != connection.Root();
      }
      break;
    case UnmapNotify:
      // Iconified by the window manager, say: an unmapped window keeps no capture.
      if (capture != kNoPlatformWindow && windows.IsWithin(capture, event.xunmap.window))
        LoseCapture();
      break;
    case FocusIn:
    case FocusOut:
      if (event.xfocus.mode == NotifyNormal || event.xfocus.mode == NotifyWhileGrabbed) {
        focusCheckPending = true;
      }
      break;
    case PropertyNotify:
      HandleProperty(event.xproperty);
      break;
    case ClientMessage:
      HandleClientMessage(event.xclient);
      break;
    default:
      break;
  }
}

// ---- Pointer ----

void X11Platform::Impl::HandleButton(const XButtonEvent& event, bool press) {
  lastInputTime = event.time;
  if (windows.Find(event.window) == nullptr) return;
  const PointT<std::int32_t> screen{event.x_root, event.y_root};
  const PointT<std::int32_t> at{event.x, event.y};
  if (event.button >= 4 && event.button <= 7) {
    // Wheel notches come as presses (and releases, which say nothing more).
    if (!press) return;
    const bool horizontal = event.button >= 6;
    const std::int32_t delta = event.button == 4 || event.button == 7 ? 120 : -120;
    PlatformWindow target = focus != kNoPlatformWindow ? focus : active;
    if (!windows.IsEnabledForInput(target)) target = PointerTarget(event.window, at, screen);
    if (target == kNoPlatformWindow) return;
    Enqueue(
        {OS_Event(target, horizontal ? kMsgHorizontalWheel : kMsgWheel,
                  MakeWheelParam(delta, ButtonsHeld(event.state)), MakePointParam(screen), Now()),
         {},
         0,
         event.state});
    return;
  }
  const std::int32_t button = LibraryButton(event.button);
  if (button == 0) return;
  const std::int32_t held =
      press ? (ButtonsHeld(event.state) | button) : (ButtonsHeld(event.state) & ~button);
  const PlatformWindow target = PointerTarget(event.window, at, screen);
  if (target == kNoPlatformWindow) {
    if (press) lastPress.reset();
    return;
  }
  const PointT<std::int32_t> client = ClientPoint(target, event.window, at, screen);
  int kind = press ? 0 : 1;
  if (press) {
    // X has no double click: a second press of the same button, soon and
    // near enough, is one.
    const bool isDouble =
        lastPress && lastPress->window == target && lastPress->button == button &&
        !lastPress->wasDouble &&
        static_cast<Time>(event.time - lastPress->time) < static_cast<Time>(doubleClickTime) &&
        std::abs(screen.x - lastPress->point.x) <= doubleClickSize.x / 2 &&
        std::abs(screen.y - lastPress->point.y) <= doubleClickSize.y / 2;
    lastPress = Press{target, button, event.time, screen, isDouble};
    if (isDouble) kind = 2;
  }
  Enqueue({OS_Event(target, ButtonMessage(button, kind), static_cast<std::uint64_t>(held),
                    MakePointParam(client), Now()),
           {},
           0,
           event.state});
}

void X11Platform::Impl::HandleMotion(const XMotionEvent& event) {
  lastInputTime = event.time;
  if (windows.Find(event.window) == nullptr) return;
  const PointT<std::int32_t> screen{event.x_root, event.y_root};
  const PointT<std::int32_t> at{event.x, event.y};
  const PlatformWindow target = PointerTarget(event.window, at, screen);
  if (capture == kNoPlatformWindow) {
    const PlatformWindow under = target;
    if (hover != kNoPlatformWindow && hover != under) PostLeaveIfTracked(hover);
    hover = under;
  }
  if (target == kNoPlatformWindow) return;
  const OS_Event move(target, kMsgPointerMove, static_cast<std::uint64_t>(ButtonsHeld(event.state)),
                      MakePointParam(ClientPoint(target, event.window, at, screen)), Now());
  // Coalescing: a newer move replaces the one still waiting at the end.
  if (!queue.empty() && queue.back().event.GetMsg() == kMsgPointerMove &&
      queue.back().event.GetWindow() == target) {
    queue.back() = {move, {}, 0, event.state};
    return;
  }
  Enqueue({move, {}, 0, event.state});
}

void X11Platform::Impl::HandleCrossing(const XCrossingEvent& event) {
  if (windows.Find(event.window) == nullptr) return;
  // Crossings that a grab of ours causes are not the pointer leaving.
  if (event.mode == NotifyGrab) return;
  if (event.type == EnterNotify) {
    if (capture == kNoPlatformWindow && event.detail != NotifyInferior) hover = event.window;
    return;
  }
  if (event.window == capture) return;
  PostLeaveIfTracked(event.window);
  if (hover == event.window) hover = kNoPlatformWindow;
}

// ---- Keyboard ----

void X11Platform::Impl::HandleKey(XKeyEvent& event, bool press) {
  lastInputTime = event.time;
  const auto code = static_cast<std::size_t>(event.keycode & 0xFFu);
  const bool wasDown = keycodeDown[code];
  keycodeDown[code] = press;
  PlatformWindow target = focus != kNoPlatformWindow ? focus : active;
  if (!windows.IsEnabledForInput(target)) target = kNoPlatformWindow;
  const x11::KeyIdentity key = keyboard.Identify(event.keycode, event.state);
  std::u16string text;
  if (press) {
    const WindowRecord* top =
        windows.Find(windows.TopLevelOf(target != kNoPlatformWindow ? target : event.window));
    text = keyboard.TextOf(event, top != nullptr ? top->inputContext.get() : nullptr, key);
  }
  if (target == kNoPlatformWindow) return;
  const bool isControlKey = key.virtualKey == vk::kControl;
  const bool control = isControlKey ? press : (event.state & ControlMask) != 0;
  // The Alt key counts as held for its own press and release.
  const bool alt = key.virtualKey == vk::kAlt || (event.state & Mod1Mask) != 0;
  const bool system = (alt || key.virtualKey == vk::kF10) && !control;
  KeyData data;
  data.scanCode = static_cast<std::uint32_t>(code);
  data.extended = key.extended;
  data.altHeld = alt && !control;
  data.previouslyDown = press ? wasDown : true;
  data.releasing = !press;
  if (key.virtualKey == 0) {
    // Text from the input method that no key of ours made.
    for (const char16_t c : text) {
      Enqueue({OS_Event(target, kMsgChar, c, MakeKeyParam(data), Now()), {}, 0, std::nullopt});
    }
    return;
  }
  const std::uint32_t message =
      press ? (system ? kMsgSysKeyDown : kMsgKeyDown) : (system ? kMsgSysKeyUp : kMsgKeyUp);
  Enqueue({OS_Event(target, message, static_cast<std::uint64_t>(key.virtualKey), MakeKeyParam(data),
                    Now()),
           std::move(text), key.sideKey, event.state});
}

// ---- Painting and geometry ----

void X11Platform::Impl::HandleExpose(const XExposeEvent& event) {
  WindowRecord* record = windows.Find(event.window);
  if (record == nullptr) return;
  const RectT<std::int32_t> area{event.x, event.y, event.width, event.height};
  // A complete back buffer answers at once; otherwise the area is painted anew.
  if (record->buffer && record->buffer->IsComplete()) {
    record->buffer->Present({area});
  } else {
    platform::AddPendingArea(*record, &area);
  }
}

void X11Platform::Impl::HandleConfigure(const XConfigureEvent& event) {
  WindowRecord* record = windows.Find(event.window);
  if (record == nullptr || record->IsChild()) return;
  RectT<std::int32_t> reported{event.x, event.y, event.width, event.height};
  if (record->reparented && !event.send_event) {
    // Relative to the window manager's frame: ask where that puts it.
    Window ignored = None;
    XTranslateCoordinates(display, record->handle, connection.Root(), 0, 0, &reported.left,
                          &reported.top, &ignored);
  }
  auto& requests = record->configureRequests;
  const auto echoed = std::find(requests.begin(), requests.end(), reported);
  if (echoed != requests.end()) {
    requests.erase(requests.begin(), echoed + 1);
    // A later request is on its way; its answer settles the matter.
    if (!requests.empty()) return;
  }
  // An X window is never empty, so a window we keep at 0 pixels reports 1.
  if (record->client.width == 0 && reported.width == 1) reported.width = 0;
  if (record->client.height == 0 && reported.height == 1) reported.height = 0;
  const RectT<std::int32_t> before = record->client;
  if (before == reported) return;
  requests.clear();
  ApplyClientRect(*record, reported);
  if (before.width != reported.width || before.height != reported.height) {
    Post(record->handle, kMsgSize, 0, MakePointParam({reported.width, reported.height}));
  }
  if (before.left != reported.left || before.top != reported.top) {
    Post(record->handle, kMsgMove, 0, MakePointParam({reported.left, reported.top}));
  }
}

void X11Platform::Impl::ReadFrameExtentsOf(Window window, x11::Insets& frame) {
  Atom type = None;
  int format = 0;
  unsigned long count = 0;
  unsigned long after = 0;
  unsigned char* data = nullptr;
  if (XGetWindowProperty(display, window, connection.Atoms().netFrameExtents, 0, 4, False,
                         XA_CARDINAL, &type, &format, &count, &after, &data) == Success &&
      data != nullptr && format == 32 && count == 4) {
    const auto* values = reinterpret_cast<const long*>(data);
    frame = {static_cast<std::int32_t>(values[0]), static_cast<std::int32_t>(values[1]),
             static_cast<std::int32_t>(values[2]), static_cast<std::int32_t>(values[3])};
  }
  if (data != nullptr) XFree(data);
}

namespace {
// How long after a restore the window manager's late iconify still counts as
// the one we asked for before it.
constexpr double kIconifyRaceSeconds = 2.0;
}  // namespace

void X11Platform::Impl::ReadWindowState(WindowRecord& record) {
  Atom type = None;
  int format = 0;
  unsigned long count = 0;
  unsigned long after = 0;
  unsigned char* data = nullptr;
  const Atom wmState = connection.Atoms().wmState;
  if (XGetWindowProperty(display, record.handle, wmState, 0, 2, False, wmState, &type, &format,
                         &count, &after, &data) == Success &&
      data != nullptr && format == 32 && count >= 1) {
    const long state = reinterpret_cast<const long*>(data)[0];
    // Late enough, the iconify is the user's own (a window manager that
    // ignored ours may act on the user's button).
    const bool undoIconify = state == IconicState && record.iconifyPending &&
                             record.restoredWhileIconifying >= 0 &&
                             Now() - record.restoredWhileIconifying < kIconifyRaceSeconds;
    if (state == IconicState) {
      record.iconifyPending = false;
      record.restoredWhileIconifying = -1.0;
    }
    if (undoIconify) {
      if (record.visible && !record.minimized) XMapRaised(display, record.handle);
    } else if (state == IconicState && !record.minimized) {
      record.minimized = true;
      if (active == record.handle) ActivateNextAfter(record.handle);
    } else if (state == NormalState && record.minimized) {
      record.minimized = false;
      platform::AddPendingArea(record, nullptr);
    }
  }
  if (data != nullptr) XFree(data);
}

void X11Platform::Impl::HandleProperty(const XPropertyEvent& event) {
  const x11::X11Atoms& atoms = connection.Atoms();
  if (event.window == connection.Root()) {
    if (event.atom == atoms.netWorkarea || event.atom == atoms.netCurrentDesktop) DisplayChanged();
    if (event.atom == atoms.netSupportingWmCheck) connection.RefreshWindowManager();
    return;
  }
  WindowRecord* record = windows.Find(event.window);
  if (record == nullptr) return;
  if (event.atom == atoms.netFrameExtents) ReadFrameExtentsOf(record->handle, record->frame);
  if (event.atom == atoms.wmState) ReadWindowState(*record);
}

void X11Platform::Impl::HandleClientMessage(const XClientMessageEvent& event) {
  const x11::X11Atoms& atoms = connection.Atoms();
  if (event.message_type != atoms.wmProtocols || event.format != 32) return;
  const auto protocol = static_cast<Atom>(event.data.l[0]);
  if (protocol == atoms.wmDeleteWindow) {
    if (windows.Find(event.window) != nullptr) Post(event.window, kMsgClose);
  } else if (protocol == atoms.netWmPing) {
    XClientMessageEvent pong = event;
    pong.window = connection.Root();
    XSendEvent(display, connection.Root(), False, SubstructureNotifyMask | SubstructureRedirectMask,
               reinterpret_cast<XEvent*>(&pong));
  }
}

// ---- Focus ----

void X11Platform::Impl::ReconcileFocus() {
  focusCheckPending = false;
  Window focused = None;
  int revert = 0;
  XGetInputFocus(display, &focused, &revert);
  const PlatformWindow top =
      windows.Find(focused) != nullptr ? windows.TopLevelOf(focused) : kNoPlatformWindow;
  if (top != kNoPlatformWindow) {
    const WindowRecord* record = windows.Find(top);
    if (top != active && record->visible && (record->exStyle & kExStyleNoActivate) == 0) {
      // A window blocked by a modal run (the user clicked it, and the window
      // manager focused it) hands the activation, and the server's focus, to
      // the window that is in use.
      const PlatformWindow usable = record->enabled ? top : UsableWindowInsteadOf(top);
      if (usable == kNoPlatformWindow || usable == top) {
        Activate(top, false, false);
      } else {
        Activate(usable, false, true);
      }
    }
    return;
  }
  // The focus went to another application (unless it is still on its way to us).
  if (active != kNoPlatformWindow && Now() - ownActivationTime > kActivationGrace) {
    DeactivateApplication();
  }
}

void X11Platform::Impl::DisplayChanged() {
  monitorsValid = false;
  for (const PlatformWindow window : windows.TopLevels()) Post(window, kMsgDisplayChange);
}

}  // namespace velkui::ui
