#include "app/editing/ExportedFile.h"

#include <algorithm>
#include <unordered_set>

#include "library/LibraryExport.h"
#include "library/LibraryFile.h"

namespace plume {

namespace {

std::string archiveOf(const SnippetGroups& groups, const std::optional<Date>& dateInstalled) {
    if (groups.size() == 1) return groupArchive(groups.front(), dateInstalled);
    LibraryContents contents;
    contents.snippetGroups = groups;
    contents.dateInstalled = dateInstalled;
    return libraryArchive(contents);
}

}  // namespace

const std::vector<std::string>& exportableExtensions() {
    static const std::vector<std::string> extensions{"plume", "csv", "json", "rtf"};
    return extensions;
}

SnippetGroups groupsOfSelection(const LibrarySelection& selection, const SnippetGroups& library) {
    const std::unordered_set<std::shared_ptr<SnippetGroup>> whole(selection.groups.begin(), selection.groups.end());
    const std::unordered_set<std::shared_ptr<Snippet>> single(selection.snippets.begin(), selection.snippets.end());
    SnippetGroups groups;
    for (const auto& group : library) {
        const bool isWhole = whole.contains(group);
        const auto copy = group->snapshot();
        std::vector<std::shared_ptr<Snippet>> snippets;
        for (const auto& snippet : group->items()) {
            if (isWhole || single.contains(snippet)) snippets.push_back(snippet->snapshot());
        }
        if (!isWhole && snippets.empty()) continue;
        copy->addItems(snippets);
        groups.push_back(copy);
    }
    return groups;
}

Result<std::string> exportedFile(const SnippetGroups& groups, const std::filesystem::path& path,
                                 const std::optional<Date>& dateInstalled) {
    const std::string extension = extensionOf(path.filename().string());
    if (extension == "plume") return archiveOf(groups, dateInstalled);
    if (extension == "csv") return groups.size() == 1 ? csvFromGroup(*groups.front()) : csvFromLibrary(groups);
    if (extension == "json") return LibraryFile::write(groups);
    if (extension == "rtf") return rtfFromGroups(groups);
    return Error{path.string() + ": snippets can be written to files that end with .plume, .csv, .json or .rtf"};
}

}  // namespace plume
