// Where the thread that hears an input method and the one that has the keyboard meet: what becomes of keys.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <deque>
#include <functional>
#include <mutex>
#include <optional>
#include <string>
#include <utility>

#include "platform/InputMethod.h"
#include "ports/posix/OwedAnswer.h"

namespace plume {

class ComposedKeys final : public InputMethod {
  public:
    // On the thread that hears, whenever there is something to take. Set before that thread runs.
    std::function<void()> happened;

    // ---- On the tap thread ----
    bool takesText() const override { return takesText_; }
    bool isComposing() const override { return composing_; }
    bool isIdle() const override { return idle_; }
    void announceKey(std::uint32_t code, bool typesNothing) override;
    void settle() override;
    std::optional<Outcome> next() override;

    // ---- On the thread that hears ----
    // Whether an engine gets the keys of the field that has the focus. Without one nothing is composed.
    void setTakesText(bool takes);
    void setComposing(bool composing) { composing_ = composing; }
    // The engine has got the key that was announced, and not one that Plume sends. What comes until it is done with
    // the key belongs to that.
    bool beginsWith(std::uint32_t code);
    void put(const std::u16string& text);
    void erase(std::size_t characters);
    void passKey();
    void end();

  private:
    bool engineIsSlow();
    void push(Outcome outcome);

    std::atomic<bool> takesText_ = false;
    std::atomic<bool> composing_ = false;
    std::atomic<bool> idle_ = true;  // written with the mutex held
    OwedAnswer owed_;
    std::chrono::steady_clock::time_point longestWait_;  // on the tap thread, as is the next
    bool typesNothing_ = false;                          // the key that was announced
    std::mutex mutex_;
    std::optional<std::uint32_t> announced_;  // guarded by mutex_, as is all that follows
    std::optional<Outcome> current_;          // of the key that was announced, once the engine has it
    std::deque<Outcome> outcomes_;
};

}  // namespace plume
