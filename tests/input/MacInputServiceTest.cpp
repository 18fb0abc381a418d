#include "input/MacInputService.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/engine/AllocationCounter.h"
#include "tests/input/InputDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Type = TapEvent::Type;

// Writes down what the service announces: "key 8 c", "up 8", "context", "shortcut 8/2", "hot 8/2".
struct Listener {
    explicit Listener(MacInputService& aService) : service(aService) {
        subscriptions.push_back(service.keyDownEvent.addObserver(this, &Listener::keyDown));
        subscriptions.push_back(service.keyUpEvent.addObserver(this, &Listener::keyUp));
        subscriptions.push_back(service.inputContextChangedEvent.addObserver(this, &Listener::contextChanged));
        subscriptions.push_back(service.unregisteredHotKeyPressedEvent.addObserver(this, &Listener::shortcut));
        subscriptions.push_back(service.hotKeysPressed.addObserver(this, &Listener::hotKeys));
        subscriptions.push_back(service.mouseDownEvent.addObserver(this, &Listener::clicked));
        subscriptions.push_back(service.secureInputChangedEvent.addObserver(this, &Listener::secureInputChanged));
        subscriptions.push_back(service.keyboardTapGivenUpEvent.addObserver(this, &Listener::givenUp));
    }
    static std::string name(const GeneralHotKey& hotKey) {
        return std::to_string(numberOf(hotKey.keyCode)) + "/" + std::to_string(hotKey.modifiers.bits());
    }
    void keyDown(ZDKeyEventArgs& event) {
        heard.push_back("key " + std::to_string(numberOf(event.key)) + " " + toUtf8(event.s.value_or(u"-")));
        EXPECT_EQ(event.c, event.s && !event.s->empty() ? event.s->front() : u'\0');
        EXPECT_EQ(service.lastKeyString(), event.s);
        event.cancel = swallows;
    }
    void keyUp(ZDKeyEventArgs& event) { heard.push_back("up " + std::to_string(numberOf(event.key))); }
    void contextChanged(InputContextChange&) { heard.emplace_back("context"); }
    void shortcut(ZDUnregisteredHotKeyPressedEventArgs& event) {
        heard.push_back("shortcut " + name(event.hotKey));
        EXPECT_EQ(event.key, event.hotKey.keyCode);
        shortcutCharacter = event.c;
        event.cancel = swallows;
    }
    void hotKeys(ZDHotKeysPressedEventArgs& event) {
        for (const auto& hotKey : event.hotKeys) heard.push_back("hot " + name(hotKey));
        event.cancel = swallows;
    }
    void clicked(ZDMouseEventArgs& event) { heard.push_back("click " + std::to_string(static_cast<int>(event.x))); }
    void secureInputChanged(MacInputService& raiser) {
        heard.emplace_back(raiser.secureInput() ? "secure" : "not secure");
    }
    void givenUp(KeyboardTapGivenUp&) { heard.emplace_back("given up"); }

    std::vector<std::string> take() { return std::exchange(heard, {}); }

    MacInputService& service;
    std::vector<Subscription> subscriptions;
    std::vector<std::string> heard;
    char16_t shortcutCharacter = 0;
    bool swallows = false;
};

struct MacInputServiceTest : ::testing::Test {
    MacInputServiceTest() {
        // Observers of key ups are there before the start.
        desk.service.disableEvents();
        desk.service.enableEvents();
        desk.loop.runReady();
    }
    std::vector<std::string> heard() {
        desk.loop.runReady();
        return listener.take();
    }

    InputDesk desk;
    Listener listener{desk.service};
};

TEST_F(MacInputServiceTest, ReadsWhatAKeyTypes) {
    desk.keyDown(KeyCode::C, u"c");
    EXPECT_EQ(desk.service.lastKeyString(), u"c");
    desk.hold(KeyModifier::Shift);
    EXPECT_EQ(desk.service.lastKeyString(), std::nullopt) << "forgotten at the next event";
    desk.hold({});
    desk.keyDown(KeyCode::C, u"ch");
    desk.keyDown(KeyCode::C);
    desk.heldFlags = EventFlag::Shift | EventFlag::CapsLock;
    desk.keyDown(KeyCode::C);
    desk.keyDown(KeyCode::Section);
    EXPECT_THAT(heard(), ElementsAre("key 8 c", "key 8 ch", "key 8 c", "key 8 C", "key 10 -"));
}

TEST_F(MacInputServiceTest, ShortcutsAreNoText) {
    desk.hold(KeyModifier::Command);
    EXPECT_FALSE(desk.keyDown(KeyCode::C, u"c"));
    EXPECT_THAT(heard(), ElementsAre("shortcut 8/8", "context"));
    listener.swallows = true;
    EXPECT_TRUE(desk.keyDown(KeyCode::C, u"c"));
    EXPECT_TRUE(desk.keyUp(KeyCode::C));
    EXPECT_THAT(heard(), ElementsAre("shortcut 8/8"));
    listener.swallows = false;
    desk.hold(KeyModifier::Option);
    desk.keyDown(KeyCode::C, u"ç");
    desk.keyDown(KeyCode::Delete, u"\b");
    EXPECT_THAT(heard(), ElementsAre("key 8 ç", "shortcut 51/4", "context"));
}

TEST_F(MacInputServiceTest, ACommandOfThePortIsAShortcutWhateverItTypes) {
    desk.hold(KeyModifier::Option);
    const auto press = [&](KeyCode keyCode, std::u16string_view text) {
        desk.tap.listener->keyboardEvent(
            {.keyCode = keyCode, .flags = desk.heldFlags, .string = text, .command = true});
    };
    press(KeyCode::C, u"");
    EXPECT_EQ(listener.shortcutCharacter, u'c') << "what the key is called";
    press(KeyCode::Return, u"\r");
    EXPECT_THAT(heard(), ElementsAre("shortcut 8/4", "context", "shortcut 36/4", "context"));
}

TEST_F(MacInputServiceTest, AKeyInTheMiddleOfASequenceTypesNothing) {
    desk.tap.listener->keyboardEvent({.keyCode = KeyCode::C, .string = {}, .composing = true});
    EXPECT_THAT(heard(), ElementsAre("key 8 -"));
}

TEST_F(MacInputServiceTest, WhatIsTypedAfterWithheldKeysStandsAlone) {
    desk.keyDown(KeyCode::C, u"c");
    desk.tap.listener->typingInterrupted();
    desk.keyDown(KeyCode::V, u"v");
    EXPECT_THAT(heard(), ElementsAre("key 8 c", "context", "key 9 v"));
}

TEST_F(MacInputServiceTest, HotKeysComeBeforeTheEngine) {
    desk.service.registerHotKey({KeyModifier::Control, KeyCode::K});
    desk.service.registerHotKey({KeyModifier::Control, KeyCode::K});
    desk.hold(KeyModifier::Control);
    EXPECT_FALSE(desk.keyDown(KeyCode::K, u"k"));
    EXPECT_THAT(heard(), ElementsAre("hot 40/2", "hot 40/2", "shortcut 40/2", "context"));
    listener.swallows = true;
    EXPECT_TRUE(desk.keyDown(KeyCode::K, u"k"));
    EXPECT_TRUE(desk.keyUp(KeyCode::K));
    EXPECT_THAT(heard(), ElementsAre("hot 40/2", "hot 40/2"));
    desk.service.unregisterHotKey({KeyModifier::Control, KeyCode::K});
    desk.service.unregisterHotKey({KeyModifier::Control, KeyCode::K});
    desk.service.unregisterHotKey({KeyModifier::Control, KeyCode::K});
    desk.keyDown(KeyCode::K, u"k");
    EXPECT_THAT(heard(), ElementsAre("shortcut 40/2"));
}

TEST_F(MacInputServiceTest, NoticesAnotherProgramBeforeItsFirstKey) {
    desk.keyDown(KeyCode::C, u"c");
    const auto other = desk.activate(u"other");
    desk.keyDown(KeyCode::C, u"c");
    EXPECT_THAT(heard(), ElementsAre("key 8 c", "context", "key 8 c"));
    EXPECT_EQ(desk.service.lastProcessReceivedKeyEvent(), other);
    EXPECT_FALSE(desk.service.isSameProcess());
    desk.processes.setFrontProcess(desk.processes.currentProcess());
    desk.keyUp(KeyCode::C);
    EXPECT_THAT(heard(), ElementsAre("context", "up 8"));
    EXPECT_TRUE(desk.service.isSameProcess());
}

TEST_F(MacInputServiceTest, ReportsClicksWhenAskedTo) {
    EXPECT_FALSE(desk.mouse.exists());
    desk.service.setListenMouseDownEvents(true);
    desk.mouse.listener({30, 40});
    EXPECT_THAT(heard(), ElementsAre("click 30"));
    desk.service.setListenMouseDownEvents(false);
    EXPECT_FALSE(desk.mouse.exists());
    desk.service.setListenMouseDownEvents(true);
    desk.service.disableEvents();
    EXPECT_FALSE(desk.mouse.exists());
    EXPECT_FALSE(desk.tap.exists());
}

TEST_F(MacInputServiceTest, FollowsSecureInput) {
    desk.processes.setFrontProcess(desk.processes.launch(u"org.example.bank", u"Bank"));
    desk.secure.on = true;
    desk.loop.advance(2.9);
    EXPECT_THAT(heard(), IsEmpty());
    desk.loop.advance(0.2);
    EXPECT_THAT(heard(), ElementsAre("secure"));
    EXPECT_EQ(desk.service.lastAppEnabledSecureInput(), u"Bank");
    desk.loop.advance(6);
    EXPECT_THAT(heard(), IsEmpty()) << "unchanged";
    desk.secure.on = false;
    desk.loop.advance(3);
    EXPECT_THAT(heard(), ElementsAre("not secure"));
    EXPECT_EQ(desk.service.lastAppEnabledSecureInput(), std::nullopt);

    desk.secure.on = true;
    desk.service.checkSecureInput();
    EXPECT_THAT(heard(), ElementsAre("secure"));
    desk.hold(KeyModifier::Shift);
    EXPECT_THAT(heard(), IsEmpty());
    desk.keyDown(KeyCode::C, u"c");
    desk.keyDown(KeyCode::V, u"v");
    EXPECT_THAT(heard(), ElementsAre("key 8 c", "key 9 v", "not secure"));
    desk.service.disableEvents();
    desk.loop.runReady();
    EXPECT_FALSE(desk.loop.nextDue()) << "nothing wakes up any more";
}

TEST_F(MacInputServiceTest, ModifiersHeldWhenTheTapIsLostAreNoHotKey) {
    desk.service.registerHotKey({KeyModifier::Command, KeyCode::None});
    desk.hold(KeyModifier::Command);
    desk.tap.listener->tapDisabledByTimeout();
    desk.hold({});
    EXPECT_THAT(heard(), ElementsAre("context"));
    desk.hold(KeyModifier::Command);
    desk.hold({});
    EXPECT_THAT(heard(), ElementsAre("hot 65535/8"));
}

TEST_F(MacInputServiceTest, TakesTheTapAgainTwiceAMinute) {
    desk.tap.listener->tapDisabledByTimeout();
    desk.loop.advance(40);
    desk.tap.listener->tapDisabledByTimeout();
    desk.loop.advance(21);
    desk.tap.listener->tapDisabledByTimeout();
    EXPECT_EQ(desk.tap.enabled, 3) << "the first is more than a minute ago";
    EXPECT_THAT(heard(), testing::Each("context")) << "what was typed before goes on in none";
    desk.loop.advance(1);
    desk.tap.listener->tapDisabledByTimeout();
    desk.loop.advance(59);
    EXPECT_EQ(desk.tap.enabled, 3);
    EXPECT_THAT(heard(), ElementsAre("context", "given up"));
    desk.loop.advance(1);
    EXPECT_EQ(desk.tap.enabled, 4) << "after a minute";
    desk.service.tryTapAgain();
    EXPECT_EQ(desk.tap.enabled, 4) << "nobody gave it up";
    for (int i = 0; i < 3; ++i) desk.tap.listener->tapDisabledByTimeout();
    desk.service.tryTapAgain();
    desk.loop.advance(61);
    EXPECT_EQ(desk.tap.enabled, 7) << "once, when asked for";
    EXPECT_EQ(desk.log.size(), 9U);
    EXPECT_EQ(desk.log.front(), "Event tap was disabled by timeout");
    desk.log.clear();
    desk.tap.listener->tapDisabledByUserInput();
    EXPECT_THAT(desk.log, ElementsAre("Event tap was disabled by user input"));
}

TEST_F(MacInputServiceTest, SaysThatATapCannotBeCreated) {
    desk.service.disableEvents();
    desk.loop.runReady();
    desk.tap.error.message = "The X server has no XInput 2.";
    desk.service.enableEvents();
    desk.loop.runReady();
    EXPECT_THAT(desk.log, ElementsAre("The event tap could not be created to monitor key events",
                                      "The X server has no XInput 2."));
    EXPECT_FALSE(desk.service.evenTapCreated());
    EXPECT_FALSE(desk.loop.nextDue());

    desk.tap.error.message.clear();
    desk.service.setListenAtAnnotatedSession(true);
    desk.service.enableEvents();
    desk.loop.runReady();
    EXPECT_TRUE(desk.tap.annotated);
}

TEST_F(MacInputServiceTest, TheSystemsHotKeyIsNoHotKeyOfModifiers) {
    int pressed = 0;
    desk.service.registerHotKey({KeyModifier::Command, KeyCode::None});
    const auto registered = [&](const GeneralHotKey& hotKey) {
        EXPECT_TRUE(desk.service.registerSystemHotKey(1, hotKey, [&] { ++pressed; }));
        return desk.systemHotKeys.registered.size();
    };
    ASSERT_EQ(registered({KeyModifier::Command, KeyCode::Space}), 1U);
    EXPECT_EQ(desk.systemHotKeys.registered[1].first, (GeneralHotKey{KeyModifier::Command, KeyCode::Space}));
    desk.hold(KeyModifier::Command);
    desk.systemHotKeys.registered[1].second();
    desk.hold({});
    EXPECT_EQ(pressed, 1);
    EXPECT_THAT(heard(), IsEmpty());
    EXPECT_EQ(registered({KeyModifier::Command, KeyCode::None}), 0U) << "without a key there is none";
}

TEST_F(MacInputServiceTest, NamesOtherProgramsThatCanSwallowKeys) {
    const auto own = desk.processes.runningApplication(desk.processes.currentProcess());
    desk.processes.setEventTaps({{true, {7, u"org.example.remapper", u"Remapper", u"/bin/remapper"}},
                                 {false, {8, u"org.example.logger", u"Logger", std::nullopt}},
                                 {true, {9, u"com.apple.dock", u"Dock", std::nullopt}},
                                 {true, *own}});
    const auto processes = desk.service.tappingProcesses();
    ASSERT_EQ(processes.size(), 1U);
    EXPECT_EQ(processes[0].processIdentifier, 7);
}

TEST_F(MacInputServiceTest, CopiesAsTheApplicationInFrontWantsIt) {
    desk.service.refreshContextInputSetting();
    desk.service.sendCopyCommand();
    EXPECT_THAT(desk.poster.take(), ElementsAre("v8/8", "^8"));
    desk.activate(u"org.macosforge.xquartz.X11");
    desk.service.sendCopyCommand();
    EXPECT_THAT(desk.poster.take(), ElementsAre("v8/2", "^8"));
    desk.activate(u"wine");
    EXPECT_TRUE(desk.service.refreshContextInputSetting()->has(InputFlag::UseControlKey));
    desk.service.sendCopyCommand();
    EXPECT_THAT(desk.poster.take(), ElementsAre("v8/2", "^8"));
    EXPECT_EQ(desk.service.contextBundleIdentifier(), u"wine");
}

TEST(MacInputService, APlainKeyAllocatesNothing) {
    InputDesk desk;
    struct Engine {
        void key(ZDKeyEventArgs& event) { keys += event.c; }
        int keys = 0;
    } engine;
    const Subscription subscription = desk.service.keyDownEvent.addObserver(&engine, &Engine::key);
    const auto typeAll = [&] {
        for (int i = 0; i < 10; ++i) {
            desk.hold(KeyModifier::Shift);
            desk.keyDown(KeyCode::C, u"C");
            desk.keyUp(KeyCode::C);
            desk.hold({});
            desk.keyDown(KeyCode::C);
            desk.keyUp(KeyCode::C);
        }
    };
    typeAll();
    const std::size_t before = allocationCount();
    typeAll();
    EXPECT_EQ(allocationCount(), before);
    EXPECT_EQ(engine.keys, 2 * 10 * ('C' + 'c'));
}

}  // namespace
}  // namespace plume
