// A connection to a bus on which services are called, and heard, without waiting for them.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "ports/dbus/BusMessages.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

// Belongs to the thread of its loop, which outlives it.
class ServiceBus {
  public:
    using Reply = std::function<void(const BusAnswer& answer)>;

    explicit ServiceBus(PollRunLoop& loop) : loop_(loop) {}
    ~ServiceBus() { disconnect(); }
    ServiceBus(const ServiceBus&) = delete;
    ServiceBus& operator=(const ServiceBus&) = delete;

    // Every signal that was listened for. It may call anything here.
    std::function<void(DBusMessage& signal)> heard;
    // Whatever was listened for and goes to somebody else; a bus that does not send such things to others never will.
    std::function<void(DBusMessage& message)> overheard;
    // The bus is gone.
    std::function<void()> lost;

    // Instead of an earlier connection. Waits for the bus for five seconds at most.
    bool connect(const std::string& address);
    // Calls that wait for an answer are forgotten.
    void disconnect();
    bool isConnected() const { return connection_ != nullptr; }
    // As the bus knows the connection; null when there is none.
    const char* name() const { return connection_ ? dbus_bus_get_unique_name(connection_.get()) : nullptr; }

    // The answer comes later, from the loop; an empty one when the service refuses, or says nothing for some seconds.
    void call(const BusMessage& message, Reply reply);
    // From now on, signals of this match rule.
    void listen(const std::string& rule);
    // No more.
    void ignore(const std::string& rule);
    // Nothing else from now on: it overhears whatever matches one of the rules, and can say nothing any more. Told once
    // the bus has begun, or does not allow it.
    void monitor(const std::vector<std::string>& rules, std::function<void(bool isAllowed)> begun);

  private:
    struct Waiting {
        Reply reply;
        Timer limit;
    };

    void drain();
    void take(DBusMessage& message);
    void answer(std::uint32_t serial, BusAnswer answer);

    PollRunLoop& loop_;
    BusConnection connection_;
    std::map<std::uint32_t, Waiting> waiting_;
    Subscription source_;
};

}  // namespace plume
