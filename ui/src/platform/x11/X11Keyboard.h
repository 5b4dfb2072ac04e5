#pragma once

#include "X11Headers.h"

#include <cstdint>
#include <optional>
#include <string>

namespace velkui::ui::x11 {

// What one X key event means in the desktop key numbering.
struct KeyIdentity {
  // The virtual key the message carries (the generic key for modifiers), 0 when
  // the key has none.
  std::int16_t virtualKey = 0;
  // The side of a modifier (160-165), else the virtual key itself.
  std::int16_t sideKey = 0;
  bool extended = false;
};

// The keyboard: keysyms to virtual keys and back, and the text of key presses
// through the input method when one can be opened (Xutf8LookupString), else
// from the keysym.
class X11Keyboard {
 public:
  explicit X11Keyboard(Display* display);
  ~X11Keyboard();
  X11Keyboard(const X11Keyboard&) = delete;
  X11Keyboard& operator=(const X11Keyboard&) = delete;

  // An input context for a top-level window (null without an input method),
  // and the events it wants on that window.
  XIC CreateContext(Window window) const;
  static long FilterEvents(XIC context);

  // The key of an event; keypad keys follow Num Lock and Shift as `state` has them.
  KeyIdentity Identify(unsigned keycode, unsigned state) const;
  // The generic virtual key of a keycode, whatever the modifiers.
  std::int16_t VirtualKeyOfKeycode(unsigned keycode) const;
  // The text a key press types, in UTF-16 (control characters included, as
  // the desktop produces them: Ctrl+A is 1, Return 13).
  std::u16string TextOf(XKeyEvent& event, XIC context, const KeyIdentity& key) const;

  // The modifier bit of Num Lock (it varies between keymaps).
  unsigned NumLockMask() const { return numLockMask_; }
  // After a MappingNotify.
  void RefreshMapping(XMappingEvent& event);

 private:
  void FindNumLockMask();

  Display* display_;
  XIM inputMethod_ = nullptr;
  unsigned numLockMask_ = Mod2Mask;
};

// The keycode that makes `virtualKey` on the keyboard of `display`, if it has one.
std::optional<KeyCode> KeycodeOfVirtualKey(Display* display, std::int16_t virtualKey, bool extended,
                                           bool numLockOn);

// Printable characters only (letters in upper case); 0 for the others.
char16_t UnshiftedCharacterOfVirtualKey(std::int16_t virtualKey);

}  // namespace velkui::ui::x11
