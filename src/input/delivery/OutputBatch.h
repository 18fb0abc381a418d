// What goes out of an output without a pause. Pure; from any thread.
//
// Programs lose keys that arrive too fast, so an output is sent in batches of at most 20 events with pauses between.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "content/PLOutput.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

struct OutputStep {
    enum class Kind { Backspaces, LeftArrows, Key, Text, Paste };

    Kind kind = Kind::Text;
    std::uint64_t count = 1;      // of Backspaces, LeftArrows and Key
    PLOutput::Fragment fragment;  // of Key, Text and Paste
};

struct OutputBatch {
    std::vector<OutputStep> steps;
    std::optional<double> pause;  // seconds until the next batch; nothing: the output is sent
};

// Takes the next batch out of the output's backspaces, fragments and arrows.
OutputBatch takeBatch(PLOutput& output, const ContextInputSetting& setting);

// Whether everything is sent with the first batch, so that a key passed on behind it comes after the whole output.
bool isSentInOneBatch(const PLOutput& output, const ContextInputSetting& setting);

// When a paste keystroke is sent, in seconds from the moment the content is offered.
double pasteKeystrokeDelay(const ContextInputSetting& setting);
// What has to pass before the batch after a paste, in seconds from the same moment.
double pauseAfterPaste(const ContextInputSetting& setting);
// The same in seconds from the moment at which the target is known to have taken the content.
double pauseAfterTaking(const ContextInputSetting& setting);

// The paste goes by way of activating Plume and then the target again.
bool pastesByActivation(const ContextInputSetting& setting);

}  // namespace plume
