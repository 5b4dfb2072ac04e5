#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui {

// The library's own message table. Every backend turns its native events into
// these; OS_Window translates them identically on every backend. The comment
// of each message says what its two parameters carry (helpers below pack and
// unpack them).
enum OS_Message : std::uint32_t {
  kMsgNone = 0,
  // w: buttons held (MouseEvent bits 1 left, 2 middle, 4 right); l: client point.
  kMsgPointerMove = 1,
  kMsgLeftButtonDown = 2,
  kMsgLeftButtonUp = 3,
  kMsgLeftButtonDoubleClick = 4,
  kMsgMiddleButtonDown = 5,
  kMsgMiddleButtonUp = 6,
  kMsgMiddleButtonDoubleClick = 7,
  kMsgRightButtonDown = 8,
  kMsgRightButtonUp = 9,
  kMsgRightButtonDoubleClick = 10,
  // w: MakeWheelParam (raw delta, 120 per notch, and the buttons held);
  // l: the pointer in SCREEN coordinates. Sent to the focus window.
  kMsgWheel = 11,
  kMsgHorizontalWheel = 12,
  // The pointer left the client area (after TrackPointerLeave). No parameters.
  kMsgPointerLeft = 13,
  // w: virtual key (the generic key for Shift, Control, Alt); l: key data.
  kMsgKeyDown = 20,
  kMsgKeyUp = 21,
  // The same with Alt held (or F10).
  kMsgSysKeyDown = 22,
  kMsgSysKeyUp = 23,
  // w: one UTF-16 unit; l: the key data of the key that produced it.
  kMsgChar = 24,
  kMsgSysChar = 25,
  kMsgDeadChar = 26,
  kMsgSysDeadChar = 27,
  // The window has an area to repaint (take it with Platform::BeginPaint).
  kMsgPaint = 30,
  // w: the timer id given to Platform::SetTimer.
  kMsgTimer = 31,
  // The client area's size changed (read it from the platform). l: width and height.
  kMsgSize = 32,
  // The window moved on screen. l: the client origin in screen coordinates.
  kMsgMove = 33,
  // w: WindowActivation (0 deactivated, 1 activated, 2 activated by a click).
  kMsgActivate = 34,
  // w: 1 when the application became active, 0 when it lost activation.
  kMsgActivateApp = 35,
  // The window gained or lost the platform keyboard focus. w: the other window.
  kMsgSetFocus = 36,
  kMsgKillFocus = 37,
  // The user (or UI_PostClose) asks the window to close.
  kMsgClose = 38,
  // The window lost the pointer capture to another window or to the system.
  kMsgCaptureLost = 39,
  // The monitors changed (read them from the platform).
  kMsgDisplayChange = 40,
  // The message loop is to end. w: exit code. Window: none.
  kMsgQuit = 41,
  // First number free for a host's own posted messages.
  kMsgUser = 0x400,
};

// The event records of the platform layer.
class OS_EventBase {
 public:
  virtual ~OS_EventBase() = default;
  // Seconds on the platform clock (Platform::GetTime).
  virtual double GetTime() const = 0;
};

// One platform message addressed to one window.
class OS_Event : public OS_EventBase {
 public:
  OS_Event() = default;
  OS_Event(PlatformWindow window, std::uint32_t message, std::uint64_t wParam, std::int64_t lParam,
           double time)
      : window_(window), message_(message), wParam_(wParam), lParam_(lParam), time_(time) {}

  PlatformWindow GetWindow() const { return window_; }
  std::uint32_t GetMsg() const { return message_; }
  std::uint64_t GetWParam() const { return wParam_; }
  std::int64_t GetLParam() const { return lParam_; }
  double GetTime() const override { return time_; }

 private:
  PlatformWindow window_ = kNoPlatformWindow;
  std::uint32_t message_ = kMsgNone;
  std::uint64_t wParam_ = 0;
  std::int64_t lParam_ = 0;
  double time_ = 0;
};

// ---- Parameter packing ----

// A point (x in the low 32 bits, y in the high 32 bits, both signed).
inline std::int64_t MakePointParam(const velkcore::PointT<std::int32_t>& p) {
  return static_cast<std::int64_t>(
      (static_cast<std::uint64_t>(static_cast<std::uint32_t>(p.y)) << 32) |
      static_cast<std::uint32_t>(p.x));
}
inline velkcore::PointT<std::int32_t> GetPointParam(std::int64_t param) {
  const auto bits = static_cast<std::uint64_t>(param);
  return {static_cast<std::int32_t>(static_cast<std::uint32_t>(bits & 0xFFFFFFFFu)),
          static_cast<std::int32_t>(static_cast<std::uint32_t>(bits >> 32))};
}

// The wheel's raw delta (low 32 bits, signed) and the buttons held (above).
inline std::uint64_t MakeWheelParam(std::int32_t delta, std::int32_t buttonsHeld) {
  return (static_cast<std::uint64_t>(static_cast<std::uint32_t>(buttonsHeld)) << 32) |
         static_cast<std::uint32_t>(delta);
}
inline std::int32_t GetWheelDelta(std::uint64_t param) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(param & 0xFFFFFFFFu));
}
inline std::int32_t GetWheelButtons(std::uint64_t param) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(param >> 32));
}

// Key data of key and character messages: bits 0-15 repeat count, 16-23 the
// scan code (the backend's own key number, Platform::MapScanCodeToVirtualKey
// maps it back), 24 an extended key, 29 Alt held, 30 the key was already down
// (auto-repeat; always set for releases), 31 the key is being released.
struct KeyData {
  std::uint32_t repeatCount = 1;
  std::uint32_t scanCode = 0;
  bool extended = false;
  bool altHeld = false;
  bool previouslyDown = false;
  bool releasing = false;
};

inline std::int64_t MakeKeyParam(const KeyData& data) {
  std::uint32_t bits = data.repeatCount & 0xFFFFu;
  bits |= (data.scanCode & 0xFFu) << 16;
  if (data.extended) bits |= 1u << 24;
  if (data.altHeld) bits |= 1u << 29;
  if (data.previouslyDown) bits |= 1u << 30;
  if (data.releasing) bits |= 1u << 31;
  return static_cast<std::int64_t>(bits);
}
inline KeyData GetKeyParam(std::int64_t param) {
  const auto bits = static_cast<std::uint32_t>(static_cast<std::uint64_t>(param) & 0xFFFFFFFFu);
  KeyData data;
  data.repeatCount = bits & 0xFFFFu;
  data.scanCode = (bits >> 16) & 0xFFu;
  data.extended = (bits & (1u << 24)) != 0;
  data.altHeld = (bits & (1u << 29)) != 0;
  data.previouslyDown = (bits & (1u << 30)) != 0;
  data.releasing = (bits & (1u << 31)) != 0;
  return data;
}

inline bool IsPointerMessage(std::uint32_t message) {
  return message >= kMsgPointerMove && message <= kMsgPointerLeft;
}
inline bool IsKeyboardMessage(std::uint32_t message) {
  return message >= kMsgKeyDown && message <= kMsgSysDeadChar;
}
inline bool IsCharacterMessage(std::uint32_t message) {
  return message >= kMsgChar && message <= kMsgSysDeadChar;
}

}  // namespace velkui::ui
