// What keys do to the buffer and to the list.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <functional>

#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::IsEmpty;

constexpr KeyModifiers Shift = KeyModifier::Shift;
constexpr KeyModifiers Control = KeyModifier::Control;
constexpr KeyModifiers Option = KeyModifier::Option;
constexpr KeyModifiers Command = KeyModifier::Command;

struct KeyCase {
    const char* about;
    KeyCode key;
    KeyModifiers modifiers;
    bool swallowed;
    bool visible;          // the list, afterwards
    std::size_t selected;  // from entry 1 of 3
    std::u16string screen;
};

TEST(Keys, DriveTheList) {
    const KeyCase cases[] = {
        {"Down", KeyCode::Down, {}, true, true, 2, u"ab"},
        {"Up", KeyCode::Up, {}, true, true, 0, u"ab"},
        {"Return", KeyCode::Return, {}, true, false, 1, u"content"},
        {"Shift+Return", KeyCode::Return, Shift, true, false, 1, u"content"},
        {"Enter", KeyCode::KeypadEnter, {}, true, false, 1, u"content"},
        {"Escape", KeyCode::Escape, {}, true, false, 1, u"ab"},
        {"Left", KeyCode::Left, {}, false, false, 1, u"ab"},
        {"Forward Delete", KeyCode::ForwardDelete, {}, false, true, 1, u"ab"},
        {"Shift+Space", KeyCode::Space, Shift, false, true, 1, u"ab "},
        {"Space, which begins nothing", KeyCode::Space, {}, false, false, 1, u"ab "},
        {"Delete, back to a shorter beginning", KeyCode::Delete, {}, false, true, 0, u"a"},
    };
    for (const KeyCase& key : cases) {
        EngineDesk desk;
        desk.add({u"abc", u"abd", u"abe"});
        desk.suggest(u"ab");
        desk.list.selected = 1;
        desk.desktop.pressAndRelease(key.key, key.modifiers);
        const auto& events = desk.desktop.front()->events();
        const bool passed =
            std::any_of(events.begin(), events.end(), [&](const auto& e) { return e.keyCode == key.key; });
        EXPECT_EQ(passed, !key.swallowed) << key.about;
        EXPECT_EQ(desk.list.visible, key.visible) << key.about;
        EXPECT_EQ(desk.list.selected, key.selected) << key.about;
        EXPECT_EQ(desk.screen(), key.screen) << key.about;
    }
}

struct DigitCase {
    const char* about;
    std::int64_t setting;
    char16_t key;
    KeyModifiers held;
    std::u16string screen;  // the list has "1" to "3" for "aba", "abb" and "abc"
};

TEST(Digits, PickFromTheList) {
    const DigitCase cases[] = {
        {"first", 0, u'1', {}, u"1"},
        {"0 stands for the tenth", 0, u'0', {}, u"ab0"},
        {"not with a modifier", 0, u'1', Option, u"ab\u00A1"},
        {"Shift", 1, u'1', Shift, u"1"},
        {"Shift is missing", 1, u'1', {}, u"ab1"},
        {"Shift and more", 1, u'1', Shift | Option, u"ab\u00A1"},
        {"Control", 2, u'2', Control, u"2"},
        {"Control and more", 2, u'2', Control | Shift, u"ab"},
        {"Option", 3, u'3', Option, u"3"},
        {"Command", 4, u'1', Command, u"1"},
        {"another than Command", 4, u'1', Control, u"ab"},
        {"no such modifier", -1, u'1', {}, u"ab1"},
        {"no such bit", 64, u'1', Command, u"ab"},
    };
    for (const DigitCase& digit : cases) {
        EngineDesk desk;
        desk.add(u"aba", u"1");
        desk.add(u"abb", u"2");
        desk.add(u"abc", u"3");
        desk.engine.setSnippetSelectorKeyModifier(digit.setting);
        desk.suggest(u"ab");
        desk.press(digit.key, digit.held);
        EXPECT_EQ(desk.screen(), digit.screen) << digit.about;
        EXPECT_FALSE(desk.list.visible) << digit.about;
    }
}

TEST(Digits, PickFromQuickSearch) {
    const DigitCase cases[] = {
        {"plain", 0, u'2', {}, u"ab2"},        {"past the end", 0, u'3', {}, u"ab3"},
        {"Shift", 1, u'2', Shift, u"ab2"},     {"Shift is missing", 1, u'1', {}, u"ab1"},
        {"Command", 4, u'2', Command, u"ab2"},
    };
    for (const DigitCase& digit : cases) {
        EngineDesk desk;
        desk.search.results = {std::make_shared<Snippet>(u"one", u"first"), std::make_shared<Snippet>(u"two", u"2")};
        desk.engine.setSnippetSelectorKeyModifier(digit.setting);
        desk.type(u"ab");
        desk.engine.quickSearch();
        desk.press(digit.key, digit.held);
        EXPECT_EQ(desk.screen(), digit.screen) << digit.about;
        EXPECT_EQ(desk.search.visible, digit.key != u'2') << digit.about;
    }
}

TEST(Keys, TypedIntoQuickSearchLeaveTheEngineAlone) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.add({u"ab"}, ExpandTrigger::HotKey);
    desk.type(u"ab");
    desk.engine.quickSearch();
    desk.engine.expandAtHotkey();
    desk.type(u"c7\b");
    desk.desktop.pressAndRelease(KeyCode::Escape);
    desk.desktop.pressAndRelease(KeyCode::Left);
    EXPECT_EQ(desk.engine.letters(), u"ab");
    EXPECT_TRUE(desk.search.visible);
}

TEST(Keys, ToPlumeItselfEndUndoButAreNotFollowed) {
    EngineDesk desk;
    desk.add(u"ab", u"Best");
    desk.type(u"ab");
    ASSERT_TRUE(desk.engine.undoInfo());
    SimulatedProcessManager& processes = desk.desktop.processManager();
    processes.setFrontProcess(processes.currentProcess());
    desk.type(u"ab");
    EXPECT_EQ(desk.engine.letters(), u"");
    EXPECT_FALSE(desk.engine.undo(true));
    desk.add({u"x"}, ExpandTrigger::HotKey);
    desk.engine.expandAtHotkey();
    EXPECT_THAT(desk.engine.letters(), IsEmpty());
}

TEST(Keys, WhileDisabledLeaveUndoAsItIs) {
    EngineDesk desk;
    desk.add(u"ab", u"Best");
    desk.type(u"ab");
    desk.engine.setEnabled(false);
    desk.type(u"ab");
    EXPECT_EQ(desk.engine.letters(), u"");
    EXPECT_TRUE(desk.engine.undoInfo());
}

struct ClickCase {
    const char* about;
    bool list;
    bool search;
    double x;
    double y;
    bool kept;
};

TEST(Buffer, StartsAnewAtAClickOutsideTheVisibleWindow) {
    // The list stands at (100, 100), the search window at (400, 100); both are 200 wide and 50 high.
    const ClickCase cases[] = {
        {"in the list", true, false, 110, 110, true},
        {"at its first corner", true, false, 100, 100, true},
        {"below it", true, false, 110, 151, false},
        {"beside it", true, false, 301, 110, false},
        {"in the search window", false, true, 410, 110, true},
        {"outside the search window", false, true, 110, 110, false},
        {"in the list, with both", true, true, 110, 110, true},
        {"in the search window, with both", true, true, 410, 110, false},
    };
    for (const ClickCase& one : cases) {
        EngineDesk desk;
        desk.add({u"abc"});
        desk.type(u"ab");
        if (one.list) desk.engine.suggestAbbreviations();
        if (one.search) desk.engine.quickSearch();
        desk.clickAt(one.x, one.y);
        EXPECT_EQ(desk.engine.letters(), one.kept ? u"ab" : u"") << one.about;
        EXPECT_EQ(desk.list.visible, one.list && one.kept) << one.about;
        EXPECT_EQ(desk.search.visible, one.search && one.kept) << one.about;
    }
}

// The buffer's rules once more, as short as they can be said, against random typing.
struct Act {
    const char* about;
    std::function<void(EngineDesk&)> perform;
    std::function<void(std::u16string&)> change;
};

const std::vector<Act>& acts() {
    const auto key = [](KeyCode code, KeyModifiers held = {}) {
        return [=](EngineDesk& desk) { desk.desktop.pressAndRelease(code, held); };
    };
    const auto empty = [](std::u16string& letters) { letters.clear(); };
    const auto nothing = [](std::u16string&) {};
    static const std::vector<Act> all = {
        {"letter", key(KeyCode::K), [](auto& letters) { letters += u'k'; }},
        {"delete", key(KeyCode::Delete),
         [](auto& letters) { letters.resize(std::max<std::size_t>(letters.size(), 1) - 1); }},
        {"forward delete", key(KeyCode::ForwardDelete), nothing},
        {"left", key(KeyCode::Left), empty},
        {"Shift and space", key(KeyCode::Space, Shift), [](auto& letters) { letters += u' '; }},
        {"two units", [](auto& desk) { desk.desktop.typeCharacter(u"\U0001F600"); }, nothing},
        {"click", [](auto& desk) { desk.clickAt(0, 0); }, empty},
        {"shortcut", key(KeyCode::S, Command), empty},
        {"function key", key(KeyCode::F1), empty},
        {"key without text", key(KeyCode::VolumeUp), nothing},
        {"switch", [](auto& desk) { desk.engine.setEnabled(true); }, empty},
    };
    return all;
}

RC_GTEST_PROP(BufferModel, AgreesWithTheEngine, ()) {
    // Every other key is a letter, so that there is something in the buffer.
    const auto chosen = *rc::gen::container<std::vector<std::size_t>>(rc::gen::inRange<std::size_t>(0, acts().size()));
    EngineDesk desk;
    std::u16string model;
    for (const std::size_t index : chosen) {
        for (const Act& act : {acts()[0], acts()[index]}) {
            RC_LOG() << act.about << "\n";
            act.perform(desk);
            act.change(model);
            RC_ASSERT(desk.engine.letters() == model);
        }
    }
}

}  // namespace
}  // namespace plume
