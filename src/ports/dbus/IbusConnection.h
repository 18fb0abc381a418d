// What IBus says on the bus that it has of its own.
#pragma once

#include <functional>
#include <string>

#include "ports/dbus/ServiceBus.h"

namespace plume {

// Belongs to the thread of its loop, which outlives it.
class IbusConnection {
  public:
    explicit IbusConnection(PollRunLoop& loop);

    // The engine in force, by its name; empty when there is none, or IBus has gone.
    std::function<void(const std::string& name)> engineChanged;

    // Instead of an earlier connection. What is in force is told as soon as IBus has said it.
    void connect(const std::string& address);

  private:
    void hear(DBusMessage& message) const;
    void askForEngine();

    ServiceBus bus_;
};

}  // namespace plume
