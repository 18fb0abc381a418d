// Plume's connection to the accessibility bus over which the parts of programs are asked.
//
// Bare libdbus, because libatspi asks each program for more: GTK 3 takes whoever listens for events, or asks for all
// its parts at once, for a screen reader, and from then on waits for the bus with every key that it gets. Plain
// questions like these leave programs as quick as they were.
#pragma once

#include <chrono>
#include <initializer_list>
#include <map>
#include <memory>
#include <string>

#include "ports/dbus/BusMessages.h"

namespace plume {

// A part of a program's user interface: where it is on the bus. The empty one is none.
struct AtspiPart {
    std::string program;  // the unique name of its connection
    std::string path;

    explicit operator bool() const { return !path.empty(); }
    bool operator==(const AtspiPart&) const = default;
};

struct PendingCallCancel {
    void operator()(DBusPendingCall* call) const {
        dbus_pending_call_cancel(call);
        dbus_pending_call_unref(call);
    }
};
using AtspiPendingCall = std::unique_ptr<DBusPendingCall, PendingCallCancel>;

// Belongs to the accessibility thread.
class AtspiBus {
  public:
    // Waits for the bus for some seconds at most.
    bool connect(const std::string& address);
    void disconnect() { connection_.reset(); }
    // False once a call has met a bus that is gone.
    bool isConnected() const;
    // How often it was connected: the next bus gives the names of the one before to other programs.
    int connections() const { return connections_; }

    // What is asked from here on until the next begin() may take that long altogether.
    void begin(std::chrono::milliseconds bound);
    // Whether something that was asked since begin() stayed unanswered, which says nothing about the part. A program
    // that says no, or has ended, has answered.
    bool leftUnanswered() const { return leftUnanswered_; }

    // One call takes 150 ms at most. A program that did not answer in time is not asked again for a second.
    BusAnswer call(const AtspiPart& part, const char* interface, const char* method,
                   std::initializer_list<BusValue> arguments = {});
    // The value stands inside a variant.
    BusAnswer property(const AtspiPart& part, const char* interface, const char* name);
    // A call that is on its way while another one is made. Its answer does not count as left out.
    AtspiPendingCall callAhead(const AtspiPart& part, const char* interface, const char* method);
    // Waits for the answer; nothing while the program is silent.
    BusAnswer answerTo(const AtspiPart& part, AtspiPendingCall call) const;
    BusAnswer callBus(const char* method, std::initializer_list<BusValue> arguments);

    // For whoever waits for signals: what to wait on, and the next message that has come, if any.
    int descriptor() const;
    BusMessage takeMessage();

  private:
    using Clock = std::chrono::steady_clock;

    BusAnswer send(const std::string& program, const BusMessage& call);
    bool isSilent(const std::string& program) const;
    void noteSilent(const std::string& program);
    void forgetIncoming();

    BusConnection connection_;
    int connections_ = 0;
    Clock::time_point end_{};
    bool leftUnanswered_ = false;
    std::map<std::string, Clock::time_point> silentUntil_;
};

}  // namespace plume
