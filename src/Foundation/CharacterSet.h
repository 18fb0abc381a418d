// An immutable set of characters with set algebra; copies share their storage.
//
// Membership of a UTF-16 unit is one look-up in a bitmap of the basic plane, fit for the road of a keystroke;
// characters beyond it are kept too. May be used from any thread.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace plume {

class CharacterSet {
  public:
    // The empty set.
    CharacterSet();
    // Moving copies: a set that was moved from must not be left with a bitmap that is gone.
    CharacterSet(const CharacterSet&) = default;
    CharacterSet& operator=(const CharacterSet&) = default;
    ~CharacterSet() = default;

    static CharacterSet withCharacters(std::u16string_view characters);
    // All code points from first to last, both included.
    static CharacterSet withRange(char32_t first, char32_t last);
    // First and last code points, both included.
    using Ranges = std::vector<std::pair<char32_t, char32_t>>;
    // Fastest in ascending order.
    static CharacterSet withRanges(const Ranges& ranges);

    // The platform's standard sets. Letters are L* and M*, lower case Ll, upper case Lu and Lt, alphanumerics L*, M*
    // and N*, decimal digits Nd, white space Zs and tab, newlines U+000A to U+000D, U+0085, U+2028 and U+2029.
    static const CharacterSet& letters();
    static const CharacterSet& lowercaseLetters();
    static const CharacterSet& uppercaseLetters();
    static const CharacterSet& alphanumerics();
    static const CharacterSet& decimalDigits();
    static const CharacterSet& whitespaces();
    static const CharacterSet& newlines();
    static const CharacterSet& whitespacesAndNewlines();

    // O(1). A surrogate unit is a member only when it was put in as such; the inverse of a set holds those that it does
    // not.
    bool contains(char16_t unit) const { return ((bitmap_[unit >> 6] >> (unit & 63)) & 1) != 0; }
    bool contains(char32_t codePoint) const;
    bool isEmpty() const;

    CharacterSet united(const CharacterSet& other) const;
    CharacterSet intersected(const CharacterSet& other) const;
    CharacterSet subtracting(const CharacterSet& other) const;
    CharacterSet inverted() const;

    // Every member as text, in code-point order. Meant for the small sets a user writes, not for `letters()`.
    std::u16string characters() const;
    // In ascending order, apart from each other.
    Ranges ranges() const;

    bool operator==(const CharacterSet& other) const;

  private:
    struct Storage;
    explicit CharacterSet(std::shared_ptr<const Storage> storage);
    std::shared_ptr<const Storage> storage_;
    const std::uint64_t* bitmap_;  // the storage's: one bit a unit
};

}  // namespace plume
