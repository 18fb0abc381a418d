#include "ports/x11/watchdog/ClipboardKeeper.h"

#include <unistd.h>

#include <memory>
#include <utility>
#include <vector>

#include "ports/posix/PollRunLoop.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/SharedClipboardCopy.h"
#include "ports/x11/clipboard/X11Pasteboard.h"
#include "ports/x11/watchdog/WatchdogProtocol.h"

namespace plume {

namespace {

// Seconds until the server, which may notice Plume's end later than the watchdog, has taken the clipboard from it.
constexpr double LongestUntilReleased = 2;

void offer(const std::string& display, const std::vector<SharedClipboardCopy::Entry>& entries) {
    PollRunLoop loop;
    auto session = X11Session::open(display, loop);
    if (!session) return;
    session.value()->serverGone = [&] { loop.stop(); };
    auto pasteboard = X11Pasteboard::open(*session.value());
    if (!pasteboard) return;
    X11Pasteboard& clipboard = *pasteboard.value();
    if (!session.value()->waitUntil([&] { return !clipboard.isHeld(); }, LongestUntilReleased)) return;
    clipboard.ownershipLost = [&] { loop.stop(); };
    clipboard.offer(entries);
    if (clipboard.isOffering()) loop.run();
}

}  // namespace

void startClipboardKeeper(const std::string& display, int descriptor) {
    const auto entries = SharedClipboardCopy::read(descriptor);
    if (entries.empty() || fork() != 0) return;
    setsid();
    close(WatchdogSocket);
    close(descriptor);
    offer(display, entries);
    _exit(0);
}

}  // namespace plume
