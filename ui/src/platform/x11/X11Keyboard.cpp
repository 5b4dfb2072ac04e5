#include "X11Keyboard.h"

#include <X11/XKBlib.h>
#include <X11/Xlocale.h>
#include <X11/Xutil.h>
#include <X11/keysym.h>
#include "X11Headers.h"

#include <array>
#include <vector>

#include <velkcore/Strings.h>
#include <velkui/ui/PlatformTypes.h>

#include "../common/KeyTable.h"

namespace velkui::ui::x11 {

namespace {

constexpr std::int16_t kPause = 19;
constexpr std::int16_t kPrint = 44;
constexpr std::int16_t kLeftWindows = 91;
constexpr std::int16_t kRightWindows = 92;
constexpr std::int16_t kApplication = 93;
constexpr std::int16_t kSeparator = 108;
constexpr std::int16_t kOem102 = 226;

struct KeysymKey {
  KeySym keysym;
  std::int16_t virtualKey;
  std::int16_t sideKey;
  bool extended;
};

// Keys that are neither letters, digits nor function keys.
constexpr KeysymKey kKeysymKeys[] = {
    {XK_BackSpace, vk::kBackspace, vk::kBackspace, false},
    {XK_Tab, vk::kTab, vk::kTab, false},
    {XK_ISO_Left_Tab, vk::kTab, vk::kTab, false},
    {XK_Return, vk::kReturn, vk::kReturn, false},
    {XK_Escape, vk::kEscape, vk::kEscape, false},
    {XK_space, vk::kSpace, vk::kSpace, false},
    {XK_Pause, kPause, kPause, false},
    {XK_Print, kPrint, kPrint, true},
    {XK_Prior, vk::kPageUp, vk::kPageUp, true},
    {XK_Next, vk::kPageDown, vk::kPageDown, true},
    {XK_End, vk::kEnd, vk::kEnd, true},
    {XK_Home, vk::kHome, vk::kHome, true},
    {XK_Left, vk::kLeft, vk::kLeft, true},
    {XK_Up, vk::kUp, vk::kUp, true},
    {XK_Right, vk::kRight, vk::kRight, true},
    {XK_Down, vk::kDown, vk::kDown, true},
    {XK_Insert, vk::kInsert, vk::kInsert, true},
    {XK_Delete, vk::kDelete, vk::kDelete, true},
    {XK_Shift_L, vk::kShift, vk::kLeftShift, false},
    {XK_Shift_R, vk::kShift, vk::kRightShift, false},
    {XK_Control_L, vk::kControl, vk::kLeftControl, false},
    {XK_Control_R, vk::kControl, vk::kRightControl, true},
    {XK_Alt_L, vk::kAlt, vk::kLeftAlt, false},
    {XK_Meta_L, vk::kAlt, vk::kLeftAlt, false},
    {XK_Alt_R, vk::kAlt, vk::kRightAlt, true},
    {XK_Meta_R, vk::kAlt, vk::kRightAlt, true},
    {XK_ISO_Level3_Shift, vk::kAlt, vk::kRightAlt, true},
    {XK_Mode_switch, vk::kAlt, vk::kRightAlt, true},
    {XK_Caps_Lock, vk::kCapsLock, vk::kCapsLock, false},
    {XK_Num_Lock, vk::kNumLock, vk::kNumLock, true},
    {XK_Scroll_Lock, vk::kScrollLock, vk::kScrollLock, false},
    {XK_Super_L, kLeftWindows, kLeftWindows, true},
    {XK_Super_R, kRightWindows, kRightWindows, true},
    {XK_Menu, kApplication, kApplication, true},
    {XK_semicolon, 186, 186, false},
    {XK_equal, 187, 187, false},
    {XK_comma, 188, 188, false},
    {XK_minus, 189, 189, false},
    {XK_period, 190, 190, false},
    {XK_slash, 191, 191, false},
    {XK_grave, 192, 192, false},
    {XK_bracketleft, 219, 219, false},
    {XK_backslash, 220, 220, false},
    {XK_bracketright, 221, 221, false},
    {XK_apostrophe, 222, 222, false},
    {XK_less, kOem102, kOem102, false},
    // The keypad: digits with Num Lock, navigation without (or with Shift).
    {XK_KP_Insert, vk::kInsert, vk::kInsert, false},
    {XK_KP_End, vk::kEnd, vk::kEnd, false},
    {XK_KP_Down, vk::kDown, vk::kDown, false},
    {XK_KP_Next, vk::kPageDown, vk::kPageDown, false},
    {XK_KP_Left, vk::kLeft, vk::kLeft, false},
    {XK_KP_Begin, vk::kClear, vk::kClear, false},
    {XK_KP_Right, vk::kRight, vk::kRight, false},
    {XK_KP_Home, vk::kHome, vk::kHome, false},
    {XK_KP_Up, vk::kUp, vk::kUp, false},
    {XK_KP_Prior, vk::kPageUp, vk::kPageUp, false},
    {XK_KP_Delete, vk::kDelete, vk::kDelete, false},
    {XK_KP_Decimal, vk::kDecimal, vk::kDecimal, false},
    {XK_KP_Separator, kSeparator, kSeparator, false},
    {XK_KP_Multiply, vk::kMultiply, vk::kMultiply, false},
    {XK_KP_Add, vk::kAdd, vk::kAdd, false},
    {XK_KP_Subtract, vk::kSubtract, vk::kSubtract, false},
    {XK_KP_Divide, vk::kDivide, vk::kDivide, true},
    {XK_KP_Enter, vk::kReturn, vk::kReturn, true},
};

// Where the keys of a US keyboard sit (evdev keycodes), for layouts whose
// keysyms are not Latin: the desktop names such keys by their place.
struct PlacedKey {
  unsigned keycode;
  std::int16_t virtualKey;
};
constexpr PlacedKey kPlacedKeys[] = {
    {10, '1'}, {11, '2'}, {12, '3'}, {13, '4'}, {14, '5'}, {15, '6'}, {16, '7'}, {17, '8'},
    {18, '9'}, {19, '0'}, {20, 189}, {21, 187}, {24, 'Q'}, {25, 'W'}, {26, 'E'}, {27, 'R'},
    {28, 'T'}, {29, 'Y'}, {30, 'U'}, {31, 'I'}, {32, 'O'}, {33, 'P'}, {34, 219}, {35, 221},
    {38, 'A'}, {39, 'S'}, {40, 'D'}, {41, 'F'}, {42, 'G'}, {43, 'H'}, {44, 'J'}, {45, 'K'},
    {46, 'L'}, {47, 186}, {48, 222}, {49, 192}, {51, 220}, {52, 'Z'}, {53, 'X'}, {54, 'C'},
    {55, 'V'}, {56, 'B'}, {57, 'N'}, {58, 'M'}, {59, 188}, {60, 190}, {61, 191}, {94, kOem102},
};

bool IsKeypadKeysym(KeySym keysym) {
  return keysym >= XK_KP_Space && keysym <= XK_KP_Equal;
}

std::optional<KeyIdentity> IdentityOfKeysym(KeySym keysym) {
  if (keysym >= XK_a && keysym <= XK_z) {
    const auto key = static_cast<std::int16_t>('A' + (keysym - XK_a));
    return KeyIdentity{key, key, false};
  }
  if ((keysym >= XK_A && keysym <= XK_Z) || (keysym >= XK_0 && keysym <= XK_9)) {
    const auto key = static_cast<std::int16_t>(keysym);
    return KeyIdentity{key, key, false};
  }
  if (keysym >= XK_KP_0 && keysym <= XK_KP_9) {
    const auto key = static_cast<std::int16_t>(vk::kNumpad0 + (keysym - XK_KP_0));
    return KeyIdentity{key, key, false};
  }
  if (keysym >= XK_F1 && keysym <= XK_F24) {
    const auto key = static_cast<std::int16_t>(vk::kF1 + (keysym - XK_F1));
    return KeyIdentity{key, key, false};
  }
  for (const KeysymKey& entry : kKeysymKeys) {
    if (entry.keysym == keysym) return KeyIdentity{entry.virtualKey, entry.sideKey, entry.extended};
  }
  return std::nullopt;
}

// The keysyms that make a virtual key, best first.
std::vector<KeySym> KeysymsOf(std::int16_t virtualKey, bool extended, bool numLockOn) {
  if (virtualKey >= 'A' && virtualKey <= 'Z')
    return {static_cast<KeySym>(XK_a + (virtualKey - 'A'))};
  if (virtualKey >= '0' && virtualKey <= '9') return {static_cast<KeySym>(virtualKey)};
  if (virtualKey >= vk::kNumpad0 && virtualKey <= vk::kNumpad9) {
    return {static_cast<KeySym>(XK_KP_0 + (virtualKey - vk::kNumpad0))};
  }
  if (virtualKey >= vk::kF1 && virtualKey < vk::kF1 + 24) {
    return {static_cast<KeySym>(XK_F1 + (virtualKey - vk::kF1))};
  }
  std::vector<KeySym> keysyms;
  // A generic modifier means its left side, or the right one when extended.
  std::int16_t side = virtualKey;
  if (virtualKey == vk::kShift) side = vk::kLeftShift;
  if (virtualKey == vk::kControl) side = extended ? vk::kRightControl : vk::kLeftControl;
  if (virtualKey == vk::kAlt) side = extended ? vk::kRightAlt : vk::kLeftAlt;
  const bool isSide = side >= vk::kLeftShift && side <= vk::kRightAlt;
  for (const KeysymKey& entry : kKeysymKeys) {
    if (isSide ? entry.sideKey != side : entry.virtualKey != virtualKey) continue;
    // A navigation key without the extended bit is the keypad's; with Num
    // Lock on, the keypad would type a digit, so the dedicated key stands in.
    const bool keypad = IsKeypadKeysym(entry.keysym);
    const bool wantKeypad = !extended && !numLockOn;
    if (!isSide && entry.virtualKey >= vk::kPageUp && entry.virtualKey <= vk::kDelete &&
        entry.virtualKey != kPrint) {
      if (keypad != wantKeypad) continue;
    } else if (!isSide && entry.extended != extended && virtualKey == vk::kReturn) {
      continue;
    }
    keysyms.push_back(entry.keysym);
  }
  return keysyms;
}

char32_t UnicodeOfKeysym(KeySym keysym) {
  if ((keysym >= 0x20 && keysym <= 0x7E) || (keysym >= 0xA0 && keysym <= 0xFF)) {
    return static_cast<char32_t>(keysym);
  }
  if ((keysym & 0xFF000000u) == 0x01000000u) return static_cast<char32_t>(keysym & 0x00FFFFFFu);
  if (keysym >= XK_KP_0 && keysym <= XK_KP_9) return U'0' + static_cast<char32_t>(keysym - XK_KP_0);
  switch (keysym) {
    case XK_BackSpace:
      return 8;
    case XK_Tab:
    case XK_ISO_Left_Tab:
    case XK_KP_Tab:
      return 9;
    case XK_Return:
    case XK_KP_Enter:
      return 13;
    case XK_Escape:
      return 27;
    case XK_KP_Space:
      return U' ';
    case XK_KP_Multiply:
      return U'*';
    case XK_KP_Add:
      return U'+';
    case XK_KP_Separator:
      return U',';
    case XK_KP_Subtract:
      return U'-';
    case XK_KP_Decimal:
      return U'.';
    case XK_KP_Divide:
      return U'/';
    case XK_KP_Equal:
      return U'=';
    case XK_EuroSign:
      return 0x20AC;
    default:
      return 0;
  }
}

void AppendUTF32(std::u16string& text, char32_t c) {
  if (c == 0) return;
  if (c >= 0x10000 && c <= 0x10FFFF) {
    c -= 0x10000;
    text.push_back(static_cast<char16_t>(0xD800 + (c >> 10)));
    text.push_back(static_cast<char16_t>(0xDC00 + (c & 0x3FF)));
  } else if (c < 0x10000 && (c < 0xD800 || c > 0xDFFF)) {
    text.push_back(static_cast<char16_t>(c));
  }
}

}  // namespace

X11Keyboard::X11Keyboard(Display* display) : display_(display) {
  Bool supported = False;
  // Auto-repeat then sends presses only, without the release between them.
  XkbSetDetectableAutoRepeat(display_, True, &supported);
  FindNumLockMask();
  if (XSupportsLocale()) {
    XSetLocaleModifiers("");
    inputMethod_ = XOpenIM(display_, nullptr, nullptr, nullptr);
  }
}

X11Keyboard::~X11Keyboard() {
  if (inputMethod_ != nullptr) XCloseIM(inputMethod_);
}

XIC X11Keyboard::CreateContext(Window window) const {
  if (inputMethod_ == nullptr) return nullptr;
  return XCreateIC(inputMethod_, XNInputStyle, XIMPreeditNothing | XIMStatusNothing, XNClientWindow,
                   window, XNFocusWindow, window, nullptr);
}

long X11Keyboard::FilterEvents(XIC context) {
  long mask = 0;
  if (context != nullptr && XGetICValues(context, XNFilterEvents, &mask, nullptr) != nullptr) {
    mask = 0;
  }
  return mask;
}

void X11Keyboard::FindNumLockMask() {
  numLockMask_ = 0;
  const KeyCode numLock = XKeysymToKeycode(display_, XK_Num_Lock);
  XModifierKeymap* map = XGetModifierMapping(display_);
  if (map == nullptr) return;
  for (int modifier = 0; modifier < 8; ++modifier) {
    for (int i = 0; i < map->max_keypermod; ++i) {
      const KeyCode code = map->modifiermap[modifier * map->max_keypermod + i];
      if (code != 0 && code == numLock) numLockMask_ = 1u << modifier;
    }
  }
  XFreeModifiermap(map);
}

void X11Keyboard::RefreshMapping(XMappingEvent& event) {
  XRefreshKeyboardMapping(&event);
  FindNumLockMask();
}

KeyIdentity X11Keyboard::Identify(unsigned keycode, unsigned state) const {
  const auto code = static_cast<KeyCode>(keycode);
  const int group = static_cast<int>((state >> 13) & 3u);
  const KeySym plain = XkbKeycodeToKeysym(display_, code, group, 0);
  const KeySym shifted = XkbKeycodeToKeysym(display_, code, group, 1);
  if (IsKeypadKeysym(plain) || IsKeypadKeysym(shifted)) {
    // The keypad's meaning depends on Num Lock and Shift.
    KeySym actual = NoSymbol;
    unsigned consumed = 0;
    if (XkbLookupKeySym(display_, code, state, &consumed, &actual) && actual != NoSymbol) {
      if (const std::optional<KeyIdentity> key = IdentityOfKeysym(actual)) return *key;
    }
  }
  if (const std::optional<KeyIdentity> key = IdentityOfKeysym(plain)) return *key;
  if (group != 0) {
    if (const std::optional<KeyIdentity> key =
            IdentityOfKeysym(XkbKeycodeToKeysym(display_, code, 0, 0))) {
      return *key;
    }
  }
  for (const PlacedKey& placed : kPlacedKeys) {
    if (placed.keycode == keycode) return {placed.virtualKey, placed.virtualKey, false};
  }
  return {};
}

std::int16_t X11Keyboard::VirtualKeyOfKeycode(unsigned keycode) const {
  return Identify(keycode, 0).virtualKey;
}

std::u16string X11Keyboard::TextOf(XKeyEvent& event, XIC context, const KeyIdentity& key) const {
  const bool control = (event.state & ControlMask) != 0;
  if (control) {
    std::u16string text;
    if (const char16_t c = platform::ControlCharacter(key.virtualKey)) text.push_back(c);
    return text;
  }
  std::u16string text;
  if (context != nullptr) {
    std::array<char, 64> small{};
    std::vector<char> large;
    char* buffer = small.data();
    int size = static_cast<int>(small.size());
    KeySym keysym = NoSymbol;
    Status status = 0;
    int length = Xutf8LookupString(context, &event, buffer, size, &keysym, &status);
    if (status == XBufferOverflow) {
      large.resize(static_cast<std::size_t>(length) + 1);
      buffer = large.data();
      size = static_cast<int>(large.size());
      length = Xutf8LookupString(context, &event, buffer, size, &keysym, &status);
    }
    if ((status == XLookupChars || status == XLookupBoth) && length > 0) {
      text = velkcore::UTF8to16(std::string_view(buffer, static_cast<std::size_t>(length)));
    }
  } else {
    KeySym keysym = NoSymbol;
    std::array<char, 16> ignored{};
    XLookupString(&event, ignored.data(), static_cast<int>(ignored.size()), &keysym, nullptr);
    AppendUTF32(text, UnicodeOfKeysym(keysym));
  }
  // The desktop makes no character for Delete.
  std::erase(text, u'\x7F');
  return text;
}

std::optional<KeyCode> KeycodeOfVirtualKey(Display* display, std::int16_t virtualKey, bool extended,
                                           bool numLockOn) {
  for (const KeySym keysym : KeysymsOf(virtualKey, extended, numLockOn)) {
    const KeyCode code = XKeysymToKeycode(display, keysym);
    if (code != 0) return code;
  }
  return std::nullopt;
}

char16_t UnshiftedCharacterOfVirtualKey(std::int16_t virtualKey) {
  if ((virtualKey >= 'A' && virtualKey <= 'Z') || (virtualKey >= '0' && virtualKey <= '9')) {
    return static_cast<char16_t>(virtualKey);
  }
  if (virtualKey >= vk::kNumpad0 && virtualKey <= vk::kNumpad9) {
    return static_cast<char16_t>(u'0' + (virtualKey - vk::kNumpad0));
  }
  if (virtualKey == vk::kReturn || virtualKey == vk::kTab || virtualKey == vk::kBackspace ||
      virtualKey == vk::kEscape) {
    return 0;
  }
  for (const KeysymKey& entry : kKeysymKeys) {
    if (entry.virtualKey != virtualKey) continue;
    const char32_t c = UnicodeOfKeysym(entry.keysym);
    if (c >= 0x20 && c < 0x7F) return static_cast<char16_t>(c);
  }
  return 0;
}

}  // namespace velkui::ui::x11
