#include "app/FirstLine.h"

#include <unicode/utf16.h>

#include <algorithm>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::size_t MostUnits = 80;
// Blank lines before it are passed over, but not for ever.
constexpr std::size_t MostRead = 4096;

}  // namespace

std::u16string firstLine(std::u16string_view content) {
    constexpr std::u16string_view LineEnds = u"\n\r\u2028\u2029";
    const bool cutsPairBehind = content.size() > MostRead && U16_IS_TRAIL(content[MostRead]);
    const std::u16string_view read = trimmed(content.substr(0, cutsPairBehind ? MostRead - 1 : MostRead));
    std::u16string_view line = trimmed(read.substr(0, read.find_first_of(LineEnds)));
    const bool isAll = line.size() == read.size() && content.size() <= MostRead;
    if (isAll && line.size() <= MostUnits) return std::u16string(line);
    std::size_t length = std::min(line.size(), MostUnits);
    const bool cutsPair = length < line.size() && U16_IS_TRAIL(line[length]);
    if (cutsPair) --length;
    line = trimmed(line.substr(0, length));
    return std::u16string(line) + u"\u2009\u2026";
}

}  // namespace plume
