// Handlers that change the tree while it is being walked. Run these under the
// sanitizer build: a use after free fails there even when the result looks right.

#include <algorithm>

#include <gtest/gtest.h>

#include <velkui/ui/NodeManagerGuards.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

// root > parent > leaf, root > sibling; only the tree (and `root`) holds them.
class ReentrancyTest : public NodeTest<> {
 protected:
  LoggingViewP root = MakeView(nullptr, {0, 0, 400, 400}, "root", log);
  LoggingView* parent = Add("parent", root.get(), {100, 100, 200, 200});
  LoggingView* leaf = Add("leaf", parent, {10, 10, 50, 50});
  LoggingView* sibling = Add("sibling", root.get(), {0, 0, 50, 50});

  LoggingView* Add(const std::string& name, UI_Node* under, RectT<float> frame) {
    return MakeView(under, frame, name, log).get();
  }
  void ClickLeaf() {
    log->clear();
    root->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonDown, 125, 130), true);
  }
  static void Detach(UI_Node* node) {
    if (UI_Container* container = node->UI_GetParentContainer()) container->ChildRemove(node);
  }
};

TEST_F(ReentrancyTest, AMouseHandlerMayDeleteItselfItsParentOrASibling) {
  leaf->onMouse = [](LoggingView& self) { Detach(&self); };
  ClickLeaf();
  EXPECT_EQ(Only(":mouse"),
            (EventLog{"leaf:mouse(leaf,1)", "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
  EXPECT_EQ(parent->ChildSize(), 0u);

  leaf = Add("leaf", parent, {10, 10, 50, 50});
  leaf->onMouse = [this](LoggingView&) {
    Detach(parent);
    Detach(sibling);
  };
  ClickLeaf();
  // The parent was detached with the leaf inside: the event still finishes its climb.
  EXPECT_EQ(Only(":mouse"),
            (EventLog{"leaf:mouse(leaf,1)", "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
  EXPECT_EQ(root->ChildSize(), 0u);
}

TEST_F(ReentrancyTest, AHandlerMayDropTheLastReferenceToTheWholeTree) {
  leaf->onMouse = [this](LoggingView&) { root.reset(); };
  LoggingView* rawRoot = root.get();
  log->clear();
  rawRoot->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonDown, 125, 130), true);
  EXPECT_EQ(root, nullptr);
  EXPECT_NE(std::find(log->begin(), log->end(), "root:mouse(leaf,1)"), log->end());
  EXPECT_EQ(manager->GetMouseOverLeafNode(), nullptr);
}

class ActingFilter : public LoggingView {
 public:
  using LoggingView::LoggingView;
  std::function<void()> action;
  bool UI_DoPreMouseEvent(UI_Node* target, const MouseEvent& event) override {
    LoggingView::UI_DoPreMouseEvent(target, event);
    if (action) action();
    return false;
  }
};

TEST_F(ReentrancyTest, FiltersMayRemoveOrDestroyOtherFilters) {
  auto filter = MakeView<ActingFilter>(nullptr, {0, 0, 1, 1}, "filter", log);
  LoggingViewP second = MakeView(nullptr, {0, 0, 1, 1}, "second", log);
  LoggingViewP third = MakeView(nullptr, {0, 0, 1, 1}, "third", log);
  // The first filter removes itself and destroys the second.
  filter->action = [&] {
    manager->RemoveMouseEventFilterNode(filter.get());
    second.reset();
  };
  manager->AddMouseEventFilterNode(filter.get());
  manager->AddMouseEventFilterNode(second.get());
  manager->AddMouseEventFilterNode(third.get());
  ClickLeaf();
  EXPECT_EQ(second, nullptr);
  ASSERT_GE(log->size(), 3u);
  EXPECT_EQ(log->at(0), "filter:premouse(leaf)");
  EXPECT_EQ(log->at(1), "third:premouse(leaf)");
  EXPECT_EQ(log->at(2), "leaf:mouse(leaf,1)");
  EXPECT_EQ(manager->GetMouseEventFilterNodes(), std::vector<UI_Node*>{third.get()});
}

TEST_F(ReentrancyTest, ACaptureMayRemoveItsNodeOrStartAnotherCapture) {
  auto capture =
      velkcore::MakeIntrusive<LoggingCapture>(leaf, Mouse(MouseEvent::kButtonDown, 15, 20), log);
  manager->BeginInputCapture(capture);
  capture->onMouse = [this] { Detach(parent); };
  log->clear();
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonUp, 125, 130), true);
  EXPECT_FALSE(manager->HasInputCapture());
  EXPECT_TRUE(capture->HasBeenCancelled());  // ended by the removal, not by the release
  EXPECT_EQ(std::count(log->begin(), log->end(), "capture:end"), 1);

  auto first =
      velkcore::MakeIntrusive<LoggingCapture>(sibling, Mouse(MouseEvent::kButtonDown, 5, 5), log);
  auto second =
      velkcore::MakeIntrusive<LoggingCapture>(sibling, Mouse(MouseEvent::kButtonDown, 5, 5), log);
  first->onMouse = [&] { manager->BeginInputCapture(second); };
  manager->BeginInputCapture(first);
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonUp, 5, 5), true);
  // The release ended neither: the first was replaced, the second never saw it.
  EXPECT_TRUE(first->HasBeenCancelled());
  EXPECT_EQ(manager->GetInputCapture(), second.get());
  EXPECT_TRUE(second->mousePositions.empty());
  manager->EndInputCapture(true);
}

TEST_F(ReentrancyTest, AKeyboardHandlerMayDestroyTheNodesAboveIt) {
  // Only the tree holds the parent: detaching it destroys it, and the leaf with
  // it once the dispatch lets go of the leaf.
  leaf->onKeyboard = [this](LoggingView&) { Detach(parent); };
  log->clear();
  EXPECT_FALSE(UI_Node::UI_DispatchKeyboardEvent(leaf, Key(KeyboardEvent::kKeyDown, 65)));
  EXPECT_EQ(Only(":key"), EventLog{"leaf:key(leaf)"});
  EXPECT_EQ(root->ChildSize(), 1u);

  // The target itself may go: the climb goes on from where it was.
  leaf = Add("leaf", sibling, {0, 0, 10, 10});
  leaf->onKeyboard = [](LoggingView& self) { Detach(&self); };
  log->clear();
  UI_Node::UI_DispatchKeyboardEvent(leaf, Key(KeyboardEvent::kKeyDown, 65));
  EXPECT_EQ(Only(":key"), EventLog{"leaf:key(leaf)"});
  EXPECT_EQ(sibling->ChildSize(), 0u);
}

TEST_F(ReentrancyTest, AFocusHandlerMayDeleteNodesOfTheChain) {
  leaf->wantsFocus = true;
  sibling->wantsFocus = true;
  leaf->UI_GainKeyboardFocus();
  // Losing focus, the leaf removes its parent (and so itself) from the tree.
  leaf->onFocusChanged = [this](LoggingView& self) {
    if (!self.UI_HasKeyboardFocus(false)) Detach(parent);
  };
  sibling->UI_GainKeyboardFocus();
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), sibling);
  EXPECT_EQ(root->ChildSize(), 1u);
  EXPECT_TRUE(root->UI_HasKeyboardFocus(false));

  // Gaining focus, a node deletes itself: the chain is cleared as it leaves.
  sibling->onFocusChanged = [](LoggingView& self) {
    if (self.UI_HasKeyboardFocus(true)) Detach(&self);
  };
  root->wantsFocus = true;
  root->UI_GainKeyboardFocus();
  sibling->onFocusChanged = nullptr;
  LoggingView* other = Add("other", root.get(), {0, 100, 10, 10});
  other->wantsFocus = true;
  other->onFocusChanged = [](LoggingView& self) {
    if (self.UI_HasKeyboardFocus(true)) Detach(&self);
  };
  other->UI_GainKeyboardFocus();
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_FALSE(root->UI_HasKeyboardFocus(false));
}

TEST_F(ReentrancyTest, AnExitNoticeMayDeleteTheNodeOrMoveTheMouseOverState) {
  root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, 125, 130, 0, 0));
  leaf->onMouse = [this](LoggingView&) { Detach(parent); };
  root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, 10, 10, 0, 0));
  EXPECT_EQ(manager->GetMouseOverLeafNode(), sibling);
  EXPECT_TRUE(sibling->UI_IsMouseOver(true));
  EXPECT_TRUE(root->UI_IsMouseOver(false));

  // A handler runs an update of its own elsewhere; the outer one, which knows
  // where the pointer is, runs again and has the last word.
  LoggingView* other = Add("other", root.get(), {200, 0, 50, 50});
  sibling->onMouse = [this](LoggingView&) {
    sibling->onMouse = nullptr;
    root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, 390, 390, 0, 0));
  };
  root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, 210, 10, 0, 0));
  EXPECT_EQ(manager->GetMouseOverLeafNode(), other);
  EXPECT_TRUE(other->UI_IsMouseOver(true));
  EXPECT_FALSE(sibling->UI_IsMouseOver(false));
  EXPECT_TRUE(root->UI_IsMouseOver(false));
  EXPECT_FALSE(root->UI_IsMouseOver(true));
}

TEST_F(ReentrancyTest, NotificationsWalkingTheSubtreeSurviveRemovals) {
  parent->onNodeChanged = [this](LoggingView&, NodeChange change) {
    if (change == NodeChange::kShownChanged) Detach(leaf);
  };
  log->clear();
  root->UI_DispatchNodeChange(NodeChange::kShownChanged);
  EXPECT_EQ(parent->ChildSize(), 0u);

  leaf = Add("leaf", parent, {10, 10, 50, 50});
  LoggingView* grandChild = Add("grandChild", leaf, {0, 0, 5, 5});
  struct DisablingView : LoggingView {
    using LoggingView::LoggingView;
    std::function<void()> action;
    void UI_DisabledStateChanged() override {
      if (action) action();
    }
  };
  auto watcher = MakeView<DisablingView>(leaf, {0, 0, 5, 5}, "watcher", log);
  watcher->action = [&] { Detach(grandChild); };
  parent->UI_SetDisabled(true);
  EXPECT_TRUE(watcher->UI_IsDisabled());
  EXPECT_EQ(leaf->ChildSize(), 1u);
  watcher->action = nullptr;  // the tree outlives this test's locals
}

}  // namespace
}  // namespace velkui::ui::test
