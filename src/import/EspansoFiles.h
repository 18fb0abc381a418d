// The files of an espanso folder or package: which are read, and in which applications what they hold is active.
//
// Throws YamlError.
#pragma once

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "import/Remarks.h"
#include "import/YamlFile.h"
#include "library/PLFunctionAvailability.h"
#include "platform/Files.h"

namespace plume {

struct EspansoFile {
    std::filesystem::path path;
    YamlValue::Pointer root;
    PLFunctionAvailability availability;
};

struct EspansoFiles {
    std::vector<EspansoFile> files;
    std::filesystem::path root;                    // the folder with match/ and config/; empty without one
    std::optional<std::u16string> wordSeparators;  // where the user set them
};

// `path` is a folder: the one with match/, match/ itself, or one with files of matches.
EspansoFiles espansoFilesIn(const std::filesystem::path& path, const Files& files, Remarks& remarks);
// One file, whose text is `bytes`, and what it imports; without `files` the latter are left out.
EspansoFiles espansoFile(const std::filesystem::path& path, std::string_view bytes, const Files* files,
                         Remarks& remarks);

}  // namespace plume
