#include <velkcore/Error.h>
#include <velkcore/Localizer.h>

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

using namespace velkcore;

namespace {
class LocalizerTest : public ::testing::Test {
 protected:
  void TearDown() override { Localizer::Get().ClearTranslations(); }
  Localizer& loc = Localizer::Get();
};
}  // namespace

TEST_F(LocalizerTest, DefaultTextWithoutTranslation) {
  EXPECT_EQ(loc.Lookup("$$$/velkui/dialogs/OK=OK"), u"OK");
  EXPECT_EQ(loc.Lookup("$$$/velkui/dialogs/Missing"), u"");
  EXPECT_EQ(loc.Lookup("plain text"), u"plain text");
  EXPECT_EQ(loc.Lookup("$$$/a/b=x=y"), u"x=y");  // only the first '=' separates
}

TEST_F(LocalizerTest, ReplacementsArgumentsAndLineBreaks) {
  const UTF16String values[] = {u"A", u"B"};
  const UTF16String args[] = {u"arg"};
  EXPECT_EQ(loc.Lookup("$$$/t/r=^1 before ^0, ^2 gone, @0!#{endl}next ^^0", values, args),
            u"B before A,  gone, arg!\nnext ^0");
  EXPECT_EQ(Localize("$$$/t/r=[^0]", {u"v"}), u"[v]");
}

TEST_F(LocalizerTest, TranslationFileOverridesDefaults) {
  const auto dir = std::filesystem::temp_directory_path() / "velkcore_localizer_test";
  std::filesystem::create_directories(dir);
  {
    std::ofstream f(dir / "de.txt", std::ios::binary);
    f << "\xEF\xBB\xBF# comment\r\n\r\n$$$/velkui/dialogs/Cancel=Abbrechen\r\n"
         "$$$/velkui/dialogs/Info=Datei ^0 fehlt#{endl}Weiter?\n";
  }
  loc.LoadLanguage(dir, "de");
  EXPECT_EQ(loc.GetLanguage(), "de");
  EXPECT_EQ(loc.Lookup("$$$/velkui/dialogs/Cancel=Cancel"), u"Abbrechen");
  EXPECT_EQ(Localize("$$$/velkui/dialogs/Info=File ^0 missing", {u"x"}), u"Datei x fehlt\nWeiter?");
  EXPECT_EQ(loc.Lookup("$$$/velkui/dialogs/OK=OK"), u"OK");
  std::filesystem::remove_all(dir);
}

TEST_F(LocalizerTest, BadTranslationTextChangesNothing) {
  EXPECT_THROW(loc.LoadTranslationText("$$$/a/b=ok\nnot an entry\n", "mem"), Exception);
  EXPECT_EQ(loc.Lookup("$$$/a/b=default"), u"default");
  EXPECT_THROW(loc.LoadTranslationFile("/nonexistent/velk.txt"), Exception);
}

TEST_F(LocalizerTest, StoredTextsInParenthesesAreResolved) {
  loc.SetTranslation("$$$/velkui/dialogs/OK=OK", u"Jawohl");
  EXPECT_EQ(loc.ResolveStoredText(u"($$$/velkui/dialogs/OK=OK)"), u"Jawohl");
  EXPECT_EQ(loc.ResolveStoredText(u"($$$/velkui/dialogs/Other=Other)"), u"Other");
  EXPECT_EQ(loc.ResolveStoredText(u"(plain)"), u"(plain)");
  EXPECT_EQ(loc.ResolveStoredText(u"$$$/velkui/dialogs/OK=OK"), u"$$$/velkui/dialogs/OK=OK");
}
