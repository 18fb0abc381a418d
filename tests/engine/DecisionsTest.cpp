// What the engine remembers of abbreviations that were typed.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <sstream>

#include "Foundation/Strings.h"
#include "tests/engine/AllocationCounter.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Outcome = MatchDecision::Outcome;
using Outcomes = std::vector<Outcome>;

constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Swallowed = ExpandTrigger::DelimiterSwallowed;

Outcomes outcomesOf(const EngineDesk& desk) {
    Outcomes outcomes;
    for (const auto& decision : desk.engine.recentDecisions()) outcomes.push_back(decision.outcome);
    return outcomes;
}

// The virtual clock stands still: every decision is made at the same moment, until the test moves it.
class Decisions : public testing::Test {
  protected:
    Date now_{std::chrono::hours(1)};
    ScopedDateSource clock_{[this] { return now_; }};
};

struct DecisionCase {
    const char* about;
    std::function<void(EngineDesk&)> prepare;  // the editor org.example.editor is in front
    std::u16string typed;
    Outcomes outcomes;
    std::u16string detail = {};  // of the last one
};

std::function<void(EngineDesk&)> group(ExpandTrigger trigger, const std::function<void(SnippetGroup&)>& setUp) {
    return [=](EngineDesk& desk) {
        const auto added = desk.add({u"sig"}, trigger);
        added->setName(u"Letters");
        setUp(*added);
    };
}

const auto AsItIs = [](SnippetGroup& /*group*/) {};

TEST_F(Decisions, TellWhatBecameOfAnAbbreviation) {
    const auto after = [](ExpandAfter rule) { return [=](SnippetGroup& group) { group.setExpandAfter(rule); }; };
    const auto onlyIn = [](const char16_t* application) {
        return [=](SnippetGroup& group) {
            group.availability().availability = PLFunctionAvailability::OnlyListed;
            group.availability().applications = {application};
        };
    };
    const auto otherLayout = [](SnippetGroup& group) {
        group.availability().inputMethodsOption = PLFunctionAvailability::OnlyListed;
        group.availability().inputMethods = {u"elsewhere"};
    };
    const auto prefixed = [](SnippetGroup& group) {
        group.setAbbreviationPrefix(u";;");
        group.setExpandAfter(ExpandAfter::Anything);
    };
    const auto commasOnly = [](SnippetGroup& group) { group.setDelimiters(CharacterSet::withCharacters(u",")); };
    const auto twice = [](EngineDesk& desk) { desk.add({u"sig"}), desk.add({u"sig"}); };
    const auto sameContent = [](EngineDesk& desk) { desk.add(u"sig", u"sig"); };
    const auto commasHereAllThere = [=](EngineDesk& desk) {
        group(Swallowed, commasOnly)(desk);
        desk.add({u"other"}, Swallowed);
    };
    const auto longerElsewhere = [=](EngineDesk& desk) {
        group(AtOnce, AsItIs)(desk);
        const auto other = desk.add({u"!sig"});
        onlyIn(u"org.example.terminal")(*other);
    };
    const auto oneForEachProgram = [=](EngineDesk& desk) {
        group(AtOnce, onlyIn(u"org.example.editor"))(desk);
        group(AtOnce, onlyIn(u"org.example.terminal"))(desk);
    };
    const DecisionCase cases[] = {
        {"an ordinary expansion", group(AtOnce, AsItIs), u"sig", {Outcome::Expanded}},
        {"at a delimiter", group(Swallowed, AsItIs), u"sig ", {Outcome::Expanded}},
        {"no delimiter yet", group(Swallowed, AsItIs), u"sig", {}},
        {"the end is missing", group(AtOnce, AsItIs), u"si and gsi", {}},
        {"never to expand", group(ExpandTrigger::Never, AsItIs), u"sig ", {}},
        {"only by the hot key, which was not pressed", group(ExpandTrigger::HotKey, AsItIs), u"sig ", {}},
        {"several", twice, u"sig", {Outcome::Offered, Outcome::Offered}},
        {"nothing would change", sameContent, u"sig", {Outcome::Failed}},
        {"another program", group(AtOnce, onlyIn(u"xterm")), u"sig", {Outcome::WrongApplication}},
        {"another program, and the end of a word",
         group(AtOnce, onlyIn(u"xterm")),
         u"desig",
         {Outcome::WrongApplication}},
        {"another layout", group(AtOnce, otherLayout), u"sig", {Outcome::WrongInputSource}},
        {"within a word", group(AtOnce, AsItIs), u"desig", {Outcome::WrongTextBefore}, u"delimiter"},
        {"not after white space",
         group(AtOnce, after(ExpandAfter::Whitespace)),
         u".sig",
         {Outcome::WrongTextBefore},
         u"whitespace"},
        {"not after a number",
         group(AtOnce, after(ExpandAfter::Digits)),
         u"sig",
         {Outcome::WrongTextBefore},
         u"digits"},
        {"the prefix began earlier", group(AtOnce, prefixed), u";;;sig", {Outcome::WrongTextBefore}, u"prefix"},
        {"without its prefix", group(AtOnce, prefixed), u" sig", {}},
        {"in capitals", group(AtOnce, AsItIs), u"SIG", {Outcome::WrongCase}},
        {"in capitals at a delimiter", group(Swallowed, AsItIs), u"Sig.", {Outcome::WrongCase}},
        {"a delimiter of others", commasHereAllThere, u"sig.", {Outcome::WrongTrigger}},
        {"a delimiter of others, within a word", commasHereAllThere, u"desig.", {}},
        {"a shorter one expands instead", longerElsewhere, u"!sig", {Outcome::WrongApplication, Outcome::Expanded}},
        {"a twin expands instead", oneForEachProgram, u"sig", {Outcome::Expanded}},
    };
    for (const DecisionCase& one : cases) {
        EngineDesk desk;
        one.prepare(desk);
        desk.type(one.typed);
        EXPECT_EQ(outcomesOf(desk), one.outcomes) << one.about;
        if (one.detail.empty() || one.outcomes != outcomesOf(desk)) continue;
        const MatchDecision last = desk.engine.recentDecisions().back();
        EXPECT_EQ(last, (MatchDecision{now_, one.outcomes[0], last.abbreviation, u"Letters", u"org.example.editor",
                                       one.detail}))
            << one.about;
    }
}

TEST_F(Decisions, AreMadeByTheHotKeyAndByChoosingFromAList) {
    EngineDesk desk;
    const auto group = desk.add({u"sig"}, ExpandTrigger::HotKey);
    desk.type(u"desig");
    desk.engine.expandAtHotkey();
    desk.type(u" sig");
    desk.engine.expandAtHotkey();
    EXPECT_THAT(outcomesOf(desk), ElementsAre(Outcome::WrongTextBefore, Outcome::Expanded));
    desk.engine.forgetDecisions();
    EXPECT_THAT(outcomesOf(desk), IsEmpty());
    desk.add({u"both"});
    desk.add({u"both"});
    desk.type(u" both1");
    EXPECT_THAT(outcomesOf(desk), ElementsAre(Outcome::Offered, Outcome::Offered, Outcome::Expanded));
}

TEST_F(Decisions, RepeatedWithinASecondCountOnce) {
    EngineDesk desk;
    desk.add({u"sig"});
    for (const int milliseconds : {0, 900, 200, 900}) {
        now_ += std::chrono::milliseconds(milliseconds);
        desk.type(u"asig ");
    }
    EXPECT_EQ(desk.engine.recentDecisions().size(), 2U);
    now_ -= std::chrono::hours(1);
    desk.type(u"asig ");
    desk.desktop.activate(u"org.example.terminal");
    desk.type(u"asig ");
    const auto decisions = desk.engine.recentDecisions();
    ASSERT_EQ(decisions.size(), 4U) << "a clock that is put back, and another program, make it another one";
    EXPECT_EQ(decisions[3].application, u"org.example.terminal");
}

TEST_F(Decisions, AreTheLastTwenty) {
    EngineDesk desk;
    const auto group = desk.add({});
    for (char16_t c = u'a'; c <= u'z'; ++c) {
        group->addItem(std::make_shared<Snippet>(std::u16string{u';', c, u'!'}, u"content"));
        desk.type(std::u16string{u'x', u';', c, u'!'});
    }
    const auto decisions = desk.engine.recentDecisions();
    ASSERT_EQ(decisions.size(), DecisionLog::Capacity);
    EXPECT_EQ(decisions.front().abbreviation, u";g!");
    EXPECT_EQ(decisions.back().abbreviation, u";z!");
}

TEST_F(Decisions, OutliveWhatTheyTellOf) {
    EngineDesk desk;
    auto group = desk.add({u"sig"});
    group->setAbbreviationPrefix(u";");
    group->setName(u"Letters");
    desk.type(u"x;sig");
    group->removeItem(group->items()[0]);
    EXPECT_EQ(desk.engine.recentDecisions().at(0).abbreviation, u";sig");
    desk.engine.setSnippetGroups({});
    group.reset();
    const MatchDecision decision = desk.engine.recentDecisions().at(0);
    EXPECT_EQ(decision.abbreviation + decision.group, u"sig") << "nobody knows the group's prefix and name any more";
}

TEST_F(Decisions, TellWhenPlumeIsOffAndWhenKeysStayAway) {
    EngineDesk desk;
    EXPECT_THAT(outcomesOf(desk), IsEmpty()) << "it began switched on";
    desk.engine.setEnabled(true);
    desk.engine.setEnabled(false);
    desk.engine.setEnabled(false);
    desk.engine.setEnabled(true);
    desk.engine.noteSecureInput(true);
    desk.engine.noteSecureInput(false);
    EXPECT_THAT(outcomesOf(desk), ElementsAre(Outcome::SwitchedOff, Outcome::SwitchedOn, Outcome::SecureInputBegan,
                                              Outcome::SecureInputEnded));
}

TEST_F(Decisions, HoldNothingThatWasTypedButAbbreviations) {
    EngineDesk desk;
    const auto group = desk.add({u"Sig", u"addr"});
    group->setName(u"Letters");
    desk.add({u"tab"}, Swallowed)->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    desk.engine.correction().setCapitalizeNewSentences(true);
    desk.engine.correction().setCorrectDoubleCapitals(true);
    desk.type(u"hunter2sig. password. secret. xSIG hunter2 PAssword. i sIg\b\b2addr qtab TAB ");
    for (const auto& decision : desk.engine.recentDecisions()) {
        EXPECT_THAT((std::vector<std::u16string>{u"Sig", u"addr", u"tab"}), ::testing::Contains(decision.abbreviation));
        EXPECT_THAT((std::vector<std::u16string>{u"Letters", u""}), ::testing::Contains(decision.group));
        EXPECT_EQ(decision.application, u"org.example.editor");
        EXPECT_THAT((std::vector<std::u16string>{u"delimiter", u""}), ::testing::Contains(decision.detail));
    }
    EXPECT_GE(desk.engine.recentDecisions().size(), 4U);
}

TEST_F(Decisions, CostNoAllocationWhereAnAbbreviationIsRefused) {
    EngineDesk desk;
    const auto group = desk.add({u"sig", u"e", u"g"});
    const auto stroke = [&](char16_t c) {
        const KeyCode key = SimulatedInputSources::strokeFor(c)->keyCode;
        desk.desktop.keyboardTap().swallows({TapEvent::Type::KeyDown, key, {}, {&c, 1}});
    };
    const auto type = [&] {
        now_ += std::chrono::seconds(2);
        for (const char16_t c : std::u16string_view(u"designer we ")) stroke(c);
    };
    type();
    const std::size_t before = allocationCount();
    for (int i = 0; i < 10; ++i) type();
    EXPECT_EQ(allocationCount(), before);
    EXPECT_EQ(desk.engine.recentDecisions().size(), DecisionLog::Capacity);
}

}  // namespace
}  // namespace plume
