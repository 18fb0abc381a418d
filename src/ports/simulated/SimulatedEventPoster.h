// Plume's own events on the simulated desktop: they reach the program in front at once, past the tap.
#pragma once

#include <functional>
#include <utility>
#include <vector>

#include "platform/EventPoster.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedKeyboard.h"

namespace plume {

class SimulatedEventPoster final : public EventPoster {
  public:
    using Deliver = std::function<void(const SynthesisedKey& key)>;

    // The keyboard is not owned and outlives the poster.
    SimulatedEventPoster(SimulatedKeyboard& keyboard, Deliver deliver)
        : keyboard_(keyboard), deliver_(std::move(deliver)) {}

    void begin() override {}
    void end() override {}
    void post(const SynthesisedKey& key, bool pastTap) override {
        if (pastTap) ++postedPastTap_;
        deliver_(key);
    }
    bool canType(std::u16string_view text) const override { return !canType_ || canType_(text); }
    KeyCode keyCodeOfLetter(char16_t letter) const override {
        return SimulatedInputSources::strokeFor(letter).value_or(SimulatedInputSources::Stroke()).keyCode;
    }
    bool isKeyDown(KeyCode keyCode) const override { return keyboard_.isDown(keyCode); }
    Point pointerLocation() const override { return pointer_; }
    void click(Point location) override { clicks_.push_back(location); }
    void holdUserKeys() override { keyboard_.hold(); }
    void releaseUserKeys() override { keyboard_.letGo(); }
    void keepHoldingUserKeys() override {}

    void setPointerLocation(Point location) { pointer_ = location; }
    // Which texts the keyboard has keys for; every text at first.
    void setCanType(std::function<bool(std::u16string_view)> canType) { canType_ = std::move(canType); }
    // Where Plume clicked, in order.
    const std::vector<Point>& clicks() const { return clicks_; }
    int postedPastTap() const { return postedPastTap_; }

  private:
    SimulatedKeyboard& keyboard_;
    const Deliver deliver_;
    Point pointer_;
    std::function<bool(std::u16string_view)> canType_;
    std::vector<Point> clicks_;
    int postedPastTap_ = 0;
};

}  // namespace plume
