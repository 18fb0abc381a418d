// D-Bus messages: what is said on a bus, and connections to say it on.
//
// Whatever is here may be used on any thread, by one at a time.
#pragma once

#include <dbus/dbus.h>

#include <cstdint>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

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

// A connection of its own to a bus; none when there is no bus, or it does not accept it. Waits for five seconds at
// most. It never ends the program when the bus goes.
BusConnection openBus(const std::string& address);

// Where the session's bus is; empty when there is none. Not libdbus's own search for it, which would start a bus where
// there is none.
std::string sessionBusAddress();

// What a method is called on.
struct BusAddress {
    const char* name;
    const char* path;
    const char* interface;
};

// A boolean inside a variant, as properties are set.
struct BusFlag {
    bool on = false;
};
// An empty table of names and values.
struct BusNoOptions {};
using BusValue =
    std::variant<std::int32_t, std::uint32_t, std::string, std::vector<std::string>, BusFlag, BusNoOptions>;

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

}  // namespace plume
