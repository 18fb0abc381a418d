// What a file would bring into the library: looked at before anything is imported.
#pragma once

#include <cstddef>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "library/ImportedLibrary.h"
#include "library/LibraryArchive.h"
#include "platform/Files.h"

namespace plume {

// A file that was read. From any thread.
struct ImportCandidate {
    ImportedLibrary library;
    // The same with the placeholders of TextExpander converted; nothing where that makes no difference, and where the
    // format says by itself what its placeholders are.
    std::optional<ImportedLibrary> converted;
};
Result<ImportCandidate> readForImport(const std::filesystem::path& path, const Files& files);

struct ImportPreview {
    // An abbreviation, its group's prefix included, that another snippet has already.
    struct Conflict {
        std::shared_ptr<Snippet> snippet;
        // Who has it: the first in the library, else the one before in what comes.
        std::shared_ptr<Snippet> with;
        std::shared_ptr<SnippetGroup> withGroup;
        bool isInLibrary = false;
        // Both stand for the same.
        bool isSame = false;
    };
    struct Group {
        std::shared_ptr<SnippetGroup> group;
        // The snippets take the place of those in the library's group of this name.
        bool replaces = false;
        std::vector<Conflict> conflicts;  // in the order of the snippets
    };

    std::vector<Group> groups;
    std::vector<std::string> remarks;

    std::size_t snippetCount() const;
};

// On the thread that owns the library. Abbreviations count as different when their case differs.
ImportPreview importPreview(const ImportedLibrary& imported, const SnippetGroups& library);

}  // namespace plume
