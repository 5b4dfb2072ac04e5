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
#include <velkui/test/MessageLog.h>
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

using velkui::test::MessageLog;
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
