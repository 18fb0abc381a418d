// Which way each key takes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "content/PLOutput.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::IsEmpty;
using ::testing::SizeIs;

struct KeyCase {
    const char* about;
    KeyCode key;
    KeyModifiers modifiers;
    std::u16string letters;  // the buffer afterwards, from "abc"
};

void PrintTo(const KeyCase& key, std::ostream* stream) {
    *stream << key.about;
}

class KeysWithoutAList : public ::testing::TestWithParam<KeyCase> {};

TEST_P(KeysWithoutAList, EditTheBufferAndReachTheApplication) {
    EngineDesk desk;
    desk.service.typeText(u"abc");
    EXPECT_FALSE(desk.service.pressKey(GetParam().key, GetParam().modifiers));
    EXPECT_EQ(desk.engine.letters(), GetParam().letters);
}

INSTANTIATE_TEST_SUITE_P(
    Codes, KeysWithoutAList,
    ::testing::Values(KeyCase{"Delete", KeyCode::Delete, {}, u"ab"},
                      KeyCase{"Shift+Delete", KeyCode::Delete, KeyModifier::Shift, u"ab"},
                      KeyCase{"Escape", KeyCode::Escape, {}, u""}, KeyCase{"Return", KeyCode::Return, {}, u"abc\r"},
                      KeyCase{"Shift+Return", KeyCode::Return, KeyModifier::Shift, u"abc\r"},
                      KeyCase{"Enter", KeyCode::KeypadEnter, {}, u"abc\x03"},
                      KeyCase{"Space", KeyCode::Space, {}, u"abc "},
                      KeyCase{"Shift+Space", KeyCode::Space, KeyModifier::Shift, u"abc "},
                      KeyCase{"Option+Space", KeyCode::Space, KeyModifier::Option, u"abc\u00A0"},
                      KeyCase{"Home", KeyCode::Home, {}, u""}, KeyCase{"Page Up", KeyCode::PageUp, {}, u""},
                      KeyCase{"End", KeyCode::End, {}, u""}, KeyCase{"Page Down", KeyCode::PageDown, {}, u""},
                      KeyCase{"Left", KeyCode::Left, {}, u""},
                      KeyCase{"Shift+Right", KeyCode::Right, KeyModifier::Shift, u""},
                      KeyCase{"Down", KeyCode::Down, {}, u""}, KeyCase{"Up", KeyCode::Up, {}, u""},
                      KeyCase{"Forward Delete", KeyCode::ForwardDelete, {}, u"abc"},
                      KeyCase{"Tab", KeyCode::Tab, {}, u"abc\t"}, KeyCase{"keypad 7", KeyCode::Keypad7, {}, u"abc7"},
                      KeyCase{"a key that types nothing", KeyCode::F1, {}, u"abc"},
                      KeyCase{"Option+Delete", KeyCode::Delete, KeyModifier::Option, u""},
                      KeyCase{"Command+Left", KeyCode::Left, KeyModifier::Command, u""},
                      KeyCase{"Control+A", KeyCode::A, KeyModifier::Control, u""}));

struct ListKeyCase {
    const char* about;
    KeyCode key;
    KeyModifiers modifiers;
    bool swallowed;
    bool visible;          // the list, afterwards
    std::size_t selected;  // from entry 1 of 3
    std::vector<std::u16string> sent;
};

void PrintTo(const ListKeyCase& key, std::ostream* stream) {
    *stream << key.about;
}

class KeysWithAList : public ::testing::TestWithParam<ListKeyCase> {};

TEST_P(KeysWithAList, DriveIt) {
    const ListKeyCase& key = GetParam();
    EngineDesk desk;
    desk.add({u"abc", u"abd", u"abe"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    desk.list.selected = 1;

    EXPECT_EQ(desk.service.pressKey(key.key, key.modifiers), key.swallowed);
    EXPECT_EQ(desk.list.visible, key.visible);
    EXPECT_EQ(desk.list.selected, key.selected);
    std::vector<std::u16string> sent;
    for (const auto& one : desk.sender.sent) sent.push_back(one.abbreviation);
    EXPECT_EQ(sent, key.sent);
}

INSTANTIATE_TEST_SUITE_P(
    Codes, KeysWithAList,
    ::testing::Values(ListKeyCase{"Down", KeyCode::Down, {}, true, true, 2, {}},
                      ListKeyCase{"Up", KeyCode::Up, {}, true, true, 0, {}},
                      ListKeyCase{"Return", KeyCode::Return, {}, true, false, 1, {u"abd"}},
                      ListKeyCase{"Shift+Return", KeyCode::Return, KeyModifier::Shift, true, false, 1, {u"abd"}},
                      ListKeyCase{"Enter", KeyCode::KeypadEnter, {}, true, false, 1, {u"abd"}},
                      ListKeyCase{"Escape", KeyCode::Escape, {}, true, false, 1, {}},
                      ListKeyCase{"Left", KeyCode::Left, {}, false, false, 1, {}},
                      ListKeyCase{"Forward Delete", KeyCode::ForwardDelete, {}, false, true, 1, {}},
                      ListKeyCase{"Shift+Space", KeyCode::Space, KeyModifier::Shift, false, true, 1, {}},
                      ListKeyCase{"Space, which begins nothing", KeyCode::Space, {}, false, false, 1, {}},
                      ListKeyCase{"Delete, back to a shorter beginning", KeyCode::Delete, {}, false, true, 0, {}}));

TEST(Keys, EscapeThatClosesTheListKeepsTheBuffer) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    desk.service.pressKey(KeyCode::Escape);
    EXPECT_EQ(desk.engine.letters(), u"ab");
    EXPECT_TRUE(desk.engine.suggestions().isEmpty());
}

TEST(Keys, ReturnSendsTheSelectedEntryAsASuggestion) {
    EngineDesk desk;
    desk.add({u"abc", u"abd"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    desk.service.pressKey(KeyCode::Down);
    desk.service.pressKey(KeyCode::Return);
    ASSERT_THAT(desk.sender.sent, SizeIs(1));
    EXPECT_EQ(desk.sender.sent[0], (RecordingSender::Sent{u"abd", u"ab", SnippetTrigger::Suggestion, u"ab", false}));
}

class ShiftWithSpaceLikeKeys : public ::testing::TestWithParam<KeyCode> {};

TEST_P(ShiftWithSpaceLikeKeys, NeverExpand) {
    EngineDesk desk;
    desk.add({u"sig"}, ExpandTrigger::DelimiterSwallowed);
    desk.service.typeText(u"sig");
    EXPECT_FALSE(desk.service.pressKey(GetParam(), KeyModifier::Shift));
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    EXPECT_THAT(desk.engine.letters(), SizeIs(4));

    desk.engine.clear();
    desk.service.typeText(u"sig");
    EXPECT_TRUE(desk.service.pressKey(GetParam()));
}

INSTANTIATE_TEST_SUITE_P(Codes, ShiftWithSpaceLikeKeys,
                         ::testing::Values(KeyCode::Space, KeyCode::Return, KeyCode::KeypadEnter));

TEST(Keys, OtherModifiersWithSpaceExpandAsUsual) {
    EngineDesk desk;
    const auto group = desk.add({u"sig"}, ExpandTrigger::DelimiterSwallowed);
    group->setDelimiters(CharacterSet::withCharacters(u"\u00A0"));
    desk.service.typeText(u"sig");
    EXPECT_TRUE(desk.service.pressKey(KeyCode::Space, KeyModifier::Shift | KeyModifier::Option));
}

TEST(Keys, AreIgnoredWhileDisabled) {
    EngineDesk desk;
    desk.add({u"ab"});
    desk.engine.setEnabled(false);
    desk.engine.setUndoInfo(UndoInformation{});
    EXPECT_EQ(desk.service.typeText(u"ab"), u"ab");
    EXPECT_EQ(desk.engine.letters(), u"");
    EXPECT_TRUE(desk.engine.undoInfo());
}

TEST(Keys, ToPlumeItselfAreNotFollowed) {
    EngineDesk desk;
    desk.add({u"ab"});
    desk.processes.setFrontProcess(desk.processes.currentProcess());
    desk.engine.setUndoInfo(UndoInformation{});
    EXPECT_EQ(desk.service.typeText(u"ab"), u"ab");
    EXPECT_EQ(desk.engine.letters(), u"");
    EXPECT_FALSE(desk.engine.undoInfo()) << "any key ends the chance to undo";
}

struct UndoCase {
    const char* about;
    std::function<void(EngineDesk&)> act;
    bool kept;
};

TEST(Undo, EndsWithTheNextKeyButNotWithClicksAndShortcuts) {
    const UndoCase cases[] = {
        {"letter", [](EngineDesk& desk) { desk.service.typeText(u"a"); }, false},
        {"Forward Delete", [](EngineDesk& desk) { desk.service.pressKey(KeyCode::ForwardDelete); }, false},
        {"key without text", [](EngineDesk& desk) { desk.service.pressKey(KeyCode::F1); }, false},
        {"click", [](EngineDesk& desk) { desk.service.click(1, 1); }, true},
        {"Command+S", [](EngineDesk& desk) { desk.press(u's', KeyModifier::Command); }, true},
    };
    for (const UndoCase& one : cases) {
        EngineDesk desk;
        desk.engine.setUndoInfo(UndoInformation{1, u"a", u"a "});
        one.act(desk);
        EXPECT_EQ(desk.engine.undoInfo().has_value(), one.kept) << one.about;
    }
}

TEST(Lifetime, AnEngineThatIsGoneHearsNothingAndShowsNothing) {
    EngineDesk desk;
    {
        AutoText second({desk.service, desk.resolver, desk.sources, desk.defaults, desk.sender, desk.suggestionSource,
                         nullptr, [] { return nullptr; }, [] { return nullptr; }});
        second.setEnabled(true);
        const auto group = SnippetGroup::make();
        group->addItem(std::make_shared<Snippet>(u"x", u"1"));
        group->addItem(std::make_shared<Snippet>(u"x", u"2"));
        second.setSnippetGroups({group});
        desk.service.typeText(u"x");
        ASSERT_TRUE(desk.loop.nextDue());
    }
    EXPECT_FALSE(desk.loop.nextDue());
    EXPECT_EQ(desk.service.typeText(u"x"), u"x");
    EXPECT_EQ(desk.engine.letters(), u"xx");
}

TEST(Construction, ReadsHowContentIsAdaptedToCase) {
    EngineDesk desk;
    EXPECT_EQ(desk.engine.snippetAdaptToAbbreviationCaseOption(), 0);
    desk.defaults.set("SnippetAdaptToAbbreviationCaseOption", std::int64_t{3});
    const AutoText second({desk.service, desk.resolver, desk.sources, desk.defaults, desk.sender, desk.suggestionSource,
                           nullptr, [] { return nullptr; }, [] { return nullptr; }});
    EXPECT_EQ(second.snippetAdaptToAbbreviationCaseOption(), 3);
    EXPECT_FALSE(second.enabled());
}

}  // namespace
}  // namespace plume
