#include "Foundation/archive/ArchivedCharacterSets.h"

#include <unicode/uniset.h>

#include <array>
#include <utility>

namespace plume {

namespace {

constexpr std::size_t PlaneSize = 0x10000;
constexpr std::size_t PlaneBytes = PlaneSize / 8;
constexpr std::size_t PlaneCount = 17;
constexpr std::size_t MostWrittenAsText = 256;

// By their numbers, from 1; those of no standard set of CharacterSet as patterns.
constexpr std::array<const char16_t*, 15> BuiltinPatterns = {
    u"[[:Cc:][:Cf:]]",  nullptr, nullptr,  nullptr,   nullptr,   nullptr,  nullptr, u"[:M:]",
    u"[:^NFD_QC=Yes:]", nullptr, u"[:P:]", u"[:Cn:]", u"[:Lt:]", u"[:S:]", nullptr};

CharacterSet setOfPattern(const char16_t* pattern) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::UnicodeSet set(icu::UnicodeString(pattern), status);
    CharacterSet::Ranges ranges;
    for (int32_t i = 0; U_SUCCESS(status) != 0 && i < set.getRangeCount(); ++i) {
        ranges.emplace_back(set.getRangeStart(i), set.getRangeEnd(i));
    }
    return CharacterSet::withRanges(ranges);
}

void appendRanges(CharacterSet::Ranges& ranges, char32_t start, std::string_view bits) {
    for (std::size_t i = 0; i < bits.size(); ++i) {
        const auto byte = static_cast<unsigned char>(bits[i]);
        for (unsigned bit = 0; byte >> bit != 0; ++bit) {
            if ((byte >> bit & 1U) == 0) continue;
            const auto c = static_cast<char32_t>(start + i * 8 + bit);
            if (!ranges.empty() && ranges.back().second + 1 == c) {
                ranges.back().second = c;
            } else {
                ranges.emplace_back(c, c);
            }
        }
    }
}

}  // namespace

std::string bitmapOfCharacterSet(const CharacterSet& set) {
    std::array<std::string, PlaneCount> planes;
    planes[0].assign(PlaneBytes, '\0');
    for (const auto& [first, last] : set.ranges()) {
        for (char32_t c = first; c <= last; ++c) {
            std::string& plane = planes[c / PlaneSize];
            if (plane.empty()) plane.assign(PlaneBytes, '\0');
            char& byte = plane[c % PlaneSize / 8];
            byte = static_cast<char>(static_cast<unsigned char>(byte) | 1U << (c & 7));
        }
    }
    std::string bitmap = std::move(planes[0]);
    for (std::size_t number = 1; number < PlaneCount; ++number) {
        if (planes[number].empty()) continue;
        bitmap.push_back(static_cast<char>(number));
        bitmap += planes[number];
    }
    return bitmap;
}

CharacterSet characterSetFromBitmap(std::string_view bitmap) {
    CharacterSet::Ranges ranges;
    appendRanges(ranges, 0, bitmap.substr(0, PlaneBytes));
    std::size_t position = PlaneBytes;
    for (std::size_t i = 1; i < PlaneCount && position < bitmap.size(); ++i) {
        const auto number = static_cast<unsigned char>(bitmap[position]);
        if (number >= 1 && number < PlaneCount) {
            appendRanges(ranges, static_cast<char32_t>(number * PlaneSize), bitmap.substr(position + 1, PlaneBytes));
        }
        position += 1 + PlaneBytes;
    }
    return CharacterSet::withRanges(ranges);
}

std::optional<CharacterSet> builtinCharacterSet(std::int64_t number) {
    switch (number) {
        case 2:
            return CharacterSet::whitespaces();
        case 3:
            return CharacterSet::whitespacesAndNewlines();
        case 4:
            return CharacterSet::decimalDigits();
        case 5:
            return CharacterSet::letters();
        case 6:
            return CharacterSet::lowercaseLetters();
        case 7:
            return CharacterSet::uppercaseLetters();
        case 10:
            return CharacterSet::alphanumerics();
        case 15:
            return CharacterSet::newlines();
        default:
            break;
    }
    if (number < 1 || number > static_cast<std::int64_t>(BuiltinPatterns.size())) return std::nullopt;
    return setOfPattern(BuiltinPatterns[static_cast<std::size_t>(number) - 1]);
}

std::optional<std::u16string> shortTextOfCharacterSet(const CharacterSet& set) {
    std::size_t count = 0;
    for (const auto& [first, last] : set.ranges()) {
        count += last - first + 1;
        // Unpaired surrogates next to each other would be read as another character.
        const bool holdsSurrogates = first <= 0xDFFF && last >= 0xD800;
        if (count > MostWrittenAsText || holdsSurrogates) return std::nullopt;
    }
    return set.characters();
}

}  // namespace plume
