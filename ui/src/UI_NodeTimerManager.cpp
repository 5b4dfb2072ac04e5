#include <velkui/ui/UI_NodeTimerManager.h>

#include <algorithm>
#include <cmath>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/ui/InputCapture.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_ToolTipManager.h>

#include "NodeHold.h"

namespace velkui::ui {

// ---- UI_NodeTimerData ----

UI_NodeTimerData::UI_NodeTimerData(UI_Node* managerNode, UI_Node* node, std::int32_t id,
                                   float seconds)
    : managerNode_(managerNode), node_(node), id_(id), seconds_(seconds) {}

UI_NodeTimerData::~UI_NodeTimerData() = default;

void UI_NodeTimerData::Start() {}

void UI_NodeTimerData::Stop() {}

// ---- UI_NodeTimerManager ----

namespace {

void Prune(UI_NodeTimerList& list, const UI_NodeTimerData* removed) {
  std::erase_if(list, [removed](const UI_NodeTimerDataP& entry) {
    return entry.get() == removed || !entry->IsLive();
  });
}

}  // namespace

UI_NodeTimerManager::UI_NodeTimerManager(UI_Node* managerNode, Factory factory)
    : managerNode_(managerNode), factory_(std::move(factory)) {}

UI_NodeTimerManager::~UI_NodeTimerManager() {
  // Nodes may outlive the window; their lists then hold dead timers, which
  // they prune the next time they touch them.
  const auto timers = std::move(timers_);
  timers_.clear();
  for (const auto& [serial, data] : timers) Detach(*data);
}

UI_NodeTimerDataP UI_NodeTimerManager::CreateTimer(UI_Node* node, std::int32_t id, float seconds) {
  velkcore::RequireInput(node != nullptr && std::isfinite(seconds) && seconds >= 0.0f);
  UI_NodeTimerDataP data =
      factory_ ? factory_(managerNode_, node, id, seconds)
               : velkcore::MakeIntrusive<UI_NodeTimerData>(managerNode_, node, id, seconds);
  velkcore::RequireInput(data != nullptr && data->manager_ == nullptr);
  data->serial_ = nextSerial_++;
  data->manager_ = this;
  timers_.emplace(data->serial_, data);
  data->Start();
  return data;
}

void UI_NodeTimerManager::Detach(UI_NodeTimerData& data) {
  data.manager_ = nullptr;
  data.Stop();
}

bool UI_NodeTimerManager::RemoveTimer(UI_Node* node, std::int32_t id, UI_NodeTimerList& list) {
  bool removed = false;
  // A copy: Stop may run platform code, and the list is pruned afterwards.
  const UI_NodeTimerList entries = list;
  for (const UI_NodeTimerDataP& data : entries) {
    if (data->node_ != node || data->id_ != id || data->manager_ != this) continue;
    timers_.erase(data->serial_);
    Detach(*data);
    removed = true;
  }
  Prune(list, nullptr);
  return removed;
}

void UI_NodeTimerManager::RemoveAllTimers(UI_Node* node, UI_NodeTimerList& list) {
  const UI_NodeTimerList entries = list;
  for (const UI_NodeTimerDataP& data : entries) {
    if (data->node_ != node || data->manager_ != this) continue;
    timers_.erase(data->serial_);
    Detach(*data);
  }
  Prune(list, nullptr);
}

bool UI_NodeTimerManager::RemoveTimerData(const UI_NodeTimerData* data, UI_NodeTimerList& list) {
  UI_NodeTimerData* live = GetTimerData(data);
  if (live == nullptr) {
    Prune(list, data);
    return false;
  }
  const UI_NodeTimerDataP keep(live);
  timers_.erase(live->serial_);
  Detach(*live);
  Prune(list, live);
  return true;
}

UI_NodeTimerData* UI_NodeTimerManager::GetTimerData(const UI_NodeTimerData* data) const {
  if (data == nullptr || data->manager_ != this) return nullptr;
  const auto found = timers_.find(data->serial_);
  return found != timers_.end() && found->second.get() == data ? found->second.get() : nullptr;
}

UI_NodeTimerData* UI_NodeTimerManager::FindTimerBySerial(std::uint32_t serial) const {
  const auto found = timers_.find(serial);
  return found != timers_.end() ? found->second.get() : nullptr;
}

std::vector<UI_NodeTimerData*> UI_NodeTimerManager::GetTimers() const {
  std::vector<UI_NodeTimerData*> timers;
  timers.reserve(timers_.size());
  for (const auto& [serial, data] : timers_) timers.push_back(data.get());
  return timers;
}

bool UI_NodeTimerManager::DispatchPossibleTimer(UI_NodeTimerData* data) {
  if (GetTimerData(data) == nullptr) return false;
  const UI_NodeTimerDataP keep(data);
  UI_Node* const node = data->GetNode();
  if (node != managerNode_ && !node->UI_IsChildOf(managerNode_)) return false;
  const NodeP keepNode = detail::Hold(node);
  const std::int32_t id = data->GetTimerID();

  UI_NodeManager* manager = UI_NodeManager::Get(false);
  if (manager != nullptr && manager->GetActiveInputCapture() == node) {
    const InputCaptureP capture(manager->GetInputCapture());
    if (capture->DoTimerNotify(id)) return true;
  }

  if (id != kToolTipTimerID) {
    if (!node->UI_DoTimerNotify(id)) {
      // The handler may have removed this timer or installed a new one with
      // the same id: only this very timer goes, and only while it is live.
      // (The node's manager may have changed too, when the node moved.)
      if (UI_NodeTimerManager* owner = data->GetManager()) {
        owner->RemoveTimerData(data, node->UI_GetTimerList());
      }
    }
    return true;
  }

  RemoveTimerData(data, node->UI_GetTimerList());
  if (manager != nullptr) {
    if (UI_ToolTipManager* tips = manager->GetToolTipManager()) tips->ToolTipTimerFired(*node);
  }
  return true;
}

// ---- UI_Node's timers ----

void UI_Node::UI_InstallTimer(float seconds, std::int32_t id) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0f);
  UI_NodeTimerManager* manager = UI_GetTimerManager(true);
  // A node in no window has nobody to tick its timer.
  velkcore::RequireInput(manager != nullptr);
  UI_RemoveTimer(id);
  timers_.push_back(manager->CreateTimer(this, id, seconds));
}

bool UI_Node::UI_RemoveTimer(std::int32_t id) {
  bool removed = false;
  // By each timer's own manager: the node may have moved since, and this also
  // runs from the destructor, where no virtual operation may be called.
  const UI_NodeTimerList entries = timers_;
  for (const UI_NodeTimerDataP& data : entries) {
    if (data->GetTimerID() != id) continue;
    if (UI_NodeTimerManager* manager = data->GetManager()) {
      removed = manager->RemoveTimerData(data.get(), timers_) || removed;
    }
  }
  std::erase_if(timers_, [id](const UI_NodeTimerDataP& data) {
    return data->GetTimerID() == id || !data->IsLive();
  });
  return removed;
}

void UI_Node::UI_RemoveAllTimers() {
  const UI_NodeTimerList entries = std::move(timers_);
  timers_.clear();
  UI_NodeTimerList scratch;
  for (const UI_NodeTimerDataP& data : entries) {
    if (UI_NodeTimerManager* manager = data->GetManager())
      manager->RemoveTimerData(data.get(), scratch);
  }
}

bool UI_Node::UI_HasTimer(std::int32_t id) const {
  return std::any_of(timers_.begin(), timers_.end(), [id](const UI_NodeTimerDataP& data) {
    return data->GetTimerID() == id && data->IsLive();
  });
}

}  // namespace velkui::ui
