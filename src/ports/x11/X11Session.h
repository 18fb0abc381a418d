// The connection over which Plume takes part in the desktop: the clipboard, who is in front, hot keys, layout changes.
// Keys have a connection of their own, so that no key waits for a large clipboard.
//
// Belongs to the tap thread, whose run loop it wakes; opened on any thread before that loop runs.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>

#include "Foundation/Result.h"
#include "Foundation/Subscription.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/x11/XcbConnection.h"

namespace plume {

class X11Session {
  public:
    using Handler = std::function<void(const xcb_generic_event_t&)>;

    // Events of a window that were asked for, as long as this exists. The session outlives it.
    class WindowEvents {
      public:
        WindowEvents() = default;
        WindowEvents(WindowEvents&& other) noexcept
            : session_(std::exchange(other.session_, nullptr)),
              window_(std::exchange(other.window_, XCB_WINDOW_NONE)),
              eventMask_(other.eventMask_) {}
        WindowEvents& operator=(WindowEvents&& other) noexcept;
        ~WindowEvents();

        // None when no events are asked for.
        xcb_window_t window() const { return window_; }

      private:
        friend class X11Session;
        WindowEvents(X11Session& session, xcb_window_t window, std::uint32_t eventMask)
            : session_(&session), window_(window), eventMask_(eventMask) {}

        X11Session* session_ = nullptr;
        xcb_window_t window_ = XCB_WINDOW_NONE;
        std::uint32_t eventMask_ = 0;
    };

    // An empty name means $DISPLAY. The loop outlives the session.
    static Result<std::unique_ptr<X11Session>> open(const std::string& display, PollRunLoop& runLoop);
    X11Session(const X11Session&) = delete;
    X11Session& operator=(const X11Session&) = delete;

    XcbConnection& connection() { return *connection_; }
    RunLoop& runLoop() { return runLoop_; }
    xcb_connection_t* get() const { return connection_->get(); }
    // A window of ours that is never shown: for owning selections and for the answers to requests.
    xcb_window_t window() const { return window_; }

    // For events of one type (its number without the flag of sent events; 0 hears errors). A handler acts: it is called
    // from the run loop alone. An observer only takes notes: it is called as soon as the event has been read, also
    // inside collect() and waitUntil(), so what it notes is never behind. Both until their subscription ends.
    [[nodiscard]] Subscription addHandler(std::uint8_t eventType, Handler handler);
    [[nodiscard]] Subscription addObserver(std::uint8_t eventType, Handler observer);

    // Asks for events of a window, in addition to what others asked for there.
    [[nodiscard]] WindowEvents listen(xcb_window_t window, std::uint32_t eventMask);

    // Reads what has arrived, for the observers; the handlers come later, from the run loop. Never waits.
    void collect();
    // Sends what has been asked for, then collects: while it sends, the library may read.
    void flush();
    // Reads and handles all that has arrived. Never waits. Not from inside a handler.
    void drain();
    // Waits until the condition holds, collecting, at most so long; false when it still does not. Calls `heartbeat`
    // meanwhile.
    bool waitUntil(const std::function<bool()>& condition, double seconds);

    // The server's own time now, for requests that must carry one; one round trip. 0 when the server is gone.
    xcb_timestamp_t serverTime();

    // Called at least every 100 ms while something is waited for.
    std::function<void()> heartbeat;
    // Called once, from the run loop, when the server is gone.
    std::function<void()> serverGone;

  private:
    struct Listener {
        std::uint8_t eventType = 0;
        bool observes = false;
        Handler handler;
        bool ended = false;
    };

    X11Session(std::unique_ptr<XcbConnection> connection, PollRunLoop& runLoop);
    Subscription add(Listener listener);
    void dispatch(const xcb_generic_event_t& event, bool toObservers);
    void unlisten(xcb_window_t window, std::uint32_t eventMask);
    void setEventMask(xcb_window_t window) const;

    const std::unique_ptr<XcbConnection> connection_;
    PollRunLoop& runLoop_;
    const xcb_window_t window_;
    std::map<std::uint64_t, std::shared_ptr<Listener>> listeners_;  // in the order of adding
    std::uint64_t lastListener_ = 0;
    std::map<xcb_window_t, std::map<std::uint32_t, int>> masks_;  // how often each mask was asked for
    std::deque<XcbOwned<xcb_generic_event_t>> collected_;
    xcb_timestamp_t noticedTime_ = 0;
    bool drains_ = false;
    Timer pendingDrain_;
    bool serverIsGone_ = false;
    Subscription source_;
    Subscription timeObserver_;
    WindowEvents windowEvents_;  // of our own window
};

}  // namespace plume
