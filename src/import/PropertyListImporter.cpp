// Property lists of any kind: text replacements of macOS and what programs export of them, and libraries that were
// renamed.
#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListReader.h"
#include "import/ForeignFile.h"
#include "import/PropertyListFields.h"
#include "import/PropertyListImporters.h"
#include "import/Remarks.h"

namespace plume {

namespace {

using Array = PropertyList::Array;

// The list of replacements, or null.
const Array* replacementsIn(const PropertyList& list) {
    if (const auto* array = list.as<Array>()) return array;
    for (const char* const key : {"NSUserDictionaryReplacementItems", "NSUserReplacementItems"}) {
        if (const auto* array = list.find<Array>(key)) return array;
    }
    return nullptr;
}

// Null when the entry is no replacement.
std::shared_ptr<Snippet> snippetFrom(const PropertyList& entry) {
    for (const auto& [abbreviation, content] : {std::pair("replace", "with"), std::pair("shortcut", "phrase")}) {
        auto text = textAt(entry, abbreviation);
        if (text) return std::make_shared<Snippet>(std::move(text), textAt(entry, content).value_or(u""));
    }
    return nullptr;
}

Result<ImportedLibrary> libraryFromReplacements(const Array& entries, const ForeignFile& file) {
    Remarks remarks;
    auto group = SnippetGroup::make();
    group->setName(SystemSubstitutionsGroup);
    std::size_t strange = 0;
    std::size_t tooMany = 0;
    std::size_t off = 0;
    for (const PropertyList& entry : entries) {
        const auto snippet = snippetFrom(entry);
        if (!snippet) {
            ++strange;
        } else if (group->items().size() == MostImportedSnippets) {
            ++tooMany;
        } else {
            group->addItem(snippet);
            off += integerAt(entry, "on").value_or(1) == 0;
        }
    }
    if (group->items().empty()) return file.fault("nothing in its list is a replacement; expected {replace, with}");
    remarks.addCount(off, "replacement was switched off; it expands here",
                     "replacements were switched off; they expand here");
    remarks.addStrange(strange);
    remarks.addTooMany(tooMany);
    return ImportedLibrary{{std::move(group)}, remarks.take()};
}

}  // namespace

Result<ImportedLibrary> importPropertyList(const ForeignFile& file) {
    const Result<PropertyList> list = readPropertyList(file.bytes);
    if (!list) return file.fault(list.error().message);
    if (list.value().find("snippetsTE2")) return libraryFromTextExpander(list.value(), file);
    if (list.value().find("Clippings")) return libraryFromTypeIt4Me(list.value(), file);
    const Array* entries = replacementsIn(list.value());
    if (!entries) return file.fault("no text replacements are in it; expected a list of {replace, with}");
    return libraryFromReplacements(*entries, file);
}

}  // namespace plume
