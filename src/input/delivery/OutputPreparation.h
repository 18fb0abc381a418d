// Decides whether the key that triggered an output is swallowed and typed again at its end, and cuts the output into
// pieces. Pure.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "content/PLOutput.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

// The last key that was heard, as far as it is still the one being handled.
struct TriggerKey {
    std::optional<KeyCode> keyCode;
    std::optional<std::u16string> string;  // what it produced
};

// Sets `cancelTrigger`, the content's suffix, the fragments and arrows of the output. `mustWait`: others are delivered
// before it, so a key passed on now would come too early.
void prepareOutput(PLOutput& output, const ContextInputSetting& setting, const TriggerKey& key, bool mustWait);

}  // namespace plume
