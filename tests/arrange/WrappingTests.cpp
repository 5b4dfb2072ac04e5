#include <gtest/gtest.h>

#include "ArrangeTestSupport.h"

namespace velkui::arrange::test {
namespace {

using Type = GroupArrangementType;

const std::vector<PointF> kThreeSquares = {{10, 10}, {10, 10}, {10, 10}};

TEST(HorizontalWrappingTest, TwoPerLineWhenOnlyTwoFitSideBySide) {
  Held wrap(Type::HorizontalWrapping, kThreeSquares);
  // 25 x 25: one per line is too tall, three per line too wide.
  wrap.group.Arrange({0, 0, 25, 25});
  EXPECT_EQ(wrap[0].Last(), (RectF{0, 0, 10, 10}));
  EXPECT_EQ(wrap[1].Last(), (RectF{10, 0, 10, 10}));
  EXPECT_EQ(wrap[2].Last(), (RectF{0, 10, 10, 10}));
}

TEST(HorizontalWrappingTest, WithoutAFittingCandidateTakesTheLeastOverflow) {
  Held wrap(Type::HorizontalWrapping, kThreeSquares);
  const struct {
    RectF area;
    RectF last;
  } cases[] = {
      // Overflow areas 150 (one per line), 100 (two per line), 150 (three per line).
      {{0, 0, 15, 15}, {0, 10, 10, 10}},
      // 50 (one per line), 80, 180.
      {{0, 0, 12, 25}, {0, 20, 10, 10}},
      // One line of three fits.
      {{0, 0, 100, 12}, {20, 0, 10, 10}},
  };
  for (const auto& c : cases) {
    wrap.group.Arrange(c.area);
    EXPECT_EQ(wrap[2].Last(), c.last) << c.area.width << "x" << c.area.height;
  }
}

TEST(HorizontalWrappingTest, SeparatorsBetweenLinesRunAcrossTheColumn) {
  Held wrap(Type::HorizontalWrapping, kThreeSquares, true);
  wrap.group.SetHorizontalSpacing(2);
  wrap.group.SetVerticalSpacing(3);
  wrap.group.Arrange({0, 0, 25, 25});
  const auto& built = wrap.group.built;
  ASSERT_EQ(built.size(), 2u);
  // a|b in the first line, then the line break before c.
  EXPECT_FALSE(built[0]->across);
  EXPECT_EQ(built[0]->frame, (RectF{10, 0, 2, 10}));
  EXPECT_TRUE(built[1]->across);
  EXPECT_EQ(built[1]->frame.top, 10);
  EXPECT_EQ(built[1]->frame.height, 3);
}

TEST(VerticalWrappingTest, FillsColumnsFirst) {
  Held wrap(Type::VerticalWrapping, kThreeSquares);
  wrap.group.Arrange({0, 0, 25, 25});
  EXPECT_EQ(wrap[1].Last(), (RectF{0, 10, 10, 10}));
  EXPECT_EQ(wrap[2].Last(), (RectF{10, 0, 10, 10}));
}

TEST(AutoLayoutTest, HoldsBothWrappingsCandidates) {
  Held autoLayout(Type::AutoLayout, {{10, 20}, {10, 20}, {10, 20}});
  // Horizontal wrapping gives 10x60, 20x40, 30x20; vertical wrapping gives 30x20 (replacing the
  // equal one), 20x40 again, 10x60 again: three distinct sizes survive.
  EXPECT_EQ(autoLayout.group.Arrangements().Size(), 3u);
  autoLayout.group.Arrange({0, 0, 21, 45});
  // Only 20x40 fits, and it is the vertical wrapping's (two per column).
  EXPECT_EQ(autoLayout[1].Last(), (RectF{0, 20, 10, 20}));
  EXPECT_EQ(autoLayout[2].Last(), (RectF{10, 0, 10, 20}));
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
  Held nested(Type::Row, {{0, 0}});
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a, &nested.group});
  row.Arrange({0, 0, 50, 10});
  ASSERT_EQ(nested[0].places.size(), 1u);
  EXPECT_EQ(nested[0].Last(), (RectF{10, 0, 0, 0}));
}

}  // namespace
}  // namespace velkui::arrange::test
