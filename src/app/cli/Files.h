// Files and folders that the command line works with.
#pragma once

#include <filesystem>
#include <string>

#include "Foundation/Result.h"

namespace plume {

// The whole file. The error names it, and says what is wrong with it; no file larger than 256 MiB is read.
Result<std::string> readWholeFile(const std::filesystem::path& path);

// Where the user's settings and library are: $XDG_CONFIG_HOME/plume, or ~/.config/plume. Empty without a home.
std::filesystem::path configurationFolder();
// Where backups are written until the user names another folder: $XDG_DATA_HOME/plume/Backups, or
// ~/.local/share/plume/Backups. Empty without a home.
std::filesystem::path backupFolder();
// What came with this program, found from where the program lies: ../share/plume beside its folder.
std::filesystem::path dataFolder();
// Plume's own sounds, of which some may be missing.
std::filesystem::path soundFolder();
// The texts of windows in other languages, of which some may be missing.
std::filesystem::path translationFolder();
// Where this program lies; empty when the system does not tell.
std::filesystem::path programFolder();

}  // namespace plume
