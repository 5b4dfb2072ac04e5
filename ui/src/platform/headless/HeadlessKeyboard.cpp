#include "HeadlessKeyboard.h"

#include <velkcore/Error.h>

namespace velkui::ui::headless {

using platform::ControlCharacter;
using platform::IsLockKey;
using platform::SyncGenericModifiers;

namespace {

constexpr std::int16_t kF10 = vk::kF10;

bool IsLetter(std::int16_t key) {
  return key >= 'A' && key <= 'Z';
}
bool IsDigit(std::int16_t key) {
  return key >= '0' && key <= '9';
}
bool IsKeypadKey(std::int16_t key) {
  return (key >= vk::kNumpad0 && key <= vk::kNumpad9) || key == vk::kDecimal;
}

// What the keypad keys report as navigation keys (Num Lock off, or Shift held).
std::int16_t NavigationKeyOfKeypad(std::int16_t key) {
  switch (key) {
    case vk::kNumpad0:
      return vk::kInsert;
    case vk::kNumpad0 + 1:
      return vk::kEnd;
    case vk::kNumpad0 + 2:
      return vk::kDown;
    case vk::kNumpad0 + 3:
      return vk::kPageDown;
    case vk::kNumpad0 + 4:
      return vk::kLeft;
    case vk::kNumpad0 + 5:
      return vk::kClear;
    case vk::kNumpad0 + 6:
      return vk::kRight;
    case vk::kNumpad0 + 7:
      return vk::kHome;
    case vk::kNumpad0 + 8:
      return vk::kUp;
    case vk::kNumpad0 + 9:
      return vk::kPageUp;
    default:
      return vk::kDelete;
  }
}

struct OemKey {
  std::int16_t key;
  char16_t plain;
  char16_t shifted;
};
constexpr OemKey kOemKeys[] = {
    {186, u';', u':'},  {187, u'=', u'+'}, {188, u',', u'<'},  {189, u'-', u'_'},
    {190, u'.', u'>'},  {191, u'/', u'?'}, {192, u'`', u'~'},  {219, u'[', u'{'},
    {220, u'\\', u'|'}, {221, u']', u'}'}, {222, u'\'', u'"'},
};
constexpr char16_t kShiftedDigits[] = u")!@#$%^&*(";

const OemKey* FindOemKey(std::int16_t key) {
  for (const OemKey& oem : kOemKeys) {
    if (oem.key == key) return &oem;
  }
  return nullptr;
}

char16_t KeypadCharacter(std::int16_t key) {
  if (key >= vk::kNumpad0 && key <= vk::kNumpad9) {
    return static_cast<char16_t>(u'0' + (key - vk::kNumpad0));
  }
  switch (key) {
    case vk::kMultiply:
      return u'*';
    case vk::kAdd:
      return u'+';
    case vk::kSubtract:
      return u'-';
    case vk::kDecimal:
      return u'.';
    case vk::kDivide:
      return u'/';
    default:
      return 0;
  }
}

}  // namespace

void SyncSides(KeyTable& keys, std::int16_t virtualKey, bool down) {
  switch (virtualKey) {
    case vk::kShift:
      keys[vk::kLeftShift].down = down;
      keys[vk::kRightShift].down = down && keys[vk::kRightShift].down;
      break;
    case vk::kControl:
      keys[vk::kLeftControl].down = down;
      keys[vk::kRightControl].down = down && keys[vk::kRightControl].down;
      break;
    case vk::kAlt:
      keys[vk::kLeftAlt].down = down;
      keys[vk::kRightAlt].down = down && keys[vk::kRightAlt].down;
      break;
    default:
      break;
  }
  SyncGenericModifiers(keys);
}

KeyStroke PressPhysicalKey(KeyTable& physical, std::int16_t virtualKey, bool extended, bool down) {
  velkcore::RequireInput(virtualKey > 0 && virtualKey < 256);
  std::int16_t generic = virtualKey;
  std::int16_t side = virtualKey;
  if (virtualKey >= vk::kLeftShift && virtualKey <= vk::kRightAlt) {
    generic = static_cast<std::int16_t>(vk::kShift + (virtualKey - vk::kLeftShift) / 2);
    extended = virtualKey == vk::kRightControl || virtualKey == vk::kRightAlt;
  } else if (virtualKey == vk::kShift) {
    side = vk::kLeftShift;
  } else if (virtualKey == vk::kControl) {
    side = extended ? vk::kRightControl : vk::kLeftControl;
  } else if (virtualKey == vk::kAlt) {
    side = extended ? vk::kRightAlt : vk::kLeftAlt;
  }
  const auto sideIndex = static_cast<std::size_t>(side);
  const bool wasDown = physical[sideIndex].down;
  if (down && !wasDown && IsLockKey(generic)) {
    physical[static_cast<std::size_t>(generic)].toggled =
        !physical[static_cast<std::size_t>(generic)].toggled;
  }
  physical[sideIndex].down = down;
  if (side == generic) physical[static_cast<std::size_t>(generic)].down = down;
  SyncGenericModifiers(physical);

  KeyStroke stroke;
  stroke.virtualKey = generic;
  if (!extended && IsKeypadKey(virtualKey) &&
      (!physical[vk::kNumLock].toggled || physical[vk::kShift].down)) {
    stroke.virtualKey = NavigationKeyOfKeypad(virtualKey);
  }
  const bool control = physical[vk::kControl].down;
  // The Alt key counts as held for its own release.
  const bool alt = physical[vk::kAlt].down || generic == vk::kAlt;
  const bool system = (alt && !control) || (generic == kF10 && !control);
  stroke.message =
      down ? (system ? kMsgSysKeyDown : kMsgKeyDown) : (system ? kMsgSysKeyUp : kMsgKeyUp);
  stroke.data.scanCode = static_cast<std::uint32_t>(side);
  stroke.data.extended = extended;
  stroke.data.altHeld = alt && !control;
  stroke.data.previouslyDown = down ? wasDown : true;
  stroke.data.releasing = !down;
  return stroke;
}

std::int16_t VirtualKeyOfScanCode(std::uint32_t scanCode) {
  const auto key = static_cast<std::int16_t>(scanCode & 0xFFu);
  if (key >= vk::kLeftShift && key <= vk::kRightAlt) {
    return static_cast<std::int16_t>(vk::kShift + (key - vk::kLeftShift) / 2);
  }
  return key;
}

char16_t UnshiftedCharacter(std::int16_t virtualKey) {
  if (IsLetter(virtualKey) || IsDigit(virtualKey)) return static_cast<char16_t>(virtualKey);
  if (virtualKey == vk::kSpace) return u' ';
  if (const char16_t keypad = KeypadCharacter(virtualKey)) return keypad;
  if (const OemKey* oem = FindOemKey(virtualKey)) return oem->plain;
  return 0;
}

char16_t CharacterOfKey(std::int16_t virtualKey, const KeyTable& keys) {
  const bool shift = keys[vk::kShift].down;
  const bool control = keys[vk::kControl].down;
  const bool alt = keys[vk::kAlt].down;
  // The US layout has no AltGr characters.
  if (control && alt) return 0;
  if (control) return ControlCharacter(virtualKey);
  if (IsLetter(virtualKey)) {
    const bool upper = shift != keys[vk::kCapsLock].toggled;
    return static_cast<char16_t>(upper ? virtualKey : virtualKey + ('a' - 'A'));
  }
  if (IsDigit(virtualKey)) {
    return shift ? kShiftedDigits[virtualKey - '0'] : static_cast<char16_t>(virtualKey);
  }
  switch (virtualKey) {
    case vk::kSpace:
      return u' ';
    case vk::kBackspace:
    case vk::kTab:
    case vk::kReturn:
    case vk::kEscape:
      return static_cast<char16_t>(virtualKey);
    default:
      break;
  }
  if (const char16_t keypad = KeypadCharacter(virtualKey)) return keypad;
  if (const OemKey* oem = FindOemKey(virtualKey)) return shift ? oem->shifted : oem->plain;
  return 0;
}

}  // namespace velkui::ui::headless
