// Turns a chosen snippet into output.
//
// Owned by the composition root, outlives the engine. Called on the thread that delivers the key events, often inside
// the key callback: what takes longer goes on after the call has returned.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "content/SnippetTrigger.h"
#include "engine/EngineState.h"
#include "library/Snippet.h"

namespace plume {

class SnippetSender {
  public:
    virtual ~SnippetSender() = default;

    // `abbreviation` is the text that was typed for the snippet and is erased, nothing when it was chosen in another
    // way. Clears the engine first, and may fill its buffer with what
    // now stands before the caret. Whether the key that triggered it must be swallowed; false when nothing was sent.
    virtual bool sendSnippet(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                             const std::optional<std::u16string>& abbreviation, SnippetTriggers snippetTrigger) = 0;

    // Takes the last expansion back, as the engine's record tells, and types what stood there before; with or without
    // the key that triggered it. False when there is no record.
    virtual bool undo(EngineState& engine, bool withTrigger) = 0;
};

}  // namespace plume
