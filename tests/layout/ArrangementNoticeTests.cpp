// Arrangement views hear of their children's changes as they happen (UI_Container's
// ChildGeometryChanged) and arrange again at once, without ever re-entering an arrangement.

#include <algorithm>
#include <cmath>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/ui/UI_ArrangementView.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

using arrange::GroupArrangementType;

// Placements of the counting views below, and how deeply they were nested: a placement that
// starts while another is still running means an arrangement re-entered itself.
struct PlacementLog {
  int depth = 0;
  int maxDepth = 0;
};

// A child that counts the frames it is given through the virtual setter (which is how a view
// places it). Changes it makes itself go through UI_SubView's setter directly, uncounted.
class CountingView : public FixedView {
 public:
  CountingView(PlacementLog& log, const RectT<float>& frame) : FixedView(frame), log_(log) {}

  void UI_SetLocalRectF(const RectT<float>& rect) override {
    ++placements;
    ++log_.depth;
    log_.maxDepth = std::max(log_.maxDepth, log_.depth);
    FixedView::UI_SetLocalRectF(rect);
    --log_.depth;
  }

  // Resizes without counting, as a control that changes its own size would.
  void ResizeSelf(float width, float height) {
    const RectT<float> frame = UI_GetLocalRectF(true);
    ui::UI_SubView::UI_SetLocalRectF({frame.left, frame.top, width, height});
  }

  int placements = 0;

 private:
  PlacementLog& log_;
};

// A text-like child: as wide as it is given, and as tall as its 240 pixels of "text" need at
// that width, in lines of 16. It adjusts its height whenever its width changes.
class WrappingText : public CountingView {
 public:
  WrappingText(PlacementLog& log, const RectT<float>& frame) : CountingView(log, frame) {
    UI_SetLayoutBinding(ui::kBindRightToRight);
  }

  void UI_SizeChanged(const RectT<float>& r) override {
    FixedView::UI_SizeChanged(r);
    const float wanted = 16.0f * std::ceil(240.0f / std::max(r.width, 1.0f));
    if (r.height != wanted) ResizeSelf(r.width, wanted);
  }
};

// A child that grows by one pixel each time it is placed, so that it never settles.
class RestlessView : public CountingView {
 public:
  using CountingView::CountingView;

  void UI_SetLocalRectF(const RectT<float>& rect) override {
    CountingView::UI_SetLocalRectF(rect);
    ResizeSelf(rect.width, rect.height + 1);
  }
};

// A parent that records which children it heard of.
class NoticeRecorder : public ui::UI_SubView {
 public:
  void ChildGeometryChanged(const ui::UI_Node& child) override {
    ui::UI_SubView::ChildGeometryChanged(child);
    notices.push_back(&child);
  }
  std::vector<const ui::UI_Node*> notices;
};

class ArrangementNoticeTest : public ArrangementPanelTest {
 protected:
  template <typename Child = CountingView>
  boost::intrusive_ptr<Child> AddCounting(ui::UI_Node& parent, const RectT<float>& frame) {
    auto child = velkcore::MakeIntrusive<Child>(log, frame);
    parent.ChildPushBack(child);
    return child;
  }

  PlacementLog log;
};

TEST_F(ArrangementNoticeTest, EveryFrameVisibilityAndMatrixChangeReachesTheParent) {
  auto parent = velkcore::MakeIntrusive<NoticeRecorder>();
  auto child = AddFixed(parent.get(), {0, 0, 50, 20});
  ASSERT_TRUE(parent->notices.empty());

  child->UI_SetLocalRectF({5, 0, 50, 20});
  child->UI_SetLocalRectF({5, 0, 50, 20});  // no change, no notice
  child->UI_Show(false);
  child->UI_Show(true);
  child->UI_SetMatrix({0, 0, 2, 2});
  EXPECT_EQ(parent->notices, std::vector<const ui::UI_Node*>(4, child.get()));

  // The notice goes to the parent of the moment only.
  parent->ChildRemove(child.get());
  child->UI_SetLocalRectF({0, 0, 10, 10});
  EXPECT_EQ(parent->notices.size(), 4u);
}

TEST_F(ArrangementNoticeTest, AChildThatGrowsShrinksOrHidesIsArrangedAgainAtOnce) {
  auto view = MakeView(GroupArrangementType::Row);
  view->SetHorizontalSpacing(5);
  auto a = AddCounting(*view, {0, 0, 50, 20});
  auto b = AddCounting(*view, {0, 0, 30, 20});
  auto c = AddCounting(*view, {0, 0, 10, 20});
  Attach(view);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 90, 0, 10, 20);
  c->placements = 0;

  a->ResizeSelf(80, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 85, 0, 30, 20);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 120, 0, 10, 20);
  EXPECT_EQ(c->placements, 1);  // one pass, not one per notice

  a->ResizeSelf(20, 20);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 60, 0, 10, 20);

  b->UI_Show(false);
  // A hidden child takes no room (the spacing on each side of it stays) and keeps its frame.
  EXPECT_RECT(c->UI_GetLocalRectF(true), 30, 0, 10, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 25, 0, 30, 20);
  b->UI_Show(true);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 60, 0, 10, 20);
  // Moving a child changes nothing it needs: nothing is arranged.
  a->UI_SetLocalRectF({40, 40, 20, 20});
  EXPECT_RECT(a->UI_GetLocalRectF(true), 40, 40, 20, 20);
  EXPECT_EQ(c->placements, 4);
  EXPECT_EQ(log.maxDepth, 1);
}

TEST_F(ArrangementNoticeTest, FramesTheViewGivesAreNoChange) {
  auto outer = MakeView(GroupArrangementType::Column);
  outer->EnableSeparators(true);
  auto stretched = velkcore::MakeIntrusive<CountingView>(log, RectT<float>{0, 0, 50, 20});
  stretched->UI_SetLayoutBinding(ui::kBindRightToRight);
  outer->ChildPushBack(stretched);
  auto nested = MakeView(GroupArrangementType::Row, {0, 0, 5, 5});
  auto inner = AddCounting(*nested, {0, 0, 30, 10});
  outer->ChildPushBack(nested);
  Attach(outer);
  // Stretching a child, sizing the nested view and its separator: one pass each time.
  EXPECT_RECT(stretched->UI_GetLocalRectF(true), 0, 0, 200, 20);
  EXPECT_EQ(stretched->placements, 1);
  EXPECT_EQ(inner->placements, 1);
  outer->UI_SetLocalRectF({10, 20, 150, 100});
  EXPECT_EQ(stretched->placements, 2);
  EXPECT_EQ(inner->placements, 2);
}

TEST_F(ArrangementNoticeTest, ALeafOfANestedViewThatGrowsMovesTheOuterSiblings) {
  auto outer = MakeView(GroupArrangementType::Column);
  outer->SetVerticalSpacing(4);
  auto nested = MakeView(GroupArrangementType::Row, {0, 0, 5, 5});
  auto inner = AddCounting(*nested, {0, 0, 30, 10});
  outer->ChildPushBack(nested);
  auto below = AddCounting(*outer, {0, 0, 50, 10});
  Attach(outer);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 14, 50, 10);

  inner->ResizeSelf(30, 25);
  EXPECT_RECT(nested->UI_GetLocalRectF(true), 0, 0, 30, 25);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 29, 50, 10);
  EXPECT_EQ(log.maxDepth, 1);
}

TEST_F(ArrangementNoticeTest, AChildThatResizesItselfWhenPlacedConverges) {
  auto view = MakeView(GroupArrangementType::Column);
  view->SetVerticalSpacing(4);
  auto text = AddCounting<WrappingText>(*view, {0, 0, 60, 64});
  auto below = AddCounting(*view, {0, 0, 50, 10});
  Attach(view);
  // Given 200 pixels the text needs two lines; one more pass places what follows it.
  EXPECT_RECT(text->UI_GetLocalRectF(true), 0, 0, 200, 32);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 36, 50, 10);
  EXPECT_EQ(below->placements, 2);

  view->UI_SetLocalRectF({10, 20, 100, 100});
  EXPECT_RECT(text->UI_GetLocalRectF(true), 0, 0, 100, 48);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 52, 50, 10);
  EXPECT_EQ(below->placements, 4);

  view->UI_SetLocalRectF({10, 20, 300, 100});
  EXPECT_RECT(text->UI_GetLocalRectF(true), 0, 0, 300, 16);
  // The height the text chose is its natural height now, but the stretched width never became
  // its natural width: narrowing the view narrows it again.
  view->UI_SetLocalRectF({10, 20, 150, 100});
  EXPECT_RECT(text->UI_GetLocalRectF(true), 0, 0, 150, 32);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 36, 50, 10);
  EXPECT_EQ(log.maxDepth, 1);
}

TEST_F(ArrangementNoticeTest, AChildThatNeverSettlesEndsTheArrangementAfterItsLastPass) {
  auto view = MakeView(GroupArrangementType::Column);
  auto restless = AddCounting<RestlessView>(*view, {0, 0, 50, 10});
  auto below = AddCounting(*view, {0, 0, 50, 10});
  Attach(view);
  EXPECT_EQ(below->placements, 5);
  EXPECT_EQ(log.maxDepth, 1);
  EXPECT_EQ(restless->UI_GetLocalRectF(true).height, 15);
}

TEST_F(ArrangementNoticeTest, ABindingChangeTakesEffectAtOnce) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = velkcore::MakeIntrusive<FixedView>(RectT<float>{0, 0, 50, 20});
  view->ChildPushBack(a);
  auto b = AddFixed(view.get(), {0, 0, 30, 20});
  Attach(view);
  a->UI_SetLayoutBinding(ui::kBindRightToRight | ui::kBindBottomToBottom);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 170, 100);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 170, 0, 30, 20);
  // Back to its natural size, not to the stretched one.
  a->UI_SetLayoutBinding(ui::LayoutBinding{});
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 50, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 50, 0, 30, 20);
}

TEST_F(ArrangementNoticeTest, AHiddenOrDetachedViewArrangesWhenItCanAgain) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddCounting(*view, {0, 0, 50, 20});
  auto b = AddCounting(*view, {0, 0, 30, 20});
  Attach(view);
  b->placements = 0;

  view->UI_Show(false);
  a->ResizeSelf(70, 20);
  EXPECT_EQ(b->placements, 0);
  view->UI_Show(true);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 70, 0, 30, 20);

  panel->ChildRemove(view.get());
  a->ResizeSelf(40, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 70, 0, 30, 20);
  Attach(view);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 40, 0, 30, 20);
}

}  // namespace
}  // namespace velkui::layout::test
