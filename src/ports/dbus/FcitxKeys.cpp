#include "ports/dbus/FcitxKeys.h"

#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::uint32_t FirstKeycode = 8;  // of X, for the first code of the hardware
constexpr std::uint32_t BackspaceSymbol = 0xFF08;

// What programs ask of their fields, what these tell them, and Fcitx's answers.
const std::vector<std::string>& rules() {
    static const std::vector<std::string> all = {
        "type='method_call',interface='org.fcitx.Fcitx.InputContext1',member='ProcessKeyEvent'",
        "type='signal',interface='org.fcitx.Fcitx.InputContext1'", "type='method_return',sender='org.fcitx.Fcitx5'",
        "type='method_return',sender='org.freedesktop.portal.Fcitx'"};
    return all;
}

bool is(DBusMessage& message, const char* member) {
    return dbus_message_has_member(&message, member) != 0;
}

// The pieces of a text, each with its looks.
bool hasText(BusReader pieces) {
    while (!pieces.isAtEnd()) {
        if (!pieces.inside().string().value_or("").empty()) return true;
    }
    return false;
}

}  // namespace

FcitxKeys::FcitxKeys(PollRunLoop& loop, ServiceBus& session, ComposedKeys& keys)
    : loop_(loop), session_(session), monitor_(loop), keys_(keys) {
    monitor_.overheard = [this](DBusMessage& message) { overhear(message); };
}

void FcitxKeys::connect(const std::string& address) {
    composes_ = true;
    goodbye_.cancel();
    if (isHearing_) return keys_.setTakesText(true);
    if (monitor_.isConnected() || !monitor_.connect(address)) return;
    key_ = {};
    unansweredPings_ = 0;
    monitor_.monitor(rules(), [this](bool isAllowed) {
        isHearing_ = isAllowed;
        keys_.setTakesText(isAllowed && composes_);
    });
}

void FcitxKeys::end() {
    constexpr double LongestWay = 0.5;  // seconds
    if (!std::exchange(composes_, false)) return;
    keys_.setTakesText(false);
    goodbye_ = loop_.performAfterDelay(LongestWay, [this] { disconnect(); });
}

void FcitxKeys::disconnect() {
    composes_ = isHearing_ = false;
    goodbye_.cancel();
    monitor_.disconnect();
    keys_.setTakesText(false);
}

void FcitxKeys::overhear(DBusMessage& message) {
    switch (dbus_message_get_type(&message)) {
        case DBUS_MESSAGE_TYPE_METHOD_CALL:
            return overhearCall(message);
        case DBUS_MESSAGE_TYPE_SIGNAL:
            return overhearSignal(message);
        default:
            return overhearReply(message);
    }
}

void FcitxKeys::overhearCall(DBusMessage& call) {
    const char* const path = dbus_message_get_path(&call);
    const char* const program = dbus_message_get_sender(&call);
    if (path == nullptr || program == nullptr) return;
    BusReader values(&call);
    const std::uint32_t symbol = values.uint32().value_or(0);
    const std::uint32_t code = values.uint32().value_or(0);
    values.uint32();  // the modifiers
    const bool isRelease = values.boolean().value_or(false);
    if (isRelease) return;
    if (focus_ != path) keys_.setComposing(false);
    focus_ = path;
    if (composes_) keys_.setTakesText(true);
    if (code < FirstKeycode || !keys_.beginsWith(code - FirstKeycode)) return;
    key_ = {program, dbus_message_get_serial(&call), symbol};
}

void FcitxKeys::overhearSignal(DBusMessage& signal) {
    // What another field gets does not come to where the user types.
    if (focus_.empty() || dbus_message_has_path(&signal, focus_.c_str()) == 0) return;
    BusReader values(&signal);
    if (is(signal, "CommitString")) {
        keys_.put(fromUtf8(values.string().value_or("")));
    } else if (is(signal, "UpdateFormattedPreedit") || is(signal, "UpdateClientSideUI")) {
        keys_.setComposing(hasText(values.inside()));
    } else if (is(signal, "DeleteSurroundingText")) {
        const std::int32_t offset = values.int32().value_or(0);
        const std::uint32_t count = values.uint32().value_or(0);
        if (offset < 0 && count == static_cast<std::uint32_t>(-offset)) keys_.erase(count);
    } else if (is(signal, "ForwardKey")) {
        forwardKey(signal);
    }
}

// Engines may give the program a key anew, or another one.
void FcitxKeys::forwardKey(DBusMessage& signal) {
    BusReader values(&signal);
    const std::uint32_t symbol = values.uint32().value_or(0);
    values.uint32();  // the modifiers
    const bool isRelease = values.boolean().value_or(false);
    if (isRelease) return;
    if (symbol == key_.symbol) return keys_.passKey();
    if (symbol == BackspaceSymbol) keys_.erase(1);
}

// What a key does is told behind its answer, and before that of what Fcitx is asked from then on.
void FcitxKeys::overhearReply(DBusMessage& reply) {
    const char* const fcitx = dbus_message_get_sender(&reply);
    if (dbus_message_has_destination(&reply, session_.name()) != 0) {
        if (unansweredPings_ > 0 && --unansweredPings_ == 0) keys_.end();
        return;
    }
    const bool isOfKey = !key_.isAnswered && dbus_message_get_reply_serial(&reply) == key_.call &&
                         dbus_message_has_destination(&reply, key_.program.c_str()) != 0;
    if (fcitx == nullptr || !isOfKey) return;
    key_.isAnswered = true;
    const bool isTaken = BusReader(&reply).boolean().value_or(false);
    if (!isTaken) keys_.passKey();
    ++unansweredPings_;
    session_.call(newCall({fcitx, "/controller", "org.freedesktop.DBus.Peer"}, "Ping"), [](const BusAnswer&) {});
}

}  // namespace plume
