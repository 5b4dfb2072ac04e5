#include <velkcore/Error.h>
#include <velkcore/Localizer.h>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;
using velkcore_test::ErrorOf;

TEST(Error, ThrowErrorCarriesEveryFieldAndFillsTheText) {
  const auto e = ErrorOf([] {
    ThrowError(ErrorLevel::kError, "$$$/velkui/pictel/Error/Test=Unable to load font \"^0\" \"^1\"",
               101, 34, 7, "Nope Sans", u"Bold");
  });
  ASSERT_TRUE(e);
  EXPECT_EQ(e->GetLevel(), ErrorLevel::kError);
  EXPECT_EQ(e->GetCategory(), 101);
  EXPECT_EQ(e->GetNumber(), 34);
  EXPECT_EQ(e->GetFlag(), 7);
  EXPECT_EQ(e->GetReplacements()[1], u"Bold");
  EXPECT_STREQ(e->what(), "Unable to load font \"Nope Sans\" \"Bold\"");
}

TEST(Error, ContractViolationAndTypeConversion) {
  const auto e = ErrorOf([] { RequireInput(false); });
  ASSERT_TRUE(e);
  EXPECT_EQ(e->GetLevel(), ErrorLevel::kContractViolation);
  EXPECT_EQ(e->GetCategory(), 105);
  EXPECT_EQ(e->GetNumber(), 25);
  EXPECT_STREQ(e->what(), "An input contract violation has occurred!");
  struct Base {
    virtual ~Base() = default;
  };
  struct Derived : Base {};
  struct Other : Base {};
  Derived d;
  Base* b = &d;
  EXPECT_EQ(CheckedCast<Derived>(b), &d);
  EXPECT_EQ(CheckedCast<Other>(static_cast<Base*>(nullptr)), nullptr);
  EXPECT_THROW(CheckedCast<Other>(b), Exception);
}

TEST(Error, NumbersAsReplacementValuesAndTheLoadedTranslation) {
  const auto numbers =
      ErrorOf([] { ThrowError(ErrorLevel::kError, "$$$/t/x=^0|^1|^2", 105, 1, 0, 42, 0.5, -3.0); });
  ASSERT_TRUE(numbers);
  EXPECT_STREQ(numbers->what(), "42|0.5|-3");

  Localizer::Get().SetTranslation("$$$/t/translated", u"Übersetzt ^0");
  const auto translated = ErrorOf(
      [] { ThrowError(ErrorLevel::kError, "$$$/t/translated=Translated ^0", 105, 1, 0, "x"); });
  Localizer::Get().ClearTranslations();
  ASSERT_TRUE(translated);
  EXPECT_STREQ(translated->what(),
               "\xC3\x9C"
               "bersetzt x");
}
