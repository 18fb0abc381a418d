#include "app/editing/ImportPreview.h"

#include <algorithm>
#include <numeric>
#include <unordered_map>

#include "import/Importers.h"
#include "library/LibraryExport.h"

namespace plume {

namespace {

struct Holder {
    std::shared_ptr<Snippet> snippet;
    std::shared_ptr<SnippetGroup> group;
    bool isInLibrary;
};

// By the abbreviation with its prefix.
using Holders = std::unordered_map<std::u16string, Holder>;

// A snippet can be listed in several groups of an imported library: its prefix is that of the list.
std::u16string abbreviationIn(const SnippetGroup& group, const Snippet& snippet) {
    const std::u16string abbreviation = snippet.abbreviation().value_or(u"");
    return abbreviation.empty() ? abbreviation : group.abbreviationPrefix().value_or(u"") + abbreviation;
}

bool haveSameContents(const ImportedLibrary& one, const ImportedLibrary& other) {
    return std::equal(one.groups.begin(), one.groups.end(), other.groups.begin(), other.groups.end(),
                      [](const auto& a, const auto& b) {
                          return std::equal(a->items().begin(), a->items().end(), b->items().begin(), b->items().end(),
                                            [](const auto& x, const auto& y) { return x->isContentEqualTo(*y); });
                      });
}

bool isFilledAnew(const SnippetGroup& group, const SnippetGroups& library) {
    return group.name() == SystemSubstitutionsGroup &&
           std::any_of(library.begin(), library.end(), [&](const auto& each) { return each->name() == group.name(); });
}

Holders holdersIn(const SnippetGroups& library, bool isOneFilledAnew) {
    Holders holders;
    const SnippetGroup* emptied = nullptr;
    for (const auto& group : library) {
        if (isOneFilledAnew && !emptied && group->name() == SystemSubstitutionsGroup) {
            emptied = group.get();
            continue;
        }
        for (const auto& snippet : group->items()) {
            holders.try_emplace(abbreviationIn(*group, *snippet), Holder{snippet, group, true});
        }
    }
    return holders;
}

ImportPreview::Group previewOf(const std::shared_ptr<SnippetGroup>& group, bool replaces, Holders& holders) {
    ImportPreview::Group preview{.group = group, .replaces = replaces, .conflicts = {}};
    for (const auto& snippet : group->items()) {
        const std::u16string abbreviation = abbreviationIn(*group, *snippet);
        if (abbreviation.empty()) continue;
        const auto [found, isNew] = holders.try_emplace(abbreviation, Holder{snippet, group, false});
        if (isNew) continue;
        const Holder& holder = found->second;
        preview.conflicts.push_back({.snippet = snippet,
                                     .with = holder.snippet,
                                     .withGroup = holder.group,
                                     .isInLibrary = holder.isInLibrary,
                                     .isSame = snippet->isContentEqualTo(*holder.snippet)});
    }
    return preview;
}

}  // namespace

Result<ImportCandidate> readForImport(const std::filesystem::path& path, const Files& files) {
    auto library = importLibrary(path, files);
    if (!library) return library.error();
    ImportCandidate candidate{.library = std::move(library).value(), .converted = {}};
    if (extensionOf(path.filename().string()) != "csv") return candidate;
    auto converted = importLibrary(path, files, {.textExpanderPlaceholders = true});
    if (converted && !haveSameContents(candidate.library, converted.value())) {
        candidate.converted = std::move(converted).value();
    }
    return candidate;
}

std::size_t ImportPreview::snippetCount() const {
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const Group& each) { return sum + each.group->items().size(); });
}

ImportPreview importPreview(const ImportedLibrary& imported, const SnippetGroups& library) {
    const auto isAnew = [&](const auto& group) { return isFilledAnew(*group, library); };
    Holders holders = holdersIn(library, std::any_of(imported.groups.begin(), imported.groups.end(), isAnew));
    ImportPreview preview{.groups = {}, .remarks = imported.remarks};
    preview.groups.reserve(imported.groups.size());
    for (const auto& group : imported.groups) preview.groups.push_back(previewOf(group, isAnew(group), holders));
    return preview;
}

}  // namespace plume
