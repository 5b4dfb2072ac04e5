#include <velkcore/PropList.h>

#include <cmath>
#include <functional>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

using namespace velkcore;

namespace {

std::optional<Exception> ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const Exception& e) {
    return e;
  }
  return std::nullopt;
}

template <typename T>
concept CanSet = requires(PropList list, T value) {
  list.Set("k", value);
};

}  // namespace

// Pointers other than text must not quietly become flags.
static_assert(!CanSet<int*>);
static_assert(!CanSet<const void*>);
static_assert(!CanSet<std::nullptr_t>);
static_assert(CanSet<char*>);

TEST(PropList, SetAndGetEveryType) {
  PropList list;
  list.Set("bool", true);
  list.Set("int32", std::int32_t{-7});
  list.Set("uint32", std::uint32_t{7});
  list.Set("uint16", std::uint16_t{65535});
  list.Set("float", 0.5f);
  list.Set("double", 0.1);
  list.Set("string", "text");
  list.Set("ustring", u"t\u00E9xt");
  list.Set("array", UTF16StringArray{u"a", u"", u"c"});
  list.NewSubList("list")->Set("inner", 1);

  EXPECT_EQ(list.GetType("bool"), PropType::kBool);
  EXPECT_EQ(list.GetType("int32"), PropType::kInt32);
  EXPECT_EQ(list.GetType("uint32"), PropType::kUInt32);
  EXPECT_EQ(list.GetType("uint16"), PropType::kUInt16);
  EXPECT_EQ(list.GetType("float"), PropType::kFloat);
  EXPECT_EQ(list.GetType("double"), PropType::kDouble);
  EXPECT_EQ(list.GetType("string"), PropType::kString);
  EXPECT_EQ(list.GetType("ustring"), PropType::kUString);
  EXPECT_EQ(list.GetType("array"), PropType::kUStringArray);
  EXPECT_EQ(list.GetType("list"), PropType::kList);
  EXPECT_EQ(list.GetType("missing"), std::nullopt);

  bool b = false;
  std::int32_t i = 0;
  std::uint32_t u = 0;
  std::uint16_t s = 0;
  float f = 0;
  double d = 0;
  std::string text;
  UTF16String utext;
  UTF16StringArray array;
  PropList sub;
  ASSERT_TRUE(list.Get("bool", b) && list.Get("int32", i) && list.Get("uint32", u) &&
              list.Get("uint16", s) && list.Get("float", f) && list.Get("double", d) &&
              list.Get("string", text) && list.Get("ustring", utext) && list.Get("array", array) &&
              list.Get("list", sub));
  EXPECT_TRUE(b);
  EXPECT_EQ(i, -7);
  EXPECT_EQ(u, 7u);
  EXPECT_EQ(s, 65535);
  EXPECT_EQ(f, 0.5f);
  EXPECT_EQ(d, 0.1);
  EXPECT_EQ(text, "text");
  EXPECT_EQ(utext, u"t\u00E9xt");
  EXPECT_EQ(array, (UTF16StringArray{u"a", u"", u"c"}));
  EXPECT_TRUE(sub.Get("inner", i));
  EXPECT_EQ(i, 1);
}

TEST(PropList, LiteralsChooseTheNaturalType) {
  PropList list;
  list.Set("a", "utf8");
  list.Set("b", u"utf16");
  list.Set("c", std::string_view("view"));
  list.Set("d", 3);
  list.Set("e", 3u);
  list.Set("f", false);
  char buffer[] = "mutable";
  list.Set("g", buffer);
  EXPECT_EQ(list.GetType("a"), PropType::kString);
  EXPECT_EQ(list.GetType("b"), PropType::kUString);
  EXPECT_EQ(list.GetType("c"), PropType::kString);
  EXPECT_EQ(list.GetType("d"), PropType::kInt32);
  EXPECT_EQ(list.GetType("e"), PropType::kUInt32);
  EXPECT_EQ(list.GetType("f"), PropType::kBool);
  EXPECT_EQ(list.GetType("g"), PropType::kString);

  const char* none = nullptr;
  const auto error = ErrorOf([&] { list.Set("h", none); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetLevel(), ErrorLevel::kContractViolation);
  EXPECT_FALSE(list.HasKey("h"));
}

TEST(PropList, AbsentKeysLeaveTheOutputAlone) {
  const PropList list;
  bool b = true;
  std::int32_t i = 42;
  double d = 2.5;
  std::string text = "keep";
  UTF16StringArray array{u"keep"};
  PropList sub;
  sub.Set("keep", 1);
  EXPECT_FALSE(list.Get("x", b));
  EXPECT_FALSE(list.Get("x", i));
  EXPECT_FALSE(list.Get("x", d));
  EXPECT_FALSE(list.Get("x", text));
  EXPECT_FALSE(list.Get("x", array));
  EXPECT_FALSE(list.Get("x", sub));
  EXPECT_TRUE(b);
  EXPECT_EQ(i, 42);
  EXPECT_EQ(d, 2.5);
  EXPECT_EQ(text, "keep");
  EXPECT_EQ(array, UTF16StringArray{u"keep"});
  EXPECT_TRUE(sub.HasKey("keep"));
  EXPECT_EQ(list.GetSubList("x"), nullptr);
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
  EXPECT_TRUE(list.Get("int", d));
  EXPECT_EQ(d, -3.0);
  EXPECT_TRUE(list.Get("big", d));
  EXPECT_EQ(d, 4294967295.0);
  EXPECT_TRUE(list.Get("small", i));
  EXPECT_EQ(i, 40000);
  EXPECT_TRUE(list.Get("whole", s));
  EXPECT_EQ(s, 12);
  EXPECT_TRUE(list.Get("half", f));
  EXPECT_EQ(f, 0.5f);
  EXPECT_TRUE(list.Get("nan", f));
  EXPECT_TRUE(std::isnan(f));
  EXPECT_TRUE(list.Get("inf", f));
  EXPECT_EQ(f, -std::numeric_limits<float>::infinity());

  struct Case {
    std::function<void()> get;
    std::string message;
  };
  const std::vector<Case> refused = {
      {[&] { list.Get("int", u); }, "'int' holds the int32 value -3, which uint32"},
      {[&] { list.Get("big", i); }, "'big' holds the uint32 value 4294967295, which int32"},
      {[&] { list.Get("big", s); }, "'big' holds the uint32 value 4294967295, which uint16"},
      {[&] { list.Get("half", i); }, "'half' holds the double value 0.5, which int32"},
      {[&] { list.Get("tenth", f); }, "holds the double value 0.1, which float"},
      {[&] { list.Get("nan", i); }, "'nan' holds the double value nan"},
      {[&] { list.Get("inf", u); }, "'inf' holds the double value -inf"},
      {[&] { list.Get("odd", f); }, "'odd' holds the int32 value 16777217, which float"},
  };
  for (const Case& c : refused) {
    const auto error = ErrorOf(c.get);
    ASSERT_TRUE(error) << c.message;
    EXPECT_EQ(error->GetKey(), kPropListNotRepresentableKey);
    EXPECT_NE(std::string(error->what()).find(c.message), std::string::npos) << error->what();
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
    const auto error = ErrorOf(get);
    ASSERT_TRUE(error) << message;
    EXPECT_EQ(error->GetKey(), kPropListTypeMismatchKey);
    EXPECT_EQ(error->what(), message);
  }
}

TEST(PropList, SubListsAreOwnedReplacedAndCopiedDeeply) {
  PropList list;
  list.Set("a", 1);
  PropList* sub = list.NewSubList("a");
  ASSERT_NE(sub, nullptr);
  EXPECT_EQ(list.GetType("a"), PropType::kList);
  sub->Set("x", 1);
  EXPECT_EQ(list.GetSubList("a"), sub);
  EXPECT_TRUE(list.GetSubList("a")->HasKey("x"));

  PropList other;
  other.Set("y", 2);
  list.SetSubList("b", other);
  other.Set("y", 3);
  std::int32_t y = 0;
  ASSERT_TRUE(list.GetSubList("b")->Get("y", y));
  EXPECT_EQ(y, 2);

  PropList copy = list;
  copy.GetSubList("a")->Set("x", 99);
  std::int32_t x = 0;
  ASSERT_TRUE(list.GetSubList("a")->Get("x", x));
  EXPECT_EQ(x, 1);
  EXPECT_NE(copy, list);

  // Storing a list into itself or one of its own parts copies first.
  list.SetSubList("a", *list.GetSubList("a"));
  EXPECT_TRUE(list.GetSubList("a")->HasKey("x"));
  list.GetSubList("a")->Set("whole", list);
  EXPECT_TRUE(list.GetSubList("a")->GetSubList("whole")->GetSubList("a")->HasKey("x"));
  EXPECT_TRUE(list.Get("b", *list.GetSubList("b")));
  EXPECT_TRUE(list.GetSubList("b")->HasKey("y"));
  PropList whole = list;
  EXPECT_TRUE(whole.Get("a", whole));
  EXPECT_TRUE(whole.HasKey("x"));
  EXPECT_FALSE(whole.HasKey("b"));
}

TEST(PropList, RemoveClearSizeAndByteOrderedIteration) {
  PropList list;
  for (const char* key : {"b", "a", "\xC3\xA9", "B", "", "a0"}) list.Set(key, 1);
  std::vector<std::string> keys;
  for (const auto& [key, value] : list) keys.push_back(key);
  EXPECT_EQ(keys, (std::vector<std::string>{"", "B", "a", "a0", "b", "\xC3\xA9"}));
  EXPECT_EQ(list.Size(), 6u);
  EXPECT_TRUE(list.Remove("a"));
  EXPECT_FALSE(list.Remove("a"));
  EXPECT_FALSE(list.HasKey("a"));
  EXPECT_EQ(list.Size(), 5u);
  list.Clear();
  EXPECT_TRUE(list.Empty());
  EXPECT_EQ(list.begin(), list.end());
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
  EXPECT_EQ(a, b);
  a.NewSubList("s")->Set("deep", u"x");
  b.NewSubList("s")->Set("deep", u"y");
  EXPECT_NE(a, b);
}

TEST(PropList, RectanglesAndPoints) {
  PropList list;
  WriteRect32(list, "r", {-1, 2, 300, std::numeric_limits<std::int32_t>::max()});
  WriteRectF32(list, "f", {0.5f, -1.25f, 1e30f, 3});
  WritePointF32(list, "p", {-0.0f, 7.5f});
  RectT<std::int32_t> r;
  RectT<float> f;
  PointT<float> p;
  ASSERT_TRUE(ReadRect32(list, "r", r));
  ASSERT_TRUE(ReadRectF32(list, "f", f));
  ASSERT_TRUE(ReadPointF32(list, "p", p));
  EXPECT_EQ(r, (RectT<std::int32_t>{-1, 2, 300, std::numeric_limits<std::int32_t>::max()}));
  EXPECT_EQ(f, (RectT<float>{0.5f, -1.25f, 1e30f, 3}));
  EXPECT_EQ(p, (PointT<float>{-0.0f, 7.5f}));
  std::int32_t left = 0;
  ASSERT_TRUE(list.GetSubList("r")->Get("left", left));
  EXPECT_EQ(left, -1);

  // Whole-number floats convert to an integer rectangle.
  list.GetSubList("f")->Set("left", 4.0f);
  list.GetSubList("f")->Set("top", 5.0f);
  list.GetSubList("f")->Set("width", 6.0f);
  ASSERT_TRUE(ReadRect32(list, "f", r));
  EXPECT_EQ(r, (RectT<std::int32_t>{4, 5, 6, 3}));
}

TEST(PropList, RectangleRecordsThatAreAbsentIncompleteOrMistyped) {
  PropList list;
  RectT<float> f{1, 2, 3, 4};
  PointT<float> p{5, 6};
  EXPECT_FALSE(ReadRectF32(list, "missing", f));
  EXPECT_FALSE(ReadPointF32(list, "missing", p));
  EXPECT_EQ(f, (RectT<float>{1, 2, 3, 4}));
  EXPECT_EQ(p, (PointT<float>{5, 6}));

  PropList* partial = list.NewSubList("partial");
  partial->Set("left", 1.0f);
  partial->Set("top", 1.0f);
  partial->Set("width", 1.0f);
  partial->Set("x", 1.0f);
  auto error = ErrorOf([&] { ReadRectF32(list, "partial", f); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetKey(), kPropListIncompleteRecordKey);
  EXPECT_STREQ(error->what(), "The property 'partial' lacks its entry 'height'.");
  error = ErrorOf([&] { ReadPointF32(list, "partial", p); });
  ASSERT_TRUE(error);
  EXPECT_STREQ(error->what(), "The property 'partial' lacks its entry 'y'.");
  EXPECT_EQ(f, (RectT<float>{1, 2, 3, 4}));
  EXPECT_EQ(p, (PointT<float>{5, 6}));

  partial->Set("height", "tall");
  error = ErrorOf([&] { ReadRectF32(list, "partial", f); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetKey(), kPropListTypeMismatchKey);
  partial->Set("height", 0.5f);
  RectT<std::int32_t> r{9, 9, 9, 9};
  error = ErrorOf([&] { ReadRect32(list, "partial", r); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetKey(), kPropListNotRepresentableKey);
  EXPECT_EQ(r, (RectT<std::int32_t>{9, 9, 9, 9}));

  list.Set("scalar", 3);
  error = ErrorOf([&] { ReadRectF32(list, "scalar", f); });
  ASSERT_TRUE(error);
  EXPECT_EQ(error->GetKey(), kPropListTypeMismatchKey);
}
