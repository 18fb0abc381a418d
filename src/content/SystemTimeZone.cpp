#include "content/SystemTimeZone.h"

#include <fcntl.h>
#include <unicode/timezone.h>

#include <memory>

namespace plume {

SystemTimeZone::FileState SystemTimeZone::look() const {
    // The time of change, which, unlike that of modification, no program can set back.
    const auto node = [this](int flags) {
        struct stat status {};
        if (fstatat(AT_FDCWD, file_.c_str(), &status, flags) != 0) return FileState::Node{};
        return FileState::Node{status.st_dev, status.st_ino, status.st_ctim.tv_sec, status.st_ctim.tv_nsec};
    };
    return {node(AT_SYMLINK_NOFOLLOW), node(0)};
}

void SystemTimeZone::follow() {
    const std::lock_guard lock(mutex_);
    // Before the zone is read: what changes meanwhile is seen the next time.
    const FileState now = look();
    if (now == seen_) return;
    seen_ = now;
    // ICU's own first look would otherwise be possible on another thread at the same time, which it cannot bear.
    const std::unique_ptr<icu::TimeZone> initialised(icu::TimeZone::createDefault());
    icu::TimeZone::adoptDefault(icu::TimeZone::detectHostTimeZone());
}

}  // namespace plume
