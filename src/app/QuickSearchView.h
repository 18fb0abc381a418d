// The quick-search window, as the thread that hears the keys drives it.
//
// Owned by whoever makes the windows; everything belongs to the main thread, the events too. The window takes the
// keyboard, which the other side gives back before anything is sent.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/CaretPlace.h"

namespace plume {

struct QuickSearchOpening {
    // Nothing: at the top right corner of the screen.
    std::optional<CaretPlace> place;
    // What is searched for at first.
    std::u16string query;
    // What is held to pick with a digit: see QuickSearchController.
    std::int64_t selectorKeyModifier = 0;
};

class QuickSearchView {
  public:
    struct Events {
        // It stands there, and this window of the system's wants the keyboard.
        std::function<void(std::uint32_t window)> shown;
        // Where it stands now with all that belongs to it, in the pixels in which clicks are reported.
        std::function<void(const Rectangle& frame)> placed;
        // The user has closed it, and nothing is to be sent.
        std::function<void()> closed;
        // The same, and another window of Plume's comes in its place.
        std::function<void()> replaced;
        // A key that can end the search has come, and did not.
        std::function<void()> stayed;
    };

    virtual ~QuickSearchView() = default;
    virtual void setEvents(Events events) = 0;
    // Also when it is visible: it begins anew.
    virtual void show(const QuickSearchOpening& opening) = 0;
    virtual void close() = 0;
};

}  // namespace plume
