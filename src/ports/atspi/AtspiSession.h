// All that the accessibility thread shares with other threads, and what it runs.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <utility>

#include "ports/atspi/AtspiAccessibility.h"
#include "ports/atspi/AtspiBus.h"
#include "ports/atspi/AtspiFocusTracker.h"
#include "ports/atspi/AtspiQueue.h"

namespace plume {

class AtspiSession {
  public:
    AtspiSession();

    AccessibilityStatus status() const { return status_; }
    AtspiFocusTracker& tracker() { return tracker_; }
    const AtspiFocus& focus() const { return tracker_.focus(); }

    // Asks on the accessibility thread: the answer, or nothing when it does not come in time.
    template <typename Answer>
    std::optional<Answer> ask(std::function<std::optional<Answer>(AtspiBus& bus)> question) {
        // Not shared: what waits in the queue would keep the queue. Whoever runs it keeps this session meanwhile.
        return queue_.ask<Answer>([this, question = std::move(question)] {
            bus_.begin(QuestionBound);
            return question(bus_);
        });
    }
    // What has the focus at this moment.
    std::optional<AtspiPart> askForFocus();

    // The thread itself, until end().
    void run();
    void end() { queue_.end(); }

  private:
    using Clock = std::chrono::steady_clock;
    static constexpr std::chrono::milliseconds QuestionBound{150};

    const std::string* connectedAddress();
    void connect();

    AtspiQueue queue_;
    AtspiBus bus_;
    std::string address_;
    Clock::time_point connectedAt_{};  // or tried to
    std::atomic<AccessibilityStatus> status_ = AccessibilityStatus::Starting;
    AtspiFocusTracker tracker_;
};

}  // namespace plume
