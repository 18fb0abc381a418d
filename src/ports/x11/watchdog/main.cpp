// The watchdog: frees the keyboard when Plume, which started it, hangs or has ended. See ports/x11/watchdog/Watchdog.h.
//
// plume-watchdog <display>, with one end of Plume's pair of sockets as standard input, the memory of the
// SharedClipboardCopy as descriptor 3 and that of the TapProgress as descriptor 4.

#include <poll.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <string>
#include <utility>

#include "ports/x11/watchdog/ClipboardKeeper.h"
#include "ports/x11/watchdog/WatchdogConnection.h"
#include "ports/x11/watchdog/WatchdogProtocol.h"
#include "ports/x11/watchdog/WatchdogSchedule.h"

namespace plume {

namespace {

double now() {
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

class WatchdogProcess {
  public:
    WatchdogProcess(WatchdogConnection& connection, TapProgress& progress)
        : connection_(connection), progress_(progress) {}

    // Until Plume ends, or the display does.
    void run() {
        // What has arrived is looked at before anybody is given up: it may be the watchdog that was late.
        while (takeMessages() && !connection_.isBroken()) {
            takeSteps();
            if (connection_.takeKeys(progress_, now()) && schedule_.keyHeard(now())) {
                keysWake_ = false;
            } else {
                wait();
            }
        }
        if (tapWindow_ != XCB_WINDOW_NONE) connection_.freeKeyboard(tapWindow_, progress_, now());
    }

  private:
    // False when Plume has ended.
    bool takeMessages() {
        for (;;) {
            const auto received = receiveWatchdogMessage(WatchdogSocket);
            if (const auto* const silence = std::get_if<WatchdogSilence>(&received)) {
                return *silence == WatchdogSilence::NothingYet;
            }
            const auto& message = std::get<WatchdogMessage>(received);
            if (message.type == WatchdogMessage::Type::Answer) schedule_.answered(message.value);
            if (message.type != WatchdogMessage::Type::TapWindow) continue;
            tapWindow_ = message.value;
            connection_.listen(tapWindow_ != XCB_WINDOW_NONE);
            keysWake_ = false;
            schedule_.watch(tapWindow_ != XCB_WINDOW_NONE);
            sendWatchdogMessage(WatchdogSocket, {WatchdogMessage::Type::Listening, tapWindow_});
        }
    }

    void takeSteps() {
        for (;;) {
            switch (schedule_.next(now())) {
                case WatchdogSchedule::Step::Wait:
                    return;
                case WatchdogSchedule::Step::ListenAndAsk:
                    keysWake_ = true;
                    [[fallthrough]];
                case WatchdogSchedule::Step::Ask:
                    sendWatchdogMessage(WatchdogSocket, {WatchdogMessage::Type::Ping, schedule_.question()});
                    break;
                case WatchdogSchedule::Step::GiveUp:
                    connection_.freeKeyboard(std::exchange(tapWindow_, XCB_WINDOW_NONE), progress_, now());
                    connection_.listen(false);
                    break;
            }
        }
    }

    void wait() const {
        pollfd entries[] = {{WatchdogSocket, POLLIN, 0}, {connection_.descriptor(), POLLIN, 0}};
        const double seconds = schedule_.nextMoment() - now();
        const int bound = std::isinf(seconds) ? -1 : static_cast<int>(std::ceil(std::max(seconds, 0.0) * 1000));
        poll(entries, keysWake_ ? std::size(entries) : 1, bound);
    }

    WatchdogConnection& connection_;
    TapProgress& progress_;
    WatchdogSchedule schedule_;
    // While Plume is being asked anyway, keys wait to be looked at.
    bool keysWake_ = false;
    xcb_window_t tapWindow_ = XCB_WINDOW_NONE;
};

}  // namespace

}  // namespace plume

int main(int count, char** arguments) {
    const std::string display = count > 1 ? arguments[1] : "";
    auto connection = plume::WatchdogConnection::open(display);
    if (!connection) {
        static_cast<void>(std::fprintf(stderr, "plume-watchdog: %s\n", connection.error().message.c_str()));
        return 1;
    }
    plume::TapProgress progress(plume::WatchdogTapProgress);
    plume::WatchdogProcess(*connection.value(), progress).run();
    connection.value().reset();
    plume::startClipboardKeeper(display, plume::WatchdogClipboard);
    return 0;
}
