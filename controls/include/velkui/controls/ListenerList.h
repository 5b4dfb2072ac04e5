#pragma once

#include <cstddef>

#include <velkcore/SharedFunctions.h>
#include <velkui/controls/MessageT.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::controls {

// The listeners of one kind of control message: an ordered list of callbacks
// whose ownership is shared with the subscribers. A subscriber unsubscribes by
// emptying the callback it shares (assigning an empty function); empty entries
// are skipped when sending and dropped the next time anything is added.
//
// Sending works on a snapshot and survives every change a listener makes: a
// listener added during a send waits for the next one, one removed or emptied
// before it was reached is not called, and the list (or the control that
// holds it) may be destroyed by a listener, which ends the send.
template <typename MessageBase>
class ListenerList {
 public:
  using Functions = velkcore::SharedFunctions<void(MessageBase*)>;
  using Function = typename Functions::Function;
  using FunctionPtr = typename Functions::FunctionPtr;

  ListenerList() = default;
  ListenerList(const ListenerList&) = delete;
  ListenerList& operator=(const ListenerList&) = delete;

  // A null listener is an input-contract violation; one already in the list is
  // not added twice.
  void Add(const FunctionPtr& listener) {
    listeners_.DropEmptyFunctions();
    listeners_.Add(listener);
  }
  bool Remove(const FunctionPtr& listener) { return listeners_.Remove(listener); }
  bool Contains(const FunctionPtr& listener) const { return listeners_.Contains(listener); }
  void Clear() { listeners_.Clear(); }
  // Entries, empty ones included.
  std::size_t Size() const { return listeners_.Size(); }
  bool Empty() const { return listeners_.Empty(); }

  // Calls every live entry in order. A listener that throws ends the send and
  // the exception reaches the caller.
  void Send(MessageBase* message) const { listeners_.CallSkippingEmpty(message); }

 private:
  Functions listeners_;
};

using ControlListenerList = ListenerList<ui::MessageT<ui::UI_Node>>;
using ConstControlListenerList = ListenerList<ui::MessageT<const ui::UI_Node>>;
using ControlCallback = ControlListenerList::Function;
using ControlCallbackP = ControlListenerList::FunctionPtr;
using ConstControlCallback = ConstControlListenerList::Function;
using ConstControlCallbackP = ConstControlListenerList::FunctionPtr;

}  // namespace velkui::controls
