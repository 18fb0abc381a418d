#include "app/cli/SearchCommand.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <ostream>
#include <set>
#include <vector>

#include "Foundation/Strings.h"
#include "app/cli/CommandLine.h"
#include "app/cli/SnippetLine.h"
#include "app/ranking/SnippetRanking.h"
#include "library/SnippetUses.h"

namespace plume {

namespace {

constexpr const char* Divider = "  -- similar --";

bool noteHoldsAll(const Snippet& snippet, const std::vector<std::u16string>& words) {
    const std::u16string note = snippet.note().value_or(u"");
    return !note.empty() && std::all_of(words.begin(), words.end(), [&](const std::u16string& word) {
        return word.empty() || containsIgnoringCase(note, word);
    });
}

// Notes are no field of quick search; what is found in them comes last.
void addByNotes(const ChosenLibrary& library, const std::u16string& text, std::vector<RankedSnippet>& rows) {
    if (trimmed(text).empty()) return;
    std::set<const Snippet*> known;
    for (const RankedSnippet& row : rows) known.insert(row.snippet.get());
    const std::vector<std::u16string> words = split(text, u' ');
    for (const auto& group : library.groups) {
        for (const auto& snippet : group->items()) {
            if (!known.contains(snippet.get()) && noteHoldsAll(*snippet, words)) rows.push_back({snippet, group, true});
        }
    }
}

std::vector<RankedSnippet> search(const ChosenLibrary& library, const std::u16string& text) {
    MemoryUserDefaults& settings = *library.settings;
    const SnippetUses uses(settings);
    SnippetRanking ranking;
    ranking.setLibrary(library.groups);
    ranking.setUses(&uses);
    const SearchRule rule{.searchBy = settings.integerForKey("SnippetQuickSearchSearchBy"),
                          .isWildcard = settings.integerForKey("SnippetQuickSearchWildcardSearch") == 1};
    std::vector<RankedSnippet> rows = ranking.search(text, rule);
    addByNotes(library, text, rows);
    return rows;
}

void showRows(const std::vector<RankedSnippet>& rows, std::ostream& output) {
    std::size_t width = 0;
    for (const RankedSnippet& row : rows) width = std::max(width, typedWidth(*row.snippet));
    bool isBelow = false;
    for (const RankedSnippet& row : rows) {
        if (row.isLoose && !isBelow) output << Divider << '\n';
        isBelow = row.isLoose;
        output << snippetLine(*row.snippet, width) << "  (" << toUtf8(row.group->name().value_or(u"")) << ")\n";
    }
}

nlohmann::ordered_json jsonOf(const RankedSnippet& row) {
    const Snippet& snippet = *row.snippet;
    const std::u16string content = snippet.plainTextContent().value_or(u"");
    const auto text = [](const std::optional<std::u16string>& value) { return toUtf8(value.value_or(u"")); };
    return {{"abbreviation", text(snippet.abbreviationWithPrefix())},
            {"label", text(snippet.label())},
            {"group", text(row.group->name())},
            {"content", toUtf8(content.substr(0, content.find_first_of(u"\r\n")))},
            {"uuid", snippet.uuid() ? toUtf8(snippet.uuid()->toString()) : ""},
            {"loose", row.isLoose}};
}

void showAsJson(const std::vector<RankedSnippet>& rows, std::ostream& output) {
    auto all = nlohmann::ordered_json::array();
    for (const RankedSnippet& row : rows) all.push_back(jsonOf(row));
    output << all.dump(2) << '\n';
}

}  // namespace

int searchSnippets(const ChosenLibrary& library, const std::string& text, bool asJson, std::ostream& output,
                   std::ostream& error) {
    const std::vector<RankedSnippet> rows = search(library, fromUtf8(text));
    if (asJson) {
        showAsJson(rows, output);
    } else {
        showRows(rows, output);
    }
    if (!rows.empty()) return ExitStatus::Success;
    error << "plume: no snippet in " << library.file.string() << " holds \"" << text << "\"\n";
    return ExitStatus::Failure;
}

}  // namespace plume
