#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <thread>

#include "tests/input/InputDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Times = std::vector<long>;

constexpr const char* Paste = "v9/8";

void addKey(PLOutput& output, std::size_t location, std::uint64_t count = 1) {
    auto key = std::make_shared<SnippetKeyVariable>(u"\u21e5", KeyCode::Tab);
    key->location = location;
    key->count = count;
    output.snippetExpandedContent->variables.push_back(key);
}

void addCaret(PLOutput& output, std::size_t location) {
    auto caret = std::make_shared<SnippetContentCaret>();
    caret->location = location;
    output.snippetExpandedContent->variables.push_back(caret);
}

TEST(OutputDelivery, ErasesTypesAndMovesTheCaretBack) {
    InputDesk desk;
    const auto output = InputDesk::output(u"abcde", 2);
    addKey(*output, 1, 2);
    addCaret(*output, 3);
    desk.service.sendOutput(output);
    EXPECT_EQ(desk.poster.takeLine(), "hold v51*2 va ^a v48*2 vbcde ^bcde v123*2 release");
    EXPECT_TRUE(desk.service.isIdle());
    EXPECT_FALSE(desk.loop.nextDue() < 2.9) << "nothing but the secure input timer";
}

TEST(OutputDelivery, FromElsewhereAnOutputIsHandedOver) {
    InputDesk desk;
    std::thread([&] { desk.service.sendOutput(InputDesk::output(u"text")); }).join();
    EXPECT_THAT(desk.poster.take(), IsEmpty());
    desk.loop.runReady();
    EXPECT_EQ(desk.poster.takeLine(), "hold vtext ^text release");
}

TEST(OutputDelivery, OneOutputAfterTheOther) {
    InputDesk desk;
    desk.service.sendOutput(InputDesk::output(u"first", 25));
    const auto second = InputDesk::output(u"second");
    second->cancelTrigger = false;
    desk.service.sendOutput(second);
    EXPECT_TRUE(second->cancelTrigger) << "a key passed on now would come first";
    desk.service.sendOutput(InputDesk::output(u"third"));
    EXPECT_EQ(desk.poster.takeLine(), "hold v51*20");
    desk.loop.advance(1);
    EXPECT_EQ(desk.poster.takeLine(),
              "v51*5 vfirst ^first release hold vsecond ^second release hold vthird ^third release");
}

TEST(OutputDelivery, AnyNumberMayWait) {
    InputDesk desk;
    desk.service.sendOutput(InputDesk::output(u"first", 25));
    for (int i = 0; i < 50'000; ++i) desk.service.sendOutput(InputDesk::output(u"x"));
    desk.loop.advance(1);
    EXPECT_EQ(desk.poster.timesOf("vx").size(), 50'000U);
}

TEST(OutputDelivery, KeysLetGoBetweenOutputsMayOrderAnother) {
    InputDesk desk;
    int ordered = 0;
    desk.poster.onRelease = [&] {
        if (++ordered == 1) desk.service.sendOutput(InputDesk::output(u"late"));
    };
    desk.service.sendOutput(InputDesk::output(u"first", 25));
    desk.service.sendOutput(InputDesk::output(u"second"));
    desk.loop.advance(1);
    desk.poster.events.erase(desk.poster.events.begin(), desk.poster.events.begin() + 51);
    EXPECT_EQ(desk.poster.takeLine(), "vfirst ^first release hold vsecond ^second release hold vlate ^late release");
}

TEST(OutputDelivery, ACompletionThatIsProposedIsOverwrittenBeforeItIsErased) {
    InputDesk desk;
    auto setting = std::make_shared<ContextInputSetting>();
    setting->overtypesCompletion = true;
    setting->pasteKeys = Keystrokes();
    desk.service.setCustomApplicationSetting(u"editor", setting);
    const auto output = InputDesk::output(u"", 2);
    output->snippetExpandedContent->content = AttributedString(u"rich");
    desk.service.sendOutput(output);
    EXPECT_EQ(desk.poster.takeLine(), "hold vx ^x v51*3 vrich ^rich release") << "and no key pastes rich text";
}

TEST(OutputDelivery, KeysThatRepeatAreKeptApartWhereOneWouldBeLost) {
    InputDesk desk;
    auto setting = std::make_shared<ContextInputSetting>();
    setting->losesRepeatedKeys = true;
    setting->overtypesCompletion = true;
    desk.service.setCustomApplicationSetting(u"editor", setting);
    desk.service.sendOutput(InputDesk::output(u"Hello aA😀😀", 2));
    EXPECT_EQ(desk.poster.takeLine(),
              "hold vx ^x v51 ^51 v59 ^59 v51 ^51 v59 ^59 v51 ^51 "
              "vHel ^Hel v59 ^59 vlo aA😀 ^lo aA😀 v59 ^59 v😀 ^😀 release");
}

struct PasteCase {
    const char* about;
    InputFlags flags;
    double pastingDelay;
    double afterPastingDelay;
    Times erasures;
    Times pastes;  // of two texts with a key between
    Times keys;
    Times released;
};

TEST(OutputDelivery, PastesAtTheTimesThatTheApplicationNeeds) {
    using enum InputFlag;
    const PasteCase cases[] = {
        {"at once", UseClipboard, 0, 0, {0}, {0, 40}, {0}, {40}},
        {"with a wait behind", UseClipboard, 0, 0.05, {0}, {0, 90}, {50}, {140}},
        {"late", UseClipboard | DelayPasting, 0.2, 0.05, {0}, {200, 490}, {250}, {540}},
        {"by activation", UseClipboard | Reactivate, 0, 0, {0}, {900, 1340}, {400}, {1340}},
        {"behind the backspaces",
         UseClipboard | UseVMHelper | DeleteAfterActivateVM,
         0,
         0,
         {900},
         {1100, 1540},
         {400},
         {1540}},
    };
    for (const PasteCase& c : cases) {
        SCOPED_TRACE(c.about);
        InputDesk desk;
        auto setting = std::make_shared<ContextInputSetting>();
        setting->flags = c.flags;
        setting->pastingDelay = c.pastingDelay;
        setting->afterPastingDelay = c.afterPastingDelay;
        desk.service.setCustomApplicationSetting(u"editor", setting);
        const auto output = InputDesk::output(u"ab", 1);
        addKey(*output, 1);
        desk.service.sendOutput(output);
        desk.loop.advance(3);
        EXPECT_EQ(desk.poster.timesOf("v51"), c.erasures);
        EXPECT_EQ(desk.poster.timesOf(Paste), c.pastes);
        EXPECT_EQ(desk.poster.timesOf("v48"), c.keys);
        EXPECT_EQ(desk.poster.timesOf("release"), c.released);
        EXPECT_EQ(desk.pasteboard.take(), u"b");
    }
}

struct Window final : VMHelperController {
    void show(Point centre) override { shown.push_back(centre); }
    void hide() override { ++hidden; }
    std::vector<Point> shown;
    int hidden = 0;
};

TEST(OutputDelivery, ActivatesAVirtualMachineAgain) {
    InputDesk desk;
    Window window;
    VMPasting pasting(desk.poster, desk.processes, desk.loop, desk.loop, &window);
    const auto machine = desk.activate(u"machine");
    auto setting = std::make_shared<ContextInputSetting>();
    setting->flags = InputFlag::ClickAtVMHelper | InputFlag::ClickAtVM | InputFlag::DeleteAfterActivateVM;
    std::vector<long> erased;
    std::vector<long> pasted;
    const auto now = [&] { return std::lround(desk.loop.now() * 1000); };
    pasting.start({setting, machine, [&] { erased.push_back(now()); }, [&] { pasted.push_back(now()); }});
    desk.loop.advance(0.19);
    EXPECT_EQ(desk.processes.frontProcess(), machine);
    desk.loop.advance(0.02);
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    EXPECT_THAT(window.shown, ElementsAre(Point{30, 40}));
    desk.loop.advance(0.28);
    EXPECT_EQ(window.hidden, 0);
    desk.loop.advance(0.02);
    EXPECT_EQ(window.hidden, 1);
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    desk.loop.advance(1);
    EXPECT_EQ(desk.processes.frontProcess(), machine);
    EXPECT_EQ(desk.poster.timesOf("click"), (Times{400, 800}));
    EXPECT_EQ(erased, Times{900});
    EXPECT_EQ(pasted, Times{1100});
}

TEST(OutputDelivery, EveryKeyPassesWhileAPasteIsToCome) {
    InputDesk desk(u"org.virtualbox.app.VirtualBoxVM");
    desk.service.registerHotKey({{}, KeyCode::X});
    desk.service.sendOutput(InputDesk::output(u"text"));
    struct Swallower {
        void pressed(ZDHotKeysPressedEventArgs& event) { event.cancel = true; }
    } swallower;
    const Subscription subscription = desk.service.hotKeysPressed.addObserver(&swallower, &Swallower::pressed);
    EXPECT_FALSE(desk.keyDown(KeyCode::X));
    desk.loop.advance(0.3);
    EXPECT_TRUE(desk.keyDown(KeyCode::X));
}

TEST(OutputDelivery, OwnKeysAreNotHeard) {
    InputDesk desk;
    int heard = 0;
    desk.poster.onPost = [&](const SynthesisedKey& key) {
        desk.send(TapEvent::Type::KeyDown, key.keyCode, u"x", key.flags);
        heard += desk.service.lastKeyString().has_value() ? 1 : 0;
    };
    desk.service.sendOutput(InputDesk::output(u"text", 2));
    EXPECT_EQ(heard, 0);
}

class ClipboardDeliveryTest : public ::testing::TestWithParam<bool> {
  protected:
    ClipboardDeliveryTest() {
        desk.pasteboard.tells = GetParam();
        desk.pasteboard.content.copyFromProgram(u"user's");
        desk.poster.onPost = [this](const SynthesisedKey& key) {
            if (key.keyCode == KeyCode::V && key.down) pasted.push_back(desk.pasteboard.take().value_or(u"nothing"));
        };
    }
    void sendTo(const char16_t* application, const char16_t* text) {
        desk.activate(application);
        desk.service.sendOutput(InputDesk::output(text));
    }

    InputDesk desk;
    std::vector<std::u16string> pasted;
};

INSTANTIATE_TEST_SUITE_P(WithAndWithoutTelling, ClipboardDeliveryTest, ::testing::Bool());

TEST_P(ClipboardDeliveryTest, WhatIsAbandonedStillOwesTheRestore) {
    desk.activate(u"net.ichi2.anki");
    desk.service.sendOutput(InputDesk::output(u"expansion", 45));
    desk.service.sendOutput(InputDesk::output(u"another"));
    desk.tap.listener->tapDisabledByTimeout();
    desk.loop.advance(2);
    EXPECT_THAT(desk.poster.timesOf("v51"), ::testing::SizeIs(20)) << "the first batch";
    EXPECT_THAT(pasted, IsEmpty());
    EXPECT_TRUE(desk.service.isIdle());
    EXPECT_EQ(desk.pasteboard.string(), u"user's");
    sendTo(u"net.ichi2.anki", u"later");
    EXPECT_THAT(pasted, ElementsAre(u"later"));
}

TEST_P(ClipboardDeliveryTest, AnOutputThatDoesNotPasteStillOwesTheRestore) {
    sendTo(u"net.ichi2.anki", u"expansion");
    desk.loop.advance(0.2);
    sendTo(u"editor", u"typed");
    desk.loop.advance(0.2);
    EXPECT_EQ(desk.pasteboard.string(), u"expansion") << "put off";
    desk.loop.advance(0.2);
    EXPECT_EQ(desk.pasteboard.string(), u"user's");
}

TEST_P(ClipboardDeliveryTest, BackToBackOutputsPasteTheirOwnContent) {
    for (const auto* text : {u"one", u"two", u"three"}) sendTo(u"net.ichi2.anki", text);
    desk.loop.advance(2);
    EXPECT_THAT(pasted, ElementsAre(u"one", u"two", u"three"));
    EXPECT_EQ(desk.pasteboard.string(), u"user's");
}

class TakingTest : public ::testing::Test {
  protected:
    TakingTest() {
        desk.pasteboard.tells = true;
        desk.pasteboard.content.copyFromProgram(u"user's");
    }

    InputDesk desk{u"net.ichi2.anki"};
};

TEST_F(TakingTest, WhatFollowsWaitsUntilThePasteWasTaken) {
    const auto output = InputDesk::output(u"abc", 1);
    addKey(*output, 1);
    addCaret(*output, 2);
    desk.service.sendOutput(output);
    desk.service.sendOutput(InputDesk::output(u"second"));
    desk.loop.advance(0.5);
    EXPECT_EQ(desk.poster.takeLine(), "hold v51 ^51 v9/8 ^9");
    EXPECT_EQ(desk.pasteboard.take(), u"a");
    EXPECT_EQ(desk.poster.takeLine(), "") << "not inside the pasteboard's call";
    desk.loop.advance(0.3);
    EXPECT_EQ(desk.poster.takeLine(), "v48 ^48 v9/8 ^9");
    EXPECT_EQ(desk.pasteboard.take(), u"bc");
    desk.pasteboard.take();  // some read twice
    desk.loop.advance(0);
    EXPECT_EQ(desk.poster.takeLine(), "v123 ^123 release hold v9/8 ^9");
    EXPECT_EQ(desk.pasteboard.take(), u"second");
    desk.loop.advance(0);
    EXPECT_EQ(desk.poster.takeLine(), "release");
}

TEST_F(TakingTest, ASecondIsLongEnough) {
    desk.service.sendOutput(InputDesk::output(u"one"));
    desk.service.sendOutput(InputDesk::output(u"two"));
    desk.loop.advance(0.99);
    EXPECT_EQ(desk.poster.takeLine(), "hold v9/8 ^9");
    desk.loop.advance(0.02);
    EXPECT_EQ(desk.poster.takeLine(), "release hold v9/8 ^9");
    desk.loop.advance(1);
    EXPECT_TRUE(desk.service.isIdle());
    desk.loop.advance(0.7);
    EXPECT_EQ(desk.pasteboard.string(), u"two") << "nobody in front has taken it, whoever else has read it";
    desk.loop.advance(0.1);
    EXPECT_EQ(desk.pasteboard.string(), u"user's") << "and it is no use to anybody";
}

TEST_F(TakingTest, AProgramThatHangsGetsThePasteFirst) {
    desk.pasteboard.awaited = true;
    desk.service.sendOutput(InputDesk::output(u"one"));
    desk.service.sendOutput(InputDesk::output(u"two"));
    desk.loop.advance(2);
    EXPECT_EQ(desk.pasteboard.string(), u"user's");
    desk.loop.advance(2);
    EXPECT_EQ(desk.poster.takeLine(), "hold v9/8 ^9");
    EXPECT_GE(desk.poster.holds, 2) << "its keys wait for more than two seconds";
    desk.pasteboard.take();
    desk.loop.advance(0);
    EXPECT_EQ(desk.poster.takeLine(), "release hold v9/8 ^9");
    desk.loop.advance(9.9);
    EXPECT_EQ(desk.poster.takeLine(), "");
    desk.loop.advance(0.2);
    EXPECT_EQ(desk.poster.takeLine(), "release") << "ten seconds at most";
}

TEST_F(TakingTest, WhatIsLeftForAProgramThatHangsGoesToNoOther) {
    desk.pasteboard.awaited = true;
    const auto output = InputDesk::output(u"abc");
    addKey(*output, 1);
    desk.service.sendOutput(output);
    desk.loop.advance(3);
    desk.activate(u"another");
    desk.pasteboard.awaited = false;
    desk.loop.advance(0.1);
    EXPECT_EQ(desk.poster.takeLine(), "hold v9/8 ^9 release");
}

TEST_F(TakingTest, TheApplicationsOwnWaitComesBehind) {
    auto setting = std::make_shared<ContextInputSetting>();
    setting->flags = InputFlag::UseClipboard | InputFlag::DelayPasting;
    setting->pastingDelay = 0.2;
    setting->afterPastingDelay = 0.05;
    desk.service.setCustomApplicationSetting(u"net.ichi2.anki", setting);
    const auto output = InputDesk::output(u"a");
    addKey(*output, 1);
    desk.service.sendOutput(output);
    desk.loop.advance(0.1);
    desk.pasteboard.take();  // before it was asked to: this is not the paste
    desk.loop.advance(0.2);
    EXPECT_EQ(desk.poster.timesOf(Paste), Times{200});
    desk.pasteboard.take();
    desk.loop.advance(1);
    EXPECT_EQ(desk.poster.timesOf("v48"), Times{350});
}

TEST_F(TakingTest, NothingIsNotPasted) {
    desk.service.sendOutput(InputDesk::output(u"", 2));
    EXPECT_EQ(desk.poster.takeLine(), "hold v51*2 release");
}

TEST(OutputDelivery, CopiesAList) {
    InputDesk desk;
    const std::vector<std::vector<std::u16string>> rows = {{u"a", u"1"}, {u"b", u"2"}};
    std::size_t row = 0;
    std::size_t column = 0;
    desk.poster.onPost = [&](const SynthesisedKey& key) {
        if (!key.down) return;
        if (key.keyCode == KeyCode::C) desk.pasteboard.content.copyFromProgram(rows[row][column]);
        if (key.keyCode == KeyCode::Tab) column = !key.flags.isEmpty() ? 0 : 1;
        if (key.keyCode == KeyCode::Down) row = std::min(row + 1, rows.size() - 1);
    };
    KeySender sender(desk.poster, desk.accessibility);
    AclExport list(sender, desk.pasteboard, desk.loop, [&] { desk.service.sendCopyCommand(); });
    list.start();
    desk.loop.advance(2);
    EXPECT_EQ(list.text(), u"a\n1\nb\n2\n");
}

}  // namespace
}  // namespace plume
