#include "ports/x11/watchdog/WatchdogProtocol.h"

#include <sys/socket.h>

#include <cerrno>

namespace plume {

void sendWatchdogMessage(int socket, WatchdogMessage message) {
    while (send(socket, &message, sizeof message, MSG_DONTWAIT | MSG_NOSIGNAL) < 0 && errno == EINTR) {
    }
}

std::variant<WatchdogMessage, WatchdogSilence> receiveWatchdogMessage(int socket) {
    WatchdogMessage message;
    ssize_t length = 0;
    do {
        length = recv(socket, &message, sizeof message, MSG_DONTWAIT);
    } while (length < 0 && errno == EINTR);
    if (length == sizeof message) return message;
    if (length < 0 && (errno == EAGAIN || errno == EWOULDBLOCK)) return WatchdogSilence::NothingYet;
    return WatchdogSilence::Ended;
}

}  // namespace plume
