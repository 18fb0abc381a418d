// Which program is in front and which part of it has the focus: found by asking, on the accessibility thread, and read
// by all without waiting.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <mutex>
#include <optional>
#include <string>
#include <utility>

#include "ports/atspi/AtspiAccessibility.h"
#include "ports/atspi/AtspiFocusFinder.h"
#include "ports/posix/OwedAnswer.h"

namespace plume {

// What has the focus, as its program told when it was asked.
struct AtspiFocused {
    AtspiPart part;
    bool isText = false;                 // no password
    std::optional<bool> selectsNothing;  // when that was asked, too
};

// What is known of the focus.
class AtspiFocus {
  public:
    // What a part is to somebody who types.
    enum class Kind { Unknown, Line, Lines, Password };
    // A program for as long as it is in front: what was found for an earlier one no longer holds.
    struct Front {
        pid_t process = 0;  // 0: not known
        std::uint64_t turn = 0;
    };

    Front front() const {
        const std::scoped_lock lock(mutex_);
        return front_;
    }
    AtspiPart part() const {
        const std::scoped_lock lock(mutex_);
        return part_;
    }
    // Nothing if it was told longer ago than a delivery asks several things at once.
    std::optional<AtspiFocused> justTold() const {
        const std::scoped_lock lock(mutex_);
        const bool isRecent = told_.part && Clock::now() - toldAt_ < JustTold;
        return isRecent ? std::optional(told_) : std::nullopt;
    }
    bool isKnown() const { return isKnown_; }
    bool isPassword() const { return kind_ == Kind::Password; }
    bool isLines() const { return kind_ == Kind::Lines; }
    pid_t process() const { return process_; }
    // Whether it went from one field of a line to another since this was asked last, while nobody expected it to move.
    bool takeOwnMove() { return movedByItself_.load(std::memory_order_relaxed) && movedByItself_.exchange(false); }

    // Whether that is another one. Its focus is not known at first.
    bool setFront(pid_t process) {
        const std::scoped_lock lock(mutex_);
        if (front_.process == process) return false;
        front_ = {process, front_.turn + 1};
        lastLine_ = {};
        movedByItself_ = false;
        change({}, Kind::Unknown, 0);
        return true;
    }
    void set(const Front& front, AtspiPart part, Kind kind, pid_t process, bool wasExpected) {
        const std::scoped_lock lock(mutex_);
        if (front.turn != front_.turn) return;
        const bool isLine = kind == Kind::Line || kind == Kind::Password;
        if (isLine && lastLine_ && lastLine_ != part && !wasExpected) movedByItself_ = true;
        lastLine_ = isLine ? part : AtspiPart();
        change(std::move(part), kind, process);
    }
    void forget(const Front& front) {
        const std::scoped_lock lock(mutex_);
        if (front.turn == front_.turn) change({}, Kind::Unknown, 0);
    }
    // Somebody asks what has the focus; `selectsNothing` is what `asked` has told.
    AtspiFocused tell(const AtspiPart& asked, std::optional<bool> selectsNothing) {
        const std::scoped_lock lock(mutex_);
        const bool isText = kind_ == Kind::Line || kind_ == Kind::Lines;
        told_ = {part_, isText, part_ == asked ? selectsNothing : std::nullopt};
        toldAt_ = Clock::now();
        return told_;
    }

  private:
    using Clock = std::chrono::steady_clock;
    static constexpr std::chrono::milliseconds JustTold{10};

    void change(AtspiPart part, Kind kind, pid_t process) {
        isKnown_ = static_cast<bool>(part);
        kind_ = kind;
        process_ = process;
        if (part != part_) told_ = {};
        part_ = std::move(part);
    }

    mutable std::mutex mutex_;  // held to copy two strings, never longer
    Front front_;
    AtspiPart part_;
    AtspiFocused told_;
    Clock::time_point toldAt_{};
    AtspiPart lastLine_;  // what had the focus last, if it is a field of one line
    std::atomic<bool> isKnown_ = false;
    std::atomic<Kind> kind_ = Kind::Unknown;
    std::atomic<bool> movedByItself_ = false;
    std::atomic<pid_t> process_ = 0;
};

// Asks what has the focus when somebody says that it may have moved, and while somebody types. With nothing going on it
// does nothing, and sets no timer.
class AtspiFocusTracker {
  public:
    // `address` makes sure that the bus is connected, and tells where it is: nothing when it cannot be.
    using BusAddressSource = std::function<const std::string*()>;
    AtspiFocusTracker(PollRunLoop& loop, AtspiBus& bus, BusAddressSource address);
    AtspiFocusTracker(const AtspiFocusTracker&) = delete;
    AtspiFocusTracker& operator=(const AtspiFocusTracker&) = delete;

    // ---- From any thread, never waiting ----
    const AtspiFocus& focus() const { return focus_; }
    void setFrontProcess(pid_t process);
    void focusMayHaveMoved();
    void userTypes();

    // ---- On the tap thread ----
    bool takeOwnMove() { return focus_.takeOwnMove(); }
    void userMovesFocus(FocusMover mover);
    // Waits for the first look at a program that has come to the front, 50 ms at most and once a program; and for where
    // the focus went, until 50 ms after the user moved it.
    void awaitAnswers();

    // ---- On the accessibility thread ----
    // What has the focus now, or a moment ago.
    AtspiFocused focusedNow();
    // Whether it may have moved a moment ago.
    bool isMoveExpected() const;

  private:
    using Clock = std::chrono::steady_clock;

    void lookSeveralTimes();
    void lookAfter(std::size_t step);
    void lookAfterTyping();
    void look();
    void lookAt(const AtspiFocus::Front& front);
    void heardFocus(const AtspiPart& part);
    void expectMove();
    void search(const AtspiFocus::Front& front);
    void becomeFocused(const AtspiFocus::Front& front, const AtspiPart& part, pid_t process);
    void listenWhereItHelps(const AtspiFocus::Front& front, const AtspiFocusFinder::Found& found);
    void setPause(std::chrono::milliseconds pause);

    PollRunLoop& loop_;
    AtspiBus& bus_;
    const BusAddressSource address_;
    AtspiFocusFinder finder_;
    AtspiFocusListener listener_;
    AtspiFocus::Front listenedFront_;  // whose focus the listener tells
    pid_t listenedProcess_ = 0;
    AtspiFocus focus_;
    int connection_ = 0;  // the one on which it was found
    Clock::time_point lookedAt_{};
    std::size_t misses_ = 0;  // looks in a row that found nothing, without those of a series
    Timer nextOfSeries_;      // of looks after a move; none after the last one
    Timer afterTyping_;
    OwedAnswer firstLook_;
    OwedAnswer moved_;  // where the focus went when the user moved it
    std::atomic<Clock::rep> movedAt_ = 0;
    std::atomic<Clock::rep> expectedUntil_ = 0;
    std::atomic<bool> programTells_ = false;  // the one in front, of its focus
    // From when on a key makes for a look.
    std::atomic<Clock::rep> nextLook_ = 0;
};

}  // namespace plume
