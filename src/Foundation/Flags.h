// A set of flags whose names are an enumeration of bits.
//
// Enumerators stand for single bits or for sets of them; a value that came from outside may hold bits that nobody has
// named, and keeps them.
#pragma once

#include <type_traits>

namespace plume {

template <typename Flag>
class Flags {
  public:
    using Bits = std::underlying_type_t<Flag>;

    constexpr Flags() = default;
    constexpr Flags(Flag flag) : bits_(static_cast<Bits>(flag)) {}  // NOLINT(google-explicit-constructor)
    static constexpr Flags fromBits(Bits bits) {
        Flags flags;
        flags.bits_ = bits;
        return flags;
    }

    constexpr Bits bits() const { return bits_; }
    constexpr bool isEmpty() const { return bits_ == 0; }
    // Holds all of these.
    constexpr bool contains(Flags flags) const { return (bits_ & flags.bits_) == flags.bits_; }
    constexpr bool containsAny(Flags flags) const { return (bits_ & flags.bits_) != 0; }

    constexpr Flags& operator|=(Flags flags) { return *this = *this | flags; }
    constexpr Flags& operator-=(Flags flags) { return *this = *this - flags; }
    constexpr Flags& operator&=(Flags flags) { return *this = *this & flags; }
    friend constexpr Flags operator|(Flags a, Flags b) { return fromBits(static_cast<Bits>(a.bits_ | b.bits_)); }
    friend constexpr Flags operator&(Flags a, Flags b) { return fromBits(static_cast<Bits>(a.bits_ & b.bits_)); }
    friend constexpr Flags operator^(Flags a, Flags b) { return fromBits(static_cast<Bits>(a.bits_ ^ b.bits_)); }
    friend constexpr Flags operator-(Flags a, Flags b) { return fromBits(static_cast<Bits>(a.bits_ & ~b.bits_)); }
    friend constexpr bool operator==(Flags, Flags) = default;

  private:
    Bits bits_ = 0;
};

}  // namespace plume
