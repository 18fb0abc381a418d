// Hears something for as long as it exists: whoever offers events or changes to hear returns one, and the listener
// keeps it beside what it calls.
//
// A plain value that can be moved. It may outlive what it listens to. Belongs to the thread of what it listens to.
#pragma once

#include <memory>
#include <utility>

namespace plume {

class Subscription {
  public:
    Subscription() = default;
    // `ended` is set when the subscription ends; who announces looks at it before every call.
    explicit Subscription(std::shared_ptr<bool> ended) : ended_(std::move(ended)) {}
    Subscription(Subscription&& other) noexcept : ended_(std::move(other.ended_)) {}
    Subscription& operator=(Subscription&& other) noexcept {
        if (this != &other) {
            end();
            ended_ = std::move(other.ended_);
        }
        return *this;
    }
    ~Subscription() { end(); }

    // The listener is not called any more.
    void end() {
        if (ended_) *std::exchange(ended_, nullptr) = true;
    }

  private:
    std::shared_ptr<bool> ended_;
};

}  // namespace plume
