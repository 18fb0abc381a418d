// Plume's side of the watchdog: a process of its own that frees the keyboard when Plume no longer can.
//
// While Plume has a keyboard tap, every key goes through the tap thread; were that thread stopped, hung or looping,
// the user's keyboard would have no effect. The watchdog hears on a connection of its own that a key went down, and
// then asks the tap thread four times a second whether it is alive, until ten seconds of that are over and the next key
// starts it anew: while nobody types, nothing wakes up. When an answer does not come within 0.6 s, or when Plume ends
// with the keyboard held, the watchdog has the X server end the tap's connection, which gives the keyboard back to the
// programs, passes on the keys that the tap has not handled, and releases those that the tap left pressed. It keeps
// keys no longer than until it sees that the tap has handled them. A tap that finds its connection gone takes the
// keyboard again when it is alive.
//
// The answer comes from a source of the tap thread's run loop, so that a thread that does not get there does not
// answer. The process ends by itself as soon as Plume has ended, in whatever way; it leaves a ClipboardKeeper behind
// when nobody else has what the user had on the clipboard. When it dies first, another one is started, though not more
// than three in a minute. One owner; used on the tap thread, or before its loop runs.
#pragma once

#include <sys/types.h>

#include <cstdint>
#include <deque>
#include <string>

#include "Foundation/Result.h"
#include "ports/posix/FileDescriptor.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/x11/watchdog/WatchdogProtocol.h"

namespace plume {

class Watchdog {
  public:
    // The descriptors of what Plume shares with the process, -1 for none.
    struct Shared {
        int clipboard = -1;    // the SharedClipboardCopy
        int tapProgress = -1;  // the TapProgress; without it no keys are passed on
    };

    // The loop outlives the watchdog. An empty display means $DISPLAY. The program is called plume-watchdog and lies
    // beside this program.
    Watchdog(PollRunLoop& loop, std::string display, Shared shared);
    // Ends the process, which frees the keyboard if there still is a tap.
    ~Watchdog();
    Watchdog(const Watchdog&) = delete;
    Watchdog& operator=(const Watchdog&) = delete;

    // Starts the process; the error says which program could not be started. Once it has started, a process that ends
    // is replaced; to be called before the tap takes the keyboard.
    Result<void> start();

    // Any window made by the connection that holds the keyboard: to be told after every connecting, before the
    // keyboard is taken. 0 when there is no tap: then there is nothing to watch over.
    void setTapWindow(std::uint32_t window);

    // Waits until the process hears the keys that the tap is going to hold, half a second at most: those that it has
    // not heard it could not pass on.
    void awaitListening();

    // Answers at once if the watchdog has asked. Whoever waits for something on the tap thread, within a bound, calls
    // this every now and then, or the wait passes for a hang.
    void beat();

    // The process, 0 when none is running.
    pid_t process() const { return process_; }

  private:
    void take(const WatchdogMessage& message);
    void replace();
    void reap();

    PollRunLoop& loop_;
    const std::string display_;
    const std::string program_;
    const Shared shared_;
    FileDescriptor socket_;
    pid_t process_ = 0;
    std::uint32_t tapWindow_ = 0;
    std::uint32_t heardWindow_ = 0;  // the process listens for that one
    std::deque<double> starts_;      // the moments of the latest ones
    Timer laterStart_;
    Subscription source_;
};

}  // namespace plume
