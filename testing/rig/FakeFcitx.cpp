#include "testing/rig/FakeFcitx.h"

#include <utility>

namespace plume::rig {

namespace {

constexpr BusAddress Field{"org.fcitx.Fcitx5", "/org/freedesktop/portal/inputcontext/1",
                           "org.fcitx.Fcitx.InputContext1"};
const std::uint32_t Symbol = 'n';

}  // namespace

FakeFcitx::FakeFcitx(std::string engine)
    : program_(openBus(sessionBusAddress())),
      engine_(std::move(engine)),
      service_(sessionBusAddress(), Field.name, [this](DBusMessage* call) { return answer(call); }) {}

BusMessage FakeFcitx::signal(const char* path, const char* member) const {
    BusMessage signal(dbus_message_new_signal(path, Field.interface, member));
    dbus_message_set_destination(signal.get(), dbus_bus_get_unique_name(program_.get()));
    return signal;
}

BusMessage FakeFcitx::commit(const char* path, const std::string& text) const {
    BusMessage commit = signal(path, "CommitString");
    const char* const value = text.c_str();
    dbus_message_append_args(commit.get(), DBUS_TYPE_STRING, &value, DBUS_TYPE_INVALID);
    return commit;
}

void FakeFcitx::setEngine(const std::string& name) {
    const BusMessage change = signal(Field.path, "CurrentIM");
    const char* const title = "An engine";
    const char* const text = name.c_str();
    const char* const language = "en";
    dbus_message_append_args(change.get(), DBUS_TYPE_STRING, &title, DBUS_TYPE_STRING, &text, DBUS_TYPE_STRING,
                             &language, DBUS_TYPE_INVALID);
    service_.send(change);
}

void FakeFcitx::loseFocus() {
    dbus_connection_send(program_.get(), newCall(Field, "FocusOut").get(), nullptr);
    dbus_connection_flush(program_.get());
}

void FakeFcitx::takeKey(std::uint32_t code, const std::string& text, bool passes, Milliseconds delay) {
    constexpr std::uint32_t FirstKeycode = 8;  // of X, for the first code of the hardware
    {
        const std::scoped_lock lock(mutex_);
        outcomes_.push_back({text, passes, delay});
    }
    const BusMessage call = newCall(Field, "ProcessKeyEvent", {Symbol, code + FirstKeycode, std::uint32_t{0}});
    const dbus_bool_t isRelease = FALSE;
    const std::uint32_t time = 0;
    dbus_message_append_args(call.get(), DBUS_TYPE_BOOLEAN, &isRelease, DBUS_TYPE_UINT32, &time, DBUS_TYPE_INVALID);
    dbus_connection_send(program_.get(), call.get(), nullptr);
    dbus_connection_flush(program_.get());
}

void FakeFcitx::putElsewhere(const std::string& text) {
    service_.send(commit("/org/freedesktop/portal/inputcontext/2", text));
}

BusMessage FakeFcitx::answer(DBusMessage* call) {
    if (dbus_message_has_member(call, "ProcessKeyEvent") != 0) {
        tellOutcome(call);
        return nullptr;
    }
    BusMessage reply(dbus_message_new_method_return(call));
    const char* const name = engine_.c_str();
    const bool asksForEngine = dbus_message_has_member(call, "CurrentInputMethod") != 0;
    if (asksForEngine) dbus_message_append_args(reply.get(), DBUS_TYPE_STRING, &name, DBUS_TYPE_INVALID);
    return reply;
}

// What the program gets is said behind the answer. A key that is passed on behind a text is given anew.
void FakeFcitx::tellOutcome(DBusMessage* call) {
    const std::scoped_lock lock(mutex_);
    const auto [text, passes, delay] = outcomes_.front();
    outcomes_.pop_front();
    waitUntil([] { return false; }, delay);
    const BusMessage reply(dbus_message_new_method_return(call));
    const dbus_bool_t isTaken = passes && text.empty() ? FALSE : TRUE;
    dbus_message_append_args(reply.get(), DBUS_TYPE_BOOLEAN, &isTaken, DBUS_TYPE_INVALID);
    service_.send(reply);
    if (!text.empty()) service_.send(commit(Field.path, text));
    service_.send(preedit(text.empty() && !passes ? "a" : ""));
    if (text.empty() || !passes) return;
    const BusMessage forward = signal(Field.path, "ForwardKey");
    const std::uint32_t modifiers = 0;
    const dbus_bool_t isRelease = FALSE;
    dbus_message_append_args(forward.get(), DBUS_TYPE_UINT32, &Symbol, DBUS_TYPE_UINT32, &modifiers, DBUS_TYPE_BOOLEAN,
                             &isRelease, DBUS_TYPE_INVALID);
    service_.send(forward);
}

// One piece of text, with its looks, and the place in it.
BusMessage FakeFcitx::preedit(const char* text) const {
    BusMessage told = signal(Field.path, "UpdateFormattedPreedit");
    DBusMessageIter values;
    DBusMessageIter pieces;
    DBusMessageIter piece;
    const std::int32_t looks = 0;
    dbus_message_iter_init_append(told.get(), &values);
    dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, "(si)", &pieces);
    dbus_message_iter_open_container(&pieces, DBUS_TYPE_STRUCT, nullptr, &piece);
    dbus_message_iter_append_basic(&piece, DBUS_TYPE_STRING, static_cast<const void*>(&text));
    dbus_message_iter_append_basic(&piece, DBUS_TYPE_INT32, &looks);
    dbus_message_iter_close_container(&pieces, &piece);
    dbus_message_iter_close_container(&values, &pieces);
    dbus_message_iter_append_basic(&values, DBUS_TYPE_INT32, &looks);
    return told;
}

}  // namespace plume::rig
