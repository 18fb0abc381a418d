// How programs are told to paste and to copy: terminals give Control+V and Control+C to what runs in them.
//
// Identifiers are those of the process manager: a desktop file's name, or a window class. Any thread.
#pragma once

#include <string_view>

namespace plume {

enum class PasteStyle {
    Control,       // Control+V and Control+C
    ControlShift,  // Control+Shift+V and Control+Shift+C
    ShiftInsert,   // Shift+Insert, which pastes the PRIMARY selection; nothing copies
};

PasteStyle pasteStyleOf(std::u16string_view identifier);

// Whether a paste there reads the PRIMARY selection in place of CLIPBOARD.
bool pastesPrimary(std::u16string_view identifier);

}  // namespace plume
