// Cutting an output into what is sent event by event. Pure; from any thread.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "content/PLOutput.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

// The chunks in which a text is typed: blockLength units each, but a tab or newline that would start a chunk is one by
// itself.
std::vector<std::u16string> fragmentsForPlainText(std::u16string_view text, const ContextInputSetting& setting);

// The fragments with every plain text cut into its chunks.
std::vector<PLOutput::Fragment> fragmentsForOutputFragments(const std::vector<PLOutput::Fragment>& fragments,
                                                            const ContextInputSetting& setting);

// Sets the output's fragments and leftArrowCount from its content. The name is the operation's own.
void refreshFragmentsForOuput(PLOutput& output, const ContextInputSetting& setting);

// How many events typing the output takes: backspaces, arrows, one for each text, every press of a key.
std::uint64_t eventCountForOutput(const PLOutput& output);

}  // namespace plume
