// The simulated keyboard raises what a real one would, in the same order.
#include "ports/simulated/SimulatedInputService.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {
namespace {

using ::testing::ElementsAre;

class Keyboard : public ::testing::Test {
  protected:
    Keyboard() {
        processes.setFrontProcess(editor);
        subscriptions.push_back(service.keyDownEvent.addObserver(this, &Keyboard::onKey));
        subscriptions.push_back(service.inputContextChangedEvent.addObserver(this, &Keyboard::onContext));
        subscriptions.push_back(service.unregisteredHotKeyPressedEvent.addObserver(this, &Keyboard::onHotKey));
        subscriptions.push_back(service.mouseDownEvent.addObserver(this, &Keyboard::onClick));
    }
    void onKey(ZDKeyEventArgs& event) {
        const std::string text = event.s ? toUtf8(*event.s) : "nothing";
        log.push_back("key " + std::to_string(numberOf(event.key)) + " " + text);
        modifiers.push_back(service.keyModifier().bits());
        EXPECT_EQ(event.c, event.s && !event.s->empty() ? event.s->front() : u'\0');
        event.cancel = swallows;
    }
    void onContext(InputContextChange& /*change*/) { log.emplace_back("context"); }
    void onHotKey(ZDUnregisteredHotKeyPressedEventArgs& event) {
        log.push_back("hot key " + std::to_string(numberOf(event.hotKey.keyCode)) + " " +
                      std::to_string(event.hotKey.modifiers.bits()));
        EXPECT_EQ(event.key, event.hotKey.keyCode);
        event.cancel = swallows;
    }
    void onClick(ZDMouseEventArgs& event) {
        log.push_back("click " + std::to_string(static_cast<int>(event.x)) + " " +
                      std::to_string(static_cast<int>(event.y)));
    }

    SimulatedProcessManager processes;
    SimulatedInputSources sources;
    SimulatedRunLoop loop;
    SimulatedInputService service{processes, sources, loop};
    ProcessSerialNumber editor = processes.launch(u"org.example.editor");
    std::vector<std::string> log;
    std::vector<Subscription> subscriptions;
    std::vector<std::int32_t> modifiers;
    bool swallows = false;
};

TEST_F(Keyboard, TypesWithShiftWhereACharacterNeedsIt) {
    EXPECT_EQ(service.typeText(u"aA1!\n\t"), u"aA1!\n\t");
    EXPECT_THAT(log, ElementsAre("key 0 a", "key 0 A", "key 18 1", "key 18 !", "key 36 \r", "key 48 \t"));
    EXPECT_THAT(modifiers, ElementsAre(0, 1, 0, 1, 0, 0));
    EXPECT_TRUE(service.keyModifier().isEmpty());
}

TEST_F(Keyboard, TypesCharactersThatAreOnNoKeyInOnePiece) {
    service.typeText(u"\u00E9\U0001F600");
    EXPECT_THAT(log, ElementsAre("key 127 \u00E9", "key 127 \U0001F600"));
}

TEST_F(Keyboard, TellsWhatWasSwallowed) {
    swallows = true;
    EXPECT_EQ(service.typeText(u"ab"), u"");
    EXPECT_TRUE(service.pressKey(KeyCode::Left));
    EXPECT_TRUE(service.pressKey(KeyCode::A, KeyModifier::Command));
}

TEST_F(Keyboard, NoticesAnotherProgramAtItsFirstKey) {
    service.typeText(u"a");
    processes.setFrontProcess(processes.launch(u"org.example.terminal"));
    EXPECT_EQ(service.lastProcessReceivedKeyEvent(), editor);
    service.typeText(u"bc");
    EXPECT_THAT(log, ElementsAre("key 0 a", "context", "key 11 b", "key 8 c"));
    EXPECT_FALSE(service.isSameProcess());
    processes.setFrontProcess(processes.currentProcess());
    service.typeText(u"d");
    EXPECT_TRUE(service.isSameProcess());
}

TEST_F(Keyboard, ShortcutsAreNoKeysAndChangeTheContextUnlessSwallowed) {
    EXPECT_FALSE(service.pressKey(KeyCode::S, KeyModifier::Command | KeyModifier::Shift));
    EXPECT_FALSE(service.pressKey(KeyCode::Delete, KeyModifier::Option));
    swallows = true;
    EXPECT_TRUE(service.pressKey(KeyCode::Digit1, KeyModifier::Control));
    EXPECT_THAT(log, ElementsAre("hot key 1 9", "context", "hot key 51 4", "context", "hot key 18 2"));
}

TEST_F(Keyboard, OptionChangesWhatAKeyProduces) {
    service.pressKey(KeyCode::Digit1, KeyModifier::Option);
    EXPECT_THAT(log, ElementsAre("key 18 \u00A1"));
    EXPECT_EQ(service.stringForKeyCode(KeyCode::Digit1, {}), u"1");
    EXPECT_EQ(service.stringForKeyCode(KeyCode::Digit1, EventFlag::Shift), u"!");
    EXPECT_EQ(service.stringForKeyCode(KeyCode::C, EventFlag::Control), u"\x03");
    EXPECT_EQ(service.stringForKeyCode(KeyCode::F1, {}), std::nullopt);
}

TEST_F(Keyboard, ClicksTellWhere) {
    service.click(3, 4);
    EXPECT_THAT(log, ElementsAre("click 3 4"));
}

TEST(KeyTable, EveryPrintableAsciiCharacterIsOnAKeyThatProducesIt) {
    const SimulatedInputSources sources;
    for (char16_t c = u' '; c <= u'~'; ++c) {
        const auto stroke = SimulatedInputSources::strokeFor(c);
        ASSERT_TRUE(stroke) << static_cast<int>(c);
        const EventFlags flags = stroke->shift ? EventFlags(EventFlag::Shift) : EventFlags();
        EXPECT_EQ(sources.translateKey(stroke->keyCode, flags), std::u16string(1, c));
    }
}

}  // namespace
}  // namespace plume
