// What lists of programs need of the program around them.
//
// Everything is called on the main thread, nothing waits, and all of it outlives the lists. Answers come by the
// functions that are given, on the main thread; a list that is gone by then is the giver's to guard against.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/ProcessManager.h"

namespace plume {

struct InstalledProgram {
    std::u16string identifier;
    std::u16string name;
    std::string icon;  // of the desktop's icon theme, or a path; empty: none
};

struct ProgramServices {
    std::function<void(std::function<void(const std::vector<RunningApplication>&)> told)> runningPrograms;
    // The next program besides Plume that comes to the front within 20 seconds; nothing when none does.
    std::function<void(std::function<void(const std::optional<RunningApplication>&)> told)> nextFrontProgram;
    std::function<std::vector<InstalledProgram>()> installedPrograms;
};

}  // namespace plume
