// Hears clicks anywhere on the screen, whoever gets them.
#pragma once

#include <functional>

#include "platform/MouseTap.h"
#include "ports/x11/X11Session.h"

namespace plume {

// On the tap thread; the session outlives it.
class X11MouseTap final : public MouseTap {
  public:
    explicit X11MouseTap(X11Session& session) : session_(session) {}
    ~X11MouseTap() override;
    X11MouseTap(const X11MouseTap&) = delete;
    X11MouseTap& operator=(const X11MouseTap&) = delete;

    // Told of every click from now on, whether or not the tap exists. The error says that clicks cannot be heard.
    Result<void> setClicked(std::function<void()> clicked);

    Result<void> create(Listener listener) override;
    bool exists() const override { return listener_ != nullptr; }
    void remove() override;

  private:
    Result<void> hear();
    void select(std::uint32_t events) const;
    void handleEvent(const xcb_generic_event_t& event);

    X11Session& session_;
    Subscription handler_;
    Listener listener_;            // while it exists
    unsigned listeningSince_ = 0;  // the number of a request
    std::function<void()> clicked_;
    std::uint8_t inputOpcode_ = 0;
};

}  // namespace plume
