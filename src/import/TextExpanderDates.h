// The dates and times of TextExpander: codes such as "%B %e, %Y", and "%@+1D", which shifts those behind it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace plume {

class TextExpanderDates {
  public:
    // A stretch of codes, and the placeholder that says the same. A length of 0: the text starts with none.
    struct Codes {
        std::size_t length = 0;
        std::u16string body;
    };

    // How long the shift is that the text starts with; it holds from now on, besides earlier ones. 0: none.
    std::size_t takeShift(std::u16string_view text);
    // The codes that the text starts with. `joined`: further ones, and the punctuation between them, go into the same
    // placeholder as far as they can.
    Codes codesIn(std::u16string_view text, bool joined) const;
    // A placeholder in this format, shifted.
    std::u16string dateBody(std::u16string_view format) const;
    std::u16string timeBody(std::u16string_view format) const;
    // Hours were added, which a date here does not follow over midnight.
    bool hasTimeShift() const { return hour_ != 0 || minute_ != 0 || second_ != 0; }

  private:
    std::int64_t year_ = 0;
    std::int64_t month_ = 0;
    std::int64_t day_ = 0;
    std::int64_t hour_ = 0;
    std::int64_t minute_ = 0;
    std::int64_t second_ = 0;
};

}  // namespace plume
