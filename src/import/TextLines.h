// Walks the lines of a text.
#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace plume {

// Lines end in LF, CR or both; the last one need not end.
class TextLines {
  public:
    explicit TextLines(std::u16string_view text) : rest_(text) {}

    // The next line without its end; nothing behind the last one.
    std::optional<std::u16string_view> next();
    // The next line, which next() will give; nothing behind the last one.
    std::optional<std::u16string_view> peek() const;
    // The number, from 1, of the line that next() gave last.
    std::size_t number() const { return number_; }

  private:
    std::u16string_view rest_;
    std::size_t number_ = 0;
};

}  // namespace plume
