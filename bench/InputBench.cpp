// Hearing and sending keys on a real desktop: what Plume adds to a key that passes, what a synthesised one costs, how
// fast text arrives, and whether what is swallowed and passed is exactly what it should be.
#include <poll.h>
#include <xcb/xtest.h>

#include <algorithm>
#include <atomic>
#include <future>
#include <iostream>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "bench/Figures.h"
#include "bench/KeyLatency.h"
#include "ports/x11/windows/DesktopFiles.h"
#include "ports/x11/windows/X11ProcessManager.h"
#include "testing/rig/KeyboardPort.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::bench {

namespace {

using rig::DesktopRig;
using rig::KeyboardPort;
using rig::Milliseconds;
using rig::PlumeProgram;
using rig::TargetKind;
using rig::TargetProgram;

constexpr TargetKind Targets[] = {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm};

std::string shortName(TargetKind kind) {
    return kind == TargetKind::GtkTextView ? "gtk" : kind == TargetKind::QtTextEdit ? "qt" : "xterm";
}

// For each of some keys, once all that comes with a start and with the first keys has been done.
std::vector<double> latencies(DesktopRig& rig, TargetProgram& target, int keys) {
    constexpr int FirstKeys = 50;
    // Programs and the window manager ask for the keyboard's layout again when Plume has taken it.
    poll(nullptr, 0, 500);
    keyLatencies(rig, target, 0, [](int typed) { return typed < FirstKeys; });
    return keyLatencies(rig, target, 0, [keys](int typed) { return typed < keys; });
}

// What Plume adds to a key, and what a tap that does nothing but pass keys on adds: by turns with keys that nobody
// hears, so that what else the machine does falls on all.
void measureAdded(DesktopRig& rig, TargetProgram& target) {
    std::vector<double> without, with, passed;
    for (int turn = 0; turn < 8; ++turn) {
        append(without, latencies(rig, target, 250));
        {
            const PlumeProgram plume(rig, "", "{}");
            append(with, latencies(rig, target, 250));
        }
        const KeyboardPort tap(rig.server().display(), KeyboardPort::Options{});
        append(passed, latencies(rig, target, 250));
    }
    print("input.untapped.median", median(without), "us");
    print("floor.input.added.median", median(passed) - median(without), "us");
    print("floor.input.added.p99", percentile(passed, 0.99) - percentile(without, 0.99), "us");
    print("input.added.median", median(with) - median(without), "us");
    print("input.added.ratio", (median(with) - median(without)) / (median(passed) - median(without)), "times");
    print("input.added.p99", percentile(with, 0.99) - percentile(without, 0.99), "us");
}

constexpr int Keys = 1000;

// The same by bare requests: what the server needs.
double bareKeyNanoseconds(DesktopRig& rig) {
    rig::XClient client(rig.server().display());
    const auto keycode = static_cast<std::uint8_t>(rig.keyboard().keycodeOf(U'a'));
    return medianNanoseconds(5, [&] {
        for (int i = 0; i < 2 * Keys; ++i) {
            xcb_test_fake_input(client.connection(), i % 2 == 0 ? XCB_KEY_PRESS : XCB_KEY_RELEASE, keycode,
                                XCB_CURRENT_TIME, XCB_WINDOW_NONE, 0, 0, 0);
        }
        client.focusedWindow();  // a round trip: the server has done them all
    });
}

// The letter a, typed into a terminal.
void measureSynthesised(DesktopRig& rig, KeyboardPort& port) {
    const auto target = rig.startTarget(TargetKind::Xterm);
    print("floor.input.synthesised", bareKeyNanoseconds(rig) / 1000 / Keys, "us");
    double nanoseconds = 0;
    port.run([&] {
        nanoseconds = medianNanoseconds(5, [&] {
            port.poster().begin();
            for (int i = 0; i < Keys; ++i) {
                port.poster().post({.keyCode = KeyCode::A, .flags = {}, .down = true, .text = {}}, false);
                port.poster().post({.keyCode = KeyCode::A, .flags = {}, .down = false, .text = {}}, false);
            }
            port.poster().end();
            port.connection().connection().sync();
        });
    });
    print("input.synthesised", nanoseconds / 1000 / Keys, "us");
}

// A thousand characters in short lines.
std::string linesOf(const std::string& line) {
    std::string text;
    std::size_t characters = 0;
    while (characters < 1000) {
        text += line + "\n";
        characters += fromUtf8(line).size() + 1;
    }
    return text;
}

int measureRate(DesktopRig& rig, KeyboardPort& port, const std::string& kindOfText, const std::string& text) {
    int wrong = 0;
    for (const TargetKind kind : Targets) {
        const auto target = rig.startTarget(kind);
        std::vector<double> rates;
        const double characters = static_cast<double>(fromUtf8(text).size());
        for (int run = 0; run < 5; ++run) {
            const auto expansion = rig::awaitExpansion(*target, text, [&] { port.type(fromUtf8(text)); });
            if (expansion.isRight) rates.push_back(characters / expansion.milliseconds * 1000);
            wrong += expansion.isRight ? 0 : 1;
        }
        if (!rates.empty()) print("input.rate." + kindOfText + "." + shortName(kind), median(rates), "chars/s");
    }
    return wrong;
}

// Keys with roll-over, a random half of which is swallowed: 0 when the target got the other half, in order.
int swallowHalf(DesktopRig& rig) {
    std::mt19937 random(20);
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    std::string typed, expected;
    std::vector<bool> swallowed;
    for (int i = 0; i < 2000; ++i) {
        typed += static_cast<char>('a' + random() % 26);
        swallowed.push_back(random() % 2 == 0);
        if (!swallowed.back()) expected += typed.back();
    }
    std::size_t next = 0;
    KeyboardPort port(
        rig.server().display(),
        {.decide = [&](const TapEvent& event) { return event.type == TapEvent::Type::KeyDown && swallowed[next++]; },
         .disabled = {}});
    std::vector<int> down;
    for (const char letter : typed) {
        const int keycode = rig.keyboard().keycodeOf(static_cast<char32_t>(letter));
        if (const auto held = std::ranges::find(down, keycode); held != down.end()) {
            rig.keyboard().release(keycode);
            down.erase(held);
        }
        rig.keyboard().press(keycode);
        down.push_back(keycode);
        if (down.size() > 2 + random() % 3) {
            rig.keyboard().release(down.front());
            down.erase(down.begin());
        }
        poll(nullptr, 0, 8);
    }
    rig.keyboard().releaseAll();
    return target->awaitText(expected) == expected ? 0 : 1;
}

void measureIdentity(DesktopRig& rig) {
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    PollRunLoop loop;
    auto session = X11Session::open(rig.server().display(), loop);
    if (!session) throw rig::RigError(session.error().message);
    X11ProcessManager processes(*session.value(), DesktopFiles::ofEnvironment());
    const auto ask = [&] {
        const auto front = processes.frontProcess();
        if (!front || !processes.runningApplication(*front)) throw rig::RigError("nobody is in front");
    };
    ask();
    print("input.identity", medianNanoseconds(2000, ask) / 1000, "us");
}

int measureAll() {
    DesktopRig rig;
    measureAdded(rig, *rig.startTarget(TargetKind::GtkTextView));
    int wrong = 0;
    {
        KeyboardPort port(rig.server().display(), KeyboardPort::Options{});
        measureSynthesised(rig, port);
        wrong += measureRate(rig, port, "ascii", linesOf("The quick brown fox jumps over the lazy dog 0123456789."));
        wrong += measureRate(rig, port, "unicode", linesOf("naïve Ünïcödé — 日本語 【】 😀 and plain letters"));
    }
    wrong += swallowHalf(rig);
    print("input.wrong", wrong, "count");
    measureIdentity(rig);
    return 0;
}

}  // namespace

}  // namespace plume::bench

int main() {
    try {
        return plume::bench::measureAll();
    } catch (const std::exception& problem) {
        std::cerr << "bench_input: " << problem.what() << '\n';
        return 1;
    }
}
