// The store's file: made, examined, and put aside when it is damaged.
#pragma once

#include <filesystem>
#include <optional>

#include "Foundation/Result.h"

namespace plume {

struct StoreFile {
    static constexpr const char* Name = "plume.sqlite3";

    std::filesystem::path path;
    // Where the file that was there is now, because it is damaged; a fresh one has taken its place.
    std::optional<std::filesystem::path> damaged;
};

// The file in this folder, with the tables of this version of Plume; folder and file are made when they are not there.
// An error when they cannot be, when another program holds them, or when a newer Plume has written the file. Blocks;
// safe with other processes that do the same.
Result<StoreFile> prepareStoreFile(const std::filesystem::path& folder);

}  // namespace plume
