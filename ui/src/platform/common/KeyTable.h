#pragma once

// Key state as both backends keep it: one entry per virtual key.

#include <array>
#include <cstdint>

#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui::platform {

using KeyTable = std::array<KeyState, 256>;

bool IsLockKey(std::int16_t virtualKey);
// The generic Shift, Control and Alt follow their two sides.
void SyncGenericModifiers(KeyTable& keys);
// Records a mouse button message taken from the queue (its button goes down
// or up) and answers true; other messages change nothing and answer false.
bool ApplyButtonMessage(KeyTable& keys, std::uint32_t message);
// What Control with a key types on the desktop (0: nothing).
char16_t ControlCharacter(std::int16_t virtualKey);
// Records a key message taken from the queue: the key and `side` (the side
// of a modifier, else the key again) go down or up, and a fresh press of a
// lock key toggles it. Other messages change nothing.
void ApplyKeyMessage(KeyTable& keys, const OS_Event& event, std::int16_t side);

}  // namespace velkui::ui::platform
