#include <velkcore/AbstractParseHandler.h>

#include <functional>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;
using velkcore_test::ErrorOf;
using velkcore_test::Raises;

namespace {

// Writes every event into a log such as "<a x=1>text</a>" and can be told to
// throw at a given element.
class RecordingHandler : public AbstractParseHandler {
 public:
  std::string log;
  std::vector<XMLPosition> starts;
  std::string throwAt;
  bool ended = false;
  std::function<void()> onStart;

 protected:
  void StartElement(std::string_view name, std::span<const XMLAttribute> attributes) override {
    starts.push_back(CurrentPosition());
    log += "<" + std::string(name);
    for (const XMLAttribute& a : attributes) {
      log += " " + std::string(a.name) + "=" + std::string(a.value);
    }
    log += ">";
    if (name == throwAt) {
      RaiseAt(CurrentPosition(), "$$$/test/Handler/Error=Refused at line ^0, column ^1: ^2", 1,
              name);
    }
    if (onStart) onStart();
  }
  void EndElement(std::string_view name) override { log += "</" + std::string(name) + ">"; }
  void CharacterData(std::string_view text) override { log += text; }
  void EndDocument() override { ended = true; }
};

}  // namespace

TEST(ParseHandler, DeliversElementsAttributesAndResolvedText) {
  RecordingHandler handler;
  handler.Parse(
      "<?xml version=\"1.0\"?>\n"
      "<!-- a comment -->\n"
      "<root a='1' b=\"two &amp; three\"><child/>x&lt;&#x41;&#13;<![CDATA[<raw>]]></root>");
  EXPECT_EQ(handler.log, "<root a=1 b=two & three><child></child>x<A\r<raw></root>");
  EXPECT_TRUE(handler.ended);
}

TEST(ParseHandler, ReportsThePositionOfEachEvent) {
  RecordingHandler handler;
  handler.Parse("<a>\n  <b/>\n\t\xC3\xA9<c/></a>");
  ASSERT_EQ(handler.starts.size(), 3u);
  EXPECT_EQ(handler.starts[0], (XMLPosition{1, 1}));
  EXPECT_EQ(handler.starts[1], (XMLPosition{2, 3}));
  // Columns count characters, not bytes.
  EXPECT_EQ(handler.starts[2], (XMLPosition{3, 3}));
}

TEST(ParseHandler, MalformedDocumentsRaiseWithLineAndColumn) {
  struct Case {
    std::string xml;
    std::string where;
  };
  const std::vector<Case> cases = {
      {"", "line 1, column 1"},
      {"<a>\n<b></a>", "line 2, column 6"},
      {"<a>\n  <b>", "line 2, column 6"},
      {"<a x='1' x='2'/>", "line 1, column 10"},
      {"<a>&undeclared;</a>", "line 1, column 4"},
      {"<a>\xFF</a>", "line 1, column 4"},
      {"<a>&#0;</a>", "line 1, column 4"},
      {"<a/><b/>", "line 1, column 5"},
      {std::string("<a>\0</a>", 8), "line 1, column 4"},
  };
  for (const Case& c : cases) {
    RecordingHandler handler;
    const auto error = ErrorOf([&] { handler.Parse(c.xml); });
    ASSERT_TRUE(error) << c.xml;
    EXPECT_EQ(error->GetKey(), kMalformedXMLKey) << c.xml;
    EXPECT_EQ(error->GetNumber(), kMalformedXMLNumber);
    EXPECT_NE(std::string(error->what()).find(c.where), std::string::npos)
        << c.xml << " -> " << error->what();
    EXPECT_FALSE(handler.ended);
  }
}

TEST(ParseHandler, RefusesDocumentTypeDeclarations) {
  const std::vector<std::string> documents = {
      // Entity expansion ("billion laughs").
      "<?xml version=\"1.0\"?>\n<!DOCTYPE lolz [\n <!ENTITY lol \"lol\">\n"
      " <!ENTITY lol2 \"&lol;&lol;&lol;&lol;&lol;&lol;&lol;&lol;&lol;&lol;\">\n]>\n"
      "<lolz>&lol2;</lolz>",
      // External entity.
      "<!DOCTYPE a [<!ENTITY x SYSTEM \"file:///etc/passwd\">]><a>&x;</a>",
      "<!DOCTYPE a SYSTEM \"http://example.invalid/a.dtd\"><a/>",
      "<!DOCTYPE a><a/>",
  };
  for (const std::string& xml : documents) {
    RecordingHandler handler;
    EXPECT_TRUE(Raises([&] { handler.Parse(xml); }, kXMLDoctypeNotAllowedKey)) << xml;
    EXPECT_EQ(handler.log, "") << "no element may be delivered";
  }
}

TEST(ParseHandler, AnErrorRaisedByTheHandlerPassesThroughAndStopsTheEvents) {
  RecordingHandler handler;
  handler.throwAt = "b";
  const auto error = ErrorOf([&] { handler.Parse("<a>\n <b><c/></b>text<d/></a>"); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetKey(), "$$$/test/Handler/Error=Refused at line ^0, column ^1: ^2");
  EXPECT_STREQ(error->what(), "Refused at line 2, column 2: b");
  EXPECT_EQ(handler.log, "<a>\n <b>");
  EXPECT_FALSE(handler.ended);

  // Any exception type keeps its type.
  RecordingHandler other;
  other.onStart = [] { throw std::runtime_error("boom"); };
  EXPECT_THROW(other.Parse("<a/>"), std::runtime_error);
}

TEST(ParseHandler, CanParseAgainAfterAFailureButNotFromInsideACallback) {
  RecordingHandler handler;
  EXPECT_THROW(handler.Parse("<a>"), Exception);
  handler.log.clear();
  const unsigned char bytes[] = {'<', 'x', '/', '>'};
  handler.Parse(std::span<const unsigned char>(bytes));
  EXPECT_EQ(handler.log, "<x></x>");

  RecordingHandler nested;
  nested.onStart = [&nested] { nested.Parse("<b/>"); };
  EXPECT_TRUE(Raises([&] { nested.Parse("<a/>"); }, kInputContractViolationKey));
}
