#pragma once

#include <cstdint>

namespace velkui::pictel {

// When non-zero the window layer flashes each redrawn area and waits this many
// milliseconds. Process-wide; 0 at start.
void SetRedrawDebugFlashDelay(std::uint32_t milliseconds);
std::uint32_t GetRedrawDebugFlashDelay();

}  // namespace velkui::pictel
