// Markdown (CommonMark, with GitHub's tables, task lists, strikethrough and bare links) as rich text.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/text/AttributedString.h"

namespace plume {

// UTF-8. Never fails; what comes behind 4 MiB is left out. HTML within it is kept. Pure; from any thread.
std::string htmlFromMarkdown(std::string_view utf8);
AttributedString attributedStringFromMarkdown(std::string_view utf8);

}  // namespace plume
