#pragma once

#include <algorithm>
#include <functional>
#include <memory>
#include <vector>

#include <velkcore/Error.h>

namespace velkcore {

template <typename Signature>
class SharedFunctions;

// An ordered list of shared callbacks. Calling is safe against changes made by
// the callbacks themselves: one removed during a call is not called if it was
// not reached yet, one added waits for the next call, and the list may even be
// destroyed by a callback.
template <typename R, typename... Args>
class SharedFunctions<R(Args...)> {
 public:
  using Function = std::function<R(Args...)>;
  using FunctionPtr = std::shared_ptr<Function>;

  SharedFunctions() = default;
  SharedFunctions(const SharedFunctions& other) : state_(std::make_shared<State>(*other.state_)) {}
  SharedFunctions& operator=(const SharedFunctions& other) {
    if (this != &other) state_ = std::make_shared<State>(*other.state_);
    return *this;
  }
  // A call under way stops at once: nothing of a destroyed list is called.
  ~SharedFunctions() { state_->functions.clear(); }

  // Appends `f`; a function already in the list is not added twice.
  void Add(const FunctionPtr& f) {
    RequireInput(f != nullptr);
    if (!Contains(f)) state_->functions.push_back(f);
  }
  FunctionPtr Add(Function f) {
    auto ptr = std::make_shared<Function>(std::move(f));
    state_->functions.push_back(ptr);
    return ptr;
  }
  bool Remove(const FunctionPtr& f) {
    auto& fs = state_->functions;
    const auto found = std::find(fs.begin(), fs.end(), f);
    if (found == fs.end()) return false;
    fs.erase(found);
    return true;
  }
  bool Contains(const FunctionPtr& f) const {
    const auto& fs = state_->functions;
    return std::find(fs.begin(), fs.end(), f) != fs.end();
  }
  // Drops entries whose function was emptied (how subscribers often unsubscribe).
  void DropEmptyFunctions() {
    std::erase_if(state_->functions, [](const FunctionPtr& f) { return !*f; });
  }
  void Clear() { state_->functions.clear(); }
  std::size_t Size() const { return state_->functions.size(); }
  bool Empty() const { return state_->functions.empty(); }

  // Calls every function in order. An empty std::function throws std::bad_function_call.
  void Call(Args... args) const {
    ForEachLive([&](const Function& f) {
      f(args...);
      return false;
    });
  }

  // Calls every function in order, skipping the ones that were emptied.
  void CallSkippingEmpty(Args... args) const {
    ForEachLive([&](const Function& f) {
      if (f) f(args...);
      return false;
    });
  }

  // For boolean callbacks: stops at the first that answers true and returns true.
  bool CallUntilTrue(Args... args) const
    requires std::is_convertible_v<R, bool>
  {
    return ForEachLive([&](const Function& f) { return static_cast<bool>(f(args...)); });
  }

 private:
  struct State {
    std::vector<FunctionPtr> functions;
  };

  template <typename Visit>
  bool ForEachLive(Visit&& visit) const {
    // Holding the state keeps it alive should a callback destroy this list.
    const std::shared_ptr<State> state = state_;
    const std::vector<FunctionPtr> snapshot = state->functions;
    for (const FunctionPtr& f : snapshot) {
      const auto& live = state->functions;
      if (std::find(live.begin(), live.end(), f) == live.end()) continue;
      // A copy: the callback may empty or replace its own function while it runs.
      const Function call = *f;
      if (visit(call)) return true;
    }
    return false;
  }

  std::shared_ptr<State> state_ = std::make_shared<State>();
};

}  // namespace velkcore
