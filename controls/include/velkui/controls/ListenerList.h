#pragma once

#include <algorithm>
#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

#include <velkcore/Error.h>
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
  using Function = std::function<void(MessageBase*)>;
  using FunctionPtr = std::shared_ptr<Function>;

  ListenerList() = default;
  ListenerList(const ListenerList&) = delete;
  ListenerList& operator=(const ListenerList&) = delete;
  ~ListenerList() { state_->entries.clear(); }

  // A null listener is an input-contract violation; one already in the list is
  // not added twice.
  void Add(const FunctionPtr& listener) {
    velkcore::RequireInput(listener != nullptr);
    DropEmptyEntries();
    if (!Contains(listener)) state_->entries.push_back(listener);
  }
  bool Remove(const FunctionPtr& listener) {
    auto& entries = state_->entries;
    const auto found = std::find(entries.begin(), entries.end(), listener);
    if (found == entries.end()) return false;
    entries.erase(found);
    return true;
  }
  bool Contains(const FunctionPtr& listener) const {
    const auto& entries = state_->entries;
    return std::find(entries.begin(), entries.end(), listener) != entries.end();
  }
  void DropEmptyEntries() {
    std::erase_if(state_->entries, [](const FunctionPtr& f) { return !f || !*f; });
  }
  void Clear() { state_->entries.clear(); }
  // Entries, empty ones included.
  std::size_t Size() const { return state_->entries.size(); }
  bool Empty() const { return state_->entries.empty(); }

  // Calls every live entry in order. A listener that throws ends the send and
  // the exception reaches the caller.
  void Send(MessageBase* message) const {
    const std::shared_ptr<State> state = state_;
    const std::vector<FunctionPtr> snapshot = state->entries;
    for (const FunctionPtr& entry : snapshot) {
      const auto& live = state->entries;
      if (std::find(live.begin(), live.end(), entry) == live.end()) continue;
      // A copy: the listener may empty its own callback while it runs.
      const Function call = *entry;
      if (call) call(message);
    }
  }

 private:
  struct State {
    std::vector<FunctionPtr> entries;
  };
  std::shared_ptr<State> state_ = std::make_shared<State>();
};

using ControlListenerList = ListenerList<ui::MessageT<ui::UI_Node>>;
using ConstControlListenerList = ListenerList<ui::MessageT<const ui::UI_Node>>;
using ControlCallback = ControlListenerList::Function;
using ControlCallbackP = ControlListenerList::FunctionPtr;
using ConstControlCallback = ConstControlListenerList::Function;
using ConstControlCallbackP = ConstControlListenerList::FunctionPtr;

}  // namespace velkui::controls
