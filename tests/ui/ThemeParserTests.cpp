#include <velkui/ui/KeyframeThemeParser.h>

#include <gtest/gtest.h>

#include <fstream>
#include <functional>
#include <iterator>
#include <optional>
#include <string>

#include <velkcore/Error.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {
namespace {

using KeyValue = KeyframeThemeEditor::KeyValue;
using ColorTrack = KeyframeThemeEditor::ColorTrack;

std::string ReadThemeFile(const std::string& name) {
  std::ifstream file(std::string(VELKUI_TEST_DATA_DIR) + "/data/theme/" + name, std::ios::binary);
  EXPECT_TRUE(file.good()) << name;
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::optional<velkcore::Exception> ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const velkcore::Exception& e) {
    return e;
  }
  return std::nullopt;
}

KeyValue Value(float v) {
  return {0, 0, v, 1, false};
}

class ThemeParserTest : public ::testing::Test {
 protected:
  void Parse(std::string_view xml) { KeyframeThemeParser(editor_).Parse(xml); }

  // Parses `xml` expecting an error of category 103 with `number`.
  velkcore::Exception ExpectThemeError(std::string_view xml, std::int32_t number) {
    const auto error = ErrorOf([&] { Parse(xml); });
    if (!error) {
      ADD_FAILURE() << "no error for " << xml;
      return velkcore::Exception(velkcore::ErrorLevel::kError, "", 0, 0, 0, {});
    }
    EXPECT_EQ(error->GetLevel(), velkcore::ErrorLevel::kError);
    EXPECT_EQ(error->GetCategory(), velkcore::kCategoryUserInterface);
    EXPECT_EQ(error->GetNumber(), number) << error->what();
    return *error;
  }

  KeyframeThemeEditor editor_;
};

TEST_F(ThemeParserTest, ThemeFileGivesADarkAndALightEnd) {
  Parse(ReadThemeFile("brightness-range.xml"));
  for (const ThemeColorIndex index : {1, 2, 4, 6, 18}) {
    EXPECT_EQ(editor_.GetColorTrack(index).size(), 2u) << index;
  }
  EXPECT_EQ(editor_.GetColorTrack(18).at(0.0f), (KeyValue{205, 0.7f, 0.8f, 1, false}));

  editor_.SetBrightness(0.0f);
  EXPECT_LT(editor_.GetColor(4).red, editor_.GetColor(1).red);  // light text on dark ground
  EXPECT_NEAR(editor_.GetColor(4).red, 0.15f, 1e-6);
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
  editor_.SetColorKeyValue(1, 0.0f, Value(0.1f));
  editor_.SetColorKeyValue(2, 0.0f, Value(0.2f));
  editor_.SetColorKeyValue(3, 0.0f, Value(0.3f));
  editor_.SetColorKeyValue(9, 0.0f, Value(0.9f));
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
  EXPECT_EQ(editor_.GetColorTrack(9), (ColorTrack{{0.0f, Value(0.9f)}}));
  editor_.Update();
  EXPECT_EQ(editor_.GetColor(1), GetDefaultThemeColor(1));
}

TEST_F(ThemeParserTest, LoadingAgainReplacesTracksInsteadOfMerging) {
  Parse(ReadThemeFile("brightness-range.xml"));
  Parse(ReadThemeFile("replacement.xml"));
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.5f, Value(0.4f)}}));
  EXPECT_EQ(editor_.GetColorTrack(2).size(), 2u);  // not named by the second file

  Parse(ReadThemeFile("replacement.xml"));
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.5f, Value(0.4f)}}));
}

TEST_F(ThemeParserTest, BadNumbersAreErrorsThatLeaveTheEditorAlone) {
  editor_.SetColorKeyValue(1, 0.0f, Value(0.7f));
  const velkcore::Exception error =
      ExpectThemeError(ReadThemeFile("bad-value.xml"), kThemeFileInvalidValueNumber);
  EXPECT_EQ(error.GetKey(), kThemeFileInvalidValueKey);
  EXPECT_EQ(error.GetReplacements()[0], u"4");  // line
  EXPECT_EQ(error.GetReplacements()[2], u"v");
  EXPECT_EQ(error.GetReplacements()[3], u"bright");
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.7f)}}));
  EXPECT_FALSE(editor_.HasColorTrack(2));

  for (const char* xml : {
           R"(<ThemeColors><KeyFrame name="-1" t="0" v="0"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1.5" t="0" v="0"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="99999999999999999999999" t="0" v="0"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="" t="0" v="0"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="nan" v="0"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="inf"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="1e99"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="0x10"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="0.5" h="ten"/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="0.5" s=""/></ThemeColors>)",
           R"(<ThemeColors><KeyFrame name="1" t="0" v="0.5" a="1,0"/></ThemeColors>)",
           R"(<ThemeColors><Theme t="half"/></ThemeColors>)",
       }) {
    ExpectThemeError(xml, kThemeFileInvalidValueNumber);
  }
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.7f)}}));
}

TEST_F(ThemeParserTest, OtherDocumentsAreRefused) {
  editor_.SetColorKeyValue(1, 0.0f, Value(0.7f));
  const velkcore::Exception error =
      ExpectThemeError(R"(<PropertyList><KeyFrame name="1" t="0" v="0"/></PropertyList>)",
                       kThemeFileNotAThemeNumber);
  EXPECT_EQ(error.GetReplacements()[2], u"PropertyList");

  // Malformed XML keeps the core's error; what was read before it is dropped.
  const auto malformed =
      ErrorOf([&] { Parse(R"(<ThemeColors><KeyFrame name="1" t="0" v="0.2"/>)"); });
  ASSERT_TRUE(malformed.has_value());
  EXPECT_EQ(malformed->GetNumber(), velkcore::kMalformedXMLNumber);
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.7f)}}));
}

TEST_F(ThemeParserTest, StrictModeRefusesWhatIsOtherwiseSkipped) {
  editor_.SetStrictMode(true);
  const velkcore::Exception missing = ExpectThemeError(
      R"(<ThemeColors><KeyFrame name="1" t="0" v="0.5"/><KeyFrame name="2" t="0"/></ThemeColors>)",
      kThemeFileMissingAttributeNumber);
  EXPECT_EQ(missing.GetReplacements()[2], u"v");
  EXPECT_EQ(missing.GetReplacements()[3], u"KeyFrame");
  EXPECT_FALSE(editor_.HasColorTrack(1));

  ExpectThemeError(R"(<ThemeColors><KeyFrame t="0" v="0"/></ThemeColors>)",
                   kThemeFileMissingAttributeNumber);
  ExpectThemeError(R"(<ThemeColors><KeyFrame name="1" v="0"/></ThemeColors>)",
                   kThemeFileMissingAttributeNumber);
  ExpectThemeError(R"(<ThemeColors><Theme/></ThemeColors>)", kThemeFileMissingAttributeNumber);
  const velkcore::Exception unknown = ExpectThemeError(
      R"(<ThemeColors><Colour name="1"/></ThemeColors>)", kThemeFileUnknownElementNumber);
  EXPECT_EQ(unknown.GetReplacements()[2], u"Colour");

  Parse(R"(<ThemeColors><Theme t="0"><KeyFrame name="1" v="0.5"/></Theme></ThemeColors>)");
  EXPECT_EQ(editor_.GetColorTrack(1), (ColorTrack{{0.0f, Value(0.5f)}}));
}

TEST_F(ThemeParserTest, ParserCanBeUsedAgainAfterAFailure) {
  KeyframeThemeParser parser(editor_);
  EXPECT_THROW(parser.Parse(R"(<ThemeColors><Theme t="0.5"><KeyFrame name="1" v="x"/></Theme>
                                </ThemeColors>)"),
               velkcore::Exception);
  const std::string xml = R"(<ThemeColors><KeyFrame name="2" t="0.25" v="0.5"/></ThemeColors>)";
  parser.Parse(std::span(reinterpret_cast<const unsigned char*>(xml.data()), xml.size()));
  EXPECT_FALSE(editor_.HasColorTrack(1));
  EXPECT_EQ(editor_.GetColorTrack(2), (ColorTrack{{0.25f, Value(0.5f)}}));
}

}  // namespace
}  // namespace velkui::ui
