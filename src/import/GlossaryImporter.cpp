// Glossaries of SpellCatcher: a keyed archive, whose strings are abbreviations and contents in turn.
#include <optional>
#include <utility>

#include "Foundation/archive/PropertyListReader.h"
#include "import/ForeignFile.h"
#include "import/Remarks.h"

namespace plume {

Result<ImportedLibrary> importGlossary(const ForeignFile& file) {
    const Result<PropertyList> list = readPropertyList(file.bytes);
    if (!list) return file.fault(list.error().message);
    const auto* objects = list.value().find<PropertyList::Array>("$objects");
    if (!objects) return file.fault("at $objects: there is none; expected the archive of a glossary");
    std::vector<std::shared_ptr<Snippet>> snippets;
    std::optional<std::u16string> pending;
    std::size_t tooMany = 0;
    for (const PropertyList& object : *objects) {
        const auto* text = object.as<std::u16string>();
        if (!text) {
            pending.reset();
        } else if (!pending) {
            pending = *text;
        } else if (snippets.size() == MostImportedSnippets) {
            ++tooMany;
            pending.reset();
        } else {
            snippets.push_back(std::make_shared<Snippet>(std::exchange(pending, std::nullopt), *text));
        }
    }
    if (snippets.empty()) return file.fault("at $objects: no abbreviation with a content; expected pairs of strings");
    Remarks remarks;
    remarks.addTooMany(tooMany);
    auto group = SnippetGroup::make();
    group->setName(file.title());
    group->setExpandTrigger(ExpandTrigger::DelimiterKept);
    group->addItems(snippets);
    return ImportedLibrary{{std::move(group)}, remarks.take()};
}

}  // namespace plume
