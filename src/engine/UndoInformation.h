// What the last expansion did, as far as taking it back needs to know.
#pragma once

#include <cstdint>
#include <string>

namespace plume {

struct UndoInformation {
    std::uint64_t backspaceCount = 0;  // erases the expansion
    std::u16string text;               // what was typed, without the key that triggered the expansion
    std::u16string textWithTrigger;    // the same with that key
};

}  // namespace plume
