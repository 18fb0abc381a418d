// The real thing: expands in every program of the session until it is asked to end.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>

#include "app/cli/LibraryChoice.h"

namespace plume {

// Returns the exit status when SIGINT, SIGTERM or SIGHUP has come, or something essential is missing. On the thread
// that main() runs on, before any other exists: it becomes the main thread, and a second one hears the keys.
int runInSession(const ChosenLibrary& library, const std::optional<std::string>& settingsFile, std::ostream& output,
                 std::ostream& error);

}  // namespace plume
