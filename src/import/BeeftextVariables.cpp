#include "import/BeeftextVariables.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/KeyModifiers.h"
#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"
#include "import/ShellText.h"

namespace plume {

namespace {

constexpr std::size_t LongestVariable = 10'000;
constexpr std::int64_t MostKeyPresses = 1000;
constexpr std::int64_t LongestDelay = 60'000;

constexpr std::array<std::u16string_view, 16> Names = {
    u"clipboard", u"date",   u"time", u"dateTime", u"input", u"combo",  u"upper",      u"lower",
    u"trim",      u"cursor", u"key",  u"shortcut", u"delay", u"envVar", u"powershell", u"image"};

// "+1d-2h" at the start, which is taken: signs, numbers and units.
std::optional<DateShift> takeShift(std::u16string_view& rest) {
    DateShift shift;
    std::u16string_view text = rest;
    while (text.starts_with(u'+') || text.starts_with(u'-')) {
        const std::size_t end = text.find_first_not_of(u"0123456789", 1);
        if (end == std::u16string_view::npos || end == 1 || end > 10) return std::nullopt;
        const std::int64_t count = integerValue(text.substr(0, end));
        switch (text[end]) {
            case u'y':
                shift.years += count;
                break;
            case u'M':
                shift.months += count;
                break;
            case u'w':
                shift.days += 7 * count;
                break;
            case u'd':
                shift.days += count;
                break;
            case u'h':
                shift.seconds += 3600 * count;
                break;
            case u'm':
                shift.seconds += 60 * count;
                break;
            case u's':
                shift.seconds += count;
                break;
            default:
                return std::nullopt;
        }
        text.remove_prefix(end + 1);
    }
    if (text.size() == rest.size() || (!text.empty() && text.front() != u':')) return std::nullopt;
    rest = text.substr(std::min<std::size_t>(1, text.size()));
    return shift;
}

std::u16string dateCommand(const DateShift& shift, std::u16string_view format) {
    std::u16string command = u"date -d 'now";
    const auto add = [&](std::int64_t count, std::u16string_view unit) {
        if (count != 0)
            command += u" " + fromUtf8((count > 0 ? "+" : "") + std::to_string(count)) + std::u16string(unit);
    };
    add(shift.years, u" years");
    add(shift.months, u" months");
    add(shift.days, u" days");
    add(shift.seconds, u" seconds");
    return command + u"' " + quotedForShell(u"+" + std::u16string(format)) + u"\n";
}

}  // namespace

// ---- Texts ----

std::vector<BeeftextVariables::Variable> BeeftextVariables::variablesIn(std::u16string_view text) {
    std::vector<Variable> variables;
    for (std::size_t at = text.find(u"#{"); at != std::u16string_view::npos; at = text.find(u"#{", at + 1)) {
        Variable variable;
        std::u16string body;
        std::size_t i = at + 2;
        const std::size_t last = std::min(text.size(), at + LongestVariable);
        for (; i < last && text[i] != u'}'; ++i) {
            if (text[i] == u'\\' && text.substr(i + 1, 1) == u"}") ++i;
            body += text[i];
        }
        if (i >= last) continue;
        const std::size_t colon = std::min(body.find(u':'), body.size());
        variable.name = body.substr(0, colon);
        if (std::find(Names.begin(), Names.end(), variable.name) == Names.end()) continue;
        variable.argument = body.substr(std::min(colon + 1, body.size()));
        variable.range = {at, i + 1 - at};
        at = i;
        variables.push_back(std::move(variable));
    }
    return variables;
}

bool BeeftextVariables::areIn(std::u16string_view text) {
    return !variablesIn(text).empty();
}

std::u16string BeeftextVariables::expand(std::u16string_view text, std::u16string_view keyword) {
    return expand(AttributedString(std::u16string(text)), keyword).string();
}

AttributedString BeeftextVariables::expand(const AttributedString& text, std::u16string_view keyword) {
    keyword_ = keyword;
    if (holdsMarker(text.string()))
        problems_.emplace_back("its text holds \xe3\x80\x90, with which Plume's placeholders begin");
    AttributedString result;
    std::size_t end = 0;
    for (const Variable& variable : variablesIn(text.string())) {
        result.append(text.substring({end, variable.range.location - end}));
        const std::u16string written = text.string().substr(variable.range.location, variable.range.length);
        result.append(valueOf(variable, written), text.attributesAt(variable.range.location));
        end = variable.range.end();
    }
    result.append(text.substring({end, text.length() - end}));
    return result;
}

std::vector<std::string> BeeftextVariables::takeProblems() {
    return std::exchange(problems_, {});
}

std::u16string BeeftextVariables::lost(const std::string& why) {
    problems_.push_back(why);
    return {};
}

std::u16string BeeftextVariables::shelved(const std::u16string& script) {
    return scripts_.placeholderFor(script, keyword_ + u" script");
}

// ---- Variables ----

std::u16string BeeftextVariables::valueOf(const Variable& variable, std::u16string_view written) {
    const std::u16string& name = variable.name;
    if (name == u"clipboard") return std::u16string(ClipboardPlaceholder);
    if (name == u"cursor") return std::u16string(CaretPlaceholder);
    if (name == u"date") return u"\u3010date:full\u3011";
    if (name == u"time") return u"\u3010time:medium\u3011";
    if (name == u"dateTime") return dateTimeOf(variable.argument);
    if (name == u"input") return fieldPlaceholder({variable.argument, false, {}, {}});
    if (name == u"combo") return snippetPlaceholder(variable.argument, {});
    if (name == u"upper" || name == u"lower" || name == u"trim") return changedText(variable);
    if (name == u"key") return keyOf(variable.argument);
    if (name == u"shortcut") return shortcutOf(variable.argument);
    if (name == u"envVar") return environmentOf(variable.argument);
    if (name == u"delay") return delayOf(variable.argument);
    return lost("Plume has nothing for " + toUtf8(written));
}

// A key that is none, which is waited for.
std::u16string BeeftextVariables::delayOf(std::u16string_view milliseconds) {
    const std::int64_t delay = std::clamp<std::int64_t>(integerValue(milliseconds), 0, LongestDelay);
    std::string fraction = std::to_string(1000 + delay % 1000);
    fraction.front() = '.';
    return u"\u3010key:delay delay:" + fromUtf8(std::to_string(delay / 1000) + fraction) + u"\u3011";
}

std::u16string BeeftextVariables::dateTimeOf(std::u16string_view argument) {
    const DateShift shift = takeShift(argument).value_or(DateShift{});
    const QtDateFormat format = readQtDateFormat(argument.empty() ? u"dddd d MMMM yyyy HH:mm:ss" : argument);
    const auto value = datePlaceholders(format.pieces, shift, {});
    return value ? *value : shelved(dateCommand(shift, format.strftime));
}

// The text of another snippet in capitals, in small letters or without white space around it: as it is now.
std::u16string BeeftextVariables::changedText(const Variable& variable) {
    const auto found = texts_.find(variable.argument);
    if (found == texts_.end() || areIn(found->second)) {
        problems_.push_back("the text of \"" + toUtf8(variable.argument) + "\" is written as it is, not changed by \"" +
                            toUtf8(variable.name) + "\"");
        return snippetPlaceholder(variable.argument, {});
    }
    if (variable.name == u"upper") return uppercased(found->second);
    return variable.name == u"lower" ? lowercased(found->second) : std::u16string(trimmed(found->second));
}

// "enter", "tab:3".
std::u16string BeeftextVariables::keyOf(std::u16string_view argument) {
    const std::size_t colon = std::min(argument.find(u':'), argument.size());
    const std::int64_t count =
        colon == argument.size()
            ? 1
            : std::clamp<std::int64_t>(integerValue(argument.substr(colon + 1)), 1, MostKeyPresses);
    const auto key = keyPlaceholder(toUtf8(argument.substr(0, colon)), 0, count);
    return key ? *key : lost("Plume knows no key \"" + toUtf8(argument) + "\"");
}

// "Ctrl+Shift+A".
std::u16string BeeftextVariables::shortcutOf(std::u16string_view argument) {
    EventFlags flags;
    std::u16string key;
    for (const std::u16string& part : split(lowercased(argument), u'+')) {
        if (part == u"ctrl" || part == u"control") {
            flags = flags | EventFlag::Control;
        } else if (part == u"shift") {
            flags = flags | EventFlag::Shift;
        } else if (part == u"alt") {
            flags = flags | EventFlag::Option;
        } else if (part == u"win" || part == u"windows" || part == u"meta") {
            flags = flags | EventFlag::Command;
        } else {
            key = part;
        }
    }
    const auto placeholder = keyPlaceholder(toUtf8(key), flags.bits(), 1);
    return placeholder ? *placeholder : lost("Plume knows no key \"" + toUtf8(argument) + "\"");
}

std::u16string BeeftextVariables::environmentOf(const std::u16string& name) {
    const bool isName = !name.empty() && std::all_of(name.begin(), name.end(), [](char16_t c) {
        return c == u'_' || (c >= u'0' && c <= u'9') || (c >= u'a' && c <= u'z') || (c >= u'A' && c <= u'Z');
    });
    if (!isName) return lost("no variable of the environment can be called \"" + toUtf8(name) + "\"");
    return shelved(u"printenv " + name + u"\n");
}

}  // namespace plume
