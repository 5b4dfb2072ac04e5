#include <stdexcept>

#include <gtest/gtest.h>

#include <cmath>

#include <velkcore/Error.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/ui/UI_SubView.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

using velkui::test::ErrorOf;
using velkui::test::RaisesContractViolation;

using NodeTreeTest = NodeTest<UI_NodeManager>;

void ExpectIndicesMatchPositions(const UI_Container& container) {
  for (std::size_t i = 0; i < container.ChildSize(); ++i) {
    EXPECT_EQ(container.ChildGet(i)->UI_GetIndex(), static_cast<std::int32_t>(i));
    EXPECT_EQ(container.ChildGet(i)->UI_GetParentContainer(), &container);
  }
}

TEST_F(NodeTreeTest, IndicesFollowEveryInsertRemoveMoveAndSwap) {
  auto root = View("root");
  auto a = View("a", root.get());
  auto b = View("b", root.get());
  auto c = View("c", root.get());
  ExpectIndicesMatchPositions(*root);

  auto d = View("d");
  root->ChildInsert(1, d);
  EXPECT_EQ(root->ChildGet(1), d);
  ExpectIndicesMatchPositions(*root);

  root->ChildMove(0, 3);  // a to the top
  EXPECT_EQ(root->ChildGet(3), a);
  ExpectIndicesMatchPositions(*root);
  root->ChildMove(3, 0);
  EXPECT_EQ(root->ChildGet(0), a);
  ExpectIndicesMatchPositions(*root);

  const auto removed = root->ChildRemove(root->ChildBegin() + 1);
  EXPECT_EQ(removed, d);
  EXPECT_EQ(d->UI_GetIndex(), -1);
  EXPECT_EQ(d->UI_GetParentContainer(), nullptr);
  ExpectIndicesMatchPositions(*root);

  root->ChildSwapOrder(0, 2);  // a b c -> c b a
  EXPECT_EQ(root->ChildGet(0), c);
  EXPECT_EQ(root->ChildGet(2), a);
  ExpectIndicesMatchPositions(*root);
  EXPECT_EQ(root->ChildFind(b.get()) - root->ChildBegin(), 1);
}

TEST_F(NodeTreeTest, AddingANodeElsewhereDetachesItFromItsOldParentFirst) {
  auto first = View("first");
  auto second = View("second");
  auto child = View("child", first.get());
  View("sibling", first.get());

  second->ChildPushBack(child);
  EXPECT_EQ(first->ChildSize(), 1u);
  EXPECT_EQ(first->ChildFind(child.get()), first->ChildEnd());
  EXPECT_EQ(child->UI_GetParentNode(), second.get());
  ExpectIndicesMatchPositions(*first);
  ExpectIndicesMatchPositions(*second);

  // Re-adding within the same parent moves it, never duplicates it.
  auto other = View("other", second.get());
  second->ChildInsert(2, child);
  ASSERT_EQ(second->ChildSize(), 2u);
  EXPECT_EQ(second->ChildGet(0), other);
  EXPECT_EQ(second->ChildGet(1), child);
  second->ChildPushBack(other);
  EXPECT_EQ(second->ChildGet(1), other);
  ExpectIndicesMatchPositions(*second);
}

TEST_F(NodeTreeTest, AddingANodeToItselfOrBelowItselfIsRejected) {
  auto root = View("root");
  auto child = View("child", root.get());
  auto grandChild = View("grandChild", child.get());
  EXPECT_TRUE(RaisesContractViolation([&] { root->ChildPushBack(root); }));
  EXPECT_TRUE(RaisesContractViolation([&] { grandChild->ChildPushBack(root); }));
  EXPECT_TRUE(RaisesContractViolation([&] { child->ChildInsert(0, root); }));
  EXPECT_TRUE(RaisesContractViolation([&] { root->ChildPushBack(nullptr); }));
  EXPECT_TRUE(RaisesContractViolation([&] { root->ChildInsert(5, View("late")); }));
  EXPECT_EQ(child->UI_GetParentNode(), root.get());
  EXPECT_EQ(root->UI_GetParentContainer(), nullptr);
}

TEST_F(NodeTreeTest, RemovalKeepsTheChildAliveAndRequestRemoveRefusesStrangers) {
  auto root = View("root");
  UI_Node* raw = nullptr;
  {
    auto child = View("child", root.get());
    raw = child.get();
  }
  EXPECT_EQ(raw->GetRefCount(), 1);  // only the parent holds it
  const NodeP removed = root->ChildRemove(raw);
  EXPECT_EQ(removed.get(), raw);
  EXPECT_EQ(removed->GetRefCount(), 1);
  EXPECT_EQ(removed->UI_GetIndex(), -1);
  EXPECT_EQ(removed->UI_GetParentNode(), nullptr);

  EXPECT_FALSE(root->ChildRequestRemove(removed.get()));
  EXPECT_EQ(root->ChildSize(), 0u);
  EXPECT_TRUE(RaisesContractViolation([&] { root->ChildRemove(removed.get()); }));
}

TEST_F(NodeTreeTest, ABareContainerIsNoParentNodeAndReleasesItsChildren) {
  auto child = View("child");
  {
    UI_Container container;
    EXPECT_FALSE(container.IsANode());
    EXPECT_EQ(container.GetAsANode(), nullptr);
    container.ChildPushBack(child);
    EXPECT_EQ(child->UI_GetParentContainer(), &container);
    EXPECT_EQ(child->UI_GetParentNode(), nullptr);
    EXPECT_EQ(child->UI_GetRootContainer(), &container);
  }
  EXPECT_EQ(child->UI_GetParentContainer(), nullptr);
  EXPECT_EQ(child->UI_GetIndex(), -1);
}

TEST_F(NodeTreeTest, ChildLookupByIdMatchesDirectChildrenOnly) {
  auto root = View("root");
  auto a = View("x", root.get());
  auto b = View("x", root.get());
  View("deep", b.get());
  EXPECT_EQ(root->UI_ChildGetFromID("x"), a.get());
  EXPECT_EQ(root->UI_ChildGetFromID("deep"), nullptr);
  EXPECT_EQ(root->UI_ChildFindFromID("X"), root->ChildEnd());
}

TEST_F(NodeTreeTest, ANewSubViewNeedsBothShowingAndAPositiveSize) {
  auto root = View("root", nullptr, {0, 0, 100, 100});
  auto child = velkcore::MakeIntrusive<LoggingView>("child", log);
  root->ChildPushBack(child);
  EXPECT_FALSE(child->UI_IsShown());

  PointT<float> p{5, 5};
  child->UI_Show(true);
  EXPECT_FALSE(child->UI_IsShown());
  EXPECT_FALSE(root->GetChildHit(false, false, &p).first);

  child->UI_Show(false);
  child->UI_SetLocalRectF({0, 0, 10, 10});
  EXPECT_FALSE(child->UI_IsShown());
  EXPECT_FALSE(root->GetChildHit(false, false, &p).first);

  child->UI_Show(true);
  EXPECT_TRUE(child->UI_IsShown());
  EXPECT_TRUE(root->GetChildHit(false, false, &p).first);
}

TEST_F(NodeTreeTest, SettingTheSameFrameTwiceNotifiesOnce) {
  auto root = View("root", nullptr, {0, 0, 100, 100});
  auto child = View("child", root.get(), {0, 0, 10, 10});
  child->sizeChanges = 0;
  child->invalidations = 0;
  log->clear();
  child->UI_SetLocalRectF({5, 5, 20, 20});
  child->UI_SetLocalRectF({5, 5, 20, 20});
  child->UI_SetLocalRect(RectT<std::int32_t>{5, 5, 20, 20});
  EXPECT_EQ(child->sizeChanges, 1);
  EXPECT_EQ(child->invalidations, 2);  // the old area and the new one
  EXPECT_EQ(*log, EventLog{"child:change1"});
}

TEST_F(NodeTreeTest, DisablingPropagatesThroughTheParentBitAndStopsAtSelfDisabledNodes) {
  auto root = View("root");
  auto middle = View("middle", root.get());
  auto leaf = View("leaf", middle.get());
  auto selfDisabled = View("selfDisabled", root.get());
  auto below = View("below", selfDisabled.get());
  selfDisabled->UI_SetDisabled(true);
  EXPECT_TRUE(below->UI_GetStateFlags().IsSet(kStateParentDisabled));

  root->UI_SetDisabled(true);
  EXPECT_TRUE(middle->UI_GetStateFlags().IsSet(kStateParentDisabled));
  EXPECT_TRUE(leaf->UI_IsDisabled());
  EXPECT_EQ(leaf->disabledChanges, 1);
  EXPECT_EQ(below->disabledChanges, 1);  // already disabled through its parent

  root->UI_SetEnabled(true);
  EXPECT_TRUE(leaf->UI_IsEnabled());
  EXPECT_TRUE(selfDisabled->UI_IsDisabled());
  EXPECT_FALSE(selfDisabled->UI_GetStateFlags().IsSet(kStateParentDisabled));
  EXPECT_TRUE(below->UI_IsDisabled());

  // A node moved under a disabled parent takes its state.
  root->UI_SetDisabled(true);
  auto newcomer = View("newcomer");
  middle->ChildPushBack(newcomer);
  EXPECT_TRUE(newcomer->UI_IsDisabled());
  middle->ChildRemove(newcomer.get());
  EXPECT_TRUE(newcomer->UI_IsEnabled());
}

TEST_F(NodeTreeTest, NodeChangesReachTheSubtreeDepthFirstInZOrder) {
  auto root = View("root");
  auto a = View("a", root.get());
  View("a1", a.get());
  View("b", root.get());
  log->clear();
  root->UI_DispatchNodeChange(NodeChange::kShownChanged);
  EXPECT_EQ(*log, (EventLog{"root:change3", "a:change3", "a1:change3", "b:change3"}));

  auto other = View("other");
  log->clear();
  other->ChildPushBack(a);
  EXPECT_EQ(*log, (EventLog{"a:change0", "a1:change0", "a:change0", "a1:change0"}));
}

// ---- Layout of children ----

class LayoutTest : public NodeTreeTest {
 protected:
  LoggingViewP parent = MakeView(nullptr, {0, 0, 100, 100}, "parent", log);
  LoggingViewP Bound(std::uint8_t binding, RectT<float> frame) {
    auto child = View("child", parent.get(), frame);
    child->UI_SetLayoutBinding(binding);
    return child;
  }
};

TEST_F(LayoutTest, BindingsStretchMoveOrCentreChildren) {
  parent->UI_SetLayoutsChildren(true);
  parent->UI_SetLocalRectF({0, 0, 100, 100});  // unchanged: not a sizing
  auto stretch = Bound(kBindRightToRight, {10, 10, 30, 30});
  auto move = Bound(kBindLeftToRight | kBindRightToRight, {10, 10, 30, 30});
  auto leftEdge = Bound(kBindLeftToRight | kBindBottomToBottom, {10, 10, 30, 30});
  auto centred = Bound(kBindCenterHorizontally | kBindCenterVertically, {10, 10, 30, 30});
  auto fixed = Bound(0, {10, 10, 30, 30});

  parent->UI_SetLocalRectF({0, 0, 150, 120});
  EXPECT_EQ(stretch->UI_GetLocalRectF(true), (RectT<float>{10, 10, 80, 30}));
  EXPECT_EQ(move->UI_GetLocalRectF(true), (RectT<float>{60, 10, 30, 30}));
  EXPECT_EQ(leftEdge->UI_GetLocalRectF(true), (RectT<float>{60, 10, -20, 50}));
  EXPECT_EQ(centred->UI_GetLocalRectF(true), (RectT<float>{60, 45, 30, 30}));
  EXPECT_EQ(fixed->UI_GetLocalRectF(true), (RectT<float>{10, 10, 30, 30}));
}

TEST_F(LayoutTest, AFrameSetByAHandlerDuringASizeChangeLaysChildrenOutOnce) {
  // A view that keeps its width a multiple of 40, correcting itself from its own handler.
  struct Snapping : UI_SubView {
    void UI_SizeChanged(const RectT<float>& frame) override {
      ++sizeChanges;
      const float snapped = std::ceil(frame.width / 40) * 40;
      if (snapped != frame.width) UI_SetLocalRectF({frame.left, frame.top, snapped, frame.height});
    }
    int sizeChanges = 0;
  };
  auto view = velkcore::MakeIntrusive<Snapping>();
  view->UI_SetLocalRectF({0, 0, 80, 40});
  view->UI_SetLayoutsChildren(true);
  auto right = velkcore::MakeIntrusive<UI_SubView>();
  right->UI_SetLocalRectF({50, 0, 20, 20});
  right->UI_SetLayoutBinding(kBindLeftToRight | kBindRightToRight);
  auto centred = velkcore::MakeIntrusive<UI_SubView>();
  centred->UI_SetLocalRectF({30, 0, 20, 20});
  centred->UI_SetLayoutBinding(kBindCenterHorizontally);
  view->ChildPushBack(right);
  view->ChildPushBack(centred);

  view->UI_SetLocalRectF({0, 0, 90, 40});  // snaps to 120
  EXPECT_EQ(view->UI_GetLocalRectF(true).width, 120.0f);
  EXPECT_EQ(right->UI_GetLocalRectF(true), (RectT<float>{90, 0, 20, 20}));
  EXPECT_EQ(centred->UI_GetLocalRectF(true), (RectT<float>{50, 0, 20, 20}));
}

TEST_F(LayoutTest, TheFirstRealSizingMovesNoChild) {
  auto fresh = View("fresh", nullptr, {0, 0, 0, 0});
  fresh->UI_SetLayoutsChildren(true);
  auto child = View("child", fresh.get(), {10, 10, 30, 30});
  child->UI_SetLayoutBinding(kBindLeftToRight | kBindRightToRight);
  fresh->UI_SetLocalRectF({0, 0, 0, 50});  // still empty: not the first sizing
  fresh->UI_SetLocalRectF({0, 0, 200, 50});
  EXPECT_EQ(child->UI_GetLocalRectF(true), (RectT<float>{10, 10, 30, 30}));
  fresh->UI_SetLocalRectF({0, 0, 220, 50});
  EXPECT_EQ(child->UI_GetLocalRectF(true), (RectT<float>{30, 10, 30, 30}));
}

TEST_F(LayoutTest, ResizesCascadeIntoGrandChildren) {
  parent->UI_SetLayoutsChildren(true);
  auto child = Bound(kBindRightToRight, {0, 0, 50, 50});
  child->UI_SetLayoutsChildren(true);
  child->UI_SetLocalRectF({0, 0, 50, 50});
  auto grandChild = View("grandChild", child.get(), {40, 0, 10, 10});
  grandChild->UI_SetLayoutBinding(kBindLeftToRight | kBindRightToRight);
  parent->UI_SetLocalRectF({0, 0, 110, 100});
  EXPECT_EQ(grandChild->UI_GetLocalRectF(true), (RectT<float>{50, 0, 10, 10}));
}

// ---- Geometry ----

TEST_F(NodeTreeTest, SelfToParentMatrixAppliesOwnThenParentForChildrenMatrix) {
  auto root = View("root", nullptr, {0, 0, 500, 500});
  auto parent = View("parent", root.get(), {10, 20, 200, 200});
  auto child = View("child", parent.get(), {5, 5, 10, 10});
  child->UI_SetMatrix({1, 2, 2, 3});
  EXPECT_EQ(child->UI_GetSelfToParentMatrix(), (ScaleMatrixT<float>{11, 17, 2, 3}));
  child->UI_SetMatrixOnlyForChildren(true);
  EXPECT_EQ(child->UI_GetSelfToParentMatrix(), (ScaleMatrixT<float>{5, 5, 1, 1}));

  parent->UI_SetMatrix({100, 0, 2, 2});
  parent->UI_SetMatrixOnlyForChildren(true);
  EXPECT_EQ(parent->UI_GetSelfToParentMatrix(), (ScaleMatrixT<float>{10, 20, 1, 1}));
  EXPECT_EQ(child->UI_GetSelfToParentMatrix(), (ScaleMatrixT<float>{110, 10, 2, 2}));
  EXPECT_EQ(child->UI_GetSelfToRootMatrix(), (ScaleMatrixT<float>{120, 30, 2, 2}));
  EXPECT_EQ(child->UI_LocalToGlobalF(PointT<float>{1, 1}), (PointT<float>{122, 32}));
}

TEST_F(NodeTreeTest, GlobalToLocalUndoesLocalToGlobal) {
  auto root = View("root", nullptr, {0, 0, 500, 500});
  auto parent = View("parent", root.get(), {7.5f, 3, 200, 200});
  parent->UI_SetMatrix({-4, 9, -0.5f, 3});
  auto child = View("child", parent.get(), {1.25f, -6, 10, 10});
  child->UI_SetMatrix({2, 2, 0.25f, -2});
  for (const PointT<float> p : {PointT<float>{0, 0}, {3.5f, -7}, {123, 456}}) {
    const PointT<float> back = child->UI_GlobalToLocalF(child->UI_LocalToGlobalF(p));
    EXPECT_NEAR(back.x, p.x, 1e-3f);
    EXPECT_NEAR(back.y, p.y, 1e-3f);
  }
  // Rectangles are rounded outwards, also through a mirroring scale.
  const RectT<std::int32_t> global = parent->UI_LocalToGlobal(RectT<std::int32_t>{0, 0, 3, 2});
  EXPECT_EQ(global, (RectT<std::int32_t>{-10, 18, 3, 6}));
}

TEST_F(NodeTreeTest, AConversionToAnAncestorOutsideTheTreeRaisesParentNotFound) {
  auto root = View("root");
  auto child = View("child", root.get(), {3, 4, 10, 10});
  auto stranger = View("stranger");
  EXPECT_EQ(child->UI_GetSelfToSpecificParentMatrix(root.get()), (ScaleMatrixT<float>{3, 4, 1, 1}));
  EXPECT_EQ(child->UI_GetSelfToSpecificParentMatrix(child.get()), ScaleMatrixT<float>{});
  const auto error = ErrorOf([&] { child->UI_GetSelfToSpecificParentMatrix(stranger.get()); });
  ASSERT_TRUE(error.has_value());
  EXPECT_EQ(error->GetCategory(), 103);
  EXPECT_EQ(error->GetNumber(), 7);
  EXPECT_EQ(error->GetKey(), "$$$/velkui/ui/Error/ParentNotFound=Parent not found.");
  child->UI_SetMatrix({0, 0, 0, 1});
  EXPECT_THROW(child->UI_GlobalToLocalF(PointT<float>{1, 1}), velkcore::Exception);
}

TEST_F(NodeTreeTest, HitTestingUsesTheChildsOwnCoordinatesAndTheTopMostChild) {
  auto root = View("root", nullptr, {0, 0, 500, 500});
  auto below = View("below", root.get(), {100, 100, 50, 50});
  auto above = View("above", root.get(), {120, 120, 50, 50});
  auto scaled = View("scaled", root.get(), {300, 300, 10, 10});
  scaled->UI_SetMatrix({0, 0, 2, 2});  // covers 600..620 in the root

  PointT<float> p{110, 110};
  auto [found, position] = root->GetChildHit(false, false, &p);
  ASSERT_TRUE(found);
  EXPECT_EQ(position->get(), below.get());
  EXPECT_EQ(p, (PointT<float>{10, 10}));

  p = {130, 130};
  std::tie(found, position) = root->GetChildHit(false, false, &p);
  ASSERT_TRUE(found);
  EXPECT_EQ(position->get(), above.get());

  p = {610, 610};
  std::tie(found, position) = root->GetChildHit(false, false, &p);
  ASSERT_TRUE(found);
  EXPECT_EQ(position->get(), scaled.get());
  EXPECT_EQ(p, (PointT<float>{5, 5}));

  // A recursive hit finds the deepest node, in its own coordinates.
  auto inner = View("inner", below.get(), {5, 5, 10, 10});
  p = {110, 110};
  std::tie(found, position) = root->GetChildHit(true, false, &p);
  ASSERT_TRUE(found);
  EXPECT_EQ(position->get(), inner.get());
  EXPECT_EQ(p, (PointT<float>{5, 5}));

  // A degenerate scale is skipped, not an error.
  scaled->UI_SetMatrix({0, 0, 0, 2});
  p = {300, 610};
  EXPECT_NO_THROW(std::tie(found, position) = root->GetChildHit(false, false, &p));
  EXPECT_FALSE(found);
}

class SometimesShownView : public LoggingView {
 public:
  using LoggingView::LoggingView;
  bool visible = true;
  bool UI_IsShown() const override { return visible && LoggingView::UI_IsShown(); }
  void SetVisible(bool v) {
    visible = v;
    UI_GeometryChanged();
  }
};

TEST_F(NodeTreeTest, HitTestingFollowsEveryChangeOfPlaceSizeOrderAndVisibility) {
  auto root = View("root", nullptr, {0, 0, 500, 500});
  auto a = View("a", root.get(), {0, 0, 50, 50});
  auto b = View("b", root.get(), {100, 0, 50, 50});
  const auto hitAt = [&](float x, float y) -> std::string {
    PointT<float> p{x, y};
    const auto [found, position] = root->GetChildHit(true, false, &p);
    return found ? (*position)->UI_GetNodeID() : "none";
  };
  EXPECT_EQ(hitAt(10, 10), "a");
  a->UI_SetLocalRectF({200, 200, 50, 50});
  EXPECT_EQ(hitAt(10, 10), "none");
  EXPECT_EQ(hitAt(210, 210), "a");
  b->UI_SetLocalRectF({190, 190, 50, 50});
  EXPECT_EQ(hitAt(210, 210), "b");
  root->ChildSwapOrder(0, 1);
  EXPECT_EQ(hitAt(210, 210), "a");
  a->UI_Show(false);
  EXPECT_EQ(hitAt(210, 210), "b");
  a->UI_Show(true);
  b->UI_SetMatrix({0, 0, 0.5f, 0.5f});  // now 95..120
  EXPECT_EQ(hitAt(100, 100), "b");
  EXPECT_EQ(hitAt(150, 150), "none");
  root->UI_SetMatrix({10, 10, 1, 1});
  root->UI_SetMatrixOnlyForChildren(true);  // every child moves by 10, 10
  EXPECT_EQ(hitAt(100, 100), "none");
  EXPECT_EQ(hitAt(115, 115), "b");
  root->ChildRemove(b.get());
  EXPECT_EQ(hitAt(115, 115), "none");

  auto custom = MakeView<SometimesShownView>(root.get(), {0, 0, 20, 20}, "custom", log);
  EXPECT_EQ(hitAt(15, 25), "custom");  // 10..30 through the root's matrix
  custom->SetVisible(false);
  EXPECT_EQ(hitAt(15, 25), "none");
  auto inner = View("inner", custom.get(), {0, 0, 5, 5});
  custom->SetVisible(true);
  EXPECT_EQ(hitAt(12, 12), "inner");
}

// ---- Layout bridge ----

TEST_F(NodeTreeTest, PlacementSetsTheFrameWithOutsetsAndIsAnsweredBack) {
  auto node = View("node", nullptr, {1.5f, 2.25f, 10.5f, 20});
  const orvant::place_data_t& before = node->get_placement();
  EXPECT_EQ(before.horizontal_m.position_m, 1);
  EXPECT_EQ(before.horizontal_m.length_m, 11);
  EXPECT_EQ(before.vertical_m.position_m, 2);
  EXPECT_EQ(before.vertical_m.length_m, 21);

  orvant::place_data_t placement;
  placement.horizontal_m = {10, 100, 2, 3};
  placement.vertical_m = {20, 50, 1, 4};
  node->place(placement);
  EXPECT_EQ(node->UI_GetLocalRectF(true), (RectT<float>{8, 19, 105, 55}));
  EXPECT_EQ(node->get_placement(), placement);

  orvant::extents_t extents;
  try {
    node->measure(extents);
    FAIL() << "no error raised";
  } catch (const std::logic_error& e) {
    EXPECT_STREQ(e.what(), "You must override UI_Node::measure");
  }
  EXPECT_THROW(node->measure_vertical(extents, placement), std::logic_error);
}

}  // namespace
}  // namespace velkui::ui::test
