#include <gtest/gtest.h>

#include <velkui/arrange/ISeparator.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/ui/UI_ArrangementView.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

using arrange::AlignmentHorizontal;
using arrange::AlignmentVertical;
using arrange::GroupArrangementType;
using ui::UI_ArrangementView;

// A separator node that records the frames it is given.
class SeparatorNode : public ui::UI_SubView, public arrange::ISeparator {
 public:
  void SetSeparatorFrame(bool acrossColumn, const RectT<float>& frame) override {
    across = acrossColumn;
    UI_SetLocalRectF(frame);
  }
  bool across = false;
};

class SeparatedView : public UI_ArrangementView {
 public:
  using UI_ArrangementView::UI_ArrangementView;
  int made = 0;

 protected:
  ui::NodeP NewSeparatorNode() override {
    ++made;
    return velkcore::MakeIntrusive<SeparatorNode>();
  }
};

// The view at (10, 20) in the panel: its origin is (40, 60) in global coordinates.
using ArrangementViewTest = ArrangementPanelTest;

TEST_F(ArrangementViewTest, ChildrenArePlacedInTheirParentsCoordinates) {
  auto view = MakeView(GroupArrangementType::Row);
  view->SetHorizontalSpacing(5);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  auto b = AddFixed(view.get(), {0, 0, 30, 40});
  Attach(view);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 50, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 55, 0, 30, 40);
  EXPECT_RECT(view->LastRectangle(), 40, 60, 200, 100);

  view->SetHorizontalAlignment(AlignmentHorizontal::Center);
  view->SetVerticalAlignment(AlignmentVertical::Bottom);
  view->SetLeftMargin(10);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 62.5f, 80, 50, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 117.5f, 60, 30, 40);
}

TEST_F(ArrangementViewTest, ATreeThatMovedDoesNotDriftWhenRearranged) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  Attach(view);
  // Moving the panel changes the view's global origin but arranges nothing...
  panel->UI_SetLocalRectF({130, 90, 300, 200});
  // ...and a later invalidation re-arranges at the rectangle last given.
  auto b = AddFixed(view.get(), {0, 0, 30, 40});
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 50, 20);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 50, 0, 30, 40);
  view->UI_SetLocalRectF({10, 20, 220, 100});
  EXPECT_RECT(view->LastRectangle(), 140, 110, 220, 100);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 50, 0, 30, 40);
}

TEST_F(ArrangementViewTest, NestedViewsTakeTheOriginAndSizeTheEngineGivesThem) {
  auto outer = MakeView(GroupArrangementType::Column);
  outer->SetVerticalSpacing(6);
  outer->SetLeftMargin(3);
  outer->SetTopMargin(3);
  auto leaf = AddFixed(outer.get(), {0, 0, 100, 20});
  auto nested = MakeView(GroupArrangementType::Row, {70, 70, 5, 5});
  nested->SetHorizontalSpacing(4);
  auto n1 = AddFixed(nested.get(), {0, 0, 30, 10});
  auto n2 = AddFixed(nested.get(), {0, 0, 40, 10});
  outer->ChildPushBack(nested);
  EXPECT_FALSE(nested->IsRootArrangement());
  Attach(outer);

  EXPECT_RECT(leaf->UI_GetLocalRectF(true), 3, 3, 100, 20);
  EXPECT_RECT(nested->UI_GetLocalRectF(true), 3, 29, 74, 10);
  EXPECT_RECT(n1->UI_GetLocalRectF(true), 0, 0, 30, 10);
  EXPECT_RECT(n2->UI_GetLocalRectF(true), 34, 0, 40, 10);
  // Arranged again (and again): the nested view's origin is set, not moved further.
  outer->UI_SetLocalRectF({10, 20, 210, 100});
  outer->UI_SetLocalRectF({10, 20, 200, 100});
  EXPECT_RECT(nested->UI_GetLocalRectF(true), 3, 29, 74, 10);
  EXPECT_RECT(n2->UI_GetLocalRectF(true), 34, 0, 40, 10);
}

TEST_F(ArrangementViewTest, ANestedViewThatLeavesBecomesARootOfItsOwn) {
  auto outer = MakeView(GroupArrangementType::Column);
  auto nested = MakeView(GroupArrangementType::Row, {0, 0, 120, 30});
  nested->SetLeftMargin(7);
  auto n1 = AddFixed(nested.get(), {0, 0, 30, 10});
  outer->ChildPushBack(nested);
  Attach(outer);
  EXPECT_RECT(nested->UI_GetLocalRectF(true), 0, 0, 37, 10);

  outer->ChildRemove(nested.get());
  EXPECT_TRUE(nested->IsRootArrangement());
  nested->UI_SetLocalRectF({5, 5, 120, 30});
  panel->ChildPushBack(nested);
  EXPECT_RECT(n1->UI_GetLocalRectF(true), 7, 0, 30, 10);
  EXPECT_RECT(nested->LastRectangle(), 35, 45, 120, 30);
}

TEST_F(ArrangementViewTest, AFlippingViewReflowsWhenResized) {
  auto view = MakeView(GroupArrangementType::Flipping, {0, 0, 300, 50});
  std::vector<boost::intrusive_ptr<FixedView>> boxes;
  for (int i = 0; i < 3; ++i) boxes.push_back(AddFixed(view.get(), {0, 0, 60, 20}));
  Attach(view);
  EXPECT_RECT(boxes[2]->UI_GetLocalRectF(true), 120, 0, 60, 20);
  view->UI_SetLocalRectF({0, 0, 100, 200});
  EXPECT_RECT(boxes[2]->UI_GetLocalRectF(true), 0, 40, 60, 20);
  view->SetArrangementType(GroupArrangementType::Row);
  EXPECT_RECT(boxes[2]->UI_GetLocalRectF(true), 120, 0, 60, 20);
}

TEST_F(ArrangementViewTest, OnlyAnAttachedShownRootArranges) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddFixed(view.get(), {5, 5, 50, 20});
  auto b = AddFixed(view.get(), {5, 5, 30, 20});
  view->UI_SetLocalRectF({10, 20, 150, 100});
  EXPECT_RECT(b->UI_GetLocalRectF(true), 5, 5, 30, 20);  // no parent node yet

  view->UI_Show(false);
  Attach(view);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 5, 5, 30, 20);  // hidden
  view->UI_Show(true);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 50, 0, 30, 20);
}

TEST_F(ArrangementViewTest, ChildrenAddedRemovedOrReorderedAreArrangedAgain) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  auto b = AddFixed(view.get(), {0, 0, 30, 20});
  Attach(view);
  auto c = AddFixed(view.get(), {0, 0, 10, 20});
  EXPECT_RECT(c->UI_GetLocalRectF(true), 80, 0, 10, 20);
  view->ChildRemove(b.get());
  EXPECT_RECT(c->UI_GetLocalRectF(true), 50, 0, 10, 20);
  view->ChildMove(1, 0);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 0, 0, 10, 20);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 10, 0, 50, 20);
  view->DeleteChildren();
  EXPECT_TRUE(view->Children().empty());
}

TEST_F(ArrangementViewTest, BindingsMakeChildrenExpandableAndTheirNaturalSizeStays) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  a->UI_SetLayoutBinding(ui::kBindRightToRight | ui::kBindBottomToBottom);
  auto b = AddFixed(view.get(), {0, 0, 30, 20});
  Attach(view);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 170, 100);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 170, 0, 30, 20);
  // Shrinking shows that the stretched size was not taken for the natural one.
  view->UI_SetLocalRectF({10, 20, 150, 60});
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 120, 60);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 120, 0, 30, 20);
  // A binding changed later is noticed too.
  b->UI_SetLayoutBinding(ui::kBindBottomToBottom);
  view->UpdateChildSizes();
  EXPECT_RECT(b->UI_GetLocalRectF(true), 120, 0, 30, 60);
}

TEST_F(ArrangementViewTest, AChildRemovingItselfWhilePlacedIsSafe) {
  auto view = MakeView(GroupArrangementType::Row);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  auto b = AddFixed(view.get(), {0, 0, 30, 20});
  auto c = AddFixed(view.get(), {0, 0, 10, 20});
  Attach(view);
  struct Leaver : FixedView {
    using FixedView::FixedView;
    void UI_SizeChanged(const RectT<float>&) override {
      if (auto* parent = UI_GetParentContainer()) parent->ChildRemove(this);
    }
  };
  auto leaver = velkcore::MakeIntrusive<Leaver>(RectT<float>{3, 3, 5, 5});
  view->ChildInsert(0, leaver);
  EXPECT_EQ(leaver->UI_GetParentContainer(), nullptr);
  EXPECT_RECT(a->UI_GetLocalRectF(true), 0, 0, 50, 20);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 80, 0, 10, 20);
}

TEST_F(ArrangementViewTest, SeparatorsFillTheGapsInTheViewsCoordinates) {
  auto view = MakeView<SeparatedView>(GroupArrangementType::Row);
  view->SetHorizontalSpacing(6);
  auto a = AddFixed(view.get(), {0, 0, 50, 20});
  auto b = AddFixed(view.get(), {0, 0, 30, 40});
  auto c = AddFixed(view.get(), {0, 0, 30, 10});
  Attach(view);
  // Without separators no divider node exists.
  EXPECT_FALSE(view->HasSeparators());
  EXPECT_EQ(view->made, 0);
  EXPECT_EQ(view->ChildSize(), 3u);
  EXPECT_EQ(view->GetSeparatorNodeCount(), 0u);
  view->EnableSeparators(true);
  ASSERT_EQ(view->GetSeparatorNodeCount(), 2u);
  ASSERT_EQ(view->ChildSize(), 5u);
  auto* first = dynamic_cast<SeparatorNode*>(view->ChildGet(3).get());
  auto* second = dynamic_cast<SeparatorNode*>(view->ChildGet(4).get());
  ASSERT_NE(first, nullptr);
  ASSERT_NE(second, nullptr);
  EXPECT_FALSE(first->across);
  EXPECT_RECT(first->UI_GetLocalRectF(true), 50, 0, 6, 20);
  EXPECT_RECT(second->UI_GetLocalRectF(true), 86, 0, 6, 10);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 92, 0, 30, 10);

  // One more child, one more gap.
  AddFixed(view.get(), {0, 0, 5, 5});
  EXPECT_EQ(view->GetSeparatorNodeCount(), 3u);
  EXPECT_EQ(view->ChildSize(), 7u);

  // A separator taken away by someone else is made again.
  view->ChildRemove(view->ChildGet(view->ChildSize() - 1).get());
  EXPECT_EQ(view->GetSeparatorNodeCount(), 3u);
  EXPECT_EQ(view->ChildSize(), 7u);

  view->EnableSeparators(false);
  EXPECT_EQ(view->GetSeparatorNodeCount(), 0u);
  EXPECT_EQ(view->ChildSize(), 4u);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 92, 0, 30, 10);
}

TEST_F(ArrangementViewTest, DeletingAllChildrenLeavesNoSeparatorBehind) {
  for (const bool arranged : {true, false}) {
    auto view = MakeView<SeparatedView>(GroupArrangementType::Row);
    view->EnableSeparators(true);
    for (int i = 0; i < 3; ++i) AddFixed(view.get(), {0, 0, 10, 10});
    if (arranged) Attach(view);
    view->BuildSeparators();
    ASSERT_EQ(view->ChildSize(), 5u);
    view->DeleteChildren();
    EXPECT_EQ(view->ChildSize(), 0u) << (arranged ? "arranged" : "never arranged");
    EXPECT_EQ(view->GetSeparatorNodeCount(), 0u);
  }
}

TEST_F(ArrangementViewTest, SeparatorsOfAColumnLieAcross) {
  auto view = MakeView<SeparatedView>(GroupArrangementType::Column);
  view->SetVerticalSpacing(2);
  view->EnableSeparators(true);
  AddFixed(view.get(), {0, 0, 50, 20});
  AddFixed(view.get(), {0, 0, 30, 20});
  Attach(view);
  ASSERT_EQ(view->GetSeparatorNodeCount(), 1u);
  auto* separator = dynamic_cast<SeparatorNode*>(view->ChildGet(2).get());
  ASSERT_NE(separator, nullptr);
  EXPECT_TRUE(separator->across);
  EXPECT_RECT(separator->UI_GetLocalRectF(true), 0, 20, 30, 2);
}

TEST_F(ArrangementViewTest, SeparatorsAreDividersByDefault) {
  auto view = MakeView(GroupArrangementType::Row);
  view->SetHorizontalSpacing(4);
  view->EnableSeparators(true);
  EXPECT_TRUE(view->HasSeparators());
  AddFixed(view.get(), {0, 0, 50, 20});
  AddFixed(view.get(), {0, 0, 30, 20});
  Attach(view);
  ASSERT_EQ(view->ChildSize(), 3u);
  auto* divider = dynamic_cast<controls::UI_Divider*>(view->ChildGet(2).get());
  ASSERT_NE(divider, nullptr);
  EXPECT_TRUE(divider->UI_IsShown());
  EXPECT_TRUE(divider->IsVertical());
  EXPECT_RECT(divider->UI_GetLocalRectF(true), 50, 0, 4, 20);
}

TEST_F(ArrangementViewTest, ASeparatorNodeMustBeASeparator) {
  struct Wrong : UI_ArrangementView {
    using UI_ArrangementView::UI_ArrangementView;
    ui::NodeP NewSeparatorNode() override {
      return velkcore::MakeIntrusive<FixedView>(RectT<float>{});
    }
  };
  auto view = MakeView<Wrong>(GroupArrangementType::Row);
  AddFixed(view.get(), {0, 0, 50, 20});
  AddFixed(view.get(), {0, 0, 30, 20});
  EXPECT_CONTRACT_VIOLATION(view->EnableSeparators(true));
}

}  // namespace
}  // namespace velkui::layout::test
