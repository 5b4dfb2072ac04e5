// The decoding of _XSETTINGS_SETTINGS, without a display.
#include <gtest/gtest.h>

#include "XSettingsBytes.h"
#include "XSettingsParser.h"

namespace velkui::ui::x11test {
namespace {

using x11::ParseXSettings;
using x11::XSettingColor;
using x11::XSettings;
using x11::XSettingValue;

XSettingsBytes EveryKind(bool mostSignificantFirst) {
  XSettingsBytes bytes(mostSignificantFirst);
  bytes.Integer("Net/DoubleClickTime", 320)
      .Integer("Net/Negative", -70000)
      .String("Net/ThemeName", "Green")  // five bytes: padded
      .String("Net/IconThemeName", "Blue")
      .String("Net/Empty", "")
      .Color("Gtk/Background", 0x1234, 0x5678, 0x9ABC, 0xFFFF);
  return bytes;
}

TEST(XSettingsParserTest, DecodesEveryTypeInEitherByteOrder) {
  const std::map<std::string, XSettingValue, std::less<>> expected{
      {"Net/DoubleClickTime", 320},
      {"Net/Negative", -70000},
      {"Net/ThemeName", std::string("Green")},
      {"Net/IconThemeName", std::string("Blue")},
      {"Net/Empty", std::string()},
      {"Gtk/Background", XSettingColor{0x1234, 0x5678, 0x9ABC, 0xFFFF}},
  };
  for (const bool mostSignificantFirst : {false, true}) {
    SCOPED_TRACE(mostSignificantFirst ? "most significant first" : "least significant first");
    const std::optional<XSettings> settings =
        ParseXSettings(EveryKind(mostSignificantFirst).Bytes(0x01020304));
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->serial, 0x01020304u);
    EXPECT_EQ(settings->values, expected);
    EXPECT_EQ(settings->Integer("Net/DoubleClickTime"), 320);
    EXPECT_EQ(settings->Integer("Net/ThemeName"), std::nullopt);
    EXPECT_EQ(settings->Integer("Net/Missing"), std::nullopt);
  }
}

TEST(XSettingsParserTest, EmptyPropertyTrailingBytesAndRepeatedNames) {
  const std::optional<XSettings> none = ParseXSettings(XSettingsBytes().Bytes());
  ASSERT_TRUE(none);
  EXPECT_TRUE(none->values.empty());

  std::vector<std::uint8_t> bytes =
      XSettingsBytes().Integer("Net/A", 1).Integer("Net/A", 2).Bytes();
  bytes.insert(bytes.end(), {9, 9, 9});
  const std::optional<XSettings> settings = ParseXSettings(bytes);
  ASSERT_TRUE(settings);
  EXPECT_EQ(settings->Integer("Net/A"), 1);
}

TEST(XSettingsParserTest, EveryTruncationIsRejected) {
  for (const bool mostSignificantFirst : {false, true}) {
    const std::vector<std::uint8_t> whole = EveryKind(mostSignificantFirst).Bytes();
    for (std::size_t size = 0; size < whole.size(); ++size) {
      EXPECT_FALSE(ParseXSettings(std::span(whole).first(size)))
          << size << " of " << whole.size() << " bytes";
    }
  }
}

TEST(XSettingsParserTest, MalformedPropertiesAreRejected) {
  std::vector<std::uint8_t> badOrder = XSettingsBytes().Integer("Net/A", 1).Bytes();
  badOrder[0] = 2;
  EXPECT_FALSE(ParseXSettings(badOrder)) << "byte order";

  XSettingsBytes unknownType;
  unknownType.Integer("Net/A", 1);
  unknownType.Start(3, "Net/B");
  unknownType.Card32(0);
  EXPECT_FALSE(ParseXSettings(unknownType.Bytes())) << "type 3";

  for (const std::uint32_t count : {2u, 0xFFFFFFFFu}) {
    EXPECT_FALSE(ParseXSettings(XSettingsBytes().Integer("Net/A", 1).Bytes(7, count)))
        << "count " << count;
  }

  // Lengths that point past the end, including ones whose padding would
  // wrap a 32-bit sum.
  for (const std::uint32_t length : {6u, 0x7FFFFFFFu, 0xFFFFFFFDu, 0xFFFFFFFFu}) {
    XSettingsBytes longString;
    longString.Start(XSettingsBytes::kString, "Net/S");
    longString.Card32(length);
    longString.Text("abcd");
    EXPECT_FALSE(ParseXSettings(longString.Bytes())) << "string length " << length;
  }
  XSettingsBytes longName;
  longName.Card8(XSettingsBytes::kInteger);
  longName.Card8(0);
  longName.Card16(0xFFFF);
  longName.Text("Net/A");
  longName.Card32(1);
  longName.Card32(5);
  EXPECT_FALSE(ParseXSettings(longName.Bytes(7, 1))) << "name length";
}

}  // namespace
}  // namespace velkui::ui::x11test
