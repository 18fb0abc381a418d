// What the readers of property lists and archives allow at most.
#pragma once

#include <algorithm>
#include <cstddef>

namespace plume {

// How deep values may stand in each other.
constexpr std::size_t DeepestPropertyList = 128;

// How many bytes of values may be made of this many bytes of a file. What a file says once and refers to often counts
// each time.
constexpr std::size_t mostBytesMadeOf(std::size_t size) {
    constexpr std::size_t Least = std::size_t{16} << 20;
    constexpr std::size_t Most = std::size_t{1} << 30;
    constexpr std::size_t PerByte = 128;
    return size >= Most / PerByte ? Most : std::min(Most, Least + size * PerByte);
}

}  // namespace plume
