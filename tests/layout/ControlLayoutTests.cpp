// The control layouts measure their control with the supplier they are given
// (here the recording supplier, whose fixed-metrics font advances half the font
// size per character) and grow their initial size to fit it.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include <velkcore/Error.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_RadioButton.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/layout/Alignments.h>
#include <velkui/layout/ControlLayouts.h>
#include <velkui/layout/LayoutJoiner.h>
#include <velkui/layout/Spacers.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/RecordingSupplier.h>
#include <velkui/ui/Theme.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

using velkcore::MakeIntrusive;

class ControlLayoutTest : public ::testing::Test {
 protected:
  ControlLayoutTest() { ui::Theme::Initialize(std::make_unique<ui::Theme>()); }
  ~ControlLayoutTest() override { ui::Theme::Terminate(); }

  // The control's own recommendation, measured the same way.
  PointT<float> Recommended(ui::UI_Node& node) {
    pictel::SurfaceP surface(*supplier, 1, 1);
    pictel::Pictel context(supplier.get(), surface.Get());
    return node.UI_GetRecommendedSize(&context);
  }
  template <typename Control>
  boost::intrusive_ptr<Control> Make(const std::u16string& text) {
    auto control = MakeIntrusive<Control>(text);
    control->SetFontSize(10);
    return control;
  }

  boost::intrusive_ptr<velkui::test::RecordingSupplier> supplier =
      MakeIntrusive<velkui::test::RecordingSupplier>();
};

TEST_F(ControlLayoutTest, ATextButtonLayoutIsFivePixelsWiderThanTheButtonAsksAndRoundsUp) {
  auto button = Make<controls::UI_TextButton>(u"A rather long caption");
  const PointT<float> wanted = Recommended(*button);
  ASSERT_GT(wanted.x, 64.0f) << "the caption decides the width";

  const UI_TextButtonLayout small(button, {10.5f, 3.2f}, supplier.get());
  EXPECT_EQ(small.GetInitialSize(), (PointT<float>{std::ceil(wanted.x + 5), std::ceil(wanted.y)}));
  const UI_TextButtonLayout large(button, {300.2f, 40.5f}, supplier.get());
  EXPECT_EQ(large.GetInitialSize(), (PointT<float>{301, 41})) << "never smaller than given";
}

TEST_F(ControlLayoutTest, CheckBoxesAndRadioButtonsAreMeasuredWithTheirLabels) {
  auto checkbox = Make<controls::UI_Checkbox>(u"Remember me");
  auto radio = Make<controls::UI_RadioButton>(u"Small");
  const PointT<float> box = Recommended(*checkbox);
  const PointT<float> dot = Recommended(*radio);
  // 11 and 5 characters of 5 pixels beside the mark.
  EXPECT_GE(box.x, 55.0f);
  EXPECT_GE(dot.x, 25.0f);

  const UI_CheckboxLayout checkboxLayout(checkbox, {0, 0}, supplier.get());
  EXPECT_EQ(checkboxLayout.GetInitialSize(),
            (PointT<float>{std::ceil(box.x + UI_CheckboxLayout::kWidthPadding), std::ceil(box.y)}));
  const UI_RadioButtonLayout radioLayout(radio, {0, 30}, supplier.get());
  EXPECT_EQ(radioLayout.GetInitialSize(),
            (PointT<float>{std::ceil(dot.x + UI_RadioButtonLayout::kWidthPadding), 30}));
}

TEST_F(ControlLayoutTest, AMultiLineTextWrapsAtTheGivenWidth) {
  auto text = Make<controls::UI_StaticText>(u"");
  text->SetText(u"one two three four");
  text->SetMultiLine(true);
  // Ten characters fit in 50 pixels: "one two" and "three four" take two lines of 10.
  const UI_TextLayout wrapped(text, {50, 0}, supplier.get());
  EXPECT_EQ(wrapped.GetInitialSize(), (PointT<float>{50, 20}));
  EXPECT_EQ(text->UI_GetLocalRectF(true).width, 50);

  auto line = Make<controls::UI_StaticText>(u"Name:");
  const UI_TextLayout oneLine(line, {0, 0}, supplier.get());
  // 25 pixels of text plus the text's own 2, one line of 10.
  EXPECT_EQ(oneLine.GetInitialSize(), (PointT<float>{27, 10}));
}

TEST_F(ControlLayoutTest, LayoutsPlaceTheirControlsInsideDecorators) {
  auto label = Make<controls::UI_StaticText>(u"Name:");
  auto button = Make<controls::UI_TextButton>(u"OK");
  auto labelLayout = MakeIntrusive<UI_TextLayout>(label, PointT<float>{0, 0}, supplier.get());
  auto buttonLayout =
      MakeIntrusive<UI_TextButtonLayout>(button, PointT<float>{0, 0}, supplier.get());
  const PointT<float> buttonSize = buttonLayout->GetInitialSize();
  // The label left of the button, both centred vertically, 10 pixels around.
  auto row = MakeIntrusive<LayoutJoiner>(MakeIntrusive<AlignVerticallyCentered>(labelLayout),
                                         MakeIntrusive<AlignVerticallyCentered>(buttonLayout),
                                         LayoutPlacement_LeftOfDO::GetSharedPtr(),
                                         ExtraSpace_Pass::GetSharedPtr());
  auto whole = MakeIntrusive<SpacerOnAllSides>(row, 10.0f);
  const PointT<float> size = whole->GetInitialSize();
  EXPECT_EQ(size, (PointT<float>{20 + 27 + buttonSize.x, 20 + buttonSize.y}));
  whole->SetLocation({0, 0, size.x, size.y});
  EXPECT_EQ(button->UI_GetLocalRectF(true), (RectT<float>{37, 10, buttonSize.x, buttonSize.y}));
  EXPECT_EQ(label->UI_GetLocalRectF(true).left, 10);
  EXPECT_EQ(label->UI_GetLocalRectF(true).width, 27);
}

TEST_F(ControlLayoutTest, MissingPiecesAndForeignNodesAreRefused) {
  auto button = Make<controls::UI_TextButton>(u"OK");
  EXPECT_THROW(UI_TextButtonLayout(button, {0, 0}, nullptr), velkcore::Exception);
  EXPECT_THROW(UI_TextButtonLayout(nullptr, {0, 0}, supplier.get()), velkcore::Exception);
  EXPECT_THROW(UI_CheckboxLayout(nullptr, {0, 0}, supplier.get()), velkcore::Exception);
  EXPECT_THROW(UI_TextButtonLayout(button, {-1, 0}, supplier.get()), velkcore::Exception);
  UI_TextButtonLayout layout(button, {0, 0}, supplier.get());
  layout.SetNode(Make<controls::UI_StaticText>(u"not a button"));
  EXPECT_THROW(layout.GetButton(), velkcore::Exception);
}

}  // namespace
}  // namespace velkui::layout::test
