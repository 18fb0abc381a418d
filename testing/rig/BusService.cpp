#include "testing/rig/BusService.h"

#include <utility>

#include "testing/rig/RigError.h"

namespace plume::rig {

BusService::BusService(const std::string& address, const std::string& name, Answer answer)
    : connection_(openBus(address)), answer_(std::move(answer)) {
    const bool owned = connection_ && dbus_bus_request_name(connection_.get(), name.c_str(), 0, nullptr) ==
                                          DBUS_REQUEST_NAME_REPLY_PRIMARY_OWNER;
    if (!owned) throw RigError("a bus takes no service named " + name);
    thread_ = std::thread([this] { serve(); });
}

BusService::~BusService() {
    ended_ = true;
    thread_.join();
}

void BusService::serve() {
    constexpr int TurnMilliseconds = 5;
    while (!ended_ && dbus_connection_read_write(connection_.get(), TurnMilliseconds) != 0) {
        while (const BusMessage message{dbus_connection_pop_message(connection_.get())}) {
            if (dbus_message_get_type(message.get()) != DBUS_MESSAGE_TYPE_METHOD_CALL) continue;
            if (const BusMessage answer = answer_(message.get())) send(answer);
        }
    }
}

}  // namespace plume::rig
