#include "Foundation/CharacterSet.h"

#include <unicode/uchar.h>
#include <unicode/uniset.h>

#include <algorithm>
#include <array>

namespace plume {

namespace {

constexpr char32_t LastOfBasicPlane = 0xFFFF;
constexpr char32_t LastCodePoint = 0x10FFFF;

}  // namespace

// The whole set as ICU keeps it (not frozen: copies of a frozen set cannot be changed), and its part in the basic plane
// once more as bits.
struct CharacterSet::Storage {
    explicit Storage(const icu::UnicodeSet& members) : set(members) {
        for (int32_t i = 0; i < set.getRangeCount(); ++i) {
            const auto first = static_cast<char32_t>(set.getRangeStart(i));
            const auto last = std::min(static_cast<char32_t>(set.getRangeEnd(i)), LastOfBasicPlane);
            for (char32_t c = first; c <= last; ++c) bitmap[c / 64] |= std::uint64_t{1} << (c % 64);
        }
    }

    static CharacterSet make(const icu::UnicodeSet& members) {
        return CharacterSet(std::make_shared<const Storage>(members));
    }

    // The characters of the general categories in `mask`.
    static icu::UnicodeSet ofCategories(std::uint32_t mask) {
        icu::UnicodeSet set;
        UErrorCode status = U_ZERO_ERROR;
        set.applyIntPropertyValue(UCHAR_GENERAL_CATEGORY_MASK, static_cast<int32_t>(mask), status);
        return set;
    }

    static std::shared_ptr<const Storage> empty() {
        static const auto empty = std::make_shared<const Storage>(icu::UnicodeSet());
        return empty;
    }

    icu::UnicodeSet set;
    std::array<std::uint64_t, 0x10000 / 64> bitmap{};
};

CharacterSet::CharacterSet() : CharacterSet(Storage::empty()) {}

CharacterSet::CharacterSet(std::shared_ptr<const Storage> storage)
    : storage_(std::move(storage)), bitmap_(storage_->bitmap.data()) {}

CharacterSet CharacterSet::withCharacters(std::u16string_view characters) {
    icu::UnicodeSet set;
    for (std::size_t i = 0; i < characters.size(); ++i) {
        const char16_t unit = characters[i];
        UChar32 c = unit;
        if (U16_IS_LEAD(unit) && i + 1 < characters.size() && U16_IS_TRAIL(characters[i + 1])) {
            c = U16_GET_SUPPLEMENTARY(unit, characters[i + 1]);
            ++i;
        }
        set.add(c);
    }
    return Storage::make(set);
}

CharacterSet CharacterSet::withRange(char32_t first, char32_t last) {
    last = std::min(last, LastCodePoint);
    if (first > last) return CharacterSet();
    return Storage::make(icu::UnicodeSet(static_cast<UChar32>(first), static_cast<UChar32>(last)));
}

CharacterSet CharacterSet::withRanges(const Ranges& ranges) {
    icu::UnicodeSet set;
    for (const auto& [first, last] : ranges) {
        if (first > LastCodePoint) continue;
        set.add(static_cast<UChar32>(first), static_cast<UChar32>(std::min(last, LastCodePoint)));
    }
    return Storage::make(set);
}

const CharacterSet& CharacterSet::letters() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_L_MASK | U_GC_M_MASK));
    return set;
}

const CharacterSet& CharacterSet::lowercaseLetters() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_LL_MASK));
    return set;
}

const CharacterSet& CharacterSet::uppercaseLetters() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_LU_MASK | U_GC_LT_MASK));
    return set;
}

const CharacterSet& CharacterSet::alphanumerics() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_L_MASK | U_GC_M_MASK | U_GC_N_MASK));
    return set;
}

const CharacterSet& CharacterSet::decimalDigits() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_ND_MASK));
    return set;
}

const CharacterSet& CharacterSet::whitespaces() {
    static const CharacterSet set = Storage::make(Storage::ofCategories(U_GC_ZS_MASK).add(u'\t'));
    return set;
}

const CharacterSet& CharacterSet::newlines() {
    static const CharacterSet set =
        Storage::make(icu::UnicodeSet(0x0A, 0x0D).add(UChar32{0x85}).add(UChar32{0x2028}).add(UChar32{0x2029}));
    return set;
}

const CharacterSet& CharacterSet::whitespacesAndNewlines() {
    static const CharacterSet set = whitespaces().united(newlines());
    return set;
}

bool CharacterSet::contains(char32_t codePoint) const {
    if (codePoint <= LastOfBasicPlane) return contains(static_cast<char16_t>(codePoint));
    return codePoint <= LastCodePoint && storage_->set.contains(static_cast<UChar32>(codePoint));
}

bool CharacterSet::isEmpty() const {
    return storage_->set.isEmpty();
}

CharacterSet CharacterSet::united(const CharacterSet& other) const {
    return Storage::make(icu::UnicodeSet(storage_->set).addAll(other.storage_->set));
}

CharacterSet CharacterSet::intersected(const CharacterSet& other) const {
    return Storage::make(icu::UnicodeSet(storage_->set).retainAll(other.storage_->set));
}

CharacterSet CharacterSet::subtracting(const CharacterSet& other) const {
    return Storage::make(icu::UnicodeSet(storage_->set).removeAll(other.storage_->set));
}

CharacterSet CharacterSet::inverted() const {
    return Storage::make(icu::UnicodeSet(storage_->set).complement());
}

std::u16string CharacterSet::characters() const {
    std::u16string result;
    const icu::UnicodeSet& set = storage_->set;
    for (int32_t i = 0; i < set.getRangeCount(); ++i) {
        for (UChar32 c = set.getRangeStart(i); c <= set.getRangeEnd(i); ++c) {
            if (U_IS_BMP(c)) {
                result += static_cast<char16_t>(c);
            } else {
                result += static_cast<char16_t>(U16_LEAD(c));
                result += static_cast<char16_t>(U16_TRAIL(c));
            }
        }
    }
    return result;
}

CharacterSet::Ranges CharacterSet::ranges() const {
    const icu::UnicodeSet& set = storage_->set;
    Ranges ranges;
    for (int32_t i = 0; i < set.getRangeCount(); ++i) {
        ranges.emplace_back(set.getRangeStart(i), set.getRangeEnd(i));
    }
    return ranges;
}

bool CharacterSet::operator==(const CharacterSet& other) const {
    return storage_ == other.storage_ || storage_->set == other.storage_->set;
}

}  // namespace plume
