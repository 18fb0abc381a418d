// Corrects slips in what is typed besides abbreviations.
//
// Owned by the composition root, outlives the engine. Called inside the key callback.
#pragma once

#include <string_view>

#include "engine/EngineState.h"
#include "input/EventArgs.h"

namespace plume {

class AutoCorrector {
  public:
    virtual ~AutoCorrector() = default;

    // After a key that completed no snippet; the buffer ends with its characters already. `context` is the buffer
    // before the key, a view into it: no longer valid once the buffer changes. When a correction is sent, the event's
    // `cancel` says what becomes of the key, and the buffer holds the corrected text.
    virtual void autoCorrect(EngineState& engine, ZDKeyEventArgs& event, std::u16string_view context) = 0;
};

}  // namespace plume
