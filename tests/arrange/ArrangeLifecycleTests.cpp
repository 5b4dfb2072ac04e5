#include <gtest/gtest.h>

#include "ArrangeTestSupport.h"

namespace velkui::arrange::test {
namespace {

using Type = GroupArrangementType;

// A row holding a leaf and then a row holding another leaf.
struct NestedRows {
  NestedRows() { outer.Hold({&a, &inner.group}); }
  Held inner{Type::Row, {{10, 10}}};
  Box a{10, 10};
  TestGroup outer{Type::Row};
};

// An empty rectangle leaves everything as it was; a non-finite one is refused.
TEST(ArrangeTest, EmptyOrNonFiniteRectangles) {
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a});
  EXPECT_CONTRACT_VIOLATION(row.Arrange({0, 0, std::numeric_limits<float>::infinity(), 10}));
  EXPECT_CONTRACT_VIOLATION(row.Arrange({std::nanf(""), 0, 10, 10}));
  EXPECT_TRUE(a.places.empty());
  row.Arrange({0, 0, 50, 50});
  ASSERT_EQ(a.places.size(), 1u);
  row.Arrange({5, 5, 0, 50});
  row.Arrange({5, 5, 50, -1});
  EXPECT_EQ(a.places.size(), 1u);
  EXPECT_EQ(row.LastRectangle(), (RectF{0, 0, 50, 50}));
}

TEST(ArrangeTest, ArrangingAChildArrangesTheWholeTreeFromItsRoot) {
  NestedRows tree;
  Box &a = tree.a, &b = tree.inner[0];
  TestGroup& outer = tree.outer;
  b.Arrange({0, 0, 100, 10});
  EXPECT_EQ(a.Last(), (RectF{0, 0, 10, 10}));
  EXPECT_EQ(b.Last(), (RectF{10, 0, 10, 10}));
  EXPECT_EQ(outer.LastRectangle(), (RectF{0, 0, 100, 10}));
}

TEST(ArrangeTest, DisabledRootKeepsTheRectangleAndArrangesOnceWhenEnabled) {
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a});
  a.EnableArrangement(false);
  EXPECT_FALSE(row.ArrangementEnabled());
  row.Arrange({0, 0, 50, 50});
  EXPECT_TRUE(a.places.empty());
  row.EnableArrangement(true);
  ASSERT_EQ(a.places.size(), 1u);
  EXPECT_EQ(a.Last(), (RectF{0, 0, 10, 10}));
}

TEST(InvalidateTest, BurstOfInvalidationsInsideOneCallArrangesOnce) {
  NestedRows tree;
  Box& a = tree.a;
  TestGroup& outer = tree.outer;
  outer.Arrange({0, 0, 100, 10});
  a.places.clear();
  outer.InvalidateAll();
  EXPECT_EQ(a.places.size(), 1u);
  EXPECT_TRUE(a.IsValid());
  EXPECT_TRUE(outer.IsValid());
}

TEST(InvalidateTest, InvalidationWhileTheHostDisabledArrangementDoesNotEnableIt) {
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a});
  row.Arrange({0, 0, 100, 10});
  row.EnableArrangement(false);
  a.places.clear();
  a.Resize(20, 10);
  a.Invalidate();
  EXPECT_FALSE(row.ArrangementEnabled());
  EXPECT_TRUE(a.places.empty());
  row.EnableArrangement(true);
  ASSERT_EQ(a.places.size(), 1u);
  EXPECT_EQ(a.Last().width, 20);
}

TEST(InvalidateTest, NestedInvalidationDoesNotArrangeWithAStaleSet) {
  // A leaf whose measurement invalidates another leaf (as a host may do while answering):
  // the nested call must not re-arrange from inside, and the outer one arranges once.
  Held held(Type::Row, {{10, 10}, {10, 10}});
  Box &a = held[0], &b = held[1];
  held.group.Arrange({0, 0, 100, 10});
  a.places.clear();
  a.onPlace = [&](Box& self, const RectF&) {
    if (self.places.size() == 1) {
      b.Resize(25, 10);
      b.Invalidate();  // during the arrangement: another pass instead of re-entering
    }
  };
  a.Invalidate();
  // First pass placed b at its old width; the second pass used the new one.
  EXPECT_EQ(a.places.size(), 2u);
  EXPECT_EQ(b.Last(), (RectF{10, 0, 25, 10}));
}

TEST(InvalidateTest, ArrangementThatKeepsInvalidatingStopsAfterFivePasses) {
  Box a(10, 10);
  TestGroup row(Type::Row);
  row.Hold({&a});
  int depth = 0;
  int deepest = 0;
  a.onPlace = [&](Box& self, const RectF&) {
    ++depth;
    deepest = std::max(deepest, depth);
    self.Invalidate();
    self.Rearrange();
    --depth;
  };
  row.Arrange({0, 0, 50, 50});
  EXPECT_EQ(a.places.size(), 5u);
  EXPECT_EQ(deepest, 1);  // never re-entered
}

TEST(InvalidateTest, RearrangeFromPlaceWithANewRectangleRunsAnotherPass) {
  Box a(10, 10);
  a.Grows(true);
  TestGroup row(Type::Row);
  row.Hold({&a});
  bool asked = false;
  a.onPlace = [&](Box& self, const RectF&) {
    if (!asked) {
      asked = true;
      self.Arrange({0, 0, 70, 10});
    }
  };
  row.Arrange({0, 0, 50, 10});
  ASSERT_EQ(a.places.size(), 2u);
  EXPECT_EQ(a.Last().width, 70);
  EXPECT_EQ(row.LastRectangle(), (RectF{0, 0, 70, 10}));
}

TEST(TreeLifetimeTest, DestroyedChildIsForgottenByItsGroup) {
  Box a(10, 10);
  TestGroup row(Type::Row);
  {
    Box gone(10, 10);
    row.Hold({&gone, &a});
    row.Arrange({0, 0, 100, 10});
    EXPECT_EQ(a.Last().left, 10);
  }
  EXPECT_EQ(row.Children().size(), 1u);
  row.Rearrange();
  EXPECT_EQ(a.Last().left, 0);
}

TEST(TreeLifetimeTest, DestroyedGroupReleasesItsChildren) {
  Box a(10, 10);
  {
    TestGroup row(Type::Row);
    row.Hold({&a});
    row.Arrange({0, 0, 100, 10});
    EXPECT_EQ(a.Parent(), &row);
  }
  EXPECT_EQ(a.Parent(), nullptr);
  a.Invalidate();  // must not touch the destroyed group
  EXPECT_TRUE(a.ArrangementEnabled());
}

TEST(TreeLifetimeTest, CyclesAreRejected) {
  TestGroup outer(Type::Row);
  TestGroup inner(Type::Row);
  outer.Hold({&inner});
  EXPECT_CONTRACT_VIOLATION(inner.Hold({&outer}));
  EXPECT_CONTRACT_VIOLATION(outer.Hold({&outer}));
  EXPECT_CONTRACT_VIOLATION(outer.Hold({nullptr}));
  EXPECT_EQ(outer.Parent(), nullptr);
}

TEST(LeafContractTest, NonFiniteOrNegativeSizesAreRejected) {
  Box nan(std::nanf(""), 10);
  Box negative(-5, 10);
  TestGroup row(Type::Row);
  row.Hold({&nan});
  EXPECT_CONTRACT_VIOLATION(row.Arrange({0, 0, 10, 10}));
  TestGroup other(Type::Row);
  other.Hold({&negative});
  EXPECT_CONTRACT_VIOLATION(other.BestSize());
  EXPECT_TRUE(nan.places.empty());
  EXPECT_TRUE(negative.places.empty());
}

TEST(LeafContractTest, RectangleSmallerThanTheMarginsPlacesAnEmptyLeaf) {
  Box a(0, 0);
  a.WithMargin(10).Grows(true, true);
  TestGroup row(Type::Row);
  row.Hold({&a});
  row.Arrange({0, 0, 5, 5});
  ASSERT_EQ(a.places.size(), 1u);
  EXPECT_EQ(a.Last().width, 0);
  EXPECT_EQ(a.Last().height, 0);
}

TEST(GroupParametersTest, SettersArrangeAgainAndRejectBadValues) {
  Held held(Type::Row, {{10, 10}, {10, 10}});
  Box& b = held[1];
  TestGroup& row = held.group;
  row.Arrange({0, 0, 100, 10});
  row.SetHorizontalSpacing(7);
  EXPECT_EQ(b.Last().left, 17);
  row.SetHorizontalAlignment(AlignmentHorizontal::Right);
  EXPECT_EQ(b.Last().left, 90);
  EXPECT_CONTRACT_VIOLATION(row.SetLeftMargin(std::numeric_limits<float>::infinity()));
  EXPECT_CONTRACT_VIOLATION(row.SetVerticalAlignment(static_cast<AlignmentVertical>(3)));
  EXPECT_EQ(row.VerticalAlignment(), AlignmentVertical::Top);
}

TEST(DynamicGroupTest, ChangingTheTypeRebuildsTheCandidates) {
  Box a(10, 10);
  Box b(10, 10);
  TestGroup group(Type::Row);
  group.Hold({&a, &b});
  group.Arrange({0, 0, 100, 100});
  EXPECT_EQ(b.Last(), (RectF{10, 0, 10, 10}));
  group.SetArrangementType(Type::Column, nullptr);
  EXPECT_EQ(b.Last(), (RectF{0, 10, 10, 10}));
  EXPECT_CONTRACT_VIOLATION(group.SetArrangementType(static_cast<Type>(6), nullptr));
  EXPECT_CONTRACT_VIOLATION(TestGroup bad(static_cast<Type>(-1)));
}

// What a host may do from inside Place: drop the candidates being placed, or the separators.
TEST(TreeLifetimeTest, HostMayChangeTheGroupWhileItIsBeingPlaced) {
  Box a(10, 10);
  Box b(10, 10);
  Box c(10, 10);
  TestGroup group(Type::HorizontalWrapping, true);
  group.Hold({&a, &b, &c});
  int calls = 0;
  a.onPlace = [&](Box&, const RectF&) {
    // Destroys the separators the lines being placed hold, then the candidates themselves.
    if (++calls == 1) group.BuildSeparators();
    if (calls == 2) group.SetArrangementType(Type::Column, nullptr);
  };
  group.Arrange({0, 0, 25, 25});
  EXPECT_EQ(c.Last(), (RectF{0, 20, 10, 10}));
  ASSERT_EQ(group.built.size(), 2u);
  EXPECT_EQ(group.built[1]->frame, (RectF{0, 20, 10, 0}));
}

}  // namespace
}  // namespace velkui::arrange::test
