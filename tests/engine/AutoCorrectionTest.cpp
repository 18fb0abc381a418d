// Sentences get their capital, words lose their second one, and nothing else is touched.
#include <gtest/gtest.h>

#include <algorithm>

#include "Foundation/Strings.h"
#include "engine/AutoTextUtils.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

struct CorrectionCase {
    const char* about;
    std::u16string typed;
    std::u16string screen;
};

TEST(Correction, ChangesSentencesAndDoubleCapitalsAsTheyAreTyped) {
    const CorrectionCase cases[] = {
        {"capital behind it", u"End. tH", u"End. tH"},
        {"punctuation behind it", u"End. a.", u"End. a."},
        {"excluded in other case", u"Pens, Etc. the", u"Pens, Etc. the"},
        {"excluded, but two spaces", u"Pens, etc.  the", u"Pens, etc.  The"},
        {"ends like an excluded one", u"Fetc. the", u"Fetc. the"},
        {"beyond ASCII", u"End. über", u"End. Über"},
        {"start of a line", u"x\nTHe", u"x\nThe"},
        {"after a tab", u"X\tTHe", u"X\tTHe"},
        {"three capitals", u"X THEm", u"X THEm"},
        {"two letters", u"X TH e", u"X TH e"},
        {"excluded in other case only", u"X IDe", u"X Ide"},
    };
    for (const CorrectionCase& one : cases) {
        EngineDesk desk;
        AutoCorrection& correction = desk.engine.correction();
        correction.setCapitalizeNewSentences(true);
        correction.setCorrectDoubleCapitals(true);
        correction.setCapitalizationExcludedAbbreviations({u"", u"ETC.", u"e.g."});
        correction.setDoubleCapitalsCorrectionExclusion({u"IDs"});
        desk.type(one.typed);
        EXPECT_EQ(desk.screen(), one.screen) << one.about;
        // The buffer is what stands before the caret.
        std::u16string buffer = one.screen;
        std::replace(buffer.begin(), buffer.end(), u'\n', u'\r');
        EXPECT_EQ(desk.engine.letters(), buffer) << one.about;
    }
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

// Every text of up to four of these characters, and a word behind it.
TEST(Sentences, StartWhereTheRulesSay) {
    const std::u16string units = u"aB .?!,\n\t\r\u0003\u2028\u00A0";
    std::vector<std::u16string> texts = {u""};
    for (std::size_t i = 0; i < texts.size(); ++i) {
        const std::u16string text = texts[i] + u"th";
        ASSERT_EQ(AutoTextUtils::shouldCapitalize(text), startsSentence(text)) << toUtf8(text);
        if (texts[i].size() == 4) continue;
        for (const char16_t unit : units) texts.push_back(texts[i] + unit);
    }
}

}  // namespace
}  // namespace plume
