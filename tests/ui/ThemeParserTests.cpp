#include <velkui/ui/KeyframeThemeParser.h>

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include <velkcore/Error.h>
#include <velkcore/File.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

using KeyValue = KeyframeThemeEditor::KeyValue;
using ColorTrack = KeyframeThemeEditor::ColorTrack;

std::filesystem::path ThemeFile(const char* name) {
  return std::filesystem::path(VELKUI_TEST_DATA_DIR) / "data" / "theme" / name;
}

KeyValue Value(float v) {
  return {0, 0, v, 1, false};
}

class ThemeParserTest : public ::testing::Test {
 protected:
  void Parse(std::string_view xml) { KeyframeThemeParser(editor_).Parse(xml); }

  // The error that parsing `xml` raises (an empty key when there is none).
  velkcore::Exception ErrorOf(std::string_view xml) {
    try {
      Parse(xml);
    } catch (const velkcore::Exception& e) {
      return e;
    }
    ADD_FAILURE() << "no error for " << xml;
    return {velkcore::ErrorLevel::kError, "", 0, 0, 0, {}};
  }

  void ExpectThemeError(std::string_view xml, std::int32_t number) {
    const velkcore::Exception error = ErrorOf(xml);
    EXPECT_EQ(error.GetCategory(), velkcore::kCategoryUserInterface) << xml;
    EXPECT_EQ(error.GetNumber(), number) << error.what();
  }

  KeyframeThemeEditor editor_;
};

TEST_F(ThemeParserTest, ThemeFileGivesADarkAndALightEnd) {
  KeyframeThemeParser(editor_).ParseFile(ThemeFile("brightness-range.xml"));
  for (const ThemeColorIndex index : {1, 2, 4, 6, 18}) {
    EXPECT_EQ(editor_.GetColorTrack(index).size(), 2u) << index;
  }
  EXPECT_EQ(editor_.GetColorTrack(18).at(0.0f), (KeyValue{205, 0.7f, 0.8f, 1, false}));
  editor_.SetBrightness(0.0f);
  EXPECT_NEAR(editor_.GetColor(4).red, 0.15f, 1e-6);
  EXPECT_LT(editor_.GetColor(4).red, editor_.GetColor(1).red);  // light text on dark ground
  editor_.SetBrightness(1.0f);
  EXPECT_GT(editor_.GetColor(4).red, editor_.GetColor(1).red);
  EXPECT_EQ(editor_.GetColor(3), GetDefaultThemeColor(3));  // not in the file
}

TEST_F(ThemeParserTest, KeyFrameAttributesAndDefaults) {
  Parse(R"(<ThemeColors>
      <KeyFrame name="7" t="0.25" v="0.5"/>
      <KeyFrame name=" 7 " t=" +0.75 " v="6e-1" h="-30" s="0.5" a="0.25" hold="true"/>
      <KeyFrame name="8" t="0" v="1" hold="TRUE"/>
      <KeyFrame name="8" t="0" v="0.9" hold="yes" unknown="x"/>
    </ThemeColors>)");
  const ColorTrack seven{{0.25f, Value(0.5f)}, {0.75f, {-30, 0.5f, 0.6f, 0.25f, true}}};
  EXPECT_EQ(editor_.GetColorTrack(7), seven);
  // The same key twice: the later key frame wins; only "true" sets hold.
  EXPECT_EQ(editor_.GetColorTrack(8), (ColorTrack{{0.0f, Value(0.9f)}}));
}

TEST_F(ThemeParserTest, ThemeElementPlacesEveryFollowingKeyFrame) {
  Parse(R"(<ThemeColors>
      <KeyFrame name="1" t="0.1" v="0.1"/>
      <Theme t="0.5">
        <KeyFrame name="1" t="0.9" v="0.5"/>
        <KeyFrame name="2" v="0.5"/>
      </Theme>
      <KeyFrame name="3" t="0.9" v="0.3"/>
      <Theme t="1"><KeyFrame name="2" v="1"/></Theme>
    </ThemeColors>)");
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.1f, Value(0.1f)}, {0.5f, Value(0.5f)}}));
  EXPECT_EQ(editor_.GetColorTrack(2), (ColorTrack{{0.5f, Value(0.5f)}, {1.0f, Value(1.0f)}}));
  EXPECT_EQ(editor_.GetColorTrack(3), (ColorTrack{{0.5f, Value(0.3f)}}));
}

TEST_F(ThemeParserTest, IncompleteKeyFramesAddNoKeyButStillReplaceTheTrack) {
  for (const ThemeColorIndex index : {1, 2, 3, 9}) editor_.SetColorKeyValue(index, 0, Value(0.1f));
  Parse(R"(<ThemeColors>
      <KeyFrame name="1" v="0.5"/>
      <KeyFrame name="2" t="0.5"/>
      <KeyFrame name="3" t="0.5" v="0.5"/>
      <KeyFrame t="0.5" v="0.5"/>
      <Theme/>
      <Unknown name="9" t="0.5" v="0.5"/>
    </ThemeColors>)");
  EXPECT_FALSE(editor_.HasColorTrack(1));
  EXPECT_FALSE(editor_.HasColorTrack(2));
  EXPECT_EQ(editor_.GetColorTrack(3), (ColorTrack{{0.5f, Value(0.5f)}}));
  EXPECT_EQ(editor_.GetColorTrack(9), (ColorTrack{{0.0f, Value(0.1f)}}));
}

TEST_F(ThemeParserTest, LoadingAgainReplacesTracksInsteadOfMerging) {
  KeyframeThemeParser parser(editor_);
  const std::string replacement = velkcore::ReadFileContents(ThemeFile("replacement.xml"));
  parser.ParseFile(ThemeFile("brightness-range.xml"));
  parser.Parse(replacement);
  parser.Parse(
      std::span(reinterpret_cast<const unsigned char*>(replacement.data()), replacement.size()));
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.5f, Value(0.4f)}}));
  EXPECT_EQ(editor_.GetColorTrack(2).size(), 2u);  // not named by the second file
}

TEST_F(ThemeParserTest, BadDocumentsAreErrorsThatLeaveTheEditorAlone) {
  editor_.SetColorKeyValue(1, 0.0f, Value(0.7f));
  const velkcore::Exception error = ErrorOf(velkcore::ReadFileContents(ThemeFile("bad-value.xml")));
  EXPECT_EQ(error.GetKey(), kThemeFileInvalidValueKey);
  EXPECT_EQ(error.GetReplacements()[0], u"4");  // line
  EXPECT_EQ(error.GetReplacements()[2], u"v");
  EXPECT_EQ(error.GetReplacements()[3], u"bright");

  for (const char* attributes : {R"(name="-1" t="0" v="0")", R"(name="1.5" t="0" v="0")",
                                 R"(name="99999999999999999999999" t="0" v="0")",
                                 R"(name="1" t="nan" v="0")", R"(name="1" t="0" v="1e99")",
                                 R"(name="1" t="0" v="0x10")", R"(name="1" t="0" v="1" a="1,0")"}) {
    ExpectThemeError(std::string("<ThemeColors><KeyFrame ") + attributes + "/></ThemeColors>",
                     kThemeFileInvalidValueNumber);
  }
  ExpectThemeError(R"(<ThemeColors><Theme t="half"/></ThemeColors>)", kThemeFileInvalidValueNumber);
  ExpectThemeError(R"(<PropertyList><KeyFrame name="1" t="0" v="0"/></PropertyList>)",
                   kThemeFileNotAThemeNumber);
  // Malformed XML keeps the core's error; what was read before the fault is dropped.
  EXPECT_EQ(ErrorOf(R"(<ThemeColors><KeyFrame name="2" t="0" v="0.2"/>)").GetNumber(),
            velkcore::kMalformedXMLNumber);

  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.7f)}}));
  EXPECT_FALSE(editor_.HasColorTrack(2));
  // The parser starts afresh after a failure.
  KeyframeThemeParser parser(editor_);
  EXPECT_THROW(parser.ParseFile(ThemeFile("missing.xml")), velkcore::Exception);
  parser.ParseFile(ThemeFile("replacement.xml"));
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.5f, Value(0.4f)}}));
}

TEST_F(ThemeParserTest, StrictModeRefusesWhatIsOtherwiseSkipped) {
  editor_.SetStrictMode(true);
  const velkcore::Exception missing = ErrorOf(
      R"(<ThemeColors><KeyFrame name="1" t="0" v="0.5"/><KeyFrame name="2" t="0"/></ThemeColors>)");
  EXPECT_EQ(missing.GetNumber(), kThemeFileMissingAttributeNumber);
  EXPECT_EQ(missing.GetReplacements()[2], u"v");
  EXPECT_EQ(missing.GetReplacements()[3], u"KeyFrame");
  EXPECT_FALSE(editor_.HasColorTrack(1));
  ExpectThemeError(R"(<ThemeColors><KeyFrame name="1" v="0"/></ThemeColors>)",
                   kThemeFileMissingAttributeNumber);
  ExpectThemeError(R"(<ThemeColors><Theme/></ThemeColors>)", kThemeFileMissingAttributeNumber);
  ExpectThemeError(R"(<ThemeColors><Colour name="1"/></ThemeColors>)",
                   kThemeFileUnknownElementNumber);

  Parse(R"(<ThemeColors><Theme t="0"><KeyFrame name="1" v="0.5"/></Theme></ThemeColors>)");
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.5f)}}));
}

}  // namespace
}  // namespace velkui::ui
