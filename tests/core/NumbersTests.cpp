#include <velkcore/Error.h>
#include <velkcore/Numbers.h>

#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <limits>

using namespace velkcore;

namespace {
class NumbersTest : public ::testing::Test {
 protected:
  void SetUp() override { SetNumberLocale({u'.', u','}); }
  void TearDown() override { SetNumberLocale({u'.', u','}); }
};

double Parse(std::u16string_view text, NumberFormatFlags flags = {}) {
  double v = -12345.0;
  EXPECT_TRUE(StringToNumber(text, v, flags)) << UTF16to8(UTF16String(text));
  return v;
}
}  // namespace

TEST_F(NumbersTest, RoundsToTheDecimalPlaces) {
  EXPECT_EQ(NumberToString(3.14159, 2), u"3.14");
  EXPECT_EQ(NumberToString(2.5, 0), u"2");  // round-half-even on the exact binary value
  EXPECT_EQ(NumberToString(0.125, 2), u"0.12");
  EXPECT_EQ(NumberToString(1.005, 2), u"1.00");   // 1.005 is really 1.00499999...
  EXPECT_EQ(NumberToString(-0.001, 2), u"0.00");  // no "-0.00"
  EXPECT_EQ(NumberToString(-0.0, 0), u"0");
  EXPECT_EQ(NumberToString(-7.25, 1), u"-7.2");
  EXPECT_EQ(NumberToString(1e21, 0), u"1000000000000000000000");
}

TEST_F(NumbersTest, EveryFormatFlag) {
  EXPECT_EQ(NumberToString(1234.5, 2, kFormatNoTrailingZeros), u"1234.5");
  EXPECT_EQ(NumberToString(12.0, 3, kFormatNoTrailingZeros), u"12");
  EXPECT_EQ(NumberToString(1234567.891, 1, kFormatUseSeparator), u"1,234,567.9");
  EXPECT_EQ(NumberToString(123.0, 0, kFormatUseSeparator), u"123");
  EXPECT_EQ(NumberToString(-1234.0, 0, kFormatUseSeparator), u"-1,234");
  EXPECT_EQ(NumberToString(5.0, 0, kFormatAlwaysSign), u"+5");
  EXPECT_EQ(NumberToString(0.0, 0, kFormatAlwaysSign), u"0");
  EXPECT_EQ(NumberToString(-5.0, 0, kFormatAlwaysSign), u"-5");
  EXPECT_EQ(NumberToString(5.0, 0, kFormatPadSign), u" 5");
  EXPECT_EQ(NumberToString(-5.0, 0, kFormatPadSign), u"-5");
  EXPECT_EQ(NumberToString(42.0, 1, kFormatLeadingSpaces), u"        42.0");
  EXPECT_EQ(NumberToString(1000.0, 1,
                           kFormatUseSeparator | kFormatAlwaysSign | kFormatNoTrailingZeros |
                               kFormatLeadingSpaces),
            u"      +1,000");
}

TEST_F(NumbersTest, LocalisedSeparatorsUnlessNoLocalization) {
  SetNumberLocale({u',', u'.'});
  EXPECT_EQ(NumberToString(1234.5, 1, kFormatUseSeparator), u"1.234,5");
  EXPECT_EQ(NumberToString(1234.5, 1, kFormatUseSeparator | kFormatNoLocalization), u"1,234.5");
  EXPECT_EQ(Parse(u"1.234,5"), 1234.5);
  EXPECT_EQ(Parse(u"1,234.5", kFormatNoLocalization), 1234.5);
  EXPECT_EQ(InternationalizeNum(u"1,234.5"), u"1.234,5");
  EXPECT_EQ(DeInternationalizeNum(u"1.234,5"), u"1,234.5");
}

TEST_F(NumbersTest, IndependentOfTheProcessLocale) {
  // A host may switch LC_NUMERIC; formatting and parsing must not follow it.
  if (std::setlocale(LC_NUMERIC, "de_DE.UTF-8") == nullptr) {
    GTEST_SKIP() << "the de_DE.UTF-8 locale is not generated (scripts/setup makes it)";
  }
  EXPECT_EQ(NumberToString(1.5, 1, kFormatNoLocalization), u"1.5");
  EXPECT_EQ(Parse(u"2.25", kFormatNoLocalization), 2.25);
  std::setlocale(LC_NUMERIC, "C");
}

TEST_F(NumbersTest, IcuLocaleSeparators) {
  EXPECT_EQ(NumberLocaleForLanguage("de_DE"), (NumberLocale{u',', u'.'}));
  EXPECT_EQ(NumberLocaleForLanguage("en_US"), (NumberLocale{u'.', u','}));
}

TEST_F(NumbersTest, ParsesEverythingTheFormatterWrites) {
  const double values[] = {0.0, -0.5, 1234567.125, -98765.4321, 1e-7, 3.0, 999999.999};
  const std::uint16_t flagSets[] = {0x00, 0x01, 0x02, 0x04, 0x08, 0x10, 0x20, 0x3F, 0x3E, 0x19};
  for (const double v : values) {
    for (const std::uint16_t f : flagSets) {
      for (const int places : {0, 2, 5}) {
        const UTF16String text = NumberToString(v, places, f);
        double back = 0;
        ASSERT_TRUE(StringToNumber(text, back, f)) << UTF16to8(text);
        const UTF16String again = NumberToString(back, places, f);
        EXPECT_EQ(again, text);
      }
    }
  }
  double v = 0;
  EXPECT_TRUE(StringToNumber(NumberToString(std::nan(""), 2), v));
  EXPECT_TRUE(std::isnan(v));
  EXPECT_TRUE(StringToNumber(NumberToString(-HUGE_VAL, 2), v));
  EXPECT_EQ(v, -HUGE_VAL);
}

TEST_F(NumbersTest, RejectsWhatIsNotANumberAndLeavesTheValue) {
  for (const char16_t* bad :
       {u"", u"-", u"abc", u"1.2.3", u"12abc", u"1e999", u",5", u"1,,000", u"--1", u"."}) {
    double v = 7.0;
    EXPECT_FALSE(StringToNumber(bad, v)) << UTF16to8(bad);
    EXPECT_EQ(v, 7.0);
  }
  EXPECT_EQ(Parse(u"  -3.5e2 "), -350.0);
  EXPECT_EQ(Parse(u"12."), 12.0);
  EXPECT_EQ(Parse(u".5"), 0.5);
  EXPECT_EQ(Parse(u"\u22124"), -4.0);
  EXPECT_EQ(Parse(u"1e-400"), 0.0);
}

TEST_F(NumbersTest, DecimalPlacesOutOfRangeIsAContractViolation) {
  EXPECT_THROW(NumberToString(1.0, -1), Exception);
  EXPECT_THROW(NumberToString(1.0, kMaxDecimalPlaces + 1), Exception);
  EXPECT_EQ(NumberToString(-1.7976931348623157e308, 0).size(), 310u);
}

TEST_F(NumbersTest, CalculateEvaluatesExpressions) {
  const auto calc = [](std::u16string_view e) {
    double r = std::nan("");
    EXPECT_TRUE(Calculate(e, r)) << UTF16to8(UTF16String(e));
    return r;
  };
  EXPECT_EQ(calc(u"1 + 2 * 3"), 7.0);
  EXPECT_EQ(calc(u"(1 + 2) * 3"), 9.0);
  EXPECT_EQ(calc(u"10 - 4 - 3"), 3.0);
  EXPECT_EQ(calc(u"2 ^ 3 ^ 2"), 512.0);
  EXPECT_EQ(calc(u"-2 ^ 2"), -4.0);
  EXPECT_EQ(calc(u"--3"), 3.0);
  EXPECT_EQ(calc(u"8 \u00F7 2 \u00D7 3"), 12.0);
  EXPECT_EQ(calc(u"1.5e2 / 3"), 50.0);
  EXPECT_EQ(calc(u"12.5"), 12.5);
  EXPECT_EQ(calc(u"1,000 + 1"), 1001.0);
  EXPECT_EQ(calc(u"3+4="), 7.0);
  EXPECT_EQ(calc(u"2 * -3"), -6.0);
}

TEST_F(NumbersTest, CalculateReportsMalformedAndNonFinite) {
  for (const char16_t* bad : {u"", u"1 +", u"(2", u"2)", u"1 / 0", u"0 / 0", u"* 3", u"1e308 * 10",
                              u"(-8) ^ 0.5", u"2 3", u"abc", u"1 = 2"}) {
    double r = 5.0;
    EXPECT_FALSE(Calculate(bad, r)) << UTF16to8(bad);
    EXPECT_EQ(r, 5.0);
  }
  // Deep nesting must fail cleanly instead of overflowing the stack.
  UTF16String deep(100000, u'(');
  deep += u"1";
  double r = 0;
  EXPECT_FALSE(Calculate(deep, r));
  UTF16String minus(100000, u'-');
  minus += u"1";
  EXPECT_FALSE(Calculate(minus, r));
}

TEST_F(NumbersTest, CalculateUsesTheLocaleDecimalSeparator) {
  SetNumberLocale({u',', u'.'});
  double r = 0;
  EXPECT_TRUE(Calculate(u"1,5 * 2", r));
  EXPECT_EQ(r, 3.0);
  EXPECT_TRUE(Calculate(u"1.5 * 2", r, kFormatNoLocalization));
  EXPECT_EQ(r, 3.0);
}
