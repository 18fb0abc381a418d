// TypeIt4Me: a property list of clippings.
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/text/RTFD.h"
#include "import/ForeignFile.h"
#include "import/PropertyListFields.h"
#include "import/PropertyListImporters.h"
#include "import/Remarks.h"

namespace plume {

namespace {

void setContent(Snippet& snippet, const PropertyList& entry, Remarks& remarks) {
    if (const auto* data = entry.find<ArchivedData>("RTFD")) {
        Result<AttributedString> text = attributedStringFromRTFD(data->bytes);
        if (text) {
            snippet.setContentType(ContentType::RichText);
            snippet.setRichTextContent(std::move(text).value());
            return;
        }
        remarks.add(snippet, "its formatting cannot be read (" + text.error().message + "), its plain text is taken");
    }
    snippet.setPlainTextContent(textAt(entry, "Plain Text"));
}

std::shared_ptr<Snippet> snippetFrom(const PropertyList& entry, Remarks& remarks) {
    auto snippet = std::make_shared<Snippet>();
    snippet->setAbbreviation(textAt(entry, "Abbreviation"));
    snippet->setLabel(textAt(entry, "Label"));
    const std::int64_t mode = integerAt(entry, "abbreviationMode").value_or(0);
    if (mode >= 0 && mode <= 2) snippet->setCaseSensitivity(static_cast<CaseSensitivity>(mode));
    setContent(*snippet, entry, remarks);
    return snippet;
}

}  // namespace

Result<ImportedLibrary> libraryFromTypeIt4Me(const PropertyList& list, const ForeignFile& file) {
    const auto* entries = list.find<PropertyList::Array>("Clippings");
    if (!entries) return file.fault("at Clippings: there is none; expected a list of clippings");
    Remarks remarks;
    auto group = SnippetGroup::make();
    group->setName(file.title());
    std::size_t strange = 0;
    std::size_t tooMany = 0;
    for (const PropertyList& entry : *entries) {
        if (!entry.as<PropertyList::Dictionary>()) {
            ++strange;
        } else if (group->items().size() == MostImportedSnippets) {
            ++tooMany;
        } else {
            group->addItem(snippetFrom(entry, remarks));
        }
    }
    remarks.addStrange(strange);
    remarks.addTooMany(tooMany);
    return ImportedLibrary{{std::move(group)}, remarks.take()};
}

Result<ImportedLibrary> importTypeIt4Me(const ForeignFile& file) {
    const Result<PropertyList> list = readPropertyList(file.bytes);
    if (!list) return file.fault(list.error().message);
    return libraryFromTypeIt4Me(list.value(), file);
}

}  // namespace plume
