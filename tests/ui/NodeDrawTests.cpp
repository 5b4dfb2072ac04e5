#include <algorithm>
#include <cstdio>

#include <gtest/gtest.h>

#include <velkui/test/RecordingSupplier.h>
#include <velkui/ui/Theme.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

using velkui::test::RecordedCall;
using velkui::test::RecordingSupplier;

// The device rectangle of a recorded PaintRect ("PaintRect (r,g,b,a) [l,t,w,h]").
RectT<float> DeviceRect(const RecordedCall& call) {
  RectT<float> local;
  const auto bracket = call.arguments.find('[');
  EXPECT_NE(bracket, std::string::npos);
  std::sscanf(call.arguments.c_str() + bracket, "[%f,%f,%f,%f]", &local.left, &local.top,
              &local.width, &local.height);
  const PointT<float> a = call.transform.Transform({local.left, local.top});
  const PointT<float> b = call.transform.Transform({local.Right(), local.Bottom()});
  return {std::min(a.x, b.x), std::min(a.y, b.y), std::abs(b.x - a.x), std::abs(b.y - a.y)};
}

class NodeDrawTest : public NodeTest<UI_NodeManager> {
 protected:
  boost::intrusive_ptr<RecordingSupplier> supplier = velkcore::MakeIntrusive<RecordingSupplier>();
  boost::intrusive_ptr<pictel::SurfaceInterface> surface = supplier->NewSurface(400, 400, true);
  pictel::Pictel context{supplier.get(), surface.get()};
  LoggingViewP root = MakeView(nullptr, {0, 0, 400, 400}, "root", log);

  LoggingViewP View(const std::string& name, UI_Node* parent, RectT<float> frame) {
    auto view = NodeTest::View(name, parent, frame);
    view->paints = true;
    return view;
  }

  void Paint() {
    log->clear();
    supplier->GetLog().Clear();
    root->UI_DispatchDrawFromRoot({1, 1, 1, 1}, &context, true);
  }
  EventLog Draws() const { return Only(":draw"); }
  // The calls of the window's surface (not of cache bitmaps).
  std::vector<RecordedCall> Calls(const std::string& name) const {
    std::vector<RecordedCall> calls;
    for (const RecordedCall& call : supplier->GetLog().GetCalls()) {
      if (call.surface == 1 && call.name == name) calls.push_back(call);
    }
    return calls;
  }
  std::vector<RectT<float>> Painted() const {
    std::vector<RectT<float>> rects;
    for (const RecordedCall& call : Calls("PaintRect")) rects.push_back(DeviceRect(call));
    return rects;
  }
  void ClipDevice(const RectT<float>& rect) {
    const auto path = supplier->NewPath();
    path->AddRect(rect);
    surface->Clip(*path, pictel::FillType::kWinding);
  }
  bool StateStackBalanced() const {
    return Calls("PushStateStack").size() == Calls("PopStateStack").size();
  }
};

TEST_F(NodeDrawTest, TheTreeIsDrawnInZOrderWithEachNodesTransform) {
  auto a = View("a", root.get(), {10, 20, 100, 100});
  auto a1 = View("a1", a.get(), {5, 5, 10, 10});
  a1->UI_SetMatrix({1, 1, 2, 3});
  auto b = View("b", root.get(), {200, 200, 50, 50});
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"a:draw", "a1:draw", "b:draw"}));
  // The background first, then each node at its place on the device.
  EXPECT_EQ(Painted(),
            (std::vector<RectT<float>>{
                {0, 0, 400, 400}, {10, 20, 100, 100}, {21, 36, 20, 30}, {200, 200, 50, 50}}));
  EXPECT_TRUE(StateStackBalanced());
}

TEST_F(NodeDrawTest, HiddenEmptyAndDegenerateNodesAreSkippedWithTheirSubtrees) {
  auto hidden = View("hidden", root.get(), {0, 0, 50, 50});
  View("underHidden", hidden.get(), {0, 0, 10, 10});
  hidden->UI_Show(false);
  View("empty", root.get(), {0, 0, 0, 50});
  auto flat = View("flat", root.get(), {0, 0, 50, 50});
  flat->UI_SetMatrix({0, 0, 1e-7f, 1});
  View("underFlat", flat.get(), {0, 0, 10, 10});
  auto shown = View("shown", root.get(), {0, 0, 50, 50});
  Paint();
  EXPECT_EQ(Draws(), std::vector<std::string>{"shown:draw"});
}

TEST_F(NodeDrawTest, ChildrenOutsideTheClipAreNeverDrawn) {
  ClipDevice({100, 100, 50, 50});
  auto inside = View("inside", root.get(), {120, 120, 10, 10});
  auto touching = View("touching", root.get(), {149, 149, 10, 10});
  View("justOutside", root.get(), {150, 100, 10, 10});
  View("farAway", root.get(), {300, 300, 10, 10});
  auto scaled = View("scaled", root.get(), {0, 0, 10, 10});
  scaled->UI_SetMatrix({0, 0, 10, 10});  // covers 0..100: outside
  auto scaledIn = View("scaledIn", root.get(), {0, 0, 20, 20});
  scaledIn->UI_SetMatrix({0, 0, 6, 6});  // covers 0..120: inside
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"inside:draw", "touching:draw", "scaledIn:draw"}));
  EXPECT_TRUE(StateStackBalanced());
}

TEST_F(NodeDrawTest, ClipToSelfClipsInsideASavedStateAndCustomDrawingReplacesUI_Draw) {
  auto clipped = View("clipped", root.get(), {10, 10, 50, 50});
  clipped->UI_SetClipToSelfEnabled(true);
  View("overhanging", clipped.get(), {40, 40, 50, 50});
  Paint();
  // The clipped node and its overhanging child are drawn under the node's device rectangle.
  const std::vector<RecordedCall> paints = Calls("PaintRect");
  ASSERT_EQ(paints.size(), 3u);
  EXPECT_EQ(paints[0].clip, (RectT<std::int32_t>{0, 0, 400, 400}));
  EXPECT_EQ(paints[1].clip, (RectT<std::int32_t>{10, 10, 50, 50}));
  EXPECT_EQ(paints[2].clip, (RectT<std::int32_t>{10, 10, 50, 50}));
  EXPECT_EQ(DeviceRect(paints[2]), (RectT<float>{50, 50, 50, 50}));
  EXPECT_EQ(Calls("Clip").size(), 1u);
  EXPECT_TRUE(StateStackBalanced());

  int customCalls = 0;
  bool answer = true;
  clipped->UI_SetCustomDrawFunction(std::make_shared<UI_Node::CustomDrawFunction>(
      [&](const UI_Node* node, pictel::Pictel* context) {
        EXPECT_EQ(node, clipped.get());
        EXPECT_EQ(context->GetSurface(), surface.get());
        ++customCalls;
        return answer;
      }));
  Paint();
  EXPECT_EQ(customCalls, 1);
  EXPECT_TRUE(Draws().empty());  // children are the custom function's business too
  answer = false;
  Paint();
  EXPECT_EQ(customCalls, 2);
  EXPECT_EQ(Draws(), (std::vector<std::string>{"clipped:draw", "overhanging:draw"}));
}

TEST_F(NodeDrawTest, DrawFromRootWithoutBackgroundModeLetsTheRootDrawItself) {
  root->paints = true;
  log->clear();
  root->UI_DispatchDrawFromRoot({0, 0, 0, 0}, &context, false);
  EXPECT_EQ(Draws(), std::vector<std::string>{"root:draw"});

  Paint();  // background mode: the root itself is not asked to draw
  EXPECT_TRUE(Draws().empty());
  supplier->GetLog().Clear();
  root->UI_DispatchDrawFromRoot({0, 0, 0, 0}, &context, true);  // transparent: no fill
  EXPECT_TRUE(Calls("PaintRect").empty());
}

// ---- Draw caches ----

class NodeCacheTest : public NodeDrawTest {
 protected:
  LoggingViewP parent = View("parent", root.get(), {10, 10, 100, 100});
  LoggingViewP child = View("child", parent.get(), {10, 10, 20, 20});

  void SetUp() override { parent->UI_SetDrawCachePolicy(DrawCachePolicy::kAlways); }
};

TEST_F(NodeCacheTest, AValidCacheStandsInForDrawing) {
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"parent:draw", "child:draw"}));
  ASSERT_NE(parent->UI_GetPictelCache(), nullptr);
  EXPECT_EQ(Calls("DrawImage").size(), 1u);
  EXPECT_TRUE(Calls("PaintRect").size() == 1u);  // only the background: the rest went to the cache

  Paint();
  EXPECT_TRUE(Draws().empty());
  EXPECT_EQ(Calls("DrawImage").size(), 1u);

  parent->UI_SetDrawCachePolicy(DrawCachePolicy::kNever);
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"parent:draw", "child:draw"}));
}

TEST_F(NodeCacheTest, InvalidatingADescendantAlwaysReachesTheCache) {
  Paint();
  for (int round = 0; round < 3; ++round) {
    child->UI_Invalidate(nullptr, InvalidateFlags{});
    child->UI_Invalidate(nullptr, InvalidateFlags{});
    EXPECT_EQ(parent->UI_GetPictelCache(), nullptr) << "round " << round;
    Paint();
    EXPECT_EQ(Draws(), (std::vector<std::string>{"parent:draw", "child:draw"}));
  }
}

TEST_F(NodeCacheTest, OnlyTheNodeStartingAKeepOwnInvalidationKeepsItsCache) {
  child->UI_SetDrawCachePolicy(DrawCachePolicy::kAlways);
  Paint();
  ASSERT_NE(child->UI_GetPictelCache(), nullptr);
  ASSERT_NE(parent->UI_GetPictelCache(), nullptr);
  child->UI_SetMatrix({5, 5, 1, 1});
  EXPECT_NE(child->UI_GetPictelCache(), nullptr);
  EXPECT_EQ(parent->UI_GetPictelCache(), nullptr);

  // Later in the same generation the child's own drawing changes: its pixels must go.
  child->UI_Invalidate(nullptr, InvalidateFlags{});
  EXPECT_EQ(child->UI_GetPictelCache(), nullptr);
}

TEST_F(NodeCacheTest, ShowingAChildAndAddingOneDropTheParentsCache) {
  auto late = View("late", nullptr, {0, 0, 10, 10});
  Paint();
  parent->ChildPushBack(late);
  EXPECT_EQ(parent->UI_GetPictelCache(), nullptr);
  Paint();
  child->UI_Show(false);
  EXPECT_EQ(parent->UI_GetPictelCache(), nullptr);
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"parent:draw", "late:draw"}));
}

TEST_F(NodeCacheTest, AThemeChangeInvalidatesCaches) {
  Theme::Initialize(std::make_unique<Theme>());
  Paint();
  Paint();
  EXPECT_TRUE(Draws().empty());
  Theme::Get().NotifyThemeChanged();
  Paint();
  EXPECT_EQ(Draws(), (std::vector<std::string>{"parent:draw", "child:draw"}));
  Theme::Terminate();
}

// ---- Invalidation ----

TEST_F(NodeDrawTest, InvalidationClimbsWithTheAreaMappedIntoEachParent) {
  auto parent = View("parent", root.get(), {100, 50, 200, 200});
  parent->UI_SetMatrix({0, 0, 2, 2});
  auto child = View("child", parent.get(), {10, 10, 40, 40});
  Paint();  // nothing pending any more
  root->invalidations = 0;
  const RectT<std::int32_t> part{5, 5, 100, 10};  // clipped to the child's 40 x 40
  child->UI_Invalidate(&part, InvalidateFlags{});
  EXPECT_EQ(root->invalidations, 1);
  EXPECT_EQ(parent->lastInvalidRect, (RectT<std::int32_t>{15, 15, 35, 10}));
  EXPECT_EQ(root->lastInvalidRect, (RectT<std::int32_t>{230, 130, 70, 20}));

  // A hidden node's area is not requested, nor an empty intersection.
  const RectT<std::int32_t> outside{50, 50, 10, 10};
  child->UI_Invalidate(&outside, InvalidateFlags{});
  child->UI_Show(false);
  root->invalidations = 0;
  child->UI_Invalidate(nullptr, InvalidateFlags{});
  EXPECT_EQ(root->invalidations, 0);
}

TEST_F(NodeDrawTest, RepeatedInvalidationsBetweenPaintsTravelUpOnce) {
  auto parent = View("parent", root.get(), {100, 50, 200, 200});
  auto child = View("child", parent.get(), {10, 10, 40, 40});
  const auto invalidateChild = [&](const RectT<std::int32_t>* area) {
    child->UI_Invalidate(area, InvalidateFlags{});
  };
  Paint();
  root->invalidations = 0;
  invalidateChild(nullptr);
  invalidateChild(nullptr);
  const RectT<std::int32_t> part{0, 0, 10, 10};
  invalidateChild(&part);  // inside what is already asked for
  EXPECT_EQ(root->invalidations, 1);

  child->UI_SetMatrix({5, 0, 1, 1});  // the old place is pending already; the new one is not
  EXPECT_EQ(root->invalidations, 2);
  invalidateChild(nullptr);
  EXPECT_EQ(root->invalidations, 2);

  Paint();  // a new generation: the same request travels again
  invalidateChild(nullptr);
  EXPECT_EQ(root->invalidations, 3);
  EXPECT_EQ(root->lastInvalidRect, (RectT<std::int32_t>{115, 60, 40, 40}));
}

}  // namespace
}  // namespace velkui::ui::test
