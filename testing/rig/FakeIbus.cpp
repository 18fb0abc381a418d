#include "testing/rig/FakeIbus.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <utility>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

constexpr const char* Name = "org.freedesktop.IBus";
constexpr const char* Path = "/org/freedesktop/IBus";
constexpr BusAddress Context{Name, "/org/freedesktop/IBus/InputContext_2", "org.freedesktop.IBus.InputContext"};

void appendText(DBusMessageIter& iterator, const std::string& text) {
    const char* const value = text.c_str();
    dbus_message_iter_append_basic(&iterator, DBUS_TYPE_STRING, static_cast<const void*>(&value));
}

// As IBus sends an object: its class, no attachments, and a text.
void appendObject(DBusMessageIter& iterator, const std::string& name, const std::string& text) {
    DBusMessageIter variant;
    DBusMessageIter fields;
    DBusMessageIter attachments;
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_VARIANT, "(sa{sv}s)", &variant);
    dbus_message_iter_open_container(&variant, DBUS_TYPE_STRUCT, nullptr, &fields);
    appendText(fields, name);
    dbus_message_iter_open_container(&fields, DBUS_TYPE_ARRAY, "{sv}", &attachments);
    dbus_message_iter_close_container(&fields, &attachments);
    appendText(fields, text);
    dbus_message_iter_close_container(&variant, &fields);
    dbus_message_iter_close_container(&iterator, &variant);
}

}  // namespace

FakeIbus::FakeIbus(DesktopRig& rig, std::string engine) : engine_(std::move(engine)) {
    const std::string address = "unix:path=" + (rig.directory() / "ibus").string();
    bus_ = rig.session().start(
        {"dbus-daemon", "--session", "--nofork", "--nopidfile", "--nosyslog", "--address=" + address}, "dbus-daemon");
    waitUntil([&] { return (program_ = openBus(address)) != nullptr || !bus_->isRunning(); });
    service_.emplace(address, Name, [this](DBusMessage* call) { return answer(call); });
    sayWhere(rig.server().display(), address);
    session_.emplace(sessionBusAddress(), Name, [](DBusMessage* /*call*/) { return BusMessage(); });
}

void FakeIbus::sayWhere(const std::string& display, const std::string& address) {
    const std::unique_ptr<char, void (*)(void*)> machine(dbus_get_local_machine_id(), dbus_free);
    const std::filesystem::path folder = std::filesystem::path(std::getenv("XDG_CONFIG_HOME")) / "ibus" / "bus";
    std::filesystem::create_directories(folder);
    std::ofstream(folder / (std::string(machine.get()) + "-unix-" + display.substr(1)))
        << "# where\nIBUS_ADDRESS=" << address << "\nIBUS_DAEMON_PID=1\n";
}

void FakeIbus::setEngine(const std::string& name) {
    const BusMessage signal(dbus_message_new_signal(Path, Name, "GlobalEngineChanged"));
    DBusMessageIter iterator;
    dbus_message_iter_init_append(signal.get(), &iterator);
    appendText(iterator, name);
    const std::scoped_lock lock(mutex_);
    engine_ = name;
    service_->send(signal);
}

void FakeIbus::takeKey(std::uint32_t code, const std::string& text, bool passes, Milliseconds delay) {
    {
        const std::scoped_lock lock(mutex_);
        outcomes_.push_back({text, passes, delay});
    }
    const std::uint32_t nothing = 0;
    dbus_connection_send(program_.get(), newCall(Context, "ProcessKeyEvent", {nothing, code, nothing}).get(), nullptr);
    dbus_connection_flush(program_.get());
}

void FakeIbus::putElsewhere(const std::string& text) {
    const std::scoped_lock lock(mutex_);
    service_->send(commit("/org/freedesktop/IBus/InputContext_1", text));
}

BusMessage FakeIbus::answer(DBusMessage* call) {
    const std::scoped_lock lock(mutex_);
    const bool isKey = dbus_message_has_member(call, "ProcessKeyEvent") != 0;
    return isKey ? outcomeOf(call) : engineIn(call);
}

BusMessage FakeIbus::engineIn(DBusMessage* call) {
    BusMessage reply(dbus_message_new_method_return(call));
    DBusMessageIter iterator;
    DBusMessageIter variant;
    dbus_message_iter_init_append(reply.get(), &iterator);
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_VARIANT, "v", &variant);
    appendObject(variant, "IBusEngineDesc", engine_);
    dbus_message_iter_close_container(&iterator, &variant);
    return reply;
}

BusMessage FakeIbus::commit(const char* context, const std::string& text) {
    BusMessage signal(dbus_message_new_signal(context, Context.interface, "CommitText"));
    dbus_message_set_destination(signal.get(), dbus_bus_get_unique_name(program_.get()));
    DBusMessageIter iterator;
    dbus_message_iter_init_append(signal.get(), &iterator);
    appendObject(iterator, "IBusText", text);
    return signal;
}

// What the program gets is said before the answer.
BusMessage FakeIbus::outcomeOf(DBusMessage* call) {
    const Outcome outcome = outcomes_.front();
    outcomes_.pop_front();
    waitUntil([] { return false; }, outcome.delay);
    if (!outcome.text.empty()) service_->send(commit(Context.path, outcome.text));
    BusMessage reply(dbus_message_new_method_return(call));
    const dbus_bool_t isTaken = outcome.passes ? FALSE : TRUE;
    dbus_message_append_args(reply.get(), DBUS_TYPE_BOOLEAN, &isTaken, DBUS_TYPE_INVALID);
    return reply;
}

}  // namespace plume::rig
