#include <algorithm>

#include <gtest/gtest.h>

#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/RecordingSupplier.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

// Text measured by the recording supplier's fixed-metrics font: every unit
// advances half the font size.
class TextControlTest : public ControlTest {
 protected:
  boost::intrusive_ptr<velkui::test::RecordingSupplier> supplier =
      velkcore::MakeIntrusive<velkui::test::RecordingSupplier>();
  pictel::SurfaceP surface{*supplier, 400, 300};
  pictel::Pictel context{supplier.get(), surface.Get()};

  std::vector<std::string> Calls(const std::string& name) const {
    std::vector<std::string> found;
    for (const std::string& call : supplier->GetLog().Strings(0, true)) {
      if (call.starts_with(name)) found.push_back(call);
    }
    return found;
  }
};

TEST_F(TextControlTest, OneLineOfStaticTextIsMeasuredAndDrawnAsGiven) {
  auto text = Add<UI_StaticText>({10, 10, 200, 20}, u"Tom & Jerry");
  text->SetFontSize(10);
  EXPECT_EQ(text->UI_GetRecommendedSize(&context), (PointT<float>{57, 10}));
  text->SetMeasureCharacters(4);
  EXPECT_EQ(text->UI_GetRecommendedSize(&context).x, 22.0f) << "measured for four digits";
  supplier->GetLog().Clear();
  text->UI_Draw(&context);
  const auto drawn = Calls("DrawString");
  ASSERT_EQ(drawn.size(), 1u);
  EXPECT_NE(drawn[0].find("\"Tom & Jerry\""), std::string::npos) << "ampersands are text here";
}

TEST_F(TextControlTest, MultiLineStaticTextWrapsAtItsWidth) {
  auto text = Add<UI_StaticText>({0, 0, 50, 100}, u"one two three four", true);
  text->SetFontSize(10);
  // At five units per 25 pixels, "one two" and "three four" fill two lines.
  EXPECT_EQ(text->UI_GetRecommendedSize(&context), (PointT<float>{50, 20}));
  supplier->GetLog().Clear();
  text->SetAlignment(kControlAlignLeft, kControlAlignTop);
  text->UI_Draw(&context);
  const auto drawn = Calls("DrawMultiLineString");
  ASSERT_EQ(drawn.size(), 1u);
  EXPECT_NE(drawn[0].find("in [0,0,50,20]"), std::string::npos) << drawn[0];
}

TEST_F(TextControlTest, ADisabledStaticTextUsesTheDisabledColour) {
  auto text = Add<UI_StaticText>({0, 0, 100, 20}, u"Quiet");
  text->SetDisabled(true);
  supplier->GetLog().Clear();
  text->UI_Draw(&context);
  const pictel::ColorRGBA grey = ui::Theme::Get().GetColor(180);
  const auto drawn = Calls("DrawString");
  ASSERT_EQ(drawn.size(), 1u);
  char spelled[64];
  std::snprintf(spelled, sizeof spelled, "%g", grey.red);
  EXPECT_NE(drawn[0].find(spelled), std::string::npos) << drawn[0];
}

TEST_F(TextControlTest, TheMnemonicIsUnderlinedOnlyWhileShown) {
  manager.EnableMnemonics();
  auto button = Add<UI_TextButton>({0, 0, 100, 24}, u"Fish && &chips");
  button->SetFontSize(10);
  supplier->GetLog().Clear();
  button->UI_Draw(&context);
  EXPECT_TRUE(Calls("StrokePath").empty());
  button->UI_TurnOnMnemonicDisplay();
  supplier->GetLog().Clear();
  button->UI_Draw(&context);
  const auto underline = Calls("StrokePath");
  ASSERT_EQ(underline.size(), 1u);
  // "Fish & chips" is 60 wide, centred in the 100-wide face: it starts at 20
  // and the underlined 'c' is the eighth unit (35..40).
  EXPECT_NE(underline[0].find("M55,"), std::string::npos) << underline[0];
  EXPECT_NE(underline[0].find("L60,"), std::string::npos) << underline[0];
}

TEST_F(TextControlTest, ATextButtonAsksForRoomForItsLongestName) {
  auto button = Add<UI_TextButton>({0, 0, 10, 10}, u"OK");
  button->SetFontSize(10);
  EXPECT_EQ(button->UI_GetRecommendedSize(&context), (PointT<float>{64, 22})) << "a minimum width";
  button->SetText(u"A much longer caption");
  EXPECT_EQ(button->UI_GetRecommendedSize(&context).x, 105 + 24);
  button->InsertModifiedName(ui::kModifierAlt, u"An even longer caption here");
  EXPECT_EQ(button->UI_GetRecommendedSize(&context).x, 135 + 24);
}

TEST_F(TextControlTest, ADividerRunsAlongItsLongerSide) {
  auto across = Add<UI_Divider>({0, 10, 120, 2});
  auto down = Add<UI_Divider>({50, 0, 2, 80});
  supplier->GetLog().Clear();
  across->UI_Draw(&context);
  down->UI_Draw(&context);
  const auto painted = Calls("PaintRect");
  ASSERT_EQ(painted.size(), 2u);
  EXPECT_NE(painted[0].find("[0,0,120,1]"), std::string::npos) << painted[0];
  EXPECT_NE(painted[1].find("[0,0,1,80]"), std::string::npos) << painted[1];
  EXPECT_FALSE(across->IsVertical());
  EXPECT_TRUE(down->IsVertical());
}

TEST_F(TextControlTest, ADividerInAGapRunsAcrossTheGapWhateverItsShape) {
  auto divider = Add<UI_Divider>({0, 0, 1, 1});
  // A wide gap between two short children of a row: still an upright line.
  divider->SetSeparatorFrame(false, {10, 0, 30, 6});
  EXPECT_TRUE(divider->IsVertical());
  EXPECT_EQ(divider->UI_GetLocalRectF(true), (velkcore::RectT<float>{10, 0, 30, 6}));
  divider->SetSeparatorFrame(true, {0, 10, 4, 20});
  EXPECT_FALSE(divider->IsVertical());
}

}  // namespace
}  // namespace velkui::controls::test
