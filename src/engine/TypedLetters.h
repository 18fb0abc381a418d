// What the user typed since the last reset: the buffer in which abbreviations are looked for.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace plume {

// Owned by the engine; belongs to the thread that delivers the key events.
class TypedLetters {
  public:
    const std::u16string& text() const { return text_; }
    void reserve(std::size_t length) { text_.reserve(length); }
    void append(std::u16string_view typed) { text_ += typed; }
    // For letters that were taken in and turned out to be an abbreviation's.
    void shrink(std::size_t length) { text_.resize(length); }

    // What stands before the caret is something else from now on; nothing, as a rule.
    void reset(std::u16string_view text = {}) {
        text_ = text;
        ++resets_;
    }
    // By the user, who may go on to what stood before all that is known.
    void eraseLast() {
        if (text_.empty()) return reset();
        text_.pop_back();
    }

    // Tells one buffer from the next.
    std::uint64_t resets() const { return resets_; }
    // All that was typed since that reset, with nothing but Backspace between; nothing when that is not known.
    std::optional<std::u16string_view> typedSince(std::uint64_t reset) const {
        return reset == resets_ ? std::optional<std::u16string_view>(text_) : std::nullopt;
    }

  private:
    std::u16string text_;
    std::uint64_t resets_ = 0;
};

}  // namespace plume
