// Telling the user about something in a snippet that cannot work, without repeating it at every expansion.
#pragma once

#include <string>
#include <string_view>

#include "content/ContentEnvironment.h"

namespace plume {

// Passes the sentence to the environment's report unless the same sentence was passed lately: the last few dozen are
// remembered, for the whole process. From any thread.
void reportOnce(const ContentEnvironment& environment, const std::string& sentence);

// A piece of a snippet as it may stand in such a sentence: in quotes, and not too long.
std::string quotedForReport(std::u16string_view text);

}  // namespace plume
