// The tap on the simulated mouse.
#pragma once

#include <utility>

#include "platform/MouseTap.h"

namespace plume {

class SimulatedMouseTap final : public MouseTap {
  public:
    Result<void> create(Listener listener) override {
        listener_ = std::move(listener);
        return {};
    }
    bool exists() const override { return listener_ != nullptr; }
    void remove() override { listener_ = nullptr; }

    // The user presses a button.
    void press(Point location) {
        if (listener_) listener_(location);
    }

  private:
    Listener listener_;
};

}  // namespace plume
