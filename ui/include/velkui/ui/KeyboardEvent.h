#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include <velkui/ui/KeyboardCode.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// One keyboard event as the node manager routes it.
class KeyboardEvent {
 public:
  enum Action : std::int32_t {
    kKeyDown = 1,
    kKeyUp = 2,
    kCharacter = 3,
    kDeadCharacter = 4,
  };

  KeyboardEvent(Action action, std::vector<char16_t> characters, std::int16_t osCode,
                ModifierKeys modifiers, bool repeat = false, const OS_Event* osEvent = nullptr);
  KeyboardEvent(const KeyboardEvent&) = default;
  KeyboardEvent& operator=(const KeyboardEvent&) = default;
  virtual ~KeyboardEvent() = default;

  // The control code of a platform virtual key (negative: extended key);
  // kKeyNone for any other key.
  static std::uint16_t GetControlCode(std::int16_t osCode);

  Action GetAction() const { return action_; }
  std::size_t GetNumCharacters() const { return characters_.size(); }
  // Raises the input-contract violation for an index out of range.
  char16_t GetCharacter(std::size_t index) const;
  std::int16_t GetOSCode() const { return osCode_; }
  bool IsExtendedOSCode() const { return osCode_ < 0; }
  ModifierKeys GetModKey() const { return modifiers_; }
  bool IsRepeat() const { return repeat_; }
  const OS_Event* GetOSEvent() const { return osEvent_; }

  // Printable from the first character when there is one, else the control
  // code of the platform key.
  KeyboardCode GetCode() const;
  // The control code of the platform key, whatever characters came with it.
  std::uint16_t GetKeyControlCode() const { return GetControlCode(osCode_); }
  bool CompareCode(KeyboardCode code) const { return GetCode() == code; }
  // Codes equal and the modifiers equal, Caps Lock ignored.
  bool CompareShortcut(KeyboardCode code, ModifierKeys modifiers) const;

  bool IsActionKeyDown() const { return action_ == kKeyDown; }
  bool IsActionKeyUp() const { return action_ == kKeyUp; }
  bool IsActionKeyChar() const { return action_ == kCharacter; }
  bool IsActionKeyDeadChar() const { return action_ == kDeadCharacter; }

 private:
  Action action_;
  std::vector<char16_t> characters_;
  std::int16_t osCode_;
  ModifierKeys modifiers_;
  bool repeat_;
  const OS_Event* osEvent_;
};

}  // namespace velkui::ui
