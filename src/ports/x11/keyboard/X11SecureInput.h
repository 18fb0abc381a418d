// Whether another program has grabbed the keyboard, or the focused field takes a password.
//
// Belongs to the main thread and has a connection of its own. The server tells nobody of a grab, so it is asked; but
// while nobody does anything no program grabs the keyboard either, and a computer at rest stays asleep.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "platform/SecureInput.h"
#include "ports/x11/XcbConnection.h"

namespace plume {

class X11SecureInput final : public SecureInput {
  public:
    // `focusIsPassword` tells whether the focused field hides what is typed, from what is already known of it.
    static Result<std::unique_ptr<X11SecureInput>> open(const std::string& display,
                                                        std::function<bool()> focusIsPassword);

    bool isSecureEventInputEnabled() const override;
    // Whether this program itself holds the keyboard, as its open menus do: that is no secret, and while it lasts
    // nobody else can.
    void setHeldByUs(std::function<bool()> heldByUs) { heldByUs_ = std::move(heldByUs); }

    // Somebody types or clicks, or another window is in front: the server is asked for ten seconds from now on. From
    // any thread, never waits.
    void somethingHappens() { happenedAt_ = Clock::now(); }

  private:
    using Clock = std::chrono::steady_clock;

    X11SecureInput(std::unique_ptr<XcbConnection> connection, std::function<bool()> focusIsPassword);
    bool isKeyboardHeld() const;

    const std::unique_ptr<XcbConnection> connection_;
    const std::function<bool()> focusIsPassword_;
    std::function<bool()> heldByUs_;
    const xcb_window_t neverShown_;
    std::atomic<Clock::time_point> happenedAt_ = Clock::now();
    mutable bool isHeld_ = false;  // when the server was asked last
};

}  // namespace plume
