// Hands questions to the accessibility thread and waits for their answers, never for long.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <utility>

#include "ports/posix/PollRunLoop.h"

namespace plume {

class AtspiQueue {
  public:
    // ---- On the accessibility thread ----
    PollRunLoop& loop() { return loop_; }
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

}  // namespace plume
