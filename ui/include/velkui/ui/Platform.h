#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>
#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui {

// The window system, as the library sees it: every operation that windows,
// the node manager, timers, tooltips, preferences, text fields, menus and the
// automation player need. Two backends implement it (ui/src/platform/headless
// and ui/src/platform/x11); the one in use is chosen once at start-up
// (CreatePlatformFromEnvironment, VELKUI_PLATFORM=x11|headless) and installed
// by PlatformSession. Everything above this interface is backend-neutral.
//
// Conventions for backends
// - Coordinates are integer pixels. "Screen" is the plane of all monitors;
//   "client" is a window's client area with (0, 0) at its top-left. Client
//   rectangles are reported and set in screen coordinates, for child windows
//   too (a child keeps its place relative to its parent when the parent moves).
//   Setters take effect at once for the getters (OS_Window reads the result
//   back right away): a backend keeps its own record and, when the window
//   manager answers differently later, reports that with kMsgSize/kMsgMove.
//   A backend may also report the library's own changes that way; windows
//   ignore a report that matches what they have.
// - Handles: OS_Window maps handles back to windows itself (UI_GetWindow);
//   the backend needs no pointer to it. Messages for a destroyed window are
//   dropped. Windows of other applications are never reported (the pointer
//   over one is over "no window").
// - Events. The backend turns native events into OS_Events (OS_Event.h lists
//   the messages and their parameters) and hands them out one by one through
//   GetNextEvent, in this order of priority: queued messages (input, posted
//   messages, activation, size, focus...), then the quit request, then timers
//   that are due, then paints of windows with a pending area. Input goes to:
//   pointer messages to the window under the pointer (client area only) or to
//   the capture window; wheel messages and key messages to the focus window
//   (OS_Window forwards the wheel to the window under the pointer). The key
//   state (GetKeyState) reflects the messages taken from the queue so far, so
//   that a handler sees the state as of its own message.
// - Pointer moves: a backend may coalesce them itself; OS_Window also drops a
//   move when HasPendingPointerMove says a newer one waits. After
//   TrackPointerLeave the window gets one kMsgPointerLeft when the pointer
//   leaves its client area (not while it holds the capture).
// - Double clicks are the backend's: a press of the same button in the same
//   window within GetDoubleClickTime of the previous press and within half
//   GetDoubleClickSize of it is reported as kMsg*DoubleClick (the press after
//   a double click is an ordinary press again).
// - Keys: wParam is the virtual key in the desktop numbering (PlatformTypes.h,
//   vk::); extended keys (the navigation block, keypad Enter and '/', right
//   Control and Alt, Num Lock...) set the extended bit of the key data; a key
//   held with Alt (and not Control) is a kMsgSys* message. TranslateEvent
//   produces the character message of a key press (printable or control
//   character, e.g. 9 for Tab, 13 for Return, Ctrl+A -> 1) and queues it so
//   that it is the next message taken. With Num Lock on and Shift held, the
//   keypad reports navigation keys (non-extended), as the desktop does.
// - Activation: one top-level window is active; activating another sends
//   kMsgActivate (0) to the old one and (1, or 2 when by a click) to the new
//   one, plus kMsgActivateApp when the application as a whole gains or loses
//   activation. The keyboard focus follows with kMsgKillFocus/kMsgSetFocus.
//   Windows with kExStyleNoActivate are never activated.
// - Paint: InvalidateRect accumulates the pending area; one kMsgPaint comes
//   when the queue is otherwise idle; BeginPaint hands the area out (and
//   clears it), EndPaint puts the pixels on screen.
// - Timers tick through kMsgTimer; an interval below 10 ms counts as 10 ms, and
//   at most one tick per timer waits in the queue.
// - GetNextEvent with `wait` blocks until a message arrives (the x11 backend:
//   on the connection and the next timer); the headless backend never blocks
//   and answers false when it has nothing, so that no modal loop can hang a test.
// - Failures to create a platform object raise velkcore errors; operations on
//   a window that no longer exists do nothing (or answer a neutral value).
// - Adding a backend: implement this class under ui/src/platform/<name>/ and
//   return it from CreatePlatform (ui/src/platform/PlatformFactory.cpp), the
//   one place where backends are chosen. Nothing above this interface changes.
class Platform {
 public:
  Platform();
  virtual ~Platform();
  Platform(const Platform&) = delete;
  Platform& operator=(const Platform&) = delete;

  // "x11" or "headless".
  virtual std::string_view GetName() const = 0;

  // ---- Windows ----
  // Creates a hidden window unless params.style has kStyleVisible.
  virtual PlatformWindow CreateWindow(const WindowCreateParams& params) = 0;
  // Destroys the window and its child windows; their queued messages are dropped.
  virtual void DestroyWindow(PlatformWindow window) = 0;
  virtual bool IsWindow(PlatformWindow window) const = 0;
  virtual void SetWindowTitle(PlatformWindow window, const velkcore::UTF16String& title) = 0;
  virtual velkcore::UTF16String GetWindowTitle(PlatformWindow window) const = 0;
  // Showing a top-level window activates it when `activate` is set.
  virtual void ShowWindow(PlatformWindow window, bool show, bool activate) = 0;
  // The window's own shown state (a child of a hidden parent may answer true).
  virtual bool IsWindowVisible(PlatformWindow window) const = 0;
  virtual void MinimizeWindow(PlatformWindow window, bool minimize) = 0;
  virtual bool IsWindowMinimized(PlatformWindow window) const = 0;
  // Activates the top-level window of `window` (and gives it the focus).
  virtual void ActivateWindow(PlatformWindow window, bool byClick) = 0;
  virtual PlatformWindow GetActiveWindow() const = 0;
  // A disabled window gets no input.
  virtual void EnableWindow(PlatformWindow window, bool enable) = 0;
  virtual bool IsWindowEnabled(PlatformWindow window) const = 0;
  // 0 (invisible) .. 1 (opaque).
  virtual void SetWindowOpacity(PlatformWindow window, float opacity) = 0;
  // Pixels of this colour become transparent; none switches it off.
  virtual void SetTransparentColorKey(PlatformWindow window,
                                      const std::optional<pictel::ColorRGBA>& key) = 0;
  // Moves a child window into another parent (keeping its client rectangle's
  // size; its position stays relative to the new parent).
  virtual void SetWindowParent(PlatformWindow window, PlatformWindow parent) = 0;
  virtual PlatformWindow GetWindowParent(PlatformWindow window) const = 0;

  // ---- Geometry ----
  // The client area in screen coordinates.
  virtual velkcore::RectT<std::int32_t> GetClientRect(PlatformWindow window) const = 0;
  virtual void SetClientRect(PlatformWindow window, const velkcore::RectT<std::int32_t>& rect) = 0;
  // The outer frame (decoration included) in screen coordinates.
  virtual velkcore::RectT<std::int32_t> GetFrameRect(PlatformWindow window) const = 0;
  virtual void SetFrameRect(PlatformWindow window, const velkcore::RectT<std::int32_t>& rect) = 0;

  // ---- Painting ----
  // Adds `clientRect` (null: the whole client area) to the pending area.
  virtual void InvalidateRect(PlatformWindow window,
                              const velkcore::RectT<std::int32_t>* clientRect) = 0;
  virtual bool HasPendingPaint(PlatformWindow window) const = 0;
  // Takes the pending area; none when there is nothing to paint (or the
  // window is hidden or empty).
  virtual std::optional<PaintTarget> BeginPaint(PlatformWindow window) = 0;
  virtual void EndPaint(PlatformWindow window, const PaintTarget& target) = 0;

  // ---- Pointer and keyboard ----
  virtual void SetCapture(PlatformWindow window) = 0;
  virtual void ReleaseCapture() = 0;
  virtual PlatformWindow GetCapture() const = 0;
  virtual void SetFocus(PlatformWindow window) = 0;
  virtual PlatformWindow GetFocus() const = 0;
  // Screen coordinates.
  virtual velkcore::PointT<std::int32_t> GetPointerPosition() const = 0;
  // The deepest shown window whose client area holds `screenPoint`, or none.
  virtual PlatformWindow GetWindowFromPoint(
      const velkcore::PointT<std::int32_t>& screenPoint) const = 0;
  // Asks for one kMsgPointerLeft when the pointer leaves the client area.
  virtual void TrackPointerLeave(PlatformWindow window) = 0;
  // Whether a pointer move for `window` waits in the queue.
  virtual bool HasPendingPointerMove(PlatformWindow window) const = 0;
  // Drops the first waiting keyboard message when it is the character
  // message of `character` (the character of a key just handled); any other
  // keyboard message first means typed-ahead input, and nothing is dropped.
  virtual bool RemovePendingCharacter(char16_t character) = 0;
  // By virtual key; vk::kLeftShift..vk::kRightAlt tell the sides apart.
  virtual KeyState GetKeyState(std::int16_t virtualKey) const = 0;
  // The virtual key of a scan code of the key data (the generic key for modifiers).
  virtual std::int16_t MapScanCodeToVirtualKey(std::uint32_t scanCode) const = 0;
  // The printable character a key makes without modifiers (letters in upper
  // case), or 0 for keys without one (control keys included).
  virtual char16_t GetUnshiftedCharacter(std::int16_t virtualKey) const = 0;
  // Milliseconds.
  virtual std::uint32_t GetDoubleClickTime() const = 0;
  // Width and height of the rectangle around a press within which the next
  // press counts as a double click.
  virtual velkcore::PointT<std::int32_t> GetDoubleClickSize() const = 0;
  virtual void SetCursor(CursorShape shape) = 0;
  virtual CursorShape GetCursor() const = 0;

  // ---- Time and timers ----
  // Seconds on a monotonic clock (the headless backend's clock is virtual).
  virtual double GetTime() const = 0;
  // Starts or restarts timer `id` of `window`: kMsgTimer every `milliseconds`.
  virtual void SetTimer(PlatformWindow window, std::uint32_t id, std::uint32_t milliseconds) = 0;
  // Stops it and drops a waiting tick.
  virtual void KillTimer(PlatformWindow window, std::uint32_t id) = 0;

  // ---- Monitors ----
  // At least one monitor, in the platform's enumeration order.
  virtual std::vector<MonitorDescription> GetMonitors() const = 0;

  // ---- Message queue ----
  // The next message; false when there is none (without `wait`, or always
  // when the headless queue is empty). A quit request comes as kMsgQuit.
  virtual bool GetNextEvent(OS_Event& event, bool wait) = 0;
  // Produces the character message of a key message (see above).
  virtual void TranslateEvent(const OS_Event& event) = 0;
  // Appends a message for its window to the queue.
  virtual void PostEvent(const OS_Event& event) = 0;
  // Asks every message loop to end; kMsgQuit comes once the queue is idle.
  virtual void PostQuit(std::int32_t exitCode) = 0;

  // ---- Clipboard ----
  virtual void SetClipboard(std::vector<ClipboardItem> items) = 0;
  virtual std::optional<std::string> GetClipboard(std::string_view type) const = 0;
  virtual std::vector<std::string> GetClipboardTypes() const = 0;

  // ---- Synthetic input (the automation player) ----
  // Played input takes the same road as real input.
  virtual void InjectPointerMove(const velkcore::PointT<std::int32_t>& screenPoint) = 0;
  // `button`: MouseEvent bits 1 left, 2 middle, 4 right.
  virtual void InjectButton(std::int32_t button, bool down) = 0;
  virtual void InjectWheel(std::int32_t delta, bool horizontal) = 0;
  virtual void InjectKey(std::int16_t virtualKey, bool extended, bool down) = 0;

  // ---- Derived helpers (not backend-specific) ----
  // Shift 0x02 and Control 0x04 held, Caps Lock 0x08 on, Alt 0x10 held.
  ModifierKeys GetModifierKeys() const;
  // The quit state, set by the message pump when it takes kMsgQuit.
  bool IsQuitting() const { return quitting_; }
  std::int32_t GetExitCode() const { return exitCode_; }
  void SetQuitting(std::int32_t exitCode);
  void ClearQuitting() { quitting_ = false; }

 private:
  bool quitting_ = false;
  std::int32_t exitCode_ = 0;
};

// The installed platform; the input-contract violation when there is none.
Platform& GetPlatform();
// Null when none is installed.
Platform* GetPlatformIfAny();
// Installs `platform` (not owned; null uninstalls). PlatformSession calls it.
void SetPlatform(Platform* platform);

// The backend for this process, from VELKUI_PLATFORM ("x11" or "headless";
// without it: x11 when DISPLAY is set, else headless). A backend this build
// does not have, or an unknown name, raises an error that says so: there is
// no silent fallback.
std::unique_ptr<Platform> CreatePlatformFromEnvironment();
// The backend of that name (the same errors).
std::unique_ptr<Platform> CreatePlatform(std::string_view name);

// Sets the pointer shape through the installed platform (nothing without one).
void OS_SetCursor(CursorShape shape);

}  // namespace velkui::ui
