#include "testing/rig/InputTestSocket.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <xorg/xf86-input-inputtest-protocol.h>

#include <cerrno>
#include <cstring>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

constexpr Milliseconds AnswerBound{5'000};

template <typename Event>
Event makeEvent(xf86ITEventType type) {
    Event event{};
    event.header.length = sizeof event;
    event.header.type = type;
    return event;
}

}  // namespace

InputTestSocket::InputTestSocket(const std::filesystem::path& path)
    : socket_(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (path.native().size() >= sizeof address.sun_path) throw RigError("too long for a socket: " + path.string());
    path.native().copy(address.sun_path, sizeof address.sun_path);
    if (connect(socket_.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        throw RigError("cannot reach the test device " + path.string() + ": " + std::strerror(errno));
    }
    auto version = makeEvent<xf86ITEventClientVersion>(XF86IT_EVENT_CLIENT_VERSION);
    version.major = XF86IT_PROTOCOL_VERSION_MAJOR;
    version.minor = XF86IT_PROTOCOL_VERSION_MINOR;
    sendBytes(&version, sizeof version);
    receive(XF86IT_RESPONSE_SERVER_VERSION, sizeof(xf86ITResponseServerVersion));
}

void InputTestSocket::sendKey(int keycode, bool press) {
    auto event = makeEvent<xf86ITEventKey>(XF86IT_EVENT_KEY);
    event.key_code = keycode;
    event.is_press = press ? 1 : 0;
    sendBytes(&event, sizeof event);
}

void InputTestSocket::sendButton(int button, bool press) {
    auto event = makeEvent<xf86ITEventButton>(XF86IT_EVENT_BUTTON);
    event.button = button;
    event.is_press = press ? 1 : 0;
    sendBytes(&event, sizeof event);
}

void InputTestSocket::sendPosition(double x, double y) {
    auto event = makeEvent<xf86ITEventMotion>(XF86IT_EVENT_MOTION);
    event.is_absolute = 1;
    event.valuators.mask[0] = 0b11;
    event.valuators.valuators[0] = x;
    event.valuators.valuators[1] = y;
    sendBytes(&event, sizeof event);
}

void InputTestSocket::sync() {
    const auto event = makeEvent<xf86ITEventWaitForSync>(XF86IT_EVENT_WAIT_FOR_SYNC);
    sendBytes(&event, sizeof event);
    receive(XF86IT_RESPONSE_SYNC_FINISHED, sizeof(xf86ITResponseSyncFinished));
}

void InputTestSocket::sendBytes(const void* bytes, std::size_t length) {
    const auto* rest = static_cast<const char*>(bytes);
    while (length > 0) {
        const ssize_t written = send(socket_.get(), rest, length, MSG_NOSIGNAL);
        if (written < 0 && errno == EINTR) continue;
        if (written <= 0) throw RigError("the X server's test device has gone");
        rest += written;
        length -= static_cast<std::size_t>(written);
    }
}

void InputTestSocket::receive(int expectedType, std::size_t expectedLength) {
    xf86ITResponseAny response{};
    const Deadline deadline(AnswerBound);
    std::size_t received = 0;
    while (received < expectedLength) {
        if (!deadline.waitReadable(socket_.get())) throw RigError("the X server's test device does not answer");
        const ssize_t count =
            recv(socket_.get(), reinterpret_cast<char*>(&response) + received, expectedLength - received, 0);
        if (count <= 0) throw RigError("the X server's test device has gone");
        received += static_cast<std::size_t>(count);
    }
    if (response.header.type != expectedType || response.header.length != expectedLength) {
        throw RigError("the X server's test device speaks another protocol");
    }
}

}  // namespace plume::rig
