// TextExpander: property lists of one group ("groupInfo") or of all of them ("groupsTE2"), and their snippets.
#include <algorithm>
#include <map>
#include <unordered_set>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/TypedStream.h"
#include "Foundation/text/HTMLImport.h"
#include "import/ForeignFile.h"
#include "import/PropertyListFields.h"
#include "import/PropertyListImporters.h"
#include "import/Remarks.h"
#include "import/TextExpanderMacros.h"

namespace plume {

namespace {

using Array = PropertyList::Array;
using Snippets = std::vector<std::shared_ptr<Snippet>>;

constexpr std::int64_t JavaScript = 4;
constexpr std::int64_t Html = 5;
constexpr std::size_t MostGroups = 10'000;

std::shared_ptr<SnippetGroup> groupFrom(const PropertyList& info) {
    auto group = SnippetGroup::make();
    group->setName(textAt(info, "groupName").value_or(textAt(info, "name").value_or(u"TextExpander Snippets")));
    switch (integerAt(info, "expandAfterMode").value_or(-1)) {
        case 0:
            group->setExpandAfter(ExpandAfter::Whitespace);
            break;
        case 1:
            group->setExpandAfter(ExpandAfter::Delimiter);
            break;
        case 2:
            group->setExpandAfter(ExpandAfter::Anything);
            break;
        default:
            break;
    }
    if (const auto suggests = integerAt(info, "suggestAbbreviations")) group->setSuggestAbbreviations(*suggests != 0);
    return group;
}

class TextExpanderReading {
  public:
    TextExpanderReading(const PropertyList& list, const ForeignFile& file) : list_(list), file_(file) {}

    Result<ImportedLibrary> read() {
        const auto* entries = list_.find<Array>("snippetsTE2");
        if (!entries) return file_.fault("at snippetsTE2: there is none; expected a list of snippets");
        for (const PropertyList& entry : *entries) addEntry(entry);
        if (snippets_.empty() && !entries->empty()) {
            return file_.fault("at snippetsTE2: nothing in it is a snippet; expected dictionaries");
        }
        makeGroups();
        remarks_.addStrange(strange_);
        remarks_.addTooMany(tooMany_);
        return ImportedLibrary{std::move(groups_), remarks_.take()};
    }

  private:
    void addEntry(const PropertyList& entry) {
        if (!entry.as<PropertyList::Dictionary>()) {
            ++strange_;
        } else if (snippets_.size() == MostImportedSnippets) {
            ++tooMany_;
        } else {
            snippets_.push_back(snippetFrom(entry));
            if (auto identifier = textAt(entry, "uuidString")) byIdentifier_[*identifier].push_back(snippets_.back());
        }
    }

    std::shared_ptr<Snippet> snippetFrom(const PropertyList& entry) {
        auto snippet = std::make_shared<Snippet>();
        snippet->setAbbreviation(textAt(entry, "abbreviation"));
        snippet->setLabel(textAt(entry, "label"));
        const std::int64_t mode = integerAt(entry, "abbreviationMode").value_or(0);
        if (mode >= 0 && mode <= 2) snippet->setCaseSensitivity(static_cast<CaseSensitivity>(mode));
        setContent(*snippet, entry);
        if (snippet->contentType() == ContentType{JavaScript}) {
            remarks_.add(*snippet, "it is JavaScript, which Plume does not run; it is kept and expands to nothing");
        } else {
            remarks_.addAll(*snippet, convertTextExpanderMacros(*snippet));
        }
        return snippet;
    }

    void setContent(Snippet& snippet, const PropertyList& entry) {
        const std::int64_t type = integerAt(entry, "snippetType").value_or(0);
        if (setRichText(snippet, entry)) return;
        const auto plain = textAt(entry, "plainText");
        if (type == Html) {
            snippet.setContentType(ContentType::RichText);
            const auto html = textAt(entry, "htmlText");
            snippet.setRichTextContent(attributedStringFromHTML(toUtf8(html.value_or(plain.value_or(u"")))));
        } else if (type >= 0 && type <= JavaScript) {
            snippet.setContentType(static_cast<ContentType>(type));
            snippet.setPlainTextContent(plain);
        } else {
            snippet.setPlainTextContent(plain);
            remarks_.add(snippet, "its type " + std::to_string(type) + " is not known; it is taken as plain text");
        }
    }

    // The formatted text, when there is one that can be read.
    bool setRichText(Snippet& snippet, const PropertyList& entry) {
        const auto* data = entry.find<ArchivedData>("richText");
        if (!data) return false;
        Result<AttributedString> text = attributedStringFromTypedStream(data->bytes);
        if (!text) {
            remarks_.add(snippet, "its formatting cannot be read (" + text.error().message + "), its text is taken");
            return false;
        }
        snippet.setContentType(ContentType::RichText);
        snippet.setRichTextContent(std::move(text).value());
        return true;
    }

    void makeGroups() {
        if (const auto* info = list_.find("groupInfo"); info && info->as<PropertyList::Dictionary>()) {
            addGroup(groupFrom(*info), snippets_, *info);
        }
        if (const auto* groups = list_.find<Array>("groupsTE2")) {
            const std::size_t taken = std::min(groups->size(), MostGroups);
            for (std::size_t i = 0; i < taken; ++i) {
                const PropertyList& info = (*groups)[i];
                addGroup(groupFrom(info), listedIn(info), info);
            }
            remarks_.addCount(groups->size() - taken, "group more than can be taken is left out",
                              "groups more than can be taken are left out");
        }
        addUngrouped();
    }

    void addGroup(std::shared_ptr<SnippetGroup> group, const Snippets& snippets, const PropertyList& info) {
        group->addItems(snippets);
        for (const auto& snippet : snippets) grouped_.insert(snippet.get());
        const auto note = textAt(info, "notes");
        if (note && !note->empty()) remarks_.add("the note of the group " + toUtf8(*group->name()) + " is left out");
        groups_.push_back(std::move(group));
    }

    // Where several snippets have one identifier, each mention of it means the next one.
    Snippets listedIn(const PropertyList& info) {
        Snippets listed;
        std::map<std::u16string, std::size_t> mentions;
        const auto* identifiers = info.find<Array>("snippetUUIDs");
        if (!identifiers) return listed;
        for (const PropertyList& identifier : *identifiers) {
            const auto* text = identifier.as<std::u16string>();
            const auto found = text ? byIdentifier_.find(*text) : byIdentifier_.end();
            if (found == byIdentifier_.end()) continue;
            const std::size_t mention = mentions[*text]++;
            if (mention < found->second.size()) listed.push_back(found->second[mention]);
        }
        return listed;
    }

    void addUngrouped() {
        Snippets rest;
        std::copy_if(snippets_.begin(), snippets_.end(), std::back_inserter(rest),
                     [&](const auto& snippet) { return !grouped_.contains(snippet.get()); });
        if (rest.empty()) return;
        const std::string name = toUtf8(file_.title());
        if (!groups_.empty()) {
            remarks_.addCount(rest.size(), "snippet was in no group and is put into one named " + name,
                              "snippets were in no group and are put into one named " + name);
        }
        auto group = SnippetGroup::make();
        group->setName(file_.title());
        group->addItems(rest);
        groups_.push_back(std::move(group));
    }

    const PropertyList& list_;
    const ForeignFile& file_;
    Snippets snippets_;
    std::map<std::u16string, Snippets> byIdentifier_;
    std::unordered_set<const Snippet*> grouped_;
    std::vector<std::shared_ptr<SnippetGroup>> groups_;
    Remarks remarks_;
    std::size_t strange_ = 0;
    std::size_t tooMany_ = 0;
};

}  // namespace

Result<ImportedLibrary> libraryFromTextExpander(const PropertyList& list, const ForeignFile& file) {
    return TextExpanderReading(list, file).read();
}

Result<ImportedLibrary> importTextExpander(const ForeignFile& file) {
    const Result<PropertyList> list = readPropertyList(file.bytes);
    if (!list) return file.fault(list.error().message);
    return libraryFromTextExpander(list.value(), file);
}

}  // namespace plume
