// What the program needs of the session and of the system, with windows or without.
#pragma once

#include <memory>
#include <string>

#include "app/cli/Voice.h"
#include "input/delivery/ApplicationTable.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

// The signals that end the program, as a descriptor. Made before other threads are, so that none of them gets one.
FileDescriptor endSignals();

// How the system's programs are typed to. What is wrong with the installed table is said, and the one that Plume was
// built with counts.
std::shared_ptr<const ApplicationTable> installedApplications(Voice& voice);

// The name of the system, as it calls itself.
std::string systemVersion();

}  // namespace plume
