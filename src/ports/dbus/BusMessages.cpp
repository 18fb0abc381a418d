#include "ports/dbus/BusMessages.h"

#include <unistd.h>

#include <cstdlib>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr int LongestWelcome = 5'000;  // milliseconds

void append(DBusMessageIter& iterator, const std::string& value) {
    // libdbus ends the program that hands it what is no UTF-8.
    const bool isValid = dbus_validate_utf8(value.c_str(), nullptr) != 0;
    const std::string valid = isValid ? value : toUtf8(fromUtf8(value));
    const char* text = valid.c_str();
    dbus_message_iter_append_basic(&iterator, DBUS_TYPE_STRING, static_cast<const void*>(&text));
}

void append(DBusMessageIter& iterator, std::int32_t value) {
    dbus_message_iter_append_basic(&iterator, DBUS_TYPE_INT32, &value);
}

void append(DBusMessageIter& iterator, std::uint32_t value) {
    dbus_message_iter_append_basic(&iterator, DBUS_TYPE_UINT32, &value);
}

void append(DBusMessageIter& iterator, const std::vector<std::string>& values) {
    DBusMessageIter list;
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_ARRAY, DBUS_TYPE_STRING_AS_STRING, &list);
    for (const std::string& value : values) append(list, value);
    dbus_message_iter_close_container(&iterator, &list);
}

void append(DBusMessageIter& iterator, BusFlag value) {
    const dbus_bool_t on = value.on ? TRUE : FALSE;
    DBusMessageIter variant;
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_VARIANT, DBUS_TYPE_BOOLEAN_AS_STRING, &variant);
    dbus_message_iter_append_basic(&variant, DBUS_TYPE_BOOLEAN, &on);
    dbus_message_iter_close_container(&iterator, &variant);
}

void append(DBusMessageIter& iterator, BusNoOptions /*none*/) {
    DBusMessageIter table;
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_ARRAY, "{sv}", &table);
    dbus_message_iter_close_container(&iterator, &table);
}

}  // namespace

std::string sessionBusAddress() {
    const char* address = std::getenv("DBUS_SESSION_BUS_ADDRESS");
    if (address != nullptr && *address != '\0') return address;
    const char* folder = std::getenv("XDG_RUNTIME_DIR");
    const std::string socket = std::string(folder != nullptr ? folder : "") + "/bus";
    if (folder == nullptr || access(socket.c_str(), F_OK) != 0) return {};
    const std::unique_ptr<char, void (*)(void*)> escaped(dbus_address_escape_value(socket.c_str()), dbus_free);
    return escaped ? std::string("unix:path=") + escaped.get() : std::string();
}

BusConnection openBus(const std::string& address) {
    BusConnection connection(dbus_connection_open_private(address.c_str(), nullptr));
    if (!connection) return nullptr;
    dbus_connection_set_exit_on_disconnect(connection.get(), FALSE);
    // What libdbus has for this waits for 25 seconds.
    const BusMessage hello = newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, DBUS_INTERFACE_DBUS}, "Hello");
    const BusAnswer welcome(
        BusMessage(dbus_connection_send_with_reply_and_block(connection.get(), hello.get(), LongestWelcome, nullptr)));
    const auto name = welcome.values().string();
    if (!name || dbus_bus_set_unique_name(connection.get(), name->c_str()) == 0) return nullptr;
    return connection;
}

BusMessage newCall(const BusAddress& to, const char* method, std::initializer_list<BusValue> arguments) {
    BusMessage call(dbus_message_new_method_call(to.name, to.path, to.interface, method));
    if (!call) return nullptr;
    DBusMessageIter iterator;
    dbus_message_iter_init_append(call.get(), &iterator);
    for (const BusValue& argument : arguments) {
        std::visit([&](const auto& value) { append(iterator, value); }, argument);
    }
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

}  // namespace plume
