#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>

// Value types shared by the platform layer (Platform.h), its backends and the
// window classes.

namespace velkui::ui {

// A platform window: an X11 window id, a record number of the headless
// backend. kNoPlatformWindow stands for "none" and, as a parent, for the desktop.
using PlatformWindow = std::uintptr_t;
inline constexpr PlatformWindow kNoPlatformWindow = 0;
// A platform menu; the library draws its menus itself, so windows have none.
using PlatformMenu = std::uintptr_t;
inline constexpr PlatformMenu kNoPlatformMenu = 0;

// Window styles, in the desktop numbering that the library's dialogs and
// archives use. Backends map them onto their window system: a child window
// lives inside its parent's client area; a pop-up without caption has no
// decoration (override-redirect on X11); a caption or sizing frame asks the
// window manager for a title bar and borders.
inline constexpr std::uint32_t kStylePopup = 0x80000000u;
inline constexpr std::uint32_t kStyleChild = 0x40000000u;
inline constexpr std::uint32_t kStyleMinimize = 0x20000000u;
inline constexpr std::uint32_t kStyleVisible = 0x10000000u;
inline constexpr std::uint32_t kStyleDisabled = 0x08000000u;
inline constexpr std::uint32_t kStyleClipSiblings = 0x04000000u;
inline constexpr std::uint32_t kStyleClipChildren = 0x02000000u;
inline constexpr std::uint32_t kStyleCaption = 0x00C00000u;
inline constexpr std::uint32_t kStyleSystemMenu = 0x00080000u;
inline constexpr std::uint32_t kStyleSizingFrame = 0x00040000u;
inline constexpr std::uint32_t kStyleMinimizeBox = 0x00020000u;
inline constexpr std::uint32_t kStyleMaximizeBox = 0x00010000u;
inline constexpr std::uint32_t kStyleModalFrame = 0x00000080u;
// An ordinary resizable top-level window.
inline constexpr std::uint32_t kStyleOverlappedWindow =
    kStyleCaption | kStyleSystemMenu | kStyleSizingFrame | kStyleMinimizeBox | kStyleMaximizeBox;

inline constexpr std::uint32_t kExStyleModalFrame = 0x00000001u;
inline constexpr std::uint32_t kExStyleTopmost = 0x00000008u;
inline constexpr std::uint32_t kExStyleToolWindow = 0x00000080u;
inline constexpr std::uint32_t kExStyleWindowEdge = 0x00000100u;
inline constexpr std::uint32_t kExStyleControlParent = 0x00010000u;
inline constexpr std::uint32_t kExStyleLayered = 0x00080000u;
// Showing or clicking the window does not activate it (tooltips, menus).
inline constexpr std::uint32_t kExStyleNoActivate = 0x08000000u;

// What a backend needs to create a window.
struct WindowCreateParams {
  velkcore::UTF16String title;
  // For a child window (kStyleChild) its parent, which must exist; for any
  // other window its owner (kNoPlatformWindow: none, the desktop).
  PlatformWindow parent = kNoPlatformWindow;
  // The outer frame in screen pixels (for a child window: its client area in
  // screen pixels; children have no frame). Sizes must not be negative.
  velkcore::RectT<std::int32_t> frame;
  std::uint32_t style = kStyleOverlappedWindow;
  std::uint32_t exStyle = 0;
};

// One display in the platform's enumeration order, in screen pixels.
struct MonitorDescription {
  velkcore::RectT<std::int32_t> bounds;
  // The part not taken by panels and docks.
  velkcore::RectT<std::int32_t> workArea;
  // Stable for as long as the display is attached (an XRandR output id, say).
  std::uintptr_t id = 0;
  bool primary = false;

  friend bool operator==(const MonitorDescription&, const MonitorDescription&) = default;
};

// Pointer shapes.
enum class CursorShape : std::int32_t {
  kArrow = 0,
  kIBeam = 1,
  kWait = 2,
  kCrosshair = 3,
  kHand = 4,
  kSizeNS = 5,
  kSizeWE = 6,
  kSizeNWSE = 7,
  kSizeNESW = 8,
  kSizeAll = 9,
  kNo = 10,
  kHidden = 11,
};

// The state of one key (or mouse button) as of the last message taken from
// the queue.
struct KeyState {
  bool down = false;
  // For the lock keys: the lock is on.
  bool toggled = false;
};

// Where a paint goes: a Cairo target (OSDeviceContext) for the drawing
// supplier's NewOSSurface, the area to repaint (client pixels) as rectangles
// and their bounds, and whether the supplier should draw through a buffer.
struct PaintTarget {
  pictel::OSDeviceContext context = nullptr;
  velkcore::RectT<std::int32_t> bounds;
  std::vector<velkcore::RectT<std::int32_t>> rects;
  bool buffered = false;
};

// One representation of the clipboard's content: a type name (the library's
// own, e.g. "VELKUI/UnicodeText") and its bytes.
struct ClipboardItem {
  std::string type;
  std::string bytes;
};

// Platform virtual keys (the desktop numbering of KeyboardEvent::GetOSCode and
// of automation scripts) that the platform layer itself refers to.
namespace vk {
inline constexpr std::int16_t kLeftButton = 1;
inline constexpr std::int16_t kRightButton = 2;
inline constexpr std::int16_t kMiddleButton = 4;
inline constexpr std::int16_t kBackspace = 8;
inline constexpr std::int16_t kTab = 9;
inline constexpr std::int16_t kClear = 12;
inline constexpr std::int16_t kReturn = 13;
inline constexpr std::int16_t kShift = 16;
inline constexpr std::int16_t kControl = 17;
inline constexpr std::int16_t kAlt = 18;
inline constexpr std::int16_t kCapsLock = 20;
inline constexpr std::int16_t kEscape = 27;
inline constexpr std::int16_t kSpace = 32;
inline constexpr std::int16_t kPageUp = 33;
inline constexpr std::int16_t kPageDown = 34;
inline constexpr std::int16_t kEnd = 35;
inline constexpr std::int16_t kHome = 36;
inline constexpr std::int16_t kLeft = 37;
inline constexpr std::int16_t kUp = 38;
inline constexpr std::int16_t kRight = 39;
inline constexpr std::int16_t kDown = 40;
inline constexpr std::int16_t kInsert = 45;
inline constexpr std::int16_t kDelete = 46;
inline constexpr std::int16_t kNumpad0 = 96;
inline constexpr std::int16_t kNumpad9 = 105;
inline constexpr std::int16_t kMultiply = 106;
inline constexpr std::int16_t kAdd = 107;
inline constexpr std::int16_t kSubtract = 109;
inline constexpr std::int16_t kDecimal = 110;
inline constexpr std::int16_t kDivide = 111;
inline constexpr std::int16_t kF1 = 112;
inline constexpr std::int16_t kF10 = 121;
inline constexpr std::int16_t kNumLock = 144;
inline constexpr std::int16_t kScrollLock = 145;
// The sides of the modifier keys (key state only; messages carry the generic key).
inline constexpr std::int16_t kLeftShift = 160;
inline constexpr std::int16_t kRightShift = 161;
inline constexpr std::int16_t kLeftControl = 162;
inline constexpr std::int16_t kRightControl = 163;
inline constexpr std::int16_t kLeftAlt = 164;
inline constexpr std::int16_t kRightAlt = 165;
}  // namespace vk

}  // namespace velkui::ui
