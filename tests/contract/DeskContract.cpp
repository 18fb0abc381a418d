// What a port knows about programs, the keyboard layout and the focused text.
#include <memory>
#include <string>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

TEST_P(ProcessManagerContract, NamesTheProgramThatHasTheKeyboard) {
    ProcessManager& processes = desk_->processManager();
    const auto first = processes.frontProcess();
    ASSERT_TRUE(first.has_value());
    const auto running = processes.runningApplication(*first);
    ASSERT_TRUE(running.has_value());
    EXPECT_TRUE(running->bundleIdentifier.has_value());

    desk_->activate(Program::Second);
    EXPECT_TRUE(desk_->runUntil([&] { return processes.frontProcess() && processes.frontProcess() != first; }));
    const auto other = processes.runningApplication(*processes.frontProcess());
    ASSERT_TRUE(other.has_value());
    EXPECT_NE(other->processIdentifier, running->processIdentifier);
}

TEST_P(ProcessManagerContract, BringsAProgramBackToTheFront) {
    ProcessManager& processes = desk_->processManager();
    const auto first = processes.frontProcess();
    ASSERT_TRUE(first.has_value());
    desk_->activate(Program::Second);
    ASSERT_TRUE(desk_->runUntil([&] { return processes.frontProcess() != first; }));
    processes.bringToFront(*first);
    EXPECT_TRUE(desk_->runUntil([&] { return processes.frontProcess() == first; }));
}

TEST_P(ProcessManagerContract, GivesTheKeyboardBackToAWindow) {
    ProcessManager& processes = desk_->processManager();
    const std::uint32_t first = processes.frontWindow();
    ASSERT_NE(first, 0U);
    EXPECT_TRUE(desk_->runUntil([&] { return processes.keysArriveIn(first); }));
    desk_->activate(Program::Second);
    ASSERT_TRUE(desk_->runUntil([&] { return processes.frontWindow() != first; }));
    EXPECT_FALSE(processes.keysArriveIn(first));
    processes.activateWindow(first);
    EXPECT_TRUE(desk_->runUntil([&] { return processes.keysArriveIn(first); }));
    // A window that is not there gets none, and takes none away.
    processes.activateWindow(first + 77'777);
    EXPECT_FALSE(processes.keysArriveIn(first + 77'777));
    EXPECT_TRUE(desk_->runUntil([&] { return processes.keysArriveIn(first); }));
    EXPECT_FALSE(processes.keysArriveIn(0));
}

TEST_P(ProcessManagerContract, KnowsNothingOfProcessesThatAreNone) {
    ProcessManager& processes = desk_->processManager();
    EXPECT_EQ(processes.runningApplication({}).has_value(), false);
    EXPECT_EQ(processes.runningApplication({77, 4'000'000'000U}).has_value(), false);
    EXPECT_NE(processes.currentProcess(), ProcessSerialNumber{});
    EXPECT_NE(processes.currentProcess(), processes.frontProcess());
}

TEST_P(InputSourcesContract, TranslatesKeysOfTheUSLayout) {
    struct Case {
        KeyCode keyCode;
        EventFlags flags;
        std::u16string produced;
    };
    const Case cases[] = {{KeyCode::A, {}, u"a"},      {KeyCode::A, EventFlag::Shift, u"A"},
                          {KeyCode::Digit1, {}, u"1"}, {KeyCode::Digit1, EventFlag::Shift, u"!"},
                          {KeyCode::Space, {}, u" "},  {KeyCode::Return, {}, u"\r"},
                          {KeyCode::Tab, {}, u"\t"},   {KeyCode::Delete, {}, u"\b"},
                          {KeyCode::Keypad1, {}, u"1"}};
    for (const Case& c : cases) {
        EXPECT_EQ(desk_->inputSources().translateKey(c.keyCode, c.flags), c.produced)
            << numberOf(c.keyCode) << ' ' << c.flags.bits();
    }
    EXPECT_EQ(desk_->inputSources().translateKey(KeyCode::None, {}), std::nullopt);
}

TEST_P(InputSourcesContract, HasANameForTheLayout) {
    const auto& identifier = desk_->inputSources().currentInputSourceIdentifier();
    ASSERT_TRUE(identifier.has_value());
    EXPECT_FALSE(identifier->empty());
}

TEST_P(AccessibilityContract, TellsTheSelectionAndTheTextBeforeIt) {
    for (const KeyCode key : {KeyCode::A, KeyCode::B, KeyCode::C}) {
        desk_->press(key);
        desk_->release(key);
    }
    ASSERT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"abc"; }));
    // Any question may go unanswered: it is asked again.
    std::shared_ptr<UIElement> focused;
    ASSERT_TRUE(desk_->runUntil([&] {
        const auto application = desk_->accessibility().frontApplicationElement();
        focused = application ? application->elementAttribute("AXFocusedUIElement") : nullptr;
        return focused && focused->rangeAttribute("AXSelectedTextRange") == TextRange{3, 0};
    }));
    EXPECT_TRUE(desk_->runUntil([&] { return focused->stringForRange("AXStringForRange", {1, 2}) == u"bc"; }));
    EXPECT_EQ(focused->stringAttribute("AXNoSuchAttribute"), std::nullopt);
    EXPECT_EQ(focused->elementAttribute("AXNoSuchAttribute"), nullptr);
}

}  // namespace plume
