// What the welcome needs of the program around it.
//
// Everything is called on the main thread and outlives the window; answers come by the functions that are given, and
// may come when the window is gone.
#pragma once

#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

struct WelcomeServices {
    // Something to be tried: what to type, and what the running Plume makes of it.
    struct Trial {
        std::u16string abbreviation;
        std::u16string expansion;
        // It expands when a space follows.
        bool needsDelimiter = false;
    };
    // The library of another program that was found on this computer.
    struct FoundLibrary {
        std::u16string name;
        std::filesystem::path path;
    };

    std::vector<Trial> trials = {};
    std::vector<FoundLibrary> foundLibraries = {};
    // Tells what was imported in one sentence, or why nothing was.
    std::function<void(const FoundLibrary&, std::function<void(const Result<std::string>&)> told)> import = {};
    // Whether the desktop shows Plume's icon now.
    std::function<bool()> hasIcon = {};
    std::function<bool()> startsAtLogin = {};
    std::function<Result<void>(bool starts)> setStartsAtLogin = {};
    // Whether Plume is to expand in its own windows, too: while this one is there to try it. May be empty.
    std::function<void(bool expands)> setExpandsInOwnWindows = {};
};

}  // namespace plume
