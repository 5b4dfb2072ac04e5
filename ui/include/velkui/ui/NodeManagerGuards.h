#pragma once

#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/UI_Node.h>

// Scoped guards of the node manager: each raises a counter or registers on
// construction and undoes it on destruction. They nest.

namespace velkui::ui {

class ScopedGuardBase {
 public:
  ScopedGuardBase(const ScopedGuardBase&) = delete;
  ScopedGuardBase& operator=(const ScopedGuardBase&) = delete;

 protected:
  ScopedGuardBase() = default;
  ~ScopedGuardBase() = default;
};

// Lets a series of focus changes reach listeners as one: the outermost guard
// takes focus away at the start and, at its end, gives it to the node that
// holds it then (or, with `restoreToCurrent`, back to the node that had it at
// the start, when that one is still shown). Nested guards do nothing.
class GroupingFocusChanges : ScopedGuardBase {
 public:
  GroupingFocusChanges(UI_NodeManager& manager, bool restoreToCurrent);
  ~GroupingFocusChanges();

 private:
  UI_NodeManager& manager_;
  bool outermost_ = false;
  NodeP restore_;
};

// Focus changes are not passed on to the platform while it lives.
class SuspendOSFocusUpdates : ScopedGuardBase {
 public:
  explicit SuspendOSFocusUpdates(UI_NodeManager& manager);
  ~SuspendOSFocusUpdates();

 private:
  UI_NodeManager& manager_;
};

// The mouse-over state stays as it is while it lives.
class SuspendMouseOverUpdates : ScopedGuardBase {
 public:
  explicit SuspendMouseOverUpdates(UI_NodeManager& manager);
  ~SuspendMouseOverUpdates();

 private:
  UI_NodeManager& manager_;
};

// A click does not activate `window` while it lives.
class SuspendOSMouseActivates : ScopedGuardBase {
 public:
  SuspendOSMouseActivates(UI_NodeManager& manager, const OS_Window* window);
  ~SuspendOSMouseActivates();

 private:
  UI_NodeManager& manager_;
  const OS_Window* window_;
};

class SetModalWindow : ScopedGuardBase {
 public:
  SetModalWindow(UI_NodeManager& manager, OS_Window* window);
  ~SetModalWindow();

 private:
  UI_NodeManager& manager_;
  OS_Window* window_;
};

class NotifyUserResizing : ScopedGuardBase {
 public:
  NotifyUserResizing(UI_NodeManager& manager, UI_Node* node, bool live);
  ~NotifyUserResizing();

 private:
  UI_NodeManager& manager_;
  NodeP node_;
  bool live_;
};

class AddAndRemoveMouseEventFilterNode : ScopedGuardBase {
 public:
  AddAndRemoveMouseEventFilterNode(UI_NodeManager& manager, UI_Node* node);
  ~AddAndRemoveMouseEventFilterNode();

 private:
  UI_NodeManager& manager_;
  UI_Node* node_;
};

class AddAndRemoveKeyboardEventFilterNode : ScopedGuardBase {
 public:
  AddAndRemoveKeyboardEventFilterNode(UI_NodeManager& manager, UI_Node* node);
  ~AddAndRemoveKeyboardEventFilterNode();

 private:
  UI_NodeManager& manager_;
  UI_Node* node_;
};

}  // namespace velkui::ui
