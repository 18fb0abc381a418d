// The modifiers held with a key: as a set of their own, and among the flags of an event.
#pragma once

#include <cstdint>

#include "Foundation/Flags.h"

namespace plume {

// The bits are those of stored hot keys.
enum class KeyModifier : std::int32_t { Shift = 1, Control = 2, Option = 4, Command = 8 };

using KeyModifiers = Flags<KeyModifier>;

constexpr KeyModifiers operator|(KeyModifier a, KeyModifier b) {
    return KeyModifiers(a) | b;
}

// What an event says about its key; the bits are those of stored key placeholders. Others, about the device and the
// place of the key, come with events and are nobody's business.
enum class EventFlag : std::uint64_t {
    CapsLock = 0x10000,
    Shift = 0x20000,
    Control = 0x40000,
    Option = 0x80000,
    Command = 0x100000,
};

using EventFlags = Flags<EventFlag>;

constexpr EventFlags operator|(EventFlag a, EventFlag b) {
    return EventFlags(a) | b;
}

// The flags of the four modifiers.
inline constexpr EventFlags ModifierFlags =
    EventFlag::Shift | EventFlag::Control | EventFlag::Option | EventFlag::Command;

constexpr KeyModifiers modifiersFromFlags(EventFlags flags) {
    return KeyModifiers::fromBits(static_cast<std::int32_t>((flags & ModifierFlags).bits() >> 17));
}

constexpr EventFlags flagsFromModifiers(KeyModifiers modifiers) {
    return EventFlags::fromBits(static_cast<std::uint64_t>(modifiers.bits()) << 17) & ModifierFlags;
}

}  // namespace plume
