// Hears clicks anywhere on the screen, whoever gets them.
#pragma once

#include "platform/MouseTap.h"
#include "platform/x11/XcbConnection.h"

namespace plume {

// On the tap thread, with the session connection, whose reader hands it every event; the connection outlives it.
class X11MouseTap final : public MouseTap {
  public:
    explicit X11MouseTap(XcbConnection& connection) : connection_(connection) {}
    ~X11MouseTap() override { remove(); }
    X11MouseTap(const X11MouseTap&) = delete;
    X11MouseTap& operator=(const X11MouseTap&) = delete;

    Result<void> create(Listener listener) override;
    bool exists() const override { return listener_ != nullptr; }
    void remove() override;

    // Every event of the connection; false for one that is no click.
    bool handleEvent(const xcb_generic_event_t& event);

  private:
    void select(std::uint32_t events) const;

    XcbConnection& connection_;
    Listener listener_;
    std::uint8_t inputOpcode_ = 0;
};

}  // namespace plume
