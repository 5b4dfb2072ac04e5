#pragma once

#include <cstdint>

#include <velkcore/Flags.h>

namespace velkui::controls {

// The state a control draws from (UI_ControlView::GetControlState).
using ControlState = velkcore::Flags<std::uint32_t>;

inline constexpr std::uint32_t kControlStateDown = 0x1;
// The pointer is over the control (and any running capture is the control's own).
inline constexpr std::uint32_t kControlStateRollover = 0x2;
inline constexpr std::uint32_t kControlStateDisabled = 0x4;
// Keyboard focus that should be drawn.
inline constexpr std::uint32_t kControlStateFocus = 0x8;

// A button's value: 0 off, 1 on.
using ButtonValue = std::int32_t;
inline constexpr ButtonValue kButtonOff = 0;
inline constexpr ButtonValue kButtonOn = 1;

}  // namespace velkui::controls
