#include <algorithm>

#include <gtest/gtest.h>

#include <velkui/ui/NodeManagerGuards.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

// root (0,0 400x400) > parent (100,100 200x200) > leaf (10,10 50x50);
// root > sibling (300,0 50x50).
class MouseRoutingTest : public NodeTest<> {
 protected:
  LoggingViewP root = View("root", nullptr, {0, 0, 400, 400});
  LoggingViewP parent = View("parent", root.get(), {100, 100, 200, 200});
  LoggingViewP leaf = View("leaf", parent.get(), {10, 10, 50, 50});
  LoggingViewP sibling = View("sibling", root.get(), {300, 0, 50, 50});

  bool Click(float x, float y, UI_Node* at = nullptr) {
    log->clear();
    return (at ? at : root.get())
        ->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonDown, x, y), true);
  }
  void MoveTo(float x, float y) {
    root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, x, y, 0, 0));
  }
};

TEST_F(MouseRoutingTest, TheLeafGetsTheEventFirstThenEachAncestorInItsOwnCoordinates) {
  EXPECT_FALSE(Click(125, 130));
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,1)", "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
  EXPECT_EQ(leaf->mousePositions.back(), (PointT<float>{15, 20}));
  EXPECT_EQ(parent->mousePositions.back(), (PointT<float>{25, 30}));
  EXPECT_EQ(root->mousePositions.back(), (PointT<float>{125, 130}));

  parent->handlesMouse = true;
  EXPECT_TRUE(Click(125, 130));
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,1)", "parent:mouse(leaf,1)"}));

  EXPECT_TRUE(Click(250, 250));  // on the parent, beside the leaf
  EXPECT_EQ(*log, EventLog{"parent:mouse(parent,1)"});
}

TEST_F(MouseRoutingTest, ANodeAskingForThePreOfferSeesTheEventBeforeItsChildren) {
  parent->SetWantsPreMouseEvents(true);
  Click(125, 130);
  EXPECT_EQ(*log, (EventLog{"parent:mouse(null,1)", "leaf:mouse(leaf,1)", "parent:mouse(leaf,1)",
                            "root:mouse(leaf,1)"}));
  parent->handlesMouse = true;
  EXPECT_TRUE(Click(125, 130));
  EXPECT_EQ(*log, EventLog{"parent:mouse(null,1)"});
}

TEST_F(MouseRoutingTest, FiltersAreOfferedTheEventBeforeTheLeafInTheOrderAdded) {
  auto first = View("first", nullptr, {0, 0, 1, 1});
  auto second = View("second", nullptr, {0, 0, 1, 1});
  {
    const AddAndRemoveMouseEventFilterNode a(*manager, first.get());
    const AddAndRemoveMouseEventFilterNode b(*manager, second.get());
    Click(125, 130);
    EXPECT_EQ(Only("mouse"),
              (EventLog{"first:premouse(leaf)", "second:premouse(leaf)", "leaf:mouse(leaf,1)",
                        "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
    first->handlesPreMouse = true;
    EXPECT_TRUE(Click(125, 130));
    EXPECT_EQ(*log, EventLog{"first:premouse(leaf)"});
  }
  EXPECT_TRUE(manager->GetMouseEventFilterNodes().empty());
}

TEST_F(MouseRoutingTest, ADisabledNodeNeitherReceivesNorConsumesTheClick) {
  leaf->handlesMouse = true;
  leaf->UI_SetDisabled(true);
  Click(125, 130);
  EXPECT_EQ(*log, (EventLog{"parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
  // Disabling the parent silences both, without changing the leaf.
  leaf->UI_SetDisabled(false);
  parent->UI_SetDisabled(true);
  Click(125, 130);
  EXPECT_EQ(*log, EventLog{"root:mouse(leaf,1)"});
}

TEST_F(MouseRoutingTest, ACustomMouseFunctionDecidesOnlyWhenItSaysItHandled) {
  bool claim = false;
  bool answer = true;
  leaf->UI_SetCustomMouseEventFunction(std::make_shared<UI_Node::CustomMouseEventFunction>(
      [&](UI_Node* node, const MouseEvent&, bool& handled) {
        log->push_back(node->UI_GetNodeID() + ":custom");
        handled = claim;
        return answer;
      }));
  Click(125, 130);
  EXPECT_EQ(Only("leaf:"), (EventLog{"leaf:custom", "leaf:mouse(leaf,1)"}));
  claim = true;
  EXPECT_TRUE(Click(125, 130));
  EXPECT_EQ(*log, EventLog{"leaf:custom"});
  answer = false;
  EXPECT_FALSE(Click(125, 130));
  EXPECT_EQ(*log, (EventLog{"leaf:custom", "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));

  leaf->UI_SetCustomMouseEventFunction(std::make_shared<UI_Node::CustomMouseEventFunction>());
  EXPECT_THROW(Click(125, 130), std::bad_function_call);
}

TEST_F(MouseRoutingTest, AboveTheTargetTheEventClimbsToTheOuterTree) {
  // Dispatched on the parent as on a window nested in another.
  Click(25, 30, parent.get());
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,1)", "parent:mouse(leaf,1)", "root:mouse(leaf,1)"}));
  EXPECT_EQ(root->mousePositions.back(), (PointT<float>{125, 130}));
}

TEST_F(MouseRoutingTest, ChildrenOwningAPlatformWindowAreSkippedWhenAsked) {
  leaf->ownsPlatformWindow = true;
  Click(125, 130);
  EXPECT_EQ(*log, (EventLog{"parent:mouse(parent,1)", "root:mouse(parent,1)"}));
  log->clear();
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kWheel, 125, 130), false);
  EXPECT_EQ(log->front(), "leaf:mouse(leaf,4)");
}

class ProxyView : public LoggingView {
 public:
  using LoggingView::LoggingView;
  UI_Node* proxy = nullptr;
  UI_Node* UI_GetMouseProxy(MouseEvent*) override { return proxy; }
};

class RecordingHook : public UI_EventRecorder {
 public:
  std::vector<std::pair<UI_Node*, PointT<float>>> mouse;
  int keys = 0;
  void RecordMouseEvent(UI_Node* target, const MouseEvent& event) override {
    mouse.emplace_back(target, event.GetPosition());
  }
  void RecordKeyboardEvent(UI_Node*, const KeyboardEvent&) override { ++keys; }
};

TEST_F(MouseRoutingTest, TheProxyBecomesTheTargetAndTheRecorderSeesItFirst) {
  auto window = MakeView<ProxyView>(nullptr, {0, 0, 400, 400}, "window", log);
  window->ChildPushBack(parent);
  window->proxy = parent.get();
  const auto recorder = std::make_shared<RecordingHook>();
  manager->SetEventRecorder(recorder);
  log->clear();
  window->UI_DispatchMouseEvent(Mouse(MouseEvent::kMove, 125, 130, 0, 0), true);
  ASSERT_EQ(recorder->mouse.size(), 1u);
  EXPECT_EQ(recorder->mouse[0].first, parent.get());
  EXPECT_EQ(recorder->mouse[0].second, (PointT<float>{25, 30}));
  EXPECT_EQ(manager->GetMouseOverRootNode(), parent.get());
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,3)", "parent:mouse(leaf,3)", "window:mouse(leaf,3)"}));
  UI_Node::UI_DispatchKeyboardEvent(leaf.get(), Key(KeyboardEvent::kKeyDown, 65));
  EXPECT_EQ(recorder->keys, 1);
  manager->SetEventRecorder(nullptr);
}

TEST_F(MouseRoutingTest, TheCursorIsAskedFromTheLeafUpwards) {
  log->clear();
  EXPECT_FALSE(root->UI_DispatchCursor({125, 130}, kModifierShift, true));
  EXPECT_EQ(*log,
            (EventLog{"leaf:cursor(leaf,2)", "parent:cursor(leaf,2)", "root:cursor(leaf,2)"}));
}

// ---- Input capture ----

class CaptureTest : public MouseRoutingTest {
 protected:
  boost::intrusive_ptr<LoggingCapture> capture;

  void StartCapture(std::int32_t button = MouseEvent::kLeftButton) {
    capture = velkcore::MakeIntrusive<LoggingCapture>(
        leaf.get(), Mouse(MouseEvent::kButtonDown, 15, 20, button), log);
    log->clear();
    manager->BeginInputCapture(capture);
  }
};

TEST_F(CaptureTest, ACaptureTakesEveryMouseEventUntilTheReleaseEndsIt) {
  StartCapture();
  EXPECT_EQ(*log,
            (EventLog{"capture:begin", "leaf:setcapture", "parent:setcapture", "root:setcapture"}));
  EXPECT_TRUE(capture->HasPlatformCapture());
  EXPECT_EQ(manager->toolTipSuspensions, std::vector<bool>{true});

  log->clear();
  EXPECT_TRUE(root->UI_DispatchMouseEvent(Mouse(MouseEvent::kMove, 390, 5, 1, 0), true));
  EXPECT_EQ(*log, EventLog{"capture:mouse3"});
  EXPECT_EQ(capture->mousePositions.back(), (PointT<float>{280, -105}));  // leaf's coordinates
  EXPECT_EQ(capture->lastCursor, (PointT<float>{280, -105}));
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetPosition(), (PointT<float>{280, -105}));

  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kMouseOverUpdate, 0, 0, 0, 0), true);
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetAction(), MouseEvent::kMove);

  log->clear();
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonUp, 300, 300, MouseEvent::kRightButton),
                              true);
  EXPECT_EQ(manager->GetInputCapture(), capture.get());  // another button: not the end
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kButtonUp, 300, 300), true);
  // Once ended, the mouse-over state is recomputed where the pointer is.
  EXPECT_EQ(*log,
            (EventLog{"capture:mouse2", "capture:mouse2", "leaf:releasecapture",
                      "parent:releasecapture", "root:releasecapture", "capture:end", "root:over"}));
  EXPECT_FALSE(manager->HasInputCapture());
  EXPECT_FALSE(capture->HasBeenCancelled());
  EXPECT_TRUE(capture->HasEnded());
  EXPECT_EQ(manager->toolTipSuspensions, (std::vector<bool>{true, false}));
}

TEST_F(CaptureTest, EscapeCancelsACaptureOnlyWithoutModifiers) {
  StartCapture();
  log->clear();
  EXPECT_TRUE(UI_Node::UI_DispatchKeyboardEvent(leaf.get(),
                                                Key(KeyboardEvent::kKeyDown, 27, kModifierShift)));
  EXPECT_TRUE(manager->HasInputCapture());
  EXPECT_EQ(capture->lastCursorModifiers, ModifierKeys{kModifierShift});
  EXPECT_TRUE(UI_Node::UI_DispatchKeyboardEvent(leaf.get(), Key(KeyboardEvent::kKeyDown, 65)));
  EXPECT_EQ(*log, (EventLog{"capture:key", "capture:key"}));  // consumed, never reaching nodes

  capture->handlesKeyboard = true;
  UI_Node::UI_DispatchKeyboardEvent(leaf.get(), Key(KeyboardEvent::kKeyDown, 27));
  EXPECT_TRUE(manager->HasInputCapture());
  capture->handlesKeyboard = false;
  UI_Node::UI_DispatchKeyboardEvent(leaf.get(), Key(KeyboardEvent::kKeyDown, 27));
  EXPECT_FALSE(manager->HasInputCapture());
  EXPECT_TRUE(capture->HasBeenCancelled());
  EXPECT_EQ(log->back(), "capture:end");
}

TEST_F(CaptureTest, ACancelledCaptureLetsEventsFlowUntilItIsEnded) {
  StartCapture();
  capture->Cancel();
  EXPECT_EQ(manager->GetActiveInputCapture(), nullptr);
  Click(125, 130);
  EXPECT_EQ(log->front(), "leaf:mouse(leaf,1)");
  EXPECT_EQ(manager->GetInputCapture(), capture.get());

  // A new capture ends the old one as cancelled first.
  auto second = velkcore::MakeIntrusive<LoggingCapture>(parent.get(),
                                                        Mouse(MouseEvent::kButtonDown, 0, 0), log);
  log->clear();
  manager->BeginInputCapture(second);
  EXPECT_EQ(log->front(), "leaf:releasecapture");
  EXPECT_NE(std::find(log->begin(), log->end(), "capture:end"), log->end());
  EXPECT_TRUE(capture->HasEnded());
  EXPECT_EQ(manager->GetActiveInputCapture(), parent.get());
  manager->EndInputCapture(true);
  EXPECT_TRUE(second->HasBeenCancelled());
}

TEST_F(CaptureTest, ACaptureWhoseNodeLeavesTheTreeIsCancelled) {
  StartCapture();
  log->clear();
  root->ChildRemove(parent.get());
  EXPECT_FALSE(manager->HasInputCapture());
  EXPECT_TRUE(capture->HasBeenCancelled());
  // Released while the node could still reach its window.
  EXPECT_EQ(Only("capture"), (EventLog{"leaf:releasecapture", "parent:releasecapture",
                                       "root:releasecapture", "capture:end"}));
}

TEST_F(CaptureTest, ACaptureEndedInsideBeginTakesNoPlatformCapture) {
  capture = velkcore::MakeIntrusive<LoggingCapture>(leaf.get(),
                                                    Mouse(MouseEvent::kButtonDown, 0, 0), log);
  capture->onBegin = [this] { manager->EndInputCapture(false); };
  manager->BeginInputCapture(capture);
  EXPECT_FALSE(manager->HasInputCapture());
  EXPECT_FALSE(capture->HasPlatformCapture());
  EXPECT_TRUE(Only("setcapture").empty());
}

// ---- Mouse-over ----

TEST_F(MouseRoutingTest, MovingBetweenSiblingsChangesOnlyTheSiblings) {
  auto a = View("a", parent.get(), {100, 10, 20, 20});
  MoveTo(125, 130);
  EXPECT_EQ(manager->GetMouseOverLeafNode(), leaf.get());
  EXPECT_TRUE(root->UI_IsMouseOver(false));
  EXPECT_TRUE(leaf->UI_IsMouseOver(true));
  EXPECT_FALSE(parent->UI_IsMouseOver(true));
  EXPECT_EQ(manager->toolTipLeaves.back(), leaf.get());

  log->clear();
  MoveTo(205, 115);
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,5)", "leaf:over", "a:over"}));
  EXPECT_EQ(leaf->mousePositions.back(), (PointT<float>{95, 5}));  // the exit notice
  EXPECT_FALSE(leaf->UI_IsMouseOver(false));
  EXPECT_TRUE(a->UI_IsMouseOver(true));
  EXPECT_TRUE(parent->UI_IsMouseOver(false));

  log->clear();
  MoveTo(206, 115);  // the same leaf: nothing happens
  EXPECT_TRUE(log->empty());

  // Into the parent itself: the leaf status moves up; the parent hears of it.
  MoveTo(180, 180);
  EXPECT_EQ(*log, (EventLog{"a:mouse(a,5)", "a:over", "parent:over"}));
  EXPECT_TRUE(parent->UI_IsMouseOver(true));
}

TEST_F(MouseRoutingTest, LeavingTheWindowLeavesTheWholeChain) {
  MoveTo(125, 130);
  log->clear();
  const MouseEvent exit = Mouse(MouseEvent::kMouseOverUpdate, -5, -5, 0, 0);
  UI_Node::UI_MouseExited(&exit, root.get());
  EXPECT_EQ(*log, (EventLog{"leaf:mouse(leaf,5)", "parent:mouse(parent,5)", "root:mouse(root,5)",
                            "leaf:over", "parent:over", "root:over"}));
  EXPECT_EQ(manager->GetMouseOverLeafNode(), nullptr);
  EXPECT_FALSE(root->UI_IsMouseOver(false));
  EXPECT_EQ(manager->toolTipLeaves.back(), nullptr);

  // A stale exit from a window the pointer already left changes nothing.
  auto other = View("other", nullptr, {0, 0, 10, 10});
  MoveTo(125, 130);
  log->clear();
  UI_Node::UI_MouseExited(&exit, other.get());
  EXPECT_TRUE(log->empty());
}

TEST_F(MouseRoutingTest, NodesThatAskForItAreInvalidatedWhenTheMouseComesAndGoes) {
  leaf->invalidatesOnMouseOver = true;
  leaf->invalidations = 0;
  MoveTo(125, 130);
  EXPECT_EQ(leaf->invalidations, 1);
  MoveTo(390, 390);
  EXPECT_EQ(leaf->invalidations, 2);
}

TEST_F(MouseRoutingTest, SuspendingMouseOverUpdatesFreezesTheState) {
  MoveTo(125, 130);
  {
    const SuspendMouseOverUpdates suspend(*manager);
    MoveTo(390, 390);
    EXPECT_EQ(manager->GetMouseOverLeafNode(), leaf.get());
  }
  MoveTo(390, 390);
  EXPECT_EQ(manager->GetMouseOverLeafNode(), root.get());
}

TEST_F(MouseRoutingTest, RemovingTheMouseOverLeafLeavesNoStaleState) {
  MoveTo(125, 130);
  const NodeP removed = parent->ChildRemove(leaf.get());
  EXPECT_EQ(manager->GetMouseOverLeafNode(), parent.get());
  EXPECT_FALSE(leaf->UI_IsMouseOver(false));
  EXPECT_TRUE(parent->UI_IsMouseOver(true));

  MoveTo(310, 10);
  EXPECT_FALSE(parent->UI_IsMouseOver(false));
  EXPECT_TRUE(sibling->UI_IsMouseOver(true));
}

TEST_F(MouseRoutingTest, ADestroyedNodeLeavesEveryRole) {
  MoveTo(125, 130);
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kMove, 125, 130, 0, 0), true);
  EXPECT_EQ(manager->GetMouseOverRootNode(), root.get());
  manager->AddMouseEventFilterNode(leaf.get());
  manager->AddKeyboardEventFilterNode(leaf.get());
  parent->ChildRemove(leaf.get());
  leaf.reset();
  EXPECT_NE(std::find(manager->toolTipDisposals.begin(), manager->toolTipDisposals.end(), "leaf"),
            manager->toolTipDisposals.end());
  EXPECT_TRUE(manager->GetMouseEventFilterNodes().empty());
  EXPECT_TRUE(manager->GetKeyboardEventFilterNodes().empty());

  root.reset();
  parent.reset();
  sibling.reset();
  EXPECT_EQ(manager->GetMouseOverLeafNode(), nullptr);
  EXPECT_EQ(manager->GetMouseOverRootNode(), nullptr);
}

TEST_F(MouseRoutingTest, EndingACaptureRecomputesTheMouseOverState) {
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kMove, 125, 130, 0, 0), true);
  MoveTo(125, 130);
  auto capture = velkcore::MakeIntrusive<LoggingCapture>(
      leaf.get(), Mouse(MouseEvent::kButtonDown, 15, 20), log);
  manager->BeginInputCapture(capture);
  manager->pointer = PointT<float>{310, 10};  // the pointer moved during the drag
  manager->EndInputCapture(false);
  EXPECT_EQ(manager->GetMouseOverLeafNode(), sibling.get());
}

}  // namespace
}  // namespace velkui::ui::test
