#pragma once

#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// Where the automation recorder plugs into the routing: every mouse and
// keyboard event is shown to it, with its target, before anything handles it.
// Install one with UI_NodeManager::SetEventRecorder.
class UI_EventRecorder {
 public:
  virtual ~UI_EventRecorder() = default;
  // `event` is in `target`'s coordinates.
  virtual void RecordMouseEvent(UI_Node* target, const MouseEvent& event) = 0;
  virtual void RecordKeyboardEvent(UI_Node* target, const KeyboardEvent& event) = 0;
};

}  // namespace velkui::ui
