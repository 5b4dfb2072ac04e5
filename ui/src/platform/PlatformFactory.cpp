// The one place where the window-system backend is chosen.
#include <cstdlib>
#include <string>

#include <velkcore/Error.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/Platform.h>

#include "x11/X11Platform.h"

namespace velkui::ui {

namespace {

constexpr std::string_view kUnknownPlatformKey =
    "$$$/velkui/ui/Error/UnknownPlatform=Unknown window-system backend \"^0\" in VELKUI_PLATFORM "
    "(use x11 or headless).";
constexpr std::int32_t kUnknownPlatformNumber = 21;

std::string ReadEnvironment(const char* name) {
  const char* value = std::getenv(name);
  return value != nullptr ? std::string(value) : std::string();
}

}  // namespace

std::unique_ptr<Platform> CreatePlatform(std::string_view name) {
  if (name == "headless") return std::make_unique<HeadlessPlatform>();
  // Raises 103/20 (naming x11 and the display) when the display cannot be opened.
  if (name == "x11") return std::make_unique<X11Platform>();
  velkcore::ThrowError(velkcore::ErrorLevel::kError, kUnknownPlatformKey,
                       velkcore::kCategoryUserInterface, kUnknownPlatformNumber, 0,
                       std::string(name));
}

std::unique_ptr<Platform> CreatePlatformFromEnvironment() {
  std::string name = ReadEnvironment("VELKUI_PLATFORM");
  if (name.empty()) name = ReadEnvironment("DISPLAY").empty() ? "headless" : "x11";
  return CreatePlatform(name);
}

}  // namespace velkui::ui
