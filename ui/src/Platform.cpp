#include <velkui/ui/Platform.h>

#include <velkcore/Error.h>

namespace velkui::ui {

namespace {

Platform* gPlatform = nullptr;

}  // namespace

Platform::Platform() = default;

Platform::~Platform() {
  if (gPlatform == this) gPlatform = nullptr;
}

ModifierKeys Platform::GetModifierKeys() const {
  ModifierKeys modifiers;
  modifiers.Set(kModifierShift, GetKeyState(vk::kShift).down);
  modifiers.Set(kModifierControl, GetKeyState(vk::kControl).down);
  modifiers.Set(kModifierCapsLock, GetKeyState(vk::kCapsLock).toggled);
  modifiers.Set(kModifierAlt, GetKeyState(vk::kAlt).down);
  return modifiers;
}

void Platform::SetQuitting(std::int32_t exitCode) {
  quitting_ = true;
  exitCode_ = exitCode;
}

Platform& GetPlatform() {
  velkcore::RequireInput(gPlatform != nullptr);
  return *gPlatform;
}

Platform* GetPlatformIfAny() {
  return gPlatform;
}

void SetPlatform(Platform* platform) {
  gPlatform = platform;
}

void OS_SetCursor(CursorShape shape) {
  if (gPlatform != nullptr) gPlatform->SetCursor(shape);
}

}  // namespace velkui::ui
