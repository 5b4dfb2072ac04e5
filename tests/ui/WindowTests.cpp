#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/ui/NodeManagerGuards.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_ViewContainer.h>
#include <velkui/ui/UI_NodeTimerManager.h>
#include <velkui/ui/UI_SubWindowView.h>

#include "WindowTestSupport.h"

namespace velkui::ui::test {
namespace {

class WindowLifecycleTest : public WindowTest {};

TEST_F(WindowLifecycleTest, ATopLevelWindowsCoordinatesAreItsClientAreaOnScreen) {
  auto window = velkcore::MakeIntrusive<OS_Window>(u"Doc", RectT<std::int32_t>{100, 50, 300, 200},
                                                   kStyleCaption | kStyleSystemMenu);
  // A caption and a one-pixel border.
  EXPECT_EQ(window->UI_GetGlobalStructureRect(), (RectT<std::int32_t>{100, 50, 300, 200}));
  EXPECT_EQ(window->UI_GetLocalRect(true), (RectT<std::int32_t>{101, 75, 298, 174}));
  EXPECT_EQ(window->UI_GetLocalRectF(false), (RectT<float>{0, 0, 298, 174}));
  EXPECT_EQ(window->UI_GetSelfToParentMatrix(), (ScaleMatrixT<float>{101, 75, 1, 1}));
  EXPECT_FALSE(window->UI_IsShown());
  EXPECT_TRUE(window->UI_ReceivesEventsFromOS());
  auto view = View(window.get(), {10, 20, 30, 30}, "view");
  // Global coordinates of a node are its window's client coordinates.
  EXPECT_EQ(view->UI_LocalToGlobalF(PointT<float>{1, 1}), (PointT<float>{11, 21}));

  window->UI_Move({200, 150});
  EXPECT_EQ(window->UI_GetLocalRect(true), (RectT<std::int32_t>{201, 175, 298, 174}));
  window->UI_SetLocalRect({0, 0, 500, 400});
  EXPECT_EQ(window->UI_GetGlobalStructureRect(), (RectT<std::int32_t>{-1, -25, 502, 426}));
  EXPECT_THROW(window->UI_CreateWindow(u"", kNoPlatformWindow, {0, 0, 1, 1}, 0, 0),
               velkcore::Exception);
}

TEST_F(WindowLifecycleTest, AUserResizeReachesTheTreeAndBoundChildrenFollow) {
  auto window = MakeWindow({0, 0, 200, 100});
  auto stretchy = View(window.get(), {10, 10, 180, 80}, "stretchy");
  stretchy->UI_SetLayoutBinding(LayoutBinding{kBindRightToRight | kBindBottomToBottom});
  auto pinned = View(window.get(), {150, 70, 40, 20}, "pinned");
  pinned->UI_SetLayoutBinding(
      LayoutBinding{kBindLeftToRight | kBindRightToRight | kBindTopToBottom | kBindBottomToBottom});
  headless.UserSetClientRect(Handle(*window), {0, 0, 300, 150});
  headless.ProcessEvents();
  EXPECT_EQ(window->UI_GetLocalRectF(false), (RectT<float>{0, 0, 300, 150}));
  EXPECT_EQ(stretchy->UI_GetLocalRectF(true), (RectT<float>{10, 10, 280, 130}));
  EXPECT_EQ(pinned->UI_GetLocalRectF(true), (RectT<float>{250, 120, 40, 20}));
  // The whole new area gets painted.
  EXPECT_EQ(headless.GetPaintCount(Handle(*window)), 2);
}

TEST_F(WindowLifecycleTest, NodesResizedDuringAUserResizeRepaintWhenItEnds) {
  auto window = MakeWindow({0, 0, 200, 100});
  auto view = View(window.get(), {10, 10, 30, 30}, "view");
  headless.ProcessEvents();
  UI_NodeManager& manager = session.GetNodeManager();
  manager.BeginUserResizing(window.get(), false);
  manager.BeginUserResizing(window.get(), false);
  manager.InvalidateNodeAfterUserResize(view.get());
  manager.InvalidateNodeAfterUserResize(view.get());
  manager.EndUserResizing(window.get(), false);
  EXPECT_FALSE(headless.HasPendingPaint(Handle(*window)));
  manager.EndUserResizing(window.get(), false);
  EXPECT_EQ(headless.GetPendingPaintBounds(Handle(*window)), (RectT<std::int32_t>{10, 10, 30, 30}));
  headless.ProcessEvents();
  // Outside a user resize the repaint is asked for at once.
  manager.InvalidateNodeAfterUserResize(view.get());
  EXPECT_TRUE(headless.HasPendingPaint(Handle(*window)));
}

TEST_F(WindowLifecycleTest, APanelDestroyedWithTheFocusInsideLeavesNoDanglingRole) {
  // A panel built outside any window (an offscreen page, say).
  class Field : public LoggingView {
   public:
    using LoggingView::LoggingView;
    bool UI_InvalidateOnKeyboardFocusChange(bool) const override { return true; }
  };
  auto panel = View(nullptr, {10, 10, 100, 50}, "panel");
  auto field = MakeView<Field>(panel.get(), {5, 5, 20, 10}, "field", log);
  field->wantsFocus = true;
  field->UI_GainKeyboardFocus();
  field.reset();
  // The last reference: the panel dies with its focused child inside, which
  // leaves while its parent is half destroyed (the sanitizer build checks it).
  panel.reset();
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), nullptr);
}

TEST_F(WindowLifecycleTest, WindowsAreFoundByHandleAndByNodeID) {
  auto a = MakeWindow({0, 0, 10, 10});
  auto b = MakeWindow({20, 0, 10, 10});
  auto c = MakeWindow({40, 0, 10, 10});
  a->UI_SetNodeID("Inspector");
  c->UI_SetNodeID("Inspector");
  EXPECT_EQ(OS_Window::UI_GetWindow(Handle(*b)), b.get());
  EXPECT_TRUE(OS_Window::UI_IsOSWindowType(Handle(*b)));
  EXPECT_EQ(OS_Window::UI_EnumerateAllWindows(),
            (std::vector<OS_Window*>{a.get(), b.get(), c.get()}));
  EXPECT_EQ(OS_Window::UI_FindWindowFromID("Inspector"), a.get());
  EXPECT_EQ(OS_Window::UI_FindAllWindowsMatchingID("Inspector"),
            (std::vector<OS_Window*>{a.get(), c.get()}));
  EXPECT_EQ(OS_Window::UI_FindWindowFromID("Nothing"), nullptr);
  const PlatformWindow handle = Handle(*b);
  b.reset();
  EXPECT_FALSE(OS_Window::UI_IsOSWindowType(handle));
  EXPECT_FALSE(headless.IsWindow(handle));
  EXPECT_EQ(OS_Window::UI_EnumerateAllWindows().size(), 2u);
  // Messages for a window that is gone are dropped.
  headless.PostEvent(OS_Event(handle, kMsgClose, 0, 0, 0));
  EXPECT_TRUE(headless.ProcessEvents());
}

TEST_F(WindowLifecycleTest, ACloseRequestHidesTheWindowUnlessAFunctionKeepsItOpen) {
  auto window = MakeWindow({0, 0, 100, 100});
  bool keepOpen = true;
  bool sawClosing = false;
  const auto veto = std::make_shared<OS_Window::CloseFunction>([&](OS_Window& w) {
    sawClosing = w.UI_DuringClose();
    return keepOpen;
  });
  window->InstallCloseFunction(veto);
  headless.UserClose(Handle(*window));
  headless.ProcessEvents();
  EXPECT_TRUE(sawClosing);
  EXPECT_TRUE(window->UI_IsShown());
  EXPECT_FALSE(window->UI_DuringClose());
  keepOpen = false;
  window->UI_PostClose();
  EXPECT_TRUE(window->UI_IsShown());
  headless.ProcessEvents();
  EXPECT_FALSE(window->UI_IsShown());
  EXPECT_FALSE(headless.IsWindowVisible(Handle(*window)));
}

TEST_F(WindowLifecycleTest, ActivationReachesTheTreeAndTheApplicationState) {
  class ActivationView : public LoggingView {
   public:
    using LoggingView::LoggingView;
    std::vector<WindowActivation> seen;
    void UI_ActivationChanged(WindowActivation activation) override { seen.push_back(activation); }
  };
  auto window = MakeWindow({0, 0, 100, 100});
  auto view = MakeView<ActivationView>(window.get(), {0, 0, 10, 10}, "view", log);
  auto other = MakeWindow({200, 0, 100, 100});
  ASSERT_EQ(view->seen, (std::vector<WindowActivation>{WindowActivation::kDeactivated}));
  MoveTo(*window, 50, 50);
  headless.Click();
  headless.ProcessEvents();
  EXPECT_EQ(view->seen.back(), WindowActivation::kActivatedByClick);
  EXPECT_TRUE(session.GetNodeManager().IsApplicationFrontmost());
  headless.DeactivateApplication();
  headless.ProcessEvents();
  EXPECT_EQ(view->seen.back(), WindowActivation::kDeactivated);
  EXPECT_FALSE(session.GetNodeManager().IsApplicationFrontmost());
  other->UI_Activate();
  headless.ProcessEvents();
  EXPECT_TRUE(session.GetNodeManager().IsApplicationFrontmost());
}

TEST_F(WindowLifecycleTest, EachWindowGetsBackTheFocusItHadWhenItIsActivatedAgain) {
  auto first = MakeWindow({0, 0, 100, 100});
  auto a = View(first.get(), {0, 0, 10, 10}, "a");
  auto second = MakeWindow({200, 0, 100, 100});
  auto b = View(second.get(), {0, 0, 10, 10}, "b");
  a->wantsFocus = true;
  b->wantsFocus = true;
  first->UI_Activate();
  headless.ProcessEvents();
  a->UI_GainKeyboardFocus();
  headless.ProcessEvents();
  // Taking focus inside a window gives the window the platform focus.
  EXPECT_EQ(headless.GetFocus(), Handle(*first));
  second->UI_Activate();
  headless.ProcessEvents();
  EXPECT_FALSE(a->UI_HasKeyboardFocus(false));
  b->UI_GainKeyboardFocus();
  headless.ProcessEvents();
  first->UI_Activate();
  headless.ProcessEvents();
  EXPECT_TRUE(a->UI_HasKeyboardFocus(true));
  second->UI_Activate();
  headless.ProcessEvents();
  EXPECT_TRUE(b->UI_HasKeyboardFocus(true));
  // While OS focus updates are suspended, focus inside a window stays there.
  {
    const SuspendOSFocusUpdates suspended(session.GetNodeManager());
    a->UI_GainKeyboardFocus();
    EXPECT_EQ(headless.GetFocus(), Handle(*second));
  }
}

TEST_F(WindowLifecycleTest, LosingThePlatformCaptureCancelsTheInputCapture) {
  auto window = MakeWindow({0, 0, 100, 100});
  auto view = View(window.get(), {0, 0, 50, 50}, "view");
  auto capture = velkcore::MakeIntrusive<LoggingCapture>(view.get(),
                                                         Mouse(MouseEvent::kButtonDown, 1, 1), log);
  session.GetNodeManager().BeginInputCapture(capture);
  EXPECT_EQ(headless.GetCapture(), Handle(*window));
  headless.DeactivateApplication();
  headless.ProcessEvents();
  EXPECT_FALSE(session.GetNodeManager().HasInputCapture());
  EXPECT_TRUE(capture->HasBeenCancelled());
}

TEST_F(WindowLifecycleTest, AWindowLeftOffScreenByAMonitorChangeComesBack) {
  headless.SetMonitors({{{0, 0, 1440, 900}, {0, 0, 1440, 900}, 1, true},
                        {{1440, 0, 1280, 1024}, {1440, 0, 1280, 1000}, 2, false}});
  auto window = MakeWindow({1800, 300, 400, 300}, kStyleCaption);
  auto safe = MakeWindow({100, 100, 200, 200}, kStyleCaption);
  headless.SetMonitors({{{0, 0, 1440, 900}, {0, 0, 1440, 860}, 1, true}});
  headless.ProcessEvents();
  const RectT<std::int32_t> frame = window->UI_GetGlobalStructureRect();
  EXPECT_EQ(frame.width, 400);
  EXPECT_LE(frame.left + frame.width, 1440);
  EXPECT_GE(frame.left, 0);
  EXPECT_EQ(safe->UI_GetGlobalStructureRect(), (RectT<std::int32_t>{100, 100, 200, 200}));
}

TEST_F(WindowLifecycleTest, AViewContainerFollowsItsNodeInsideTheHost) {
  auto window = MakeWindow({100, 100, 400, 300});
  auto panel = View(window.get(), {50, 40, 300, 200}, "panel");
  auto container = MakeView<OS_ViewContainer>(panel.get(), {10, 10, 100, 50}, true);
  const PlatformWindow handle = Handle(*container);
  ASSERT_NE(handle, kNoPlatformWindow);
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{160, 150, 100, 50}));
  panel->UI_SetLocalRectF({60, 40, 300, 200});
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{170, 150, 100, 50}));
  panel->UI_Show(false);
  EXPECT_FALSE(headless.IsWindowVisible(handle));
  panel->UI_Show(true);
  EXPECT_TRUE(headless.IsWindowVisible(handle));
  // Into another window.
  auto other = MakeWindow({600, 100, 300, 300});
  other->ChildPushBack(container);
  EXPECT_EQ(headless.GetWindowParent(handle), Handle(*other));
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{610, 110, 100, 50}));
  // Moving the host on screen carries the child along.
  other->UI_Move({700, 200});
  EXPECT_EQ(headless.GetClientRect(handle).left - headless.GetClientRect(Handle(*other)).left, 10);
}

TEST_F(WindowLifecycleTest, APopupViewContainerFollowsOnScreen) {
  auto window = MakeWindow({100, 100, 400, 300}, kStyleCaption);
  auto popup = MakeView<OS_PopupViewContainer>(window.get(), {10, 20, 80, 40});
  const PlatformWindow handle = Handle(*popup);
  ASSERT_NE(handle, kNoPlatformWindow);
  EXPECT_EQ(headless.GetWindowParent(handle), Handle(*window));
  EXPECT_TRUE((headless.GetWindowStyle(handle) & kStylePopup) != 0);
  const RectT<std::int32_t> client = headless.GetClientRect(Handle(*window));
  EXPECT_EQ(headless.GetClientRect(handle),
            (RectT<std::int32_t>{client.left + 10, client.top + 20, 80, 40}));
  headless.UserSetClientRect(Handle(*window), {300, 300, 400, 300});
  headless.ProcessEvents();
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{310, 320, 80, 40}));
}

TEST_F(WindowLifecycleTest, ASubWindowSendsItsMouseToItsProxy) {
  auto window = MakeWindow({0, 0, 400, 300});
  auto proxy = MakeView<RecordingView>(window.get(), {0, 0, 400, 300}, "proxy", log);
  auto subView = MakeView<UI_SubWindowView>(window.get(), {100, 50, 200, 100});
  SubWindow* sub = subView->GetSubWindow();
  ASSERT_NE(sub, nullptr);
  const PlatformWindow handle = Handle(*sub);
  ASSERT_NE(handle, kNoPlatformWindow);
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{100, 50, 200, 100}));
  EXPECT_EQ(sub->GetProxyOrParent(), subView.get());
  sub->SetProxy(proxy.get());
  headless.MovePointer({110, 60});
  headless.Click();
  headless.ProcessEvents();
  // The click went to the sub-window's platform window and on to the proxy,
  // in the proxy's coordinates.
  ASSERT_EQ(proxy->MouseOf(MouseEvent::kButtonDown).size(), 1u);
  EXPECT_EQ(proxy->MouseOf(MouseEvent::kButtonDown).front().GetPosition(),
            (PointT<float>{110, 60}));
  subView->UI_SetLocalRectF({0, 0, 50, 60});
  EXPECT_EQ(headless.GetClientRect(handle), (RectT<std::int32_t>{0, 0, 50, 60}));
  subView->UI_Show(false);
  EXPECT_FALSE(headless.IsWindowVisible(handle));
  sub->SetProxy(nullptr);
}

TEST_F(WindowLifecycleTest, OwnersChainUpToTheModalWindow) {
  auto main = MakeWindow({0, 0, 100, 100});
  auto dialog = MakeWindow({10, 10, 50, 50});
  auto popup = MakeWindow({20, 20, 10, 10});
  popup->SetOwner(dialog.get());
  dialog->SetOwner(main.get());
  EXPECT_THROW(main->SetOwner(popup.get()), velkcore::Exception);
  EXPECT_FALSE(popup->OwnedByModalWindow());
  {
    const SetModalWindow modal(session.GetNodeManager(), dialog.get());
    EXPECT_TRUE(popup->OwnedByModalWindow());
    EXPECT_TRUE(dialog->OwnedByModalWindow());
    EXPECT_FALSE(main->OwnedByModalWindow());
  }
  dialog.reset();
  EXPECT_EQ(popup->GetOwner(), nullptr);
}

TEST_F(WindowLifecycleTest, TimersTickThroughThePlatformAndStopWithTheirWindow) {
  auto window = MakeWindow({0, 0, 100, 100});
  auto view = View(window.get(), {0, 0, 10, 10}, "view");
  int ticks = 0;
  view->UI_InstallTimerNotifyFunction(
      std::make_shared<UI_Node::TimerNotifyFunction>([&](std::int32_t id) {
        if (id != 3) return false;
        ++ticks;
        return true;
      }));
  view->UI_InstallTimer(0.1f, 3);
  headless.RunFor(1.05);
  EXPECT_EQ(ticks, 10);
  ASSERT_EQ(headless.GetTimers(Handle(*window)).size(), 1u);
  view->UI_RemoveTimer(3);
  EXPECT_TRUE(headless.GetTimers(Handle(*window)).empty());
  // A handler that answers false stops its platform timer with the first tick.
  int lastTicks = 0;
  view->UI_InstallTimerNotifyFunction(
      std::make_shared<UI_Node::TimerNotifyFunction>([&](std::int32_t id) {
        if (id == 4) ++lastTicks;
        return false;
      }));
  view->UI_InstallTimer(0.05f, 4);
  headless.RunFor(1);
  EXPECT_EQ(lastTicks, 1);
  EXPECT_TRUE(headless.GetTimers(Handle(*window)).empty());
  view->UI_InstallTimer(0.1f, 3);
  const PlatformWindow handle = Handle(*window);
  window->ChildRemove(view.get());
  EXPECT_TRUE(headless.GetTimers(handle).empty());
  window->ChildPushBack(view);
  view->UI_InstallTimer(0.1f, 3);
  window.reset();
  EXPECT_FALSE(view->UI_HasTimer(3));
}

TEST_F(WindowLifecycleTest, AQueueThatNeverRunsDryIsAnErrorNotAHang) {
  auto window = MakeWindow({0, 0, 100, 100});
  auto view = View(window.get(), {0, 0, 10, 10}, "view");
  // A node that asks for another paint from its own paint.
  view->onDraw = [](LoggingView& self) { self.UI_Invalidate(nullptr, InvalidateFlags{}); };
  view->UI_Invalidate(nullptr, InvalidateFlags{});
  headless.SetMessageLimit(500);
  const auto error = velkui::test::ErrorOf([&] { headless.ProcessEvents(); });
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetNumber(), 22);
  view->onDraw = nullptr;
  headless.ProcessEvents();
  HeadlessPlatform loose;
  EXPECT_THROW(loose.ProcessEvents(), velkcore::Exception);
}

TEST_F(WindowLifecycleTest, TheModalLoopEndsWhenTheHeadlessQueueRunsDryOrOnQuit) {
  auto window = MakeWindow({0, 0, 100, 100});
  MoveTo(*window, 5, 5);
  EXPECT_EQ(OS_RunMessageLoop([] { return false; }), PumpResult::kIdle);
  int turns = 0;
  headless.Click();
  EXPECT_EQ(OS_RunMessageLoop([&] { return ++turns > 1; }), PumpResult::kDispatched);
  OS_PostQuit(3);
  headless.Click();
  // Queued messages come first, then the quit request.
  EXPECT_EQ(OS_RunMessageLoop({}), PumpResult::kQuit);
  EXPECT_EQ(headless.GetQueueLength(), 0u);
  EXPECT_TRUE(headless.IsQuitting());
  EXPECT_EQ(headless.GetExitCode(), 3);
  // Every loop started while quitting ends at once.
  EXPECT_EQ(OS_PumpEvent(false), PumpResult::kQuit);
  EXPECT_FALSE(headless.ProcessEvents());
  headless.ClearQuitting();
}

}  // namespace
}  // namespace velkui::ui::test
