// The watchdog: frees the keyboard when Plume, which started it, hangs or has ended. See platform/x11/Watchdog.h.
//
// plume-watchdog <display>, with one end of Plume's pair of sockets as standard input, and the memory of the
// clipboard's legacy as descriptor 3.

#include <poll.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <string>
#include <utility>

#include "ports/x11/watchdog/ClipboardHeir.h"
#include "ports/x11/watchdog/KeyboardGuard.h"
#include "ports/x11/watchdog/Vigil.h"
#include "ports/x11/watchdog/WatchdogProtocol.h"

namespace plume {

namespace {

double now() {
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

class WatchdogProcess {
  public:
    explicit WatchdogProcess(KeyboardGuard& guard) : guard_(guard) {}

    // Until Plume ends, or the display does.
    void run() {
        // What has arrived is looked at before anybody is given up: it may be the watchdog that was late.
        while (takeMessages() && !guard_.isBroken()) {
            takeSteps();
            if (guard_.takeKey() && vigil_.keyHeard(now())) {
                guard_.listen(false);
            } else {
                wait();
            }
        }
        if (tapWindow_ != XCB_WINDOW_NONE) guard_.freeKeyboard(tapWindow_);
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
            if (message.type == WatchdogMessage::Type::Answer) vigil_.answered(message.value);
            if (message.type != WatchdogMessage::Type::TapWindow) continue;
            tapWindow_ = message.value;
            guard_.listen(false);
            vigil_.watch(tapWindow_ != XCB_WINDOW_NONE);
        }
    }

    void takeSteps() {
        for (;;) {
            switch (vigil_.next(now())) {
                case Vigil::Step::Wait:
                    return;
                case Vigil::Step::ListenAndAsk:
                    guard_.listen(true);
                    [[fallthrough]];
                case Vigil::Step::Ask:
                    sendWatchdogMessage(WatchdogSocket, {WatchdogMessage::Type::Ping, vigil_.question()});
                    break;
                case Vigil::Step::GiveUp:
                    guard_.freeKeyboard(std::exchange(tapWindow_, XCB_WINDOW_NONE));
                    guard_.listen(false);
                    break;
            }
        }
    }

    void wait() const {
        pollfd entries[] = {{WatchdogSocket, POLLIN, 0}, {guard_.descriptor(), POLLIN, 0}};
        const double seconds = vigil_.nextMoment() - now();
        const int bound = std::isinf(seconds) ? -1 : static_cast<int>(std::ceil(std::max(seconds, 0.0) * 1000));
        poll(entries, std::size(entries), bound);
    }

    KeyboardGuard& guard_;
    Vigil vigil_;
    xcb_window_t tapWindow_ = XCB_WINDOW_NONE;
};

}  // namespace

}  // namespace plume

int main(int count, char** arguments) {
    const std::string display = count > 1 ? arguments[1] : "";
    auto guard = plume::KeyboardGuard::open(display);
    if (!guard) {
        static_cast<void>(std::fprintf(stderr, "plume-watchdog: %s\n", guard.error().message.c_str()));
        return 1;
    }
    plume::WatchdogProcess(*guard.value()).run();
    guard.value().reset();
    plume::offerClipboardLegacy(display, plume::WatchdogLegacy);
    return 0;
}
