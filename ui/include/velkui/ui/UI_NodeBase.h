#pragma once

#include <velkcore/RefCountedObject.h>
#include <velkui/ui/UI_Container.h>

namespace velkui::ui {

// A node is always also a container: the reference count plus the child list.
class UI_NodeBase : public velkcore::RefCountedObject, public UI_Container {
 protected:
  explicit UI_NodeBase(UI_Node* self) : UI_Container(self) {}
};

}  // namespace velkui::ui
