#include "ports/atspi/AtspiBus.h"

#include <algorithm>
#include <type_traits>

namespace plume {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds CallBound{150};
constexpr std::chrono::seconds SilentPause{1};
constexpr milliseconds ClockError{5};  // libdbus's, at most

void append(DBusMessageIter& iterator, const BusValue& value) {
    std::visit(
        [&](const auto& held) {
            using Held = std::remove_cvref_t<decltype(held)>;
            if constexpr (std::is_same_v<Held, std::string>) {
                const char* text = held.c_str();
                dbus_message_iter_append_basic(&iterator, DBUS_TYPE_STRING, static_cast<const void*>(&text));
            } else {
                constexpr int Type = std::is_signed_v<Held> ? DBUS_TYPE_INT32 : DBUS_TYPE_UINT32;
                dbus_message_iter_append_basic(&iterator, Type, &held);
            }
        },
        value);
}

}  // namespace

BusConnection openBus(const std::string& address) {
    BusConnection connection(dbus_connection_open_private(address.c_str(), nullptr));
    if (!connection) return nullptr;
    dbus_connection_set_exit_on_disconnect(connection.get(), FALSE);
    if (dbus_bus_register(connection.get(), nullptr) == 0) return nullptr;
    return connection;
}

BusMessage newCall(const BusAddress& to, const char* method, std::initializer_list<BusValue> arguments) {
    BusMessage call(dbus_message_new_method_call(to.name, to.path, to.interface, method));
    if (!call) return nullptr;
    DBusMessageIter iterator;
    dbus_message_iter_init_append(call.get(), &iterator);
    for (const BusValue& argument : arguments) append(iterator, argument);
    return call;
}

BusReader::BusReader(DBusMessage* message) : hasValues_(dbus_message_iter_init(message, &iterator_) != 0) {}

bool BusReader::isAt(int type) const {
    return hasValues_ && dbus_message_iter_get_arg_type(&iterator_) == type;
}

bool BusReader::isAtEnd() const {
    return !hasValues_ || isAt(DBUS_TYPE_INVALID);
}

std::optional<bool> BusReader::boolean() {
    if (!isAt(DBUS_TYPE_BOOLEAN)) return std::nullopt;
    dbus_bool_t value = FALSE;
    dbus_message_iter_get_basic(&iterator_, &value);
    dbus_message_iter_next(&iterator_);
    return value != 0;
}

std::optional<std::int32_t> BusReader::int32() {
    if (!isAt(DBUS_TYPE_INT32)) return std::nullopt;
    std::int32_t value = 0;
    dbus_message_iter_get_basic(&iterator_, &value);
    dbus_message_iter_next(&iterator_);
    return value;
}

std::optional<std::uint32_t> BusReader::uint32() {
    if (!isAt(DBUS_TYPE_UINT32)) return std::nullopt;
    std::uint32_t value = 0;
    dbus_message_iter_get_basic(&iterator_, &value);
    dbus_message_iter_next(&iterator_);
    return value;
}

std::optional<std::string> BusReader::textOfType(int type) {
    if (!isAt(type)) return std::nullopt;
    const char* value = nullptr;
    dbus_message_iter_get_basic(&iterator_, static_cast<void*>(&value));
    std::string text = value;
    dbus_message_iter_next(&iterator_);
    return text;
}

std::optional<std::string> BusReader::string() {
    return textOfType(DBUS_TYPE_STRING);
}

std::optional<std::string> BusReader::objectPath() {
    return textOfType(DBUS_TYPE_OBJECT_PATH);
}

BusReader BusReader::inside() {
    BusReader reader;
    if (isAtEnd()) return reader;
    if (isAt(DBUS_TYPE_VARIANT) || isAt(DBUS_TYPE_STRUCT) || isAt(DBUS_TYPE_ARRAY)) {
        dbus_message_iter_recurse(&iterator_, &reader.iterator_);
        reader.hasValues_ = true;
    }
    dbus_message_iter_next(&iterator_);
    return reader;
}

bool AtspiBus::connect(const std::string& address) {
    ++connections_;
    silentUntil_.clear();
    connection_ = openBus(address);
    return connection_ != nullptr;
}

bool AtspiBus::isConnected() const {
    return connection_ && dbus_connection_get_is_connected(connection_.get()) != 0;
}

void AtspiBus::begin(milliseconds bound) {
    end_ = Clock::now() + bound;
    leftUnanswered_ = false;
    forgetIncoming();
}

BusAnswer AtspiBus::call(const AtspiPart& part, const char* interface, const char* method,
                         std::initializer_list<BusValue> arguments) {
    if (!part) return {};
    return send(part.program, newCall({part.program.c_str(), part.path.c_str(), interface}, method, arguments));
}

BusAnswer AtspiBus::property(const AtspiPart& part, const char* interface, const char* name) {
    return call(part, DBUS_INTERFACE_PROPERTIES, "Get", {interface, name});
}

BusAnswer AtspiBus::callBus(const char* method, std::initializer_list<BusValue> arguments) {
    return send(DBUS_SERVICE_DBUS,
                newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, DBUS_INTERFACE_DBUS}, method, arguments));
}

BusAnswer AtspiBus::send(const std::string& program, const BusMessage& call) {
    const Clock::time_point begin = Clock::now();
    const auto bound = std::min(CallBound, std::chrono::ceil<milliseconds>(end_ - begin));
    if (!call || !isConnected() || bound.count() <= 0 || isSilent(program)) {
        leftUnanswered_ = true;
        return {};
    }
    BusMessage reply(dbus_connection_send_with_reply_and_block(connection_.get(), call.get(),
                                                               static_cast<int>(bound.count()), nullptr));
    if (reply) return BusAnswer(std::move(reply));
    // An error that comes at once is an answer: there is no such part, or the program has ended.
    const bool waited = Clock::now() - begin >= bound - ClockError;
    if (waited) noteSilent(program);
    if (waited || !isConnected()) leftUnanswered_ = true;
    return {};
}

bool AtspiBus::isSilent(const std::string& program) const {
    const auto found = silentUntil_.find(program);
    return found != silentUntil_.end() && Clock::now() < found->second;
}

void AtspiBus::noteSilent(const std::string& program) {
    const Clock::time_point now = Clock::now();
    std::erase_if(silentUntil_, [&](const auto& entry) { return entry.second <= now; });
    silentUntil_[program] = now + SilentPause;
}

int AtspiBus::descriptor() const {
    int descriptor = -1;
    if (!connection_ || dbus_connection_get_unix_fd(connection_.get(), &descriptor) == 0) return -1;
    return descriptor;
}

BusMessage AtspiBus::takeMessage() {
    if (!connection_) return nullptr;
    dbus_connection_read_write(connection_.get(), 0);
    return BusMessage(dbus_connection_pop_message(connection_.get()));
}

// Late replies, and what others send unasked: libdbus keeps them until somebody takes them.
void AtspiBus::forgetIncoming() {
    if (!connection_) return;
    while (dbus_connection_dispatch(connection_.get()) == DBUS_DISPATCH_DATA_REMAINS) {
    }
}

}  // namespace plume
