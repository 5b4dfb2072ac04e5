#include <gtest/gtest.h>

#include <velkui/ui/NodeManagerGuards.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

using NodeServiceTest = NodeTest<>;

TEST_F(NodeServiceTest, TimerFunctionsAreAskedInOrderUntilOneAnswers) {
  auto node = View("node", nullptr, {0, 0, 10, 10});
  EXPECT_FALSE(node->UI_DoTimerNotify(3));
  std::vector<std::string> calls;
  const auto first = std::make_shared<UI_Node::TimerNotifyFunction>([&](std::int32_t id) {
    calls.push_back("first" + std::to_string(id));
    return id == 7;
  });
  const auto second = std::make_shared<UI_Node::TimerNotifyFunction>([&](std::int32_t id) {
    calls.push_back("second" + std::to_string(id));
    return true;
  });
  node->UI_InstallTimerNotifyFunction(first);
  node->UI_InstallTimerNotifyFunction(second);
  EXPECT_TRUE(node->UI_DoTimerNotify(7));
  EXPECT_TRUE(node->UI_DoTimerNotify(3));
  EXPECT_EQ(calls, (std::vector<std::string>{"first7", "first3", "second3"}));
  node->UI_RemoveTimerNotifyFunction(second);
  EXPECT_FALSE(node->UI_DoTimerNotify(3));
  node->UI_InstallTimerNotifyFunction(std::make_shared<UI_Node::TimerNotifyFunction>());
  EXPECT_THROW(node->UI_DoTimerNotify(3), std::bad_function_call);
}

TEST_F(NodeServiceTest, MovingASubtreeRemovesTheTimersOfEveryNodeInIt) {
  auto first = View("first", nullptr, {0, 0, 100, 100});
  auto second = View("second", nullptr, {0, 0, 100, 100});
  auto moved = View("moved", first.get(), {0, 0, 50, 50});
  View("inner", moved.get(), {0, 0, 5, 5});
  manager->timerRemovals.clear();
  second->ChildPushBack(moved);
  // Once leaving the first parent and once joining the second.
  EXPECT_EQ(manager->timerRemovals, (std::vector<std::string>{"moved", "inner", "moved", "inner"}));
}

TEST_F(NodeServiceTest, OnlyANewTooltipTextIsAnnounced) {
  auto node = View("node", nullptr, {0, 0, 10, 10});
  node->UI_SetToolTip(u"Gain", 120);
  node->UI_SetToolTip(u"Gain", 80);
  EXPECT_EQ(node->UI_GetToolTip(), u"Gain");
  EXPECT_EQ(node->UI_GetToolTipWidth(), 120);
  node->UI_SetToolTip(u"Level", 80);
  EXPECT_EQ(node->UI_GetToolTipWidth(), 80);
  EXPECT_EQ(manager->toolTipChanges, (std::vector<std::string>{"node", "node"}));
}

TEST_F(NodeServiceTest, PlatformControlsAreFoundWithTheirRectanglesInTheAskingNode) {
  auto root = View("root", nullptr, {0, 0, 400, 400});
  auto panel = View("panel", root.get(), {100, 100, 200, 200});
  panel->UI_SetMatrix({0, 0, 2, 1});
  auto field = View("field", panel.get(), {10, 20, 30, 10});
  field->ownsPlatformWindow = true;
  View("insideField", field.get(), {0, 0, 5, 5});
  auto hiddenField = View("hiddenField", panel.get(), {50, 50, 10, 10});
  hiddenField->ownsPlatformWindow = true;
  hiddenField->UI_Show(false);

  UI_Node::OSControlClipRects rects;
  root->UI_GetOSControlClipRects(&rects);
  ASSERT_EQ(rects.size(), 1u);
  EXPECT_EQ(rects[0].first, field.get());
  EXPECT_EQ(rects[0].second, (RectT<float>{220, 120, 60, 10}));
  EXPECT_EQ(field->UI_ChildGetFromID("insideField")->UI_GetParentEventRecipientNode(), field.get());
  EXPECT_EQ(field->UI_GetParentEventRecipientNode(), nullptr);
}

TEST_F(NodeServiceTest, GuardsRaiseTheirCountersForTheirScopeAndNest) {
  auto node = View("node", nullptr, {0, 0, 10, 10});
  std::vector<std::string> resizes;
  manager->InstallUserResizeFunction(
      std::make_shared<UI_NodeManager::UserResizeFunction>([&](bool begin, UI_Node* n, bool live) {
        resizes.push_back(std::string(begin ? "begin " : "end ") + n->UI_GetNodeID() +
                          (live ? " live" : ""));
      }));
  {
    const NotifyUserResizing outer(*manager, node.get(), true);
    const SuspendOSFocusUpdates focus(*manager);
    {
      const SuspendOSFocusUpdates nested(*manager);
      EXPECT_TRUE(manager->IsSuspendingOSFocusChanges());
    }
    EXPECT_TRUE(manager->IsSuspendingOSFocusChanges());
    EXPECT_TRUE(manager->IsUserResizing());
  }
  EXPECT_FALSE(manager->IsSuspendingOSFocusChanges());
  EXPECT_FALSE(manager->IsUserResizing());
  EXPECT_EQ(resizes, (std::vector<std::string>{"begin node live", "end node live"}));
  manager->UnregisterFunctions();
}

}  // namespace
}  // namespace velkui::ui::test
