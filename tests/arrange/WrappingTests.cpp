#include <gtest/gtest.h>

#include "ArrangeTestSupport.h"

namespace velkui::arrange::test {
namespace {

using Type = GroupArrangementType;

TEST(HorizontalWrappingTest, TwoPerLineWhenOnlyTwoFitSideBySide) {
  Box a(10, 10);
  Box b(10, 10);
  Box c(10, 10);
  TestGroup wrap(Type::HorizontalWrapping);
  wrap.Hold({&a, &b, &c});
  // 25 x 25: one per line is too tall, three per line too wide.
  wrap.Arrange({0, 0, 25, 25});
  EXPECT_EQ(a.Last(), (RectF{0, 0, 10, 10}));
  EXPECT_EQ(b.Last(), (RectF{10, 0, 10, 10}));
  EXPECT_EQ(c.Last(), (RectF{0, 10, 10, 10}));
}

TEST(HorizontalWrappingTest, WithoutAFittingCandidateTakesTheLeastOverflow) {
  Box a(10, 10);
  Box b(10, 10);
  Box c(10, 10);
  TestGroup wrap(Type::HorizontalWrapping);
  wrap.Hold({&a, &b, &c});
  // 15 x 15: overflow areas are 150 (one per line), 100 (two per line), 150 (three per line).
  wrap.Arrange({0, 0, 15, 15});
  EXPECT_EQ(c.Last(), (RectF{0, 10, 10, 10}));
  // 12 x 25: 50 (one per line), 80, 180.
  wrap.Arrange({0, 0, 12, 25});
  EXPECT_EQ(c.Last(), (RectF{0, 20, 10, 10}));
  // 100 x 12: one line of three fits.
  wrap.Arrange({0, 0, 100, 12});
  EXPECT_EQ(c.Last(), (RectF{20, 0, 10, 10}));
}

TEST(HorizontalWrappingTest, SeparatorsBetweenLinesRunAcrossTheColumn) {
  Box a(10, 10);
  Box b(10, 10);
  Box c(10, 10);
  TestGroup wrap(Type::HorizontalWrapping, true);
  wrap.SetHorizontalSpacing(2);
  wrap.SetVerticalSpacing(3);
  wrap.Hold({&a, &b, &c});
  wrap.Arrange({0, 0, 25, 25});
  ASSERT_EQ(wrap.built.size(), 2u);
  // a|b in the first line, then the line break before c.
  EXPECT_FALSE(wrap.built[0]->across);
  EXPECT_EQ(wrap.built[0]->frame, (RectF{10, 0, 2, 10}));
  EXPECT_TRUE(wrap.built[1]->across);
  EXPECT_EQ(wrap.built[1]->frame.top, 10);
  EXPECT_EQ(wrap.built[1]->frame.height, 3);
}

TEST(VerticalWrappingTest, FillsColumnsFirst) {
  Box a(10, 10);
  Box b(10, 10);
  Box c(10, 10);
  TestGroup wrap(Type::VerticalWrapping);
  wrap.Hold({&a, &b, &c});
  wrap.Arrange({0, 0, 25, 25});
  EXPECT_EQ(b.Last(), (RectF{0, 10, 10, 10}));
  EXPECT_EQ(c.Last(), (RectF{10, 0, 10, 10}));
}

TEST(AutoLayoutTest, HoldsBothWrappingsCandidates) {
  Box a(10, 20);
  Box b(10, 20);
  Box c(10, 20);
  TestGroup autoLayout(Type::AutoLayout);
  autoLayout.Hold({&a, &b, &c});
  // Horizontal wrapping gives 10x60, 20x40, 30x20; vertical wrapping gives 30x20 (replacing the
  // equal one), 20x40 again, 10x60 again: three distinct sizes survive.
  EXPECT_EQ(autoLayout.Arrangements().Size(), 3u);
  autoLayout.Arrange({0, 0, 21, 45});
  // Only 20x40 fits, and it is the vertical wrapping's (two per column).
  EXPECT_EQ(b.Last(), (RectF{0, 20, 10, 20}));
  EXPECT_EQ(c.Last(), (RectF{10, 0, 10, 20}));
}

TEST(EmptyGroupTest, ArrangesNothingAndHasNoBestSize) {
  TestGroup empty(Type::AutoLayout, true);
  empty.SetLeftMargin(10);
  empty.Hold({});
  EXPECT_EQ(empty.BestSize(), (PointF{0, 0}));
  empty.Arrange({0, 0, 50, 50});
  EXPECT_EQ(empty.dimensions, (PointF{-1, -1}));
  EXPECT_TRUE(empty.built.empty());
}

TEST(EmptyGroupTest, IsLeftOutOfItsParentAndItsGapSeparatorCollapses) {
  Box a(10, 10);
  TestGroup empty(Type::Row);
  Box c(10, 10);
  TestGroup row(Type::Row, true);
  row.SetHorizontalSpacing(5);
  row.Hold({&a, &empty, &c});
  row.Arrange({0, 0, 100, 10});
  EXPECT_EQ(c.Last(), (RectF{15, 0, 10, 10}));
  ASSERT_EQ(row.built.size(), 2u);
  // The gap before c carries a separator, the one next to the empty group collapses.
  EXPECT_EQ(row.built[1]->frame, (RectF{10, 0, 5, 10}));
  EXPECT_EQ(row.built[0]->frame.width, 0);
}

TEST(EmptyGroupTest, NestedGroupFirstOfferedNothingStillPlacesItsChildren) {
  Box dot(0, 0);
  TestGroup nested(Type::Row);
  nested.Hold({&dot});
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a, &nested});
  row.Arrange({0, 0, 50, 10});
  ASSERT_EQ(dot.places.size(), 1u);
  EXPECT_EQ(dot.Last(), (RectF{10, 0, 0, 0}));
}

}  // namespace
}  // namespace velkui::arrange::test
