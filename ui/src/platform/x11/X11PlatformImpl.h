#pragma once

// The state of the X11 backend, shared by X11Platform.cpp (the platform
// operations) and X11Events.cpp (X events into library messages).

#include <array>
#include <chrono>
#include <deque>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>

#include "../common/KeyTable.h"
#include "../common/WindowTable.h"
#include "TimerHeap.h"
#include "X11BackBuffer.h"
#include "X11Clipboard.h"
#include "X11Connection.h"
#include "X11Cursors.h"
#include "X11Keyboard.h"
#include "X11Platform.h"
#include "XSettingsClient.h"

namespace velkui::ui::x11 {

using velkcore::PointT;
using velkcore::RectT;

using platform::Insets;

struct InputContextDeleter {
  void operator()(XIC context) const {
    if (context != nullptr) XDestroyIC(context);
  }
};
using InputContext = std::unique_ptr<std::remove_pointer_t<XIC>, InputContextDeleter>;

struct WindowRecord : platform::WindowRecordBase {
  // A pop-up without caption: placed by us, never by a window manager.
  bool overrideRedirect = false;
  // The window manager's frame around the client area.
  Insets frame;
  // Whether a window manager put the window into a frame of its own.
  bool reparented = false;
  std::unique_ptr<X11BackBuffer> buffer;
  InputContext inputContext;
  // Client rectangles asked of the server whose ConfigureNotify has not come back.
  std::deque<RectT<std::int32_t>> configureRequests;
  // An iconify request the window manager has not acted on yet, and when the
  // window was restored meanwhile (< 0: it was not); such a window is mapped
  // again when it turns iconic soon after.
  bool iconifyPending = false;
  double restoredWhileIconifying = -1.0;
};

// One message of the queue, with what the backend needs to know when it is taken.
struct QueuedMessage {
  OS_Event event;
  // Key presses: the text they type (character messages follow in TranslateEvent).
  std::u16string text;
  // Key messages: the side of a modifier, else the virtual key.
  std::int16_t sideKey = 0;
  // Input messages: the X modifier state before the event.
  std::optional<unsigned> modifierState;
};

// The "no synthetic input" error (103/62) when XTest is missing.
void RequireSyntheticInput(bool available);
// The keycode of a virtual key on `display`'s keyboard; the "no key for
// this virtual key" error (103/60) when it has none.
KeyCode RequireKeycode(Display* display, std::int16_t virtualKey, bool extended, bool numLockOn);

}  // namespace velkui::ui::x11

namespace velkui::ui {

struct X11Platform::Impl {
  template <typename T>
  using PointT = velkcore::PointT<T>;
  template <typename T>
  using RectT = velkcore::RectT<T>;

  Impl();
  ~Impl();

  // Members in the order they must be built (and the reverse of their end):
  // the windows go before the input method and the connection.
  x11::X11Connection connection;
  Display* display;
  x11::X11Keyboard keyboard;
  x11::X11Cursors cursors;
  x11::X11Clipboard clipboard;
  x11::XSettingsClient xsettings;
  platform::WindowTable<x11::WindowRecord> windows;

  // Top-level windows in the order they were last activated (latest last).
  std::vector<PlatformWindow> activationOrder;
  std::deque<x11::QueuedMessage> queue;
  std::optional<x11::QueuedMessage> lastKeyPress;
  x11::TimerHeap timers;
  PlatformWindow capture = kNoPlatformWindow;
  PlatformWindow focus = kNoPlatformWindow;
  PlatformWindow active = kNoPlatformWindow;
  PlatformWindow hover = kNoPlatformWindow;
  // The unmapped window that names our windows as one application (ICCCM
  // client leader and window group), so window managers focus and stack them
  // together.
  Window clientLeader = None;
  bool applicationActive = false;
  // When we last asked for activation ourselves (the focus may lag behind).
  double ownActivationTime = -1.0;
  bool focusCheckPending = false;
  // What GetKeyState answers (as of the messages taken) and which keycodes
  // the X server reported down.
  platform::KeyTable keys{};
  std::array<bool, 256> keycodeDown{};
  struct Press {
    PlatformWindow window = kNoPlatformWindow;
    std::int32_t button = 0;
    Time time = 0;
    PointT<std::int32_t> point;
    bool wasDouble = false;
  };
  std::optional<Press> lastPress;
  static constexpr std::uint32_t kDefaultDoubleClickTime = 500;
  static constexpr std::int32_t kDefaultDoubleClickSize = 4;
  // The X resource velkui.multiClickTime: it wins over the desktop's setting.
  std::optional<std::uint32_t> resourceDoubleClickTime;
  std::uint32_t doubleClickTime = kDefaultDoubleClickTime;
  PointT<std::int32_t> doubleClickSize{kDefaultDoubleClickSize, kDefaultDoubleClickSize};
  CursorShape cursor = CursorShape::kArrow;
  bool quitPending = false;
  std::int32_t quitCode = 0;
  std::vector<MonitorDescription> monitors;
  bool monitorsValid = false;
  int randrEventBase = -1;
  bool shapeAvailable = false;
  bool xtestAvailable = false;
  Time lastInputTime = CurrentTime;
  std::array<std::int32_t, 2> wheelRemainder{};

  // ---- Records ----
  RectT<std::int32_t> ScreenFrame(const x11::WindowRecord& record) const;

  // ---- Queue ----
  double Now() const;
  void Post(PlatformWindow window, std::uint32_t message, std::uint64_t w = 0, std::int64_t l = 0);
  void Enqueue(x11::QueuedMessage message);
  void UpdateKeyState(const x11::QueuedMessage& message);
  // `locks`: the lock keys too (not for a lock key's own messages, whose
  // state may still show the lock it is about to change).
  void SyncModifiers(unsigned state, bool locks);
  void ApplyClientRect(x11::WindowRecord& record, const RectT<std::int32_t>& relative);
  // Whether GetNextEvent would hand something out now.
  bool HasMessage();
  // Sleeps in poll() until the connection has data or `seconds` pass (< 0: no limit).
  bool Wait(double seconds);

  // ---- Activation and focus ----
  void SetFocus(PlatformWindow handle);
  void Activate(PlatformWindow handle, bool byClick, bool askServer);
  void ActivateNextAfter(PlatformWindow leaving);
  // The window that takes the activation a disabled (blocked) top-level
  // window was given from outside: the latest active top-level window that
  // is usable. kNoPlatformWindow when there is none.
  PlatformWindow UsableWindowInsteadOf(PlatformWindow blocked) const;
  void DeactivateApplication();
  void PostLeaveIfTracked(PlatformWindow handle);
  void LoseCapture();

  // ---- Pointer ----
  PlatformWindow WindowAtScreen(const PointT<std::int32_t>& point) const;
  PointT<std::int32_t> QueryPointer() const;
  PlatformWindow PointerTarget(PlatformWindow eventWindow, const PointT<std::int32_t>& eventPoint,
                               const PointT<std::int32_t>& screen) const;
  PointT<std::int32_t> ClientPoint(PlatformWindow target, PlatformWindow eventWindow,
                                   const PointT<std::int32_t>& eventPoint,
                                   const PointT<std::int32_t>& screen) const;
  void ApplyCursor();
  // The double-click time and size from the resource, the desktop's settings
  // or the defaults.
  void ApplyDoubleClickSettings();
  void CreateClientLeader();

  // ---- X events (X11Events.cpp) ----
  // Reads every event the connection has and turns it into messages.
  void DrainConnection();
  void HandleEvent(XEvent& event);
  void HandleButton(const XButtonEvent& event, bool press);
  void HandleMotion(const XMotionEvent& event);
  void HandleCrossing(const XCrossingEvent& event);
  void HandleKey(XKeyEvent& event, bool press);
  void HandleConfigure(const XConfigureEvent& event);
  void HandleExpose(const XExposeEvent& event);
  void HandleProperty(const XPropertyEvent& event);
  void HandleClientMessage(const XClientMessageEvent& event);
  void ReconcileFocus();
  void DisplayChanged();
  void ReadFrameExtentsOf(Window window, x11::Insets& frame);
  // Waits a little for the window manager's answer to _NET_REQUEST_FRAME_EXTENTS
  // (other events stay queued).
  bool WaitForFrameExtents(Window window);
  void ReadWindowState(x11::WindowRecord& record);
};

}  // namespace velkui::ui
