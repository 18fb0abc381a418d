// Text files of other programs, whatever encoding they are written in.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "Foundation/Result.h"

namespace plume {

// What bytes are that are no Unicode.
enum class CodePage { Windows1252, MacRoman };

// The text without its byte order mark. Read by its mark, else as UTF-8, as UTF-16 when every other byte of the
// beginning is 0, else in the code page, in which any bytes are a text. An error, with the place, when NUL characters
// show that the file is no text.
Result<std::u16string> textOfFile(std::string_view bytes, CodePage otherwise);

// The number of the line, from 1, in which this position lies. A line ends in LF, CR or both.
std::size_t lineNumberAt(std::u16string_view text, std::size_t position);

}  // namespace plume
