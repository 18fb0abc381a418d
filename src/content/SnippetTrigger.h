// Why an output is made.
#pragma once

#include <cstdint>

#include "Foundation/Flags.h"

namespace plume {

enum class SnippetTrigger : std::uint32_t {
    Direct = 1,
    Typed = 2,
    Suggestion = 4,
    Digit = 8,
    FromSeveralMatches = 16,
    ScriptResult = 32,
    HotKey = 64,
};

using SnippetTriggers = Flags<SnippetTrigger>;

constexpr SnippetTriggers operator|(SnippetTrigger a, SnippetTrigger b) {
    return SnippetTriggers(a) | b;
}

}  // namespace plume
