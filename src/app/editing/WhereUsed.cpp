#include "app/editing/WhereUsed.h"

#include <string>
#include <string_view>

#include "content/PlaceholderBody.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetAbbreviationVariable.h"

namespace plume {

namespace {

constexpr std::u16string_view Beginning = u"\u3010snippet:";

bool includes(const Snippet& outer, const Snippet& inner, const SnippetGroups& groups) {
    const auto& content = outer.richTextContent();
    if (!content) return false;
    const std::u16string& text = content->string();
    for (std::size_t at = text.find(Beginning); at != std::u16string::npos; at = text.find(Beginning, at + 1)) {
        const std::size_t end = text.find(ClosingMarker, at);
        if (end == std::u16string::npos) return false;
        const auto variable = std::dynamic_pointer_cast<SnippetAbbreviationVariable>(
            parseVariable(std::u16string_view(text).substr(at + 1, end - at - 1)));
        if (variable && findSnippetBySnippetAbbreviationVariable(*variable, outer, groups).get() == &inner) return true;
    }
    return false;
}

}  // namespace

std::vector<std::shared_ptr<Snippet>> snippetsThatInclude(const Snippet& snippet, const SnippetGroups& groups) {
    std::vector<std::shared_ptr<Snippet>> found;
    for (const auto& group : groups) {
        for (const auto& outer : group->items()) {
            if (outer.get() != &snippet && includes(*outer, snippet, groups)) found.push_back(outer);
        }
    }
    return found;
}

}  // namespace plume
