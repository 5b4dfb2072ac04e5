#include <velkui/ui/KeyboardEvent.h>

#include <utility>

#include <velkcore/Error.h>

namespace velkui::ui {

namespace {

// Platform virtual keys (the desktop numbering the automation scripts use).
constexpr std::int16_t kVkBackspace = 8;
constexpr std::int16_t kVkTab = 9;
constexpr std::int16_t kVkClear = 12;
constexpr std::int16_t kVkReturn = 13;
constexpr std::int16_t kVkShift = 16;
constexpr std::int16_t kVkControl = 17;
constexpr std::int16_t kVkAlt = 18;
constexpr std::int16_t kVkPause = 19;
constexpr std::int16_t kVkCapsLock = 20;
constexpr std::int16_t kVkEscape = 27;
constexpr std::int16_t kVkSpace = 32;
constexpr std::int16_t kVkPageUp = 33;
constexpr std::int16_t kVkPageDown = 34;
constexpr std::int16_t kVkEnd = 35;
constexpr std::int16_t kVkHome = 36;
constexpr std::int16_t kVkLeft = 37;
constexpr std::int16_t kVkUp = 38;
constexpr std::int16_t kVkRight = 39;
constexpr std::int16_t kVkDown = 40;
constexpr std::int16_t kVkPrintScreen = 44;
constexpr std::int16_t kVkInsert = 45;
constexpr std::int16_t kVkDelete = 46;
constexpr std::int16_t kVkHelp = 47;
constexpr std::int16_t kVkApplication = 93;
constexpr std::int16_t kVkF1 = 112;
constexpr std::int16_t kVkF24 = 135;
constexpr std::int16_t kVkNumLock = 144;
constexpr std::int16_t kVkScrollLock = 145;

std::uint16_t PlainKeyCode(std::int16_t vk) {
  if (vk >= kVkF1 && vk <= kVkF24) return static_cast<std::uint16_t>(kKeyF1 + (vk - kVkF1));
  switch (vk) {
    case kVkSpace:
      return kKeySpace;
    case kVkBackspace:
      return kKeyBackspace;
    case kVkTab:
      return kKeyTab;
    case kVkReturn:
      return kKeyReturn;
    case kVkEscape:
      return kKeyEscape;
    case kVkScrollLock:
      return kKeyScrollLock;
    case kVkPause:
      return kKeyPause;
    case kVkInsert:
      return kKeyInsert;
    case kVkDelete:
      return kKeyDelete;
    case kVkHome:
      return kKeyHome;
    case kVkEnd:
      return kKeyEnd;
    case kVkPageUp:
      return kKeyPageUp;
    case kVkPageDown:
      return kKeyPageDown;
    case kVkHelp:
      return kKeyHelp;
    case kVkClear:
      return kKeyClear;
    case kVkLeft:
      return kKeyLeft;
    case kVkRight:
      return kKeyRight;
    case kVkUp:
      return kKeyUp;
    case kVkDown:
      return kKeyDown;
    case kVkNumLock:
      return kKeyNumLock;
    case kVkControl:
      return kKeyControl;
    case kVkAlt:
      return kKeyAlt;
    case kVkShift:
      return kKeyShift;
    case kVkCapsLock:
      return kKeyCapsLock;
    case kVkApplication:
      return kKeyApplication;
    default:
      return kKeyNone;
  }
}

}  // namespace

KeyboardEvent::KeyboardEvent(Action action, std::vector<char16_t> characters, std::int16_t osCode,
                             ModifierKeys modifiers, bool repeat, const OS_Event* osEvent)
    : action_(action),
      characters_(std::move(characters)),
      osCode_(osCode),
      modifiers_(modifiers),
      repeat_(repeat),
      osEvent_(osEvent) {}

std::uint16_t KeyboardEvent::GetControlCode(std::int16_t osCode) {
  if (osCode >= 0) {
    // Print Screen only exists as an extended key.
    return osCode == kVkPrintScreen ? std::uint16_t{kKeyNone} : PlainKeyCode(osCode);
  }
  const auto vk = static_cast<std::int16_t>(-static_cast<std::int32_t>(osCode));
  if (vk == kVkReturn) return kKeyEnter;
  if (vk == kVkPrintScreen) return kKeyPrintScreen;
  return PlainKeyCode(vk);
}

char16_t KeyboardEvent::GetCharacter(std::size_t index) const {
  velkcore::RequireInput(index < characters_.size());
  return characters_[index];
}

KeyboardCode KeyboardEvent::GetCode() const {
  if (!characters_.empty() && characters_.front() != 0) {
    return KeyboardCode::CreateFromKeyboardChar(characters_.front(), IsExtendedOSCode());
  }
  return KeyboardCode::CreateFromControlCode(GetControlCode(osCode_), IsExtendedOSCode());
}

bool KeyboardEvent::CompareShortcut(KeyboardCode code, ModifierKeys modifiers) const {
  ModifierKeys own = modifiers_;
  own.Clear(kModifierCapsLock);
  return GetCode() == code && own == modifiers;
}

}  // namespace velkui::ui
