// Tells when the machine goes to sleep and when it has woken up, by the system's login manager.
//
// Heard on a thread of its own. A system without a login manager never tells.
#pragma once

#include <functional>

#include "platform/RunLoop.h"
#include "ports/dbus/BusThread.h"

namespace plume {

class SleepSession;

class SystemSleep {
  public:
    // Told true before the sleep, or as soon as the process runs again, and false after it, on the main thread.
    using Listener = std::function<void(bool sleeps)>;

    // The loop outlives it.
    SystemSleep(RunLoop& mainLoop, Listener listener);
    ~SystemSleep();

  private:
    BusThread<SleepSession> thread_;
};

}  // namespace plume
