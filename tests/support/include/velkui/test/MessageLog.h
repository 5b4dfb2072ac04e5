#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <velkui/controls/ControlMessages.h>
#include <velkui/controls/UI_ControlView.h>
#include <velkui/controls/UI_InteractiveControlView.h>

namespace velkui::test {

// Records the messages of controls as short strings, in order.
class MessageLog {
 public:
  void Watch(controls::UI_ControlView& control) {
    Keep(
        control,
        [this](ui::MessageT<ui::UI_Node>* m) {
          if (auto* button = dynamic_cast<controls::UI_ButtonChangedMessage*>(m)) {
            Add(Name(m) + "changed(" + std::to_string(button->GetModKeys().Get()) + ")");
          } else {
            Add(Name(m) + "changed");
          }
        },
        false);
    if (auto* interactive = dynamic_cast<controls::UI_InteractiveControlView*>(&control)) {
      auto f = std::make_shared<controls::ControlCallback>([this](ui::MessageT<ui::UI_Node>* m) {
        auto* step = dynamic_cast<controls::UI_InteractiveControlChangedMessage*>(m);
        static const char* const kNames[] = {"begin", "continue", "finish", "cancel"};
        std::string text = Name(m) + kNames[step->GetChangeMessage()];
        if (step->GetChangeMessage() == controls::kContinueChange) {
          text += "(" + std::to_string(step->GetModKeys().Get()) + ")";
        }
        Add(text);
      });
      interactive->NotifyWhenChangedInteractively(f);
      callbacks_.push_back(f);
    }
  }
  void WatchHover(controls::UI_ControlView& control) {
    Keep(
        control,
        [this](ui::MessageT<ui::UI_Node>* m) {
          auto* hover = dynamic_cast<controls::UI_HoverMessage*>(m);
          Add(Name(m) + "hover(" + std::to_string(hover->GetMouseEvent().GetAction()) + ")");
        },
        true);
  }
  // With a prefix per control ("name:"), for logs of several controls.
  void SetPrefixed(bool prefixed) { prefixed_ = prefixed; }
  const std::vector<std::string>& Entries() const { return entries_; }
  void Clear() { entries_.clear(); }
  // Called with each entry as it is added.
  std::function<void(const std::string&)> onAdd;

 private:
  void Keep(controls::UI_ControlView& control, controls::ControlCallback f, bool hover) {
    auto p = std::make_shared<controls::ControlCallback>(std::move(f));
    if (hover) {
      control.NotifyHover(p);
    } else {
      control.NotifyWhenChanged(p);
    }
    callbacks_.push_back(p);
  }
  std::string Name(ui::MessageT<ui::UI_Node>* m) const {
    return prefixed_ ? m->GetSubject()->UI_GetNodeID() + ":" : std::string();
  }
  void Add(std::string entry) {
    entries_.push_back(std::move(entry));
    if (onAdd) onAdd(entries_.back());
  }

  std::vector<std::string> entries_;
  std::vector<controls::ControlCallbackP> callbacks_;
  bool prefixed_ = false;
};

}  // namespace velkui::test
