#pragma once

#include <cstdint>

#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>

#include "../common/KeyTable.h"

// The headless backend's keyboard: a US layout, modifier sides, lock keys and
// the keypad's double role, as a desktop keyboard driver reports them.
namespace velkui::ui::headless {

using platform::KeyTable;

// One key message as the keyboard produces it.
struct KeyStroke {
  std::uint32_t message = kMsgKeyDown;
  std::int16_t virtualKey = 0;
  KeyData data;
};

// Setting a key directly: a generic modifier sets its left side, a side its generic key.
void SyncSides(KeyTable& keys, std::int16_t virtualKey, bool down);
// Presses or releases a key on `physical` and answers the message it makes.
KeyStroke PressPhysicalKey(KeyTable& physical, std::int16_t virtualKey, bool extended, bool down);
// The scan codes are the virtual keys pressed (the sides for modifiers).
std::int16_t VirtualKeyOfScanCode(std::uint32_t scanCode);
// Printable characters only; letters in upper case.
char16_t UnshiftedCharacter(std::int16_t virtualKey);
// The character a key press makes in the state `keys` (0: none).
char16_t CharacterOfKey(std::int16_t virtualKey, const KeyTable& keys);

}  // namespace velkui::ui::headless
