#include "content/DelayText.h"

#include <unicode/numberformatter.h>

#include <charconv>
#include <cmath>

#include "Foundation/Strings.h"

namespace plume {
namespace {

bool isDigitAt(std::u16string_view text, std::size_t index) {
    return index < text.size() && text[index] >= u'0' && text[index] <= u'9';
}

bool isGroupAt(std::u16string_view text, std::size_t index) {
    return text[index] == u',' && isDigitAt(text, index + 1) && isDigitAt(text, index + 2) &&
           isDigitAt(text, index + 3) && !isDigitAt(text, index + 4);
}

// The number that the text starts with, in ASCII, without its grouping.
std::string ungrouped(std::u16string_view text) {
    std::string number;
    bool whole = true;
    for (std::size_t i = 0; i < text.size() && text[i] < 0x80; ++i) {
        if (whole && i > 0 && isDigitAt(text, i - 1) && isGroupAt(text, i)) continue;
        if (text[i] == u'.' || text[i] == u'e' || text[i] == u'E') whole = false;
        number += static_cast<char>(text[i]);
    }
    return number;
}

}  // namespace

double delayFromText(std::u16string_view text) {
    text = trimmed(text);
    if (!text.empty() && text.front() == u'+') text.remove_prefix(1);
    const std::string number = ungrouped(text);
    double seconds = 0;
    const auto read = std::from_chars(number.data(), number.data() + number.size(), seconds);
    return read.ec == std::errc() && std::isfinite(seconds) ? seconds : 0;
}

std::u16string textFromDelay(double seconds) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::UnicodeString text = icu::number::NumberFormatter::withLocale(icu::Locale::getUS())
                                        .precision(icu::number::Precision::maxFraction(3))
                                        .formatDouble(seconds, status)
                                        .toString(status);
    return {text.getBuffer(), static_cast<std::size_t>(text.length())};
}

}  // namespace plume
