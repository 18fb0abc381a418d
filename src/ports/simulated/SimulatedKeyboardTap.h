// The tap on the simulated keyboard: whoever listens is asked about each of the user's keys.
#pragma once

#include <optional>
#include <string>
#include <utility>

#include "platform/KeyboardTap.h"

namespace plume {

class SimulatedKeyboardTap final : public KeyboardTap {
  public:
    Result<void> create(KeyboardTapListener& listener, bool annotatedSession) override;
    bool exists() const override { return listener_ != nullptr; }
    void enable() override {}  // it never is disabled
    void remove() override;
    Result<void> check() const override;

    // Makes create() and check() fail with this message, or succeed again.
    void setMissing(std::optional<std::string> message) { missing_ = std::move(message); }
    bool listensAtAnnotatedSession() const { return annotatedSession_; }

    // Whether the listener swallows the event; without a listener nobody does.
    bool swallows(const TapEvent& event);

  private:
    KeyboardTapListener* listener_ = nullptr;
    bool annotatedSession_ = false;
    std::optional<std::string> missing_;
};

}  // namespace plume
