#include "KeyTable.h"

namespace velkui::ui::platform {

namespace {

std::int16_t ButtonVirtualKey(std::uint32_t message) {
  switch (message) {
    case kMsgLeftButtonDown:
    case kMsgLeftButtonUp:
    case kMsgLeftButtonDoubleClick:
      return vk::kLeftButton;
    case kMsgMiddleButtonDown:
    case kMsgMiddleButtonUp:
    case kMsgMiddleButtonDoubleClick:
      return vk::kMiddleButton;
    case kMsgRightButtonDown:
    case kMsgRightButtonUp:
    case kMsgRightButtonDoubleClick:
      return vk::kRightButton;
    default:
      return 0;
  }
}

}  // namespace

bool IsLockKey(std::int16_t virtualKey) {
  return virtualKey == vk::kCapsLock || virtualKey == vk::kNumLock || virtualKey == vk::kScrollLock;
}

void SyncGenericModifiers(KeyTable& keys) {
  keys[vk::kShift].down = keys[vk::kLeftShift].down || keys[vk::kRightShift].down;
  keys[vk::kControl].down = keys[vk::kLeftControl].down || keys[vk::kRightControl].down;
  keys[vk::kAlt].down = keys[vk::kLeftAlt].down || keys[vk::kRightAlt].down;
}

bool ApplyButtonMessage(KeyTable& keys, std::uint32_t message) {
  const std::int16_t button = ButtonVirtualKey(message);
  if (button == 0) return false;
  keys[static_cast<std::size_t>(button)].down =
      message != kMsgLeftButtonUp && message != kMsgMiddleButtonUp && message != kMsgRightButtonUp;
  return true;
}

char16_t ControlCharacter(std::int16_t virtualKey) {
  if (virtualKey >= 'A' && virtualKey <= 'Z') return static_cast<char16_t>(virtualKey - 'A' + 1);
  switch (virtualKey) {
    case 219:
      return 27;
    case 220:
      return 28;
    case 221:
      return 29;
    case vk::kReturn:
      return 10;
    case vk::kBackspace:
      return 127;
    case vk::kSpace:
      return u' ';
    case vk::kEscape:
      return 27;
    default:
      return 0;
  }
}

void ApplyKeyMessage(KeyTable& keys, const OS_Event& event, std::int16_t side) {
  const std::uint32_t message = event.GetMsg();
  if (message < kMsgKeyDown || message > kMsgSysKeyUp) return;
  const bool down = message == kMsgKeyDown || message == kMsgSysKeyDown;
  const KeyData data = GetKeyParam(event.GetLParam());
  const auto key = static_cast<std::size_t>(event.GetWParam() & 0xFFu);
  if (down && !data.previouslyDown && IsLockKey(static_cast<std::int16_t>(key))) {
    keys[key].toggled = !keys[key].toggled;
  }
  keys[key].down = down;
  keys[static_cast<std::size_t>(side & 0xFF)].down = down;
  SyncGenericModifiers(keys);
}

}  // namespace velkui::ui::platform
