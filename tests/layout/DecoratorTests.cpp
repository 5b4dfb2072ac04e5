#include <gtest/gtest.h>

#include <velkui/layout/Alignments.h>
#include <velkui/layout/LayoutJoiner.h>
#include <velkui/layout/Spacers.h>
#include <velkui/layout/UI_NodeLayout.h>
#include <velkui/test/RecordingSupplier.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

const RectT<float> kArea{0, 0, 100, 40};

using SpacerP = boost::intrusive_ptr<StrategicLayoutDecorator>;

template <typename Spacer>
SpacerP Make(SmartLayoutP object, bool keeps) {
  return velkcore::MakeIntrusive<Spacer>(std::move(object), 10.0f, keeps);
}

// Keeping the extra space widens the spacer to one unit short of the object; passing it
// widens the object to one unit after the spacer. Vertical spacers leave no gap.
TEST(SpacerTest, EachSideKeepsOrPassesTheExtraSpace) {
  const RectT<float> tall{0, 0, 40, 100};
  const struct {
    const char* name;
    SpacerP (*make)(SmartLayoutP object, bool keeps);
    bool keeps;
    RectT<float> area, object, spacer;
  } cases[] = {
      {"left keeps", Make<SpacerOnTheLeft>, true, kArea, {50, 0, 50, 40}, {0, 0, 49, 40}},
      {"left passes", Make<SpacerOnTheLeft>, false, kArea, {11, 0, 89, 40}, {0, 0, 10, 40}},
      {"right keeps", Make<SpacerOnTheRight>, true, kArea, {0, 0, 50, 40}, {51, 0, 49, 40}},
      {"right passes", Make<SpacerOnTheRight>, false, kArea, {0, 0, 89, 40}, {90, 0, 10, 40}},
      {"top keeps", Make<SpacerOnTheTop>, true, tall, {0, 50, 40, 50}, {0, 0, 40, 50}},
      {"top passes", Make<SpacerOnTheTop>, false, tall, {0, 10, 40, 90}, {0, 0, 40, 10}},
      {"bottom keeps", Make<SpacerOnTheBottom>, true, tall, {0, 0, 40, 50}, {0, 50, 40, 50}},
      {"bottom passes", Make<SpacerOnTheBottom>, false, tall, {0, 0, 40, 90}, {0, 90, 40, 10}},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    const bool horizontal = c.area.width > c.area.height;
    auto object = horizontal ? Recording(50, 20) : Recording(20, 50);
    const SpacerP spacer = c.make(object, c.keeps);
    spacer->SetLocation(c.area);
    EXPECT_SAME_RECT(object->Last(), c.object);
    EXPECT_SAME_RECT(spacer->GetOwnRect(), c.spacer);
  }
}

TEST(SpacerTest, TightAndTooSmallAreas) {
  auto object = Recording(50, 20);
  auto spacer = velkcore::MakeIntrusive<SpacerOnTheLeft>(object, 10.0f, true);
  // Not wider than both: the object gets the rest, narrower than it wants.
  spacer->SetLocation({5, 5, 40, 30});
  EXPECT_RECT(spacer->GetOwnRect(), 5, 5, 10, 30);
  EXPECT_RECT(object->Last(), 15, 5, 30, 30);
  // Narrower than the spacer itself: the spacer takes it all, the object nothing.
  spacer->SetLocation({5, 5, 8, 30});
  EXPECT_RECT(spacer->GetOwnRect(), 5, 5, 8, 30);
  EXPECT_RECT(object->Last(), 0, 0, 0, 0);
}

TEST(SpacerTest, ExtraSpaceBelowTheGapNeverShrinksAnElement) {
  auto object = Recording(50, 20);
  auto spacer = velkcore::MakeIntrusive<SpacerOnTheLeft>(object, 10.0f, true);
  spacer->SetLocation({0, 0, 60.5f, 20});
  EXPECT_RECT(spacer->GetOwnRect(), 0, 0, 10, 20);
  EXPECT_RECT(object->Last(), 10.5f, 0, 50, 20);
}

TEST(SpacerTest, InitialSizesCombineAlongTheAxis) {
  auto object = Recording(50, 20);
  EXPECT_EQ(SpacerOnTheLeft(object, 10, true).GetInitialSize(), (PointT<float>{60, 20}));
  EXPECT_EQ(SpacerOnTheBottom(object, 7, false).GetInitialSize(), (PointT<float>{50, 27}));
  EXPECT_EQ(SpacerOnAllSides(object, 4).GetInitialSize(), (PointT<float>{58, 28}));
}

TEST(SpacerTest, AllSidesLeaveTheObjectTheInside) {
  auto object = Recording(20, 10);
  SpacerOnAllSides spacer(object, 5);
  spacer.SetLocation({0, 0, 100, 50});
  // The horizontal spacers keep one unit from the object on each side.
  EXPECT_RECT(object->Last(), 6, 5, 88, 40);
}

TEST(SpacerTest, BadSizesAndNullObjectsAreRefused) {
  auto object = Recording(1, 1);
  EXPECT_CONTRACT_VIOLATION(SpacerOnTheLeft(object, -1, true));
  EXPECT_CONTRACT_VIOLATION(SpacerOnTheTop(object, std::nanf(""), true));
  EXPECT_CONTRACT_VIOLATION(SpacerOnTheRight(nullptr, 1, true));
  EXPECT_CONTRACT_VIOLATION(RecordingLayout({-1, 0}));
  SpacerOnTheLeft spacer(object, 1, true);
  EXPECT_CONTRACT_VIOLATION(spacer.SetPlacementAlgorithm(nullptr));
  EXPECT_CONTRACT_VIOLATION(spacer.SetExtraSpaceAlgorithm(nullptr));
  EXPECT_CONTRACT_VIOLATION(spacer.SetLocation({0, 0, std::nanf(""), 1}));
}

TEST(PlacementTest, ANullExtraSpaceRuleIsRefused) {
  RectT<float> own{};
  RectT<float> decorated{};
  EXPECT_CONTRACT_VIOLATION(LayoutPlacement_BelowDO::GetSharedPtr()->GetRects(
      kArea, {1, 1}, {1, 1}, own, decorated, nullptr));
}

TEST(JoinerTest, PlacesBothElements) {
  auto label = Recording(30, 12);
  auto field = Recording(80, 20);
  LayoutJoiner joiner(label, field, LayoutPlacement_LeftOfDO::GetSharedPtr(),
                      ExtraSpace_Pass::GetSharedPtr());
  EXPECT_EQ(joiner.GetInitialSize(), (PointT<float>{110, 20}));
  joiner.SetLocation({10, 10, 200, 20});
  EXPECT_RECT(label->Last(), 10, 10, 30, 20);
  EXPECT_RECT(field->Last(), 41, 10, 169, 20);

  // The own element's size is read when placing, so a changed element is honoured.
  auto wider = Recording(50, 12);
  joiner.SetElement(wider);
  joiner.SetLocation({10, 10, 200, 20});
  EXPECT_RECT(wider->Last(), 10, 10, 50, 20);
  EXPECT_EQ(label->locations.size(), 1u);
}

TEST(JoinerTest, ParentAndChildShareTheRectangleInTheirOwnCoordinates) {
  auto parent = Recording(100, 10);
  auto child = Recording(40, 30);
  ParentChildLayoutJoiner joiner(parent, child);
  EXPECT_EQ(joiner.GetInitialSize(), (PointT<float>{100, 30}));
  joiner.SetLocation({20, 30, 120, 50});
  EXPECT_RECT(parent->Last(), 20, 30, 120, 50);
  EXPECT_RECT(child->Last(), 0, 0, 120, 50);
}

TEST(AlignmentTest, CentresWholeNumberedAndLeavesWiderObjectsAlone) {
  auto object = Recording(33.5f, 11);
  AlignHorizontallyCentered horizontal(object);
  horizontal.SetLocation({10, 5, 100, 40});
  EXPECT_RECT(object->Last(), 43, 5, 34, 40);
  EXPECT_EQ(horizontal.GetInitialSize(), (PointT<float>{33.5f, 11}));

  AlignVerticallyCentered vertical(object);
  vertical.SetLocation({10, 5, 100, 40});
  EXPECT_RECT(object->Last(), 10, 19, 100, 11);

  auto wide = Recording(150, 50);
  AlignHorizontallyCentered wideAlign(wide);
  wideAlign.SetLocation({10, 5, 100, 40});
  EXPECT_RECT(wide->Last(), 10, 5, 100, 40);
  AlignVerticallyCentered tallAlign(wide);
  tallAlign.SetLocation({10, 5, 100, 40});
  EXPECT_RECT(wide->Last(), 10, 5, 100, 40);
}

TEST(DecoratorTest, InsertedDecoratorGoesJustBelow) {
  auto object = Recording(50, 20);
  auto outer = velkcore::MakeIntrusive<SpacerOnTheLeft>(object, 10.0f, false);
  auto inserted = velkcore::MakeIntrusive<SpacerOnTheTop>(Recording(1, 1), 5.0f, false);
  outer->InsertLayoutDecorator(inserted);
  EXPECT_EQ(outer->GetDecoratedObject(), inserted);
  EXPECT_EQ(inserted->GetDecoratedObject(), object);
  EXPECT_EQ(outer->GetInitialSize(), (PointT<float>{60, 25}));
  outer->SetLocation({0, 0, 100, 40});
  EXPECT_RECT(object->Last(), 11, 5, 89, 35);
}

TEST(DecoratorTest, CyclesAreRefusedAndLeaveTheTreeAsItWas) {
  auto object = Recording(50, 20);
  auto inner = velkcore::MakeIntrusive<SpacerOnTheLeft>(object, 10.0f, false);
  auto outer = velkcore::MakeIntrusive<AlignHorizontallyCentered>(inner);
  EXPECT_CONTRACT_VIOLATION(inner->SetDecoratedObject(outer));
  EXPECT_CONTRACT_VIOLATION(inner->SetDecoratedObject(inner));
  EXPECT_CONTRACT_VIOLATION(outer->InsertLayoutDecorator(outer));
  EXPECT_CONTRACT_VIOLATION(outer->InsertLayoutDecorator(inner));
  EXPECT_CONTRACT_VIOLATION(inner->SetDecoratedObject(nullptr));
  EXPECT_CONTRACT_VIOLATION(outer->InsertLayoutDecorator(nullptr));

  // Through a joiner's own element too.
  auto joiner = velkcore::MakeIntrusive<LayoutJoiner>(Recording(1, 1), object,
                                                      LayoutPlacement_AboveDO::GetSharedPtr(),
                                                      ExtraSpace_Keep::GetSharedPtr());
  auto around = velkcore::MakeIntrusive<AlignVerticallyCentered>(joiner);
  EXPECT_CONTRACT_VIOLATION(joiner->SetElement(around));
  auto loop = velkcore::MakeIntrusive<LayoutJoiner>(outer, Recording(1, 1),
                                                    LayoutPlacement_AboveDO::GetSharedPtr(),
                                                    ExtraSpace_Keep::GetSharedPtr());
  EXPECT_CONTRACT_VIOLATION(inner->InsertLayoutDecorator(loop));

  EXPECT_EQ(inner->GetDecoratedObject(), object);
  EXPECT_EQ(outer->GetDecoratedObject(), inner);
  EXPECT_TRUE(outer->Contains(object.get()));
  EXPECT_FALSE(inner->Contains(outer.get()));
}

TEST(EmptyLayoutTest, IsSharedAndPlacesNothing) {
  const SmartLayoutP& empty = EmptyLayout::GetSharedPtr();
  EXPECT_EQ(empty, EmptyLayout::GetSharedPtr());
  EXPECT_EQ(empty->GetInitialSize(), (PointT<float>{0, 0}));
  auto object = Recording(20, 10);
  LayoutJoiner joiner(empty, object, LayoutPlacement_RightOfDO::GetSharedPtr(),
                      ExtraSpace_Pass::GetSharedPtr());
  joiner.SetLocation({0, 0, 50, 10});
  EXPECT_RECT(object->Last(), 0, 0, 49, 10);
}

TEST(NodeLayoutTest, SetsTheNodeFrame) {
  auto node = AddFixed(nullptr, {0, 0, 10, 10});
  auto layout = velkcore::MakeIntrusive<UI_NodeLayout>(node, PointT<float>{60, 20});
  SpacerOnAllSides margins(layout, 8);
  EXPECT_EQ(margins.GetInitialSize(), (PointT<float>{76, 36}));
  margins.SetLocation({0, 0, 76, 36});
  EXPECT_RECT(node->UI_GetLocalRectF(true), 8, 8, 60, 20);
  EXPECT_CONTRACT_VIOLATION(UI_NodeLayout(nullptr, {1, 1}));
  EXPECT_CONTRACT_VIOLATION(layout->SetNode(nullptr));
}

// What the control layouts build on: measuring a control and growing to fit it.
class MeasuredLayout : public UI_NodeLayout {
 public:
  MeasuredLayout(ui::NodeP node, PointT<float> size, const pictel::SupplierInterface* supplier)
      : UI_NodeLayout(node, size) {
    const PointT<float> recommended = MeasureRecommendedSize(*GetNode(), supplier);
    GrowInitialSizeToFit({recommended.x + 5, recommended.y});
  }
};

TEST(NodeLayoutTest, ControlLayoutsGrowToTheRecommendedSize) {
  const auto supplier = velkcore::MakeIntrusive<velkui::test::RecordingSupplier>();
  auto node = AddFixed(nullptr, {0, 0, 10, 10}, {70.2f, 18.5f});
  EXPECT_EQ(MeasuredLayout(node, {40, 22}, supplier.get()).GetInitialSize(),
            (PointT<float>{76, 22}));
  EXPECT_EQ(MeasuredLayout(node, {90, 10}, supplier.get()).GetInitialSize(),
            (PointT<float>{90, 19}));
  EXPECT_CONTRACT_VIOLATION(MeasuredLayout(node, {1, 1}, nullptr));
}

}  // namespace
}  // namespace velkui::layout::test
