// The hash of abbreviations: one that grows to the left, so that the hashes of all suffixes of what was typed come from
// one walk over its end.
#pragma once

#include <cstdint>
#include <string_view>

namespace plume {

// The hash of the empty text.
inline constexpr std::uint64_t EmptySuffixHash = 0xcbf29ce484222325ULL;

// The hash of a suffix with one more unit in front of it. Units are case-folded by the caller.
constexpr std::uint64_t extendSuffixHash(std::uint64_t hash, char16_t foldedUnit) {
    return (hash ^ foldedUnit) * 0x9e3779b97f4a7c15ULL;
}

// The hash of a text regardless of its case: folded, then extended from its end to its start.
std::uint64_t hashOfSuffix(std::u16string_view text);

}  // namespace plume
