// Automaton: what its XML holds, in one group.
#include "import/AutomatonTyperXMLParser.h"
#include "import/ForeignFile.h"

namespace plume {

Result<ImportedLibrary> importAutomaton(const ForeignFile& file) {
    AutomatonTyperXMLParser parser;
    const Result<void> whole = parser.parse(file.bytes);
    if (!whole && parser.snippets().empty()) return file.fault(whole.error().message);
    if (parser.snippets().empty()) return file.fault("no object of type TYPERABBREVIATION is in it; expected snippets");
    if (!whole) parser.remarks().add("nothing behind a fault is read: " + whole.error().message);
    parser.remarks().addTooMany(parser.tooMany());
    auto group = SnippetGroup::make();
    group->setName(file.title());
    group->addItems(parser.snippets());
    return ImportedLibrary{{std::move(group)}, parser.remarks().take()};
}

}  // namespace plume
