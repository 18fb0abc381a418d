// When the watchdog asks Plume whether it is alive, and when it stops waiting for an answer.
//
// Knows nothing of sockets or displays: it is told the time and what happened, and says what to do next.
#pragma once

#include <cstdint>
#include <limits>
#include <optional>

namespace plume {

class WatchdogSchedule {
  public:
    static constexpr double AskPeriod = 0.25;     // seconds from one question to the next
    static constexpr double AnswerTimeout = 0.6;  // seconds until a missing answer means that Plume hangs
    static constexpr double AskingTime = 10;      // seconds of asking after a key
    static constexpr double Never = std::numeric_limits<double>::infinity();

    enum class Step {
        Wait,          // until nextMoment()
        Ask,           // with question()
        ListenAndAsk,  // for keys again; the question then covers the keys before it
        GiveUp,        // Plume hangs: free the keyboard
    };

    // Somebody has the keyboard, or nobody, from now on.
    void watch(bool on);

    // A key went down. True: now that Plume is being asked regularly, keys need not wake anybody.
    bool keyHeard(double now);
    void answered(std::uint32_t question);

    // What is to be done now: to be asked again until it says Wait.
    Step next(double now);
    double nextMoment() const;
    std::uint32_t question() const { return question_; }

  private:
    bool watching_ = false;
    bool listening_ = false;
    std::uint32_t question_ = 0;
    double askUntil_ = 0;
    double askAt_ = Never;
    std::optional<double> askedAt_;  // while the answer is missing
};

}  // namespace plume
