// The real thing: expands in every program of the session until it is asked to end.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>

namespace plume {

// Expands the snippets of the file, also when it changes, or those of the user's own library; the settings are those of
// the file, or the user's own. Returns the exit status when SIGINT, SIGTERM or SIGHUP has come, or something essential
// is missing. On the thread that main() runs on, before any other exists: it becomes the main thread, and a second one
// hears the keys.
int runInSession(const std::optional<std::string>& libraryFile, const std::optional<std::string>& settingsFile,
                 std::ostream& output, std::ostream& error);

}  // namespace plume
