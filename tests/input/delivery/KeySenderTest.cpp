#include "input/delivery/KeySender.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "tests/input/delivery/RecordingPoster.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

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
    sender.sendPlainText(u"\nabc");
    EXPECT_THAT(poster.take(), ElementsAre("v\n", "^\n", "vabc", "^abc"));
    auto setting = std::make_shared<ContextInputSetting>(with(InputFlag::PostToSessionEventTap));
    setting->blockLength = 2;
    sender.setContextInputSetting(setting);
    sender.sendPlainText(u"abc");
    EXPECT_THAT(poster.take(), ElementsAre("vab!", "^ab!", "vc!", "^c!"));
    EXPECT_FALSE(sender.isSending());
}

TEST_F(KeySenderTest, PressesKeys) {
    sender.sendKey(KeyCode::Return, EventFlag::Shift, 2);
    EXPECT_THAT(poster.take(), ElementsAre("v36/1", "^36/1", "v36/1", "^36/1"));
    sender.sendBackspaces(2);
    EXPECT_THAT(poster.take(), ElementsAre("v51", "^51", "v51", "^51"));
    sender.sendBackspaces(0);
    EXPECT_THAT(poster.take(), IsEmpty());
    sender.sendShiftTab();
    EXPECT_THAT(poster.take(), ElementsAre("v48/1", "^48/1"));
    sender.sendLeftArrowKeys(1);
    EXPECT_THAT(poster.take(), ElementsAre("v123", "^123"));
}

TEST_F(KeySenderTest, ErasesASelectionBeforeWhatWasTyped) {
    const auto application = std::make_shared<SimulatedUIElement>();
    const auto field = std::make_shared<SimulatedUIElement>();
    application->setAttribute("AXFocusedUIElement", std::shared_ptr<UIElement>(field));
    field->setAttribute("AXSelectedTextRange", TextRange{4, 3});
    accessibility.setFrontApplicationElement(application);
    sender.sendBackspaces(1);
    EXPECT_THAT(poster.take(), ElementsAre("v117", "^117", "v51", "^51"));
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
    poster.own = CommandKeystroke{KeyCode::Help, EventFlag::Shift};
    sender.sendPasteCommand(with({}));
    EXPECT_THAT(poster.take(), ElementsAre("v114/1", "^114/1")) << "the program's own keystroke";
}

TEST_F(KeySenderTest, CopiesWithCommandOrControl) {
    sender.sendCopyCommand(false);
    EXPECT_THAT(poster.take(), ElementsAre("v8/8", "^8"));
    sender.sendCopyCommand(true);
    EXPECT_THAT(poster.take(), ElementsAre("v8/2", "^8"));
}

}  // namespace
}  // namespace plume
