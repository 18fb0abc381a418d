// From the press of the key that completes an abbreviation to the complete text in a program, on a real desktop, beside
// the least that any expander could take: the same text typed or pasted by a bare synthesiser. With --with-peer also
// beside another expander, AutoKey.
#include <poll.h>
#include <unistd.h>
#include <xcb/xtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "bench/Figures.h"
#include "bench/PeerProgram.h"
#include "testing/rig/PlumeProgram.h"
#include "testing/rig/SelectionClients.h"

namespace plume::bench {

namespace {

using rig::DesktopRig;
using rig::Expansion;
using rig::PlumeProgram;
using rig::TargetKind;
using rig::TargetProgram;

struct Case {
    std::string name;          // "typed20"
    std::string abbreviation;  // completed by its last key
    std::size_t length;        // characters
    int runs;
};

const std::vector<Case> Typed = {
    {"typed20", "qta", 20, 100}, {"typed200", "qtb", 200, 100}, {"typed2000", "qtc", 2000, 20}};
const std::vector<Case> Pasted = {
    {"paste200", "qpa", 200, 100}, {"paste2000", "qpb", 2000, 100}, {"paste20000", "qpc", 20000, 40}};

// Text of a length, in words and without line feeds.
std::string textOf(std::size_t length, bool onlyAscii) {
    static const std::vector<std::string> ascii = {"the", "quick", "brown", "fox", "jumps", "over", "a", "lazy", "dog"};
    static const std::vector<std::string> mixed = {"naïve", "Ünïcödé", "—", "日本語", "【】", "😀", "plain"};
    const auto& words = onlyAscii ? ascii : mixed;
    std::string text;
    std::size_t characters = 0;
    for (std::size_t i = 0; characters < length; ++i) {
        const std::string word = words[i % words.size()] + " ";
        for (std::size_t at = 0; at < word.size() && characters < length;) {
            std::size_t end = at + 1;
            while (end < word.size() && (static_cast<unsigned char>(word[end]) & 0xC0) == 0x80) ++end;
            text += word.substr(at, end - at);
            at = end;
            ++characters;
        }
    }
    return text;
}

std::string library(const std::vector<Case>& cases, bool onlyAscii, int others = 0) {
    std::ostringstream json;
    json << R"([{"name": "bench", "expandAfter": 2, "expandTrigger": 0, "items": [)";
    for (std::size_t i = 0; i < cases.size(); ++i) {
        json << (i > 0 ? "," : "") << R"({"abbreviation": ")" << cases[i].abbreviation << R"(", "content": ")"
             << textOf(cases[i].length, onlyAscii) << R"("})";
    }
    for (int i = 0; i < others; ++i) {
        json << R"(,{"abbreviation": "other)" << i << R"(.", "content": "Something that stands in a library, )" << i
             << R"("})";
    }
    json << "]}]";
    return json.str();
}

std::string settings(bool paste) {
    return std::string(R"({"UseClipboard": )") + (paste ? "true" : "false") +
           R"(, "UseClipboardIn": 0, "UseClipboardForLongText": false})";
}

// What expands: Plume, the bare synthesiser, or another program.
using Expand = std::function<Expansion(const Case&, const std::string& expected)>;

// Milliseconds, by case.
using Times = std::map<std::string, std::vector<double>>;

int measure(Times& times, const std::vector<Case>& cases, const Expand& expand) {
    int wrong = 0;
    for (const Case& tested : cases) {
        for (int run = 0; run < tested.runs; ++run) {
            const Expansion expansion = expand(tested, textOf(tested.length, true));
            if (expansion.isRight) {
                times[tested.name].push_back(expansion.milliseconds);
            } else {
                ++wrong;
            }
        }
    }
    return wrong;
}

void printTimes(const std::string& prefix, const Times& times, const std::string& target) {
    for (const auto& [name, values] : times) {
        print(prefix + name + "." + target + ".median", median(values), "ms");
        print(prefix + name + "." + target + ".p95", percentile(values, 0.95), "ms");
    }
}

std::string shortName(TargetKind kind) {
    return kind == TargetKind::GtkTextView ? "gtk" : kind == TargetKind::QtTextEdit ? "qt" : "xterm";
}

constexpr TargetKind Targets[] = {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm};

// A tenth of the runs: it takes its time.
void measurePeer(DesktopRig& rig) {
    int wrong = 0;
    int runs = 0;
    for (const TargetKind kind : Targets) {
        const auto target = rig.startTarget(kind);
        for (const bool paste : {false, true}) {
            std::vector<Case> cases = paste ? Pasted : Typed;
            std::vector<PeerPhrase> phrases;
            for (Case& tested : cases) {
                phrases.push_back({tested.abbreviation, textOf(tested.length, true), paste});
                runs += tested.runs /= 10;
            }
            const PeerProgram peer(rig, phrases, kind == TargetKind::Xterm);
            Times times;
            wrong += measure(times, cases, [&](const Case& tested, const std::string& text) {
                return rig::typeAndAwait(rig, *target, tested.abbreviation, text);
            });
            printTimes("peer.delivery.", times, shortName(kind));
        }
    }
    print("peer.delivery.wrong", wrong, "count");
    print("peer.delivery.runs", runs, "count");
}

// As a fast typist does it, each key before the one before it comes up.
void typeOn(DesktopRig& rig, const std::string& text) {
    constexpr int Gap = 15;  // milliseconds
    int previous = 0;
    for (const char character : text) {
        const int keycode = rig.keyboard().keycodeOf(static_cast<char32_t>(character));
        if (previous == keycode) rig.keyboard().release(std::exchange(previous, 0));
        rig.keyboard().press(keycode);
        if (previous != 0) rig.keyboard().release(previous);
        previous = keycode;
        poll(nullptr, 0, Gap);
    }
    if (previous != 0) rig.keyboard().release(previous);
    rig.keyboard().sync();
}

// Every kind of text, while the user goes on typing: how many of them did not arrive exactly.
int countWrong(DesktopRig& rig, bool paste) {
    const std::vector<Case> cases = {{"20", "qxa", 20, 50}, {"200", "qxb", 200, 50}, {"2000", "qxc", 2000, 50}};
    const std::string typedOn = " and on";
    int wrong = 0;
    for (const bool onlyAscii : {true, false}) {
        const PlumeProgram plume(rig, library(cases, onlyAscii), settings(paste));
        for (const TargetKind kind : Targets) {
            const auto target = rig.startTarget(kind);
            for (const Case& tested : cases) {
                const std::string expected = textOf(tested.length, onlyAscii) + typedOn;
                for (int run = 0; run < tested.runs; ++run) {
                    target->clear();
                    typeOn(rig, tested.abbreviation + typedOn);
                    if (target->awaitText(expected) != expected) ++wrong;
                }
            }
        }
    }
    return wrong;
}

// What there is at the least: keys sent one after the other, or a clipboard and a keystroke, without any listening.
class BareExpander {
  public:
    explicit BareExpander(DesktopRig& rig) : rig_(rig), client_(rig.server().display()) {}

    void type(const std::string& text) {
        for (const char character : text) tap(rig_.keyboard().keycodeOf(static_cast<char32_t>(character)));
        xcb_flush(client_.connection());
    }

    // Takes the selection that the target pastes.
    void offer(const std::string& text, bool toTerminal) {
        owner_.reset();
        rig::ForeignOwner::Options options;
        if (toTerminal) options.selection = "PRIMARY";
        owner_ = std::make_unique<rig::ForeignOwner>(
            rig_.server().display(), rig::SelectionOffer{{"UTF8_STRING", {"UTF8_STRING", 8, text}}}, options);
    }

    void paste(bool isTerminal) {
        // From the keyboard: the synthesiser's own has another layout than the programs know.
        if (isTerminal) {
            rig_.keyboard().chord({rig::Key::LeftShift}, rig::Key::Insert);
        } else {
            rig_.keyboard().chord({rig::Key::LeftControl}, U'v');
        }
    }

  private:
    void tap(int keycode) {
        send(XCB_KEY_PRESS, keycode);
        send(XCB_KEY_RELEASE, keycode);
    }
    void send(std::uint8_t type, int keycode) {
        xcb_test_fake_input(client_.connection(), type, static_cast<std::uint8_t>(keycode), XCB_CURRENT_TIME,
                            XCB_WINDOW_NONE, 0, 0, 0);
    }

    DesktopRig& rig_;
    rig::XClient client_;
    std::unique_ptr<rig::ForeignOwner> owner_;
};

// Plume and the floor take turns, each a few runs at a time: what else the machine does slows both alike, and their
// ratio holds.
class Turns {
  public:
    explicit Turns(DesktopRig& rig) : rig_(rig), bare_(rig) {}

    // How many texts did not arrive exactly.
    int measure(TargetKind kind, bool paste) {
        std::vector<Case> cases = paste ? Pasted : Typed;
        for (Case& tested : cases) tested.runs /= Count;
        const auto target = rig_.startTarget(kind);
        Times floor;
        Times plume;
        int wrong = 0;
        for (int turn = 0; turn < Count; ++turn) {
            takeFloor(floor, cases, *target, paste, kind == TargetKind::Xterm);
            const PlumeProgram program(rig_, library(cases, true), settings(paste));
            wrong += bench::measure(plume, cases, [&](const Case& tested, const std::string& expected) {
                return rig::typeAndAwait(rig_, *target, tested.abbreviation, expected);
            });
        }
        printTimes("floor.delivery.", floor, shortName(kind));
        printTimes("delivery.", plume, shortName(kind));
        for (const auto& [name, times] : plume) {
            if (!floor.contains(name)) continue;
            print("delivery." + name + "." + shortName(kind) + ".ratio", median(times) / median(floor[name]), "times");
        }
        return wrong;
    }

  private:
    static constexpr int Count = 5;

    void takeFloor(Times& times, const std::vector<Case>& cases, TargetProgram& target, bool paste, bool isTerminal) {
        bench::measure(times, cases, [&](const Case&, const std::string& expected) {
            if (!paste) return rig::awaitExpansion(target, expected, [&] { bare_.type(expected); });
            bare_.offer(expected, isTerminal);
            return rig::awaitExpansion(target, expected, [&] { bare_.paste(isTerminal); });
        });
    }

    DesktopRig& rig_;
    BareExpander bare_;
};

// Of the process and all its threads, in seconds.
double processorTime(pid_t process) {
    double nanoseconds = 0;
    for (const auto& task : std::filesystem::directory_iterator("/proc/" + std::to_string(process) + "/task")) {
        std::ifstream file(task.path() / "schedstat");
        double ran = 0;
        if (file >> ran) nanoseconds += ran;
    }
    return nanoseconds / 1e9;
}

long wakeUps(pid_t process) {
    long count = 0;
    for (const auto& task : std::filesystem::directory_iterator("/proc/" + std::to_string(process) + "/task")) {
        std::ifstream file(task.path() / "status");
        for (std::string line; std::getline(file, line);) {
            if (line.starts_with("voluntary_ctxt_switches:")) count += std::stol(line.substr(line.find(':') + 1));
        }
    }
    return count;
}

double megabytesInMemory(pid_t process) {
    std::ifstream file("/proc/" + std::to_string(process) + "/smaps_rollup");
    for (std::string line; std::getline(file, line);) {
        if (line.starts_with("Pss:")) return std::stod(line.substr(4)) / 1024;
    }
    return 0;
}

void measureFootprint(DesktopRig& rig) {
    const std::string content = library(Typed, true, 10'000);
    std::vector<double> ready;
    for (int run = 0; run < 5; ++run) ready.push_back(PlumeProgram(rig, content).secondsToReady() * 1000);
    print("delivery.ready.10000", median(ready), "ms");

    PlumeProgram plume(rig, content);
    const pid_t process = plume.process().pid();
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    const double before = processorTime(process);
    std::string typed;
    for (int i = 0; i < 100; ++i) {
        rig.keyboard().type("some words to go ");
        typed += "some words to go ";
    }
    target->awaitText(typed);
    print("delivery.cpu_per_key.10000", (processorTime(process) - before) * 1000 / static_cast<double>(typed.size()),
          "ms");
    print("delivery.pss.10000", megabytesInMemory(process), "MB");
    // The watchdog asks until ten seconds after the last key.
    sleep(12);
    constexpr int Seconds = 10;
    const long atRest = wakeUps(process);
    sleep(Seconds);
    print("delivery.idle_wakeups", static_cast<double>(wakeUps(process) - atRest) / Seconds, "per_s");
}

int measureAll(bool withPeer) {
    if (withPeer && !PeerProgram::isInstalled()) throw rig::RigError("install the package autokey-gtk");
    DesktopRig rig;
    if (withPeer) measurePeer(rig);
    int wrong = 0;
    Turns turns(rig);
    for (const TargetKind kind : Targets) wrong += turns.measure(kind, false) + turns.measure(kind, true);
    wrong += countWrong(rig, false) + countWrong(rig, true);
    print("delivery.wrong", wrong, "count");
    measureFootprint(rig);
    return 0;
}

}  // namespace

}  // namespace plume::bench

int main(int count, char** arguments) {
    try {
        return plume::bench::measureAll(count > 1 && arguments[1] == std::string("--with-peer"));
    } catch (const std::exception& problem) {
        std::cerr << "bench_delivery: " << problem.what() << '\n';
        return 1;
    }
}
