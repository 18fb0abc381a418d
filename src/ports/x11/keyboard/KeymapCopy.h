// Gives keyboards the keymap of another one.
#pragma once

#include <cstdint>
#include <span>
#include <string>

namespace plume {

// Copies what the keys of one device do to the others, over a connection of its own that is gone afterwards: a few
// milliseconds. False when the server refused. Any thread, one at a time.
bool copyKeymap(const std::string& display, std::uint16_t from, std::span<const std::uint16_t> to);

}  // namespace plume
