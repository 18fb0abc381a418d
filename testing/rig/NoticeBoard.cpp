#include "testing/rig/NoticeBoard.h"

#include <utility>

namespace plume::rig {

namespace {

constexpr const char* Interface = "org.freedesktop.Notifications";
constexpr const char* Path = "/org/freedesktop/Notifications";

}  // namespace

NoticeBoard::NoticeBoard()
    : service_(sessionBusAddress(), Interface, [this](DBusMessage* call) { return answer(call); }) {}

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
    service_.send(signal);
    shown_.erase(shown);
}

BusMessage NoticeBoard::answer(DBusMessage* call) {
    BusMessage reply(dbus_message_new_method_return(call));
    if (std::string(dbus_message_get_member(call)) == "Notify") {
        const std::uint32_t number = keep(call);
        dbus_message_append_args(reply.get(), DBUS_TYPE_UINT32, &number, DBUS_TYPE_INVALID);
    } else {
        const char* abilities[] = {"actions", "body", "body-markup"};
        const char** list = abilities;
        dbus_message_append_args(reply.get(), DBUS_TYPE_ARRAY, DBUS_TYPE_STRING, static_cast<void*>(&list), 3,
                                 DBUS_TYPE_INVALID);
    }
    return reply;
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
