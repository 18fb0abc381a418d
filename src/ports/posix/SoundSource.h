// Where a sound that is known by name comes from.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace plume {

// One of both.
struct SoundSource {
    std::filesystem::path file;
    std::string event;  // of the desktop's sound theme
};

// Plume's own sound of this name, from the folder of these, or what comes closest to it in the sound theme.
SoundSource soundSourceOf(std::string_view name, const std::filesystem::path& ownSounds);

}  // namespace plume
