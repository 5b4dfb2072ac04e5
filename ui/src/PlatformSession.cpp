#include <velkui/ui/PlatformSession.h>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorManagement.h>
#include <velkui/pictel/StartupShutdownGdiPlus.h>
#include <velkui/ui/DefaultKeyframeTheme.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/Theme.h>

namespace velkui::ui {

PlatformSession::PlatformSession() : PlatformSession(CreatePlatformFromEnvironment()) {}

PlatformSession::PlatformSession(std::unique_ptr<Platform> platform)
    : platform_(std::move(platform)) {
  velkcore::RequireInput(platform_ != nullptr && GetPlatformIfAny() == nullptr);
  SetPlatform(platform_.get());
  try {
    graphics_ = std::make_unique<utility::StartupShutdownGdiPlus>();
    if (!Theme::IsInitialized()) {
      // With the library's key frames, SetBrightness gives the dark look out of the box.
      auto theme = std::make_unique<KeyframeThemeEditor>();
      LoadDefaultKeyframeTheme(*theme);
      Theme::Initialize(std::move(theme));
      ownsTheme_ = true;
    }
    manager_ = std::make_unique<OS_NodeManager>();
    UI_NodeManager::Set(manager_.get());
    pictel::SetMonitorEnumerator([] {
      std::vector<pictel::MonitorPiece> pieces;
      if (const Platform* current = GetPlatformIfAny()) {
        for (const MonitorDescription& monitor : current->GetMonitors()) {
          pieces.emplace_back(monitor.bounds, reinterpret_cast<void*>(monitor.id));
        }
      }
      return pieces;
    });
  } catch (...) {
    manager_.reset();
    if (ownsTheme_) Theme::Terminate();
    graphics_.reset();
    SetPlatform(nullptr);
    throw;
  }
}

PlatformSession::~PlatformSession() {
  pictel::SetMonitorEnumerator({});
  if (UI_NodeManager::Get(false) == manager_.get()) UI_NodeManager::Set(nullptr);
  manager_.reset();
  if (ownsTheme_ && Theme::IsInitialized()) Theme::Terminate();
  graphics_.reset();
  if (GetPlatformIfAny() == platform_.get()) SetPlatform(nullptr);
  platform_.reset();
}

}  // namespace velkui::ui
