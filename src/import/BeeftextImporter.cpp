// The backups and exports of Beeftext: JSON, and separated values that hold its variables.
#include <map>
#include <memory>
#include <tuple>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLImport.h"
#include "import/BeeftextVariables.h"
#include "import/ForeignFile.h"
#include "import/JsonMembers.h"
#include "import/Remarks.h"

namespace plume {

namespace {

// The numbers in the file; 0 is the user's setting, which is the stricter way unless changed.
enum class Matching : std::int8_t { Default = 0, Strict = 1, Loose = 2 };
enum class Case : std::int8_t { Default = 0, Sensitive = 1, Insensitive = 2 };

std::int64_t integerIn(const JsonMembers& members, std::string_view key) {
    const auto found = members.find(key);
    return found ? found->integer() : 0;
}

// The first of the names, of which later versions of the file have the first.
std::u16string textIn(const JsonMembers& members, std::initializer_list<std::string_view> names) {
    for (const std::string_view name : names) {
        if (const auto found = members.find(name)) return found->string();
    }
    return {};
}

class Reader {
  public:
    explicit Reader(const ForeignFile& file) : file_(file), variables_(texts_, scripts_) {}

    ImportedLibrary read() {
        const JsonNode root = JsonNode::parse(file_.bytes, file_.path.string());
        const JsonMembers members(root);
        const auto combos = members.find("combos");
        if (!combos) root.fail("expected \"combos\", the snippets of Beeftext, or a list of Plume's groups");
        if (const auto groups = members.find("groups")) readGroups(*groups);
        const std::vector<JsonNode> all = combos->elements();
        for (const JsonNode& node : all) {
            const JsonMembers combo(node);
            texts_.emplace(textIn(combo, {"keyword", "comboText"}), textIn(combo, {"snippet", "substitutionText"}));
        }
        for (const JsonNode& combo : all) add(JsonMembers(combo));
        if (auto group = scripts_.group(u"Beeftext scripts")) library_.groups.push_back(std::move(group));
        library_.remarks = remarks_.take();
        return std::move(library_);
    }

  private:
    struct Group {
        std::u16string name;
        bool isEnabled = true;
    };
    // Of a combo: its group, whether it expands within words, whether it expands at all.
    using GroupKey = std::tuple<std::u16string, bool, bool>;

    void readGroups(const JsonNode& list) {
        for (const JsonNode& node : list.elements()) {
            const JsonMembers members(node);
            groups_[members.string("uuid")] = {members.string("name"), members.boolean("enabled", true)};
        }
    }

    void add(const JsonMembers& combo) {
        const std::u16string keyword = textIn(combo, {"keyword", "comboText"});
        if (count_ == MostImportedSnippets) remarks_.add("the rest of the snippets is too many");
        if (++count_ > MostImportedSnippets) return;
        auto snippet = std::make_shared<Snippet>(keyword, std::nullopt);
        const std::u16string name = combo.string("name");
        if (!name.empty()) snippet->setLabel(name);
        const std::u16string description = combo.string("description");
        if (!description.empty()) snippet->setNote(description);
        if (integerIn(combo, "caseSensitivity") == static_cast<int>(Case::Insensitive)) {
            snippet->setCaseSensitivity(CaseSensitivity::IgnoreCase);
        }
        setContent(combo, *snippet);
        for (const std::string& problem : variables_.takeProblems()) remarks_.add(*snippet, problem);
        groupFor(combo).addItem(snippet);
    }

    void setContent(const JsonMembers& combo, Snippet& snippet) {
        const std::u16string text = textIn(combo, {"snippet", "substitutionText"});
        const std::u16string& keyword = *snippet.abbreviation();
        if (combo.boolean("useHtml", false)) {
            snippet.setContentType(ContentType::RichText);
            snippet.setRichTextContent(variables_.expand(attributedStringFromHTML(toUtf8(text)), keyword));
        } else {
            snippet.setPlainTextContent(variables_.expand(text, keyword));
        }
    }

    SnippetGroup& groupFor(const JsonMembers& combo) {
        const std::u16string uuid = textIn(combo, {"group", "groupUuid"});
        const auto known = groups_.find(uuid);
        const Group own = known == groups_.end() ? Group{file_.title(), true} : known->second;
        const bool isLoose = integerIn(combo, "matchingMode") == static_cast<int>(Matching::Loose);
        const bool isEnabled = own.isEnabled && combo.boolean("enabled", true);
        auto& group = made_[GroupKey(uuid, isLoose, isEnabled)];
        if (group) return *group;
        group = SnippetGroup::make();
        group->setName(own.name + (isEnabled ? u"" : u" (switched off)"));
        group->setExpandAfter(isLoose ? ExpandAfter::Anything : ExpandAfter::Delimiter);
        group->setExpandTrigger(isEnabled ? ExpandTrigger::Immediately : ExpandTrigger::Never);
        library_.groups.push_back(group);
        return *group;
    }

    const ForeignFile& file_;
    ImportedLibrary library_;
    Remarks remarks_;
    ScriptShelf scripts_;
    BeeftextVariables::Texts texts_;
    BeeftextVariables variables_;
    std::map<std::u16string, Group> groups_;
    std::map<GroupKey, std::shared_ptr<SnippetGroup>> made_;
    std::size_t count_ = 0;
};

}  // namespace

Result<ImportedLibrary> importBeeftext(const ForeignFile& file) {
    return readingJson([&] { return Reader(file).read(); });
}

void convertBeeftextVariables(ImportedLibrary& library) {
    ScriptShelf scripts;
    BeeftextVariables::Texts texts;
    std::vector<std::shared_ptr<Snippet>> found;
    for (const auto& group : library.groups) {
        for (const auto& snippet : group->items()) {
            const std::u16string text = snippet->plainTextContent().value_or(u"");
            if (snippet->abbreviation()) texts.emplace(*snippet->abbreviation(), text);
            if (BeeftextVariables::areIn(text)) found.push_back(snippet);
        }
    }
    Remarks remarks;
    BeeftextVariables variables(texts, scripts);
    for (const auto& snippet : found) {
        snippet->setPlainTextContent(
            variables.expand(*snippet->plainTextContent(), snippet->abbreviation().value_or(u"Beeftext")));
        for (const std::string& problem : variables.takeProblems()) remarks.add(*snippet, problem);
    }
    remarks.addCount(found.size(), "snippet has variables of Beeftext, which are placeholders now",
                     "snippets have variables of Beeftext, which are placeholders now");
    if (auto group = scripts.group(u"Beeftext scripts")) library.groups.push_back(std::move(group));
    for (std::string& line : remarks.take()) library.remarks.push_back(std::move(line));
}

}  // namespace plume
