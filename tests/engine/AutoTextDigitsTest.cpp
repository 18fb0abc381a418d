// Digit keys that pick an entry of a list.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "content/PLOutput.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using enum KeyModifier;
struct DigitCase {
    const char* about;
    std::int64_t setting;
    char16_t key;
    KeyModifiers held;
    bool swallowed;
    std::u16string sent;  // of "aba", "abb" and "abc"; empty for none
    bool visible;         // the list, afterwards
};

void PrintTo(const DigitCase& digit, std::ostream* stream) {
    *stream << digit.about;
}

class DigitWithAList : public ::testing::TestWithParam<DigitCase> {};

TEST_P(DigitWithAList, PicksAnEntry) {
    const DigitCase& digit = GetParam();
    EngineDesk desk;
    desk.add({u"aba", u"abb", u"abc"});
    desk.engine.setSnippetSelectorKeyModifier(digit.setting);
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();

    EXPECT_EQ(desk.press(digit.key, digit.held), digit.swallowed);
    EXPECT_EQ(desk.list.visible, digit.visible);
    if (digit.sent.empty()) {
        EXPECT_THAT(desk.sender.sent, IsEmpty());
    } else {
        EXPECT_THAT(desk.sender.sent,
                    ElementsAre(RecordingSender::Sent{digit.sent, u"ab", SnippetTrigger::Digit, u"ab", false}));
    }
}

INSTANTIATE_TEST_SUITE_P(Settings, DigitWithAList,
                         ::testing::Values(DigitCase{"first", 0, u'1', {}, true, u"aba", false},
                                           DigitCase{"last", 0, u'3', {}, true, u"abc", false},
                                           DigitCase{"one past the end closes the list", 0, u'4', {}, true, u"", false},
                                           DigitCase{"two past the end is typed", 0, u'5', {}, false, u"", false},
                                           DigitCase{"0 stands for the tenth", 0, u'0', {}, false, u"", false},
                                           DigitCase{"not with a modifier", 0, u'1', Option, false, u"", false},
                                           DigitCase{"not a digit", 0, u'x', {}, false, u"", false},
                                           DigitCase{"Shift", 1, u'1', Shift, true, u"aba", false},
                                           DigitCase{"Shift is missing", 1, u'1', {}, false, u"", false},
                                           DigitCase{"Shift and more", 1, u'1', Shift | Option, false, u"", false},
                                           DigitCase{"Control", 2, u'2', Control, true, u"abb", false},
                                           DigitCase{"Control and more", 2, u'2', Control | Shift, false, u"", false},
                                           DigitCase{"Option", 3, u'3', Option, true, u"abc", false},
                                           DigitCase{"Command", 4, u'1', Command, true, u"aba", false},
                                           DigitCase{"another than Command", 4, u'1', Control, false, u"", false},
                                           DigitCase{"no such modifier", -1, u'1', {}, false, u"", false},
                                           DigitCase{"no such bit", 64, u'1', Command, false, u"", false}));

TEST(Digits, ReachTheTenthEntry) {
    EngineDesk desk;
    desk.openListOf(10);
    EXPECT_TRUE(desk.press(u'0', {}));
    ASSERT_THAT(desk.sender.sent, SizeIs(1));
    EXPECT_EQ(desk.sender.sent[0].trigger, SnippetTrigger::Digit | SnippetTrigger::FromSeveralMatches);
}

TEST(Digits, ThatPickNothingAreTyped) {
    EngineDesk desk;
    desk.openListOf(3);
    EXPECT_FALSE(desk.press(u'0', {}));
    EXPECT_EQ(desk.engine.letters(), u"ab0");
}

TEST(Digits, ThatNeedNoModifierAreNoShortcuts) {
    EngineDesk desk;
    desk.openListOf(3);
    ZDUnregisteredHotKeyPressedEventArgs event;
    event.c = u'1';
    desk.service.unregisteredHotKeyPressedEvent.raise(event);
    EXPECT_FALSE(event.cancel);
    EXPECT_THAT(desk.sender.sent, IsEmpty());
}

TEST(Digits, WithoutAListAreTyped) {
    EngineDesk desk;
    EXPECT_EQ(desk.service.typeText(u"1"), u"1");
    EXPECT_EQ(desk.engine.letters(), u"1");
}

struct SearchCase {
    const char* about;
    std::int64_t setting;
    char16_t key;
    KeyModifiers held;
    bool swallowed;
};

void PrintTo(const SearchCase& digit, std::ostream* stream) {
    *stream << digit.about;
}

class DigitWithQuickSearch : public ::testing::TestWithParam<SearchCase> {};

TEST_P(DigitWithQuickSearch, PicksAResult) {
    const SearchCase& digit = GetParam();
    EngineDesk desk;
    desk.search.results = {std::make_shared<Snippet>(u"one", u"1"), std::make_shared<Snippet>(u"two", u"2")};
    desk.engine.setSnippetSelectorKeyModifier(digit.setting);
    desk.service.typeText(u"ab");
    desk.engine.quickSearch();

    EXPECT_EQ(desk.press(digit.key, digit.held), digit.swallowed);
    if (digit.swallowed) {
        EXPECT_THAT(desk.sender.sent,
                    ElementsAre(RecordingSender::Sent{u"two", std::nullopt, SnippetTrigger::Direct, u"ab", false}));
        EXPECT_FALSE(desk.search.visible);
    } else {
        EXPECT_THAT(desk.sender.sent, IsEmpty());
    }
}

INSTANTIATE_TEST_SUITE_P(Settings, DigitWithQuickSearch,
                         ::testing::Values(SearchCase{"plain", 0, u'2', {}, true},
                                           SearchCase{"past the end", 0, u'3', {}, false},
                                           SearchCase{"Shift", 1, u'2', Shift, true},
                                           SearchCase{"Shift is missing", 1, u'2', {}, false},
                                           SearchCase{"Command", 4, u'2', Command, true}));

TEST(Digits, AnythingElseTypedIntoQuickSearchLeavesTheEngineAlone) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.service.typeText(u"ab");
    desk.engine.quickSearch();
    desk.service.typeText(u"c7\b");
    desk.service.pressKey(KeyCode::Escape);
    desk.service.pressKey(KeyCode::Left);
    EXPECT_EQ(desk.engine.letters(), u"ab");
    EXPECT_TRUE(desk.search.visible);
    EXPECT_THAT(desk.sender.sent, IsEmpty());
}

TEST(Digits, TheirModifierIsTheSameInBothWindows) {
    EngineDesk desk;
    desk.engine.setSnippetSelectorKeyModifier(2);
    desk.engine.quickSearch();
    EXPECT_EQ(desk.search.modifier, 2);
    desk.search.visible = false;
    desk.openListOf(2);
    EXPECT_EQ(desk.list.modifier, 2);

    desk.engine.setSnippetSelectorKeyModifier(3);
    EXPECT_EQ(desk.search.modifier, 3);
    EXPECT_EQ(desk.list.modifier, 3);
}

}  // namespace
}  // namespace plume
