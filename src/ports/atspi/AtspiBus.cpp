#include "ports/atspi/AtspiBus.h"

#include <algorithm>

namespace plume {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds CallBound{150};
constexpr std::chrono::seconds SilentPause{1};
constexpr milliseconds ClockError{5};  // libdbus's, at most

}  // namespace

bool AtspiBus::connect(const std::string& address) {
    ++connections_;
    silentUntil_.clear();
    connection_ = openBus(address);
    return connection_ != nullptr;
}

bool AtspiBus::isConnected() const {
    return connection_ && dbus_connection_get_is_connected(connection_.get()) != 0;
}

void AtspiBus::begin(milliseconds bound) {
    end_ = Clock::now() + bound;
    leftUnanswered_ = false;
    forgetIncoming();
}

BusAnswer AtspiBus::call(const AtspiPart& part, const char* interface, const char* method,
                         std::initializer_list<BusValue> arguments) {
    if (!part) return {};
    return send(part.program, newCall({part.program.c_str(), part.path.c_str(), interface}, method, arguments));
}

BusAnswer AtspiBus::property(const AtspiPart& part, const char* interface, const char* name) {
    return call(part, DBUS_INTERFACE_PROPERTIES, "Get", {interface, name});
}

AtspiPendingCall AtspiBus::callAhead(const AtspiPart& part, const char* interface, const char* method) {
    if (!part || !isConnected() || isSilent(part.program)) return nullptr;
    const BusMessage call = newCall({part.program.c_str(), part.path.c_str(), interface}, method);
    DBusPendingCall* pending = nullptr;
    dbus_connection_send_with_reply(connection_.get(), call.get(), &pending, static_cast<int>(CallBound.count()));
    return AtspiPendingCall(pending);
}

BusAnswer AtspiBus::answerTo(const AtspiPart& part, AtspiPendingCall call) const {
    if (!call || !isConnected() || isSilent(part.program)) return {};
    dbus_pending_call_block(call.get());
    BusMessage reply(dbus_pending_call_steal_reply(call.get()));
    const bool isAnswer = reply && dbus_message_get_type(reply.get()) == DBUS_MESSAGE_TYPE_METHOD_RETURN;
    return isAnswer ? BusAnswer(std::move(reply)) : BusAnswer();
}

BusAnswer AtspiBus::callBus(const char* method, std::initializer_list<BusValue> arguments) {
    return send(DBUS_SERVICE_DBUS,
                newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, DBUS_INTERFACE_DBUS}, method, arguments));
}

BusAnswer AtspiBus::send(const std::string& program, const BusMessage& call) {
    const Clock::time_point begin = Clock::now();
    const auto bound = std::min(CallBound, std::chrono::ceil<milliseconds>(end_ - begin));
    if (!call || !isConnected() || bound.count() <= 0 || isSilent(program)) {
        leftUnanswered_ = true;
        return {};
    }
    BusMessage reply(dbus_connection_send_with_reply_and_block(connection_.get(), call.get(),
                                                               static_cast<int>(bound.count()), nullptr));
    if (reply) return BusAnswer(std::move(reply));
    // An error that comes at once is an answer: there is no such part, or the program has ended.
    const bool waited = Clock::now() - begin >= bound - ClockError;
    if (waited) noteSilent(program);
    if (waited || !isConnected()) leftUnanswered_ = true;
    return {};
}

bool AtspiBus::isSilent(const std::string& program) const {
    const auto found = silentUntil_.find(program);
    return found != silentUntil_.end() && Clock::now() < found->second;
}

void AtspiBus::noteSilent(const std::string& program) {
    const Clock::time_point now = Clock::now();
    std::erase_if(silentUntil_, [&](const auto& entry) { return entry.second <= now; });
    silentUntil_[program] = now + SilentPause;
}

int AtspiBus::descriptor() const {
    int descriptor = -1;
    if (!connection_ || dbus_connection_get_unix_fd(connection_.get(), &descriptor) == 0) return -1;
    return descriptor;
}

BusMessage AtspiBus::takeMessage() {
    if (!connection_) return nullptr;
    dbus_connection_read_write(connection_.get(), 0);
    return BusMessage(dbus_connection_pop_message(connection_.get()));
}

// Late replies, and what others send unasked: libdbus keeps them until somebody takes them.
void AtspiBus::forgetIncoming() {
    if (!connection_) return;
    while (dbus_connection_dispatch(connection_.get()) == DBUS_DISPATCH_DATA_REMAINS) {
    }
}

}  // namespace plume
