#pragma once

#include <string>
#include <vector>

#include "ports/atspi/AtspiBus.h"

namespace plume::rig {

// Counts the calls of some methods that anybody makes over a bus, from the constructor on.
class BusMonitor {
  public:
    BusMonitor(const std::string& address, const std::vector<std::string>& methods);  // throws RigError

    // Of all methods so far.
    int count();
    void forget() {
        count();
        count_ = 0;
    }

  private:
    BusConnection connection_;
    int count_ = 0;
};

}  // namespace plume::rig
