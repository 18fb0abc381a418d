#include "app/editing/CopiedRows.h"

#include <set>
#include <utility>

namespace plume {

namespace {

class Identities {
  public:
    explicit Identities(const SnippetGroups& library) {
        for (const auto& group : library) {
            if (group->uuid()) taken_.insert(*group->uuid());
            for (const auto& snippet : group->items()) {
                if (snippet->uuid()) taken_.insert(*snippet->uuid());
            }
        }
    }
    // From now on it is taken.
    bool take(const std::optional<Uuid>& uuid) { return uuid && taken_.insert(*uuid).second; }

  private:
    std::set<Uuid> taken_;
};

std::shared_ptr<Snippet> withFreeIdentity(const std::shared_ptr<Snippet>& snippet, Identities& identities) {
    return identities.take(snippet->uuid()) ? snippet : snippet->copySnippet();
}

std::shared_ptr<SnippetGroup> withFreeIdentities(const std::shared_ptr<SnippetGroup>& group, Identities& identities) {
    if (!identities.take(group->uuid())) return group->copySnippetGroup(true);
    std::vector<std::shared_ptr<Snippet>> items;
    items.reserve(group->items().size());
    for (const auto& snippet : group->items()) items.push_back(withFreeIdentity(snippet, identities));
    group->replaceItems(items);
    return group;
}

}  // namespace

std::string archiveOfRows(const LibrarySelection& rows) {
    // Snippets that stand alone come first, in a group that is none of the library's.
    const auto loose = SnippetGroup::make();
    for (const auto& snippet : rows.snippets) loose->addItem(snippet->snapshot());
    LibraryContents contents;
    contents.snippetGroups.push_back(loose);
    contents.snippetGroups.insert(contents.snippetGroups.end(), rows.groups.begin(), rows.groups.end());
    return libraryArchive(contents);
}

Result<LibrarySelection> rowsOfArchive(std::string_view bytes, const SnippetGroups& library) {
    auto read = readLibraryArchive(bytes, {});
    if (!read) return read.error();
    LibrarySelection rows;
    Identities identities(library);
    const SnippetGroups groups = std::move(read).value().snippetGroups;
    if (groups.empty()) return rows;
    for (const auto& snippet : groups.front()->items()) {
        rows.snippets.push_back(withFreeIdentity(snippet, identities));
    }
    for (auto group = groups.begin() + 1; group != groups.end(); ++group) {
        rows.groups.push_back(withFreeIdentities(*group, identities));
    }
    return rows;
}

}  // namespace plume
