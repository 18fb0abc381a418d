// How far the tap has come with the user's keys, in memory that Plume shares with its watchdog.
//
// The watchdog hears the same keys as the tap. When it has to free the keyboard, it passes on those that the tap has
// not handled, and a tap that comes to life again leaves them alone. A key is told by the server's time and its number
// among the keys of that time, which both sides count for themselves. The memory belongs to no file and holds no keys.
#pragma once

#include <atomic>
#include <cstdint>

#include "ports/posix/FileDescriptor.h"

namespace plume {

// A press or a release; none of the repeats of a held key.
struct KeyMoment {
    std::uint32_t time = 0;  // the server's, in milliseconds
    std::uint32_t number = 0;
};

// Numbers the presses and releases as they come.
class KeyMoments {
  public:
    KeyMoment next(std::uint32_t time);

  private:
    KeyMoment latest_;
};

class TapProgress {
  public:
    // Memory of its own. Where there is none to share, nobody else knows of the progress.
    TapProgress();
    // The memory that was inherited as this descriptor.
    explicit TapProgress(int descriptor);
    ~TapProgress();
    TapProgress(const TapProgress&) = delete;
    TapProgress& operator=(const TapProgress&) = delete;

    // For the watchdog to inherit; -1 when there is none.
    int descriptor() const { return memory_.get(); }

    // The tap: with a new connection; after each key; and whether to leave keys to the watchdog. No system calls.
    void begin();
    void setHandled(KeyMoment key);
    bool isTakenOver() const { return words_->takenOver.load() != 0; }

    // The watchdog: true also when nothing is known.
    bool hasHandled(KeyMoment key) const;
    void takeOver() { words_->takenOver.store(1); }

  private:
    struct Words {
        std::atomic<std::uint64_t> handled = 0;  // time and number
        std::atomic<std::uint32_t> takenOver = 0;
    };
    static_assert(std::atomic<std::uint64_t>::is_always_lock_free);

    void map();

    FileDescriptor memory_;
    Words own_;  // where none is shared
    Words* words_ = &own_;
};

}  // namespace plume
