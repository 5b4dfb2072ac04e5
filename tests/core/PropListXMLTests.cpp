#include <velkcore/AbstractParseHandler.h>
#include <velkcore/PropListXML.h>

#include <bit>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <functional>
#include <limits>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;
using velkcore_test::ErrorOf;
using velkcore_test::Match;
using velkcore_test::Raises;

namespace {

PropList RoundTrip(const PropList& list) {
  return ReadPropList(WritePropList(list));
}

std::string Nested(std::size_t lists) {
  std::string xml = "<prop.map version='4'>";
  for (std::size_t i = 1; i < lists; ++i) xml += "<prop.list><prop.pair><key>k</key>";
  xml += "<prop.list/>";
  for (std::size_t i = 1; i < lists; ++i) xml += "</prop.pair></prop.list>";
  return xml + "</prop.map>";
}

PropList NestedList(std::size_t lists) {
  PropList root;
  PropList* list = &root;
  for (std::size_t i = 1; i < lists; ++i) list = list->NewSubList("k");
  return root;
}

}  // namespace

TEST(PropListXML, WritesTheStoredForm) {
  PropList list;
  list.Set("count", -2);
  list.Set("items", UTF16StringArray{u"one", u"two"});
  list.NewSubList("empty");
  list.NewSubList("bounds")->Set("left", 1);

  EXPECT_EQ(WritePropList(list), R"(<?xml version="1.0" encoding="UTF-8"?>
<prop.map version="4">
  <prop.list>
    <prop.pair>
      <key>bounds</key>
      <prop.list>
        <prop.pair>
          <key>left</key>
          <int type="signed" size="32">1</int>
        </prop.pair>
      </prop.list>
    </prop.pair>
    <prop.pair>
      <key>count</key>
      <int type="signed" size="32">-2</int>
    </prop.pair>
    <prop.pair>
      <key>empty</key>
      <prop.list/>
    </prop.pair>
    <prop.pair>
      <key>items</key>
      <array>
        <array.type><ustring/></array.type>
        <ustring>one</ustring>
        <ustring>two</ustring>
      </array>
    </prop.pair>
  </prop.list>
</prop.map>
)");
  EXPECT_EQ(RoundTrip(list), list);
  EXPECT_EQ(WritePropList(PropList()),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<prop.map version=\"4\">\n"
            "  <prop.list/>\n</prop.map>\n");
}

// The element each kind of value is stored as, alone in a list under the key "k".
TEST(PropListXML, WritesEachValueAsItsElement) {
  const std::pair<std::function<void(PropList&)>, std::string> cases[] = {
      {[](PropList& l) { l.Set("k", true); }, "<true/>"},
      {[](PropList& l) { l.Set("k", false); }, "<false/>"},
      {[](PropList& l) { l.Set("k", 7u); }, R"(<int type="unsigned" size="32">7</int>)"},
      {[](PropList& l) { l.Set("k", std::uint16_t{8080}); },
       R"(<int type="unsigned" size="16">8080</int>)"},
      {[](PropList& l) { l.Set("k", 0.1f); }, "<float>0.1</float>"},
      {[](PropList& l) { l.Set("k", 0.1); }, R"(<float size="64">0.1</float>)"},
      {[](PropList& l) { l.Set("k", "A&B <c>"); }, "<string>A&amp;B &lt;c&gt;</string>"},
      {[](PropList& l) { l.Set("k", u"Zoom\r\n"); }, "<ustring>Zoom&#13;\n</ustring>"},
      {[](PropList& l) { l.Set("k", std::string("\x01", 1)); },
       R"(<string encoding="hex">01</string>)"},
  };
  const std::string head = "    <prop.pair>\n      <key>k</key>\n      ";
  for (const auto& [set, element] : cases) {
    PropList list;
    set(list);
    const std::string xml = WritePropList(list);
    EXPECT_NE(xml.find(head + element + "\n    </prop.pair>"), std::string::npos) << xml;
    EXPECT_EQ(RoundTrip(list), list) << element;
  }
}

TEST(PropListXML, ExtremeNumbersReadBackBitExactly) {
  // Zeros, 1, 0.1, 1/3, smallest normal, largest, lowest, smallest and another
  // denormal, epsilon, infinities, quiet NaNs of both signs, NaNs with payloads.
  std::vector<float> floats;
  for (const std::uint32_t bits :
       {0x00000000u, 0x80000000u, 0x3f800000u, 0x3dcccccdu, 0x3eaaaaabu, 0x00800000u, 0x7f7fffffu,
        0xff7fffffu, 0x00000001u, 0x000116c2u, 0x34000000u, 0x7f800000u, 0xff800000u, 0x7fc00000u,
        0xffc00000u, 0x7fa00001u, 0xffc00123u}) {
    floats.push_back(std::bit_cast<float>(bits));
  }
  std::vector<double> doubles;
  for (const std::uint64_t bits :
       {0x0000000000000000ull, 0x8000000000000000ull, 0x3fb999999999999aull, 0x3fd5555555555555ull,
        0x0010000000000000ull, 0x7fefffffffffffffull, 0xffefffffffffffffull, 0x0000000000000001ull,
        0x00000000000003dfull, 0x3cb0000000000000ull, 0x4170000010000000ull, 0x7ff0000000000000ull,
        0xfff0000000000000ull, 0x7ff8000000000000ull, 0xfff8000000000000ull, 0x7ff0000000000001ull,
        0xfff8000000000abcull}) {
    doubles.push_back(std::bit_cast<double>(bits));
  }
  PropList list;
  for (std::size_t i = 0; i < floats.size(); ++i) list.Set("f" + std::to_string(i), floats[i]);
  for (std::size_t i = 0; i < doubles.size(); ++i) list.Set("d" + std::to_string(i), doubles[i]);
  list.Set("i1", std::numeric_limits<std::int32_t>::min());
  list.Set("i2", std::numeric_limits<std::int32_t>::max());
  list.Set("u1", std::numeric_limits<std::uint32_t>::max());
  list.Set("u2", 0u);
  list.Set("s1", std::uint16_t{65535});
  list.Set("s2", std::uint16_t{0});

  const std::string xml = WritePropList(list);
  EXPECT_NE(xml.find("<float>nan(0x7fa00001)</float>"), std::string::npos);
  EXPECT_NE(xml.find("<float size=\"64\">-inf</float>"), std::string::npos);
  EXPECT_NE(xml.find("<float>-nan</float>"), std::string::npos);
  EXPECT_NE(xml.find(">-2147483648<"), std::string::npos);
  EXPECT_EQ(ReadPropList(xml), list);  // equality compares the bits
}

TEST(PropListXML, EveryByteAndEveryCodeUnitSurvives) {
  PropList list;
  std::string allBytes;
  UTF16StringArray allUnits;
  for (int byte = 0; byte < 256; ++byte) {
    allBytes.push_back(static_cast<char>(byte));
    list.Set("b" + std::to_string(byte), std::string(1, static_cast<char>(byte)));
  }
  for (int unit = 0; unit <= 0xFFFF; ++unit) allUnits.emplace_back(1, static_cast<char16_t>(unit));
  list.Set("allBytes", allBytes);
  list.Set("allUnits", allUnits);
  list.Set("surrogates", UTF16StringArray{u"\U0001F600",
                                          {char16_t(0xDC00), char16_t(0xD800)},
                                          {u'a', char16_t(0xD800)},
                                          {char16_t(0xDFFF), u'b'}});
  list.Set("nonCharacters", "\xEF\xBF\xBE \xEF\xBF\xBF");
  list.Set("badUTF8", "\xC0\x80 \xED\xA0\x80 \xF4\x90\x80\x80 \xE2\x82");
  list.Set("markup", "]]> <!-- &amp; --> <?pi?> <![CDATA[x]]>");
  list.Set("spaces", u"  \t leading and trailing \n\n ");
  list.Set("lineEnds", u"a\r\nb\rc\n\rd");
  list.Set("", "empty key");
  list.Set("key\r\n<&>", "awkward key");
  list.Set(std::string("\0\x01\xFF", 3), "unwritable key");
  list.Set("emptyString", "");
  list.Set("emptyUString", u"");
  list.Set("emptyArray", UTF16StringArray{});
  list.Set("emptyItems", UTF16StringArray{u"", u""});

  const std::string xml = WritePropList(list);
  EXPECT_EQ(ReadPropList(xml), list);
  EXPECT_NE(xml.find("<ustring>a&#13;\nb&#13;c\n&#13;d</ustring>"), std::string::npos)
      << "carriage returns are kept without falling back to hex";
  EXPECT_NE(xml.find("<key encoding=\"hex\">0001ff</key>"), std::string::npos);
  EXPECT_NE(xml.find("<ustring encoding=\"hex\">dc00d800</ustring>"), std::string::npos);
}

TEST(PropListXML, ListsNestUpToTheLimit) {
  const PropList deepest = NestedList(kMaxPropListDepth);
  EXPECT_EQ(RoundTrip(deepest), deepest);
  EXPECT_EQ(ReadPropList(Nested(kMaxPropListDepth)), deepest);

  const std::size_t column = Nested(kMaxPropListDepth + 1).find("<prop.list/>") + 1;
  EXPECT_TRUE(
      Raises([] { ReadPropList(Nested(kMaxPropListDepth + 1)); }, kPropListTooDeepKey,
             "Lists nest deeper than 256 levels at line 1, column " + std::to_string(column) + ".",
             Match::kWhole));
  EXPECT_TRUE(
      Raises([] { WritePropList(NestedList(kMaxPropListDepth + 1)); }, kPropListWriteTooDeepKey));
}

TEST(PropListXML, AcceptsEquivalentSpellings) {
  const std::string xml =
      "<?xml version='1.0' encoding='ISO-8859-1'?>\n"
      "<!-- written by hand -->\n"
      "<prop.map version='4'><?tool hint?><prop.list>\n"
      "  <prop.pair><key>n</key><int size='32' type='signed'>\n  -12\t</int></prop.pair>\n"
      "  <prop.pair><key>f</key><float size='32'> 2.5 </float></prop.pair>\n"
      "  <prop.pair><key>d</key><float size='64'>1e300</float></prop.pair>\n"
      "  <prop.pair><key>inf</key><float>Infinity</float></prop.pair>\n"
      "  <prop.pair><key>s</key><string/></prop.pair>\n"
      "  <prop.pair><key>latin</key><ustring>caf\xE9</ustring></prop.pair>\n"
      "  <prop.pair><key>hex</key><ustring encoding='hex'>00410042</ustring></prop.pair>\n"
      "  <prop.pair><key>HEX</key><string encoding='hex'>4A4b</string></prop.pair>\n"
      "  <prop.pair><key>t</key><true>  </true></prop.pair>\n"
      "</prop.list></prop.map>\n";
  const std::vector<unsigned char> bytes(xml.begin(), xml.end());
  const PropList list = ReadPropList(std::span<const unsigned char>(bytes));
  PropList expected;
  expected.Set("n", -12);
  expected.Set("f", 2.5f);
  expected.Set("d", 1e300);
  expected.Set("inf", std::numeric_limits<float>::infinity());
  expected.Set("s", "");
  expected.Set("latin", u"caf\u00E9");
  expected.Set("hex", u"AB");
  expected.Set("HEX", "JK");
  expected.Set("t", true);
  EXPECT_EQ(list, expected);
}

TEST(PropListXML, MalformedDocumentsRaiseWithLineAndColumn) {
  struct Case {
    std::string xml;
    std::string_view key;
    std::string where;
  };
  const std::vector<Case> cases = {
      {"", kMalformedXMLKey, "line 1, column 1"},
      {"<prop.map version='4'>\n<prop.list>\n<prop.pair>", kMalformedXMLKey, "line 3, column 12"},
      {"<!DOCTYPE prop.map><prop.map version='4'><prop.list/></prop.map>", kXMLDoctypeNotAllowedKey,
       "line 1, column 1"},
      {"<prop.mop version='4'><prop.list/></prop.mop>", kPropListUnexpectedElementKey,
       "line 1, column 1"},
      {"<prop.map version='3'><prop.list/></prop.map>", kPropListBadAttributeKey,
       "line 1, column 1"},
      {"<prop.map><prop.list/></prop.map>", kPropListMissingAttributeKey, "line 1, column 1"},
      {"\n  <prop.map version='4'></prop.map>", kPropListMissingPartKey, "line 2, column 3"},
      {"<prop.map version='4'><prop.list/><prop.list/></prop.map>", kPropListUnexpectedElementKey,
       "line 1, column 35"},
  };
  for (const Case& c : cases)
    EXPECT_TRUE(Raises([&] { ReadPropList(c.xml); }, c.key, c.where)) << c.xml;
}

// Each body sits on line 3 of a document; the error points at `at`.
TEST(PropListXML, BadPairsRaiseWithLineAndColumn) {
  struct Case {
    std::string body;
    std::string_view key;
    std::string at;
  };
  const std::string pair = "<prop.pair><key>a</key>";
  const std::vector<Case> cases = {
      {"<prop.pair><true/></prop.pair>", kPropListMissingPartKey, "<prop.pair>"},
      {pair + "</prop.pair>", kPropListMissingPartKey, "<prop.pair>"},
      {pair + "<true/><false/></prop.pair>", kPropListUnexpectedElementKey, "<false/>"},
      {pair + "<key>b</key></prop.pair>", kPropListUnexpectedElementKey, "<key>b"},
      {pair + "<date>1</date></prop.pair>", kPropListUnexpectedElementKey, "<date>"},
      {"<key>a</key>", kPropListUnexpectedElementKey, "<key>"},
      {"junk" + pair + "<true/></prop.pair>", kPropListUnexpectedTextKey, "junk"},
      {"<prop.pair id='1'><key>a</key><true/></prop.pair>", kPropListUnexpectedAttributeKey,
       "<prop.pair"},
      {pair + "<prop.list x='1'/></prop.pair>", kPropListUnexpectedAttributeKey, "<prop.list"},
      {pair + "<true/></prop.pair>" + pair + "<false/></prop.pair>", kPropListDuplicateKeyKey,
       "<key>a</key><false/>"},
      {pair + "<int type='signed' size='64'>1</int></prop.pair>", kPropListBadAttributeKey, "<int"},
      {pair + "<int type='signed' size='16'>1</int></prop.pair>", kPropListBadAttributeKey, "<int"},
      {pair + "<int type='float' size='32'>1</int></prop.pair>", kPropListBadAttributeKey, "<int"},
      {pair + "<int size='32'>1</int></prop.pair>", kPropListMissingAttributeKey, "<int"},
      {pair + "<int type='signed' size='32' base='16'>1</int></prop.pair>",
       kPropListUnexpectedAttributeKey, "<int"},
      {pair + "<int type='signed' size='32'>12x</int></prop.pair>", kPropListBadNumberKey, "<int"},
      {pair + "<int type='signed' size='32'></int></prop.pair>", kPropListBadNumberKey, "<int"},
      {pair + "<int type='signed' size='32'>-2147483649</int></prop.pair>", kPropListBadNumberKey,
       "<int"},
      {pair + "<int type='unsigned' size='32'>4294967296</int></prop.pair>", kPropListBadNumberKey,
       "<int"},
      {pair + "<int type='unsigned' size='32'>-1</int></prop.pair>", kPropListBadNumberKey, "<int"},
      {pair + "<int type='unsigned' size='16'>65536</int></prop.pair>", kPropListBadNumberKey,
       "<int"},
      {pair + "<float>abc</float></prop.pair>", kPropListBadNumberKey, "<float"},
      {pair + "<float>1e39</float></prop.pair>", kPropListBadNumberKey, "<float"},
      {pair + "<float>nan(0x3f800000)</float></prop.pair>", kPropListBadNumberKey, "<float"},
      {pair + "<float size='64'>nan(0x)</float></prop.pair>", kPropListBadNumberKey, "<float"},
      {pair + "<float size='16'>1</float></prop.pair>", kPropListBadAttributeKey, "<float"},
      {pair + "<true>yes</true></prop.pair>", kPropListUnexpectedTextKey, "yes"},
      {pair + "<string>a<b/></string></prop.pair>", kPropListUnexpectedElementKey, "<b/>"},
      {pair + "<string encoding='base64'>AA==</string></prop.pair>", kPropListBadAttributeKey,
       "<string"},
      {pair + "<string encoding='hex'>abc</string></prop.pair>", kPropListBadEncodedTextKey,
       "<string"},
      {pair + "<ustring encoding='hex'>00410</ustring></prop.pair>", kPropListBadEncodedTextKey,
       "<ustring"},
      {"<prop.pair><key encoding='hex'>g0</key><true/></prop.pair>", kPropListBadEncodedTextKey,
       "<key"},
      {pair + "<array><ustring>a</ustring></array></prop.pair>", kPropListMissingPartKey,
       "<array>"},
      {pair + "<array><array.type><string/></array.type></array></prop.pair>",
       kPropListUnexpectedElementKey, "<string/>"},
      {pair + "<array><array.type></array.type></array></prop.pair>", kPropListMissingPartKey,
       "<array.type>"},
      {pair + "<array><array.type><ustring/><ustring/></array.type></array></prop.pair>",
       kPropListUnexpectedElementKey, "<ustring/></array.type>"},
      {pair + "<array><array.type><ustring encoding='hex'/></array.type></array></prop.pair>",
       kPropListUnexpectedAttributeKey, "<ustring"},
      {pair + "<array><array.type><ustring/></array.type><string>a</string></array></prop.pair>",
       kPropListUnexpectedElementKey, "<string>"},
  };
  for (const Case& c : cases) {
    const std::string xml =
        "<prop.map version='4'>\n<prop.list>\n" + c.body + "\n</prop.list>\n</prop.map>";
    const std::string where = "line 3, column " + std::to_string(c.body.find(c.at) + 1);
    EXPECT_TRUE(Raises([&] { ReadPropList(xml); }, c.key, where)) << c.body << " at " << where;
  }
}

TEST(PropListXML, MessagesNameWhatIsWrong) {
  const std::string head = "<prop.map version='4'><prop.list><prop.pair><key>a</key>";
  const std::string tail = "</prop.pair></prop.list></prop.map>";
  auto message = [&](const std::string& value) {
    const auto error = ErrorOf([&] { ReadPropList(head + value + tail); });
    return error ? std::string(error->what()) : std::string("no error");
  };
  EXPECT_EQ(message("<int type='unsigned' size='16'>65536</int>"),
            "The text '65536' at line 1, column 57 is not a valid uint16.");
  EXPECT_EQ(message("<float size='8'>1</float>"),
            "Unknown value '8' of attribute 'size' at line 1, column 57.");
  EXPECT_EQ(message("<array></array>"),
            "The <array> element at line 1, column 57 lacks its array.type.");
  EXPECT_EQ(
      message("<float>" + std::string(1000, '9') + "x</float>"),
      "The text '" + std::string(40, '9') + "...' at line 1, column 57 is not a valid float.");
}

// What the fuzz target checks, over its seed corpus: every input either raises
// or reads as a list that writes back to text reading as the same list.
TEST(PropListXML, SeedCorpusKeepsTheFuzzInvariant) {
  const std::filesystem::path corpus =
      std::filesystem::path(VELKUI_TEST_DATA_DIR) / ".." / "fuzz" / "corpus" / "proplist";
  std::size_t inputs = 0;
  for (const auto& entry : std::filesystem::directory_iterator(corpus)) {
    std::ifstream in(entry.path(), std::ios::binary);
    const std::string input(std::istreambuf_iterator<char>(in), {});
    ++inputs;
    std::optional<PropList> list;
    try {
      list = ReadPropList(input);
    } catch (const Exception&) {
      continue;
    }
    const std::string written = WritePropList(*list);
    EXPECT_EQ(ReadPropList(written), *list) << entry.path();
    EXPECT_EQ(WritePropList(ReadPropList(written)), written) << entry.path();
  }
  EXPECT_GE(inputs, 5u);
}
