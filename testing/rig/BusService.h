#pragma once

#include <atomic>
#include <functional>
#include <string>
#include <thread>

#include "ports/dbus/BusMessages.h"

namespace plume::rig {

// A service on a bus, in the process of the test: a thread of its own answers calls.
class BusService {
  public:
    // What is sent for a call, on the thread; may be nothing.
    using Answer = std::function<BusMessage(DBusMessage* call)>;

    // Throws RigError when the bus does not give it that name.
    BusService(const std::string& address, const std::string& name, Answer answer);
    ~BusService();
    BusService(const BusService&) = delete;
    BusService& operator=(const BusService&) = delete;

    // From any thread.
    void send(const BusMessage& message) { dbus_connection_send(connection_.get(), message.get(), nullptr); }

  private:
    void serve();

    BusConnection connection_;
    const Answer answer_;
    std::atomic<bool> ended_ = false;
    std::thread thread_;
};

}  // namespace plume::rig
