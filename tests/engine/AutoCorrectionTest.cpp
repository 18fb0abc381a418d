// Sentences get their capital, words lose their second one, and nothing else is touched.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "engine/AutoTextUtils.h"
#include "tests/engine/SendingDesk.h"

namespace plume {
namespace {

using ::testing::SizeIs;

struct CorrectionCase {
    const char* about;
    std::u16string typed;
    std::u16string screen;
};

void PrintTo(const CorrectionCase& one, std::ostream* stream) {
    *stream << one.about;
}

void correctEverything(AutoCorrection& correction) {
    correction.setCapitalizeNewSentences(true);
    correction.setCorrectDoubleCapitals(true);
    correction.setCapitalizationExcludedAbbreviations({u"", u"ETC.", u"e.g."});
    correction.setDoubleCapitalsCorrectionExclusion({u"IDs"});
}

class Correcting : public ::testing::TestWithParam<CorrectionCase> {};

TEST_P(Correcting, WhatIsTyped) {
    SendingDesk desk;
    correctEverything(desk.correction);
    desk.type(GetParam().typed);
    EXPECT_EQ(desk.screen(), GetParam().screen);
    // The buffer is what stands before the caret.
    std::u16string buffer = GetParam().screen;
    for (char16_t& unit : buffer) {
        if (unit == u'\n') unit = u'\r';
    }
    EXPECT_EQ(desk.engine.letters(), buffer);
}

INSTANTIATE_TEST_SUITE_P(
    Sentences, Correcting,
    ::testing::Values(CorrectionCase{"after a period", u"End. the", u"End. The"},
                      CorrectionCase{"after a question", u"Eh? the", u"Eh? The"},
                      CorrectionCase{"after an exclamation", u"Oh!  the", u"Oh!  The"},
                      CorrectionCase{"word of one letter", u"End. a b", u"End. A b"},
                      CorrectionCase{"capital behind it", u"End. tH", u"End. tH"},
                      CorrectionCase{"no space", u"x.th", u"x.th"},
                      CorrectionCase{"in a sentence", u"Of the", u"Of the"},
                      CorrectionCase{"after a comma", u"Oh, the", u"Oh, the"},
                      CorrectionCase{"after a tab", u"line\tthe", u"line\tThe"},
                      CorrectionCase{"on a new line", u"line\nthe", u"line\nThe"},
                      CorrectionCase{"indented on a new line", u"line\n  the", u"line\n  The"},
                      CorrectionCase{"spaces from the start", u"  the", u"  the"},
                      CorrectionCase{"punctuation behind it", u"End. a.", u"End. a."},
                      CorrectionCase{"excluded abbreviation", u"Pens, etc. the", u"Pens, etc. the"},
                      CorrectionCase{"excluded in other case", u"Pens, Etc. the", u"Pens, Etc. the"},
                      CorrectionCase{"excluded, but two spaces", u"Pens, etc.  the", u"Pens, etc.  The"},
                      CorrectionCase{"ends like an excluded one", u"Fetc. the", u"Fetc. the"},
                      CorrectionCase{"beyond ASCII", u"End. über", u"End. Über"}));

INSTANTIATE_TEST_SUITE_P(Capitals, Correcting,
                         ::testing::Values(CorrectionCase{"word", u"x THe", u"x The"},
                                           CorrectionCase{"start of the text", u"THe", u"The"},
                                           CorrectionCase{"start of a line", u"x\nTHe", u"x\nThe"},
                                           CorrectionCase{"after a tab", u"x\tTHe", u"x\tTHe"},
                                           CorrectionCase{"in parentheses", u"x (THe", u"x (THe"},
                                           CorrectionCase{"three capitals", u"x THEm", u"x THEm"},
                                           CorrectionCase{"two letters", u"x TH e", u"x TH e"},
                                           CorrectionCase{"excluded", u"x IDs", u"x IDs"},
                                           CorrectionCase{"excluded in other case only", u"x IDe", u"x Ide"}));

TEST(Correction, SendsOneLetterLikeASnippet) {
    SendingDesk desk;
    correctEverything(desk.correction);
    desk.pipeline.setPlayFeedbackSound(true);
    desk.type(u"End. th");
    ASSERT_THAT(desk.service.outputs(), SizeIs(1));
    EXPECT_EQ(desk.lastOutput().backspaceCount, 1U);
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::Typed);
    EXPECT_FALSE(desk.lastOutput().cancelTrigger);
    EXPECT_THAT(desk.sounds.names, SizeIs(1));
}

TEST(Correction, IsUndone) {
    for (const bool withTrigger : {false, true}) {
        SendingDesk desk;
        correctEverything(desk.correction);
        desk.type(u"End. th");
        EXPECT_TRUE(desk.undo(withTrigger));
        EXPECT_EQ(desk.screen(), withTrigger ? u"End. th" : u"End. t");
    }
}

TEST(Correction, IsMadeOnlyWhereItIsOnAndAllowed) {
    struct Case {
        const char* about;
        std::function<void(SendingDesk&)> change;
        bool corrects;
    };
    const Case cases[] = {
        {"by itself", [](SendingDesk&) {}, true},
        {"sentences off", [](SendingDesk& desk) { desk.correction.setCapitalizeNewSentences(false); }, false},
        {"nowhere listed",
         [](SendingDesk& desk) {
             desk.correction.autoCorrectAvailability().availability = PLFunctionAvailability::OnlyListed;
         },
         false},
        {"except here",
         [](SendingDesk& desk) {
             auto& where = desk.correction.autoCorrectAvailability();
             where.availability = PLFunctionAvailability::ExceptListed;
             where.applications = {u"org.example.editor"};
         },
         false},
        {"not with this layout",
         [](SendingDesk& desk) {
             auto& where = desk.correction.autoCorrectAvailability();
             where.inputMethodsOption = PLFunctionAvailability::ExceptListed;
             where.inputMethods = {std::u16string(SimulatedInputSources::US)};
         },
         false},
        {"an application that wants none",
         [](SendingDesk& desk) {
             ContextInputSetting setting;
             setting.flags = InputFlag::DisableCapitalization;
             desk.service.setContextInputSetting(setting);
         },
         false},
    };
    for (const Case& one : cases) {
        SendingDesk desk;
        correctEverything(desk.correction);
        one.change(desk);
        desk.type(u"End. th");
        EXPECT_EQ(desk.screen(), one.corrects ? u"End. Th" : u"End. th") << one.about;
    }
}

// With less than two characters in the buffer, what stands before the caret is asked for.
TEST(Correction, JudgesByTheTextInTheFieldAfterAClick) {
    struct Case {
        std::u16string field;  // before the caret
        bool corrects;
    };
    for (const Case& one : {Case{u"t", true}, Case{u"End. t", true}, Case{u"of t", false}, Case{u"at", false}}) {
        SendingDesk desk;
        correctEverything(desk.correction);
        const auto field = std::make_shared<SimulatedUIElement>();
        field->setText(one.field);
        field->setAttribute("AXSelectedTextRange", TextRange{static_cast<std::int64_t>(one.field.size()), 0});
        const auto application = std::make_shared<SimulatedUIElement>();
        application->setAttribute("AXFocusedUIElement", SimulatedUIElement::Element(field));
        desk.accessibility.setFrontApplicationElement(application);
        desk.type(u"h");
        EXPECT_THAT(desk.service.outputs(), SizeIs(one.corrects ? 1 : 0)) << toUtf8(one.field);
        EXPECT_EQ(desk.engine.letters(), u"h") << "what was not typed is not in the buffer";
    }
}

TEST(Correction, GivesSnippetsTheFirstSay) {
    SendingDesk desk;
    correctEverything(desk.correction);
    desk.add(u"th", u"thorium");
    desk.type(u"End. th");
    EXPECT_EQ(desk.screen(), u"End. thorium");
}

// The rules told once more, unit by unit.
bool startsSentence(const std::u16string& text) {
    std::ptrdiff_t i = static_cast<std::ptrdiff_t>(text.size()) - 3;
    if (i < 0) return false;
    const std::u16string breaks = u"\t\n\v\f\r\u0003\u0085\u2028\u2029\u00A0";
    bool space = false;
    for (; i >= 0; --i) {
        const char16_t unit = text[static_cast<std::size_t>(i)];
        if (breaks.find(unit) != std::u16string::npos) return true;
        if (unit != u' ') return space && (unit == u'.' || unit == u'?' || unit == u'!');
        space = true;
    }
    return false;
}

RC_GTEST_PROP(Sentences, StartWhereTheRulesSay, ()) {
    const auto text =
        *rc::gen::container<std::u16string>(rc::gen::elementOf(std::u16string(u"aB .?!,\n\t\r\u0003\u2028\u00A0")));
    RC_ASSERT(AutoTextUtils::shouldCapitalize(text) == startsSentence(text));
}

}  // namespace
}  // namespace plume
