#include "ports/dbus/IbusConnection.h"

#include <array>
#include <cstdlib>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr const char* Service = "org.freedesktop.IBus";
constexpr const char* Context = "org.freedesktop.IBus.InputContext";
constexpr BusAddress Properties{Service, "/org/freedesktop/IBus", "org.freedesktop.DBus.Properties"};
constexpr const char* EngineChanged = "GlobalEngineChanged";
// What programs ask of their contexts, what these tell them, and the answers.
constexpr std::array Overheard = {"eavesdrop='true',type='method_call',interface='org.freedesktop.IBus.InputContext'",
                                  "eavesdrop='true',type='signal',interface='org.freedesktop.IBus.InputContext'",
                                  "eavesdrop='true',type='method_return'"};
constexpr std::uint32_t Release = 1U << 30;  // among the modifiers of a key
constexpr std::uint32_t BackspaceSymbol = 0xFF08;

// IBus sends its objects as structures in variants: the class, attachments, then the fields. The first field of an
// engine is its name, that of a text what it says.
std::string firstFieldOf(BusReader& values) {
    BusReader object = values.inside().inside();
    object.string();
    object.inside();
    return object.string().value_or("");
}

struct Key {
    std::uint32_t symbol = 0;
    std::uint32_t code = 0;
    bool down = true;
};

Key keyIn(DBusMessage& message) {
    BusReader values(&message);
    Key key;
    key.symbol = values.uint32().value_or(0);
    key.code = values.uint32().value_or(0);
    key.down = (values.uint32().value_or(0) & Release) == 0;
    return key;
}

bool is(DBusMessage& message, const char* member) {
    return dbus_message_has_member(&message, member) != 0;
}

}  // namespace

IbusConnection::IbusConnection(PollRunLoop& loop, ComposedKeys& keys) : keys_(keys), bus_(loop) {
    bus_.heard = [this](DBusMessage& message) { hear(message); };
    bus_.overheard = [this](DBusMessage& message) { overhear(message); };
    bus_.lost = [this] { setEngine({}); };
}

void IbusConnection::connect(const std::string& address) {
    composes_ = false;
    if (!bus_.connect(address)) return setEngine({});
    bus_.listen(std::string("type='signal',interface='") + Service + "',member='" + EngineChanged + "'");
    askForEngine();
}

void IbusConnection::askForEngine() {
    const BusMessage call = newCall(Properties, "Get", {std::string(Service), std::string("GlobalEngine")});
    bus_.call(call, [this](const BusAnswer& answer) {
        BusReader property = answer.values().inside();
        setEngine(firstFieldOf(property));
    });
}

void IbusConnection::hear(DBusMessage& message) {
    if (dbus_message_is_signal(&message, Service, EngineChanged) == 0) return;
    setEngine(BusReader(&message).string().value_or(""));
}

void IbusConnection::setEngine(const std::string& name) {
    // Engines of this kind leave the keys alone.
    const bool composes = !name.empty() && !name.starts_with("xkb:");
    if (composes != composes_) {
        for (const char* rule : Overheard) composes ? bus_.listen(rule) : bus_.ignore(rule);
    }
    composes_ = composes;
    // Where the focus is by now nobody has said: the next key will tell.
    keys_.setTakesText(composes);
    engineChanged(composes ? name : std::string());
}

void IbusConnection::overhear(DBusMessage& message) {
    if (!composes_) return;
    switch (dbus_message_get_type(&message)) {
        case DBUS_MESSAGE_TYPE_METHOD_CALL:
            return overhearCall(message);
        case DBUS_MESSAGE_TYPE_SIGNAL:
            return overhearSignal(message);
        default:
            return overhearReply(message);
    }
}

void IbusConnection::overhearCall(DBusMessage& call) {
    const char* const path = dbus_message_get_path(&call);
    const char* const program = dbus_message_get_sender(&call);
    if (path == nullptr || program == nullptr || dbus_message_has_interface(&call, Context) == 0) return;
    if (is(call, "FocusOut") && focus_ == path) {
        focus_.clear();
        keys_.setTakesText(false);
    } else if (is(call, "FocusIn")) {
        focus_ = path;
        keys_.setComposing(false);
        keys_.setTakesText(true);
    } else if (is(call, "ProcessKeyEvent")) {
        const Key key = keyIn(call);
        if (!key.down) return;
        focus_ = path;
        keys_.setTakesText(true);
        if (!keys_.beginsWith(key.code)) return;
        keyCall_ = dbus_message_get_serial(&call);
        keyProgram_ = program;
        keyCode_ = key.code;
    }
}

void IbusConnection::overhearSignal(DBusMessage& signal) {
    // What another context gets, or one that has just lost the focus, does not come to where the user types.
    if (focus_.empty() || dbus_message_has_path(&signal, focus_.c_str()) == 0) return;
    BusReader values(&signal);
    if (is(signal, "CommitText")) {
        keys_.put(fromUtf8(firstFieldOf(values)));
    } else if (is(signal, "UpdatePreeditText") || is(signal, "UpdatePreeditTextWithMode")) {
        const bool isEmpty = firstFieldOf(values).empty();
        values.uint32();  // the place in it
        keys_.setComposing(!isEmpty && values.boolean().value_or(false));
    } else if (is(signal, "HidePreeditText")) {
        keys_.setComposing(false);
    } else if (is(signal, "DeleteSurroundingText")) {
        const std::int32_t offset = values.int32().value_or(0);
        const std::uint32_t count = values.uint32().value_or(0);
        if (offset < 0 && count == static_cast<std::uint32_t>(-offset)) keys_.erase(count);
    } else if (is(signal, "ForwardKeyEvent")) {
        forwardKey(signal);
    }
}

// Engines may give the program a key anew, or another one.
void IbusConnection::forwardKey(DBusMessage& signal) {
    const Key key = keyIn(signal);
    if (!key.down) return;
    if (key.code == keyCode_) return keys_.passKey();
    if (key.symbol == BackspaceSymbol) keys_.erase(1);
}

void IbusConnection::overhearReply(DBusMessage& reply) {
    if (keyProgram_.empty() || dbus_message_get_reply_serial(&reply) != keyCall_) return;
    if (dbus_message_has_destination(&reply, keyProgram_.c_str()) == 0) return;
    keyProgram_.clear();
    const bool isTaken = BusReader(&reply).boolean().value_or(false);
    if (!isTaken) keys_.passKey();
    keys_.end();
}

}  // namespace plume
