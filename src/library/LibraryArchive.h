// The library as one archive: what the store, backups, exports and the sync file hold.
//
// Pure; from any thread, as far as nobody changes the records meanwhile.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"
#include "library/SnippetGroup.h"

namespace plume {

using SnippetGroups = std::vector<std::shared_ptr<SnippetGroup>>;

// Everything but the groups can be missing in an archive.
struct LibraryContents {
    using Text = std::optional<std::u16string>;

    SnippetGroups snippetGroups;
    std::optional<Date> dateInstalled;
    Text uuidString;         // of the library
    Text versionUUIDString;  // of its present state
    std::optional<Date> dateCreated;
    std::optional<PropertyList::Dictionary> preferences;
};

// Rewrites a content of older versions in today's syntax.
using ConvertOldSnippet = std::function<void(Snippet&)>;

std::string libraryArchive(const LibraryContents& contents);
// One group alone: without the identities that belong to a library.
std::string groupArchive(const std::shared_ptr<SnippetGroup>& group, const std::optional<Date>& dateInstalled);

// The error says what is wrong with the bytes. Contents that an older version wrote are converted; an empty
// `convertOldSnippet` leaves them as they are. A snippet whose conversion throws stays as it was.
Result<LibraryContents> readLibraryArchive(std::string_view bytes, const ConvertOldSnippet& convertOldSnippet);

// A snippet whose conversion throws stays as it was.
void convertOldSnippets(const SnippetGroups& groups, const ConvertOldSnippet& convertOldSnippet);

}  // namespace plume
