// The older archives without keys, as far as rich text is written in them.
//
// Made for foreign bytes: bounded in depth, time and memory. Pure; from any thread.
#pragma once

#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

// The attributed text, or plain text, that the stream holds. Attributes from the first class on that is not known are
// left out, the text stays. The error says at which offset the bytes are wrong and what was expected.
Result<AttributedString> attributedStringFromTypedStream(std::string_view bytes);

}  // namespace plume
