// The lists on a desktop, with the program itself and real keys: how soon they are seen, what they cost who types on,
// and how soon what was chosen arrives.
#include <poll.h>

#include <chrono>
#include <string>
#include <vector>

#include "bench/Desk.h"
#include "bench/Figures.h"
#include "bench/GeneratedLibrary.h"
#include "bench/KeyLatency.h"
#include "bench/SearchFigures.h"

namespace plume::bench {

namespace {

using rig::Key;
using Clock = std::chrono::steady_clock;

// What is suggested for a text that consists of this one letter, however long it is.
constexpr const char* LongAbbreviations = R"json([
  { "name": "Long", "expandAfter": 2, "expandTrigger": 3, "items": [
      { "abbreviation": "aaaaaaaaaaaab", "content": "one" },
      { "abbreviation": "aaaaaaaaaaaac", "content": "two" },
      { "abbreviation": "zebra crossing", "content": "Look left and right." } ] }
])json";

// With a list and a search by hot keys.
class ListDesk : public Desk {
  public:
    explicit ListDesk(std::size_t snippetsPerGroup)
        : Desk(LongAbbreviations, {{"suggestAbbreviationsHotKey", "120"}, {"quickSearchHotKey", "99"}},  // F2, F3
               libraryArchive(makeLibrary(snippetsPerGroup, 10))) {}
};

// Below the first line of the text, where the list stands.
xcb_rectangle_t belowFirstLine(Desk& desk) {
    const auto place = desk.rig().client().placeOf(desk.target().window());
    return {static_cast<std::int16_t>(place.x + 40), static_cast<std::int16_t>(place.y + 24), 240, 60};
}

void benchList(Desk& desk) {
    constexpr int Runs = 21;
    const xcb_rectangle_t part = belowFirstLine(desk);
    desk.rig().keyboard().type("xx aaa");
    Desk::settle();
    desk.tap(Key::F2);
    Desk::settle();
    const std::string shown = desk.picture(part);
    std::vector<double> times;
    for (int i = 0; i < Runs; ++i) {
        desk.tap(Key::Escape);
        Desk::settle();
        require(desk.picture(part) != shown);
        times.push_back(desk.untilShown(part, shown, [&] { desk.tap(Key::F2); }));
    }
    print("suggest.visible", median(std::move(times)), "ms");
    desk.tap(Key::Escape);
}

void benchKeysBesideList(Desk& desk) {
    constexpr int Keys = 400;
    constexpr int Pause = 5;
    const auto latencies = [&] {
        return keyLatencies(desk.rig(), desk.target(), Pause, [](int typed) { return typed < Keys; });
    };
    latencies();
    std::vector<double> quiet;
    std::vector<double> beside;
    constexpr int Turns = 4;
    for (int turn = 0; turn < Turns; ++turn) {
        append(quiet, latencies());
        desk.tap(Key::F2);
        Desk::settle();
        append(beside, latencies());
        desk.tap(Key::Escape);
        Desk::settle();
    }
    const double quietest = percentile(quiet, 0.99);
    print("suggest.key.quiet.p99", quietest, "us");
    print("suggest.key.median", median(beside) - median(quiet), "us");
    print("suggest.key.p99", percentile(std::move(beside), 0.99) - quietest, "us");
}

// The window stands at the caret; its rows, without the field whose cursor blinks.
xcb_rectangle_t foundRows(Desk& desk) {
    const auto active = desk.rig().client().activeWindow();
    const auto place = desk.rig().client().placeOf(active);
    return {static_cast<std::int16_t>(place.x + 10), static_cast<std::int16_t>(place.y + 48),
            static_cast<std::uint16_t>(place.width - 40), 60};
}

void benchSearch(Desk& desk, const std::string& size) {
    constexpr int Runs = 15;
    desk.target().clear();
    desk.tap(Key::F3);
    poll(nullptr, 0, 1'500);
    const xcb_rectangle_t part = foundRows(desk);
    const std::string empty = desk.picture(part);
    const auto press = [&](char32_t letter) {
        return [&desk, code = desk.rig().keyboard().keycodeOf(letter)] {
            desk.rig().keyboard().press(code);
            desk.rig().keyboard().release(code);
            desk.rig().keyboard().sync();
        };
    };
    std::vector<double> keys;
    std::string before = empty;
    for (const char32_t letter : U"zebra crossi") {
        if (letter == 0) break;
        press(letter)();
        Desk::settle();
        const std::string after = desk.picture(part);
        if (after == before) continue;
        for (int i = 0; i < 3; ++i) {
            desk.tap(Key::Backspace);
            Desk::settle();
            keys.push_back(desk.untilShown(part, after, press(letter)));
            Desk::settle();
        }
        before = after;
    }
    print("search.key." + size, median(keys), "ms");
    print("search.key." + size + ".max", percentile(keys, 1), "ms");
    desk.tap(Key::Escape);
    desk.tap(Key::Escape);
    std::vector<double> opened;
    for (int i = 0; i < Runs; ++i) {
        poll(nullptr, 0, 500);
        require(desk.picture(part) != empty);
        opened.push_back(desk.untilShown(part, empty, [&] { desk.tap(Key::F3); }));
        poll(nullptr, 0, 500);
        desk.tap(Key::Escape);
    }
    print("search.open." + size, median(std::move(opened)), "ms");
}

void benchSend(Desk& desk) {
    constexpr int Runs = 15;
    std::vector<double> times;
    for (int i = 0; i < Runs; ++i) {
        desk.target().clear();
        poll(nullptr, 0, 500);
        desk.tap(Key::F3);
        poll(nullptr, 0, 500);
        desk.rig().keyboard().type("zebra");
        poll(nullptr, 0, 500);
        desk.target().forgetReports();
        const auto pressed = Clock::now();
        desk.tap(Key::Return);
        const auto change = desk.target().takeChange(Desk::Bound);
        require(change.has_value());
        times.push_back(std::chrono::duration<double, std::milli>(change->time - pressed).count());
        require(desk.target().awaitText("Look left and right.") == "Look left and right.");
    }
    print("search.send", median(std::move(times)), "ms");
}

}  // namespace

void printListFigures() {
    {
        ListDesk desk(SnippetsPerGroup);
        benchList(desk);
        benchKeysBesideList(desk);
        benchSend(desk);
        benchSearch(desk, "10000");
    }
    ListDesk desk(10 * SnippetsPerGroup);
    benchSearch(desk, "100000");
}

}  // namespace plume::bench
