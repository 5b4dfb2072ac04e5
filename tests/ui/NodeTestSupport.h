#pragma once

// Helpers shared by the node and routing tests: a manager installed for one
// test and a sub-view that logs its hooks.

#include <algorithm>
#include <cmath>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include <velkcore/Geometry.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/InputCapture.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui::test {

using velkcore::PointT;
using velkcore::RectT;
using velkcore::ScaleMatrixT;

using EventLog = std::vector<std::string>;

// Installs a fresh manager for the lifetime of the object.
template <typename Manager = UI_NodeManager>
class ScopedManager {
 public:
  ScopedManager() { UI_NodeManager::Set(&manager_); }
  ~ScopedManager() { UI_NodeManager::Set(nullptr); }
  Manager& operator*() { return manager_; }
  Manager* operator->() { return &manager_; }

 private:
  Manager manager_;
};

// A sub-view that appends what happens to it to a shared log ("name:what").
class LoggingView : public UI_SubView {
 public:
  LoggingView(std::string name, std::shared_ptr<EventLog> log)
      : name_(std::move(name)), log_(std::move(log)) {
    UI_SetNodeID(name_);
  }

  const std::string& Name() const { return name_; }

  // Behaviour switches.
  bool handlesMouse = false;
  bool handlesPreMouse = false;
  bool handlesKeyboard = false;
  bool handlesPreKeyboard = false;
  bool wantsFocus = false;
  bool passesCharsToParent = false;
  bool invalidatesOnMouseOver = false;
  bool paints = false;
  bool ownsPlatformWindow = false;
  std::function<void(LoggingView&)> onMouse;
  std::function<void(LoggingView&)> onKeyboard;
  std::function<void(LoggingView&)> onFocusChanged;
  std::function<void(LoggingView&)> onMouseOverChanged;
  std::function<void(LoggingView&, NodeChange)> onNodeChanged;
  std::function<void(LoggingView&)> onDraw;

  // Mouse positions received, in this node's coordinates.
  std::vector<PointT<float>> mousePositions;
  int invalidations = 0;
  int sizeChanges = 0;
  int disabledChanges = 0;
  int drawCount = 0;

  bool UI_DoMouseEvent(UI_Node* target, const MouseEvent& event) override {
    Log("mouse(" + NameOf(target) + "," + std::to_string(event.GetAction()) + ")");
    mousePositions.push_back(event.GetPosition());
    if (onMouse) onMouse(*this);
    return handlesMouse;
  }
  bool UI_DoPreMouseEvent(UI_Node* target, const MouseEvent&) override {
    Log("premouse(" + NameOf(target) + ")");
    return handlesPreMouse;
  }
  bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent&) override {
    Log("key(" + NameOf(target) + ")");
    if (onKeyboard) onKeyboard(*this);
    return handlesKeyboard;
  }
  bool UI_DoPreKeyboardEvent(UI_Node* target, const KeyboardEvent&) override {
    Log("prekey(" + NameOf(target) + ")");
    return handlesPreKeyboard;
  }
  bool UI_DoCursor(UI_Node* target, const PointT<float>&, ModifierKeys modifiers) override {
    Log("cursor(" + NameOf(target) + "," + std::to_string(modifiers.Get()) + ")");
    return false;
  }
  bool UI_WantsKeyboardFocus() const override { return wantsFocus; }
  bool UI_DispatchKeyboardCharEventToParent() override { return passesCharsToParent; }
  bool UI_InvalidateOnMouseOverChange(bool) const override { return invalidatesOnMouseOver; }
  void UI_FocusChanged() override {
    Log("focus");
    if (onFocusChanged) onFocusChanged(*this);
  }
  void UI_MouseOverChanged() override {
    Log("over");
    if (onMouseOverChanged) onMouseOverChanged(*this);
  }
  void UI_NodeChanged(NodeChange change) override {
    Log("change" + std::to_string(static_cast<int>(change)));
    if (onNodeChanged) onNodeChanged(*this, change);
  }
  void UI_SetCapture() override {
    Log("setcapture");
    UI_SubView::UI_SetCapture();
  }
  void UI_ReleaseCapture() override {
    Log("releasecapture");
    UI_SubView::UI_ReleaseCapture();
  }
  bool UI_ReceivesEventsFromOS() const override { return ownsPlatformWindow; }
  bool UI_AreAllParentsVisible() const override {
    // A root stands for a window here.
    return UI_GetParentNode() == nullptr ? UI_IsShown() : UI_SubView::UI_AreAllParentsVisible();
  }
  // Lets a test ask for the pre-offer of mouse events (state flag 0x10).
  void SetWantsPreMouseEvents(bool wants) {
    StateFlags flags = UI_GetStateFlags();
    flags.Set(kStateWantsPreMouseEvents, wants);
    UI_SetStateFlags(flags);
  }
  void UI_SizeChanged(const RectT<float>&) override { ++sizeChanges; }
  void UI_DisabledStateChanged() override { ++disabledChanges; }
  void UI_Invalidate(const RectT<std::int32_t>* rect, InvalidateFlags flags) override {
    ++invalidations;
    if (rect != nullptr) lastInvalidRect = *rect;
    UI_SubView::UI_Invalidate(rect, flags);
  }
  void UI_Draw(pictel::Pictel* context) const override {
    Log("draw");
    ++const_cast<LoggingView*>(this)->drawCount;
    if (onDraw) onDraw(const_cast<LoggingView&>(*this));
    if (paints) context->GetSurface()->PaintRect({0, 0, 0, 1}, UI_GetLocalRectF(false));
    UI_SubView::UI_Draw(context);
  }

  RectT<std::int32_t> lastInvalidRect{};

  void Log(const std::string& what) const {
    if (log_) log_->push_back(name_ + ":" + what);
  }
  static std::string NameOf(const UI_Node* node) {
    if (node == nullptr) return "null";
    return node->UI_GetNodeID();
  }

 private:
  std::string name_;
  std::shared_ptr<EventLog> log_;
};

using LoggingViewP = boost::intrusive_ptr<LoggingView>;

// A manager whose platform hooks are observed (and the pointer position set) by the test.
class FakeManager : public UI_NodeManager {
 public:
  std::vector<UI_Node*> toolTipLeaves;
  std::vector<bool> toolTipSuspensions;
  std::vector<std::string> toolTipDisposals;
  int pendingKeyboardRemovals = 0;
  std::optional<PointT<float>> pointer;
  std::vector<std::string> timerRemovals;
  std::vector<std::string> toolTipChanges;

  void RemoveNodeTimers(UI_Node& node) override { timerRemovals.push_back(node.UI_GetNodeID()); }
  void ToolTipChanged(UI_Node& node) override { toolTipChanges.push_back(node.UI_GetNodeID()); }

  void MouseOverLeafChangedForToolTips(UI_Node* leaf) override { toolTipLeaves.push_back(leaf); }
  void SuspendToolTips(bool suspend) override { toolTipSuspensions.push_back(suspend); }
  // Called from a node's destructor: only its non-virtual parts may be read.
  void DisposeToolTipOwnedBy(UI_Node& node) override {
    toolTipDisposals.push_back(node.UI_GetNodeID());
  }
  void RemovePendingKeyboardMessages() override { ++pendingKeyboardRemovals; }
  std::optional<PointT<float>> QueryPointerPosition(const UI_Node& root) const override {
    return pointer ? pointer : UI_NodeManager::QueryPointerPosition(root);
  }
};

// An input capture that logs what it gets ("capture:...").
class LoggingCapture : public InputCapture {
 public:
  LoggingCapture(UI_Node* node, const MouseEvent& initial, std::shared_ptr<EventLog> log)
      : InputCapture(node, initial), log_(std::move(log)) {}

  bool handlesMouse = false;
  bool handlesKeyboard = false;
  std::function<void()> onMouse;
  std::function<void()> onBegin;
  std::vector<PointT<float>> mousePositions;

  void Begin() override {
    log_->push_back("capture:begin");
    if (onBegin) onBegin();
  }
  void End() override { log_->push_back("capture:end"); }
  bool DoMouseEvent(const MouseEvent& event) override {
    log_->push_back("capture:mouse" + std::to_string(event.GetAction()));
    mousePositions.push_back(event.GetPosition());
    if (onMouse) onMouse();
    return handlesMouse;
  }
  bool DoKeyboardEvent(const KeyboardEvent&) override {
    log_->push_back("capture:key");
    return handlesKeyboard;
  }
  bool DoCursor(const PointT<float>& point, ModifierKeys modifiers) override {
    lastCursor = point;
    lastCursorModifiers = modifiers;
    return true;
  }

  PointT<float> lastCursor{};
  ModifierKeys lastCursorModifiers;

 private:
  std::shared_ptr<EventLog> log_;
};

// A shown sub-view with a frame, added to `parent` when given.
template <typename View = LoggingView, typename... Args>
boost::intrusive_ptr<View> MakeView(UI_Node* parent, const RectT<float>& frame, Args&&... args) {
  auto view = velkcore::MakeIntrusive<View>(std::forward<Args>(args)...);
  view->UI_SetLocalRectF(frame);
  view->UI_Show(true);
  if (parent != nullptr) parent->ChildPushBack(view);
  return view;
}

// A manager of its own, a shared log and logging views for one test.
template <typename Manager = FakeManager>
class NodeTest : public ::testing::Test {
 protected:
  ScopedManager<Manager> manager;
  std::shared_ptr<EventLog> log = std::make_shared<EventLog>();

  LoggingViewP View(const std::string& name, UI_Node* under = nullptr,
                    RectT<float> frame = {0, 0, 10, 10}) {
    return MakeView(under, frame, name, log);
  }
  // The log entries that contain `what`.
  EventLog Only(const std::string& what) const {
    EventLog out;
    std::copy_if(log->begin(), log->end(), std::back_inserter(out),
                 [&](const std::string& s) { return s.find(what) != std::string::npos; });
    return out;
  }
};

inline MouseEvent Mouse(MouseEvent::Action action, float x, float y, std::int32_t button = 1,
                        std::int32_t count = 1, ModifierKeys modifiers = {}) {
  return MouseEvent(action, button, count, PointT<float>{x, y}, modifiers);
}

inline KeyboardEvent Key(KeyboardEvent::Action action, std::int16_t osCode,
                         ModifierKeys modifiers = {}, std::vector<char16_t> chars = {},
                         bool repeat = false) {
  return KeyboardEvent(action, std::move(chars), osCode, modifiers, repeat);
}

}  // namespace velkui::ui::test
