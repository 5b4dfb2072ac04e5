#pragma once

#include <memory>

#include <velkui/ui/OS_NodeManager.h>
#include <velkui/ui/Platform.h>

namespace velkui::utility {
class StartupShutdownGdiPlus;
}

namespace velkui::ui {

// The start-up of a program that shows windows, undone in reverse order when
// it ends:
//  1. the window-system backend (from VELKUI_PLATFORM, or the one given) is installed;
//  2. the drawing library is started (kept alive for the whole session);
//  3. the default theme is installed unless the host installed one already;
//  4. the node manager (OS_NodeManager, with the tooltip manager) is created
//     and installed, which registers the calling thread as the main thread;
//  5. the drawing layer learns the monitors (for colour management by display).
// One session at a time. Windows should be gone before the session ends.
class PlatformSession {
 public:
  PlatformSession();
  explicit PlatformSession(std::unique_ptr<Platform> platform);
  ~PlatformSession();
  PlatformSession(const PlatformSession&) = delete;
  PlatformSession& operator=(const PlatformSession&) = delete;

  Platform& GetPlatform() { return *platform_; }
  OS_NodeManager& GetNodeManager() { return *manager_; }

 private:
  std::unique_ptr<Platform> platform_;
  std::unique_ptr<utility::StartupShutdownGdiPlus> graphics_;
  bool ownsTheme_ = false;
  std::unique_ptr<OS_NodeManager> manager_;
};

}  // namespace velkui::ui
