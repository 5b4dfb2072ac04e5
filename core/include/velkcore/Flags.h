#pragma once

#include <type_traits>

namespace velkcore {

// A small typed bit set: modifier keys, control state, node state.
template <typename T>
class Flags {
  static_assert(std::is_unsigned_v<T>, "Flags holds an unsigned bit pattern");

 public:
  using value_type = T;

  constexpr Flags() = default;
  constexpr Flags(T bits) : bits_(bits) {}  // NOLINT: implicit on purpose, flags read like numbers

  constexpr T Get() const { return bits_; }
  constexpr void Set(T bits) { bits_ = static_cast<T>(bits_ | bits); }
  constexpr void Set(T bits, bool on) { on ? Set(bits) : Clear(bits); }
  constexpr void Clear(T bits) { bits_ = static_cast<T>(bits_ & ~bits); }
  constexpr void ClearAll() { bits_ = 0; }
  constexpr void Assign(T bits) { bits_ = bits; }
  // True when every bit of `bits` is set.
  constexpr bool IsSet(T bits) const { return (bits_ & bits) == bits; }
  constexpr bool IsAnySet(T bits) const { return (bits_ & bits) != 0; }
  constexpr bool IsEmpty() const { return bits_ == 0; }

  constexpr Flags operator|(Flags o) const { return static_cast<T>(bits_ | o.bits_); }
  constexpr Flags operator&(Flags o) const { return static_cast<T>(bits_ & o.bits_); }
  constexpr Flags operator^(Flags o) const { return static_cast<T>(bits_ ^ o.bits_); }
  constexpr Flags operator~() const { return static_cast<T>(~bits_); }
  constexpr Flags& operator|=(Flags o) { bits_ = static_cast<T>(bits_ | o.bits_); return *this; }
  constexpr Flags& operator&=(Flags o) { bits_ = static_cast<T>(bits_ & o.bits_); return *this; }
  constexpr Flags& operator^=(Flags o) { bits_ = static_cast<T>(bits_ ^ o.bits_); return *this; }

  friend constexpr bool operator==(Flags, Flags) = default;

 private:
  T bits_ = 0;
};

}  // namespace velkcore
