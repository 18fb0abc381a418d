#include "app/editing/DictionaryGroup.h"

#include <utility>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {

std::shared_ptr<SnippetGroup> dictionaryGroup(std::u16string name, std::string_view utf8,
                                              CaseSensitivity caseSensitivity) {
    auto group = SnippetGroup::make();
    group->setName(std::move(name));
    group->setExpandTrigger(ExpandTrigger::DelimiterKept);
    group->setCaseSensitivity(caseSensitivity);
    group->setSuggestAbbreviations(false);
    group->setShowInMenuBar(false);
    auto lines = split(fromUtf8(utf8), u'\n');
    // What stands behind the last line feed is no line.
    if (lines.back().empty()) lines.pop_back();
    std::vector<std::shared_ptr<Snippet>> snippets;
    for (std::size_t i = 0; i + 1 < lines.size(); i += 2) {
        auto snippet = std::make_shared<Snippet>(lines[i], lines[i + 1]);
        snippet->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
        snippets.push_back(std::move(snippet));
    }
    group->addItems(snippets);
    return group;
}

}  // namespace plume
