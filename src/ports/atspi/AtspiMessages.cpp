#include "ports/atspi/AtspiMessages.h"

#include <type_traits>

namespace plume {

namespace {

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

}  // namespace plume
