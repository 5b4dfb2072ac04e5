#include <velkui/pictel/RedrawDebug.h>

#include <atomic>

namespace velkui::pictel {

namespace {
std::atomic<std::uint32_t> redrawDebugFlashDelay{0};
}

void SetRedrawDebugFlashDelay(std::uint32_t milliseconds) {
  redrawDebugFlashDelay.store(milliseconds, std::memory_order_relaxed);
}

std::uint32_t GetRedrawDebugFlashDelay() {
  return redrawDebugFlashDelay.load(std::memory_order_relaxed);
}

}  // namespace velkui::pictel
