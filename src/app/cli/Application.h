// The program as people have it in their session: with its icon and its windows, until it is asked to end.
#pragma once

#include <iosfwd>

namespace plume {

// On the thread that main() runs on, before any other exists: it becomes the main thread, and a second one hears the
// keys. Returns the exit status when the user, the session or SIGINT, SIGTERM or SIGHUP has ended the program. Another
// Plume that runs on this display is brought to the front instead.
int runApplication(int argc, char** argv, std::ostream& error);

}  // namespace plume
