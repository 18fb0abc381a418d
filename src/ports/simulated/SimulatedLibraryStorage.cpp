#include "ports/simulated/SimulatedLibraryStorage.h"

#include <utility>

namespace plume {

void SimulatedLibraryStorage::Disk::setFailure(std::optional<Error> failure) {
    const std::lock_guard lock(mutex_);
    failure_ = std::move(failure);
}

SimulatedLibraryStorage::SimulatedLibraryStorage(RunLoop& loop, std::shared_ptr<Disk> disk)
    : loop_(loop), disk_(std::move(disk)) {
    const std::lock_guard lock(disk_->mutex_);
    disk_->users_.insert(this);
}

SimulatedLibraryStorage::~SimulatedLibraryStorage() {
    const std::lock_guard lock(disk_->mutex_);
    disk_->users_.erase(this);
}

Result<LibraryStorage::Stored> SimulatedLibraryStorage::load() {
    const std::lock_guard lock(disk_->mutex_);
    if (disk_->failure_) return *disk_->failure_;
    Stored stored{.archive = disk_->archive_, .journal = {}, .generation = disk_->generation_};
    for (const auto& [generation, entry] : disk_->journal_) stored.journal.push_back(entry);
    return stored;
}

bool SimulatedLibraryStorage::isOutdated(Generation basedOn) const {
    if (basedOn > disk_->generation_ || basedOn < savedUpTo_) return true;
    for (Generation later = basedOn + 1; later <= disk_->generation_; ++later) {
        if (!own_.contains(later)) return true;
    }
    return false;
}

LibraryStorage::Generation SimulatedLibraryStorage::noteWrite() {
    own_.insert(++disk_->generation_);
    for (const SimulatedLibraryStorage* user : disk_->users_) {
        if (user == this) continue;
        user->loop_.perform([observers = std::weak_ptr(user->observers_)] {
            if (const auto those = observers.lock()) those->call();
        });
    }
    return disk_->generation_;
}

LibraryStorage::Written SimulatedLibraryStorage::append(std::string_view journalEntry, Generation basedOn) {
    const std::lock_guard lock(disk_->mutex_);
    if (disk_->failure_) return *disk_->failure_;
    if (isOutdated(basedOn)) return {Outdated()};
    const Generation written = noteWrite();
    disk_->journal_.emplace(written, journalEntry);
    return {written};
}

LibraryStorage::Written SimulatedLibraryStorage::save(std::string_view archive, Generation basedOn) {
    const std::lock_guard lock(disk_->mutex_);
    if (disk_->failure_) return *disk_->failure_;
    if (isOutdated(basedOn)) return {Outdated()};
    disk_->archive_ = archive;
    disk_->journal_.erase(disk_->journal_.begin(), disk_->journal_.upper_bound(basedOn));
    savedUpTo_ = basedOn;
    return {noteWrite()};
}

Subscription SimulatedLibraryStorage::addObserver(std::function<void()> changedByAnotherProcess) {
    return observers_->add(std::move(changedByAnotherProcess));
}

}  // namespace plume
