// What one key produces, kept without allocating.
#pragma once

#include <xcb/xcb.h>
#include <xkbcommon/xkbcommon.h>

#include <array>
#include <cstddef>
#include <string_view>

namespace plume {

class KeyText {
  public:
    std::u16string_view view() const { return {units_.data(), length_}; }
    void clear() { length_ = 0; }

    // What the key types in this state. With Alt held a program takes a key for a command: then nothing that prints.
    void assignKey(xkb_state& state, xcb_keycode_t keycode, bool alt);
    // UTF-8, cut off where it is longer than a key's text may be.
    void assign(std::string_view utf8);

  private:
    void append(char32_t character);

    std::array<char16_t, 10> units_{};
    std::size_t length_ = 0;
};

}  // namespace plume
