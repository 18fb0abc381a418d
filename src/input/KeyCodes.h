// Virtual key codes and modifier sets as Plume uses them: those of a US Apple keyboard, whatever the real one is.
#pragma once

#include <cstdint>

namespace plume {

namespace KeyCode {
inline constexpr std::uint16_t Return = 36;
inline constexpr std::uint16_t Tab = 48;
inline constexpr std::uint16_t Space = 49;
inline constexpr std::uint16_t Delete = 51;
inline constexpr std::uint16_t Escape = 53;
inline constexpr std::uint16_t KeypadEnter = 76;
inline constexpr std::uint16_t Home = 115;
inline constexpr std::uint16_t PageUp = 116;
inline constexpr std::uint16_t ForwardDelete = 117;
inline constexpr std::uint16_t End = 119;
inline constexpr std::uint16_t PageDown = 121;
inline constexpr std::uint16_t Left = 123;
inline constexpr std::uint16_t Right = 124;
inline constexpr std::uint16_t Down = 125;
inline constexpr std::uint16_t Up = 126;
inline constexpr std::uint16_t None = 65535;
}  // namespace KeyCode

// A set of held modifiers, as inside the program.
namespace KeyModifier {
inline constexpr std::int32_t Shift = 1;
inline constexpr std::int32_t Control = 2;
inline constexpr std::int32_t Option = 4;
inline constexpr std::int32_t Command = 8;
}  // namespace KeyModifier

// The same modifiers as bits of an event's flags.
namespace EventFlag {
inline constexpr std::uint64_t Shift = 0x20000;
inline constexpr std::uint64_t Control = 0x40000;
inline constexpr std::uint64_t Option = 0x80000;
inline constexpr std::uint64_t Command = 0x100000;
}  // namespace EventFlag

constexpr std::int32_t modifiersFromFlags(std::uint64_t flags) {
    return static_cast<std::int32_t>((flags >> 17) & 15);
}

}  // namespace plume
