#include <velkui/pictel/StartupShutdownGdiPlus.h>

#include <atomic>

#include "TextEngine.h"

namespace velkui::utility {

namespace {
std::atomic<int> liveStartups{0};
}

StartupShutdownGdiPlus::StartupShutdownGdiPlus() {
  // Raises error 20 when fontconfig or the font map cannot be started.
  pictel::cairo::TextEngine::Get();
  liveStartups.fetch_add(1, std::memory_order_acq_rel);
}

// The font machinery stays loaded for the life of the process: fonts and
// layouts made while drawing may outlive this object.
StartupShutdownGdiPlus::~StartupShutdownGdiPlus() {
  liveStartups.fetch_sub(1, std::memory_order_acq_rel);
}

bool StartupShutdownGdiPlus::IsStarted() {
  return liveStartups.load(std::memory_order_acquire) > 0;
}

}  // namespace velkui::utility
