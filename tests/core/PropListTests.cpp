#include <velkcore/PropList.h>

#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;
using velkcore_test::ErrorOf;
using velkcore_test::Match;
using velkcore_test::Raises;

namespace {

template <typename T>
concept CanSet = requires(PropList list, T value) {
  list.Set("k", value);
};

// Stores `value`, checks its type, reads it back; then checks that reading an
// absent key reports absence and leaves the output alone.
template <typename T>
void ExpectStoredAs(const T& value, PropType type) {
  PropList list;
  list.Set("k", value);
  EXPECT_EQ(list.GetType("k"), type);
  T out{};
  ASSERT_TRUE(list.Get("k", out));
  EXPECT_EQ(out, value);
  EXPECT_FALSE(list.Get("absent", out));
  EXPECT_EQ(out, value);
}

}  // namespace

// Pointers other than text must not quietly become flags.
static_assert(!CanSet<int*>);
static_assert(!CanSet<const void*>);
static_assert(!CanSet<std::nullptr_t>);
static_assert(CanSet<char*>);

TEST(PropList, EveryTypeIsStoredAndReadBack) {
  ExpectStoredAs(true, PropType::kBool);
  ExpectStoredAs(std::int32_t{-7}, PropType::kInt32);
  ExpectStoredAs(std::uint32_t{4000000000u}, PropType::kUInt32);
  ExpectStoredAs(std::uint16_t{65535}, PropType::kUInt16);
  ExpectStoredAs(0.5f, PropType::kFloat);
  ExpectStoredAs(0.1, PropType::kDouble);
  ExpectStoredAs(std::string("text"), PropType::kString);
  ExpectStoredAs(UTF16String(u"t\u00E9xt"), PropType::kUString);
  ExpectStoredAs(UTF16StringArray{u"a", u"", u"c"}, PropType::kUStringArray);
  PropList sub;
  sub.Set("inner", 1);
  ExpectStoredAs(sub, PropType::kList);
  EXPECT_EQ(PropList().GetType("missing"), std::nullopt);
  EXPECT_EQ(PropList().GetSubList("missing"), nullptr);
}

TEST(PropList, LiteralsChooseTheNaturalType) {
  PropList list;
  char buffer[] = "mutable";
  list.Set("a", "utf8");
  list.Set("b", u"utf16");
  list.Set("c", std::string_view("view"));
  list.Set("d", 3);
  list.Set("e", 3u);
  list.Set("f", false);
  list.Set("g", buffer);
  const std::vector<PropType> expected = {PropType::kString, PropType::kUString, PropType::kString,
                                          PropType::kInt32,  PropType::kUInt32,  PropType::kBool,
                                          PropType::kString};
  std::vector<PropType> types;
  for (const auto& [key, value] : list) types.push_back(value.GetType());
  EXPECT_EQ(types, expected);

  const char* none = nullptr;
  const auto error = ErrorOf([&] { list.Set("h", none); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetLevel(), ErrorLevel::kContractViolation);
  EXPECT_FALSE(list.HasKey("h"));
}

TEST(PropList, NumbersConvertOnlyWhenExact) {
  PropList list;
  list.Set("int", std::int32_t{-3});
  list.Set("big", std::uint32_t{4294967295u});
  list.Set("small", std::uint16_t{40000});
  list.Set("whole", 12.0);
  list.Set("half", 0.5);
  list.Set("tenth", 0.1);
  list.Set("nan", std::numeric_limits<double>::quiet_NaN());
  list.Set("inf", -std::numeric_limits<double>::infinity());
  list.Set("odd", std::int32_t{16777217});  // not a float

  double d = 0;
  float f = 0;
  std::int32_t i = 0;
  std::uint32_t u = 0;
  std::uint16_t s = 0;
  EXPECT_TRUE(list.Get("int", d) && d == -3.0);
  EXPECT_TRUE(list.Get("big", d) && d == 4294967295.0);
  EXPECT_TRUE(list.Get("small", i) && i == 40000);
  EXPECT_TRUE(list.Get("whole", s) && s == 12);
  EXPECT_TRUE(list.Get("half", f) && f == 0.5f);
  EXPECT_TRUE(list.Get("nan", f) && std::isnan(f));
  EXPECT_TRUE(list.Get("inf", f) && f == -std::numeric_limits<float>::infinity());

  const std::vector<std::pair<std::function<void()>, std::string>> refused = {
      {[&] { list.Get("int", u); }, "'int' holds the int32 value -3, which uint32"},
      {[&] { list.Get("big", i); }, "'big' holds the uint32 value 4294967295, which int32"},
      {[&] { list.Get("big", s); }, "'big' holds the uint32 value 4294967295, which uint16"},
      {[&] { list.Get("half", i); }, "'half' holds the double value 0.5, which int32"},
      {[&] { list.Get("tenth", f); }, "holds the double value 0.1, which float"},
      {[&] { list.Get("nan", i); }, "'nan' holds the double value nan"},
      {[&] { list.Get("inf", u); }, "'inf' holds the double value -inf"},
      {[&] { list.Get("odd", f); }, "'odd' holds the int32 value 16777217, which float"},
  };
  for (const auto& [get, message] : refused) {
    EXPECT_TRUE(Raises(get, kPropListNotRepresentableKey, message)) << message;
  }
  EXPECT_EQ(i, 40000) << "a refused conversion writes nothing";
}

TEST(PropList, OtherMismatchesRaiseNamingKeyAndTypes) {
  PropList list;
  list.Set("flag", true);
  list.Set("name", "x");
  list.Set("count", 3);
  list.NewSubList("sub");
  bool b = false;
  std::int32_t i = 0;
  UTF16String text;
  std::string utf8;
  const std::vector<std::pair<std::function<void()>, std::string>> cases = {
      {[&] { list.Get("flag", i); }, "The property 'flag' holds bool, not int32."},
      {[&] { list.Get("count", b); }, "The property 'count' holds int32, not bool."},
      {[&] { list.Get("name", text); }, "The property 'name' holds string, not ustring."},
      {[&] { list.Get("sub", utf8); }, "The property 'sub' holds property list, not string."},
      {[&] { list.GetSubList("name"); }, "The property 'name' holds string, not property list."},
  };
  for (const auto& [get, message] : cases) {
    EXPECT_TRUE(Raises(get, kPropListTypeMismatchKey, message, Match::kWhole)) << message;
  }
}

TEST(PropList, SubListsAreOwnedReplacedAndCopiedDeeply) {
  PropList list;
  list.Set("a", 1);
  PropList* sub = list.NewSubList("a");
  sub->Set("x", 1);
  EXPECT_EQ(list.GetSubList("a"), sub);
  EXPECT_TRUE(list.GetSubList("a")->HasKey("x"));

  PropList other;
  other.Set("y", 2);
  list.SetSubList("b", other);
  other.Set("y", 3);
  std::int32_t y = 0;
  EXPECT_TRUE(list.GetSubList("b")->Get("y", y) && y == 2);

  PropList copy = list;
  copy.GetSubList("a")->Set("x", 99);
  std::int32_t x = 0;
  EXPECT_TRUE(list.GetSubList("a")->Get("x", x) && x == 1);
  EXPECT_NE(copy, list);

  // Storing a list into itself or one of its own parts copies first.
  list.SetSubList("a", *list.GetSubList("a"));
  EXPECT_TRUE(list.GetSubList("a")->HasKey("x"));
  list.GetSubList("a")->Set("whole", list);
  EXPECT_TRUE(list.GetSubList("a")->GetSubList("whole")->GetSubList("a")->HasKey("x"));
  PropList whole = list;
  EXPECT_TRUE(whole.Get("a", whole));
  EXPECT_TRUE(whole.HasKey("x") && !whole.HasKey("b"));
}

TEST(PropList, RemoveClearSizeAndByteOrderedIteration) {
  PropList list;
  for (const char* key : {"b", "a", "\xC3\xA9", "B", "", "a0"}) list.Set(key, 1);
  std::vector<std::string> keys;
  for (const auto& [key, value] : list) keys.push_back(key);
  EXPECT_EQ(keys, (std::vector<std::string>{"", "B", "a", "a0", "b", "\xC3\xA9"}));
  EXPECT_TRUE(list.Remove("a"));
  EXPECT_FALSE(list.Remove("a"));
  EXPECT_EQ(list.Size(), 5u);
  list.Clear();
  EXPECT_TRUE(list.Empty());
}

TEST(PropList, EqualityComparesTypesAndExactBits) {
  PropList a;
  PropList b;
  a.Set("n", std::numeric_limits<double>::quiet_NaN());
  b.Set("n", std::numeric_limits<double>::quiet_NaN());
  EXPECT_EQ(a, b);
  a.Set("z", 0.0);
  b.Set("z", -0.0);
  EXPECT_NE(a, b);
  b.Set("z", 0.0);
  a.Set("v", 1);
  b.Set("v", 1u);
  EXPECT_NE(a, b);
  b.Set("v", 1);
  a.NewSubList("s")->Set("deep", u"x");
  b.NewSubList("s")->Set("deep", u"y");
  EXPECT_NE(a, b);
}

TEST(PropList, RectanglesAndPoints) {
  PropList list;
  const RectT<std::int32_t> r{-1, 2, 300, std::numeric_limits<std::int32_t>::max()};
  const RectT<float> f{0.5f, -1.25f, 1e30f, 3};
  WriteRect32(list, "r", r);
  WriteRectF32(list, "f", f);
  WritePointF32(list, "p", {-0.0f, 7.5f});
  RectT<std::int32_t> r2;
  RectT<float> f2;
  PointT<float> p{5, 6};
  EXPECT_TRUE(ReadRect32(list, "r", r2) && r2 == r);
  EXPECT_TRUE(ReadRectF32(list, "f", f2) && f2 == f);
  EXPECT_TRUE(ReadPointF32(list, "p", p) && p == (PointT<float>{-0.0f, 7.5f}));
  EXPECT_EQ(list.GetSubList("r")->GetType("left"), PropType::kInt32);

  EXPECT_FALSE(ReadRectF32(list, "missing", f2));
  EXPECT_FALSE(ReadPointF32(list, "missing", p));
  EXPECT_EQ(f2, f);

  // Whole-number floats convert to an integer rectangle; fractions do not.
  list.GetSubList("f")->Set("left", 4.0f);
  list.GetSubList("f")->Set("top", 5.0f);
  list.GetSubList("f")->Set("width", 6.0f);
  EXPECT_TRUE(ReadRect32(list, "f", r2) && r2 == (RectT<std::int32_t>{4, 5, 6, 3}));
  list.GetSubList("f")->Set("top", 5.5f);
  EXPECT_THROW(ReadRect32(list, "f", r2), Exception);
  EXPECT_EQ(r2, (RectT<std::int32_t>{4, 5, 6, 3}));
}

TEST(PropList, RectangleRecordsThatAreIncompleteOrMistyped) {
  PropList list;
  PropList* partial = list.NewSubList("partial");
  for (const char* key : {"left", "top", "width", "x"}) partial->Set(key, 1.0f);
  list.Set("scalar", 3);
  RectT<float> f{1, 2, 3, 4};
  PointT<float> p{5, 6};
  const std::vector<std::pair<std::function<void()>, std::string>> cases = {
      {[&] { ReadRectF32(list, "partial", f); },
       "The property 'partial' lacks its entry 'height'."},
      {[&] { ReadPointF32(list, "partial", p); }, "The property 'partial' lacks its entry 'y'."},
      {[&] { ReadRectF32(list, "scalar", f); },
       "The property 'scalar' holds int32, not property list."},
      {[&] {
         partial->Set("height", "tall");
         ReadRectF32(list, "partial", f);
       },
       "The property 'height' holds string, not float."},
  };
  for (const auto& [read, message] : cases) EXPECT_TRUE(Raises(read, "", message, Match::kWhole));
  EXPECT_EQ(f, (RectT<float>{1, 2, 3, 4}));
  EXPECT_EQ(p, (PointT<float>{5, 6}));
}
