// The snippets offered to the user.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "library/Snippet.h"

namespace plume {

// Two lists in step: entry i of `suggestionFilters` is the text that made entry i of `suggestions` one.
struct SuggestionList {
    std::vector<std::shared_ptr<Snippet>> suggestions;
    std::vector<std::u16string> suggestionFilters;

    std::size_t size() const { return suggestions.size(); }
    bool isEmpty() const { return suggestions.empty(); }

    void append(std::shared_ptr<Snippet> snippet, std::u16string filter) {
        suggestions.push_back(std::move(snippet));
        suggestionFilters.push_back(std::move(filter));
    }
    void clear() {
        suggestions.clear();
        suggestionFilters.clear();
    }
};

}  // namespace plume
