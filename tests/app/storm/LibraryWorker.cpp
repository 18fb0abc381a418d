// Edits a real library on a real disk as fast as it can, and writes down what it did, for tools/library_storm.py.
//
//   plume_library_worker edit FOLDER LOG SEED [SYNC-FOLDER SECONDS]   until it is killed, or for so many seconds
//   plume_library_worker show FOLDER      the version, then the abbreviations, of the library that the store holds
//   plume_library_worker read FILE        the abbreviations in an archive
//
// Waits of a second and more are ten times as short, so that saves and synchronisation happen often.
#include <fcntl.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <iostream>
#include <random>

#include "Foundation/Strings.h"
#include "app/cli/BackgroundWork.h"
#include "import/Importers.h"
#include "library/DataManager.h"
#include "library/KnownSettings.h"
#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/posix/PosixFiles.h"
#include "ports/posix/store/SqliteStore.h"

namespace plume {
namespace {

class HastyLoop final : public RunLoop {
  public:
    explicit HastyLoop(PollRunLoop& loop) : loop_(loop) {}
    double now() const override { return loop_.now(); }
    void perform(Call call) override { loop_.perform(std::move(call)); }

  private:
    CallId schedule(double delay, Call call) override {
        const CallId id = ++lastId_;
        timers_[id] = loop_.performAfterDelay(delay < 1 ? delay : delay / 10, [this, id, call = std::move(call)] {
            const auto running = call;
            timers_.erase(id);
            running();
        });
        return id;
    }
    void cancel(CallId id) override { timers_.erase(id); }

    PollRunLoop& loop_;
    std::map<CallId, Timer> timers_;
    CallId lastId_ = 0;
};

double secondsNow() {
    return std::chrono::duration<double>(std::chrono::system_clock::now().time_since_epoch()).count();
}

std::string abbreviations(const SnippetGroups& groups) {
    std::string all;
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) all += " " + toUtf8(snippet->abbreviation().value_or(u"-"));
    }
    return all;
}

// A library on the disk, in this process.
class Worker {
  public:
    explicit Worker(const std::filesystem::path& folder) {
        auto opened = SqliteStore::open(folder, &watcher_);
        if (!opened) throw std::runtime_error(opened.error().message);
        for (const std::string& problem : opened.value().problems) std::cerr << "problem: " << problem << '\n';
        if (opened.value().damagedFile) throw std::runtime_error("the store is damaged");
        store_ = std::move(opened.value().store);
        store_->settings().registerDefaults(registeredSettings(folder / "Backups"));
        manager_ = std::make_unique<DataManager>(DataManager::Dependencies{
            .settings = store_->settings(),
            .storage = store_->library(),
            .files = files_,
            .watcher = watcher_,
            .loop = hasty_,
            .places = {.damagedFiles = folder},
            .import = [this](const Files::Path& path) { return importLibrary(path, files_); },
            .convertOldSnippet = {},
            .report = [](const std::string& sentence) { std::cerr << sentence << '\n'; },
            .inBackground = [this](auto work, auto done) { saves_.begin(std::move(work), std::move(done)); },
            .offerBackup = [](const auto&) { throw std::runtime_error("the library is damaged"); },
        });
        if (const auto loaded = manager_->loadAutoTextData(); !loaded) throw std::runtime_error(loaded.error().message);
    }

    void edit(const std::string& log, unsigned seed, const std::filesystem::path& syncFolder, double seconds) {
        log_ = ::open(log.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600);
        random_.seed(seed);
        prefix_ = std::to_string(seed) + "-" + std::to_string(getpid()) + "-";
        isSyncing_ = !syncFolder.empty();
        synced_ = manager_->didSyncDataEvent.addObserver(this, &Worker::noteSync);
        if (isSyncing_) {
            auto& settings = store_->settings();
            (void)settings.setObject("BackupQuantity", std::int64_t{0});
            (void)settings.setObject("SyncDirectory", fromUtf8(syncFolder.string()));
            (void)settings.setObject("SyncEnabled", true);
            manager_->sync().loadSyncPreferences(false);
        }
        note();
        next();
        if (seconds > 0) end_ = loop_.performAfterDelay(seconds, [this] { quiet_ = true; });
        // What is under way is sent, and arrives.
        if (seconds > 0) stop_ = loop_.performAfterDelay(seconds + 8, [this] { loop_.stop(); });
        loop_.run();
        saves_.finish();
        if (const auto saved = manager_->saveRest(); !saved) throw std::runtime_error(saved.error().message);
    }

    const LibraryContents& library() const { return manager_->library(); }

  private:
    unsigned below(unsigned bound) { return static_cast<unsigned>(random_()) % bound; }

    void next() {
        // Now and then a rest that is long enough for a synchronisation.
        const double delay = isSyncing_ && below(40) == 0 ? below(3) : below(40) / 1000.0;
        timer_ = loop_.performAfterDelay(delay, [this] {
            if (quiet_) return;
            act();
            next();
        });
    }

    void act() {
        auto& groups = manager_->snippetGroups();
        if (groups.empty()) manager_->generateSnippetGroupSamples(u"Group", {});
        auto& group = *groups[below(static_cast<unsigned>(groups.size()))];
        switch (isSyncing_ ? 99 : below(30)) {
            case 0:
                if (!group.items().empty()) group.removeItem(group.items()[below(unsigned(group.items().size()))]);
                break;
            case 1:
                if (groups.size() < 5) manager_->generateSnippetGroupSamples(u"Another", {});
                break;
            case 2:
                (void)manager_->saveData();
                return;
            case 3:
                (void)manager_->backups().backup();
                return;
            case 4:
                if (const auto newest = manager_->backups().newestBackup()) (void)manager_->restoreFile(*newest);
                return note();
            case 5:
                group.setAbbreviationPrefix(fromUtf8(std::to_string(below(100))));
                break;
            default:
                group.addItem(std::make_shared<Snippet>(fromUtf8(prefix_ + std::to_string(++count_)),
                                                        std::u16string(below(2000), u'x')));
        }
        manager_->notifyDataChanged();
        note();
    }

    void noteSync(LibraryEvent&) { note(); }

    // One line in one write: the moment, the version, and what the library holds.
    void note() {
        const auto& version = manager_->library().versionUUIDString;
        const std::string line = std::to_string(secondsNow()) + " " + toUtf8(version.value_or(u"-")) +
                                 abbreviations(manager_->snippetGroups()) + "\n";
        if (::write(log_, line.data(), line.size()) < 0) throw std::runtime_error("the log cannot be written");
    }

    PollRunLoop loop_;
    HastyLoop hasty_{loop_};
    PosixFiles files_;
    InotifyFileWatcher watcher_{loop_};
    std::unique_ptr<SqliteStore> store_;
    std::unique_ptr<DataManager> manager_;
    BackgroundWork saves_{loop_};
    Subscription synced_;
    std::mt19937 random_{std::random_device()()};  // edit() seeds it anew
    std::string prefix_;
    int count_ = 0;
    int log_ = -1;
    bool isSyncing_ = false;
    bool quiet_ = false;
    Timer timer_;
    Timer end_;
    Timer stop_;
};

int run(const std::vector<std::string>& arguments) {
    if (arguments.size() == 2 && arguments[0] == "read") {
        const auto imported = importLibrary(arguments[1], PosixFiles());
        if (!imported) throw std::runtime_error(imported.error().message);
        std::cout << abbreviations(imported.value().groups) << '\n';
        return 0;
    }
    if (arguments.size() < 2) return 2;
    Worker worker(arguments[1]);
    if (arguments[0] == "show") {
        std::cout << toUtf8(worker.library().versionUUIDString.value_or(u"-"))
                  << abbreviations(worker.library().snippetGroups) << '\n';
        return 0;
    }
    const bool syncs = arguments.size() == 6;
    worker.edit(arguments.at(2), static_cast<unsigned>(std::stoul(arguments.at(3))), syncs ? arguments[4] : "",
                syncs ? std::stod(arguments[5]) : 0);
    return 0;
}

}  // namespace
}  // namespace plume

int main(int argc, char** argv) {
    try {
        return plume::run({argv + 1, argv + argc});
    } catch (const std::exception& problem) {
        std::cerr << problem.what() << '\n';
        return 1;
    }
}
