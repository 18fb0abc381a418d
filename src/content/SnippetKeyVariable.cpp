#include "content/SnippetKeyVariable.h"

#include <unicode/numberformatter.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {
namespace {

// ---- The delay as text: the en_US decimal style ("0.5", "1,234.125"), whatever the user's locale ----

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

// Seconds; never infinite or not a number; 0 when the text starts with no number. Grouping commas are read where three
// digits follow, as the style writes them.
double delayFromText(std::u16string_view text) {
    text = trimmed(text);
    if (!text.empty() && text.front() == u'+') text.remove_prefix(1);
    const std::string number = ungrouped(text);
    double seconds = 0;
    const auto read = std::from_chars(number.data(), number.data() + number.size(), seconds);
    return read.ec == std::errc() && std::isfinite(seconds) ? seconds : 0;
}

// At most three fraction digits.
std::u16string textFromDelay(double seconds) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::UnicodeString text = icu::number::NumberFormatter::withLocale(icu::Locale::getUS())
                                        .precision(icu::number::Precision::maxFraction(3))
                                        .formatDouble(seconds, status)
                                        .toString(status);
    return {text.getBuffer(), static_cast<std::size_t>(text.length())};
}

// ---- Parameters ----

// A code that no keyboard has must not press some other key: it counts as no key.
KeyCode keyCodeParam(const VariableParams& params) {
    if (!params.contains(u"code")) return KeyCode::None;
    const std::int64_t code = integerParam(params, u"code");
    return code < 0 || code > numberOf(KeyCode::None) ? KeyCode::None : KeyCode{static_cast<std::uint16_t>(code)};
}

EventFlags modifiersParam(const VariableParams& params) {
    return EventFlags::fromBits(
        static_cast<std::uint64_t>(std::max<std::int64_t>(integerParam(params, u"modifiers"), 0)));
}

std::uint64_t countParam(const VariableParams& params) {
    const std::int64_t count = integerParam(params, u"count");
    return count < 1 ? 1 : std::min(static_cast<std::uint64_t>(count), SnippetKeyVariable::MaximumCount);
}

double delayParam(const VariableParams& params) {
    const auto found = params.find(u"delay");
    return found == params.end() ? 0 : std::clamp(delayFromText(found->second), 0.0, SnippetKeyVariable::MaximumDelay);
}

}  // namespace

SnippetKeyVariable::SnippetKeyVariable(const VariableParams& params)
    : SnippetVariable(params),
      key(textParam(params, u"key")),
      keyCode(keyCodeParam(params)),
      count(countParam(params)),
      delay(delayParam(params)),
      modifiers(modifiersParam(params)) {}

SnippetKeyVariable::SnippetKeyVariable(std::u16string label, KeyCode code) : key(std::move(label)), keyCode(code) {}

bool SnippetKeyVariable::shift() const {
    return modifiers.contains(EventFlag::Shift);
}
bool SnippetKeyVariable::control() const {
    return modifiers.contains(EventFlag::Control);
}
bool SnippetKeyVariable::option() const {
    return modifiers.contains(EventFlag::Option);
}
bool SnippetKeyVariable::command() const {
    return modifiers.contains(EventFlag::Command);
}

bool SnippetKeyVariable::isArrow() const {
    return keyCode >= KeyCode::Left && keyCode <= KeyCode::Up;
}

bool SnippetKeyVariable::isReturnOrTab() const {
    return keyCode == KeyCode::Return || keyCode == KeyCode::Tab;
}

bool SnippetKeyVariable::movesCaret() const {
    return isReturnOrTab() || keyCode == KeyCode::KeypadEnter;
}

std::u16string SnippetKeyVariable::toString() const {
    BodyWriter writer;
    writer.param(u"key", key.value_or(std::u16string()));
    writer.param(u"code", numberOf(keyCode));
    if (!modifiers.isEmpty()) writer.unsignedParam(u"modifiers", modifiers.bits());
    if (count >= 2) writer.unsignedParam(u"count", count);
    if (delay > 0) writer.param(u"delay", textFromDelay(delay));
    return writer.take();
}

}  // namespace plume
