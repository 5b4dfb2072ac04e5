#pragma once

#include <compare>
#include <cstdint>

namespace velkui::ui {

// Keys that produce no character of their own (or that are recognised by key
// rather than by character).
enum KeyboardCodeValue : std::uint16_t {
  kKeySpace = 1,
  kKeyBackspace = 2,
  kKeyTab = 3,
  kKeyReturn = 4,
  kKeyEnter = 5,  // keypad Enter
  kKeyEscape = 6,
  kKeyF1 = 7,
  kKeyF24 = 30,
  kKeyPrintScreen = 31,
  kKeyScrollLock = 32,
  kKeyPause = 33,
  kKeyInsert = 34,
  kKeyDelete = 35,
  kKeyHome = 36,
  kKeyEnd = 37,
  kKeyPageUp = 38,
  kKeyPageDown = 39,
  kKeyHelp = 40,
  kKeyClear = 41,
  kKeyLeft = 42,
  kKeyRight = 43,
  kKeyUp = 44,
  kKeyDown = 45,
  kKeyNumLock = 46,
  kKeyControl = 47,
  kKeyAlt = 48,
  kKeyShift = 50,
  kKeyCapsLock = 51,
  kKeyApplication = 52,
  kKeyNone = 0xFFFF,
};

// A key as a 32-bit value: bit 31 marks a printable UTF-16 character in the low
// 16 bits, bit 30 an extended key; otherwise the low 16 bits are a KeyboardCodeValue.
class KeyboardCode {
 public:
  static constexpr std::uint32_t kPrintableBit = 0x80000000u;
  static constexpr std::uint32_t kExtendedBit = 0x40000000u;

  constexpr KeyboardCode() = default;
  constexpr explicit KeyboardCode(std::uint32_t value) : value_(value) {}

  // 0xFFFF for the character 0.
  static constexpr KeyboardCode CreateFromKeyboardChar(char16_t ch, bool extended) {
    if (ch == 0) return KeyboardCode(kKeyNone);
    return KeyboardCode(static_cast<std::uint32_t>(ch) | kPrintableBit |
                        (extended ? kExtendedBit : 0u));
  }
  static constexpr KeyboardCode CreateFromControlCode(std::uint16_t code, bool extended) {
    return KeyboardCode(static_cast<std::uint32_t>(code) | (extended ? kExtendedBit : 0u));
  }

  // Bit 30 is cleared unless asked for.
  constexpr std::uint32_t GetValue(bool withExtended = false) const {
    return withExtended ? value_ : (value_ & ~kExtendedBit);
  }
  constexpr bool IsPrintable() const { return (value_ & kPrintableBit) != 0; }
  constexpr bool IsExtended() const { return (value_ & kExtendedBit) != 0; }
  // The character of a printable code, else 0.
  constexpr char16_t GetCharacter() const {
    return IsPrintable() ? static_cast<char16_t>(value_ & 0xFFFFu) : u'\0';
  }
  // The control code of a non-printable code, else kKeyNone.
  constexpr std::uint16_t GetControlCode() const {
    return IsPrintable() ? std::uint16_t{kKeyNone} : static_cast<std::uint16_t>(value_ & 0xFFFFu);
  }

  friend constexpr bool operator==(KeyboardCode, KeyboardCode) = default;
  friend constexpr auto operator<=>(KeyboardCode, KeyboardCode) = default;

 private:
  std::uint32_t value_ = kKeyNone;
};

}  // namespace velkui::ui
