// The suggestion list as it is seen: what its window shows, and what the user does with the pointer there.
//
// Owned by whoever makes the windows; everything belongs to the main thread, the events too. The window takes neither
// the focus nor the keyboard: which entry is selected and which are in sight comes from outside with each page.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "app/CaretPlace.h"

namespace plume {

struct SuggestionRow {
    std::u16string abbreviation;  // with its prefix
    std::size_t typedLength = 0;  // units of it that stand in the text already
    std::u16string label;
    std::u16string content;  // its beginning, in one line
    char16_t digit = u'\0';  // picks it; U+0000: none does

    bool operator==(const SuggestionRow&) const = default;
};

// The entries in sight.
struct SuggestionPage {
    std::uint64_t number = 0;  // tells pages apart: a click concerns the page that was seen
    std::vector<SuggestionRow> rows;
    std::size_t first = 0;     // place of the first row in the list
    std::size_t total = 0;     // of the whole list
    std::size_t selected = 0;  // place in the list; need not be in sight
    // What is held to pick with a digit: see SuggestionController.
    std::int64_t selectorKeyModifier = 0;

    // It looks the same.
    bool isSameAs(const SuggestionPage& other) const {
        return rows == other.rows && first == other.first && total == other.total && selected == other.selected &&
               selectorKeyModifier == other.selectorKeyModifier;
    }
};

class SuggestionView {
  public:
    struct Events {
        // An entry of the page of that number, by its place in the list.
        std::function<void(std::uint64_t page, std::size_t index)> clicked;
        // Towards the end of the list, or its beginning when negative.
        std::function<void(int rows)> scrolled;
        // Where the window stands now, in the pixels in which clicks are reported.
        std::function<void(const Rectangle& frame)> placed;
    };

    virtual ~SuggestionView() = default;
    virtual void setEvents(Events events) = 0;
    virtual void show(const SuggestionPage& page, const CaretPlace& place) = 0;
    // Where it stands; does nothing while it is hidden.
    virtual void update(const SuggestionPage& page) = 0;
    virtual void hide() = 0;
};

}  // namespace plume
