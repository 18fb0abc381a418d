#include "input/delivery/OutputBatch.h"

#include <gtest/gtest.h>

#include <sstream>

namespace plume {
namespace {

using enum InputFlag;
using Fragment = PLOutput::Fragment;

Fragment key(std::uint64_t count, double delay = 0) {
    auto variable = std::make_shared<SnippetKeyVariable>(u"\u21e5", KeyCode::Tab);
    variable->count = count;
    variable->delay = delay;
    return variable;
}

std::vector<Fragment> chunks(std::size_t count) {
    return std::vector<Fragment>(count, std::u16string(u"chunk"));
}

const Fragment Text = std::u16string(u"text");
const Fragment Rich = AttributedString(u"rich");

// "B5 T2 +0.04": five backspaces, two texts, and a pause; "." behind the last batch.
std::string description(const OutputBatch& batch) {
    std::ostringstream line;
    for (std::size_t i = 0; i < batch.steps.size();) {
        const OutputStep& step = batch.steps[i];
        std::uint64_t count = 0;
        for (; i < batch.steps.size() && batch.steps[i].kind == step.kind; ++i) count += batch.steps[i].count;
        line << "BLKTP"[static_cast<int>(step.kind)] << count << ' ';
    }
    if (batch.pause) {
        line << '+' << *batch.pause;
    } else {
        line << '.';
    }
    return line.str();
}

struct BatchCase {
    const char* about;
    std::uint64_t backspaces;
    std::vector<Fragment> fragments;
    std::uint64_t leftArrows;
    std::vector<std::string> batches;
    bool isSentInOneBatch;
    InputFlags flags = {};
    double pastingDelay = 0;
    double afterPastingDelay = 0;
    double afterErasingDelay = 0;
};

const BatchCase Cases[] = {
    {"nothing", 0, {}, 0, {"."}, true},
    {"short", 3, {Text}, 2, {"B3 T1 L2 ."}, true},
    {"text behind the last backspaces", 45, chunks(16), 0, {"B20 +0.04", "B20 +0.04", "B5 T15 +0.04", "T1 ."}, false},
    {"20 backspaces end an output", 20, {Text}, 3, {"B20 ."}, true},
    {"as the rest, too", 40, {Text}, 0, {"B20 +0.04", "B20 ."}, false},
    {"a full batch has a pause behind it", 19, {Text}, 0, {"B19 T1 +0.04", "."}, true},
    {"many texts", 0, chunks(41), 0, {"T20 +0.04", "T20 +0.04", "T1 ."}, false},
    {"many presses", 0, {key(30)}, 0, {"K20 +0.04", "K10 ."}, false},
    {"a delay behind a key", 0, {key(2, 0.5), Text}, 0, {"K2 +0.5", "T1 ."}, false},
    {"behind every part of its presses", 0, {key(30, 1)}, 0, {"K20 +1", "K10 +1", "."}, false},
    {"keys between typed texts", 0, {Text, key(3), Text}, 0, {"T1 K3 T1 ."}, true},
    {"a key without presses", 0, {key(0), Text}, 0, {"T1 ."}, true},
    {"arrows", 0, {Text}, 20, {"T1 L19 +0.04", "L1 ."}, false},
    {"exactly full with arrows", 0, {Text}, 19, {"T1 L19 ."}, true},
    {"one paste", 3, {Text}, 2, {"B3 P1 L2 ."}, true, UseClipboard},
    {"keys are seen before the next paste",
     0,
     {Text, key(1), Text, key(1), key(2)},
     0,
     {"P1 K1 +0.04", "P1 K3 ."},
     false,
     UseClipboard},
    {"rich text is pasted", 0, {key(1), Rich, key(1)}, 0, {"K1 +0.04", "P1 K1 ."}, false},
    {"a wait behind a paste", 0, {Text, key(1)}, 0, {"P1 +0.05", "K1 ."}, false, UseClipboard, 0, 0.05},
    {"a wait before it, too", 0, {Text}, 1, {"P1 +0.25", "L1 ."}, false, UseClipboard | DelayPasting, 0.2, 0.05},
    {"never no wait", 0, {Text}, 0, {"P1 +0.005", "."}, false, UseClipboard | DelayPasting},
    {"by way of activation", 0, {Text}, 0, {"P1 +0.4", "."}, false, UseClipboard | Reactivate, 0, 0.05},
    {"typed all the same", 0, {Text}, 0, {"T1 ."}, true, DelayPasting},
    {"keys settle",
     25,
     {Text, key(1), key(1), Text},
     2,
     {"B20 +0.04", "B5 +0.03", "T1 K2 +0.03", "T1 L2 +0.03", "."},
     false,
     {},
     0,
     0,
     0.03},
    {"at the end, too", 20, {key(1, 0.01)}, 0, {"B20 +0.03", "K1 +0.03", "."}, false, {}, 0, 0, 0.03},
    {"nothing has to", 0, {Text}, 0, {"T1 ."}, true, {}, 0, 0, 0.03},
    {"nothing before a paste", 3, {Text}, 1, {"B3 P1 L1 +0.03", "."}, false, UseClipboard, 0, 0, 0.03},
};

TEST(OutputBatch, TakesAnOutputApart) {
    for (const BatchCase& c : Cases) {
        PLOutput output;
        output.backspaceCount = c.backspaces;
        output.fragments = c.fragments;
        output.leftArrowCount = c.leftArrows;
        ContextInputSetting setting;
        setting.flags = c.flags;
        setting.pastingDelay = c.pastingDelay;
        setting.afterPastingDelay = c.afterPastingDelay;
        setting.afterErasingDelay = c.afterErasingDelay;
        EXPECT_EQ(isSentInOneBatch(output, setting), c.isSentInOneBatch) << c.about;
        std::vector<std::string> batches;
        for (bool more = true; more && batches.size() < 10;) {
            const OutputBatch batch = takeBatch(output, setting);
            batches.push_back(description(batch));
            more = batch.pause.has_value();
        }
        EXPECT_EQ(batches, c.batches) << c.about;
    }
}

TEST(OutputBatch, LeavesTheContentsKeysAlone) {
    const auto variable = std::make_shared<SnippetKeyVariable>(u"\u21e5", KeyCode::Tab);
    variable->count = 30;
    PLOutput output;
    output.fragments = {variable};
    takeBatch(output, {});
    takeBatch(output, {});
    EXPECT_TRUE(output.fragments.empty());
    EXPECT_EQ(variable->count, 30U);
}

}  // namespace
}  // namespace plume
