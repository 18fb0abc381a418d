#include "input/delivery/KeySender.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <numeric>
#include <set>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "input/delivery/OutputFragments.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "tests/input/delivery/RecordingPoster.h"

namespace plume {
namespace {

using ::testing::ElementsAre;

class KeySenderTest : public ::testing::Test {
  protected:
    static ContextInputSetting with(InputFlags flags) {
        ContextInputSetting setting;
        setting.flags = flags;
        return setting;
    }

    RecordingPoster poster;
    SimulatedAccessibility accessibility;
    KeySender sender{poster, accessibility};
};

TEST_F(KeySenderTest, TypesTextInChunksWithoutModifiers) {
    sender.sendPlainText(u"\n\tabc");
    EXPECT_THAT(poster.take(), ElementsAre("v\n", "^\n", "v\t", "^\t", "vabc", "^abc"));
    auto setting = std::make_shared<ContextInputSetting>(with(InputFlag::PostToSessionEventTap));
    setting->blockLength = 2;
    sender.setContextInputSetting(setting);
    sender.sendPlainText(u"abc");
    EXPECT_THAT(poster.take(), ElementsAre("vab!", "^ab!", "vc!", "^c!"));
    EXPECT_FALSE(sender.isSending());
}

RC_GTEST_PROP(KeySenderChunks, GiveBackTheText, (const std::vector<std::uint8_t>& picks)) {
    std::u16string text;
    for (const auto pick : picks) text += u"abc \t\n\u2029x"[pick % 8];
    ContextInputSetting setting;
    setting.blockLength = *rc::gen::inRange<std::uint64_t>(0, 7);
    const auto chunks = fragmentsForPlainText(text, setting);
    RC_ASSERT(std::accumulate(chunks.begin(), chunks.end(), std::u16string()) == text);
}

TEST_F(KeySenderTest, PastesAsTheApplicationWantsIt) {
    using enum InputFlag;
    struct Case {
        const char* about;
        InputFlags flags;
        std::set<KeyCode> held;
        std::vector<std::string> events;
    };
    const Case cases[] = {
        {"usual", {}, {}, {"v9/8", "^9"}},
        {"control", UseControlKey, {}, {"v9/2", "^9"}},
        {"V is held", {}, {KeyCode::V}, {"^9", "v9/8", "^9"}},
        {"alternative", AlternativePasting, {}, {"v55", "v9/8", "^9/8", "^55"}},
        {"alternative with control", AlternativePasting | UseControlKey, {}, {"v59", "v9/2", "^9/2", "^59"}},
        {"no flags", AlternativePasting | DoNotSetModifier, {KeyCode::Shift}, {"^56", "v55", "v9", "^9", "^55"}},
    };
    for (const Case& c : cases) {
        poster.held = c.held;
        sender.sendPasteCommand(with(c.flags));
        EXPECT_EQ(poster.take(), c.events) << c.about;
    }
    poster.held.clear();
    ContextInputSetting named;
    named.pasteKeys = {{u'y', KeyCode::None, EventFlag::Control}, {u'+'}, {0, KeyCode::Help, EventFlag::Shift}};
    sender.sendPasteCommand(named);
    EXPECT_EQ(poster.takeLine(), "v16/2 ^16/2 v+ ^+ v114/1 ^114/1") << "the keys of the setting before all others";
    named.copyKeys = Keystrokes();
    sender.sendCopyCommand(named, true);
    EXPECT_EQ(poster.takeLine(), "") << "no key copies";
}

}  // namespace
}  // namespace plume
