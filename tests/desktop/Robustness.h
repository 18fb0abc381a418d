// What the tests of the whole program under adverse conditions share: a desktop, Plume on it, and the texts it sends.
#pragma once

#include <gtest/gtest.h>
#include <poll.h>

#include <algorithm>
#include <cstdlib>
#include <memory>
#include <string>

#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::rig {

// How often the repeated parts run, as a multiple of what a test run can afford: PLUME_ROUNDS in the environment.
inline int rounds() {
    const char* const wanted = std::getenv("PLUME_ROUNDS");
    return wanted != nullptr ? std::max(1, std::atoi(wanted)) : 1;
}

inline std::string times(int count, const std::string& text) {
    std::string all;
    for (int i = 0; i < count; ++i) all += text;
    return all;
}

inline const std::string Ascii = "the quick brown fox ";           // 20 characters
inline const std::string Mixed = "naïve Ünïcödé — 日本語 【】 😀";  // 25 characters

// An abbreviation, typed last key and all, and what it becomes.
struct Sample {
    std::string abbreviation;
    std::string content;
};

inline const Sample ShortAscii{"zqa", Ascii};
inline const Sample LongAscii{"zqb", times(10, Ascii)};
inline const Sample ShortMixed{"zqc", Mixed};
inline const Sample LongMixed{"zqd", times(8, Mixed)};
inline const Sample Shifted{"zq!", Ascii};
inline const Sample HugeShifted{"zq#", times(80, Mixed)};
inline const Sample Word{"kwa", Mixed};  // at a delimiter, which is kept
inline const Sample LongWord{"kwb", times(10, Ascii)};

inline std::string sampleLibrary() {
    const auto item = [](const Sample& sample) {
        return R"({"abbreviation": ")" + sample.abbreviation + R"(", "content": ")" + sample.content + R"("})";
    };
    return R"([{"name": "At once", "expandAfter": 2, "expandTrigger": 0, "items": [)" + item(ShortAscii) + "," +
           item(LongAscii) + "," + item(ShortMixed) + "," + item(LongMixed) + "," + item(HugeShifted) + "," +
           item(Shifted) + R"(]}, {"name": "Words", "expandAfter": 2, "expandTrigger": 1, "items": [)" + item(Word) +
           "," + item(LongWord) + "]}]";
}

enum class Way { Typed, Pasted };

inline std::string settingsFor(Way way) {
    return std::string(R"({"PlayFeedbackSound": false, "UseClipboardForLongText": false, "UseClipboardIn": 0, )") +
           R"("UseClipboard": )" + (way == Way::Pasted ? "true}" : "false}");
}

// Plume on the suite's desktop; a fresh one when the way changes or the last one ended.
class Robustness : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() {
        plume_.reset();
        rig_.reset();
    }

    void TearDown() override { rig_->keyboard().releaseAll(); }

    static void startPlume(Way way) {
        plume_.reset();
        plume_ = std::make_unique<PlumeProgram>(*rig_, sampleLibrary(), settingsFor(way));
    }

    // No key and no modifier is down for programs.
    static bool isKeyboardAtRest() { return rig_->client().keysDown().empty() && rig_->client().modifiers() == 0; }

    static std::string log() { return plume_->process().logTail(); }

    static inline std::unique_ptr<DesktopRig> rig_;
    static inline std::unique_ptr<PlumeProgram> plume_;
};

}  // namespace plume::rig
