#include <velkcore/PropList.h>

#include <bit>
#include <charconv>
#include <cmath>
#include <limits>
#include <utility>

#include <velkcore/Error.h>

namespace velkcore {
namespace {

template <typename T>
constexpr PropType TypeOf() {
  if constexpr (std::is_same_v<T, bool>) return PropType::kBool;
  if constexpr (std::is_same_v<T, std::int32_t>) return PropType::kInt32;
  if constexpr (std::is_same_v<T, std::uint32_t>) return PropType::kUInt32;
  if constexpr (std::is_same_v<T, std::uint16_t>) return PropType::kUInt16;
  if constexpr (std::is_same_v<T, float>) return PropType::kFloat;
  if constexpr (std::is_same_v<T, double>) return PropType::kDouble;
  if constexpr (std::is_same_v<T, std::string>) return PropType::kString;
  if constexpr (std::is_same_v<T, UTF16String>) return PropType::kUString;
  if constexpr (std::is_same_v<T, UTF16StringArray>) return PropType::kUStringArray;
  if constexpr (std::is_same_v<T, PropList>) return PropType::kList;
}

[[noreturn]] void ThrowTypeMismatch(std::string_view key, PropType held, PropType wanted) {
  ThrowError(ErrorLevel::kError, kPropListTypeMismatchKey, kCategoryUtilities,
             kPropListTypeMismatchNumber, 0, key, PropTypeName(held), PropTypeName(wanted));
}

template <typename From>
std::string NumberText(From value) {
  char buffer[64];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
  return std::string(buffer, result.ptr);
}

// Converts `value` to To when To holds exactly the same number.
template <typename To, typename From>
std::optional<To> ExactlyAs(From value) {
  if constexpr (std::is_same_v<To, From>) {
    return value;
  } else if constexpr (std::is_integral_v<From> && std::is_integral_v<To>) {
    if (!std::in_range<To>(value)) return std::nullopt;
    return static_cast<To>(value);
  } else if constexpr (std::is_integral_v<From>) {
    // Every 32-bit integer is exact in a double, so the double can judge the float.
    const To converted = static_cast<To>(value);
    if (static_cast<double>(converted) != static_cast<double>(value)) return std::nullopt;
    return converted;
  } else if constexpr (std::is_integral_v<To>) {
    const double v = value;
    if (!std::isfinite(v) || std::trunc(v) != v) return std::nullopt;
    if (v < static_cast<double>(std::numeric_limits<To>::min()) ||
        v > static_cast<double>(std::numeric_limits<To>::max())) {
      return std::nullopt;
    }
    return static_cast<To>(v);
  } else if constexpr (std::is_same_v<To, double>) {
    return static_cast<double>(value);
  } else {
    // double to float: NaN stays NaN, infinities stay, finite values only when no bit is lost.
    if (std::isnan(value)) {
      const float nan = std::numeric_limits<float>::quiet_NaN();
      return std::signbit(value) ? -nan : nan;
    }
    if (std::isfinite(value) && std::fabs(value) > std::numeric_limits<float>::max()) {
      return std::nullopt;
    }
    const float converted = static_cast<float>(value);
    if (static_cast<double>(converted) != value) return std::nullopt;
    return converted;
  }
}

template <typename To, typename From>
To ConvertFrom(std::string_view key, From held) {
  if (const auto converted = ExactlyAs<To>(held)) return *converted;
  ThrowError(ErrorLevel::kError, kPropListNotRepresentableKey, kCategoryUtilities,
             kPropListNotRepresentableNumber, 0, key, PropTypeName(TypeOf<From>()),
             PropTypeName(TypeOf<To>()), NumberText(held));
}

template <typename To>
To ConvertNumber(std::string_view key, const PropValue& value) {
  switch (value.GetType()) {
    case PropType::kInt32:
      return ConvertFrom<To>(key, *value.GetIf<std::int32_t>());
    case PropType::kUInt32:
      return ConvertFrom<To>(key, *value.GetIf<std::uint32_t>());
    case PropType::kUInt16:
      return ConvertFrom<To>(key, *value.GetIf<std::uint16_t>());
    case PropType::kFloat:
      return ConvertFrom<To>(key, *value.GetIf<float>());
    case PropType::kDouble:
      return ConvertFrom<To>(key, *value.GetIf<double>());
    default:
      ThrowTypeMismatch(key, value.GetType(), TypeOf<To>());
  }
}

template <typename F>
bool SameBits(F a, F b) {
  using Bits = std::conditional_t<sizeof(F) == 4, std::uint32_t, std::uint64_t>;
  return std::bit_cast<Bits>(a) == std::bit_cast<Bits>(b);
}

}  // namespace

std::string_view PropTypeName(PropType type) {
  switch (type) {
    case PropType::kBool:
      return "bool";
    case PropType::kInt32:
      return "int32";
    case PropType::kUInt32:
      return "uint32";
    case PropType::kUInt16:
      return "uint16";
    case PropType::kFloat:
      return "float";
    case PropType::kDouble:
      return "double";
    case PropType::kString:
      return "string";
    case PropType::kUString:
      return "ustring";
    case PropType::kUStringArray:
      return "ustring array";
    case PropType::kList:
      return "property list";
  }
  return "unknown";
}

// ---- PropValue ----

PropValue::PropValue(const PropList& list) : value_(std::make_unique<PropList>(list)) {}
PropValue::PropValue(PropList&& list) : value_(std::make_unique<PropList>(std::move(list))) {}

PropValue::PropValue(const PropValue& other)
    : value_(std::visit(
          [](const auto& held) -> decltype(value_) {
            using Held = std::decay_t<decltype(held)>;
            if constexpr (std::is_same_v<Held, std::unique_ptr<PropList>>) {
              return std::make_unique<PropList>(*held);
            } else {
              return held;
            }
          },
          other.value_)) {}

PropValue::PropValue(PropValue&& other) noexcept = default;

PropValue& PropValue::operator=(const PropValue& other) {
  if (this != &other) *this = PropValue(other);
  return *this;
}

PropValue& PropValue::operator=(PropValue&& other) noexcept = default;
PropValue::~PropValue() = default;

bool operator==(const PropValue& a, const PropValue& b) {
  if (a.value_.index() != b.value_.index()) return false;
  return std::visit(
      [&](const auto& held) {
        using Held = std::decay_t<decltype(held)>;
        const Held& other = std::get<Held>(b.value_);
        if constexpr (std::is_floating_point_v<Held>) {
          return SameBits(held, other);
        } else if constexpr (std::is_same_v<Held, std::unique_ptr<PropList>>) {
          return *held == *other;
        } else {
          return held == other;
        }
      },
      a.value_);
}

// ---- PropList ----

void PropList::Put(std::string_view key, PropValue value) {
  const auto found = entries_.find(key);
  if (found != entries_.end()) {
    found->second = std::move(value);
  } else {
    entries_.emplace(std::string(key), std::move(value));
  }
}

void PropList::Set(std::string_view key, const char* value) {
  RequireInput(value != nullptr);
  Put(key, PropValue(std::string(value)));
}

void PropList::Set(std::string_view key, const char16_t* value) {
  RequireInput(value != nullptr);
  Put(key, PropValue(UTF16String(value)));
}

const PropValue* PropList::Find(std::string_view key) const {
  const auto found = entries_.find(key);
  return found == entries_.end() ? nullptr : &found->second;
}

std::optional<PropType> PropList::GetType(std::string_view key) const {
  const PropValue* value = Find(key);
  if (value == nullptr) return std::nullopt;
  return value->GetType();
}

template <typename T>
bool PropList::GetConverted(std::string_view key, T& out) const {
  const PropValue* value = Find(key);
  if (value == nullptr) return false;
  if (const T* exact = value->GetIf<T>()) {
    out = *exact;
  } else {
    out = ConvertNumber<T>(key, *value);
  }
  return true;
}

template <typename T>
bool PropList::GetExact(std::string_view key, T& out) const {
  const PropValue* value = Find(key);
  if (value == nullptr) return false;
  const T* exact = value->GetIf<T>();
  if (exact == nullptr) ThrowTypeMismatch(key, value->GetType(), TypeOf<T>());
  out = *exact;
  return true;
}

bool PropList::Get(std::string_view key, bool& out) const {
  return GetExact(key, out);
}
bool PropList::Get(std::string_view key, std::int32_t& out) const {
  return GetConverted(key, out);
}
bool PropList::Get(std::string_view key, std::uint32_t& out) const {
  return GetConverted(key, out);
}
bool PropList::Get(std::string_view key, std::uint16_t& out) const {
  return GetConverted(key, out);
}
bool PropList::Get(std::string_view key, float& out) const {
  return GetConverted(key, out);
}
bool PropList::Get(std::string_view key, double& out) const {
  return GetConverted(key, out);
}
bool PropList::Get(std::string_view key, std::string& out) const {
  return GetExact(key, out);
}
bool PropList::Get(std::string_view key, UTF16String& out) const {
  return GetExact(key, out);
}
bool PropList::Get(std::string_view key, UTF16StringArray& out) const {
  return GetExact(key, out);
}
bool PropList::Get(std::string_view key, PropList& out) const {
  const PropList* list = GetSubList(key);
  if (list == nullptr) return false;
  if (list != &out) out = PropList(*list);
  return true;
}

PropList* PropList::NewSubList(std::string_view key) {
  Put(key, PropValue(PropList()));
  return GetSubList(key);
}

PropList* PropList::GetSubList(std::string_view key) {
  return const_cast<PropList*>(std::as_const(*this).GetSubList(key));
}

const PropList* PropList::GetSubList(std::string_view key) const {
  const PropValue* value = Find(key);
  if (value == nullptr) return nullptr;
  const PropList* list = value->GetIf<PropList>();
  if (list == nullptr) ThrowTypeMismatch(key, value->GetType(), PropType::kList);
  return list;
}

bool PropList::Remove(std::string_view key) {
  const auto found = entries_.find(key);
  if (found == entries_.end()) return false;
  entries_.erase(found);
  return true;
}

// ---- rectangles and points ----

namespace {

template <typename T>
void ReadRecordEntry(const PropList& record, std::string_view recordKey, std::string_view entry,
                     T& out) {
  if (!record.Get(entry, out)) {
    ThrowError(ErrorLevel::kError, kPropListIncompleteRecordKey, kCategoryUtilities,
               kPropListIncompleteRecordNumber, 0, recordKey, entry);
  }
}

template <typename T>
void WriteRect(PropList& list, std::string_view key, const RectT<T>& rect) {
  PropList record;
  record.Set("left", rect.left);
  record.Set("top", rect.top);
  record.Set("width", rect.width);
  record.Set("height", rect.height);
  list.SetSubList(key, record);
}

template <typename T>
bool ReadRect(const PropList& list, std::string_view key, RectT<T>& out) {
  const PropList* record = list.GetSubList(key);
  if (record == nullptr) return false;
  RectT<T> rect;
  ReadRecordEntry(*record, key, "left", rect.left);
  ReadRecordEntry(*record, key, "top", rect.top);
  ReadRecordEntry(*record, key, "width", rect.width);
  ReadRecordEntry(*record, key, "height", rect.height);
  out = rect;
  return true;
}

}  // namespace

void WriteRect32(PropList& list, std::string_view key, const RectT<std::int32_t>& rect) {
  WriteRect(list, key, rect);
}

bool ReadRect32(const PropList& list, std::string_view key, RectT<std::int32_t>& out) {
  return ReadRect(list, key, out);
}

void WriteRectF32(PropList& list, std::string_view key, const RectT<float>& rect) {
  WriteRect(list, key, rect);
}

bool ReadRectF32(const PropList& list, std::string_view key, RectT<float>& out) {
  return ReadRect(list, key, out);
}

void WritePointF32(PropList& list, std::string_view key, const PointT<float>& point) {
  PropList record;
  record.Set("x", point.x);
  record.Set("y", point.y);
  list.SetSubList(key, record);
}

bool ReadPointF32(const PropList& list, std::string_view key, PointT<float>& out) {
  const PropList* record = list.GetSubList(key);
  if (record == nullptr) return false;
  PointT<float> point;
  ReadRecordEntry(*record, key, "x", point.x);
  ReadRecordEntry(*record, key, "y", point.y);
  out = point;
  return true;
}

}  // namespace velkcore
