#include "content/SnippetContentCase.h"

#include <algorithm>
#include <map>
#include <memory>
#include <utility>
#include <variant>

#include "library/SnippetUtils.h"

namespace plume {

namespace {

// Places of the text as it was, with what becomes of them.
using Places = std::map<std::size_t, std::size_t>;

SnippetAbbreviationVariable* asScript(SnippetVariable& variable) {
    return dynamic_cast<SnippetAbbreviationVariable*>(&variable);
}

Places placesOf(const SnippetExpandedContent& content) {
    Places places;
    for (const auto& variable : content.variables) {
        places.emplace(variable->location, 0);
        const auto* script = asScript(*variable);
        if (script != nullptr) places.emplace(script->location + script->scriptLength, 0);
    }
    return places;
}

// Corrects the text once more, with the stretches between the places told apart by an attribute, and measures them.
void locate(Places& places, std::u16string_view text, std::u16string_view typedAbbreviation, std::int64_t flags) {
    AttributedString marked;
    std::size_t start = 0;
    const auto markUpTo = [&](std::size_t end) {
        auto attributes = std::make_shared<TextAttributes>();
        attributes->baselineOffset = static_cast<double>(start);
        marked.append(text.substr(start, end - start), attributes);
        start = end;
    };
    for (const auto& [place, corrected] : places) markUpTo(std::min(place, text.size()));
    markUpTo(text.size());

    const AttributedString result = SnippetUtils::correctedCase(marked, typedAbbreviation, flags);
    auto run = result.runs().begin();
    std::size_t position = 0;
    std::size_t correctedPosition = 0;
    for (auto& [place, corrected] : places) {
        if (place > position && run != result.runs().end()) {
            correctedPosition += run->length;
            position = place;
            ++run;
        }
        corrected = correctedPosition;
    }
}

void moveVariables(SnippetExpandedContent& content, const Places& places) {
    for (const auto& variable : content.variables) {
        const std::size_t location = places.at(variable->location);
        if (auto* script = asScript(*variable)) {
            script->scriptLength = places.at(script->location + script->scriptLength) - location;
        }
        variable->location = location;
    }
}

}  // namespace

void correctSnippetContentCase(SnippetExpandedContent& content, std::u16string_view typedAbbreviation,
                               std::int64_t flags) {
    const std::u16string before = content.string();
    content.setContent(std::visit(
        [&](const auto& text) -> SnippetExpandedContent::Content {
            return SnippetUtils::correctedCase(text, typedAbbreviation, flags);
        },
        content.content));
    if (content.string().size() == before.size()) return;
    Places places = placesOf(content);
    locate(places, before, typedAbbreviation, flags);
    moveVariables(content, places);
}

}  // namespace plume
