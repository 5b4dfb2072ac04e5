#pragma once

#include <concepts>
#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

#include <velkcore/Error.h>
#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>

namespace velkcore {

class PropList;

using UTF16StringArray = std::vector<UTF16String>;

enum class PropType : std::uint8_t {
  kBool,
  kInt32,
  kUInt32,
  kUInt16,
  kFloat,
  kDouble,
  kString,        // UTF-8 std::string
  kUString,       // UTF16String
  kUStringArray,  // UTF16StringArray
  kList,          // nested PropList
};

// "bool", "int32", "uint32", "uint16", "float", "double", "string", "ustring",
// "ustring array", "property list".
std::string_view PropTypeName(PropType type);

inline constexpr std::string_view kPropListTypeMismatchKey =
    "$$$/velkcore/PropList/Error/TypeMismatch=The property '^0' holds ^1, not ^2.";
inline constexpr std::string_view kPropListNotRepresentableKey =
    "$$$/velkcore/PropList/Error/NotRepresentable=The property '^0' holds the ^1 value ^3, which "
    "^2 cannot represent exactly.";
inline constexpr std::string_view kPropListIncompleteRecordKey =
    "$$$/velkcore/PropList/Error/IncompleteRecord=The property '^0' lacks its entry '^1'.";
inline constexpr std::int32_t kPropListTypeMismatchNumber = 50;
inline constexpr std::int32_t kPropListNotRepresentableNumber = 51;
inline constexpr std::int32_t kPropListIncompleteRecordNumber = 52;

// One typed value of a property list. Copies are deep.
class PropValue {
 public:
  // Only a real bool: a pointer must not turn into a flag.
  template <std::same_as<bool> B>
  explicit PropValue(B value) : value_(value) {}
  explicit PropValue(std::int32_t value) : value_(value) {}
  explicit PropValue(std::uint32_t value) : value_(value) {}
  explicit PropValue(std::uint16_t value) : value_(value) {}
  explicit PropValue(float value) : value_(value) {}
  explicit PropValue(double value) : value_(value) {}
  explicit PropValue(std::string value) : value_(std::move(value)) {}
  explicit PropValue(UTF16String value) : value_(std::move(value)) {}
  explicit PropValue(UTF16StringArray value) : value_(std::move(value)) {}
  explicit PropValue(const PropList& list);
  explicit PropValue(PropList&& list);

  PropValue(const PropValue& other);
  PropValue(PropValue&& other) noexcept;
  PropValue& operator=(const PropValue& other);
  PropValue& operator=(PropValue&& other) noexcept;
  ~PropValue();

  PropType GetType() const { return static_cast<PropType>(value_.index()); }

  // The value when it has exactly type T (PropList for a nested list), else null.
  template <typename T>
  const T* GetIf() const {
    if constexpr (std::is_same_v<T, PropList>) {
      const auto* list = std::get_if<std::unique_ptr<PropList>>(&value_);
      return list != nullptr ? list->get() : nullptr;
    } else {
      return std::get_if<T>(&value_);
    }
  }
  template <typename T>
  T* GetIf() {
    return const_cast<T*>(std::as_const(*this).template GetIf<T>());
  }

  // Same type and same value; floating-point values compare by their bits, so
  // a NaN equals itself and -0.0 differs from 0.0.
  friend bool operator==(const PropValue& a, const PropValue& b);

 private:
  // The order matches PropType.
  std::variant<bool, std::int32_t, std::uint32_t, std::uint16_t, float, double, std::string,
               UTF16String, UTF16StringArray, std::unique_ptr<PropList>>
      value_;
};

// A tree of pairs from a UTF-8 key to a typed value, ordered by the bytes of
// the keys. A value semantic type: copies are deep.
//
// Get(key, out) returns false and leaves `out` alone when the key is absent.
// When the key holds another numeric type (int32, uint32, uint16, float,
// double) the value converts if `out`'s type represents it exactly; otherwise,
// and for any other mismatch, Get raises kPropListTypeMismatchKey or
// kPropListNotRepresentableKey naming the key and the types.
class PropList {
 public:
  using Entries = std::map<std::string, PropValue, std::less<>>;
  using const_iterator = Entries::const_iterator;

  PropList() = default;
  PropList(const PropList&) = default;
  PropList(PropList&&) noexcept = default;
  PropList& operator=(const PropList&) = default;
  PropList& operator=(PropList&&) noexcept = default;
  ~PropList() = default;

  bool Get(std::string_view key, bool& out) const;
  bool Get(std::string_view key, std::int32_t& out) const;
  bool Get(std::string_view key, std::uint32_t& out) const;
  bool Get(std::string_view key, std::uint16_t& out) const;
  bool Get(std::string_view key, float& out) const;
  bool Get(std::string_view key, double& out) const;
  bool Get(std::string_view key, std::string& out) const;
  bool Get(std::string_view key, UTF16String& out) const;
  bool Get(std::string_view key, UTF16StringArray& out) const;
  bool Get(std::string_view key, PropList& out) const;

  // Each Set replaces whatever the key held.
  template <std::same_as<bool> B>
  void Set(std::string_view key, B value) {
    Put(key, PropValue(value));
  }
  void Set(std::string_view key, std::int32_t value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, std::uint32_t value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, std::uint16_t value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, float value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, double value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, std::string value) { Put(key, PropValue(std::move(value))); }
  void Set(std::string_view key, std::string_view value) {
    Put(key, PropValue(std::string(value)));
  }
  // A null pointer is an input-contract violation.
  void Set(std::string_view key, const char* value);
  void Set(std::string_view key, UTF16String value) { Put(key, PropValue(std::move(value))); }
  void Set(std::string_view key, std::u16string_view value) {
    Put(key, PropValue(UTF16String(value)));
  }
  void Set(std::string_view key, const char16_t* value);
  void Set(std::string_view key, UTF16StringArray value) { Put(key, PropValue(std::move(value))); }
  void Set(std::string_view key, const PropList& value) { Put(key, PropValue(value)); }
  void Set(std::string_view key, PropValue value) { Put(key, std::move(value)); }

  bool HasKey(std::string_view key) const { return Find(key) != nullptr; }
  std::optional<PropType> GetType(std::string_view key) const;
  const PropValue* Find(std::string_view key) const;

  // A new empty list under `key`, replacing what was there; this list owns it.
  PropList* NewSubList(std::string_view key);
  // The list under `key`, null when absent; raises when the key holds another type.
  PropList* GetSubList(std::string_view key);
  const PropList* GetSubList(std::string_view key) const;
  void SetSubList(std::string_view key, const PropList& list) { Set(key, list); }

  // Whether there was something to remove.
  bool Remove(std::string_view key);
  void Clear() { entries_.clear(); }
  std::size_t Size() const { return entries_.size(); }
  bool Empty() const { return entries_.empty(); }

  // (key, value) pairs in the byte order of the keys.
  const_iterator begin() const { return entries_.begin(); }
  const_iterator end() const { return entries_.end(); }

  friend bool operator==(const PropList& a, const PropList& b) { return a.entries_ == b.entries_; }

 private:
  void Put(std::string_view key, PropValue value);
  template <typename T>
  bool GetConverted(std::string_view key, T& out) const;
  template <typename T>
  bool GetExact(std::string_view key, T& out) const;

  Entries entries_;
};

// Rectangles and points stored as a sub-list under `key`: "left", "top",
// "width", "height" (int32 or float) and "x", "y" (float). Read returns false
// and leaves `out` alone when the key is absent; a record that is present but
// lacks an entry raises kPropListIncompleteRecordKey, a mistyped one the type
// errors of Get.
void WriteRect32(PropList& list, std::string_view key, const RectT<std::int32_t>& rect);
bool ReadRect32(const PropList& list, std::string_view key, RectT<std::int32_t>& out);
void WriteRectF32(PropList& list, std::string_view key, const RectT<float>& rect);
bool ReadRectF32(const PropList& list, std::string_view key, RectT<float>& out);
void WritePointF32(PropList& list, std::string_view key, const PointT<float>& point);
bool ReadPointF32(const PropList& list, std::string_view key, PointT<float>& out);

}  // namespace velkcore
