// The application with a library of 10,000 snippets on a real desktop: when it is ready, what memory and what wake-ups
// it costs while nothing happens, how fast its windows and changes are, and what changes cost who types meanwhile.
#include <poll.h>

#include <atomic>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "app/session/CommandSocket.h"
#include "bench/Figures.h"
#include "bench/GeneratedLibrary.h"
#include "bench/KeyLatency.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::bench {
namespace {

using rig::DesktopRig;
using rig::Milliseconds;
using rig::TargetKind;

const std::vector<std::string> Windows{"preferences", "new-snippet", "decisions", "reports",
                                       "diagnostics", "restore",     "welcome",   "about"};

std::filesystem::path programPath() {
    return std::filesystem::read_symlink("/proc/self/exe").parent_path() / "plume";
}

// The number in a line of a file of /proc that begins with these words; 0 when there is none.
double numberIn(const std::filesystem::path& file, const std::string& words) {
    std::ifstream lines(file);
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with(words)) return std::stod(line.substr(words.size()));
    }
    return 0;
}

class RunningPlume {
  public:
    explicit RunningPlume(DesktopRig& rig) : rig_(rig) {
        const auto started = std::chrono::steady_clock::now();
        process_ = rig.session().start({programPath()}, "plume");
        const rig::Deadline deadline(Milliseconds(20'000));
        while (process_->logTail().find("Plume is ready") == std::string::npos) {
            require(!deadline.passed() && process_->isRunning());
            poll(nullptr, 0, 1);
        }
        millisecondsToReady_ = since(started);
    }

    double millisecondsToReady() const { return millisecondsToReady_; }

    // Milliseconds until the reply.
    double ask(std::vector<std::string> words) const {
        const auto asked = std::chrono::steady_clock::now();
        const auto reply = handOver(socket(), {"/", std::move(words)});
        require(reply.ok() && reply.value() && reply.value()->status == 0);
        return since(asked);
    }
    double quit() {
        const auto asked = std::chrono::steady_clock::now();
        ask({"quit"});
        require(process_->waitForExit(Milliseconds(10'000)) == 0);
        return since(asked);
    }

    double megabytes() const { return numberIn(folder() / "smaps_rollup", "Pss:") / 1024; }
    double wakeUps() const {
        double all = 0;
        for (const auto& task : std::filesystem::directory_iterator(folder() / "task")) {
            all += numberIn(task.path() / "status", "voluntary_ctxt_switches:");
        }
        return all;
    }
    void closeWindowInFront() const {
        poll(nullptr, 0, 400);
        rig_.keyboard().chord({rig::Key::LeftControl}, U'w');
        rig_.keyboard().sync();
        poll(nullptr, 0, 300);
    }

  private:
    static double since(std::chrono::steady_clock::time_point moment) {
        return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - moment).count();
    }
    std::filesystem::path folder() const { return "/proc/" + std::to_string(process_->pid()); }
    std::filesystem::path socket() const {
        for (const auto& entry : std::filesystem::directory_iterator(rig_.directory() / "run")) {
            if (entry.path().extension() == ".socket") return entry.path();
        }
        return {};
    }

    DesktopRig& rig_;
    std::unique_ptr<rig::ChildProcess> process_;
    double millisecondsToReady_ = 0;
};

void importLibrary(DesktopRig& rig) {
    const auto all = rig.directory() / "all.plume";
    std::ofstream(all, std::ios::binary) << libraryArchive(makeLibrary(SnippetsPerGroup, 10));
    const auto import = rig.session().start({programPath(), "import", all.string()}, "plume");
    require(import->waitForExit(Milliseconds(20'000)) == 0);
}

void benchStartAndEnd(DesktopRig& rig) {
    std::vector<double> ready;
    std::vector<double> quit;
    constexpr int Runs = 7;
    for (int i = 0; i < Runs; ++i) {
        RunningPlume plume(rig);
        ready.push_back(plume.millisecondsToReady());
        quit.push_back(plume.quit());
    }
    print("app.ready.10000", median(std::move(ready)), "ms");
    print("app.quit", median(std::move(quit)), "ms");
}

void benchIdle(const RunningPlume& plume) {
    constexpr int Settled = 8'000;
    constexpr int Seconds = 20;
    poll(nullptr, 0, Settled);
    print("app.pss.idle.10000", plume.megabytes(), "MB");
    const double before = plume.wakeUps();
    poll(nullptr, 0, Seconds * 1000);
    print("app.idle_wakeups", (plume.wakeUps() - before) / Seconds, "a second");
}

void benchWindows(const RunningPlume& plume) {
    std::vector<double> opened;
    constexpr int Runs = 7;
    for (int i = 0; i < Runs; ++i) {
        // It answers again when what the window needed at first has been done.
        const double shown = plume.ask({"show", "preferences"});
        opened.push_back(shown + plume.ask({"status"}));
        plume.closeWindowInFront();
    }
    print("app.preferences.open", median(std::move(opened)), "ms");
    for (const std::string& window : Windows) {
        plume.ask({"show", window});
        plume.closeWindowInFront();
    }
    constexpr int Settled = 3'000;
    poll(nullptr, 0, Settled);
    print("app.pss.after_windows.10000", plume.megabytes(), "MB");
}

// From the change to its being told done, behind which the next key finds it.
void benchEdits(DesktopRig& rig, const RunningPlume& plume) {
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    std::vector<double> times;
    constexpr int Runs = 15;
    for (int i = 0; i < Runs; ++i) {
        const std::string text = "text " + std::to_string(i);
        times.push_back(plume.ask({"add", "qzv", text}));
        require(rig::typeAndAwait(rig, *target, "qzv ", text + " ").isRight);
        plume.ask({"remove", "qzv"});
    }
    print("app.edit_to_effect", median(std::move(times)), "ms");
}

void benchKeysDuringEdits(DesktopRig& rig, const RunningPlume& plume) {
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    const auto latencies = [&](int seconds) {
        const rig::Deadline deadline(Milliseconds(seconds * 1000));
        return keyLatencies(rig, *target, 5, [&deadline](int) { return !deadline.passed(); });
    };
    latencies(4);
    std::vector<double> quiet;
    std::vector<double> busy;
    constexpr int Turns = 10;
    for (int turn = 0; turn < Turns; ++turn) {
        append(quiet, latencies(2));
        std::atomic<bool> ends = false;
        std::thread editor([&] {
            while (!ends) {
                plume.ask({"add", "qzw", "text"});
                poll(nullptr, 0, 20);
                plume.ask({"remove", "qzw"});
                poll(nullptr, 0, 20);
            }
        });
        append(busy, latencies(2));
        ends = true;
        editor.join();
    }
    const double quietest = percentile(std::move(quiet), 0.99);
    print("app.key_during_edits.quiet.p99", quietest, "us");
    print("app.key_during_edits.p99", percentile(std::move(busy), 0.99) - quietest, "us");
}

}  // namespace
}  // namespace plume::bench

int main() {
    using namespace plume::bench;
    plume::rig::DesktopRig desktop;
    importLibrary(desktop);
    benchStartAndEnd(desktop);
    RunningPlume plume(desktop);
    benchIdle(plume);
    benchWindows(plume);
    benchEdits(desktop, plume);
    benchKeysDuringEdits(desktop, plume);
}
