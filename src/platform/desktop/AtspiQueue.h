// Hands questions to the accessibility thread and waits for their answers, never for long.
#pragma once

#include <glib.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <utility>

#include "platform/desktop/AtspiObjects.h"

namespace plume {

class AtspiQueue : public std::enable_shared_from_this<AtspiQueue> {
  public:
    using Call = std::function<void()>;

    AtspiQueue();
    ~AtspiQueue();
    AtspiQueue(const AtspiQueue&) = delete;
    AtspiQueue& operator=(const AtspiQueue&) = delete;

    // ---- On the accessibility thread ----
    GMainContext* context() const { return context_; }
    // Runs what is posted until end(), and `afterEach` whenever something was run.
    void run(const Call& afterEach);
    // From now on questions are passed on; until then they stay unanswered.
    void open() { open_ = true; }
    // Shares a part with other threads. Takes over the caller's reference.
    AtspiPart share(AtspiAccessible* part);

    // ---- From any thread ----
    void post(Call call);
    void postAfter(std::chrono::milliseconds delay, Call call);
    void end();
    bool hasEnded() const { return ended_; }

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
        post([asked, question = std::move(question)] {
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

    void attach(GSource* source, Call call);
    bool answersAreExpected() const;
    void expectNoAnswers();

    GMainContext* const context_;
    std::atomic<bool> open_ = false;
    std::atomic<bool> ended_ = false;
    std::atomic<std::chrono::steady_clock::rep> pausedUntil_ = 0;
};

}  // namespace plume
