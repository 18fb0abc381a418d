#pragma once

#include <functional>
#include <string>
#include <vector>

namespace plume::target {

// What a terminal's program makes of the bytes it reads: a text with an insertion point, edited by the usual keys. It
// knows Backspace, Delete, Home, End, the arrows to the left and right, and bracketed pastes; it ignores other control
// sequences.
class TerminalLine {
  public:
    struct Listener {
        std::function<void(int position, int removed, const std::string& inserted)> changed;
        std::function<void()> pasted;
    };

    explicit TerminalLine(Listener listener) : listener_(std::move(listener)) {}

    void read(const std::string& bytes);

    std::string text() const;
    int length() const { return static_cast<int>(characters_.size()); }
    bool isAtEnd() const { return caret_ == characters_.size(); }
    void setText(const std::string& text);

  private:
    // Takes one character or control sequence off the front of the bytes not understood yet; false: more is needed.
    bool takeOne();
    bool takeSequence();
    bool takeCharacter();
    void perform(const std::string& sequence);
    void insert(const std::string& text);
    void remove(std::size_t from);
    void flush();

    Listener listener_;
    std::vector<std::string> characters_;
    std::size_t caret_ = 0;
    std::string unread_;
    std::string run_;  // characters inserted one after the other, told as one change
};

std::vector<std::string> splitCharacters(const std::string& text);

}  // namespace plume::target
