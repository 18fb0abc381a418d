// What Plume and its watchdog tell each other, over a pair of connected sockets that keep messages whole.
#pragma once

#include <unistd.h>

#include <cstdint>
#include <variant>

namespace plume {

struct WatchdogMessage {
    enum class Type : std::uint32_t {
        TapWindow,  // from Plume: a window of the connection that holds the keyboard; 0 when none does
        Listening,  // from the watchdog: it hears the keys that the connection of this window holds
        Ping,       // from the watchdog: are you alive? The value is to be sent back
        Answer,
    };

    Type type = Type::Ping;
    std::uint32_t value = 0;
};

// The watchdog finds its end of the pair as its standard input.
inline constexpr int WatchdogSocket = STDIN_FILENO;
// Where it finds the memory of the SharedClipboardCopy, if there is one.
inline constexpr int WatchdogClipboard = STDERR_FILENO + 1;
// And that of the TapProgress.
inline constexpr int WatchdogTapProgress = WatchdogClipboard + 1;

enum class WatchdogSilence { NothingYet, Ended };

// Neither of the two ever waits. What cannot be sent is lost: then the other side has ended, or has not listened for
// hundreds of messages.
void sendWatchdogMessage(int socket, WatchdogMessage message);
std::variant<WatchdogMessage, WatchdogSilence> receiveWatchdogMessage(int socket);

}  // namespace plume
