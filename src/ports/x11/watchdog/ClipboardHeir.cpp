#include "ports/x11/watchdog/ClipboardHeir.h"

#include <unistd.h>

#include <memory>
#include <utility>
#include <vector>

#include "ports/posix/PollRunLoop.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/ClipboardLegacy.h"
#include "ports/x11/clipboard/X11Pasteboard.h"
#include "ports/x11/watchdog/WatchdogProtocol.h"

namespace plume {

namespace {

// The server may notice Plume's end later than the watchdog.
constexpr double LongestDeath = 2;  // seconds

void offer(const std::string& display, const std::vector<ClipboardLegacy::Entry>& entries) {
    PollRunLoop loop;
    auto session = X11Session::open(display, loop);
    if (!session) return;
    session.value()->serverGone = [&] { loop.stop(); };
    auto pasteboard = X11Pasteboard::open(*session.value());
    if (!pasteboard) return;
    X11Pasteboard& clipboard = *pasteboard.value();
    if (!session.value()->waitUntil([&] { return !clipboard.isHeld(); }, LongestDeath)) return;
    clipboard.ownershipLost = [&] { loop.stop(); };
    clipboard.takeUp(entries);
    if (clipboard.isOffering()) loop.run();
}

}  // namespace

void offerClipboardLegacy(const std::string& display, int descriptor) {
    const auto entries = ClipboardLegacy::read(descriptor);
    if (entries.empty() || fork() != 0) return;
    setsid();
    close(WatchdogSocket);
    close(descriptor);
    offer(display, entries);
    _exit(0);
}

}  // namespace plume
