// A machine with a library and the editor's operations on it, and everything that was done to undo.
#pragma once

#include <string>
#include <vector>

#include "app/editing/LibraryEditor.h"
#include "library/LibraryArchive.h"
#include "tests/library/LibraryMachine.h"

namespace plume::test {

struct EditedMachine {
    EditedMachine() {
        machine.load();
        machine.manager->snippetGroups().clear();
        editor.reloadDuplicateManager();
    }

    // "abbreviation=content" each.
    std::shared_ptr<SnippetGroup> addGroup(const std::u16string& name, const std::vector<std::u16string>& snippets,
                                           const std::u16string& prefix = {}) {
        auto group = SnippetGroup::make();
        group->setName(name);
        if (!prefix.empty()) group->setAbbreviationPrefix(prefix);
        for (const auto& text : snippets) {
            const std::size_t end = text.find(u'=');
            group->addItem(std::make_shared<Snippet>(text.substr(0, end), text.substr(end + 1)));
        }
        machine.manager->snippetGroups().push_back(group);
        editor.reloadDuplicateManager();
        return group;
    }
    // The abbreviations of the rows that are marked as duplicates.
    std::vector<std::string> marked() const {
        std::vector<std::string> rows;
        for (const auto& group : editor.groups()) {
            for (const auto& snippet : group->items()) {
                if (editor.isDuplicated(*snippet)) rows.push_back(toUtf8(snippet->abbreviation().value_or(u"")));
            }
        }
        return rows;
    }
    std::vector<std::string> library() const { return machine.library(); }
    std::string bytes() const {
        LibraryContents contents;
        contents.snippetGroups = editor.groups();
        return libraryArchive(contents);
    }

    SharedWorld world;
    Machine machine{world};
    std::vector<LibraryChange> done;
    LibraryEditor editor{*machine.manager, [this](const LibraryChange& change) { done.push_back(change); }};
};

}  // namespace plume::test
