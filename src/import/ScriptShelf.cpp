#include "import/ScriptShelf.h"

#include "import/ForeignPlaceholders.h"

namespace plume {

std::u16string ScriptShelf::placeholderFor(const std::u16string& script, const std::u16string& name) {
    std::shared_ptr<Snippet>& snippet = snippets_[script];
    if (!snippet) {
        snippet = std::make_shared<Snippet>(name, script);
        snippet->setContentType(ContentType::ShellScript);
        inOrder_.push_back(snippet);
    }
    return snippetPlaceholder(snippet->abbreviation().value_or(u""),
                              snippet->uuid() ? snippet->uuid()->toString() : u"");
}

std::shared_ptr<SnippetGroup> ScriptShelf::group(const std::u16string& name) const {
    if (inOrder_.empty()) return nullptr;
    auto group = SnippetGroup::make();
    group->setName(name);
    group->setExpandTrigger(ExpandTrigger::Never);
    group->setShowInMenuBar(false);
    group->setSuggestAbbreviations(false);
    group->addItems(inOrder_);
    return group;
}

}  // namespace plume
