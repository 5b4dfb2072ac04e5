#include <string>
#include <utility>

#include <gtest/gtest.h>

#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/StringTruncation.h>
#include <velkui/test/FixedMetricsFont.h>
#include <velkui/test/RecordingSupplier.h>

#include "PictelTestSupport.h"

namespace {

using namespace velkui::pictel;
using velkcore::UTF16String;
using velkui::test::FixedMetricsFont;
using velkui::test::RecordingSupplier;

// Size 10 and advance ratio 0.5: every UTF-16 unit is 5 units wide, "..." 15.
class TruncationTest : public ::testing::Test {
 protected:
  FixedMetricsFont font{u"Fixed", u"", 10.0f};
};

TEST_F(TruncationTest, TextThatFitsExactlyIsKeptOneUnitWiderIsCut) {
  const char16_t* text = u"abcdefghij";  // 50 wide
  for (auto mode :
       {TextTruncation::kEnd, TextTruncation::kEndEllipsis, TextTruncation::kPathEllipsis}) {
    EXPECT_EQ(u"abcdefghij", TruncateString(font, text, mode, 50.0f));
    EXPECT_NE(u"abcdefghij", TruncateString(font, text, mode, 49.0f));
  }
  EXPECT_EQ(u"abcdefghij", TruncateString(font, text, TextTruncation::kNone, 1.0f));
}

TEST_F(TruncationTest, CutAtEndKeepsTheLongestPrefixStrictlyNarrower) {
  EXPECT_EQ(u"abcdefghi", TruncateString(font, u"abcdefghij", TextTruncation::kEnd, 49.0f));
  // Nine units measure exactly 45, which is not below 45.
  EXPECT_EQ(u"abcdefgh", TruncateString(font, u"abcdefghij", TextTruncation::kEnd, 45.0f));
  EXPECT_EQ(u"", TruncateString(font, u"abcdefghij", TextTruncation::kEnd, 5.0f));
}

TEST_F(TruncationTest, EndEllipsisNeverShowsTheEllipsisAlone) {
  EXPECT_EQ(u"abcd...", TruncateString(font, u"abcdefghij", TextTruncation::kEndEllipsis, 40.0f));
  EXPECT_EQ(u"a...", TruncateString(font, u"abcdefghij", TextTruncation::kEndEllipsis, 20.5f));
  // "..." alone measures 15: it is all that fits below 20, and at 15 nothing does.
  EXPECT_EQ(u"...", TruncateString(font, u"abcdefghij", TextTruncation::kEndEllipsis, 20.0f));
  EXPECT_EQ(u"", TruncateString(font, u"abcdefghij", TextTruncation::kEndEllipsis, 15.0f));
  EXPECT_EQ(u"", TruncateString(font, u"abcdefghij", TextTruncation::kEndEllipsis, 10.0f));
}

TEST_F(TruncationTest, PathEllipsisKeepsHeadAndTail) {
  const UTF16String text = u"ABCDEFGHIJKLMNOPQRST";  // 20 units, 100 wide
  EXPECT_EQ(u"ABCDEFG...ST",
            TruncateString(font, text.c_str(), TextTruncation::kPathEllipsis, 61.0f));
  EXPECT_EQ(u"...RST", TruncateString(font, text.c_str(), TextTruncation::kPathEllipsis, 31.0f));
  EXPECT_EQ(u"", TruncateString(font, text.c_str(), TextTruncation::kPathEllipsis, 0.0f));
}

TEST(GeneratePathEllipsisString, CountsFromTheTextLength) {
  const UTF16String text = u"ABCDEFGHIJKLMNOPQRST";
  const std::pair<std::uint32_t, UTF16String> cases[] = {
      {12, u"ABCDEFG...ST"}, {5, u"...ST"}, {2, u"..."}, {9, u"ABCDEFG..."}, {0, u""}, {20, text},
      {400, text},
  };
  UTF16String out = u"stale";
  for (const auto& [length, expected] : cases) {
    GeneratePathEllipsisString(text, length, out);
    EXPECT_EQ(expected, out) << length;
  }
}

TEST(GeneratePathEllipsisString, NeverSplitsASurrogatePair) {
  // U+1F600 is the pair D83D DE00.
  const UTF16String headPair = u"abcdef\U0001F600ghijklmnop";
  UTF16String out;
  GeneratePathEllipsisString(headPair, 12, out);
  EXPECT_EQ(u"abcdef...nop", out);
  const UTF16String tailPair = u"abcdefghijklmnopq\U0001F600";
  GeneratePathEllipsisString(tailPair, 11, out);
  EXPECT_EQ(u"abcdefg...", out);
  GeneratePathEllipsisString(tailPair, 12, out);
  EXPECT_EQ(u"abcdefg...\U0001F600", out);
}

TEST_F(TruncationTest, CutAtEndNeverSplitsASurrogatePair) {
  // Units: a b D83D DE00 c d; at maxWidth 16 a unit-wise cut would end inside the pair.
  EXPECT_EQ(u"ab", TruncateString(font, u"ab\U0001F600cd", TextTruncation::kEnd, 16.0f));
  EXPECT_EQ(u"ab\U0001F600", TruncateString(font, u"ab\U0001F600cd", TextTruncation::kEnd, 21.0f));
  EXPECT_EQ(u"ab...", TruncateString(font, u"ab\U0001F600cd", TextTruncation::kEndEllipsis, 29.0f));
}

using DrawStringTest = velkui::pictel::test::RecordingSurfaceTest;

TEST_F(DrawStringTest, TruncatedTextIsDrawnAtTheSamePointAndAlignment) {
  surface->DrawString(*brush, *font, u"abcdefghij", {100, 50}, TextAlignment::kEnd,
                      TextTruncation::kEndEllipsis, 40.0f);
  EXPECT_EQ(std::vector<std::string>{"DrawString \"abcd...\" at 100,50 align2 solid(0,0,0,1)"},
            Drawn());
}

TEST_F(DrawStringTest, NothingIsDrawnWhenNotEvenTheEllipsisFits) {
  surface->DrawString(*brush, *font, u"abcdefghij", {0, 50}, TextAlignment::kStart,
                      TextTruncation::kEndEllipsis, 12.0f);
  for (auto mode :
       {TextTruncation::kEnd, TextTruncation::kEndEllipsis, TextTruncation::kPathEllipsis}) {
    surface->DrawString(*brush, *font, u"abc", {0, 50}, TextAlignment::kStart, mode, 0.0f);
  }
  surface->DrawString(*brush, *font, u"", {0, 50}, TextAlignment::kStart, TextTruncation::kNone,
                      0.0f);
  EXPECT_TRUE(Drawn().empty());
  // Without truncation maxWidth does not matter.
  surface->DrawString(*brush, *font, u"abc", {0, 50}, TextAlignment::kStart, TextTruncation::kNone,
                      0.0f);
  EXPECT_EQ(1u, Drawn().size());
}

TEST_F(DrawStringTest, MaximumLineWidthOfMultiLineText) {
  EXPECT_EQ(0.0f, surface->MeasureMaximumMultiLineStringWidth(*font, u""));
  EXPECT_EQ(15.0f, surface->MeasureMaximumMultiLineStringWidth(*font, u"a\nbbb"));
  EXPECT_EQ(20.0f, surface->MeasureMaximumMultiLineStringWidth(*font, u"a\r\nbbbb\n\n"));
  EXPECT_EQ(10.0f, surface->MeasureMaximumMultiLineStringWidth(*font, u"\nxy"));
}

}  // namespace
