#include "ports/posix/InotifyFileWatcher.h"

#include <linux/magic.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstring>
#include <deque>
#include <tuple>
#include <utility>

namespace plume {

namespace {

using Path = std::filesystem::path;

constexpr std::uint32_t NameEvents = IN_CREATE | IN_DELETE | IN_MOVED_FROM | IN_MOVED_TO;
constexpr std::uint32_t FileEvents = NameEvents | IN_MODIFY | IN_CLOSE_WRITE | IN_ATTRIB;

// File systems on which others write without this system being told.
bool isShared(const Path& folder) {
    constexpr std::array<unsigned, 6> Shared{NFS_SUPER_MAGIC,  SMB_SUPER_MAGIC, CIFS_SUPER_MAGIC,
                                             SMB2_SUPER_MAGIC, V9FS_MAGIC,      FUSE_SUPER_MAGIC};
    struct statfs system {};
    if (statfs(folder.c_str(), &system) != 0) return false;
    return std::find(Shared.begin(), Shared.end(), static_cast<unsigned>(system.f_type)) != Shared.end();
}

// The names that are still to be gone through, from a folder without links on its way.
class Way {
  public:
    explicit Way(const Path& file) { push(file); }

    bool isOver() const { return names_.empty(); }
    bool isLast() const { return names_.size() == 1; }
    const Path& folder() const { return folder_; }
    std::string name() const { return names_.front(); }

    // False when there is nothing more to go to.
    bool go() {
        const Path next = folder_ / names_.front();
        names_.pop_front();
        std::error_code problem;
        const auto kind = std::filesystem::symlink_status(next, problem).type();
        if (kind == std::filesystem::file_type::symlink) return follow(std::filesystem::read_symlink(next, problem));
        if (kind != std::filesystem::file_type::directory) return false;
        folder_ = next;
        dropDots();
        return true;
    }

  private:
    bool follow(const Path& target) {
        constexpr int MostLinks = 40;
        if (++links_ > MostLinks) return false;
        push(target);
        return true;
    }

    void push(const Path& path) {
        if (path.is_absolute()) folder_ = "/";
        const Path names = path.relative_path();
        names_.insert(names_.begin(), names.begin(), names.end());
        dropDots();
    }

    void dropDots() {
        while (!names_.empty() && (names_.front() == ".." || names_.front() == "." || names_.front().empty())) {
            if (names_.front() == "..") folder_ = folder_.parent_path();
            names_.pop_front();
        }
    }

    Path folder_ = "/";
    std::deque<std::string> names_;
    int links_ = 0;
};

}  // namespace

struct InotifyFileWatcher::Look {
    explicit Look(const Path& file) {
        struct stat status {};
        if (stat(file.c_str(), &status) != 0) return;
        what = {status.st_dev,          status.st_ino,         status.st_size,        status.st_mtim.tv_sec,
                status.st_mtim.tv_nsec, status.st_ctim.tv_sec, status.st_ctim.tv_nsec};
    }
    bool operator==(const Look&) const = default;

    std::tuple<dev_t, ino_t, off_t, time_t, long, time_t, long> what = {};
};

InotifyFileWatcher::InotifyFileWatcher(DescriptorLoop& loop, double timeBetweenLooks)
    : loop_(loop), timeBetweenLooks_(timeBetweenLooks), inotify_(inotify_init1(IN_NONBLOCK | IN_CLOEXEC)) {
    if (inotify_.isOpen()) source_ = loop_.addSource(inotify_.get(), [this] { drain(); });
}

Subscription InotifyFileWatcher::watch(const Path& file, std::function<void()> changed) {
    if (!isTelling_) forgetUnused();
    Watched& watched = watched_.emplace_back();
    watched.file = file;
    watchWay(watched);
    (void)noteLook(watched);
    lookAgainLater();
    return watched.observers.add(std::move(changed));
}

void InotifyFileWatcher::watchWay(Watched& watched) {
    watched.steps.clear();
    watched.isLookedAt = !inotify_.isOpen();
    Way way(watched.file);
    // A folder is watched before its names are looked at: what changes in between is told.
    while (!way.isOver()) {
        addStep(watched, way.folder(), way.name(), way.isLast());
        if (!way.go()) break;
    }
    if (isShared(way.folder())) watched.isLookedAt = true;
}

void InotifyFileWatcher::addStep(Watched& watched, const Path& folder, const std::string& name, bool isLast) {
    if (!inotify_.isOpen()) return;
    const int number = inotify_add_watch(inotify_.get(), folder.c_str(),
                                         (isLast ? FileEvents : NameEvents) | IN_MASK_ADD | IN_ONLYDIR);
    if (number < 0) {
        watched.isLookedAt = true;
        return;
    }
    folders_.insert(number);
    watched.steps.push_back({number, name, isLast});
}

void InotifyFileWatcher::drain() {
    constexpr std::size_t Room = 16384;
    alignas(inotify_event) std::array<char, Room> bytes{};
    bool any = false;
    for (ssize_t size = 0; (size = read(inotify_.get(), bytes.data(), bytes.size())) > 0;) {
        any = true;
        inotify_event event{};
        for (std::size_t at = 0; at < static_cast<std::size_t>(size); at += sizeof event + event.len) {
            std::memcpy(&event, bytes.data() + at, sizeof event);
            // The name is filled up with zeros.
            const std::string name = event.len > 0 ? std::string(bytes.data() + at + sizeof event) : std::string();
            if (event.mask & IN_IGNORED) folders_.erase(event.wd);
            noteEvent(event.wd, name, event.mask & IN_Q_OVERFLOW);
        }
    }
    if (any) tellChanges();
}

void InotifyFileWatcher::noteEvent(int folder, const std::string& name, bool isOverflow) {
    for (Watched& watched : watched_) {
        for (const Step& step : watched.steps) {
            const bool isMeant = isOverflow || (step.folder == folder && (name.empty() || step.name == name));
            if (!isMeant) continue;
            if (isOverflow || step.isLast) watched.hasChanged = true;
            watched.isLookedAt = true;  // until its way is watched anew
        }
    }
}

void InotifyFileWatcher::tellChanges() {
    for (Watched& watched : watched_) {
        if (!watched.isLookedAt) continue;
        watchWay(watched);
        if (noteLook(watched)) watched.hasChanged = true;
    }
    forgetUnused();
    lookAgainLater();
    // Observers may watch more files and end what they watch; everything stays where it is meanwhile.
    isTelling_ = true;
    for (Watched& watched : watched_) {
        if (std::exchange(watched.hasChanged, false)) watched.observers.call();
    }
    isTelling_ = false;
}

bool InotifyFileWatcher::noteLook(Watched& watched) {
    auto look = std::make_shared<const Look>(watched.file);
    const bool differs = !watched.look || *watched.look != *look;
    watched.look = std::move(look);
    return differs;
}

void InotifyFileWatcher::forgetUnused() {
    std::erase_if(watched_, [](const Watched& watched) { return watched.observers.empty(); });
    std::set<int> used;
    for (const Watched& watched : watched_) {
        for (const Step& step : watched.steps) used.insert(step.folder);
    }
    std::erase_if(folders_, [&](int folder) {
        const bool isUnused = !used.contains(folder);
        if (isUnused) inotify_rm_watch(inotify_.get(), folder);
        return isUnused;
    });
}

void InotifyFileWatcher::lookAgainLater() {
    const bool any = std::any_of(watched_.begin(), watched_.end(), [](const Watched& w) { return w.isLookedAt; });
    if (!any) {
        looking_.cancel();
    } else if (!looking_) {
        looking_ = loop_.performAfterDelay(timeBetweenLooks_, [this] { lookAtAll(); });
    }
}

void InotifyFileWatcher::lookAtAll() {
    looking_.cancel();
    tellChanges();
}

}  // namespace plume
