#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/ui/UI_NodeTimerManager.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

// A root that stands in for a window: it owns a timer manager.
class TimerRoot : public LoggingView {
 public:
  TimerRoot(std::string name, std::shared_ptr<EventLog> log)
      : LoggingView(std::move(name), std::move(log)),
        timers_(std::make_unique<UI_NodeTimerManager>(this, UI_NodeTimerManager::Factory{})) {}
  UI_NodeTimerManager* UI_GetTimerManager(bool) override { return timers_.get(); }
  const UI_NodeTimerManager* UI_GetTimerManager(bool) const override { return timers_.get(); }
  UI_NodeTimerManager& Timers() { return *timers_; }
  void DropTimerManager() { timers_.reset(); }

 private:
  std::unique_ptr<UI_NodeTimerManager> timers_;
};

// Plain timer data that records its platform timer's life.
class TrackedTimerData : public UI_NodeTimerData {
 public:
  TrackedTimerData(UI_Node* managerNode, UI_Node* node, std::int32_t id, float seconds,
                   std::vector<std::string>* log)
      : UI_NodeTimerData(managerNode, node, id, seconds), log_(log) {}

 protected:
  void Start() override { log_->push_back("start" + std::to_string(GetTimerID())); }
  void Stop() override { log_->push_back("stop" + std::to_string(GetTimerID())); }

 private:
  std::vector<std::string>* log_;
};

class TimerTest : public NodeTest<UI_NodeManager> {
 protected:
  boost::intrusive_ptr<TimerRoot> root =
      MakeView<TimerRoot>(nullptr, {0, 0, 200, 200}, "root", log);
  LoggingViewP node = MakeView(root.get(), {10, 10, 50, 50}, "node", log);

  // Ticks every live timer of `owner` with `id` once; answers how many ticked.
  int Tick(UI_Node& owner, std::int32_t id) {
    int ticked = 0;
    const UI_NodeTimerList timers = owner.UI_GetTimerList();
    for (const UI_NodeTimerDataP& data : timers) {
      if (data->GetTimerID() == id && root->Timers().DispatchPossibleTimer(data.get())) ++ticked;
    }
    return ticked;
  }
  std::shared_ptr<UI_Node::TimerNotifyFunction> Handler(std::function<bool(std::int32_t)> f) {
    auto handler = std::make_shared<UI_Node::TimerNotifyFunction>(std::move(f));
    node->UI_InstallTimerNotifyFunction(handler);
    return handler;
  }
};

TEST_F(TimerTest, InstallingTwiceWithOneIdLeavesOneTimerWithTheSecondPeriod) {
  node->UI_InstallTimer(0.5f, 4);
  node->UI_InstallTimer(0.25f, 4);
  node->UI_InstallTimer(1.0f, 5);
  ASSERT_EQ(root->Timers().GetTimerCount(), 2u);
  ASSERT_EQ(node->UI_GetTimerList().size(), 2u);
  EXPECT_EQ(node->UI_GetTimerList()[0]->GetTimerID(), 4);
  EXPECT_FLOAT_EQ(node->UI_GetTimerList()[0]->GetSeconds(), 0.25f);
  EXPECT_TRUE(node->UI_RemoveTimer(4));
  EXPECT_FALSE(node->UI_RemoveTimer(4));
  EXPECT_FALSE(node->UI_HasTimer(4));
  EXPECT_TRUE(node->UI_HasTimer(5));
  EXPECT_EQ(root->Timers().GetTimerCount(), 1u);
}

TEST_F(TimerTest, AHandlerThatAnswersFalseGetsNoSecondTick) {
  int ticks = 0;
  Handler([&](std::int32_t) {
    ++ticks;
    return false;
  });
  node->UI_InstallTimer(0.1f, 1);
  const UI_NodeTimerDataP data = node->UI_GetTimerList().front();
  EXPECT_TRUE(root->Timers().DispatchPossibleTimer(data.get()));
  EXPECT_FALSE(data->IsLive());
  EXPECT_FALSE(root->Timers().DispatchPossibleTimer(data.get()));
  EXPECT_EQ(ticks, 1);
  EXPECT_TRUE(node->UI_GetTimerList().empty());
}

TEST_F(TimerTest, AHandlerThatReinstallsItsIdKeepsTheNewTimerAndTheOthers) {
  node->UI_InstallTimer(1.0f, 8);
  Handler([&](std::int32_t id) {
    if (id == 3) node->UI_InstallTimer(0.2f, 3);
    return false;
  });
  node->UI_InstallTimer(0.1f, 3);
  EXPECT_EQ(Tick(*node, 3), 1);
  // The answer false removed nothing: its own timer was already replaced.
  ASSERT_TRUE(node->UI_HasTimer(3));
  EXPECT_TRUE(node->UI_HasTimer(8));
  EXPECT_EQ(root->Timers().GetTimerCount(), 2u);
}

TEST_F(TimerTest, AHandlerMayDestroyItsOwnNode) {
  LoggingView* raw = node.get();
  Handler([&](std::int32_t) {
    root->ChildRemove(raw);
    node.reset();
    return false;
  });
  raw->UI_InstallTimer(0.1f, 2);
  const UI_NodeTimerDataP data = raw->UI_GetTimerList().front();
  EXPECT_TRUE(root->Timers().DispatchPossibleTimer(data.get()));
  EXPECT_FALSE(data->IsLive());
  EXPECT_EQ(root->Timers().GetTimerCount(), 0u);
}

TEST_F(TimerTest, ANodeInNoWindowCannotInstallATimer) {
  auto loose = MakeView(nullptr, {0, 0, 10, 10}, "loose", log);
  EXPECT_TRUE(velkui::test::RaisesContractViolation([&] { loose->UI_InstallTimer(0.1f, 1); }));
  EXPECT_THROW(node->UI_InstallTimer(-1.0f, 1), velkcore::Exception);
  EXPECT_THROW(node->UI_InstallTimer(std::numeric_limits<float>::quiet_NaN(), 1),
               velkcore::Exception);
  EXPECT_TRUE(node->UI_GetTimerList().empty());
}

TEST_F(TimerTest, TheActiveCaptureLooksFirst) {
  class TimerCapture : public LoggingCapture {
   public:
    using LoggingCapture::LoggingCapture;
    bool answer = true;
    bool DoTimerNotify(std::int32_t id) override {
      ids.push_back(id);
      return answer;
    }
    std::vector<std::int32_t> ids;
  };
  int nodeTicks = 0;
  Handler([&](std::int32_t) {
    ++nodeTicks;
    return true;
  });
  node->UI_InstallTimer(0.1f, 6);
  auto capture =
      velkcore::MakeIntrusive<TimerCapture>(node.get(), Mouse(MouseEvent::kButtonDown, 1, 1), log);
  manager->BeginInputCapture(capture);
  EXPECT_EQ(Tick(*node, 6), 1);
  EXPECT_EQ(nodeTicks, 0);
  capture->answer = false;
  EXPECT_EQ(Tick(*node, 6), 1);
  EXPECT_EQ(nodeTicks, 1);
  capture->Cancel();
  EXPECT_EQ(Tick(*node, 6), 1);
  EXPECT_EQ(capture->ids, (std::vector<std::int32_t>{6, 6}));
  manager->EndInputCapture(true);
}

TEST_F(TimerTest, OnlyTimersOfTheManagersOwnTreeTick) {
  Handler([](std::int32_t) { return true; });
  node->UI_InstallTimer(0.1f, 1);
  const UI_NodeTimerDataP data = node->UI_GetTimerList().front();
  // Moved elsewhere without the usual removal (a bare container, say): the
  // stale timer must not reach a node outside the window.
  auto other = MakeView(nullptr, {0, 0, 10, 10}, "other", log);
  auto foreign = root->Timers().CreateTimer(other.get(), 1, 0.1f);
  EXPECT_FALSE(root->Timers().DispatchPossibleTimer(foreign.get()));
  EXPECT_TRUE(root->Timers().DispatchPossibleTimer(data.get()));
  EXPECT_FALSE(root->Timers().DispatchPossibleTimer(nullptr));
  UI_NodeTimerList list;
  EXPECT_TRUE(root->Timers().RemoveTimerData(foreign.get(), list));
}

TEST_F(TimerTest, LeavingTheWindowOrDyingStopsTheTimersOfASubtree) {
  std::vector<std::string> platform;
  UI_NodeTimerManager tracked(
      root.get(), [&](UI_Node* managerNode, UI_Node* owner, std::int32_t id, float seconds) {
        return UI_NodeTimerDataP(new TrackedTimerData(managerNode, owner, id, seconds, &platform));
      });
  auto inner = MakeView(node.get(), {0, 0, 5, 5}, "inner", log);
  node->UI_GetTimerList().push_back(tracked.CreateTimer(node.get(), 1, 0.1f));
  inner->UI_GetTimerList().push_back(tracked.CreateTimer(inner.get(), 2, 0.1f));
  EXPECT_EQ(platform, (std::vector<std::string>{"start1", "start2"}));
  root->ChildRemove(node.get());
  EXPECT_EQ(tracked.GetTimerCount(), 0u);
  EXPECT_EQ(platform, (std::vector<std::string>{"start1", "start2", "stop1", "stop2"}));

  auto dying = MakeView(nullptr, {0, 0, 5, 5}, "dying", log);
  dying->UI_GetTimerList().push_back(tracked.CreateTimer(dying.get(), 3, 0.1f));
  dying.reset();
  EXPECT_EQ(tracked.GetTimerCount(), 0u);
  EXPECT_EQ(platform.back(), "stop3");
}

TEST_F(TimerTest, NodesOutliveTheirWindowsTimers) {
  node->UI_InstallTimer(0.1f, 1);
  const UI_NodeTimerDataP data = node->UI_GetTimerList().front();
  root->DropTimerManager();
  EXPECT_FALSE(data->IsLive());
  EXPECT_FALSE(node->UI_HasTimer(1));
  EXPECT_FALSE(node->UI_RemoveTimer(1));
  EXPECT_TRUE(node->UI_GetTimerList().empty());
}

}  // namespace
}  // namespace velkui::ui::test
