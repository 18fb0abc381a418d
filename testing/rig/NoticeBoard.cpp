#include "testing/rig/NoticeBoard.h"

#include <utility>

#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

constexpr const char* Interface = "org.freedesktop.Notifications";
constexpr const char* Path = "/org/freedesktop/Notifications";

}  // namespace

NoticeBoard::NoticeBoard() : connection_(openBus(sessionBusAddress())) {
    if (!connection_ ||
        dbus_bus_request_name(connection_.get(), Interface, 0, nullptr) != DBUS_REQUEST_NAME_REPLY_PRIMARY_OWNER) {
        throw RigError("the session's bus takes no service for notices");
    }
    thread_ = std::thread([this] { serve(); });
}

NoticeBoard::~NoticeBoard() {
    ended_ = true;
    thread_.join();
}

std::optional<std::string> NoticeBoard::body(const std::string& title) const {
    const std::scoped_lock lock(mutex_);
    const auto shown = shown_.find(title);
    return shown != shown_.end() ? std::optional(shown->second.body) : std::nullopt;
}

void NoticeBoard::press(const std::string& title, const std::string& label) {
    const std::scoped_lock lock(mutex_);
    const auto shown = shown_.find(title);
    if (shown == shown_.end() || !shown->second.buttons.contains(label)) return;
    const BusMessage signal(dbus_message_new_signal(Path, Interface, "ActionInvoked"));
    const char* name = shown->second.buttons.at(label).c_str();
    dbus_message_append_args(signal.get(), DBUS_TYPE_UINT32, &shown->second.number, DBUS_TYPE_STRING, &name,
                             DBUS_TYPE_INVALID);
    send(signal);
    shown_.erase(shown);
}

void NoticeBoard::serve() {
    constexpr int TurnMilliseconds = 5;
    while (!ended_ && dbus_connection_read_write(connection_.get(), TurnMilliseconds) != 0) {
        while (const BusMessage message{dbus_connection_pop_message(connection_.get())}) {
            if (dbus_message_get_type(message.get()) == DBUS_MESSAGE_TYPE_METHOD_CALL) answer(message.get());
        }
    }
}

void NoticeBoard::answer(DBusMessage* call) {
    const BusMessage reply(dbus_message_new_method_return(call));
    if (std::string(dbus_message_get_member(call)) == "Notify") {
        const std::uint32_t number = keep(call);
        dbus_message_append_args(reply.get(), DBUS_TYPE_UINT32, &number, DBUS_TYPE_INVALID);
    } else {
        const char* abilities[] = {"actions", "body", "body-markup"};
        const char** list = abilities;
        dbus_message_append_args(reply.get(), DBUS_TYPE_ARRAY, DBUS_TYPE_STRING, static_cast<void*>(&list), 3,
                                 DBUS_TYPE_INVALID);
    }
    send(reply);
}

std::uint32_t NoticeBoard::keep(DBusMessage* call) {
    BusReader values(call);
    values.string();  // the program
    values.uint32();
    values.string();  // the icon
    const std::string title = values.string().value_or("");
    Shown shown{++last_, values.string().value_or(""), {}};
    for (BusReader buttons = values.inside(); !buttons.isAtEnd();) {
        const std::string name = buttons.string().value_or("");
        shown.buttons[buttons.string().value_or("")] = name;
    }
    const std::scoped_lock lock(mutex_);
    shown_[title] = std::move(shown);
    return last_;
}

}  // namespace plume::rig
