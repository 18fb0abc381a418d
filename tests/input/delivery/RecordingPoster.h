// A poster that writes down what it is given.
#pragma once

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "platform/EventPoster.h"
#include "platform/RunLoop.h"

namespace plume {

// "v51" is a key going down, "^51" up, with modifiers behind a slash, or the text instead of the key code; "!" follows
// what goes past the tap. "hold" and "release" are of the user's keys.
class RecordingPoster final : public EventPoster {
  public:
    void begin() override { ++open; }
    void end() override { --open; }
    void post(const SynthesisedKey& key, bool pastTap) override {
        EXPECT_GT(open, 0) << "outside of begin and end";
        std::string event = key.down ? "v" : "^";
        event += key.text.empty() ? std::to_string(numberOf(key.keyCode)) : toUtf8(key.text);
        if (!key.flags.isEmpty()) event += "/" + std::to_string(modifiersFromFlags(key.flags).bits());
        if (pastTap) event += "!";
        write(std::move(event));
        if (onPost) onPost(key);
    }
    bool canType(std::u16string_view text) const override { return text.find(untypeable) == std::u16string_view::npos; }
    KeyCode keyCodeOfLetter(char16_t letter) const override { return letter == u'v' ? KeyCode::V : KeyCode::Y; }
    bool isKeyDown(KeyCode keyCode) const override { return held.contains(keyCode); }
    Point pointerLocation() const override { return {30, 40}; }
    void click(Point) override { write("click"); }
    void holdUserKeys() override { write("hold"); }
    void keepHoldingUserKeys() override { ++holds; }
    void releaseUserKeys() override {
        write("release");
        if (onRelease) onRelease();
    }

    std::vector<std::string> take() { return std::exchange(events, {}); }
    // The same as one line; "v51*3" are three presses in a row.
    std::string takeLine() {
        std::string line;
        for (std::size_t i = 0; i < events.size();) {
            std::size_t count = 1;
            while (i + 2 * count + 1 < events.size() && events[i + 2 * count] == events[i] &&
                   events[i + 2 * count + 1] == events[i + 1]) {
                ++count;
            }
            if (!line.empty()) line += ' ';
            line += events[i];
            if (count > 1) line += "*" + std::to_string(count);
            i += count > 1 ? 2 * count : 1;
        }
        events.clear();
        return line;
    }
    // The moments at which this was posted, in milliseconds.
    std::vector<long> timesOf(std::string_view event) const {
        std::vector<long> times;
        for (const auto& [time, posted] : timeline) {
            if (posted == event) times.push_back(std::lround(time * 1000));
        }
        return times;
    }

    int open = 0;
    int holds = 0;  // how often they were kept waiting
    std::vector<std::string> events;
    std::vector<std::pair<double, std::string>> timeline;
    const RunLoop* clock = nullptr;
    std::set<KeyCode> held;
    char16_t untypeable = u'\uFFFF';
    std::function<void(const SynthesisedKey&)> onPost;
    std::function<void()> onRelease;

  private:
    void write(std::string event) {
        timeline.emplace_back(clock ? clock->now() : 0, event);
        events.push_back(std::move(event));
    }
};

}  // namespace plume
