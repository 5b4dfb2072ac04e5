#pragma once

#include <string>
#include <vector>

#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_Node.h>

namespace velkui::test {

// A view (of class `Base`) that keeps a copy of every mouse and keyboard event
// it is offered before handling it as `Base` does.
template <typename Base>
class InputRecorder : public Base {
 public:
  using Base::Base;

  std::vector<ui::MouseEvent> mouse;
  std::vector<ui::KeyboardEvent> keys;

  bool UI_DoMouseEvent(ui::UI_Node* target, const ui::MouseEvent& event) override {
    mouse.push_back(event);
    return Base::UI_DoMouseEvent(target, event);
  }
  bool UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) override {
    keys.push_back(event);
    return Base::UI_DoKeyboardEvent(target, event);
  }
  // The events of one action only.
  std::vector<ui::MouseEvent> MouseOf(ui::MouseEvent::Action action) const {
    std::vector<ui::MouseEvent> found;
    for (const ui::MouseEvent& e : mouse) {
      if (e.GetAction() == action) found.push_back(e);
    }
    return found;
  }
  // The characters typed, in order.
  std::u16string Typed() const {
    std::u16string text;
    for (const ui::KeyboardEvent& e : keys) {
      if (e.IsActionKeyChar() && e.GetNumCharacters() > 0) text += e.GetCharacter(0);
    }
    return text;
  }
};

}  // namespace velkui::test
