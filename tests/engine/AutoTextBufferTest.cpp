// What the buffer holds after what was typed, clicked and switched.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

TEST(Buffer, FollowsTypingAndDelete) {
    EngineDesk desk;
    desk.service.typeText(u"a\bb");
    EXPECT_EQ(desk.engine.letters(), u"b");
}

TEST(Buffer, DeleteOnAnEmptyBufferReachesTheApplication) {
    EngineDesk desk;
    EXPECT_FALSE(desk.service.pressKey(KeyCode::Delete));
    EXPECT_EQ(desk.engine.letters(), u"");
}

struct TextCase {
    const char* about;
    std::optional<std::u16string> produced;
};

TEST(Buffer, IsKeptByKeysThatDoNotProduceOneUnit) {
    const TextCase cases[] = {{"no text", std::nullopt},
                              {"empty text", u""},
                              {"two units", u"\u00B4e"},
                              {"a pair of surrogates", u"\U0001F600"}};
    for (const TextCase& one : cases) {
        EngineDesk desk;
        desk.service.typeText(u"ab");
        EXPECT_FALSE(desk.service.pressKeyProducing(KeyCode::E, one.produced)) << one.about;
        EXPECT_EQ(desk.engine.letters(), u"ab") << one.about;
    }
}

TEST(Buffer, ShiftWithSpaceAppendsWhateverItProduces) {
    EngineDesk desk;
    desk.service.pressKeyProducing(KeyCode::Space, std::nullopt, KeyModifier::Shift);
    EXPECT_EQ(desk.engine.letters(), u"");
    desk.service.pressKeyProducing(KeyCode::Space, u"\u00B4 ", KeyModifier::Shift);
    EXPECT_EQ(desk.engine.letters(), u"\u00B4 ");
}

TEST(Buffer, StartsAnewWhenTheKeyboardGoesToAnotherProgram) {
    EngineDesk desk;
    desk.service.typeText(u"ab");
    const auto terminal = desk.processes.launch(u"org.example.terminal");
    desk.processes.setFrontProcess(terminal);
    EXPECT_EQ(desk.engine.letters(), u"ab") << "nobody notices before the next key";
    desk.service.typeText(u"c");
    EXPECT_EQ(desk.engine.letters(), u"c");
}

TEST(Buffer, StartsAnewWhenTheEngineIsSwitched) {
    EngineDesk desk;
    desk.service.typeText(u"ab");
    desk.engine.setEnabled(true);
    EXPECT_EQ(desk.engine.letters(), u"");
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
        {"no window", false, false, 110, 110, false},
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
        desk.service.typeText(u"ab");
        if (one.list) desk.engine.suggestAbbreviations();
        if (one.search) desk.engine.quickSearch();
        desk.service.click(one.x, one.y);
        EXPECT_EQ(desk.engine.letters(), one.kept ? u"ab" : u"") << one.about;
        EXPECT_EQ(desk.list.visible, one.list && one.kept) << one.about;
        EXPECT_EQ(desk.search.visible, one.search && one.kept) << one.about;
    }
}

TEST(Buffer, HoldsWhatItHasLongPastItsUsualLength) {
    EngineDesk desk;
    const std::u16string text(20'000, u'q');
    desk.service.typeText(text);
    EXPECT_EQ(desk.engine.letters(), text);
}

// The buffer's rules once more, as short as they can be said, against random typing.
RC_GTEST_PROP(BufferModel, AgreesWithTheEngine, ()) {
    enum class Act { Letter, Delete, ForwardDelete, Left, ShiftSpace, TwoUnits, Click, Shortcut, Nothing };
    const auto acts = *rc::gen::container<std::vector<Act>>(rc::gen::weightedElement<Act>({{10, Act::Letter},
                                                                                           {4, Act::Delete},
                                                                                           {1, Act::ForwardDelete},
                                                                                           {1, Act::Left},
                                                                                           {2, Act::ShiftSpace},
                                                                                           {1, Act::TwoUnits},
                                                                                           {1, Act::Click},
                                                                                           {1, Act::Shortcut},
                                                                                           {1, Act::Nothing}}));
    EngineDesk desk;
    std::u16string model;
    for (const Act act : acts) {
        switch (act) {
            case Act::Letter:
                desk.service.typeText(u"k");
                model += u'k';
                break;
            case Act::Delete:
                desk.service.pressKey(KeyCode::Delete);
                if (!model.empty()) model.pop_back();
                break;
            case Act::ForwardDelete:
                desk.service.pressKey(KeyCode::ForwardDelete);
                break;
            case Act::Left:
                desk.service.pressKey(KeyCode::Left);
                model.clear();
                break;
            case Act::ShiftSpace:
                desk.service.pressKey(KeyCode::Space, KeyModifier::Shift);
                model += u' ';
                break;
            case Act::TwoUnits:
                desk.service.pressKeyProducing(KeyCode::E, u"xy");
                break;
            case Act::Click:
                desk.service.click(0, 0);
                model.clear();
                break;
            case Act::Shortcut:
                desk.press(u's', KeyModifier::Command);
                model.clear();
                break;
            case Act::Nothing:
                desk.service.pressKey(KeyCode::F1);
                break;
        }
        RC_ASSERT(desk.engine.letters() == model);
    }
}

}  // namespace
}  // namespace plume
