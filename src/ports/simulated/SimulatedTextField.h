// A plain text field with a caret and a selection. Positions are UTF-16 units; deleting and moving take whole
// characters as a person sees them.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "Foundation/Strings.h"

namespace plume {

class SimulatedTextField {
  public:
    enum class Movement { Left, Right, Up, Down, LineStart, LineEnd };

    const std::u16string& text() const { return text_; }
    // The end of the selection that moves.
    std::size_t caret() const { return caret_; }
    Range selection() const;
    std::u16string selectedText() const;

    // With the caret at its end.
    void setText(std::u16string text);
    // Beyond the text is its end. The caret is the end of the range.
    void select(Range range);

    // In place of the selection.
    void insert(std::u16string_view text);
    // The selection, or else one character.
    void deleteBackward();
    void deleteForward();
    // Without `extending` a selection collapses: to its near end by Left and Right, and the others start from there.
    void move(Movement movement, bool extending);

  private:
    std::size_t target(Movement movement, std::size_t from) const;
    std::size_t previousCharacter(std::size_t from) const;
    std::size_t nextCharacter(std::size_t from) const;
    std::size_t lineStart(std::size_t from) const;
    std::size_t lineEnd(std::size_t from) const;

    std::u16string text_;
    std::size_t caret_ = 0;
    std::size_t anchor_ = 0;  // the end of the selection that stays
};

}  // namespace plume
