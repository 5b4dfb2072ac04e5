#pragma once

// A node manager, a theme, a virtual clock and a root that stands in for a
// window (it owns a timer manager), plus helpers that route input through the
// node manager the way a window does.

#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include <velkcore/Geometry.h>
#include <velkui/controls/ControlClock.h>
#include <velkui/controls/ControlMessages.h>
#include <velkui/controls/UI_InteractiveControlView.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_NodeTimerManager.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::controls::test {

using ui::KeyboardEvent;
using ui::ModifierKeys;
using ui::MouseEvent;
using velkcore::PointT;
using velkcore::RectT;

// Platform key codes.
inline constexpr std::int16_t kVkReturn = 13;
inline constexpr std::int16_t kVkEscape = 27;
inline constexpr std::int16_t kVkSpace = 32;
inline constexpr std::int16_t kVkAlt = 18;

class TestRoot : public ui::UI_SubView {
 public:
  TestRoot()
      : timers_(
            std::make_unique<ui::UI_NodeTimerManager>(this, ui::UI_NodeTimerManager::Factory{})) {
    UI_SetNodeID("root");
  }
  ui::UI_NodeTimerManager* UI_GetTimerManager(bool) override { return timers_.get(); }
  const ui::UI_NodeTimerManager* UI_GetTimerManager(bool) const override { return timers_.get(); }
  ui::UI_NodeTimerManager& Timers() { return *timers_; }

 private:
  std::unique_ptr<ui::UI_NodeTimerManager> timers_;
};

// Records the messages of controls as short strings, in order.
class MessageLog {
 public:
  void Watch(UI_ControlView& control) {
    Keep(
        control,
        [this](ui::MessageT<ui::UI_Node>* m) {
          if (auto* button = dynamic_cast<UI_ButtonChangedMessage*>(m)) {
            Add(Name(m) + "changed(" + std::to_string(button->GetModKeys().Get()) + ")");
          } else {
            Add(Name(m) + "changed");
          }
        },
        false);
    if (auto* interactive = dynamic_cast<UI_InteractiveControlView*>(&control)) {
      auto f = std::make_shared<ControlCallback>([this](ui::MessageT<ui::UI_Node>* m) {
        auto* step = dynamic_cast<UI_InteractiveControlChangedMessage*>(m);
        static const char* const kNames[] = {"begin", "continue", "finish", "cancel"};
        std::string text = Name(m) + kNames[step->GetChangeMessage()];
        if (step->GetChangeMessage() == kContinueChange) {
          text += "(" + std::to_string(step->GetModKeys().Get()) + ")";
        }
        Add(text);
      });
      interactive->NotifyWhenChangedInteractively(f);
      callbacks_.push_back(f);
    }
  }
  void WatchHover(UI_ControlView& control) {
    Keep(
        control,
        [this](ui::MessageT<ui::UI_Node>* m) {
          auto* hover = dynamic_cast<UI_HoverMessage*>(m);
          Add(Name(m) + "hover(" + std::to_string(hover->GetMouseEvent().GetAction()) + ")");
        },
        true);
  }
  // With a prefix per control ("name:"), for logs of several controls.
  void SetPrefixed(bool prefixed) { prefixed_ = prefixed; }
  const std::vector<std::string>& Entries() const { return entries_; }
  void Clear() { entries_.clear(); }
  std::function<void()> onAdd;

 private:
  void Keep(UI_ControlView& control, ControlCallback f, bool hover) {
    auto p = std::make_shared<ControlCallback>(std::move(f));
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
    if (onAdd) onAdd();
  }

  std::vector<std::string> entries_;
  std::vector<ControlCallbackP> callbacks_;
  bool prefixed_ = false;
};

using Log = std::vector<std::string>;

class ControlTest : public ::testing::Test {
 protected:
  ControlTest() {
    ui::UI_NodeManager::Set(&manager);
    ui::Theme::Initialize(std::make_unique<ui::Theme>());
    SetControlClock([this] { return now; });
    root->UI_SetLocalRectF({0, 0, 400, 300});
    root->UI_Show(true);
  }
  ~ControlTest() override {
    manager.EndInputCapture(true);
    root->DeleteChildren();
    root.reset();
    SetControlClock({});
    ui::Theme::Terminate();
    ui::UI_NodeManager::Set(nullptr);
  }

  template <typename Control, typename... Args>
  boost::intrusive_ptr<Control> Add(const RectT<float>& frame, Args&&... args) {
    auto control = velkcore::MakeIntrusive<Control>(std::forward<Args>(args)...);
    control->UI_SetLocalRectF(frame);
    control->UI_Show(true);
    root->ChildPushBack(control);
    return control;
  }

  bool Mouse(MouseEvent::Action action, float x, float y, ModifierKeys modifiers = {},
             std::int32_t clicks = 1) {
    const MouseEvent event(action, MouseEvent::kLeftButton, clicks, {x, y}, modifiers);
    if (action == MouseEvent::kMove) root->UI_UpdateMouseOverState(event);
    return root->UI_DispatchMouseEvent(event, true);
  }
  bool Press(float x, float y, ModifierKeys m = {}) {
    return Mouse(MouseEvent::kButtonDown, x, y, m);
  }
  bool Release(float x, float y, ModifierKeys m = {}) {
    return Mouse(MouseEvent::kButtonUp, x, y, m);
  }
  bool Move(float x, float y) { return Mouse(MouseEvent::kMove, x, y); }
  void Click(float x, float y, ModifierKeys m = {}) {
    Move(x, y);
    Press(x, y, m);
    Release(x, y, m);
  }

  // Key events go where a window sends them: to the focus leaf, else the root.
  bool Key(KeyboardEvent::Action action, std::int16_t osCode, ModifierKeys modifiers = {},
           std::vector<char16_t> chars = {}, bool repeat = false) {
    ui::UI_Node* target = manager.GetKeyboardFocusLeafNode();
    if (target == nullptr) target = root.get();
    return ui::UI_Node::UI_DispatchKeyboardEvent(
        target, KeyboardEvent(action, std::move(chars), osCode, modifiers, repeat));
  }
  bool KeyDown(std::int16_t code, ModifierKeys m = {}, std::vector<char16_t> chars = {}) {
    return Key(KeyboardEvent::kKeyDown, code, m, std::move(chars));
  }
  bool KeyUp(std::int16_t code, ModifierKeys m = {}, std::vector<char16_t> chars = {}) {
    return Key(KeyboardEvent::kKeyUp, code, m, std::move(chars));
  }

  // Moves the virtual clock on in steps, ticking every live timer of `node`
  // once per step (the node's timers all run at `step` in these tests).
  void Advance(ui::UI_Node& node, double seconds, double step) {
    for (double elapsed = step; elapsed <= seconds + 1e-9; elapsed += step) {
      now += step;
      const ui::UI_NodeTimerList timers = node.UI_GetTimerList();
      for (const ui::UI_NodeTimerDataP& data : timers) {
        if (data->IsLive()) root->Timers().DispatchPossibleTimer(data.get());
      }
    }
  }
  std::size_t LiveTimers(const ui::UI_Node& node) {
    std::size_t count = 0;
    for (const auto& data : const_cast<ui::UI_Node&>(node).UI_GetTimerList())
      count += data->IsLive();
    return count;
  }

  ui::UI_NodeManager manager;
  double now = 100.0;
  boost::intrusive_ptr<TestRoot> root = velkcore::MakeIntrusive<TestRoot>();
};

}  // namespace velkui::controls::test
