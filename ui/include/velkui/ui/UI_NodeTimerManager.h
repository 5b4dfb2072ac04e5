#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <vector>

#include <velkui/ui/UI_NodeTimerData.h>

namespace velkui::ui {

// The timers of one window (its manager node). The window owns it
// (UI_GetTimerManager on the window; on any other node it is the hosting
// window's) and calls DispatchPossibleTimer when a platform timer ticks.
class UI_NodeTimerManager {
 public:
  // Makes the timer data (a platform form that owns a platform timer, usually).
  using Factory = std::function<UI_NodeTimerDataP(UI_Node* managerNode, UI_Node* node,
                                                  std::int32_t id, float seconds)>;

  // An empty factory makes plain timer data (no platform timer).
  UI_NodeTimerManager(UI_Node* managerNode, Factory factory);
  // Stops every live timer and detaches it from its node's list.
  ~UI_NodeTimerManager();
  UI_NodeTimerManager(const UI_NodeTimerManager&) = delete;
  UI_NodeTimerManager& operator=(const UI_NodeTimerManager&) = delete;

  UI_Node* GetManagerNode() const { return managerNode_; }

  // A new live timer of `node` (not null) with `id`, ticking every `seconds`
  // (finite, not negative). It does not touch other timers of the node:
  // UI_Node::UI_InstallTimer removes a timer with the same id first.
  UI_NodeTimerDataP CreateTimer(UI_Node* node, std::int32_t id, float seconds);
  // Removes the live timers of `node` with `id` from this manager and from
  // `list` (the node's own list); true when there was one.
  bool RemoveTimer(UI_Node* node, std::int32_t id, UI_NodeTimerList& list);
  // Removes every timer of `node` from this manager and from `list`.
  void RemoveAllTimers(UI_Node* node, UI_NodeTimerList& list);
  // Removes exactly this timer (when it is live here) and drops it from `list`.
  bool RemoveTimerData(const UI_NodeTimerData* data, UI_NodeTimerList& list);
  // `data` when it is live in this manager, else null.
  UI_NodeTimerData* GetTimerData(const UI_NodeTimerData* data) const;
  UI_NodeTimerData* FindTimerBySerial(std::uint32_t serial) const;
  std::size_t GetTimerCount() const { return timers_.size(); }
  // The live timers in the order they were made.
  std::vector<UI_NodeTimerData*> GetTimers() const;

  // One tick of `data`'s timer (UI_DispatchPossibleTimer): ignored unless the
  // timer is live here and its node is the manager node or below it; the
  // node's active input capture is asked first; then the node's
  // UI_DoTimerNotify, and an answer of false removes that timer (only that one,
  // and only while it is still live: the handler may have removed or replaced
  // it). The tooltip timer goes to the node manager's tooltip manager.
  // Answers whether the tick was handled.
  bool DispatchPossibleTimer(UI_NodeTimerData* data);

 private:
  void Detach(UI_NodeTimerData& data);

  UI_Node* managerNode_;
  Factory factory_;
  std::map<std::uint32_t, UI_NodeTimerDataP> timers_;
  std::uint32_t nextSerial_ = 1;
};

}  // namespace velkui::ui
