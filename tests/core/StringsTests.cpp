#include <velkcore/Strings.h>

#include <gtest/gtest.h>

using namespace velkcore;

TEST(Strings, Utf8RoundTripKeepsEveryPlane) {
  const std::string text = "a\xC3\xA9\xE2\x82\xAC\xF0\x9F\x8E\xB5z";  // a é € 🎵 z
  const UTF16String wide = UTF8to16(text);
  EXPECT_EQ(wide, UTF16String(u"a\u00E9\u20AC\U0001F3B5z"));
  EXPECT_EQ(UTF16to8(wide), text);
}

TEST(Strings, MalformedInputBecomesReplacementCharacters) {
  // Truncated sequence, overlong encoding, encoded surrogate, lone continuation byte.
  EXPECT_EQ(UTF8to16("x\xE2\x82"), UTF16String(u"x\uFFFD"));
  EXPECT_EQ(UTF8to16("\xC0\xAF"), UTF16String(u"\uFFFD\uFFFD"));
  EXPECT_EQ(UTF8to16("\xED\xA0\x80!"), UTF16String(u"\uFFFD\uFFFD\uFFFD!"));
  EXPECT_EQ(UTF8to16("\x80"), UTF16String(u"\uFFFD"));
  const UTF16String lone{u'a', char16_t(0xD800), u'b', char16_t(0xDC00)};
  EXPECT_EQ(UTF16to8(lone),
            "a\xEF\xBF\xBD"
            "b\xEF\xBF\xBD");
  EXPECT_EQ(AsciiToUTF16("ok\xFF"), UTF16String(u"ok\uFFFD"));
}

TEST(Strings, CaseMappingIsLocaleIndependentAndMayChangeLength) {
  EXPECT_EQ(ToUpperCase(u"stra\u00DFe i"), UTF16String(u"STRASSE I"));  // no Turkish dotted I
  EXPECT_EQ(ToLowerCase(u"\u0130"), UTF16String(u"i\u0307"));
  EXPECT_EQ(FoldCase(u"Stra\u00DFE"), FoldCase(u"STRASSE"));
  EXPECT_EQ(ToUpperCase(u'\u00E9'), u'\u00C9');
  const UTF16String lone{char16_t(0xDC01), u'a'};
  EXPECT_EQ(ToUpperCase(lone), (UTF16String{char16_t(0xDC01), u'A'}));
}

TEST(Strings, ReplaceAllDoesNotRescanReplacedText) {
  UTF16String s = u"aaa";
  EXPECT_EQ(ReplaceAllStringInString(s, u"a", u"aa"), 3u);
  EXPECT_EQ(s, u"aaaaaa");
  EXPECT_EQ(ReplaceAllStringInString(s, u"", u"x"), 0u);
  std::string narrow = "1,000,000";
  EXPECT_EQ(ReplaceAllStringInString(narrow, ",", ""), 2u);
  EXPECT_EQ(narrow, "1000000");
}

TEST(Strings, ReplaceInStringReplacesOnlyTheFirstFromAPosition) {
  UTF16String s = u"^0 and ^0";
  EXPECT_TRUE(ReplaceInString(s, u"^0", u"one", 1));
  EXPECT_EQ(s, u"^0 and one");
  EXPECT_FALSE(ReplaceInString(s, u"^0", u"x", 100));
  EXPECT_FALSE(ReplaceInString(s, u"zz", u"x"));
}

TEST(Strings, MnemonicAmpersands) {
  constexpr auto npos = std::u16string_view::npos;
  EXPECT_EQ(LocateSingleAmpersandInString(u"&Open"), 0u);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Save && &Quit"), 8u);
  EXPECT_EQ(LocateSingleAmpersandInString(u"R&&D"), npos);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Trailing&"), npos);
  EXPECT_EQ(LocateSingleAmpersandInString(u"&&&x"), 2u);
  EXPECT_EQ(StripDisplayString(u"Save && &Quit&"), UTF16String(u"Save & Quit"));
}

TEST(Strings, NumericCharacters) {
  EXPECT_TRUE(HasNumericChars(u"x = 3"));
  EXPECT_FALSE(HasNumericChars(u"-.,+"));
  EXPECT_FALSE(HasNumericChars(u""));
}
