// Computes which snippets to offer for what has been typed so far.
#pragma once

#include <string_view>

#include "engine/EngineState.h"
#include "engine/SuggestionList.h"

namespace plume {

// Owned by the composition root, outlives the engine. Called on the thread that delivers the key events, only when a
// list is shown or asked for.
class SuggestionSource {
  public:
    virtual ~SuggestionSource() = default;

    // Appends to `list` the snippets of these groups that `letters`, which is not empty, may become, the best first.
    // The groups are those that admit the application in front.
    virtual void appendSuggestions(std::u16string_view letters, const EngineState::Groups& groups,
                                   SuggestionList& list) const = 0;
};

}  // namespace plume
