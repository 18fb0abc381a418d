// A library to measure with: 10,000 snippets of mixed content.
#pragma once

#include <cstddef>
#include <cstdlib>

#include "library/LibraryArchive.h"

namespace plume::bench {

inline constexpr std::size_t GroupCount = 100;
inline constexpr std::size_t SnippetsPerGroup = 100;
inline constexpr std::size_t SnippetCount = GroupCount * SnippetsPerGroup;

// A benchmark of something that does not work would be worth nothing.
inline void require(bool condition) {
    if (!condition) std::abort();
}

// One in `richEvery` snippets is rich, none for 0.
LibraryContents makeLibrary(std::size_t snippetsPerGroup, std::size_t richEvery);

}  // namespace plume::bench
