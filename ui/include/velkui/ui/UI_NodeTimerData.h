#pragma once

#include <cstdint>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/RefCountedObject.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// The tooltip timer's id; the library's other internal timers come from
// UI_NodeManager::GetUniqueTimerID (-2, -3, ...), clients use 0 and above.
inline constexpr std::int32_t kToolTipTimerID = -1;

// One timer of one node. A window's timer manager creates it and keeps it live
// until it is removed; the node lists it so that it can remove its own timers.
// Nodes are held by plain pointer: a node removes its timers when it leaves a
// window or dies, and a dying manager detaches every timer it still holds.
class UI_NodeTimerData : public velkcore::RefCountedObject {
 public:
  UI_NodeTimerData(UI_Node* managerNode, UI_Node* node, std::int32_t id, float seconds);
  ~UI_NodeTimerData() override;

  UI_Node* GetManagerNode() const { return managerNode_; }
  UI_Node* GetNode() const { return node_; }
  std::int32_t GetTimerID() const { return id_; }
  float GetSeconds() const { return seconds_; }
  // Unique among the timers of one manager (1, 2, ...); platform forms use it
  // as the platform timer's id.
  std::uint32_t GetSerial() const { return serial_; }
  // Whether a manager still holds the timer.
  bool IsLive() const { return manager_ != nullptr; }
  UI_NodeTimerManager* GetManager() const { return manager_; }

 protected:
  // Platform forms start and stop their platform timer here; the manager calls
  // Start once the timer is live and Stop when it removes it.
  virtual void Start();
  virtual void Stop();

 private:
  friend class UI_NodeTimerManager;

  UI_Node* managerNode_;
  UI_Node* node_;
  std::int32_t id_;
  float seconds_;
  std::uint32_t serial_ = 0;
  UI_NodeTimerManager* manager_ = nullptr;
};

using UI_NodeTimerDataP = boost::intrusive_ptr<UI_NodeTimerData>;
// A node's own timers (live ones and, until pruned, removed ones).
using UI_NodeTimerList = std::vector<UI_NodeTimerDataP>;

}  // namespace velkui::ui
