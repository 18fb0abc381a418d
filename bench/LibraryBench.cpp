// How long a library of 10,000 snippets takes to be written as an archive and read back, and how large it becomes; what
// a change and a save cost; how fast foreign libraries come in; and when a Plume with such a library is ready, and what
// its changes cost who types meanwhile.
#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "app/cli/BackgroundWork.h"
#include "bench/Figures.h"
#include "bench/GeneratedLibrary.h"
#include "bench/KeyLatency.h"
#include "import/Importers.h"
#include "library/DataManager.h"
#include "library/KnownSettings.h"
#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/posix/PosixFiles.h"
#include "ports/posix/store/SqliteStore.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::bench {
namespace {

using rig::DesktopRig;
using rig::Milliseconds;
using rig::PlumeProgram;
using rig::TargetKind;
using rig::TargetProgram;

constexpr int Runs = 15;

void benchArchive() {
    const LibraryContents library = makeLibrary(SnippetsPerGroup, 10);
    std::string bytes;
    print("library.archive.write", medianNanoseconds(Runs, [&] { bytes = libraryArchive(library); }) / 1e6, "ms");
    const auto readAll = [&bytes] {
        const auto read = readLibraryArchive(bytes, {});
        require(read.ok() && read.value().snippetGroups.size() == GroupCount);
        require(read.value().snippetGroups.back()->items().size() == SnippetsPerGroup);
    };
    print("library.archive.read", medianNanoseconds(Runs, readAll) / 1e6, "ms");
}

void benchSize() {
    const std::size_t all = libraryArchive(makeLibrary(SnippetsPerGroup, 0)).size();
    const std::size_t groups = libraryArchive(makeLibrary(0, 0)).size();
    print("library.archive.bytes_per_snippet", static_cast<double>(all - groups) / SnippetCount, "bytes");
}

// ---- The store ----

// A library in a store on the disk, with a loop that runs.
class StoredBench {
  public:
    explicit StoredBench(const std::filesystem::path& folder) : work_(loop_) {
        auto opened = SqliteStore::open(folder, nullptr);
        require(opened.ok());
        store_ = std::move(opened.value().store);
        store_->settings().registerDefaults(registeredSettings(folder / "Backups"));
        DataManager::Dependencies dependencies{
            .settings = store_->settings(),
            .storage = store_->library(),
            .files = files_,
            .watcher = watcher_,
            .loop = loop_,
            .places = {},
            .import = [this](const Files::Path& path) { return importLibrary(path, files_); },
            .convertOldSnippet = {},
            .report = [](const std::string& sentence) { std::fprintf(stderr, "%s\n", sentence.c_str()); },
            .inBackground = [this](auto work, auto done) { work_.begin(std::move(work), std::move(done)); },
        };
        manager_ = std::make_unique<DataManager>(std::move(dependencies));
        require(manager_->loadAutoTextData().ok());
        manager_->snippetGroups() = makeLibrary(SnippetsPerGroup, 10).snippetGroups;
        manager_->notifyDataChanged();
        require(manager_->saveData().ok());
    }
    ~StoredBench() { work_.finish(); }

    void measureJournal() {
        std::vector<double> times;
        for (std::size_t i = 0; i < 200; ++i) {
            change(i * 37);
            times.push_back(nanosecondsOf([this] { require(manager_->writeJournal().ok()); }));
        }
        print("library.journal.append", median(std::move(times)) / 1e6, "ms");
    }

    // The longest that a call which is due every half millisecond has to wait beyond that, while a save comes and goes.
    void measureSave() {
        change(1);
        probe(loop_.now());
        const Timer end = loop_.performAfterDelay(7, [this] { loop_.stop(); });
        loop_.run();
        print("library.save.blocked", longest_ * 1e3, "ms");
    }

  private:
    void change(std::size_t number) {
        auto& group = *manager_->snippetGroups()[number % GroupCount];
        group.items()[number % SnippetsPerGroup]->setPlainTextContent(u"Changed " + std::u16string(number % 90, u'x'));
        manager_->notifyDataChanged();
    }
    void probe(double due) {
        longest_ = std::max(longest_, loop_.now() - due);
        const double next = loop_.now() + 0.0005;
        probe_ = loop_.performAfterDelay(0.0005, [this, next] { probe(next); });
    }

    PollRunLoop loop_;
    BackgroundWork work_;
    PosixFiles files_;
    InotifyFileWatcher watcher_{loop_};
    std::unique_ptr<SqliteStore> store_;
    std::unique_ptr<DataManager> manager_;
    Timer probe_;
    double longest_ = 0;
};

// ---- Foreign libraries ----

void benchImport(const std::filesystem::path& folder) {
    const auto file = folder / "five-thousand.ahk";
    std::ofstream lines(file);
    for (int i = 0; i < 5000; ++i) lines << "::abbr" << i << "::The replacement of number " << i << ", a short one\n";
    lines.close();
    const PosixFiles files;
    const auto import = [&] {
        const auto imported = importLibrary(file, files);
        require(imported.ok() && imported.value().groups.front()->items().size() == 5000);
    };
    print("library.import.ahk5000", medianNanoseconds(Runs, import) / 1e6, "ms");
}

void benchConvert(const std::filesystem::path& folder, const std::string& program) {
    const auto file = folder / "many.textexpander";
    std::ofstream list(file);
    list << R"(<?xml version="1.0" encoding="UTF-8"?><plist version="1.0"><dict><key>groupInfo</key><dict>)"
         << "<key>groupName</key><string>Many</string></dict><key>snippetsTE2</key><array>";
    for (int i = 0; i < 1500; ++i) {
        list << "<dict><key>abbreviation</key><string>te" << i
             << "</string><key>abbreviationMode</key><integer>0</integer>"
             << "<key>label</key><string>Label " << i
             << "</string><key>plainText</key><string>Dear %filltext:name=who%, "
             << "today is %A, %e %B; number " << i << ".%|</string><key>snippetType</key><integer>0</integer>"
             << "<key>uuidString</key><string>uuid-" << i << "</string></dict>";
    }
    list << "</array></dict></plist>";
    list.close();
    const std::string command =
        program + " convert " + file.string() + " " + (folder / "many.plume").string() + " >/dev/null";
    const auto convert = [&] { require(std::system(command.c_str()) == 0); };
    print("library.convert.textexpander1500", medianNanoseconds(Runs, convert) / 1e6, "ms");
}

// ---- A Plume that runs ----

std::vector<double> latencies(DesktopRig& rig, TargetProgram& target, int seconds) {
    const rig::Deadline deadline(Milliseconds(seconds * 1000));
    return keyLatencies(rig, target, 5, [&deadline](int) { return !deadline.passed(); });
}

// Two versions of the library turn by turn from "another machine". Every one has Plume take it over and save it.
class OtherMachine {
  public:
    explicit OtherMachine(DesktopRig& rig) : folder_(rig.directory() / "shared") {
        std::filesystem::create_directories(folder_ / "Plume");
        LibraryContents library = makeLibrary(SnippetsPerGroup, 10);
        for (const char* name : {"0", "1"}) {
            library.snippetGroups[7]->items()[7]->setPlainTextContent(fromUtf8(name));
            library.versionUUIDString = Uuid::random().toString();
            library.dateCreated = currentDate();
            std::ofstream(folder_ / name, std::ios::binary) << libraryArchive(library);
        }
        send();
    }

    const std::filesystem::path& folder() const { return folder_; }

    void send() {
        const auto draft = folder_ / "draft";
        std::filesystem::copy_file(folder_ / std::to_string(++sent_ % 2), draft);
        std::filesystem::rename(draft, folder_ / "Plume" / "Data.plume");
    }

  private:
    std::filesystem::path folder_;
    int sent_ = 0;
};

LibraryStorage::Generation savesIn(DesktopRig& rig) {
    const auto opened = SqliteStore::open(rig.directory() / "home/.config/plume", nullptr);
    require(opened.ok());
    return opened.value().store->library().load().value().generation;
}

void benchReady(DesktopRig& rig, const std::string& program) {
    const auto all = rig.directory() / "all.plume";
    std::ofstream(all, std::ios::binary) << libraryArchive(makeLibrary(SnippetsPerGroup, 10));
    require(rig.session().start({program, "import", all.string()}, "plume")->waitForExit(Milliseconds(20'000)) == 0);
    std::vector<double> ready;
    for (int i = 0; i < 7; ++i) ready.push_back(PlumeProgram(rig, "").secondsToReady());
    print("library.ready.10000", median(std::move(ready)) * 1e3, "ms");
}

void benchSaving(DesktopRig& rig, const std::string& program) {
    OtherMachine other(rig);
    const std::pair<const char*, std::string> settings[] = {{"SyncDirectory", other.folder()}, {"SyncEnabled", "true"}};
    for (const auto& [name, value] : settings) {
        const auto set = rig.session().start({program, "settings", name, value}, "plume");
        require(set->waitForExit(Milliseconds(5'000)) == 0);
    }
    PlumeProgram plume(rig, "");
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    latencies(rig, *target, 5);
    // Turn by turn, since a machine is not equally fast all the time.
    constexpr int Turns = 12;
    std::vector<double> quiet;
    std::vector<double> busy;
    const auto before = savesIn(rig);
    for (int turn = 0; turn < Turns; ++turn) {
        append(quiet, latencies(rig, *target, 2));
        other.send();
        append(busy, latencies(rig, *target, 2));
    }
    require(savesIn(rig) >= before + Turns);
    const double quietest = percentile(std::move(quiet), 0.99);
    print("library.key_during_save.quiet.p99", quietest, "us");
    print("library.key_during_save.p99", percentile(std::move(busy), 0.99) - quietest, "us");
}

}  // namespace
}  // namespace plume::bench

int main() {
    using namespace plume::bench;
    const auto program = (std::filesystem::read_symlink("/proc/self/exe").parent_path() / "plume").string();
    std::string name = (std::filesystem::temp_directory_path() / "plume-bench-XXXXXX").string();
    require(mkdtemp(name.data()) != nullptr);
    benchArchive();
    benchSize();
    {
        StoredBench stored(std::filesystem::path(name) / "store");
        stored.measureJournal();
        stored.measureSave();
    }
    benchImport(name);
    benchConvert(name, program);
    std::filesystem::remove_all(name);
    plume::rig::DesktopRig desktop;
    benchReady(desktop, program);
    benchSaving(desktop, program);
}
