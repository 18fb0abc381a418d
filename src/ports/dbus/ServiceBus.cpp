#include "ports/dbus/ServiceBus.h"

#include <string_view>
#include <utility>

namespace plume {

namespace {

constexpr double LongestAnswer = 5.0;  // seconds

}  // namespace

bool ServiceBus::connect(const std::string& address) {
    disconnect();
    if (address.empty()) return false;
    connection_ = openBus(address);
    int descriptor = -1;
    if (!connection_ || dbus_connection_get_unix_fd(connection_.get(), &descriptor) == 0) {
        connection_.reset();
        return false;
    }
    source_ = loop_.addSource(descriptor, [this] { drain(); });
    return true;
}

void ServiceBus::disconnect() {
    source_.end();
    waiting_.clear();
    connection_.reset();
}

void ServiceBus::call(const BusMessage& message, Reply reply) {
    dbus_uint32_t serial = 0;
    if (!connection_ || !message || dbus_connection_send(connection_.get(), message.get(), &serial) == 0) {
        loop_.perform([reply = std::move(reply)] { reply({}); });
        return;
    }
    waiting_[serial] = {std::move(reply),
                        loop_.performAfterDelay(LongestAnswer, [this, serial] { answer(serial, {}); })};
}

void ServiceBus::listen(const std::string& rule) {
    // Without an error to fill in, nobody waits for the bus.
    if (connection_) dbus_bus_add_match(connection_.get(), rule.c_str(), nullptr);
}

void ServiceBus::ignore(const std::string& rule) {
    if (connection_) dbus_bus_remove_match(connection_.get(), rule.c_str(), nullptr);
}

void ServiceBus::monitor(const std::vector<std::string>& rules, std::function<void(bool isAllowed)> begun) {
    call(newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, "org.freedesktop.DBus.Monitoring"}, "BecomeMonitor",
                 {rules, std::uint32_t{0}}),
         [begun = std::move(begun)](const BusAnswer& answer) { begun(static_cast<bool>(answer)); });
}

void ServiceBus::drain() {
    if (!connection_) return;
    dbus_connection_read_write(connection_.get(), 0);
    while (connection_) {
        const BusMessage message(dbus_connection_pop_message(connection_.get()));
        if (!message) break;
        take(*message);
    }
    if (!connection_ || dbus_connection_get_is_connected(connection_.get()) != 0) return;
    disconnect();
    if (lost) lost();
}

void ServiceBus::take(DBusMessage& message) {
    const char* const destination = dbus_message_get_destination(&message);
    if (destination != nullptr && std::string_view(destination) != name()) {
        if (overheard) overheard(message);
        return;
    }
    switch (dbus_message_get_type(&message)) {
        case DBUS_MESSAGE_TYPE_METHOD_RETURN:
            return answer(dbus_message_get_reply_serial(&message), BusAnswer(BusMessage(dbus_message_ref(&message))));
        case DBUS_MESSAGE_TYPE_ERROR:
            return answer(dbus_message_get_reply_serial(&message), {});
        case DBUS_MESSAGE_TYPE_SIGNAL:
            if (heard) heard(message);
            return;
        default:
            return;
    }
}

void ServiceBus::answer(std::uint32_t serial, BusAnswer answer) {
    const auto found = waiting_.find(serial);
    if (found == waiting_.end()) return;
    const Reply reply = std::move(found->second.reply);
    waiting_.erase(found);
    reply(answer);
}

}  // namespace plume
