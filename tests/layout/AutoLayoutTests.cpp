#include <gtest/gtest.h>

#include <velkui/pictel/Pictel.h>
#include <velkui/test/RecordingSupplier.h>
#include <velkui/ui/AutoLayoutSubView.h>
#include <velkui/ui/UI_LayoutView.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

using ui::UI_LayoutView;

class AutoLayoutTest : public ::testing::Test {
 protected:
  AutoLayoutTest()
      : surface_(supplier_->NewSurface(1, 1, true)), context_(supplier_.get(), surface_.get()) {}

  // A layout view with layout enabled.
  static boost::intrusive_ptr<UI_LayoutView> MakeView(const RectT<float>& frame,
                                                      bool maintainMargins) {
    auto view = velkcore::MakeIntrusive<UI_LayoutView>();
    view->UI_SetLocalRectF(frame);
    view->SetLayoutEnabled(true);
    view->SetMaintainMargins(maintainMargins);
    return view;
  }

  // A horizontal view 200 × 50 with three 40 × 20 children 10 apart.
  boost::intrusive_ptr<UI_LayoutView> MakeRow(bool maintainMargins) {
    auto view = MakeView({5, 5, 200, 50}, maintainMargins);
    view->SetLayoutMode(UI_LayoutView::kLayoutHorizontal);
    first = AddFixed(view.get(), {10, 10, 40, 20});
    second = AddFixed(view.get(), {60, 10, 40, 20}, {60, 20});
    third = AddFixed(view.get(), {110, 10, 40, 20});
    return view;
  }

  boost::intrusive_ptr<velkui::test::RecordingSupplier> supplier_ =
      velkcore::MakeIntrusive<velkui::test::RecordingSupplier>();
  boost::intrusive_ptr<pictel::SurfaceInterface> surface_;
  pictel::Pictel context_;
  boost::intrusive_ptr<FixedView> first, second, third;
};

// The middle child asks for 60 × 20 unless told otherwise: growth moves the following
// children; with margins the view keeps them, without it fits the right-most and bottom-most
// edges; a child never shrinks below its authored size.
TEST_F(AutoLayoutTest, GrowthMovesTheFollowingChildrenAndSizesTheView) {
  const struct {
    bool maintainMargins;
    PointT<float> recommended;
    RectT<float> second, third, view;
  } cases[] = {
      {true, {60, 20}, {60, 10, 60, 20}, {130, 10, 40, 20}, {5, 5, 220, 50}},
      {false, {60, 20}, {60, 10, 60, 20}, {130, 10, 40, 20}, {5, 5, 170, 30}},
      {false, {10, 5}, {60, 10, 40, 20}, {110, 10, 40, 20}, {5, 5, 200, 50}},
      {true, {70, 5}, {60, 10, 70, 20}, {140, 10, 40, 20}, {5, 5, 230, 50}},
  };
  for (const auto& c : cases) {
    auto view = MakeRow(c.maintainMargins);
    second->SetRecommended(c.recommended);
    view->AutoLayout(&context_);
    EXPECT_RECT(first->UI_GetLocalRectF(true), 10, 10, 40, 20);
    EXPECT_SAME_RECT(second->UI_GetLocalRectF(true), c.second);
    EXPECT_SAME_RECT(third->UI_GetLocalRectF(true), c.third);
    EXPECT_SAME_RECT(view->UI_GetLocalRectF(true), c.view);
  }
}

TEST_F(AutoLayoutTest, ChildrenAreTakenInOrderOfTheirEdgeAndOriginsAreWholeNumbers) {
  auto view = MakeView({0, 0, 100, 300}, false);
  view->SetLayoutMode(7);  // vertical
  EXPECT_EQ(view->GetLayoutMode(), UI_LayoutView::kLayoutVertical);
  // Added bottom first; the upper one grows by 10.5 (rounded up to 11).
  auto lower = AddFixed(view.get(), {3.7f, 50.2f, 30, 20});
  auto upper = AddFixed(view.get(), {0, 10, 30, 20}, {25, 30.5f});
  view->AutoLayout(&context_);
  EXPECT_RECT(upper->UI_GetLocalRectF(true), 0, 10, 30, 31);
  EXPECT_RECT(lower->UI_GetLocalRectF(true), 3, 61, 30, 20);
  EXPECT_RECT(view->UI_GetLocalRectF(true), 0, 0, 33, 81);
}

TEST_F(AutoLayoutTest, ScaledChildrenShareTheLargestSizeAcross) {
  auto view = MakeRow(false);
  view->SetScaleChildren(true);
  second->SetRecommended({40, 34});
  third->UI_SetLocalRectF({110, 20, 40, 20});
  view->AutoLayout(&context_);
  EXPECT_EQ(first->UI_GetLocalRectF(true).height, 34);
  EXPECT_EQ(third->UI_GetLocalRectF(true).height, 34);
  // The view holds the scaled children as they finally are.
  EXPECT_RECT(view->UI_GetLocalRectF(true), 5, 5, 150, 54);
}

TEST_F(AutoLayoutTest, NestedViewsAreLaidOutFirst) {
  auto outer = MakeView({0, 0, 300, 100}, true);
  auto inner = MakeView({0, 0, 100, 40}, true);
  outer->ChildPushBack(inner);
  auto grower = AddFixed(inner.get(), {0, 0, 100, 40}, {100, 55});
  auto below = AddFixed(outer.get(), {0, 50, 100, 20});
  // A plain sub-view holding an auto-layout view: the view below it is laid out too.
  auto plain = AddFixed(outer.get(), {0, 80, 100, 10});
  auto deep = MakeView({0, 0, 50, 5}, true);
  plain->ChildPushBack(deep);
  auto deepChild = AddFixed(deep.get(), {0, 0, 50, 5}, {50, 9});

  outer->AutoLayout(&context_);
  EXPECT_RECT(inner->UI_GetLocalRectF(true), 0, 0, 100, 55);
  EXPECT_RECT(below->UI_GetLocalRectF(true), 0, 65, 100, 20);
  EXPECT_RECT(deep->UI_GetLocalRectF(true), 0, 0, 50, 9);
  EXPECT_RECT(plain->UI_GetLocalRectF(true), 0, 95, 100, 10);
  EXPECT_RECT(outer->UI_GetLocalRectF(true), 0, 0, 300, 115);
}

TEST_F(AutoLayoutTest, BindingsAreNotAppliedWhileLayingOut) {
  auto view = MakeRow(true);
  view->UI_SetLayoutsChildren(true);
  third->UI_SetLayoutBinding(ui::kBindLeftToRight | ui::kBindRightToRight);
  view->AutoLayout(&context_);
  EXPECT_RECT(third->UI_GetLocalRectF(true), 130, 10, 40, 20);
  EXPECT_TRUE(view->UI_GetLayoutsChildren());
}

TEST_F(AutoLayoutTest, DisabledViewsAndBadArgumentsLayNothingOut) {
  auto view = MakeRow(true);
  view->SetLayoutEnabled(false);
  view->AutoLayout(&context_);
  EXPECT_RECT(second->UI_GetLocalRectF(true), 60, 10, 40, 20);
  EXPECT_CONTRACT_VIOLATION(view->AutoLayout(nullptr));
  EXPECT_CONTRACT_VIOLATION(ui::AutoLayoutSubView(ui::SubViewP(), &context_));
}

TEST(LayoutViewTest, PropertiesAreTheLayoutFlags) {
  auto view = velkcore::MakeIntrusive<UI_LayoutView>();
  EXPECT_EQ(view->UI_GetSubViewLayoutFlags().Get(), 0);
  EXPECT_EQ(view->GetLayoutMode(), UI_LayoutView::kLayoutVertical);
  view->SetLayoutMode(0);
  view->SetScaleChildren(true);
  view->SetMaintainMargins(true);
  view->SetLayoutEnabled(true);
  EXPECT_EQ(view->UI_GetSubViewLayoutFlags().Get(), 0x0F);
  EXPECT_EQ(view->GetLayoutMode(), UI_LayoutView::kLayoutHorizontal);
  view->SetScaleChildren(false);
  view->SetLayoutMode(1);
  EXPECT_EQ(view->UI_GetSubViewLayoutFlags().Get(), 0x05);
}

}  // namespace
}  // namespace velkui::layout::test
