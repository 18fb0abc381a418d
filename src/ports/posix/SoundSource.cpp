#include "ports/posix/SoundSource.h"

#include <array>
#include <system_error>

namespace plume {

namespace {

struct EventName {
    std::string_view sound;
    const char* event;
};

constexpr std::array EventNames = {
    EventName{"Basso", "dialog-error"}, EventName{"Funk", "dialog-warning"}, EventName{"Glass", "complete"},
    EventName{"Ping", "bell"},          EventName{"Pop", "message"},
};

}  // namespace

SoundSource soundSourceOf(std::string_view name, const std::filesystem::path& ownSounds) {
    std::error_code problem;
    std::filesystem::path own = ownSounds / (std::string(name) + ".wav");
    const bool isName = !ownSounds.empty() && name.find('/') == std::string_view::npos;
    if (isName && std::filesystem::exists(own, problem)) {
        return {std::move(own), {}};
    }
    for (const EventName& known : EventNames) {
        if (known.sound == name) return {{}, known.event};
    }
    return {{}, std::string(name)};
}

}  // namespace plume
