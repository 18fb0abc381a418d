// All that the accessibility thread shares with other threads, and what it runs.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <utility>

#include "ports/atspi/AtspiAccessibility.h"
#include "ports/atspi/AtspiFocusTracker.h"

namespace plume {

// Where this session has its accessibility bus, if it has one.
struct AccessibilityBus {
    AccessibilityStatus status;  // Working, SwitchedOff, NotInstalled or NoSession
    std::string address;         // empty for the last two
};

// Asked of the session's D-Bus. Starts the bus when it can be started. May wait for seconds: on the accessibility
// thread.
AccessibilityBus findAccessibilityBus();

// The processes that tell of their user interface there. May wait for a second.
std::set<pid_t> processesOnBus(const AccessibilityBus& bus);

// Asks the session's D-Bus to have programs tell of their user interface. May wait for seconds, too.
void switchAccessibilityOn();

// Hands questions to the accessibility thread and waits for their answers, never for long.
class AtspiQueue {
  public:
    // ---- On the accessibility thread ----
    PollRunLoop& loop() { return loop_; }
    bool hasEnded() const { return ended_; }
    // Runs what is posted until end().
    void run() { loop_.run(); }
    // Whether questions are passed on. At first they stay unanswered.
    void setOpen(bool open) { open_ = open; }
    bool isOpen() const { return open_; }

    // ---- From any thread ----
    void end();

    // The answer; nothing when it does not come in time, and for a while after that at once.
    template <typename Answer>
    std::optional<Answer> ask(std::function<std::optional<Answer>()> question) {
        if (!answersAreExpected()) return std::nullopt;
        struct Asked {
            std::promise<std::optional<Answer>> answer;
            std::atomic<bool> wanted = true;
        };
        const auto asked = std::make_shared<Asked>();
        std::future<std::optional<Answer>> answer = asked->answer.get_future();
        loop_.perform([asked, question = std::move(question)] {
            asked->answer.set_value(asked->wanted ? question() : std::nullopt);
        });
        if (answer.wait_for(LongestWait) == std::future_status::ready) return answer.get();
        asked->wanted = false;
        expectNoAnswers();
        return std::nullopt;
    }

  private:
    // With a moment for waking up, a caller loses 20 ms at most.
    static constexpr std::chrono::milliseconds LongestWait{15};
    static constexpr std::chrono::seconds Pause{1};

    bool answersAreExpected() const;
    void expectNoAnswers();

    PollRunLoop loop_;
    std::atomic<bool> open_ = false;
    std::atomic<bool> ended_ = false;
    std::atomic<std::chrono::steady_clock::rep> pausedUntil_ = 0;
};

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
    std::optional<AtspiFocused> askForFocus();
    // Where it is; nobody waits. Told on the accessibility thread, or not when that hangs.
    void askForPlaces(std::function<void(const FocusedPlaces&)> told);

    // From any thread.
    void switchOn();

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
