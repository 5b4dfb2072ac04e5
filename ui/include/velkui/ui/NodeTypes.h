#pragma once

#include <cstdint>

#include <velkcore/Flags.h>

// Small shared vocabulary of the node tree, plus the forward declarations of
// types that belong to other parts of the library (windows, timers, data
// transfer) and that node signatures only mention.

namespace velkui::pictel {
class Pictel;
class SupplierInterface;
class SurfaceInterface;
class CacheInterface;
}  // namespace velkui::pictel

namespace velkui::datatransfer {
class OS_ReceiveData;
}  // namespace velkui::datatransfer

namespace velkui::ui {

class UI_Container;
class UI_Node;
class UI_SubView;
class UI_NodeManager;
class UI_NodeTimerManager;
class OS_Event;
class OS_Window;
class MouseEvent;
class KeyboardEvent;
class InputCapture;

using StateFlags = velkcore::Flags<std::uint32_t>;
using InvalidateFlags = velkcore::Flags<std::uint32_t>;
using UpdateFlags = velkcore::Flags<std::uint32_t>;
using ModifierKeys = velkcore::Flags<std::uint8_t>;
using ViewFlags = velkcore::Flags<std::uint8_t>;
using LayoutBinding = velkcore::Flags<std::uint8_t>;

// Node state bits (UI_Node::UI_GetStateFlags).
inline constexpr std::uint32_t kStateMouseOver = 0x2;
inline constexpr std::uint32_t kStateSelfDisabled = 0x4;
inline constexpr std::uint32_t kStateParentDisabled = 0x8;
inline constexpr std::uint32_t kStateWantsPreMouseEvents = 0x10;

// UI_Invalidate flag: the node's own cached pixels stay valid (only its
// position or transform changed).
inline constexpr std::uint32_t kInvalidateKeepOwnCache = 0x1;

// Sub-view flags.
inline constexpr std::uint8_t kViewShown = 0x1;
inline constexpr std::uint8_t kViewLayoutsChildren = 0x2;
inline constexpr std::uint8_t kViewHasBeenSized = 0x4;

// Layout binding: how a sub-view follows its parent's size changes.
inline constexpr std::uint8_t kBindLeftToRight = 0x01;
inline constexpr std::uint8_t kBindTopToBottom = 0x02;
inline constexpr std::uint8_t kBindRightToRight = 0x04;
inline constexpr std::uint8_t kBindBottomToBottom = 0x08;
inline constexpr std::uint8_t kBindCenterHorizontally = 0x10;
inline constexpr std::uint8_t kBindCenterVertically = 0x20;

// Modifier keys of mouse and keyboard events.
inline constexpr std::uint8_t kModifierShift = 0x02;
inline constexpr std::uint8_t kModifierControl = 0x04;
inline constexpr std::uint8_t kModifierCapsLock = 0x08;
inline constexpr std::uint8_t kModifierAlt = 0x10;

enum class NodeChange : std::int32_t {
  kParentChanged = 0,
  kFrameChanged = 1,
  kUnused = 2,
  kShownChanged = 3,
  kWindowMembershipChanged = 4,
};

// What a window tells its nodes when its activation changes.
enum class WindowActivation : std::int32_t {
  kDeactivated = 0,
  kActivated = 1,
  kActivatedByClick = 2,
};

enum class DrawCachePolicy : std::int32_t {
  kSurfaceDecides = 0,
  kNever = 1,
  kAlways = 2,
};

}  // namespace velkui::ui
