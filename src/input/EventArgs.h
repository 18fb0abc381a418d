// The arguments of the input service's events. A listener swallows a key by setting `cancel`.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "input/GeneralHotKey.h"

namespace plume {

struct ZDCancelEventArgs {
    bool cancel = false;
};

struct ZDKeyEventArgs : ZDCancelEventArgs {
    KeyCode key = KeyCode::None;
    char16_t c = 0;                   // first unit of `s`; 0 when there is none
    std::optional<std::u16string> s;  // what the key produces
    // The program has it already: a text, which may be a long one, or a key without one. It cannot be swallowed.
    bool delivered = false;
    // More text is being composed behind what was delivered.
    bool composing = false;
};

struct ZDMouseEventArgs : ZDCancelEventArgs {
    double x = 0;
    double y = 0;
};

struct ZDHotKeysPressedEventArgs : ZDCancelEventArgs {
    std::vector<GeneralHotKey> hotKeys;
};

struct ZDUnregisteredHotKeyPressedEventArgs : ZDKeyEventArgs {
    GeneralHotKey hotKey;
};

}  // namespace plume
