// The terminals that programs run in, as the system keeps them: /dev/pts/3.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

namespace plume {

// Those in which processes below this one run, for a terminal program its windows and tabs, and those behind a terminal
// multiplexer that runs in one of them; not the one that it was started from itself. Reads a small file for each
// process of the system, which takes some milliseconds.
std::vector<std::string> terminalDevicesBelow(pid_t process);

// Whether a line is read there without being shown, as prompts for passwords do. A shell that edits its line reads keys
// and is none of these. False for a terminal of another user's. Takes microseconds and never waits for a program.
bool hidesInput(const std::string& device);

}  // namespace plume
