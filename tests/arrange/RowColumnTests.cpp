#include <gtest/gtest.h>

#include "ArrangeTestSupport.h"

namespace velkui::arrange::test {
namespace {

using Type = GroupArrangementType;

TEST(RowTest, MinimumAndBestSizesIncludeSpacingAndMargins) {
  Box a(10, 20);
  Box b(30, 5);
  b.WithMinWidth(12);
  TestGroup row(Type::Row);
  row.SetHorizontalSpacing(4);
  row.SetLeftMargin(1);
  row.SetRightMargin(2);
  row.SetTopMargin(3);
  row.SetBottomMargin(5);
  row.Hold({&a, &b});
  const impl::ArrangementSet& set = row.Arrangements();
  ASSERT_EQ(set.Size(), 1u);
  EXPECT_FLOAT_EQ(set[0]->MinWidth(), 10 + 12 + 4 + 3);
  EXPECT_FLOAT_EQ(set[0]->MinHeight(), 20 + 8);
  EXPECT_FLOAT_EQ(set[0]->BestWidth(), 10 + 30 + 4 + 3);
  EXPECT_FLOAT_EQ(set[0]->BestHeight(), 28);
}

TEST(RowTest, AlignmentPlacesTheRunAndEachChildAcross) {
  const struct {
    AlignmentHorizontal horizontal;
    AlignmentVertical vertical;
    float spacing;
    RectF area, a, b;
  } cases[] = {
      // Run of 10 + 10 + 20 = 40 centred in 100.
      {AlignmentHorizontal::Center,
       AlignmentVertical::Center,
       10,
       {100, 200, 100, 50},
       {130, 220, 10, 10},
       {150, 210, 20, 30}},
      {AlignmentHorizontal::Right,
       AlignmentVertical::Bottom,
       0,
       {0, 0, 100, 50},
       {70, 40, 10, 10},
       {80, 20, 20, 30}},
  };
  for (const auto& c : cases) {
    Held row(Type::Row, {{10, 10}, {20, 30}});
    row.group.SetHorizontalAlignment(c.horizontal);
    row.group.SetVerticalAlignment(c.vertical);
    row.group.SetHorizontalSpacing(c.spacing);
    row.group.Arrange(c.area);
    EXPECT_EQ(row[0].Last(), c.a);
    EXPECT_EQ(row[1].Last(), c.b);
  }
}

TEST(RowTest, ExtraWidthIsSharedInProportionAndACappedChildPassesItOn) {
  for (const bool capped : {false, true}) {
    Box a(10, 10);
    Box b(30, 10);
    a.Grows(true).CappedAt(capped ? 15 : 1000);
    b.Grows(true);
    TestGroup row(Type::Row);
    row.Hold({&a, &b});
    row.Arrange({0, 0, 80, 10});
    // 40 extra: 20 and 60; capped at 15, the first leaves the pool and the second takes 65 in
    // the same round.
    const float first = capped ? 15 : 20;
    EXPECT_EQ(a.Last(), (RectF{0, 0, first, 10}));
    EXPECT_EQ(b.Last(), (RectF{first, 0, 80 - first, 10}));
  }
}

TEST(RowTest, ExtraWidthNeverGoesToChildrenThatCannotGrow) {
  Box fixed(10, 10);
  Box grows(30, 10);
  grows.Grows(true);
  TestGroup row(Type::Row);
  row.Hold({&fixed, &grows});
  row.Arrange({0, 0, 100, 10});
  EXPECT_EQ(fixed.Last(), (RectF{0, 0, 10, 10}));
  EXPECT_EQ(grows.Last(), (RectF{10, 0, 90, 10}));
}

TEST(RowTest, ZeroWidthExpandableChildrenGetNothingAndNoNaN) {
  Box a(0, 10);
  Box b(0, 10);
  a.Grows(true);
  b.Grows(true);
  TestGroup row(Type::Row);
  row.Hold({&a, &b});
  row.Arrange({0, 0, 50, 10});
  ASSERT_FALSE(a.places.empty());
  EXPECT_FALSE(HasNaN(a.Last()));
  EXPECT_FALSE(HasNaN(b.Last()));
  EXPECT_EQ(a.Last().width, 0);
}

TEST(RowTest, RunThatFitsItsMinimumNeverOverflowsEvenWhenBestIsWider) {
  // Natural widths 60 + 60 but minimum 20 + 20: offered 70, the row fits its minimum and
  // must stay inside, whether or not the children can grow.
  for (const bool grows : {false, true}) {
    Box a(60, 10);
    Box b(60, 10);
    a.WithMinWidth(20).Grows(grows);
    b.WithMinWidth(20).Grows(grows);
    TestGroup row(Type::Row);
    row.SetHorizontalSpacing(5);
    row.Hold({&a, &b});
    row.Arrange({0, 0, 70, 10});
    EXPECT_LE(b.Last().left + b.Last().width, 70.0001f) << grows;
    EXPECT_GE(a.Last().width, 20) << grows;
    EXPECT_GE(b.Last().width, 20) << grows;
    EXPECT_FLOAT_EQ(a.Last().width + b.Last().width + 5, 70) << grows;
  }
}

TEST(RowTest, NestedGroupWithMarginsDoesNotOverlapItsNextSibling) {
  Held nested(Type::Row, {{20, 10}});
  nested.group.SetLeftMargin(5);
  nested.group.SetRightMargin(5);
  Box after(10, 10);
  TestGroup outer(Type::Row);
  outer.Hold({&nested.group, &after});
  outer.Arrange({0, 0, 200, 10});
  EXPECT_EQ(nested[0].Last(), (RectF{5, 0, 20, 10}));
  EXPECT_EQ(after.Last(), (RectF{30, 0, 10, 10}));
  // The nested group reports the rectangle it was given and the size it used.
  EXPECT_EQ(nested.group.position, (PointF{0, 0}));
  EXPECT_EQ(nested.group.dimensions, (PointF{30, 10}));
}

TEST(RowTest, SeparatorsCoverEachGapAlongTheShorterNeighbour) {
  Held row(Type::Row, {{10, 30}, {10, 10}, {10, 20}}, true);
  TestGroup& group = row.group;
  group.SetHorizontalSpacing(4);
  group.SetVerticalAlignment(AlignmentVertical::Center);
  group.Arrange({0, 0, 100, 30});
  ASSERT_EQ(group.built.size(), 2u);
  EXPECT_FALSE(group.built[0]->across);
  EXPECT_EQ(group.built[0]->frame, (RectF{10, 10, 4, 10}));
  EXPECT_EQ(group.built[1]->frame, (RectF{24, 10, 4, 10}));
  // Rebuilding with the same number of children keeps the separators.
  group.Invalidate();
  EXPECT_EQ(group.clearCalls, 1);
}

TEST(ColumnTest, MirrorsTheRowOnTheOtherAxis) {
  Box a(10, 10);
  Box b(20, 30);
  b.Grows(false, true);
  TestGroup column(Type::Column, true);
  column.SetVerticalSpacing(5);
  column.SetHorizontalAlignment(AlignmentHorizontal::Center);
  column.Hold({&a, &b});
  const auto& set = column.Arrangements();
  ASSERT_EQ(set.Size(), 1u);
  EXPECT_FLOAT_EQ(set[0]->MinWidth(), 20);
  EXPECT_FLOAT_EQ(set[0]->MinHeight(), 45);
  column.Arrange({0, 0, 40, 100});
  EXPECT_EQ(a.Last(), (RectF{15, 0, 10, 10}));
  EXPECT_EQ(b.Last(), (RectF{10, 15, 20, 85}));
  ASSERT_EQ(column.built.size(), 1u);
  EXPECT_TRUE(column.built[0]->across);
  EXPECT_EQ(column.built[0]->frame, (RectF{15, 10, 10, 5}));
}

TEST(FlippingTest, PicksTheRowWhenWideAndTheColumnWhenTall) {
  Held flipping(Type::Flipping, {{30, 10}, {30, 10}});
  EXPECT_EQ(flipping.group.Arrangements().Size(), 2u);
  flipping.group.Arrange({0, 0, 100, 10});
  EXPECT_EQ(flipping[1].Last(), (RectF{30, 0, 30, 10}));
  flipping.group.Arrange({0, 0, 30, 100});
  EXPECT_EQ(flipping[1].Last(), (RectF{0, 10, 30, 10}));
}

}  // namespace
}  // namespace velkui::arrange::test
