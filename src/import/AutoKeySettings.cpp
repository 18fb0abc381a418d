#include "import/AutoKeySettings.h"

#include "import/JsonMembers.h"

namespace plume {

namespace {

// The numbers in "modes".
enum class Mode : std::int8_t { Abbreviation = 1, Prediction = 2, HotKey = 3 };

void readAbbreviation(const JsonMembers& members, AutoKeySettings& settings) {
    if (const auto list = members.find("abbreviations")) settings.abbreviations = list->strings();
    // Old files have a single one.
    if (const auto one = members.find("abbreviation")) settings.abbreviations = {one->string()};
    settings.isImmediate = members.boolean("immediate", false);
    settings.expandsInside = members.boolean("triggerInside", false);
    settings.ignoresCase = members.boolean("ignoreCase", false);
    settings.erasesAbbreviation = members.boolean("backspace", true);
    if (const auto characters = members.find("wordChars")) settings.wordCharacters = characters->string();
}

void readHotKey(const JsonMembers& members, AutoKeySettings& settings) {
    const std::u16string key = members.string("hotKey");
    if (key.empty()) return;
    if (const auto modifiers = members.find("modifiers")) {
        for (const std::u16string& modifier : modifiers->strings()) settings.hotKey += modifier + u"+";
    }
    settings.hotKey += key;
}

void readModes(const JsonNode& modes, AutoKeySettings& settings) {
    for (const JsonNode& mode : modes.elements()) {
        const auto number = static_cast<Mode>(mode.integer(0, 100));
        settings.isByAbbreviation = settings.isByAbbreviation || number == Mode::Abbreviation;
        settings.isByPrediction = settings.isByPrediction || number == Mode::Prediction;
        settings.isByHotKey = settings.isByHotKey || number == Mode::HotKey;
    }
}

}  // namespace

AutoKeySettings readAutoKeySettings(std::string_view json, const std::string& fileName) {
    const JsonMembers members(JsonNode::parse(json, fileName));
    AutoKeySettings settings;
    settings.description = members.string("description");
    if (settings.description.empty()) settings.description = members.string("title");
    settings.matchesCase = members.boolean("matchCase", false);
    settings.omitsTrigger = members.boolean("omitTrigger", false);
    settings.asksFirst = members.boolean("prompt", false);
    if (const auto modes = members.find("modes")) readModes(*modes, settings);
    if (const auto abbreviation = members.find("abbreviation")) readAbbreviation(JsonMembers(*abbreviation), settings);
    if (const auto hotKey = members.find("hotkey")) readHotKey(JsonMembers(*hotKey), settings);
    if (const auto filter = members.find("filter")) {
        const JsonMembers parts(*filter);
        if (const auto pattern = parts.find("regex")) settings.windowFilter = pattern->string();
        settings.isFilterRecursive = parts.boolean("isRecursive", false);
    }
    return settings;
}

std::optional<std::u16string> delimitersOfAutoKey(std::u16string_view wordCharacters, bool& isOther) {
    isOther = false;
    if (wordCharacters == u"[\\w]" || wordCharacters == u"\\w") return std::nullopt;
    isOther = true;
    if (!wordCharacters.starts_with(u"[^") || !wordCharacters.ends_with(u']')) return std::nullopt;
    const std::u16string_view set = wordCharacters.substr(2, wordCharacters.size() - 3);
    std::u16string characters;
    for (std::size_t i = 0; i < set.size(); ++i) {
        if (set[i] == u'-' && i > 0 && i + 1 < set.size()) return std::nullopt;
        if (set[i] != u'\\' || i + 1 == set.size()) {
            characters += set[i] == u'\n' ? u'\r' : set[i];
            continue;
        }
        const char16_t escaped = set[++i];
        if (escaped == u's') {
            characters += u" \t\r";
        } else if (escaped == u'n' || escaped == u't' || escaped == u'r') {
            characters += escaped == u't' ? u'\t' : u'\r';
        } else if ((escaped >= u'a' && escaped <= u'z') || (escaped >= u'A' && escaped <= u'Z')) {
            return std::nullopt;
        } else {
            characters += escaped;
        }
    }
    isOther = characters.empty();
    if (isOther) return std::nullopt;
    return characters;
}

}  // namespace plume
