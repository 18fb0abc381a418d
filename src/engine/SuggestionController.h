// The window at the caret that lists suggestions, as the engine drives it.
//
// Owned by the engine and used on the thread that delivers the key events, inside its callback too: a port whose
// windows live on another thread hands over and answers at once from what it was last told. The window never takes the
// keyboard.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "library/Snippet.h"
#include "platform/Accessibility.h"

namespace plume {

// The snippets offered to the user: two lists in step: entry i of `suggestionFilters` is the text that made entry i of
// `suggestions` one.
struct SuggestionList {
    std::vector<std::shared_ptr<Snippet>> suggestions;
    std::vector<std::u16string> suggestionFilters;

    std::size_t size() const { return suggestions.size(); }
    bool isEmpty() const { return suggestions.empty(); }

    void reserve(std::size_t count) {
        suggestions.reserve(count);
        suggestionFilters.reserve(count);
    }
    void append(std::shared_ptr<Snippet> snippet, std::u16string filter) {
        suggestions.push_back(std::move(snippet));
        suggestionFilters.push_back(std::move(filter));
    }
    void clear() {
        suggestions.clear();
        suggestionFilters.clear();
    }
};

class SuggestionController {
  public:
    virtual ~SuggestionController() = default;

    // The engine's own list, which outlives the controller. It is read on this thread while the window is visible.
    virtual void setSnippets(const SuggestionList& list) = 0;
    // Called, on the thread of the key events, when the user clicks an entry.
    virtual void setSuggestionSelectedAction(std::function<void()> action) = 0;
    // Which modifier picks entries with digit keys, for showing it: 0 none, n the one of bit n - 1.
    virtual void setSnippetSelectorKeyModifier(std::int64_t modifier) = 0;

    // Shows the list as it is now, with the first entry selected.
    virtual void reloadData() = 0;
    // Makes the window as high as its entries.
    virtual void refreshHeight() = 0;
    virtual void showWindowAtCaret() = 0;
    virtual void close() = 0;

    // Past an end the selection stays where it is.
    virtual void nextSuggestion() = 0;
    virtual void previousSuggestion() = 0;
    // NotFound when there is no entry.
    virtual std::size_t selectedSuggestionIndex() const = 0;

    // True from showWindowAtCaret to close.
    virtual bool windowVisible() const = 0;
    // On the screen, in the coordinates in which mouse events are reported.
    virtual Rectangle windowFrame() const = 0;
};

}  // namespace plume
