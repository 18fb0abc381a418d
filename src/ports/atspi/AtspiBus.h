// D-Bus messages, and Plume's connection to the accessibility bus over which the parts of programs are asked.
//
// Bare libdbus, because libatspi asks each program for more: GTK 3 takes whoever listens for events, or asks for all
// its parts at once, for a screen reader, and from then on waits for the bus with every key that it gets. Plain
// questions like these leave programs as quick as they were.
#pragma once

#include <dbus/dbus.h>

#include <chrono>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace plume {

struct MessageUnref {
    void operator()(DBusMessage* message) const { dbus_message_unref(message); }
};
using BusMessage = std::unique_ptr<DBusMessage, MessageUnref>;

// For connections that are nobody else's.
struct ConnectionClose {
    void operator()(DBusConnection* connection) const {
        dbus_connection_close(connection);
        dbus_connection_unref(connection);
    }
};
using BusConnection = std::unique_ptr<DBusConnection, ConnectionClose>;

// A connection of its own to a bus; none when there is no bus, or it does not accept it. May wait for as long as
// libdbus does. It never ends the program when the bus goes.
BusConnection openBus(const std::string& address);

// What a method is called on.
struct BusAddress {
    const char* name;
    const char* path;
    const char* interface;
};

using BusValue = std::variant<std::int32_t, std::uint32_t, std::string>;

// Name and path must be valid ones: libdbus ends the program that hands it others.
BusMessage newCall(const BusAddress& to, const char* method, std::initializer_list<BusValue> arguments = {});

// Reads one value after the other. Asked for a value of another type than the next one, or past the end, it answers
// nothing and stays where it is. The message must outlive it.
class BusReader {
  public:
    BusReader() = default;  // of no values
    explicit BusReader(DBusMessage* message);

    std::optional<bool> boolean();
    std::optional<std::int32_t> int32();
    std::optional<std::uint32_t> uint32();
    std::optional<std::string> string();
    std::optional<std::string> objectPath();
    // What is inside the next value, which may be a variant, a structure or an array. Nothing is inside of others, but
    // they are passed by, too: a list is read to its end whatever is in it.
    BusReader inside();
    bool isAtEnd() const;

  private:
    bool isAt(int type) const;
    std::optional<std::string> textOfType(int type);

    mutable DBusMessageIter iterator_{};  // libdbus takes no constant ones
    bool hasValues_ = false;
};

// A reply, or none.
class BusAnswer {
  public:
    BusAnswer() = default;
    explicit BusAnswer(BusMessage message) : message_(std::move(message)) {}

    explicit operator bool() const { return message_ != nullptr; }
    BusReader values() const { return message_ ? BusReader(message_.get()) : BusReader(); }

  private:
    BusMessage message_;
};

// A part of a program's user interface: where it is on the bus. The empty one is none.
struct AtspiPart {
    std::string program;  // the unique name of its connection
    std::string path;

    explicit operator bool() const { return !path.empty(); }
    bool operator==(const AtspiPart&) const = default;
};

// Belongs to the accessibility thread.
class AtspiBus {
  public:
    // May wait for the bus for as long as libdbus does.
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
