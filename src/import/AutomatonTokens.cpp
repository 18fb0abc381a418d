// The tokens of Automaton's contents.
#include <algorithm>
#include <array>
#include <optional>

#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetKeyVariable.h"
#include "import/AutomatonTyperXMLParser.h"

namespace plume {

namespace {

using View = std::u16string_view;
using Text = std::u16string;

Text placeholder(Text body) {
    // There is no way to write the markers within a body.
    std::replace(body.begin(), body.end(), OpeningMarker, u'[');
    std::replace(body.begin(), body.end(), ClosingMarker, u']');
    return OpeningMarker + body + ClosingMarker;
}

struct Key {
    View name;
    View label;
    KeyCode code;
};
constexpr std::array Keys = {
    Key{u"left", u"\u25C0", KeyCode::Left},     Key{u"right", u"\u25B6", KeyCode::Right},
    Key{u"up", u"\u25B2", KeyCode::Up},         Key{u"down", u"\u25BC", KeyCode::Down},
    Key{u"return", u"\u21A9", KeyCode::Return}, Key{u"enter", u"\u21A9", KeyCode::Return},
    Key{u"tab", u"\u21E5", KeyCode::Tab},       Key{u"escape", u"\u238B", KeyCode::Escape},
};

// A key without a code, which presses nothing, when it is not known.
Text keyBody(View name) {
    const auto key =
        std::find_if(Keys.begin(), Keys.end(), [&](const Key& k) { return equalsIgnoringCase(k.name, name); });
    if (key != Keys.end()) return SnippetKeyVariable(Text(key->label), key->code).toString();
    return SnippetKeyVariable(Text(name), KeyCode::None).toString();
}

struct DatePart {
    View token;
    View pattern;
};
constexpr std::array DateParts = {
    DatePart{u"${hour}", u"HH"},  DatePart{u"${minute}", u"mm"},    DatePart{u"${second}", u"ss"},
    DatePart{u"${AMPM}", u"a"},   DatePart{u"${timeZone}", u"zzz"}, DatePart{u"${year}", u"yyyy"},
    DatePart{u"${month}", u"MM"}, DatePart{u"${day}", u"dd"},
};

Text dateBody(View pattern) {
    Text format;
    while (!pattern.empty()) {
        const auto part = std::find_if(DateParts.begin(), DateParts.end(),
                                       [&](const DatePart& p) { return pattern.starts_with(p.token); });
        format += part == DateParts.end() ? pattern.substr(0, 1) : part->pattern;
        pattern.remove_prefix(part == DateParts.end() ? 1 : part->token.size());
    }
    SnippetDateVariable date;
    date.format = std::move(format);
    return date.toString();
}

// Behind the "}" that ends the token which starts at `start`; nothing when none does.
std::optional<std::size_t> endOfToken(View text, std::size_t start) {
    std::size_t open = 0;
    for (std::size_t at = start; at < text.size(); ++at) {
        if (text.substr(at).starts_with(u"${")) ++open;
        if (text[at] == u'}' && --open == 0) return at + 1;
    }
    return std::nullopt;
}

}  // namespace

Text AutomatonTyperXMLParser::convertAutomatonToken(View token) {
    if (token == u"pasteboard") return placeholder(u"clipboard");
    const std::size_t colon = token.find(u':');
    const bool hasParameter = colon != View::npos;
    const View parameter = hasParameter ? token.substr(colon + 1) : View();
    if (token.starts_with(u"abbreviation") && hasParameter) return placeholder(u"snippet:" + escapeParam(parameter));
    if (token.starts_with(u"field")) return placeholder(u"field:" + escapeParam(parameter));
    if (token.starts_with(u"cursor") && hasParameter) {
        return placeholder(parameter == u"here" ? Text(u"|") : keyBody(parameter));
    }
    if (token.starts_with(u"current-date") && hasParameter) return placeholder(dateBody(parameter));
    return Text(token);
}

Text convertAutomatonExpansion(View text) {
    constexpr std::size_t Marks = 2;  // "${"
    Text converted;
    std::size_t copied = 0;
    for (std::size_t at = text.find(u"${"); at != View::npos; at = text.find(u"${", copied)) {
        const auto end = endOfToken(text, at);
        if (!end) break;
        const View token = text.substr(at + Marks, *end - 1 - at - Marks);
        const Text placed = AutomatonTyperXMLParser::convertAutomatonToken(token);
        converted += text.substr(copied, at - copied);
        converted += placed == token ? text.substr(at, *end - at) : View(placed);
        copied = *end;
    }
    converted += text.substr(copied);
    return converted;
}

}  // namespace plume
