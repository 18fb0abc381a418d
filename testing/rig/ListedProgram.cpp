#include "testing/rig/ListedProgram.h"

#include <array>

#include "ports/atspi/AtspiParts.h"
#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

constexpr const char* RootPath = "/org/a11y/atspi/accessible/root";
constexpr const char* WindowPath = "/window";
constexpr const char* TextPath = "/text";
constexpr const char* PasswordPath = "/password";
const std::string PanelPath = "/panel/";

const char* pathOf(ListedProgram::Field field) {
    return field == ListedProgram::Field::Password ? PasswordPath : TextPath;
}

std::uint32_t bit(AtspiState state) {
    return 1U << static_cast<std::uint32_t>(state);
}

void appendPart(DBusMessageIter& iterator, const char* name, const char* path) {
    DBusMessageIter part;
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_STRUCT, nullptr, &part);
    dbus_message_iter_append_basic(&part, DBUS_TYPE_STRING, static_cast<const void*>(&name));
    dbus_message_iter_append_basic(&part, DBUS_TYPE_OBJECT_PATH, static_cast<const void*>(&path));
    dbus_message_iter_close_container(&iterator, &part);
}

void appendVariant(DBusMessageIter& iterator, int type, const void* value) {
    DBusMessageIter variant;
    const std::array<char, 2> signature{static_cast<char>(type), '\0'};
    dbus_message_iter_open_container(&iterator, DBUS_TYPE_VARIANT, signature.data(), &variant);
    dbus_message_iter_append_basic(&variant, type, value);
    dbus_message_iter_close_container(&iterator, &variant);
}

}  // namespace

ListedProgram::ListedProgram(const std::string& address, int depth) : depth_(depth), connection_(openBus(address)) {
    if (!connection_) throw RigError("no bus at " + address);
    name_ = dbus_bus_get_unique_name(connection_.get());
    enlist();
    thread_ = std::thread([this] { serve(); });
}

ListedProgram::~ListedProgram() {
    ended_ = true;
    thread_.join();
}

void ListedProgram::enlist() {
    const BusMessage call = newCall({"org.a11y.atspi.Registry", RootPath, "org.a11y.atspi.Socket"}, "Embed");
    DBusMessageIter arguments;
    dbus_message_iter_init_append(call.get(), &arguments);
    appendPart(arguments, name_.c_str(), RootPath);
    const BusMessage reply(dbus_connection_send_with_reply_and_block(connection_.get(), call.get(), 10'000, nullptr));
    if (!reply) throw RigError("the registry does not list a program");
}

void ListedProgram::serve() {
    constexpr int TurnMilliseconds = 5;
    while (!ended_ && dbus_connection_read_write(connection_.get(), TurnMilliseconds) != 0) {
        while (const BusMessage message{dbus_connection_pop_message(connection_.get())}) {
            if (dbus_message_get_type(message.get()) == DBUS_MESSAGE_TYPE_METHOD_CALL) answer(message.get());
        }
    }
}

void ListedProgram::focus(Field field) {
    focused_ = field;
    const BusMessage signal(dbus_message_new_signal(pathOf(field), "org.a11y.atspi.Event.Object", "StateChanged"));
    const char* state = "focused";
    const std::int32_t gained = 1;
    const std::int32_t unused = 0;
    DBusMessageIter values;
    DBusMessageIter properties;
    dbus_message_iter_init_append(signal.get(), &values);
    dbus_message_iter_append_basic(&values, DBUS_TYPE_STRING, static_cast<const void*>(&state));
    dbus_message_iter_append_basic(&values, DBUS_TYPE_INT32, &gained);
    dbus_message_iter_append_basic(&values, DBUS_TYPE_INT32, &unused);
    appendVariant(values, DBUS_TYPE_INT32, &unused);
    dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, "{sv}", &properties);
    dbus_message_iter_close_container(&values, &properties);
    send(signal);
}

// The root, its window, panel in panel in panel, and in the last one the fields.
std::vector<std::string> ListedProgram::childrenOf(const std::string& path) const {
    if (path == RootPath) return {WindowPath};
    if (path == TextPath || path == PasswordPath || (hidesParts_ && path == WindowPath)) return {};
    const int level = path.starts_with(PanelPath) ? std::stoi(path.substr(PanelPath.size())) : 0;
    if (level == depth_) return {TextPath, PasswordPath};
    return {PanelPath + std::to_string(level + 1)};
}

std::uint32_t ListedProgram::stateOf(const std::string& path) const {
    if (path == WindowPath) return hidesParts_ ? 0 : bit(AtspiState::Active);
    const bool isField = path == TextPath || path == PasswordPath;
    return bit(AtspiState::Showing) | (isField ? bit(AtspiState::Editable) : 0) |
           (path == pathOf(focused_) ? bit(AtspiState::Focused) : 0);
}

void ListedProgram::answer(DBusMessage* call) {
    const std::string path = dbus_message_get_path(call);
    const std::string method = dbus_message_get_member(call);
    BusReader arguments(call);
    if (method == "Get") {
        arguments.string();
        return answerProperty(call, path, arguments.string().value_or(""));
    }
    const BusMessage reply(dbus_message_new_method_return(call));
    DBusMessageIter values;
    DBusMessageIter list;
    dbus_message_iter_init_append(reply.get(), &values);
    if (method == "GetChildren") {
        dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, "(so)", &list);
        for (const std::string& child : childrenOf(path)) appendPart(list, name_.c_str(), child.c_str());
        dbus_message_iter_close_container(&values, &list);
    } else if (method == "GetState") {
        const std::array<std::uint32_t, 2> words{stateOf(path), 0};
        dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, "u", &list);
        for (const std::uint32_t word : words) dbus_message_iter_append_basic(&list, DBUS_TYPE_UINT32, &word);
        dbus_message_iter_close_container(&values, &list);
    } else if (method == "GetRelationSet") {
        hidesParts_ = false;
        dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, "(ua(so))", &list);
        dbus_message_iter_close_container(&values, &list);
    } else if (method == "GetRole") {
        const AtspiRole role = path == PasswordPath ? AtspiRole::PasswordText : AtspiRole::Entry;
        dbus_message_iter_append_basic(&values, DBUS_TYPE_UINT32, &role);
    }
    send(reply);
}

void ListedProgram::answerProperty(DBusMessage* call, const std::string& path, const std::string& name) {
    const BusMessage reply(dbus_message_new_method_return(call));
    DBusMessageIter values;
    dbus_message_iter_init_append(reply.get(), &values);
    const char* toolkit = "Unheard-of";
    const auto count = static_cast<std::int32_t>(childrenOf(path).size());
    if (name == "ToolkitName") {
        appendVariant(values, DBUS_TYPE_STRING, static_cast<const void*>(&toolkit));
    } else {
        appendVariant(values, DBUS_TYPE_INT32, &count);
    }
    send(reply);
}

}  // namespace plume::rig
