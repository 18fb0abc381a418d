// Programs that are known to take keys or to type on their own, told by their names: X does not say who does.
#pragma once

#include <vector>

#include "platform/ProcessManager.h"

namespace plume {

// Those of the user that are running, ten at most. Reads the system's list of processes: some milliseconds.
std::vector<RunningApplication> runningKeyTools();

}  // namespace plume
